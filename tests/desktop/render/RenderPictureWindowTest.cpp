#include "desktop/render/RenderPictureWindow.h"
#include "tests/desktop/dialogs/DialogDriver.h"

#include <gtest/gtest.h>

#include <QAction>
#include <QProgressBar>
#include <QSignalSpy>
#include <QTest>

#include <vector>

namespace quarn::desktop {
namespace {

using test::part;

/// A picture whose pixels tell where they stand.
struct Pixels {
    Pixels(int width, int height) : width_px(width), height_px(height) {
        for (int y = 0; y < height; ++y) {
            for (int x = 0; x < width; ++x)
                for (const int byte : {x % 251, y % 241, (x + y) % 239, 255})
                    rgba.push_back(static_cast<std::uint8_t>(byte));
        }
    }
    ShownPicture shown() const { return {width_px, height_px, rgba}; }

    int width_px;
    int height_px;
    std::vector<std::uint8_t> rgba;
};

class RenderPictureWindowTest : public testing::Test {
protected:
    QAction& action(const char* name) {
        auto* const found = m_window.findChild<QAction*>(name);
        EXPECT_NE(found, nullptr) << name;
        return *found;
    }
    QImage picture() { return part(m_window, "picture").grab().toImage(); }

    RenderPictureWindow m_window{nullptr};
    QSignalSpy m_saves{&m_window, &RenderPictureWindow::saveRequested};
    QSignalSpy m_stops{&m_window, &RenderPictureWindow::stopRequested};
    QSignalSpy m_closes{&m_window, &RenderPictureWindow::closedByPerson};
};

TEST_F(RenderPictureWindowTest, ShowsItselfWithAPictureAndClosesWithAnEmptyOneWithoutASignal) {
    EXPECT_FALSE(m_window.isVisible());
    m_window.showPicture(Pixels(40, 30).shown());
    EXPECT_TRUE(m_window.isVisible());
    m_window.showPicture({});
    EXPECT_TRUE(QTest::qWaitFor([&] { return !m_window.isVisible(); }));
    EXPECT_EQ(m_closes.count(), 0);
}

TEST_F(RenderPictureWindowTest, StaysWhileOnePictureFollowsAnother) {
    m_window.showPicture(Pixels(40, 30).shown());
    m_window.showPicture({});
    m_window.showPicture(Pixels(40, 30).shown());
    QTest::qWait(700);
    EXPECT_TRUE(m_window.isVisible());
}

TEST_F(RenderPictureWindowTest, KeepsThePixelsAfterTheCall) {
    {
        const Pixels pixels(40, 30);
        m_window.showPicture(pixels.shown());
    }
    m_window.setFitting(false);
    const QImage shown = picture();
    ASSERT_EQ(shown.size(), QSize(40, 30));
    for (const QPoint at : {QPoint(0, 0), QPoint(39, 0), QPoint(17, 29)}) {
        EXPECT_EQ(shown.pixelColor(at), QColor(at.x(), at.y(), at.x() + at.y()));
    }
}

TEST_F(RenderPictureWindowTest, FitsALargePictureIntoTheWindowAndShowsItWholeOnDemand) {
    m_window.showPicture(Pixels(1600, 400).shown());
    m_window.resize(600, 500);
    EXPECT_TRUE(action("fit").isChecked());
    EXPECT_LE(part(m_window, "picture").width(), 600);
    EXPECT_NEAR(m_window.scale(), 600.0 / 1600.0, 0.01);
    EXPECT_NEAR(part(m_window, "picture").height(), 150, 2);
    action("whole").trigger();
    EXPECT_EQ(part(m_window, "picture").size(), QSize(1600, 400));
    EXPECT_DOUBLE_EQ(m_window.scale(), 1.0);
    action("fit").trigger();
    EXPECT_LE(part(m_window, "picture").width(), 600);
}

TEST_F(RenderPictureWindowTest, NeverBlowsASmallPictureUp) {
    m_window.showPicture(Pixels(40, 30).shown());
    m_window.resize(600, 500);
    EXPECT_EQ(part(m_window, "picture").size(), QSize(40, 30));
}

TEST_F(RenderPictureWindowTest, ClosesForGoodOnlyByThePerson) {
    m_window.showPicture(Pixels(40, 30).shown());
    m_window.close();
    EXPECT_FALSE(m_window.isVisible());
    EXPECT_EQ(m_closes.count(), 1);
}

TEST_F(RenderPictureWindowTest, AsksToSave) {
    m_window.showPicture(Pixels(40, 30).shown());
    action("save").trigger();
    EXPECT_EQ(m_saves.count(), 1);
}

TEST_F(RenderPictureWindowTest, ShowsProgressAndStopsOnDemandWhileAPictureIsRendered) {
    m_window.showPicture(Pixels(40, 30).shown());
    EXPECT_FALSE(action("stop").isVisible());
    EXPECT_FALSE(part(m_window, "progress").isVisible());
    m_window.showProgress(0.25);
    EXPECT_TRUE(part(m_window, "progress").isVisible());
    EXPECT_EQ(part<QProgressBar>(m_window, "progress").text(), "25%");
    EXPECT_FALSE(action("save").isEnabled());
    action("stop").trigger();
    EXPECT_EQ(m_stops.count(), 1);
    m_window.close();
    EXPECT_TRUE(m_window.isVisible());
    EXPECT_EQ(m_stops.count(), 2);
    EXPECT_EQ(m_closes.count(), 0);
    m_window.showProgress(1.0);
    EXPECT_FALSE(part(m_window, "progress").isVisible());
    EXPECT_TRUE(action("save").isEnabled());
}

TEST_F(RenderPictureWindowTest, AppearsForTheFirstPictureOnceItTakesAWhile) {
    m_window.showProgress(0.0);
    EXPECT_FALSE(m_window.isVisible());
    QTest::qWait(600);
    m_window.showProgress(0.1);
    EXPECT_TRUE(m_window.isVisible());
    m_window.showProgress(1.0);
    EXPECT_TRUE(QTest::qWaitFor([&] { return !m_window.isVisible(); })); // it was stopped
}

TEST_F(RenderPictureWindowTest, RefusesAPictureWithFewerPixelsThanItTells) {
    const Pixels pixels(40, 30);
    m_window.showPicture({40, 31, pixels.rgba});
    EXPECT_FALSE(m_window.isVisible());
}

} // namespace
} // namespace quarn::desktop
