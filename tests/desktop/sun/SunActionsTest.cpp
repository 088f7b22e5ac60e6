// What the Sun menu makes: hours of sun, the diagram of the sun's paths, the almanac of a day.
#include "desktop/animation/AnimationBar.h"
#include "desktop/window/Language.h"
#include "tests/desktop/dialogs/DialogDriver.h"
#include "tests/desktop/window/WindowFixture.h"

#include <QCheckBox>
#include <QClipboard>
#include <QComboBox>
#include <QDateEdit>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QSpinBox>
#include <QTableWidget>
#include <QTimeEdit>

namespace quarn::desktop::test {
namespace {

class SunActionsTest : public WindowTest {
protected:
    SunActionsTest() { readSlab(); }

    /// Chooses an action of the Sun menu and does this in its form.
    void answer(const char* action, const QString& form, std::function<void(QWidget&)> act) {
        onceShown(form, std::move(act));
        part<QAction>(window, action).trigger();
    }
    static void type(QWidget& form, const char* field, const QString& text) {
        auto& edit = part<QLineEdit>(form, field);
        edit.setFocus();
        edit.selectAll();
        QTest::keyClicks(&edit, text);
    }
    static void press(QWidget& form, const char* button) { click(part<QPushButton>(form, button)); }
    static QString text(QWidget& form, const char* field) {
        return part<QLineEdit>(form, field).text();
    }
    static QString flaw(QWidget& form) {
        auto& label = part<QLabel>(form, "flaw");
        return label.isVisible() ? label.text() : QString();
    }
    QString told() { return part<QLabel>(window, "sharedFileText").text(); }
    bool isThere(const char* file) { return std::filesystem::exists(folder / file); }
};

TEST_F(SunActionsTest, HoursOfSunOfANamedDayBecomeAPlanAndItsPage) {
    answer("sunHours", "hoursForm", [&](QWidget& form) {
        EXPECT_EQ(text(form, "folder"), qtText(folder.path()));
        type(form, "place", "Athens");
        EXPECT_EQ(text(form, "zone"), "Europe/Athens");
        part<QDateEdit>(form, "date").setDate(QDate(2026, 5, 5));
        auto& named = part<QComboBox>(form, "namedDay");
        EXPECT_EQ(named.currentText(), "Other day");
        QTest::keyClick(&named, Qt::Key_Down);
        QTest::keyClick(&named, Qt::Key_Down);
        EXPECT_EQ(part<QDateEdit>(form, "date").date(), QDate(2026, 3, 20));
        part<QSpinBox>(form, "minutes").setValue(60);
        press(form, "ok");
    });
    for (const char* const file :
         {"model-sunhours.png", "model-sunhours.html", "model-sunhours.csv", "model-sunhours.npy"})
        EXPECT_TRUE(isThere(file)) << file;
    EXPECT_TRUE(told().startsWith("model-sunhours.html: at most 1")) << told().toStdString();
    EXPECT_TRUE(part<QPushButton>(window, "sharedFileOpen").isVisible());
    EXPECT_TRUE(part<QPushButton>(window, "sharedFilePicture").isVisible());
    answer("sunHours", "hoursForm", [](QWidget& form) {
        EXPECT_EQ(text(form, "place"), "Athens, Greece") << "the document keeps the place";
        QTest::keyClick(&form, Qt::Key_Escape);
    });
}

TEST_F(SunActionsTest, AFormThatCannotBeTakenSaysWhyAndStays) {
    answer("sunHours", "hoursForm", [&](QWidget& form) {
        type(form, "place", "Athnes");
        press(form, "ok");
        EXPECT_TRUE(flaw(form).contains("Did you mean Athens, Greece")) << flaw(form).toStdString();
        EXPECT_EQ(form.focusWidget(), &part<QLineEdit>(form, "place"));
        type(form, "place", "37.98, 23.73");
        EXPECT_EQ(flaw(form), "");
        type(form, "zone", "Europe/Atlantis");
        press(form, "ok");
        EXPECT_TRUE(flaw(form).contains("Europe/Atlantis")) << flaw(form).toStdString();
        type(form, "zone", "+02:00");
        part<QCheckBox>(form, "wholeDay").setChecked(false);
        part<QTimeEdit>(form, "from").setTime(QTime(15, 0));
        part<QTimeEdit>(form, "to").setTime(QTime(9, 0));
        press(form, "ok");
        EXPECT_EQ(flaw(form), "No time is left: it ends before it begins.");
        part<QTimeEdit>(form, "to").setTime(QTime(16, 0));
        part<QCheckBox>(form, "several").setChecked(true);
        part<QDateEdit>(form, "lastDate").setDate(part<QDateEdit>(form, "date").date().addDays(-1));
        press(form, "ok");
        EXPECT_EQ(flaw(form), "The last day is before the first one.");
        part<QCheckBox>(form, "several").setChecked(false);
        type(form, "folder", qtText(folder / "nowhere"));
        press(form, "ok");
        EXPECT_TRUE(flaw(form).contains("There is no folder")) << flaw(form).toStdString();
        EXPECT_TRUE(form.isVisible());
        press(form, "cancel");
    });
    EXPECT_FALSE(isThere("model-sunhours.png"));
    EXPECT_FALSE(window.starter().isRunning());
}

/// The system's own folder takes no file of anybody's.
TEST_F(SunActionsTest, AFolderThatTakesNoFilesIsTold) {
    QString why;
    answer("sunHours", "hoursForm", [&](QWidget& form) {
        type(form, "folder", "/proc");
        part<QSpinBox>(form, "minutes").setValue(240);
        press(form, "ok");
        if (!form.isVisible())
            return;
        why = flaw(form);
        press(form, "cancel");
    });
    EXPECT_TRUE(why.contains("/proc") || told().startsWith("Cannot write")) << told().toStdString();
    EXPECT_FALSE(part<QPushButton>(window, "sharedFileOpen").isVisible());
}

TEST_F(SunActionsTest, CancelEndsHoursOfSunAndNothingIsWritten) {
    QTimer clock;
    bool is_ended = false;
    QObject::connect(&clock, &QTimer::timeout, &window, [&] {
        auto& progress = part<QLabel>(window, "progressText");
        if (is_ended || !progress.isVisible() || !progress.text().contains("model-sunhours.png"))
            return;
        is_ended = true;
        EXPECT_FALSE(part<QAction>(window, "sunPath").isEnabled());
        click(part<QPushButton>(window, "progressCancel"));
    });
    clock.start(0);
    answer("sunHours", "hoursForm", [&](QWidget& form) {
        part<QDateEdit>(form, "date").setDate(QDate(2026, 1, 1));
        part<QCheckBox>(form, "several").setChecked(true);
        part<QDateEdit>(form, "lastDate").setDate(QDate(2026, 12, 31));
        press(form, "ok");
    });
    EXPECT_TRUE(is_ended);
    EXPECT_FALSE(isThere("model-sunhours.png"));
    EXPECT_FALSE(part<QWidget>(window, "sharedFileRow").isVisible());
    EXPECT_TRUE(part<QAction>(window, "sunPath").isEnabled());
}

TEST_F(SunActionsTest, TheDiagramShowsWhatTheModelHidesFromAPoint) {
    answer("sunPath", "pathForm", [&](QWidget& form) {
        type(form, "place", "Berlin");
        type(form, "point", "3,0,0.1");
        type(form, "file", qtText(folder / "paths.txt"));
        press(form, "ok");
        EXPECT_TRUE(flaw(form).contains(".svg")) << flaw(form).toStdString();
        type(form, "file", qtText(folder / "paths.svg"));
        press(form, "ok");
    });
    const std::string svg = quarn::test::readFile(folder / "paths.svg");
    EXPECT_NE(svg.find("Berlin, Germany"), std::string::npos);
    EXPECT_NE(svg.find("stereographic-hidden"), std::string::npos);
    EXPECT_EQ(svg.find("orthographic-hour-12"), std::string::npos);
    EXPECT_TRUE(told().contains("paths.svg: hours are those of CET")) << told().toStdString();
    EXPECT_TRUE(part<QPushButton>(window, "sharedFilePicture").isVisible());
}

TEST_F(SunActionsTest, ADiagramOfAnUnknownObjectSaysWhyThereIsNone) {
    answer("sunPath", "pathForm", [&](QWidget& form) {
        type(form, "point", "Balcony");
        press(form, "ok");
    });
    EXPECT_TRUE(told().contains("Balcony")) << told().toStdString();
    EXPECT_FALSE(isThere("model-sunpath.svg"));
    EXPECT_FALSE(part<QPushButton>(window, "sharedFilePicture").isVisible());
}

/// Clocks in Germany go forward from 02:00 to 03:00 on 29 March 2026.
TEST_F(SunActionsTest, TheAlmanacTellsADayByTheClockOnTheWall) {
    answer("sunAlmanac", "almanacForm", [](QWidget& form) {
        type(form, "place", "Berlin");
        auto& hours = part<QTableWidget>(form, "hours");
        part<QDateEdit>(form, "date").setDate(QDate(2026, 3, 28));
        EXPECT_EQ(hours.rowCount(), 24);
        part<QDateEdit>(form, "date").setDate(QDate(2026, 3, 29));
        EXPECT_EQ(hours.rowCount(), 23);
        EXPECT_EQ(hours.item(1, 0)->text(), "01:00 CET");
        EXPECT_EQ(hours.item(2, 0)->text(), "03:00 CEST");
        press(form, "copy");
        EXPECT_TRUE(QApplication::clipboard()->text().contains("03:00 CEST\t"));
        type(form, "place", "nowhere at all");
        EXPECT_EQ(hours.rowCount(), 0);
        EXPECT_TRUE(part<QLabel>(form, "events").text().contains("nowhere at all"));
        press(form, "cancel");
    });
}

TEST_F(SunActionsTest, NamedDaysAreThoseOfTheHemisphere) {
    answer("sunAlmanac", "almanacForm", [](QWidget& form) {
        auto& named = part<QComboBox>(form, "namedDay");
        auto& date = part<QDateEdit>(form, "date");
        date.setDate(QDate(2026, 6, 21));
        type(form, "place", "Berlin");
        EXPECT_EQ(named.currentText(), "Longest day");
        type(form, "place", "Sydney");
        EXPECT_EQ(named.currentText(), "Shortest day");
        press(form, "cancel");
    });
}

TEST_F(SunActionsTest, EveryFieldIsReachedWithTheTabKey) {
    answer("sunHours", "hoursForm", [](QWidget& form) {
        part<QLineEdit>(form, "place").setFocus();
        QStringList reached;
        for (int step = 0; step < 40; ++step) {
            reached << form.focusWidget()->objectName();
            QTest::keyClick(form.focusWidget(), Qt::Key_Tab);
        }
        for (const char* const field :
             {"map", "zone", "north", "date", "namedDay", "several", "wholeDay", "minutes",
              "picture", "lines", "folder", "chooseFolder", "ok", "cancel"})
            EXPECT_TRUE(reached.contains(field)) << field;
        press(form, "cancel");
    });
}

/// The forms in every language of the window.
class SunFormsInLanguages : public WindowPartsTest,
                            public testing::WithParamInterface<const char*> {
protected:
    SunFormsInLanguages() : WindowPartsTest(GetParam()), m_language(GetParam()) {}
    const Language m_language;
};

TEST_P(SunFormsInLanguages, FitASmallScreen) {
    MainWindow window(session, front_end);
    window.show();
    const std::pair<const char*, const char*> forms[] = {
        {"sunHours", "hoursForm"}, {"sunPath", "pathForm"}, {"sunAlmanac", "almanacForm"}};
    for (const auto& [action, name] : forms) {
        onceShown(name, [&](QWidget& form) {
            EXPECT_LE(form.width(), 1000) << action;
            EXPECT_LE(form.height(), 560) << action;
            if (const QByteArray to = qgetenv("QUARN_FORM_PICTURES"); !to.isEmpty())
                form.grab().save(QString("%1/%2-%3.png").arg(to, name, GetParam()));
            QTest::keyClick(&form, Qt::Key_Escape);
        });
        part<QAction>(window, action).trigger();
    }
}

INSTANTIATE_TEST_SUITE_P(Languages, SunFormsInLanguages,
                         testing::Values("en", "de", "es", "fr", "ja", "zh"),
                         [](const auto& language) { return std::string(language.param); });

} // namespace
} // namespace quarn::desktop::test
