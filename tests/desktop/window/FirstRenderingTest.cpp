#include "desktop/command_line/CommandStarter.h"
#include "desktop/render/PictureSheet.h"
#include "tests/desktop/window/WindowFixture.h"

#include <QElapsedTimer>
#include <QProgressBar>

namespace quarn::desktop {
namespace {

class FirstRenderingTest : public test::WindowTest {
protected:
    FirstRenderingTest() { readSlab(); }
    QWidget* renderWindow() { return window.findChild<QWidget*>("render_window"); }
    bool isRenderWindowShown() { return renderWindow() && renderWindow()->isVisible(); }
};

TEST_F(FirstRenderingTest, ShowsItsWindowWithPictureAndProgressWhileItRuns) {
    run("_-RenderSettings _Size 1600 1200 _Samples 16384 _Enter");
    bool was_shown = false;
    bool had_progress = false;
    bool had_picture = false;
    QElapsedTimer since_start;
    since_start.start();
    QTimer look;
    QObject::connect(&look, &QTimer::timeout, [&] {
        if (isRenderWindowShown()) {
            was_shown = true;
            had_progress |= test::part<QProgressBar>(*renderWindow(), "progress").isVisible();
            had_picture |= !test::part<PictureSheet>(*renderWindow(), "picture").picture().isNull();
        }
        if (was_shown || since_start.elapsed() > 30000)
            window.starter().stop();
    });
    look.start(20);
    run("_-Render");
    look.stop();
    EXPECT_TRUE(was_shown);
    EXPECT_TRUE(had_progress);
    EXPECT_TRUE(had_picture) << "as far as it was";
    // No picture stays: the window has nothing to show.
    EXPECT_TRUE(QTest::qWaitFor([&] { return !isRenderWindowShown(); }, 5000));
}

TEST_F(FirstRenderingTest, ShortOneShowsItsPicture) {
    run("_-RenderSettings _Size 32 24 _Samples 1 _Enter");
    run("_-Render");
    EXPECT_TRUE(isRenderWindowShown());
}

} // namespace
} // namespace quarn::desktop
