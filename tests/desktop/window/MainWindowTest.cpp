#include "desktop/animation/AnimationBar.h"
#include "desktop/menus/CommandMenus.h"
#include "tests/desktop/window/WindowFixture.h"

#include <QFileInfo>
#include <QSignalSpy>

namespace quarn::desktop::test {
namespace {

using MainWindowTest = WindowTest;

/// Does something while the animation plays: when the second picture of it is shown.
class DuringPlay final : public QObject {
public:
    DuringPlay(CommandStarter& starter, std::function<void()> work) : m_work(std::move(work)) {
        connect(&starter, &CommandStarter::started, this, [this](const QString& line) {
            if (line.contains("PlayAnimation"))
                QTimer::singleShot(30, this, m_work);
        });
    }

private:
    std::function<void()> m_work;
};

TEST_F(MainWindowTest, TitleNamesTheDocumentAndMarksChanges) {
    EXPECT_TRUE(window.windowTitle().startsWith("New document"));
    EXPECT_FALSE(window.isWindowModified());
    readSlab();
    run("_-SaveAs \"" + qtText(folder / "slab.quarn") + '"');
    EXPECT_TRUE(window.windowTitle().startsWith("slab.quarn"))
        << window.windowTitle().toStdString();
    EXPECT_FALSE(window.isWindowModified());
    run("_-Point 1,2,3");
    EXPECT_TRUE(window.isWindowModified());
}

TEST_F(MainWindowTest, TitleShowsTheMarkOfChangesOfANameAsItIs) {
    run("_-SaveAs \"" + qtText(folder / "slab[*].quarn") + '"');
    run("_-Point 1,2,3");
    EXPECT_TRUE(window.windowTitle().startsWith("slab[*][*].quarn[*]"))
        << window.windowTitle().toStdString();
}

TEST_F(MainWindowTest, TypedCommandIsRunAndItsWordsStandInTheOutput) {
    QTest::keyClicks(&window.commandPane().line(), "List");
    QTest::keyClick(&window.commandPane().line(), Qt::Key_Return);
    EXPECT_TRUE(printed().contains("List")) << printed().toStdString();
}

TEST_F(MainWindowTest, SecondCommandIsRefusedWhileOneRunsAndThePersonIsTold) {
    readSlab();
    setUpTurntable(60);
    QSignalSpy refused(&window.starter(), &CommandStarter::refused);
    DuringPlay second(window.starter(), [&] {
        EXPECT_TRUE(window.starter().isRunning());
        run("_-Point 1,2,3");
    });
    run("_-PlayAnimation");
    ASSERT_EQ(refused.size(), 1);
    EXPECT_TRUE(refused[0][0].toString().contains("PlayAnimation"));
    EXPECT_TRUE(printed().contains("still running")) << printed().toStdString();
}

TEST_F(MainWindowTest, StopEndsWhatPlaysAndTheNextCommandIsNotStopped) {
    readSlab();
    setUpTurntable(2000);
    bool was_stopped = false;
    DuringPlay stop(window.starter(), [&] {
        was_stopped = window.starter().isRunning();
        window.starter().stop();
    });
    QElapsedTimer clock;
    clock.start();
    run("_-PlayAnimation");
    EXPECT_TRUE(was_stopped);
    EXPECT_LT(clock.elapsed(), 20000) << "2000 frames would take longer";
    EXPECT_FALSE(front_end.isInterrupted());
}

TEST_F(MainWindowTest, ViewThatIsClosedWhileItPlaysStaysUntilTheCommandHasEnded) {
    readSlab();
    setUpTurntable(60);
    bool was_there = false;
    DuringPlay close(window.starter(), [&] {
        session.closeView(L"Perspective");
        was_there = findView(session.document(), "Perspective") != nullptr;
    });
    run("_-PlayAnimation");
    EXPECT_TRUE(was_there);
    EXPECT_EQ(findView(session.document(), "Perspective"), nullptr);
    EXPECT_EQ(window.views().widget("Perspective"), nullptr);
    EXPECT_EQ(window.views().widgets().size(), 3);
}

TEST_F(MainWindowTest, WindowRepaintsWhileItPlays) {
    readSlab();
    setUpTurntable(6);
    int turns = 0;
    QTimer ticking;
    QObject::connect(&ticking, &QTimer::timeout, [&] { ++turns; });
    ticking.start(5);
    run("_-PlayAnimation");
    EXPECT_GT(turns, 3) << "the event loop was not worked on";
}

TEST_F(MainWindowTest, ResizeWhileItPlaysTakesEffectAfterwards) {
    readSlab();
    setUpTurntable(60);
    QSize frame_meanwhile;
    const QSize frame_before = view("Perspective").size();
    DuringPlay resize(window.starter(), [&] {
        window.resize(1100, 820);
        settle();
        auto& pipeline = *hostView("Perspective").MainViewport().DisplayPipeline();
        frame_meanwhile = {pipeline.FrameWidth(), pipeline.FrameHeight()};
    });
    run("_-PlayAnimation");
    settle();
    EXPECT_EQ(frame_meanwhile, frame_before);
    EXPECT_NE(view("Perspective").size(), frame_before);
    EXPECT_EQ(view("Perspective").picture().size(), view("Perspective").size());
}

TEST_F(MainWindowTest, ScriptRunsInTheWindowAsOneCommand) {
    quarn::test::writeFile(folder / "steps.txt", "_Point 1,2,3\n_Point 4,5,6\n");
    QSignalSpy ended(&window.starter(), &CommandStarter::ended);
    window.runScript(qtText(folder / "steps.txt"), false);
    EXPECT_EQ(ended.size(), 1);
    EXPECT_NE(session.document().FindObjectByName(L"Point"), nullptr);
}

TEST_F(MainWindowTest, SizeAndBordersComeBackInTheNextRun) {
    window.resize(777, 666);
    window.close();
    MainWindow next(session, front_end);
    next.restoreLayout();
    EXPECT_EQ(next.size(), QSize(777, 666));
}

TEST_F(MainWindowTest, ExitClosesTheWindow) {
    run("_-Exit");
    settle();
    EXPECT_FALSE(window.isVisible());
}

TEST_F(MainWindowTest, MainWindowIsTheOneOfTheFrontEnd) {
    EXPECT_EQ(reinterpret_cast<QWidget*>(front_end.mainWindow()), &window);
}

} // namespace
} // namespace quarn::desktop::test
