#include "desktop/animation/AnimationBar.h"

#include "desktop/animation/ProgressRow.h"
#include "host/session/ViewFrame.h"
#include "sdk/qncore/QnView.h"
#include "tests/desktop/WindowParts.h"

#include <QAction>

#include <gmock/gmock.h>

namespace quarn::desktop::test {
namespace {

class AnimationBarTest : public WindowPartsTest {
protected:
    AnimationBarTest() {
        usePart([this](FrontEndParts& used) {
            used.frame_written = [this](const std::filesystem::path& file, int written, int total) {
                bar.frameWritten(file, written, total);
                frames_written = written;
                progress = part<QLabel>(bar, "progressText").text();
                if (written == stop_at)
                    click(part<QPushButton>(bar, "progressCancel"));
            };
            used.view_shown = [this](CQuarnView& view, const ShownPicture&) {
                bar.viewShown(view);
                shown_numbers.append(number().value());
            };
        });
        bar.resize(900, 40);
        bar.show();
    }

    void setUp(int frames) {
        setUpTurntable(frames);
        bar.refresh();
    }
    QToolButton& button(const QString& name) { return part<QToolButton>(bar, name); }
    QSlider& slider() { return part<QSlider>(bar, "frameSlider"); }
    QSpinBox& number() { return part<QSpinBox>(bar, "frameNumber"); }
    /// Works on events until nothing more is due.
    void settle() {
        for (int i = 0; i < 20; ++i)
            QApplication::processEvents();
    }

    AnimationBar bar{session, starter};
    int frames_written = 0;
    int stop_at = 0;
    QString progress;
    QList<int> shown_numbers;
};

TEST_F(AnimationBarTest, IsDisabledAsLongAsThereIsNoAnimation) {
    for (const char* name :
         {"firstFrame", "previousFrame", "play", "nextFrame", "lastFrame", "record"})
        EXPECT_FALSE(button(name).isEnabled()) << name;
    EXPECT_FALSE(slider().isEnabled());
    EXPECT_FALSE(number().isEnabled());
    setUp(3);
    for (const char* name :
         {"firstFrame", "previousFrame", "play", "nextFrame", "lastFrame", "record"})
        EXPECT_TRUE(button(name).isEnabled()) << name;
    EXPECT_TRUE(slider().isEnabled());
    EXPECT_EQ(number().suffix(), " / 2");
}

TEST_F(AnimationBarTest, ButtonsStepThroughTheFrames) {
    setUp(5);
    click(button("lastFrame"));
    EXPECT_EQ(record().CurrentFrame(), 4);
    EXPECT_EQ(slider().value(), 4);
    click(button("nextFrame")); // wraps to the first
    EXPECT_EQ(record().CurrentFrame(), 0);
    click(button("nextFrame"));
    EXPECT_EQ(number().value(), 1);
    click(button("previousFrame"));
    click(button("previousFrame"));
    EXPECT_EQ(record().CurrentFrame(), 4);
    click(button("firstFrame"));
    EXPECT_EQ(record().CurrentFrame(), 0);
    EXPECT_EQ(started,
              (QStringList{"_ViewLastFrame", "_ViewNextFrame", "_ViewNextFrame",
                           "_ViewPreviousFrame", "_ViewPreviousFrame", "_ViewFirstFrame"}));
}

TEST_F(AnimationBarTest, OnlyTheNewestFrameOfADragIsShown) {
    setUp(100);
    for (int frame : {10, 20, 30, 40})
        slider().setValue(frame);
    settle();
    EXPECT_EQ(started, QStringList{"_ViewFrameNumber 40"});
    EXPECT_EQ(record().CurrentFrame(), 40);
    EXPECT_FALSE(bar.isStepping());
}

TEST_F(AnimationBarTest, FramesThatAreAskedForWhileOneIsDrawnAreNotQueued) {
    setUp(100);
    int moves = 0;
    const auto move = [&](const QString&) {
        // From within the running command, as a mouse that goes on moving does.
        if (++moves == 1) {
            for (int frame = 51; frame <= 60; ++frame)
                later([this, frame] { slider().setValue(frame); });
        }
    };
    QObject::connect(&starter, &CommandStarter::started, &bar, move);
    slider().setValue(50);
    settle();
    EXPECT_EQ(started, (QStringList{"_ViewFrameNumber 50", "_ViewFrameNumber 60"}));
    EXPECT_EQ(record().CurrentFrame(), 60);
}

TEST_F(AnimationBarTest, ATypedNumberShowsItsFrame) {
    setUp(20);
    number().setFocus();
    number().selectAll();
    QTest::keyClicks(&number(), "12");
    QTest::keyClick(&number(), Qt::Key_Return);
    settle();
    EXPECT_EQ(record().CurrentFrame(), 12);
    EXPECT_EQ(slider().value(), 12);
}

TEST_F(AnimationBarTest, PlayingRunsTheNumberAlongAndPutsTheCameraBack) {
    setUp(4);
    CQuarnViewport& viewport = activeView(session.document()).MainViewport();
    const KM_3dPoint before = viewport.VP().CameraLocation();
    click(button("play"));
    EXPECT_THAT(shown_numbers, testing::IsSupersetOf({0, 1, 2, 3}));
    EXPECT_EQ(viewport.VP().CameraLocation(), before);
}

TEST_F(AnimationBarTest, ThePlayButtonStopsAPlayAtOnceAndTheCameraIsPutBack) {
    setUp(1000);
    CQuarnViewport& viewport = activeView(session.document()).MainViewport();
    const KM_3dPoint before = viewport.VP().CameraLocation();
    QElapsedTimer since_stop;
    QTimer::singleShot(100, [&] {
        EXPECT_EQ(button("play").toolTip(), "Stop");
        since_stop.start();
        click(button("play"));
    });
    click(button("play"));
    // A thousand frames would wait for at least ten seconds.
    EXPECT_LT(since_stop.elapsed(), 5000);
    EXPECT_EQ(viewport.VP().CameraLocation(), before);
    EXPECT_EQ(button("play").toolTip(), "Play");
    EXPECT_TRUE(button("play").isEnabled());
}

TEST_F(AnimationBarTest, ARecordingShowsHowFarItIsAndCanOpenItsPage) {
    setUp(3);
    KM_3dmAnimationProperties changed = record();
    changed.SetFolderName(wideText(qtText(folder / "out")));
    session.document().Properties().SetAnimationProperties(changed);
    usePart([](FrontEndParts& used) {
        used.ask = [](const Question&) { return Answer{Answer::Kind::enter, {}}; };
    });
    bar.refresh();
    EXPECT_FALSE(bar.openPageAction().isEnabled());
    click(button("record"));
    EXPECT_EQ(started, QStringList{"_RecordAnimation"});
    EXPECT_EQ(last_result, CQuarnCommand::success) << printed.toStdString();
    EXPECT_EQ(frames_written, 3);
    EXPECT_EQ(progress, "Frame 3 of 3");
    EXPECT_TRUE(std::filesystem::exists(folder / "out" / "Turn002.jpg"));
    EXPECT_TRUE(bar.openPageAction().isEnabled());
    EXPECT_TRUE(part<QToolButton>(bar, "openPageButton").isVisible());
    EXPECT_FALSE(part<QProgressBar>(bar, "progressBar").isVisible());
}

TEST_F(AnimationBarTest, CancelEndsARecordingAndKeepsWhatWasWritten) {
    setUp(50);
    KM_3dmAnimationProperties changed = record();
    changed.SetFolderName(wideText(qtText(folder / "out")));
    session.document().Properties().SetAnimationProperties(changed);
    usePart([](FrontEndParts& used) {
        used.ask = [](const Question&) { return Answer{Answer::Kind::enter, {}}; };
    });
    stop_at = 4;
    bar.record();
    EXPECT_EQ(frames_written, 4);
    EXPECT_TRUE(std::filesystem::exists(folder / "out" / "Turn003.jpg"));
    EXPECT_FALSE(std::filesystem::exists(folder / "out" / "Turn004.jpg"));
    EXPECT_FALSE(starter.isRunning());
}

TEST_F(AnimationBarTest, SunStudiesShowTheDateOfTheirFrame) {
    run("_SetOneDaySunAnimation 51 0 0 21 6 2026 6 0 8 0 30 _jpg _RenderedViewport Perspective "
        "_Enter");
    run("_ViewportSize 16 16");
    bar.refresh();
    click(button("firstFrame"));
    const QString first = part<QLabel>(bar, "frameDate").text();
    EXPECT_EQ(first, qtText(record().Dates()[0]));
    EXPECT_FALSE(first.isEmpty());
    click(button("nextFrame"));
    EXPECT_NE(part<QLabel>(bar, "frameDate").text(), first);
}

TEST_F(AnimationBarTest, ADateIsShownAsItIsStoredAndNotAsAPage) {
    run("_SetOneDaySunAnimation 51 0 0 21 6 2026 6 0 8 0 30 _jpg _RenderedViewport Perspective "
        "_Enter");
    KM_3dmAnimationProperties changed = record();
    changed.Dates()[0] = L"<b>Noon</b>";
    session.document().Properties().SetAnimationProperties(changed);
    run("_ViewportSize 16 16");
    bar.refresh();
    click(button("firstFrame"));
    EXPECT_EQ(part<QLabel>(bar, "frameDate").text(), "<b>Noon</b>");
    EXPECT_EQ(part<QLabel>(bar, "frameDate").textFormat(), Qt::PlainText);
}

TEST(RecordingPaceTest, TellsTheTimeThatIsLeft) {
    using std::chrono::seconds;
    const RecordingPace::Clock::time_point begin{};
    RecordingPace pace;
    pace.begin(begin);
    pace.noteFrame(30, 120, begin + seconds(10)); // 3 a second, 90 to come
    EXPECT_EQ(pace.text(), "Frame 30 of 120, about 30 s left");
    EXPECT_DOUBLE_EQ(pace.share(), 0.25);
    pace.noteFrame(40, 120, begin + seconds(100)); // 2.5 s each, 80 to come: 200 s
    EXPECT_EQ(pace.text(), "Frame 40 of 120, about 4 min left");
    pace.noteFrame(120, 120, begin + seconds(120));
    EXPECT_EQ(pace.text(), "Frame 120 of 120");
    EXPECT_DOUBLE_EQ(pace.share(), 1.0);
}

TEST(RecordingPaceTest, CountsTheRenderedPartOfAPicture) {
    using std::chrono::seconds;
    const RecordingPace::Clock::time_point begin{};
    RecordingPace pace;
    pace.begin(begin);
    pace.noteFrame(1, 4, begin + seconds(10));
    pace.noteShare(0.5, begin + seconds(15));
    EXPECT_DOUBLE_EQ(pace.share(), 0.375);
    EXPECT_EQ(pace.text(), "Frame 1 of 4, about 25 s left"); // 15 s for 1.5 pictures, 2.5 to come
}

} // namespace
} // namespace quarn::desktop::test
