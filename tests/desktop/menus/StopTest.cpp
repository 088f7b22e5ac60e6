#include "desktop/menus/CommandMenus.h"
#include "tests/desktop/window/WindowFixture.h"

namespace quarn::desktop::test {
namespace {

class StopTest : public WindowTest {};

TEST_F(StopTest, EndsACommandThatAsksWithAllItsQuestions) {
    int questions = 0;
    QObject::connect(&window.starter(), &CommandStarter::started, &window, [&](const QString&) {
        later([&] {
            ASSERT_TRUE(window.commandPane().isAsking());
            ++questions;
            window.menus().stopAction().trigger();
        });
    });
    run("_Circle");
    EXPECT_EQ(questions, 1);
    EXPECT_FALSE(window.commandPane().isAsking());
    EXPECT_FALSE(window.starter().isRunning());
}

} // namespace
} // namespace quarn::desktop::test
