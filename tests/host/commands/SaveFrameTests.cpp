#include "engine/display/DisplayMode.h"
#include "host/share/frames/FramePicture.h"
#include "sdk/qncore/QnPlatform.h"
#include "tests/host/app/TestCommand.h"
#include "tests/host/document/DocumentFixtures.h"
#include "tests/support/TempFolder.h"

#include <gmock/gmock.h>

#include <stdexcept>

namespace quarn::test {
namespace {

using testing::HasSubstr;

/// Keeps a record and gives its frames as a plug-in does, or fails in the way it is told to.
class FrameKeeper final : public IQnZoetrixDynamicAccess {
public:
    FrameKeeper() {
        record.SetCaptureType(KM_3dmAnimationProperties::turntable);
        record.SetViewportName(L"Perspective");
        record.SetFrameCount(2);
        for (const double x : {10.0, 12.0}) {
            record.CameraPoints().Append(KM_3dPoint(x, -20.0, 8.0));
            record.TargetPoints().Append(KM_3dPoint::Origin);
        }
        Zoetrix_SetQuarnDynamicAccess(this);
    }
    ~FrameKeeper() override { Zoetrix_SetQuarnDynamicAccess(nullptr); }

    const KM_3dmAnimationProperties& AnimationProperties(const CQuarnDoc&) const override {
        return record;
    }
    void SetAnimationProperties(const CQuarnDoc&, const KM_3dmAnimationProperties&) override {
        ++stored;
    }
    bool AnimatedViewAtFrame(CQuarnDoc&, const KM_3dmAnimationProperties& rec, int frame,
                             KM_Viewport& out) override {
        if (throws)
            throw std::runtime_error("no camera today");
        asked_frame = frame;
        return out.SetCameraLocation(rec.CameraPoints()[frame - 1]);
    }
    bool AnimatedSunAtFrame(CQuarnDoc&, const KM_3dmAnimationProperties&, int frame,
                            KM_Light& light) override {
        asked_frame = frame;
        light.SetStyle(KM_LightStyle::world_directional);
        light.SetDirection({0.0, 0.0, -1.0});
        return true;
    }

    KM_3dmAnimationProperties record;
    bool throws = false;
    int asked_frame = 0;
    int stored = 0;
};

class SaveFrameTest : public HostTest {
protected:
    ViewState& view() { return Document::of(session.document()).activeView(); }
    CQuarnCommand::result save(const wchar_t* words) {
        return run((KM_wString(L"SaveFrame ") + words + L" \"" +
                    KM_wString::FromUtf8(file.string()) + L"\"")
                       .Array());
    }

    TempFolder folder;
    const std::filesystem::path file = folder.path() / "frame.bmp";
};

TEST_F(SaveFrameTest, WithoutAPlugInNothingIsAsked) {
    ASSERT_EQ(Zoetrix_QuarnDynamicAccess(), nullptr);
    EXPECT_EQ(save(L"0"), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("No plug-in keeps an animation. Load one with LoadPlugIn"));
    EXPECT_TRUE(front_end.questions().empty());
    EXPECT_FALSE(std::filesystem::exists(file));
}

TEST_F(SaveFrameTest, AsksTheObjectForTheFrameCountedFromOne) {
    FrameKeeper keeper;
    ASSERT_EQ(save(L"1"), CQuarnCommand::success);
    EXPECT_EQ(keeper.asked_frame, 2);
    EXPECT_EQ(keeper.stored, 0);
    EXPECT_TRUE(std::filesystem::exists(file));
}

TEST_F(SaveFrameTest, ANameWithBlanksWithoutQuotesIsToldAndNothingIsWritten) {
    FrameKeeper keeper;
    EXPECT_EQ(save((L"1 " + (folder / "my.bmp").wstring()).c_str()), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("Nothing was written: behind the name of the file stands"));
    EXPECT_TRUE(std::filesystem::is_empty(folder.path()));
}

TEST_F(SaveFrameTest, AWriteProtectedPictureIsNotReplaced) {
    FrameKeeper keeper;
    writeFile(file, "old");
    std::filesystem::permissions(file, std::filesystem::perms::owner_read);
    EXPECT_EQ(save(L"1"), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("frame.bmp': it is write-protected"));
    EXPECT_EQ(readFile(file), "old");
}

TEST_F(SaveFrameTest, WhatTheViewsShowStays) {
    FrameKeeper keeper;
    addBox(view().document(), {-5, -5, 0}, {5, 5, 5});
    view().setFrameSize(32, 18);
    view().redraw(CQuarnView::draw_scene);
    const auto picture = view().frameBuffer().rgba;
    const auto drawn = view().drawCount();
    const auto shown = view().showCount();
    for (const auto type :
         {KM_3dmAnimationProperties::turntable, KM_3dmAnimationProperties::one_day_sun}) {
        keeper.record.SetCaptureType(type);
        ASSERT_EQ(save(L"Size 20 10 1"), CQuarnCommand::success);
    }
    EXPECT_TRUE(view().frameBuffer().rgba == picture);
    EXPECT_EQ(view().drawCount(), drawn);
    EXPECT_EQ(view().showCount(), shown);
    EXPECT_EQ(view().frameWidth(), 32);
    view().redraw(CQuarnView::draw_scene);
    EXPECT_TRUE(view().frameBuffer().rgba == picture) << "the next redraw shows what it did";
}

TEST_F(SaveFrameTest, APlugInThatThrowsIsAFrameThatCannotBePlaced) {
    FrameKeeper keeper;
    keeper.throws = true;
    EXPECT_EQ(save(L"0"), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("The camera of frame 0 cannot be placed"));
    EXPECT_THAT(printed(), HasSubstr("two different points"));
    EXPECT_THAT(printed(), HasSubstr("a direction for it that points up"));
    EXPECT_FALSE(std::filesystem::exists(file));
}

TEST_F(SaveFrameTest, ThePictureHasTheSizeThatIsAskedFor) {
    FrameKeeper keeper;
    // 24 bits a pixel, rows filled up to 4 bytes, behind 54 bytes of headers.
    ASSERT_EQ(save(L"Size 20 10 0"), CQuarnCommand::success);
    EXPECT_EQ(std::filesystem::file_size(file), 54U + 10U * 60U);
    ASSERT_EQ(save(L"Size 20 10 Size 8 4 0"), CQuarnCommand::success);
    EXPECT_EQ(std::filesystem::file_size(file), 54U + 4U * 24U);
    view().setFrameSize(40, 30);
    ASSERT_EQ(save(L"0"), CQuarnCommand::success);
    EXPECT_EQ(std::filesystem::file_size(file), 54U + 30U * 120U);
}

TEST_F(SaveFrameTest, RenderedFrameHasTheRenderSizeAndShowsTheView) {
    FrameKeeper keeper;
    addBox(view().document(), {-5, -5, 0}, {5, 5, 5});
    ASSERT_EQ(run(L"RenderSettings Size 24 16 Samples 4 PreviewSamples 2 _Enter"),
              CQuarnCommand::success);
    keeper.record.SetRenderFull(true);
    ASSERT_EQ(save(L"1"), CQuarnCommand::success) << printed();
    EXPECT_EQ(std::filesystem::file_size(file), 54U + 16U * 72U);
    EXPECT_FALSE(view().document().renderWindow().isOpen()) << "the window is not used";
    keeper.record.SetRenderFull(false);
    keeper.record.SetRenderPreview(true);
    ASSERT_EQ(save(L"Size 20 10 0"), CQuarnCommand::success) << printed();
    EXPECT_EQ(std::filesystem::file_size(file), 54U + 10U * 60U);
}

TEST_F(SaveFrameTest, ATransparentFrameIsClearAroundTheModelAndNotWrittenAsBmp) {
    FrameKeeper keeper;
    addBox(view().document(), {-5, -5, 0}, {5, 5, 5});
    keeper.record.SetDisplayMode(rendered_mode_id);
    view().setFrameSize(32, 24);
    ASSERT_EQ(run(L"RenderSettings Background Transparent Ground=No _Enter"),
              CQuarnCommand::success);
    EXPECT_EQ(save(L"0"), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("Pictures of the kind bmp have no opacity"));
    EXPECT_FALSE(std::filesystem::exists(file));
    ASSERT_EQ(run(L"FitView _Enter"), CQuarnCommand::success);
    keeper.record.CameraPoints()[0] = view().viewport().CameraLocation();
    ASSERT_EQ(run((L"SaveFrame 0 \"" + (folder / "frame.png").wstring() + L"\"").c_str()),
              CQuarnCommand::success)
        << printed();
    const auto picture = readFramePicture(folder / "frame.png");
    ASSERT_TRUE(picture) << picture.message();
    EXPECT_EQ(picture.value().pixel(0, 0)[3], 0);
    EXPECT_EQ(picture.value().pixel(16, 12)[3], 255);
}

TEST_F(SaveFrameTest, RenderingThatIsCancelledWritesNoFile) {
    FrameKeeper keeper;
    keeper.record.SetRenderFull(true);
    front_end.setKeyDown(VK_ESCAPE, true);
    EXPECT_EQ(save(L"Size 20 10 0"), CQuarnCommand::cancel);
    EXPECT_FALSE(std::filesystem::exists(file));
}

} // namespace
} // namespace quarn::test
