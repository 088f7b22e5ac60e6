#include "desktop/dialogs/FormWindow.h"
#include "desktop/dialogs/LocationDialog.h"
#include "desktop/dialogs/MessageBox.h"
#include "desktop/views/OpenViews.h"
#include "desktop/window/Language.h"
#include "sdk/qncore/qncore.h"
#include "tests/desktop/WindowParts.h"
#include "tests/desktop/dialogs/DialogDriver.h"

#include <QComboBox>
#include <QDateEdit>
#include <QLineEdit>
#include <QMessageBox>
#include <QTimeEdit>

#include <limits>

namespace quarn::desktop {
namespace {

using test::onceShown;
using test::part;

/// The host's own forms in the window's dialogs, in the order of their files.
enum Form : int { camera = 4201, render_settings = 4202, sun = 4203, viewport_size = 4204 };

class HostFormsTest : public test::WindowPartsTest {
protected:
    explicit HostFormsTest(const std::string& language = "C") : WindowPartsTest(language) {
        usePart([](FrontEndParts& used) {
            used.make_dialog = makeFormWindow;
            used.show_message = showMessageBox;
            used.choose_place = askPlace;
        });
    }

    /// Chooses a command in a menu and does this in its form.
    void answer(const QString& command, Form form, std::function<void(QWidget&)> act) {
        onceShown(QString("form%1").arg(form), std::move(act));
        starter.start(command);
    }
    static QLineEdit& field(QWidget& form, int control) {
        return part<QLineEdit>(form, QString("control%1").arg(control));
    }
    static void type(QWidget& form, int control, const char* text) {
        QLineEdit& edit = field(form, control);
        edit.setFocus();
        edit.selectAll();
        QTest::keyClicks(&edit, text);
    }
    static void press(QWidget& form, const QString& button) {
        QTest::mouseClick(&part(form, button), Qt::LeftButton);
    }
    const KM_Viewport& viewport() {
        return findView(session.document(), "Perspective")->MainViewport().VP();
    }
};

TEST_F(HostFormsTest, CameraIsMovedInItsForm) {
    run("_-Camera _Location 10,-20,5 _Target 1,2,3 _Enter");
    answer("_Camera", camera, [](QWidget& form) {
        EXPECT_EQ(form.focusWidget(), &field(form, 4301));
        EXPECT_EQ(field(form, 4301).text(), "10");
        type(form, 4303, "7,25");
        part<QComboBox>(form, "control4307").setCurrentIndex(1);
        press(form, "ok");
    });
    EXPECT_EQ(last_result, CQuarnCommand::success);
    EXPECT_EQ(viewport().CameraLocation(), KM_3dPoint(10, -20, 7.25));
    EXPECT_TRUE(viewport().IsParallelProjection());
}

TEST_F(HostFormsTest, SizeThatNoPictureHasKeepsTheFormOpen) {
    run("_-ViewportSize 640 360");
    answer("_ViewportSize", viewport_size, [](QWidget& form) {
        type(form, 4302, "0");
        onceShown("message", [](QWidget& box) {
            EXPECT_EQ(dynamic_cast<QMessageBox&>(box).text(), "Enter a number between 1 and 16384");
            press(box, "ok");
        });
        press(form, "ok");
        EXPECT_TRUE(form.isVisible());
        EXPECT_EQ(form.focusWidget(), &field(form, 4302));
        QTest::keyClick(&form, Qt::Key_Escape);
    });
    EXPECT_EQ(last_result, CQuarnCommand::cancel);
}

TEST_F(HostFormsTest, RenderSettingsTakeTheSizeOfTheViewByAButton) {
    run("_-ViewportSize 801 450");
    answer("_RenderSettings", render_settings, [](QWidget& form) {
        press(form, "control4303");
        EXPECT_EQ(field(form, 4301).text(), "801");
        EXPECT_EQ(field(form, 4302).text(), "450");
        press(form, "ok");
    });
    EXPECT_EQ(last_result, CQuarnCommand::success);
}

TEST_F(HostFormsTest, RenderSettingsKeepTheLightThatIsChosenInTheirForm) {
    answer("_RenderSettings", render_settings, [](QWidget& form) {
        EXPECT_EQ(field(form, 4309).text(), "");
        part<QComboBox>(form, "control4306").setCurrentIndex(1);
        type(form, 4309, "-0,5");
        part<QComboBox>(form, "control4310").setCurrentIndex(2);
        part<QComboBox>(form, "control4312").setCurrentIndex(1);
        press(form, "ok");
    });
    EXPECT_EQ(last_result, CQuarnCommand::success);
    answer("_RenderSettings", render_settings, [](QWidget& form) {
        EXPECT_EQ(part<QComboBox>(form, "control4306").currentText(), "Studio");
        EXPECT_EQ(field(form, 4309).text(), "-0.5");
        EXPECT_EQ(part<QComboBox>(form, "control4310").currentText(), "Transparent");
        EXPECT_EQ(part<QComboBox>(form, "control4312").currentText(), "Off");
        press(form, "cancel");
    });
}

TEST_F(HostFormsTest, SunIsPutByAPlaceChosenBeforeTheForm) {
    answer("_Sun", sun, [](QWidget& form) {
        onceShown("location", [&](QWidget& picker) {
            EXPECT_EQ(picker.parentWidget(), &form);
            auto& latitude = part<QLineEdit>(picker, "latitude");
            latitude.selectAll();
            QTest::keyClicks(&latitude, "39.742476");
            auto& longitude = part<QLineEdit>(picker, "longitude");
            longitude.selectAll();
            QTest::keyClicks(&longitude, "-105.1786");
            press(picker, "ok");
        });
        press(form, "control4304");
        EXPECT_EQ(field(form, 4302).text(), "39.74");
        part<QDateEdit>(form, "control4305").setDate(QDate(2003, 10, 17));
        part<QTimeEdit>(form, "control4306").setTime(QTime(12, 30, 30));
        press(form, "control4309");
        // Reda and Andreas, Solar Position Algorithm (NREL/TP-560-34302), appendix A.5.
        EXPECT_EQ(field(form, 4310).text(), "194.34");
        EXPECT_EQ(field(form, 4311).text(), "39.87");
        press(form, "ok");
    });
    EXPECT_TRUE(printed.contains("sun: on, azimuth 194.34, altitude 39.87"))
        << printed.toStdString();
}

TEST_F(HostFormsTest, SunFormBeginsWithThePlaceAndDayOfTheSunStudy) {
    KM_3dmAnimationProperties study = record();
    study.SetLatitude(48.137);
    study.SetLongitude(11.575);
    study.SetNorthAngle(30);
    study.SetStartYear(2026);
    study.SetStartMonth(12);
    study.SetStartDay(21);
    session.document().Properties().SetAnimationProperties(study);
    answer("_Sun", sun, [](QWidget& form) {
        EXPECT_EQ(field(form, 4302).text(), "48.14");
        EXPECT_EQ(field(form, 4303).text(), "11.58");
        EXPECT_EQ(part<QDateEdit>(form, "control4305").date(), QDate(2026, 12, 21));
        EXPECT_EQ(field(form, 4308).text(), "30");
        press(form, "cancel");
    });
}

TEST_F(HostFormsTest, SunFormPassesOverAStudyOfNoPlaceAndNoDay) {
    KM_3dmAnimationProperties no_place = record();
    no_place.SetLongitude(1e300);
    KM_3dmAnimationProperties no_number = record();
    no_number.SetLatitude(std::numeric_limits<double>::quiet_NaN());
    KM_3dmAnimationProperties no_day = record();
    no_day.SetStartDay(31); // of June
    for (const KM_3dmAnimationProperties& hostile : {no_place, no_number, no_day}) {
        session.document().Properties().SetAnimationProperties(hostile);
        answer("_Sun", sun, [](QWidget& form) {
            EXPECT_EQ(field(form, 4302).text(), "51.28");
            EXPECT_EQ(field(form, 4303).text(), "0");
            EXPECT_EQ(part<QDateEdit>(form, "control4305").date(), QDate(2010, 6, 1));
            press(form, "cancel");
        });
    }
}

struct Spoken {
    const char* language;
    const char* sun;
    const char* date; ///< of the first of June 2010
};

/// The forms in every language of the window.
class HostFormsInLanguages : public HostFormsTest, public testing::WithParamInterface<Spoken> {
protected:
    HostFormsInLanguages() : HostFormsTest(GetParam().language), m_language(GetParam().language) {}
    const Language m_language;
};

TEST_P(HostFormsInLanguages, SpeakTheLanguageInWordsAndDates) {
    answer("_Sun", sun, [](QWidget& form) {
        EXPECT_EQ(form.windowTitle(), GetParam().sun);
        EXPECT_EQ(part<QDateEdit>(form, "control4305").text(), GetParam().date);
        press(form, "cancel");
    });
}

TEST_P(HostFormsInLanguages, FitASmallScreen) {
    const std::pair<const char*, Form> forms[] = {{"_Camera", camera},
                                                  {"_RenderSettings", render_settings},
                                                  {"_Sun", sun},
                                                  {"_ViewportSize", viewport_size}};
    for (const auto& [command, form] : forms)
        answer(command, form, [&](QWidget& shown) {
            EXPECT_LE(shown.width(), 800) << command;
            EXPECT_LE(shown.height(), 560) << command;
            press(shown, "cancel");
        });
    EXPECT_EQ(last_result, CQuarnCommand::cancel);
}

INSTANTIATE_TEST_SUITE_P(
    Languages, HostFormsInLanguages,
    testing::Values(Spoken{"en", "Sun", "6/1/2010"}, Spoken{"de", "Sonne", "01.06.2010"},
                    Spoken{"es", "Sol", "1/6/2010"}, Spoken{"fr", "Soleil", "01/06/2010"},
                    Spoken{"ja", "太陽", "2010/06/01"}, Spoken{"zh", "太阳", "2010/6/1"}),
    [](const auto& spoken) { return std::string(spoken.param.language); });

} // namespace
} // namespace quarn::desktop
