#include "desktop/recovery/RecoveryBeat.h"

#include "desktop/command_line/CommandPane.h"
#include "host/session/DocumentState.h"
#include "tests/desktop/window/WindowFixture.h"

#include <QStatusBar>

namespace quarn::desktop::test {
namespace {

using namespace std::chrono_literals;

class RecoveryBeatTest : public WindowTest {
protected:
    void keepIn(const std::filesystem::path& state_folder) {
        window.keepUnsavedWork({.state_folder = state_folder, .every = 100ms});
    }
    /// How many documents of this program are kept; only other programs offer them.
    int kept() {
        const std::filesystem::path marks = folder / "state" / "recovery";
        if (!std::filesystem::exists(marks))
            return 0;
        int count = 0;
        for (const auto& file : std::filesystem::directory_iterator(marks))
            count += file.path().extension() == ".mark";
        return count;
    }
};

TEST_F(RecoveryBeatTest, WorkIsKeptWhileNothingHappensAndNotAfterItIsSaved) {
    keepIn(folder / "state");
    run("_-Point 1,2,3");
    EXPECT_TRUE(QTest::qWaitFor([this] { return kept() == 1; }));
    run("_-SaveAs \"" + qtText(folder / "a.quarn") + '"');
    EXPECT_TRUE(QTest::qWaitFor([this] { return kept() == 0; }));
}

TEST_F(RecoveryBeatTest, WhatAPersonDidNotWantIsNotKept) {
    keepIn(folder / "state");
    run("_-Point 1,2,3");
    EXPECT_TRUE(QTest::qWaitFor([this] { return kept() == 1; }));
    window.finish();
    EXPECT_EQ(kept(), 0);
}

TEST_F(RecoveryBeatTest, TroubleIsToldOnceAndWorkGoesOn) {
    keepIn("/dev/null/state");
    run("_-Point 1,2,3");
    EXPECT_TRUE(QTest::qWaitFor([this] { return printed().contains("/dev/null"); }));
    EXPECT_TRUE(window.statusBar()->currentMessage().contains("/dev/null"));
    run("_-Point 4,5,6");
    QTest::qWait(400);
    EXPECT_EQ(printed().count("/dev/null"), 1) << printed().toStdString();
    EXPECT_EQ(objectCount(session.document()), 2);
}

} // namespace
} // namespace quarn::desktop::test
