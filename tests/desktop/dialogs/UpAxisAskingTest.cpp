#include "desktop/dialogs/UpAxisAsking.h"
#include "tests/desktop/dialogs/DialogDriver.h"

#include <gtest/gtest.h>

#include <QCheckBox>
#include <QLabel>
#include <QSettings>
#include <QTest>
#include <QToolButton>

namespace quarn::desktop {
namespace {

using test::onceShown;
using test::part;

class UpAxisAskingTest : public testing::Test {
protected:
    UpAxisAskingTest() { QSettings().clear(); }

    std::optional<ModelUp> ask(const std::filesystem::path& file = "/models/<b>house.obj") {
        const auto draw = [this](ModelUp up, int width_px, int height_px) -> ShownPicture {
            ++m_drawn;
            if (!m_can_draw)
                return {};
            m_picture.assign(static_cast<std::size_t>(4 * width_px * height_px),
                             up == ModelUp::y ? 0x11 : 0xdd);
            return {width_px, height_px, m_picture};
        };
        return m_asking.ask(nullptr, {file, ModelUp::z, draw});
    }
    std::optional<ModelUp> answerWith(std::function<void(QWidget&)> act,
                                      const std::filesystem::path& file) {
        onceShown("upAxis", std::move(act));
        return ask(file);
    }
    static void click(QWidget& window, const char* name) {
        QTest::mouseClick(&part(window, name), Qt::LeftButton);
    }
    static int shade(QWidget& window, const char* button) {
        const QIcon icon = part<QToolButton>(window, button).icon();
        return icon.pixmap(QSize(20, 15)).toImage().pixelColor(5, 5).red();
    }

    UpAxisAsking m_asking{nullptr};
    std::vector<std::uint8_t> m_picture;
    bool m_can_draw = true;
    int m_drawn = 0;
};

TEST_F(UpAxisAskingTest, ShowsAPictureOfEachWayTheTakenOneFirst) {
    onceShown("upAxis", [](QWidget& window) {
        EXPECT_EQ(window.windowTitle(), "Which way is up?");
        EXPECT_EQ(part<QLabel>(window, "question").textFormat(), Qt::PlainText);
        EXPECT_TRUE(part<QLabel>(window, "question").text().startsWith("<b>house.obj does not"));
        EXPECT_EQ(part<QToolButton>(window, "upZ").text(), "&Z points up, as usual");
        EXPECT_EQ(part<QToolButton>(window, "upY").text(), "&Y points up");
        EXPECT_LT(part(window, "upZ").x(), part(window, "upY").x());
        EXPECT_EQ(shade(window, "upZ"), 0xdd);
        EXPECT_EQ(shade(window, "upY"), 0x11);
        window.close();
    });
    ask();
}

TEST_F(UpAxisAskingTest, AClickOnAPictureOrItsKeyChoosesTheWay) {
    const auto click_on = [](const char* name) {
        return [name](QWidget& window) { click(window, name); };
    };
    EXPECT_EQ(answerWith(click_on("upY"), "/a.obj"), ModelUp::y);
    EXPECT_EQ(answerWith(click_on("upZ"), "/b.obj"), ModelUp::z);
    const auto alt_y = [](QWidget& window) {
        QTest::keyClick(&window, Qt::Key_Y, Qt::AltModifier);
    };
    EXPECT_EQ(answerWith(alt_y, "/c.obj"), ModelUp::y);
}

TEST_F(UpAxisAskingTest, EnterChoosesTheWayThatStandsOrTheOneWithTheKeyboard) {
    const auto enter = [](QWidget& window) { QTest::keyClick(&window, Qt::Key_Return); };
    EXPECT_EQ(answerWith(enter, "/a.obj"), ModelUp::z);
    const auto tab_and_enter = [](QWidget& window) {
        QTest::keyClick(window.focusWidget(), Qt::Key_Tab);
        QTest::keyClick(window.focusWidget(), Qt::Key_Return);
    };
    EXPECT_EQ(answerWith(tab_and_enter, "/b.obj"), ModelUp::y);
}

TEST_F(UpAxisAskingTest, EscapeAndTheWindowsOwnButtonChooseNothing) {
    const auto escape = [](QWidget& window) { QTest::keyClick(&window, Qt::Key_Escape); };
    const auto close = [](QWidget& window) { window.close(); };
    EXPECT_EQ(answerWith(escape, "/a.obj"), std::nullopt);
    EXPECT_EQ(answerWith(close, "/a.obj"), std::nullopt);
}

TEST_F(UpAxisAskingTest, AFileIsAskedAboutOnce) {
    EXPECT_EQ(answerWith([](QWidget& window) { click(window, "upY"); }, "/models/a.obj"),
              ModelUp::y);
    m_drawn = 0;
    EXPECT_EQ(ask("/models/a.obj"), ModelUp::y);
    EXPECT_EQ(ask("/models/../models/a.obj"), ModelUp::y);
    EXPECT_EQ(m_drawn, 0);
    EXPECT_EQ(answerWith([](QWidget& window) { click(window, "upZ"); }, "/models/b.obj"),
              ModelUp::z);
}

TEST_F(UpAxisAskingTest, WhoDoesNotWantToBeAskedIsNotUntilTheMenuBringsItBack) {
    const auto never_again = [](QWidget& window) {
        part<QCheckBox>(window, "neverAgain").click();
        click(window, "upZ");
    };
    EXPECT_EQ(answerWith(never_again, "/a.obj"), ModelUp::z);
    EXPECT_FALSE(m_asking.switchAction().isChecked());
    EXPECT_EQ(ask("/b.obj"), std::nullopt);
    EXPECT_FALSE(UpAxisAsking(nullptr).switchAction().isChecked()) << "the next run";
    m_asking.switchAction().trigger();
    EXPECT_EQ(answerWith([](QWidget& window) { click(window, "upY"); }, "/b.obj"), ModelUp::y);
    EXPECT_TRUE(UpAxisAsking(nullptr).switchAction().isChecked());
}

TEST_F(UpAxisAskingTest, WithoutPicturesNobodyIsAsked) {
    m_can_draw = false;
    EXPECT_EQ(ask(), std::nullopt);
}

} // namespace
} // namespace quarn::desktop
