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
    /// Does something in the application's event loop, and ends the program shortly afterwards, as
    /// soon as the work is far enough.
    /// @return whether the loop returned by itself
    bool endDuring(
        std::function<void()> work, std::function<bool()> is_far_enough = [] { return true; }) {
        later(std::move(work));
        QTimer look;
        look.callOnTimeout([&] {
            if (!is_far_enough())
                return;
            look.stop();
            window.programEnd().end(UnsavedWork::kept);
        });
        look.start(120);
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
    const auto frames = [this] {
        return QDir(qtText(folder / "frames")).entryList({"*.jpg"}).size();
    };
    EXPECT_TRUE(endDuring(
        [this] {
            run("_-RecordAnimation _TargetFolder \"" + qtText(folder / "frames") + "\" _Enter");
        },
        [&] { return frames() > 2; }));
    EXPECT_GT(frames(), 2) << printed().toStdString();
    EXPECT_LT(frames(), 5000);
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
