#include "host/document/Document.h"
#include "host/document/DocumentDrawing.h"
#include "host/document/DocumentScene.h"
#include "sdk/qncore/qncore.h"
#include "tests/engine/display/DisplayFixture.h"
#include "tests/host/app/TestCommand.h"
#include "tests/host/document/DocumentFixtures.h"
#include "tests/support/TempFolder.h"

#include <cmath>

namespace quarn::test {
namespace {

constexpr int frames = 12;

/// How a frame becomes a picture: in a display mode, or by a command that renders it.
struct Capture {
    const wchar_t* name;
    const wchar_t* script = nullptr; ///< null: drawn in the mode of that name
};

/// Records as a plug-in does: a camera that circles, and a picture of every frame.
class RecordedScene : public HostTest, public testing::WithParamInterface<Capture> {
protected:
    void SetUp() override {
        // Large enough for a scene of its own, and small ones that share one.
        document().objects().addMesh(L"Hills", {shared(hillMesh(100))});
        for (int i = 0; i < 3; ++i)
            addBox(document(), {3.0 * i, 0.0, 0.0}, {3.0 * i + 2.0, 2.0, 4.0});
        ASSERT_EQ(run(L"ViewportSize 64 48"), CQuarnCommand::success);
        ASSERT_EQ(run(L"RenderSettings Size 32 24 Samples 2 PreviewSamples 1 _Enter"),
                  CQuarnCommand::success);
    }

    Document& document() { return Document::of(session.document()); }

    /// @return how often a part of the scene was prepared for rays so far
    std::size_t buildCount() {
        const auto scene = document().drawing().scene();
        EXPECT_TRUE(scene.ok()) << scene.message();
        return scene.ok() ? scene.value()->display().rays().buildCount() : 0;
    }

    bool capture(CQuarnView& view, int frame) {
        const KM_wString path =
            KM_wString::FromUtf8((folder / ("f" + std::to_string(frame) + ".bmp")).string());
        if (const wchar_t* const script = GetParam().script) {
            const unsigned int number = session.document().RuntimeSerialNumber();
            const bool done =
                QuarnApp().RunScript(number, script, 0) &&
                QuarnApp().RunScript(number, L"_-SaveRenderWindowAs \"" + path + L"\"", 0) &&
                QuarnApp().RunScript(number, L"_CloseRenderWindow", 0);
            view.Redraw(CQuarnView::draw_scene);
            return done;
        }
        CQuarnDisplayPipeline& pipeline = *view.ActiveViewport().DisplayPipeline();
        CQuarnDib picture;
        const bool drawn =
            pipeline.DrawToDib(picture, 64, 48, *pipeline.CurrentDisplayAttributes());
        pipeline.CopyToFrameBuffer(picture);
        view.Redraw(CQuarnView::show_frame_buffer);
        return drawn && picture.WriteToFile(path, 0);
    }

    /// @return how often the scene was built for the frames after the first picture
    std::size_t builtWhileRecording() {
        std::size_t built = 0;
        TestScriptCommand record(L"Record", [&](const CQuarnCommandContext&) {
            CQuarnView& view = document().activeView().face();
            EXPECT_TRUE(view.MainViewport().SetDisplayMode(mode()));
            view.Redraw();
            const std::size_t before = buildCount();
            for (int frame = 0; frame < frames; ++frame) {
                const double angle = 2.0 * KM_PI * frame / frames;
                EXPECT_TRUE(view.MainViewport().SetTargetAndCameraLocation(
                    {0.0, 0.0, 0.0}, {40.0 * std::cos(angle), 40.0 * std::sin(angle), 15.0}, true,
                    true));
                EXPECT_TRUE(capture(view, frame)) << frame << printed();
            }
            built = buildCount() - before;
            return CQuarnCommand::success;
        });
        add(record);
        EXPECT_EQ(run(L"Record"), CQuarnCommand::success);
        return built;
    }

    TempFolder folder;

private:
    static KM_UUID mode() {
        KM_SimpleArray<const CDisplayPipelineAttributes*> modes;
        CQuarnDisplayAttrsMgr::GetDisplayAttrsList(modes);
        for (const CDisplayPipelineAttributes* mode : modes)
            if (mode->EnglishName() == GetParam().name)
                return mode->Id();
        return CQuarnDisplayAttrsMgr::RenderedModeId();
    }
};

TEST_P(RecordedScene, IsBuiltOnceForAllFrames) {
    EXPECT_EQ(builtWhileRecording(), 0U);
    EXPECT_TRUE(std::filesystem::exists(folder / "f11.bmp"));
    // The count does tell of what is built: an object more is.
    const std::size_t before = buildCount();
    addBox(document(), {-9.0, -9.0, 0.0}, {-5.0, -5.0, 5.0});
    EXPECT_GT(buildCount(), before);
}

TEST_P(RecordedScene, IsDrawnOnceForEachFrame) {
    const std::uint64_t before = document().activeView().drawCount();
    builtWhileRecording();
    // Once before the first frame, when the display mode is entered.
    EXPECT_EQ(document().activeView().drawCount() - before, 1U + frames);
}

INSTANTIATE_TEST_SUITE_P(WaysOfCapture, RecordedScene,
                         testing::Values(Capture{L"Wireframe"}, Capture{L"Shaded"},
                                         Capture{L"Rendered"}, Capture{L"Translucent"},
                                         Capture{L"X-Ray"}, Capture{L"Drawing"}, Capture{L"Clay"},
                                         Capture{L"RenderFull", L"_Render"},
                                         Capture{L"RenderPreview", L"_RenderPreview"}),
                         [](const auto& capture) {
                             KM_wString name = capture.param.name;
                             name.Remove(L'-');
                             return name.ToUtf8();
                         });

} // namespace
} // namespace quarn::test
