#include "tests/zoetrix/fixtures/RecordingFixture.h"

#include <tbb/global_control.h>
#include <tbb/task_arena.h>

#include <array>

namespace {

/// How frames become pictures.
struct Capture {
    const char* name;
    KM_UUID (*display_mode)() = CQuarnDisplayAttrsMgr::RenderedModeId;
    bool renders_fully = false;
    bool renders_quickly = false;
};

template <int index> KM_UUID modeAt() {
    KM_SimpleArray<const CDisplayPipelineAttributes*> modes;
    CQuarnDisplayAttrsMgr::GetDisplayAttrsList(modes);
    return modes[index]->Id();
}

/// Recordings of one scene, each way of capture.
class SameRecording : public RecordingFixture, public testing::WithParamInterface<Capture> {
protected:
    void SetUp() override {
        RecordingFixture::SetUp();
        importObj("v -3 2 -1\nv 3 2 -1\nv 3 4 3\nv -3 4 3\nv -2 -2 1\nv 2 -2 2\no wall\n"
                  "f 1 2 3 4\no rail\nl 5 6\n");
        renderSmall();
        ASSERT_EQ(CQuarnCommand::success, run(L"ViewportSize 131 77"));
        record().SetFileExtension(L"png");
        record().SetDisplayMode(GetParam().display_mode());
        record().SetRenderFull(GetParam().renders_fully);
        record().SetRenderPreview(GetParam().renders_quickly);
    }

    /// The bytes of the three frames, recorded by so many threads.
    std::array<std::string, 3> recordedBy(int threads) {
        const tbb::global_control limit(tbb::global_control::max_allowed_parallelism,
                                        static_cast<std::size_t>(std::max(threads, 2)));
        tbb::task_arena arena(threads);
        arena.execute([&] {
            EXPECT_EQ(threads, tbb::this_task_arena::max_concurrency());
            EXPECT_EQ(CQuarnCommand::success, run(L"RecordAnimation _Enter"));
        });
        std::array<std::string, 3> pictures;
        for (std::size_t k = 0; k < pictures.size(); ++k) {
            const std::filesystem::path file = frames / ("Walk00" + std::to_string(k) + ".png");
            pictures[k] = readFile(file);
            std::filesystem::remove(file);
        }
        return pictures;
    }
};

/// The same of sun studies, which have one display mode.
class SameSunStudy : public SameRecording {};

std::string nameOf(const testing::TestParamInfo<Capture>& capture) {
    return capture.param.name;
}

} // namespace

TEST_P(SameRecording, ComesFromOneTwoAndSevenThreads) {
    const std::array<std::string, 3> by_one = recordedBy(1);
    EXPECT_FALSE(by_one[0].empty());
    EXPECT_NE(by_one[0], by_one[2]) << "the camera moves";
    EXPECT_TRUE(by_one == recordedBy(2));
    EXPECT_TRUE(by_one == recordedBy(7));
}

TEST_P(SameSunStudy, ComesFromOneTwoAndSevenThreads) {
    setUpSunFrames(3);
    const std::array<std::string, 3> by_one = recordedBy(1);
    EXPECT_FALSE(by_one[0].empty());
    EXPECT_NE(by_one[0], by_one[2]) << "the sun moves";
    EXPECT_TRUE(by_one == recordedBy(2));
    EXPECT_TRUE(by_one == recordedBy(7));
}

INSTANTIATE_TEST_SUITE_P(WaysOfCapture, SameRecording,
                         testing::Values(Capture{"Wireframe", modeAt<0>},
                                         Capture{"Shaded", modeAt<1>},
                                         Capture{"Rendered", modeAt<2>},
                                         Capture{"Translucent", modeAt<3>},
                                         Capture{"XRay", modeAt<4>}, Capture{"Drawing", modeAt<5>},
                                         Capture{"Clay", modeAt<6>},
                                         Capture{.name = "RenderFull", .renders_fully = true},
                                         Capture{.name = "RenderPreview", .renders_quickly = true}),
                         nameOf);
INSTANTIATE_TEST_SUITE_P(WaysOfCapture, SameSunStudy,
                         testing::Values(Capture{"Rendered"},
                                         Capture{.name = "RenderFull", .renders_fully = true},
                                         Capture{.name = "RenderPreview", .renders_quickly = true}),
                         nameOf);
