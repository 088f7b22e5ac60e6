#include "desktop/window/Language.h"
#include "desktop/dialogs/FormWindow.h"
#include "tests/desktop/dialogs/DialogDriver.h"

#include <gtest/gtest.h>

#include <QCalendarWidget>
#include <QCoreApplication>
#include <QDateEdit>
#include <QTimeEdit>

namespace quarn::desktop {
namespace {

/// The environment of a person, put back afterwards.
class LanguageTest : public testing::Test {
protected:
    static constexpr const char* VARIABLES[] = {"LC_ALL",   "LC_MESSAGES", "LC_TIME",
                                                "LANGUAGE", "LC_NUMERIC",  "LANG"};
    LanguageTest() {
        for (const char* variable : VARIABLES) {
            m_former << qgetenv(variable);
            qunsetenv(variable);
        }
    }
    ~LanguageTest() override {
        for (int index = 0; index < m_former.size(); ++index)
            if (m_former[index].isNull())
                qunsetenv(VARIABLES[index]);
            else
                qputenv(VARIABLES[index], m_former[index]);
    }

    /// What stands on Qt's own button.
    static QString cancelText() { return QCoreApplication::translate("QPlatformTheme", "Cancel"); }

    QByteArrayList m_former;
};

TEST_F(LanguageTest, QtSpeaksEveryLanguageOfTheWindow) {
    const struct {
        const char* language;
        const char* cancel;
        const char* june;
    } spoken[] = {
        {"en", "Cancel", "June"},  {"de", "Abbrechen", "Juni"}, {"es", "Cancelar", "junio"},
        {"fr", "Annuler", "juin"}, {"ja", "キャンセル", "6月"}, {"zh", "取消", "六月"},
        {"zh_CN", "取消", "六月"},
    };
    for (const auto& [code, cancel, june] : spoken) {
        const Language language(code);
        EXPECT_TRUE(language.hasTexts()) << code;
        EXPECT_EQ(cancelText(), cancel);
        EXPECT_EQ(QLocale().monthName(6), june);
    }
    EXPECT_EQ(cancelText(), "Cancel");
}

TEST_F(LanguageTest, LanguageOfTheEnvironmentIsTheOneThatTheHostTakes) {
    qputenv("LANGUAGE", "fr");
    qputenv("LANG", "ja_JP.UTF-8");
    EXPECT_EQ(textLocale({}).language(), QLocale::Japanese);
    qputenv("LC_MESSAGES", "es_ES.UTF-8");
    EXPECT_EQ(textLocale({}).language(), QLocale::Spanish);
    qputenv("LC_ALL", "zh_CN.UTF-8");
    EXPECT_EQ(textLocale({}).language(), QLocale::Chinese);
    EXPECT_EQ(textLocale("de").language(), QLocale::German);
    const Language language({});
    EXPECT_EQ(cancelText(), "取消");
}

TEST_F(LanguageTest, UnknownLanguageLeavesEverythingAsItIs) {
    for (const char* unknown : {"xx", "C", "nonsense!"}) {
        const Language language(unknown);
        EXPECT_FALSE(language.hasTexts()) << unknown;
        EXPECT_EQ(cancelText(), "Cancel");
        EXPECT_EQ(QLocale(), QLocale::system());
    }
}

TEST_F(LanguageTest, DatesAreThoseOfTheCountryWhereItsLanguageIsSpoken) {
    const QLocale austria("de_AT");
    EXPECT_EQ(formatLocale("de", austria), austria);
    EXPECT_EQ(formatLocale("", austria), austria);
    EXPECT_EQ(formatLocale("xx", austria), austria);
    EXPECT_EQ(formatLocale("de_CH", austria), QLocale("de_CH"));
    EXPECT_EQ(formatLocale("fr", austria), QLocale("fr"));
}

TEST_F(LanguageTest, FormsWriteDatesAndTheirCalendarInTheLanguage) {
    const struct {
        const char* language;
        const char* date;
        const char* time;
        const char* month;
    } written[] = {{"de", "21.06.2026", "14:30", "Juni"},
                   {"zh", "2026/6/21", "14:30", "六月"},
                   {"en", "6/21/2026", "2:30 PM", "June"}};
    for (const auto& [code, date, time, month] : written) {
        const Language language(code);
        DialogTemplate form;
        form.id = 1;
        form.controls = {{3, DialogControl::Kind::date, L"Day", L"", false},
                         {4, DialogControl::Kind::time, L"Time", L"", false}};
        const auto window = makeFormWindow(form, nullptr);
        window->setDateTime(3, {2026, 6, 21, 14, 30, 0});
        window->setDateTime(4, {2026, 6, 21, 14, 30, 0});
        QWidget* shown = nullptr;
        for (QWidget* widget : QApplication::topLevelWidgets())
            if (widget->objectName() == "form1")
                shown = widget;
        ASSERT_TRUE(shown);
        const auto& day = test::part<QDateEdit>(*shown, "control3");
        EXPECT_EQ(day.text(), date);
        EXPECT_EQ(test::part<QTimeEdit>(*shown, "control4").text(), time);
        EXPECT_EQ(day.calendarWidget()->locale().monthName(6), month);
    }
}

} // namespace
} // namespace quarn::desktop
