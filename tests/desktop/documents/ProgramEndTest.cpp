#include "desktop/documents/ProgramEnd.h"
#include "desktop/documents/UnsavedChanges.h"
#include "host/session/DocumentState.h"
#include "tests/desktop/window/WindowFixture.h"

#include <QDir>
#include <QSignalSpy>

namespace quarn::desktop::test {
namespace {

class ProgramEndTest : public WindowTest {
protected:
    /// Does something in the application's event loop, and ends the program shortly afterwards.
    /// @return whether the loop returned by itself
    bool endDuring(std::function<void()> work) {
        later(std::move(work));
        QTimer::singleShot(120, &window, [this] { window.programEnd().end(UnsavedWork::kept); });
        QTimer late;
        late.callOnTimeout([] { QCoreApplication::exit(1); });
        late.start(20000);
        return QApplication::exec() == 0;
    }
};

/// What the window is at when the program is to end.
struct Work {
    const char* name;
    const char* line;
};

class EndDuring : public ProgramEndTest, public testing::WithParamInterface<Work> {};

TEST_P(EndDuring, WhateverIsGoingOnIsGivenUpAndChangesNothing) {
    readSlab();
    setUpTurntable(5000);
    run("_-SaveAs \"" + qtText(folder / "slab.quarn") + '"');
    QSignalSpy ended(&window.starter(), &CommandStarter::ended);
    bool was_running = false;
    QTimer::singleShot(80, &window, [&] { was_running = window.starter().isRunning(); });
    EXPECT_TRUE(endDuring([this] { run(GetParam().line); }));
    EXPECT_TRUE(was_running);
    EXPECT_EQ(ended.size(), 1);
    EXPECT_FALSE(isModified(session.document()));
    EXPECT_EQ(QApplication::activeModalWidget(), nullptr);
    EXPECT_EQ(window.programEnd().unsavedWork(), UnsavedWork::kept);
}

INSTANTIATE_TEST_SUITE_P(ProgramEnd, EndDuring,
                         testing::Values(Work{"AQuestion", "_Circle"}, Work{"AForm", "_Camera"},
                                         Work{"AFileChooser", "_Open"},
                                         Work{"APlay", "_-PlayAnimation"},
                                         Work{"ARendering", "_-Render"}),
                         [](const auto& work) { return std::string(work.param.name); });

TEST_F(ProgramEndTest, FramesThatWereRecordedStayAndThePageShowsThem) {
    readSlab();
    setUpTurntable(5000);
    std::filesystem::create_directory(folder / "frames");
    EXPECT_TRUE(endDuring([this] {
        run("_-RecordAnimation _TargetFolder \"" + qtText(folder / "frames") + "\" _Enter");
    }));
    const QStringList frames = QDir(qtText(folder / "frames")).entryList({"*.jpg"});
    EXPECT_GT(frames.size(), 2) << printed().toStdString();
    EXPECT_LT(frames.size(), 5000);
    EXPECT_EQ(QDir(qtText(folder / "frames")).entryList({"*.html"}).size(), 1);
}

TEST_F(ProgramEndTest, TheQuestionAboutUnsavedChangesIsGivenUpAndTheyStay) {
    run("_-Point 1,2,3");
    EXPECT_TRUE(endDuring([this] { window.close(); }));
    EXPECT_TRUE(isModified(session.document()));
    EXPECT_TRUE(window.isVisible());
}

TEST_F(ProgramEndTest, NothingIsStartedAfterwards) {
    EXPECT_TRUE(endDuring([] {}));
    run("_-Point 1,2,3");
    EXPECT_EQ(objectCount(session.document()), 0);
}

} // namespace
} // namespace quarn::desktop::test
