#include "tests/zoetrix/fixtures/PlugInFixture.h"

#include <cmath>
#include <limits>

using testing::HasSubstr;

namespace {

class Navigation : public PlugInFixture {
protected:
    void SetUp() override { ASSERT_EQ(CQuarnCommand::success, run(L"ViewportSize 32 24")); }

    void standAt(int frame) {
        setUpCameraFrames(30);
        record().SetCurrentFrame(frame);
    }
    /// The frame that the view shows.
    int shownFrame() {
        const KM_3dPoint camera = view(L"Perspective").MainViewport().VP().CameraLocation();
        EXPECT_TRUE(near(camera, cameraOfFrame(static_cast<int>(std::lround(camera.x))), 1e-9));
        return static_cast<int>(std::lround(camera.x));
    }
};

} // namespace

TEST_F(Navigation, WithoutAnimationEachCommandSaysSo) {
    EXPECT_EQ(CQuarnCommand::failure, run(L"PlayAnimation"));
    EXPECT_THAT(printed(), HasSubstr(L"No animation is currently set. There is nothing to view\n"));
    for (const wchar_t* command : {L"ViewFirstFrame", L"ViewLastFrame", L"ViewPreviousFrame",
                                   L"ViewNextFrame", L"ViewFrameNumber"}) {
        front_end.clearPrinted();
        EXPECT_EQ(CQuarnCommand::failure, run(command));
        EXPECT_THAT(printed(),
                    HasSubstr(L"No animation is currently set. There is no frame to view\n"));
    }
    EXPECT_TRUE(front_end.questions().empty());
}

TEST_F(Navigation, FirstAndLastFrameAreTheEnds) {
    standAt(12);
    ASSERT_EQ(CQuarnCommand::success, run(L"ViewLastFrame"));
    EXPECT_EQ(29, shownFrame());
    EXPECT_EQ(29, record().CurrentFrame());
    ASSERT_EQ(CQuarnCommand::success, run(L"ViewFirstFrame"));
    EXPECT_EQ(0, shownFrame());
    EXPECT_EQ(0, record().CurrentFrame());
}

TEST_F(Navigation, SteppingWrapsAtBothEnds) {
    standAt(0);
    ASSERT_EQ(CQuarnCommand::success, run(L"ViewPreviousFrame"));
    EXPECT_EQ(29, shownFrame());
    ASSERT_EQ(CQuarnCommand::success, run(L"ViewNextFrame"));
    EXPECT_EQ(0, shownFrame());
}

TEST_F(Navigation, EachStepGoesOnFromTheFrameShownLast) {
    standAt(3);
    ASSERT_EQ(CQuarnCommand::success, run(L"ViewNextFrame"));
    EXPECT_EQ(4, shownFrame());
    ASSERT_EQ(CQuarnCommand::success, run(L"ViewNextFrame"));
    EXPECT_EQ(5, shownFrame());
    ASSERT_EQ(CQuarnCommand::success, run(L"ViewPreviousFrame"));
    EXPECT_EQ(4, shownFrame());
}

TEST_F(Navigation, FrameOutOfRangeIsSteppedFromAsItIs) {
    standAt(30);
    ASSERT_EQ(CQuarnCommand::success, run(L"ViewNextFrame"));
    EXPECT_EQ(31, record().CurrentFrame());
    ASSERT_EQ(CQuarnCommand::success, run(L"ViewPreviousFrame"));
    EXPECT_EQ(30, record().CurrentFrame());
    ASSERT_EQ(CQuarnCommand::success, run(L"ViewPreviousFrame"));
    EXPECT_EQ(29, shownFrame());
}

TEST_F(Navigation, StepFromANegativeFrameShowsAll) {
    standAt(-5);
    const KM_3dPoint before = view(L"Perspective").MainViewport().VP().CameraLocation();
    ASSERT_EQ(CQuarnCommand::success, run(L"ViewPreviousFrame"));
    EXPECT_TRUE(near(view(L"Perspective").MainViewport().VP().CameraLocation(), before, 0.0));
    EXPECT_EQ(29, record().CurrentFrame());
}

TEST_F(Navigation, SteppingBeyondTheLargestAndTheSmallestNumberGoesNoFurther) {
    constexpr int largest = std::numeric_limits<int>::max();
    standAt(largest);
    const KM_3dPoint before = view(L"Perspective").MainViewport().VP().CameraLocation();
    ASSERT_EQ(CQuarnCommand::success, run(L"ViewNextFrame"));
    EXPECT_EQ(largest, record().CurrentFrame());
    ASSERT_EQ(CQuarnCommand::success, run(L"ViewPreviousFrame"));
    EXPECT_EQ(largest - 1, record().CurrentFrame());
    EXPECT_TRUE(near(view(L"Perspective").MainViewport().VP().CameraLocation(), before, 0.0));

    // A negative frame is the whole animation.
    standAt(std::numeric_limits<int>::min());
    ASSERT_EQ(CQuarnCommand::success, run(L"ViewPreviousFrame"));
    EXPECT_EQ(29, record().CurrentFrame());
}

TEST_F(Navigation, AStoredFrameOutOfRangeIsNoAnswer) {
    for (const int stored :
         {30, -1, std::numeric_limits<int>::max(), std::numeric_limits<int>::min()}) {
        standAt(stored);
        EXPECT_EQ(CQuarnCommand::cancel, run(L"ViewFrameNumber _Enter")) << stored;
        EXPECT_EQ(stored, record().CurrentFrame());
        EXPECT_EQ(CQuarnCommand::success, run(L"ViewFrameNumber 7")) << stored;
        EXPECT_EQ(7, shownFrame());
    }
}

TEST_F(Navigation, ARecordWhoseCountIsNotThatOfItsListsHasNoFrames) {
    for (const int count : {29, 31, 0, -30, std::numeric_limits<int>::max()}) {
        standAt(3);
        record().SetFrameCount(count);
        for (const wchar_t* command : {L"PlayAnimation", L"ViewFirstFrame", L"ViewLastFrame",
                                       L"ViewPreviousFrame", L"ViewNextFrame", L"ViewFrameNumber"})
            EXPECT_EQ(CQuarnCommand::failure, run(command)) << count;
        EXPECT_EQ(3, record().CurrentFrame());
    }
    EXPECT_TRUE(front_end.questions().empty());
}

TEST_F(Navigation, WithoutItsViewNoCommandShowsAFrame) {
    standAt(3);
    record().SetViewportName(L"Back");
    for (const wchar_t* command : {L"PlayAnimation", L"ViewFirstFrame", L"ViewLastFrame",
                                   L"ViewPreviousFrame", L"ViewNextFrame", L"ViewFrameNumber 4"}) {
        front_end.clearPrinted();
        EXPECT_EQ(CQuarnCommand::failure, run(command));
        EXPECT_THAT(printed(), HasSubstr(L"Unable to find viewport to play animation\n"));
        EXPECT_EQ(3, record().CurrentFrame());
    }
}

TEST_F(Navigation, PlayingReturnsTheViewAndStoresTheLastFrame) {
    standAt(3);
    const KM_3dPoint before = view(L"Perspective").MainViewport().VP().CameraLocation();
    ASSERT_EQ(CQuarnCommand::success, run(L"PlayAnimation"));
    EXPECT_TRUE(near(view(L"Perspective").MainViewport().VP().CameraLocation(), before, 0.0));
    EXPECT_EQ(29, record().CurrentFrame());
}

TEST_F(Navigation, FrameNumberIsAskedBetweenTheFirstAndTheLast) {
    standAt(3);
    ASSERT_EQ(CQuarnCommand::success, run(L"ViewFrameNumber 29"));
    EXPECT_EQ(29, shownFrame());
    ASSERT_EQ(CQuarnCommand::success, run(L"ViewFrameNumber 0"));
    EXPECT_EQ(0, shownFrame());
    answer({L"_Enter"});
    ASSERT_EQ(CQuarnCommand::success, run(L"ViewFrameNumber"));
    EXPECT_EQ(0, shownFrame());
    EXPECT_EQ(L"Frame to go to", front_end.questions().back().prompt.View());
    EXPECT_EQ(L"0", front_end.questions().back().default_answer->View());
}

TEST_F(Navigation, BadFrameNumbersAreRefused) {
    standAt(3);
    for (const wchar_t* number : {L"30", L"-1", L"five", L"_Cancel"}) {
        front_end.clearPrinted();
        EXPECT_EQ(CQuarnCommand::cancel, run(KM_wString(L"ViewFrameNumber ") + number));
        EXPECT_THAT(printed(), HasSubstr(L"Invalid number of frames. Nothing done\n"));
        EXPECT_EQ(3, record().CurrentFrame());
    }
}

TEST_F(Navigation, OneFrameLeavesOneNumber) {
    setUpCameraFrames(1);
    EXPECT_EQ(CQuarnCommand::success, run(L"ViewFrameNumber 0"));
    EXPECT_EQ(CQuarnCommand::cancel, run(L"ViewFrameNumber 1"));
    EXPECT_EQ(CQuarnCommand::cancel, run(L"ViewFrameNumber -1"));
    EXPECT_EQ(0, record().CurrentFrame());
}

TEST_F(Navigation, FailedShowingStoresNothing) {
    standAt(3);
    record().SetViewportName(L"Back");
    record().SetFileExtension(L".jpg");
    EXPECT_EQ(CQuarnCommand::failure, run(L"ViewNextFrame"));
    EXPECT_THAT(printed(), HasSubstr(L"Unable to find viewport to play animation\n"));
    EXPECT_EQ(3, record().CurrentFrame());
    EXPECT_EQ(L".jpg", record().FileExtension().View());
}
