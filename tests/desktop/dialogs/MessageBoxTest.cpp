#include "desktop/dialogs/MessageBox.h"
#include "tests/desktop/dialogs/DialogDriver.h"

#include <gtest/gtest.h>

#include <QMessageBox>
#include <QPushButton>
#include <QTest>

namespace quarn::desktop {
namespace {

using test::onceShown;
using test::part;

QMessageBox& boxOf(QWidget& window) {
    return dynamic_cast<QMessageBox&>(window);
}

TEST(MessageBox, ShowsTextTitleAndTheWarningIconAndReturnsOne) {
    onceShown("message", [](QWidget& window) {
        EXPECT_EQ(boxOf(window).text(), "Vex UI (ZEL_VexUI.qnp) cannot be loaded.");
        EXPECT_EQ(boxOf(window).windowTitle(), "Animation");
        EXPECT_EQ(boxOf(window).icon(), QMessageBox::Warning);
        QTest::mouseClick(&part(window, "ok"), Qt::LeftButton);
    });
    EXPECT_EQ(
        showMessageBox(nullptr, L"Vex UI (ZEL_VexUI.qnp) cannot be loaded.", L"Animation", 48), 1);
}

TEST(MessageBox, HasTheIconThatTheFlagsName) {
    const struct {
        unsigned flags;
        QMessageBox::Icon icon;
    } examples[] = {{0, QMessageBox::NoIcon},
                    {16, QMessageBox::Critical},
                    {32, QMessageBox::Question},
                    {48 | 0x1000, QMessageBox::Warning},
                    {64, QMessageBox::Information}};
    for (const auto& example : examples) {
        onceShown("message", [&](QWidget& window) {
            EXPECT_EQ(boxOf(window).icon(), example.icon) << example.flags;
            QTest::keyClick(&window, Qt::Key_Return);
        });
        showMessageBox(nullptr, L"text", L"title", example.flags);
    }
}

TEST(MessageBox, EscapeAndTheWindowsOwnButtonConfirmToo) {
    onceShown("message", [](QWidget& window) { QTest::keyClick(&window, Qt::Key_Escape); });
    EXPECT_EQ(showMessageBox(nullptr, L"text", L"title", 0), 1);
    onceShown("message", [](QWidget& window) { window.close(); });
    EXPECT_EQ(showMessageBox(nullptr, L"text", L"title", 0), 1);
}

TEST(MessageBox, TakesNoTextForMarkup) {
    onceShown("message", [](QWidget& window) {
        EXPECT_EQ(boxOf(window).textFormat(), Qt::PlainText);
        window.close();
    });
    showMessageBox(nullptr, L"<b>bold</b> is a name", L"title", 0);
}

TEST(MessageBox, SurvivesItsOwner) {
    auto owner = std::make_unique<QWidget>();
    onceShown("message", [&](QWidget&) { owner.reset(); });
    EXPECT_EQ(showMessageBox(owner.get(), L"text", L"title", 0), 1);
}

TEST(AskWhether, OnlyTheButtonThatAgreesIsYes) {
    const auto answer = [](std::function<void(QWidget&)> act) {
        onceShown("message", std::move(act));
        return askWhether(nullptr, L"Replace it?", L"Save", L"Replace");
    };
    EXPECT_TRUE(answer([](QWidget& window) {
        EXPECT_EQ(part<QPushButton>(window, "yes").text(), "Replace");
        QTest::mouseClick(&part(window, "yes"), Qt::LeftButton);
    }));
    EXPECT_FALSE(answer(
        [](QWidget& window) { QTest::mouseClick(&part(window, "cancel"), Qt::LeftButton); }));
    EXPECT_FALSE(answer([](QWidget& window) { QTest::keyClick(&window, Qt::Key_Return); }));
    EXPECT_FALSE(answer([](QWidget& window) { QTest::keyClick(&window, Qt::Key_Escape); }));
}

} // namespace
} // namespace quarn::desktop
