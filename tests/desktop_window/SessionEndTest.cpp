#include "tests/desktop_window/HouseDesk.h"
#include "tests/desktop_window/driver/DesktopSession.h"

#include <gtest/gtest.h>

namespace quarn::test {

namespace {

using Answer = DesktopSession::Answer;

class SessionEnds : public testing::Test {
protected:
    /// A turntable is set up and not saved.
    void startWithChanges() {
        desk.startWithHouse({.session_manager = session.address()});
        desk.setUpTurntable();
    }
    Answer answer() {
        desk.lookUntil("an answer to the desktop",
                       [this](const Windows&) { return session.answer() != Answer::none; });
        return session.answer();
    }

    DesktopSession session;
    HouseDesk desk;
};

TEST_F(SessionEnds, UnsavedChangesAreAskedAboutAndWhoStaysHasTheSessionGoOn) {
    startWithChanges();
    session.prepareEnd(true);
    desk.click("keepDocument");
    EXPECT_EQ(answer(), Answer::cancelled);
    desk.waitUntilIdle();

    session.prepareEnd(true);
    desk.click("discardChanges");
    EXPECT_EQ(answer(), Answer::agreed);
    session.end();
    EXPECT_EQ(desk.waitForEnd().exit_code, 0);
}

TEST_F(SessionEnds, WhereNothingMayBeAskedUnsavedWorkIsOfferedAtTheNextStart) {
    startWithChanges();
    session.prepareEnd(false);
    EXPECT_EQ(answer(), Answer::agreed);
    EXPECT_TRUE(desk.look().modalWindows().isEmpty());
    session.end();
    EXPECT_EQ(desk.waitForEnd().exit_code, 0);
    desk.begin({});
    desk.widget("recover");
}

} // namespace

} // namespace quarn::test
