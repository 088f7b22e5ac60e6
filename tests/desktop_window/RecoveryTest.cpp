#include "tests/desktop_window/HouseDesk.h"

#include <csignal>
#include <gtest/gtest.h>

namespace quarn::test {

namespace {

class Recovery : public testing::Test {
protected:
    /// A turntable of the house is set up, saved under no name, and kept.
    void leaveUnsavedWork(int signal) {
        desk.startWithHouse({.arguments = {"--recovery-every", "0.1"}});
        desk.setUpTurntable();
        desk.lookUntil("work that is kept", [this](const Windows&) {
            const std::filesystem::path state = desk.home() / ".state" / "quarn";
            return std::filesystem::exists(state) && !std::filesystem::is_empty(state);
        });
        desk.sendSignal(signal);
        desk.waitForEnd();
    }
    QStringList house() { return {QString::fromStdString(desk.documents() / "house.obj")}; }

    HouseDesk desk;
};

TEST_F(Recovery, UnsavedWorkOfAKilledProgramIsOfferedBeforeAFileIsOpened) {
    leaveUnsavedWork(SIGKILL);
    desk.begin({.arguments = house()});
    desk.click("later");
    desk.waitForOutput("house.obj: 2 objects");
    desk.waitUntilIdle();

    desk.begin({.arguments = house()});
    desk.click("recover");
    desk.waitForOutput("house.obj was not opened");
    desk.waitUntilIdle();
    desk.widget("play");
    desk.closeWindow("mainWindow");
    desk.click("discardChanges");
    desk.waitForEnd();

    desk.start();
}

TEST_F(Recovery, AnUnattendedRunIsToldOfUnsavedWorkWhichTheMenuOffers) {
    leaveUnsavedWork(SIGTERM);
    writeFile(desk.home() / "script.txt", "_-List\n");
    desk.start({.arguments = {"--run-script", "script.txt"}});
    desk.waitForOutput("File > Recover unsaved work");
    desk.waitForOutput("script.txt");
    desk.chooseInMenu("recoverWork");
    desk.click("discard");
    desk.click("yes");
    desk.waitUntilIdle();
    desk.chooseInMenu("recoverWork");
    EXPECT_TRUE(desk.look().modalWindows().isEmpty());
}

} // namespace

} // namespace quarn::test
