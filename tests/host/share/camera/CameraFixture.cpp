#include "tests/host/share/camera/CameraFixture.h"

#include "host/recording/FramesManifest.h"
#include "zoetrix/plugin/ZoetrixPlugIn.h"

#include <algorithm>

namespace quarn::test {

namespace {

class Follower final : public RecordingFollower {
public:
    explicit Follower(std::vector<KM_Viewport>& cameras) : m_cameras(cameras) {}
    void frameRecorded(const RecordedFrame& frame) override {
        EXPECT_EQ(frame.number, static_cast<int>(m_cameras.size()));
        m_cameras.push_back(frame.camera);
    }
    void frameKept(int, const std::filesystem::path&) override {}
    void recordingEnded(const RecordingReport&) override {}

private:
    std::vector<KM_Viewport>& m_cameras;
};

} // namespace

void CameraFixture::SetUp() {
    importObj("v -1 -1 0\nv 1 -1 0\nv 1 1 0\nv -1 1 0\nv 0 0 2\no roof\n"
              "f 1 2 5\nf 2 3 5\nf 3 4 5\nf 4 1 5\n");
    runAll({L"ViewportSize 64 48"});
    front_end.clearPrinted();
}

void CameraFixture::runAll(std::initializer_list<const wchar_t*> lines) {
    for (const wchar_t* const line : lines)
        ASSERT_EQ(run(line), CQuarnCommand::success) << KM_wString(line).ToUtf8() << "\n" << said();
}

void CameraFixture::makeCurve(const std::string& name, const std::string& points, bool replaces) {
    const std::filesystem::path file = folder / (name + ".txt");
    writeFile(file, points);
    const std::string line = std::string("_-ImportCurve ") + (replaces ? "[Replace] " : "[Name] ") +
                             "\"" + name + "\" \"" + file.native() + "\"";
    ASSERT_EQ(run(KM_wString::FromUtf8(line)), CQuarnCommand::success) << said();
}

void CameraFixture::setUpCameras(const KM_3dPointArray& cameras) {
    setUpCameraFrames(cameras.Count());
    for (int k = 0; k < cameras.Count(); ++k) {
        record().CameraPoints()[k] = cameras[k];
        record().TargetPoints()[k] = KM_3dPoint::Origin;
    }
}

std::vector<KM_Viewport> CameraFixture::recorded() {
    std::vector<KM_Viewport> cameras;
    Application::current()->recordingFollowers().add(std::make_unique<Follower>(cameras));
    const KM_wString line =
        L"-RecordAnimation TargetFolder \"" + wide(folder / "frames") + L"\" _Enter";
    std::filesystem::create_directories(folder / "frames");
    EXPECT_EQ(run(line), CQuarnCommand::success) << said();
    return cameras;
}

CQuarnCommand::result CameraFixture::exportTo(const std::filesystem::path& file,
                                              const wchar_t* rate) {
    front_end.clearPrinted();
    return run(KM_wString(L"-ExportCamera ") + rate + L" \"" + wide(file) + L"\"");
}

std::string CameraFixture::exported(const std::string& name, const wchar_t* rate) {
    EXPECT_EQ(exportTo(folder / name, rate), CQuarnCommand::success) << said();
    return readFile(folder / name);
}

KM_3dPoint pointOf(const Json& list) {
    return {list.at(0).get<double>(), list.at(1).get<double>(), list.at(2).get<double>()};
}

testing::AssertionResult alike(const KM_3dPoint& a, const KM_3dPoint& b, double relative) {
    return near(a, b, relative * std::max(a.DistanceTo(KM_3dPoint::Origin), 1.0));
}

void expectCameras(const std::vector<KM_Viewport>& cameras, const Json& track) {
    ASSERT_GT(cameras.size(), 0U);
    ASSERT_EQ(track.at("frames").size(), cameras.size());
    for (std::size_t k = 0; k < cameras.size(); ++k) {
        const Json& frame = track.at("frames").at(k);
        const FrameCamera drawn = frameCameraOf(cameras[k]);
        EXPECT_EQ(frame.at("frame"), k);
        EXPECT_TRUE(alike(drawn.place, pointOf(frame.at("place")), 1e-12)) << k;
        EXPECT_TRUE(alike(drawn.target, pointOf(frame.at("target")), 1e-12)) << k;
        EXPECT_TRUE(alike(KM_3dPoint(drawn.up), pointOf(frame.at("up")), 1e-12)) << k;
        EXPECT_TRUE(alike(KM_3dPoint(-cameras[k].CameraZ()), pointOf(frame.at("direction")), 1e-12))
            << k;
        EXPECT_EQ(track.at("projection"), drawn.is_parallel ? "parallel" : "perspective");
        if (drawn.is_parallel) {
            EXPECT_NEAR(track.at("width").get<double>(), drawn.width, 1e-12 * drawn.width);
            EXPECT_NEAR(track.at("height").get<double>(), drawn.height, 1e-12 * drawn.height);
        } else {
            EXPECT_NEAR(track.at("lens_mm").get<double>(), drawn.lens_mm, 1e-12 * drawn.lens_mm);
        }
    }
}

} // namespace quarn::test
