#include "desktop/front_end/EscapeKey.h"

#include <gtest/gtest.h>

#include <QTest>
#include <QWidget>

namespace quarn::desktop {
namespace {

class EscapeKeyTest : public testing::Test {
protected:
    EscapeKey m_escape;
    QWidget m_widget;
};

TEST_F(EscapeKeyTest, IsDownFromPressToRelease) {
    EXPECT_FALSE(m_escape.isDown());
    QTest::keyPress(&m_widget, Qt::Key_Escape);
    EXPECT_TRUE(m_escape.isDown());
    EXPECT_TRUE(m_escape.isDown());
    QTest::keyRelease(&m_widget, Qt::Key_Escape);
    EXPECT_FALSE(m_escape.isDown());
}

TEST_F(EscapeKeyTest, ShortTapBetweenTwoLooksIsSeenOnce) {
    QTest::keyClick(&m_widget, Qt::Key_Escape);
    EXPECT_TRUE(m_escape.isDown());
    EXPECT_FALSE(m_escape.isDown());
}

TEST_F(EscapeKeyTest, ForgottenTapIsNotSeen) {
    QTest::keyClick(&m_widget, Qt::Key_Escape);
    m_escape.forgetTap();
    EXPECT_FALSE(m_escape.isDown());
}

TEST_F(EscapeKeyTest, OtherKeysAreNotEscape) {
    QTest::keyPress(&m_widget, Qt::Key_Return);
    EXPECT_FALSE(m_escape.isDown());
    QTest::keyRelease(&m_widget, Qt::Key_Return);
}

} // namespace
} // namespace quarn::desktop
