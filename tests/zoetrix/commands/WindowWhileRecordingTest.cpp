#include "host/session/AnimationState.h"
#include "host/session/DocumentState.h"
#include "host/session/ViewFrame.h"
#include "host/session/ViewNavigation.h"
#include "host/session/ViewPicking.h"
#include "tests/zoetrix/fixtures/RecordingFixture.h"

namespace {

/// What a person does with the mouse while the program is busy.
class WindowWhileRecording : public RecordingFixture {
protected:
    std::string recorded(int frame) const {
        return readFile(frames / ("Walk00" + std::to_string(frame) + ".bmp"));
    }
    void SetUp() override {
        RecordingFixture::SetUp();
        record().SetHtmlFilename(L"Walk");
        record().SetFileExtension(L"bmp");
    }
    CQuarnCommand::result recordAll() {
        answer({L"_Enter"});
        return run(L"RecordAnimation");
    }
};

} // namespace

TEST_F(WindowWhileRecording, WhateverTheMouseDoesToViewsThePicturesAreTheSame) {
    ASSERT_EQ(CQuarnCommand::success, recordAll());
    const std::vector<std::string> calm = {recorded(0), recorded(1), recorded(2)};
    ASSERT_EQ(64U * 48U * 3U + 54U, calm[0].size()) << "header and pixels of 64 by 48";
    ASSERT_NE(calm[0], calm[2]);

    int width_px = 65;
    front_end.while_waiting = [&] {
        EXPECT_TRUE(quarn::setFrameSize(view(L"Perspective"), ++width_px, 50));
        quarn::activateView(view(L"Top"));
        quarn::orbitView(view(L"Front"), 5.0, 5.0);
        quarn::zoomView(view(L"Top"), 1.1, 5.0, 5.0);
        quarn::objectAt(view(L"Perspective"), 32.0, 24.0);
        quarn::pointAt(view(L"Top"), 32.0, 24.0);
    };
    ASSERT_EQ(CQuarnCommand::success, recordAll());
    front_end.while_waiting = nullptr;
    for (int frame = 0; frame < 3; ++frame)
        EXPECT_EQ(calm[static_cast<std::size_t>(frame)], recorded(frame)) << frame;
    EXPECT_EQ(width_px, view(L"Perspective").MainViewport().DisplayPipeline()->FrameWidth());
    EXPECT_STREQ(L"Top", quarn::activeView(doc()).MainViewport().Name());
}

TEST_F(WindowWhileRecording, ARenderedRecordingStaysWithTheViewThatItBeganWith) {
    renderSmall();
    record().SetRenderPreview(true);
    ASSERT_EQ(CQuarnCommand::success, recordAll());
    const std::string calm = recorded(2);
    front_end.while_waiting = [&] { quarn::activateView(view(L"Top")); };
    ASSERT_EQ(CQuarnCommand::success, recordAll());
    front_end.while_waiting = nullptr;
    EXPECT_EQ(calm, recorded(2));
}

TEST_F(WindowWhileRecording, PlayingAndSteppingModifyNothingAndTheFrameIsKnown) {
    ASSERT_EQ(CQuarnCommand::success, run(L"SaveAs \"" + wide(folder / "walk.quarn") + L"\""));
    ASSERT_FALSE(quarn::isModified(doc()));
    ASSERT_EQ(CQuarnCommand::success, run(L"PlayAnimation"));
    ASSERT_EQ(CQuarnCommand::success, run(L"ViewFrameNumber 1"));
    EXPECT_FALSE(quarn::isModified(doc()));
    EXPECT_EQ(1, quarn::animationState(doc()).current_frame);
    EXPECT_EQ(3, quarn::animationState(doc()).frame_count);
    EXPECT_TRUE(quarn::animationState(doc()).can_play);
    ASSERT_EQ(CQuarnCommand::success, run(L"AnimationName Other"));
    EXPECT_TRUE(quarn::isModified(doc()));
}

TEST_F(WindowWhileRecording, ASunStudyThatWasPlayedLeavesTheDocumentUnmodified) {
    setUpSunFrames(3);
    ASSERT_EQ(CQuarnCommand::success, run(L"SaveAs \"" + wide(folder / "sun.quarn") + L"\""));
    ASSERT_EQ(CQuarnCommand::success, run(L"PlayAnimation"));
    EXPECT_FALSE(quarn::isModified(doc()));
    ASSERT_EQ(CQuarnCommand::success, run(L"New"));
    EXPECT_FALSE(quarn::isModified(doc()));
    EXPECT_FALSE(quarn::animationState(doc()).can_play);
}
