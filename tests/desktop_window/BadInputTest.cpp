#include "tests/desktop_window/HouseDesk.h"
#include "tests/quarn/Pictures.h"

#include <gtest/gtest.h>

namespace quarn::test {

namespace {

class BadInput : public testing::Test {
protected:
    /// The window's own button; what is asked then is answered, and the program ends.
    void closeProgram(const QStringList& answers) {
        desk.closeWindow("mainWindow");
        for (const QString& answer : answers)
            desk.click(answer);
        const Ended ended = desk.waitForEnd();
        EXPECT_EQ(ended.exit_code, 0) << ended.killed_by << ended.err;
    }

    void play() {
        desk.click("play");
        desk.lookUntil("frame 3", [](const Windows& seen) {
            return seen.isCommandRunning() && seen.widget("frameNumber")->value >= 3;
        });
    }

    void startRecording() {
        desk.click("record");
        desk.click("promptOk");
        desk.lookUntil("a frame written", [this](const Windows&) {
            return std::filesystem::exists(desk.documents() / "Animation" / "Animation002.jpg");
        });
    }

    /// The program still does what it is for.
    void expectAlive() {
        desk.waitUntilIdle();
        desk.chooseInMenu("command_List");
        desk.waitForOutput("_List");
        desk.waitUntilIdle();
    }

    HouseDesk desk;
};

TEST_F(BadInput, ClosingADialogByItsWindowsButtonChangesNothing) {
    desk.startWithHouse();
    desk.chooseInMenu("command_SetTurntableAnimation");
    desk.closeWindow("turntableForm");
    const Windows seen = desk.waitUntilIdle();
    EXPECT_FALSE(seen.widget("play")->is_enabled);
    expectAlive();
}

TEST_F(BadInput, NoOtherCommandStartsWhileAQuestionWaits) {
    desk.startWithHouse();
    desk.chooseInMenu("command_Line");
    const Windows asked = desk.lookUntil(
        "a question", [](const Windows& seen) { return seen.widget("prompt") != nullptr; });
    for (const SeenItem& action : asked.actions) {
        const bool is_command = action.name.startsWith("command_");
        EXPECT_FALSE(is_command && action.is_enabled) << action.name.toStdString();
    }
    desk.escape();
    expectAlive();
}

TEST_F(BadInput, WindowIsClosedWhileTheAnimationPlays) {
    desk.startWithHouse();
    desk.setUpTurntable();
    play();
    closeProgram({"stopAndClose", "discardChanges"});
}

TEST_F(BadInput, PlayingGoesOnWhereThePersonDoesNotWantToCloseAfterAll) {
    desk.startWithHouse();
    desk.setUpTurntable();
    play();
    desk.closeWindow("mainWindow");
    desk.click("letGoOn");
    desk.waitUntilIdle();
    EXPECT_EQ(desk.widget("frameNumber").value, 99);
}

TEST_F(BadInput, WindowIsClosedWhileTheAnimationIsRecorded) {
    desk.startWithHouse();
    desk.setUpTurntable();
    startRecording();
    closeProgram({"stopAndClose", "discardChanges"});
    EXPECT_TRUE(std::filesystem::exists(desk.documents() / "Animation" / "Animation.html"));
}

TEST_F(BadInput, WindowIsClosedWhileAQuestionWaits) {
    desk.startWithHouse();
    desk.chooseInMenu("command_Line");
    desk.widget("prompt");
    closeProgram({});
}

TEST_F(BadInput, WindowBehindADialogCannotBeClosed) {
    desk.startWithHouse();
    desk.chooseInMenu("command_SetTurntableAnimation");
    desk.widget("turntableForm");
    desk.closeWindow("mainWindow");
    desk.click("cancel");
    expectAlive();
}

/// The plug-in shows the frames that are left without pauses.
TEST_F(BadInput, StoppingAnAnimationThatPlaysLeavesAUsableWindow) {
    desk.startWithHouse();
    desk.setUpTurntable();
    play();
    desk.click("play");
    desk.waitUntilIdle();
    play();
    desk.escape();
    expectAlive();
}

TEST_F(BadInput, FileThatIsNoModelIsToldAndTheWindowStays) {
    writeFile(desk.documents() / "noise.obj", std::string("\x7f\0\x13v 1 nan\nf 9 9 9\n", 19));
    writeFile(desk.documents() / "noise.quarn", std::string(4000, '\xff'));
    for (const char* const name : {"noise.obj", "noise.quarn", "missing.glb"}) {
        desk.start({.arguments = {QString::fromStdString(desk.documents() / name)}});
        desk.waitForOutput(name);
        expectAlive();
    }
}

TEST_F(BadInput, RecentFileThatIsGoneIsTakenFromTheList) {
    desk.start();
    desk.openHouse();
    std::filesystem::remove(desk.documents() / "house.obj");
    desk.chooseInMenu("recentFile1");
    const Windows seen = desk.lookUntil(
        "an empty list", [](const Windows& now) { return !now.action("recentFile1"); });
    EXPECT_FALSE(seen.isCommandRunning());
    expectAlive();
}

TEST_F(BadInput, DiskThatIsFullEndsARecordingWithWholeFiles) {
    // A frame has more bytes, the page and the settings have fewer.
    desk.startWithHouse({.largest_file = 6000});
    desk.setUpTurntable();
    desk.click("record");
    desk.click("promptOk");
    desk.waitForOutput("Animation");
    desk.giveUp([this](const Windows& seen) { desk.cancel(seen); });
    desk.waitForOutput("the file would be larger than is allowed here");
    for (const std::string& name : filesIn(desk.documents() / "Animation"))
        EXPECT_TRUE(name == "Animation.html" || name == "Animation.recording")
            << name << " is a picture that is not whole";
    expectAlive();
}

TEST_F(BadInput, WindowOfAnySizeGoesOn) {
    desk.startWithHouse();
    const unsigned window = desk.widget("mainWindow").window_id;
    for (const QSize size_px : {QSize(1, 1), QSize(4000, 3000), QSize(1280, 860)}) {
        desk.display().resize(window, size_px);
        desk.stillPicture();
        desk.look();
    }
    desk.setUpTurntable();
    expectAlive();
}

/// Of an old laptop.
TEST_F(BadInput, SmallScreenHasRoomForTheWindowAndItsDialogs) {
    const QRect screen(0, 0, 1024, 768);
    desk.startWithHouse({.screen_px = screen.size()});
    const auto expectOnScreen = [&](const char* name) {
        const QRect place = desk.widget(name).place;
        EXPECT_TRUE(screen.contains(place)) << name << ": " << place.x() << ',' << place.y() << ' '
                                            << place.width() << " x " << place.height();
    };
    expectOnScreen("mainWindow");
    desk.chooseInMenu("command_SetOneDaySunAnimation");
    expectOnScreen("dayForm");
    desk.click("choosePlace");
    expectOnScreen("location");
    desk.click("cancel");
    desk.waitUntilGone("location");
    desk.click("cancel");
    desk.waitUntilIdle();
}

TEST_F(BadInput, LanguagesWithOtherScriptsSetUpATurntable) {
    for (const char* const language : {"ja", "zh"}) {
        desk.start({.arguments = {"--language", language,
                                  QString::fromStdString(desk.documents() / "house.obj")}});
        desk.waitForOutput("house.obj");
        desk.setUpTurntable();
        EXPECT_NE(desk.widget("record").text, "Record…") << language;
    }
}

} // namespace

} // namespace quarn::test
