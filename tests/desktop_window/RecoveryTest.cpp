#include "tests/desktop_window/HouseDesk.h"

#include <chrono>
#include <csignal>
#include <filesystem>
#include <gtest/gtest.h>
#include <thread>

namespace quarn::test {

namespace {

class Recovery : public testing::Test {
protected:
    /// A turntable of the house is set up, saved under no name, and kept.
    void leaveUnsavedWork(int signal) {
        desk.startWithHouse({.arguments = {"--recovery-every", "0.1"}});
        desk.setUpTurntable();
        desk.lookUntil("work that is kept", [this](const Windows&) { return isKept(); });
        std::this_thread::sleep_for(std::chrono::milliseconds(500)); // its last bytes, on a beat
        desk.sendSignal(signal);
        desk.waitForEnd();
    }
    /// Whether a mark leads to a copy; it is written before the copy is whole.
    bool isKept() const {
        const std::filesystem::path kept = desk.home() / ".state" / "quarn" / "recovery";
        if (!std::filesystem::is_directory(kept))
            return false;
        for (const auto& entry : std::filesystem::directory_iterator(kept))
            if (entry.path().extension() == ".mark")
                return true;
        return false;
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
