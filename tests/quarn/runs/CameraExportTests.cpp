#include "tests/quarn/Pictures.h"
#include "tests/quarn/Studio.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

namespace quarn::test {
namespace {

using nlohmann::json;
using testing::HasSubstr;
using testing::StartsWith;

class CameraExport : public testing::Test {
protected:
    void SetUp() override {
        const Ended ended = run(m_studio.turntable(5, {"--save", "house", "--mode", "Wireframe"}));
        ASSERT_EQ(ended.exit_code, 0) << ended.err;
    }
    Ended camera(const std::vector<std::string>& options) {
        Start start;
        start.folder = m_studio.path();
        start.arguments = {"camera", "house.quarn"};
        start.arguments.insert(start.arguments.end(), options.begin(), options.end());
        return run(start);
    }

    Studio m_studio;
};

TEST_F(CameraExport, HoldsTheCamerasThatTheListOfFramesTells) {
    const Ended ended = camera({"--out", "camera.json"});
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_EQ(ended.out, "Wrote the camera of 5 frames, 10 a second, to camera.json.\n");
    const json track = json::parse(readFile(m_studio / "camera.json"));
    const json list = json::parse(readFile(m_studio / "out/house.frames.json"));
    ASSERT_EQ(track["frames"].size(), 5U);
    for (std::size_t frame = 0; frame < 5; ++frame)
        for (const char* const part : {"place", "target", "up"})
            for (std::size_t axis = 0; axis < 3; ++axis)
                EXPECT_NEAR(track["frames"][frame][part][axis].get<double>(),
                            list["images"][frame]["camera"][part][axis].get<double>(), 1e-11);
}

TEST_F(CameraExport, TakesTheFrameRateAndTellsWhatAPersonShouldKnow) {
    const Ended ended = camera({"--out", "a camera.glb", "--fps", "50"});
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_THAT(ended.out, StartsWith("The document has no units: one unit counts as a metre"));
    EXPECT_THAT(ended.out,
                HasSubstr("Wrote the camera of 5 frames, 50 a second, to a camera.glb."));
    EXPECT_THAT(readFile(m_studio / "a camera.glb"), StartsWith("glTF"));
}

TEST_F(CameraExport, ShowsItsScript) {
    const Ended ended = camera({"--out", "a camera.glb", "--fps", "50", "--show-script"});
    EXPECT_EQ(ended.exit_code, 0) << ended.err;
    EXPECT_EQ(ended.out,
              "_-Open \"house.quarn\"\n_-ExportCamera [FrameRate] 50 \"a camera.glb\"\n");
    EXPECT_FALSE(std::filesystem::exists(m_studio / "a camera.glb"));
}

TEST_F(CameraExport, TellsMistakesInOneLine) {
    writeFile(m_studio / "model.glb", "a model");
    const std::pair<std::vector<std::string>, const char*> mistakes[] = {
        {{"--out", "camera.fbx"}, "Give a file that ends in .glb, .gltf, .json or .csv."},
        {{"--out", "nowhere/camera.glb"}, "nowhere"},
        {{"--out", "model.glb"}, "model.glb is not replaced"},
        {{"--out", "camera.glb", "--fps", "0"},
         "--fps must be a whole number of frames a second from 1 to 1000"}};
    for (const auto& [options, reason] : mistakes) {
        const Ended ended = camera(options);
        EXPECT_NE(ended.exit_code, 0) << reason;
        EXPECT_EQ(linesOf(ended.err).size(), 1U) << ended.err;
        EXPECT_THAT(ended.err, HasSubstr(reason));
    }
    EXPECT_EQ(readFile(m_studio / "model.glb"), "a model");
    EXPECT_EQ(camera({"--out", "model.glb", "--overwrite"}).exit_code, 0);
    EXPECT_THAT(readFile(m_studio / "model.glb"), StartsWith("glTF"));
}

TEST_F(CameraExport, OfADocumentWithoutAnimationSaysHowToSetOneUp) {
    writeFile(m_studio / "bare.txt", "_-SaveAs bare.quarn\n");
    Start start;
    start.folder = m_studio.path();
    start.arguments = {"run", "bare.txt", "house.obj"};
    ASSERT_EQ(run(start).exit_code, 0);
    start.arguments = {"camera", "bare.quarn", "--out", "camera.glb"};
    const Ended ended = run(start);
    EXPECT_EQ(ended.exit_code, 1);
    EXPECT_THAT(ended.err, HasSubstr("The document has no animation. Set one up, such as with "
                                     "SetTurntableAnimation"));
}

} // namespace
} // namespace quarn::test
