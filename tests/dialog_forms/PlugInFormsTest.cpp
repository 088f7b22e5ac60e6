#include "desktop/dialogs/FormWindow.h"
#include "desktop/dialogs/LocationDialog.h"
#include "desktop/dialogs/MessageBox.h"
#include "desktop/front_end/DesktopFrontEnd.h"
#include "host/session/Session.h"
#include "tests/desktop/dialogs/DialogDriver.h"
#include "zoetrix/ui/PathAnimationDialog.h"
#include "zoetrix/ui/SeasonDialog.h"
#include "zoetrix/ui/SunDialog.h"
#include "zoetrix/ui/TurnTableDialog.h"

#include <gtest/gtest.h>

#include <QComboBox>
#include <QDateEdit>
#include <QLineEdit>
#include <QMessageBox>
#include <QTest>
#include <QTimeEdit>

namespace quarn::desktop {
namespace {

using test::onceShown;
using test::part;
using Names = KM_ClassArray<KM_wString>;

Names names(std::initializer_list<const wchar_t*> texts) {
    Names list;
    for (const wchar_t* text : texts)
        list.Append(text);
    return list;
}

SessionOptions optionsOfTheSources() {
    const std::filesystem::path sources = QUARN_SOURCE_DIR;
    SessionOptions options;
    options.language = "C";
    options.locale_folders = {sources / "zoetrix" / "locale"};
    options.dialog_folders = {sources / "zoetrix" / "dialogs"};
    return options;
}

FrontEndParts dialogParts() {
    FrontEndParts parts;
    parts.make_dialog = makeFormWindow;
    parts.show_message = showMessageBox;
    parts.choose_place = askPlace;
    return parts;
}

/// The plug-in's own forms in the window's own dialogs.
class PlugInFormsTest : public testing::Test {
protected:
    PlugInFormsTest() { m_front_end.setParts(dialogParts()); }

    /// Shows the dialog to a person who does this in its form. @return what DoModal returned
    static int show(CDialog& dialog, std::function<void(QWidget&)> act) {
        onceShown(QString("form%1").arg(dialog.TemplateId()), std::move(act));
        return dialog.DoModal();
    }
    static void type(QWidget& form, int control, const char* text) {
        auto& field = part<QLineEdit>(form, QString("control%1").arg(control));
        field.setFocus();
        field.selectAll();
        QTest::keyClicks(&field, text);
    }
    static void pick(QWidget& form, int control, int index) {
        part<QComboBox>(form, QString("control%1").arg(control)).setCurrentIndex(index);
    }
    static int shownEntry(QWidget& form, int control) {
        return part<QComboBox>(form, QString("control%1").arg(control)).currentIndex();
    }
    static void press(QWidget& form, const QString& button) {
        QTest::mouseClick(&part(form, button), Qt::LeftButton);
    }
    /// Presses OK with what is to be refused. The field has the keyboard then, its text selected.
    static void expectRefusal(QWidget& form, int control, const char* text, const QString& why) {
        type(form, control, text);
        bool was_told = false;
        onceShown("message", [&](QWidget& box) {
            was_told = true;
            EXPECT_EQ(dynamic_cast<QMessageBox&>(box).text(), why);
            QTest::mouseClick(&part(box, "ok"), Qt::LeftButton);
        });
        press(form, "ok");
        EXPECT_TRUE(was_told);
        EXPECT_TRUE(form.isVisible());
        auto& field = part<QLineEdit>(form, QString("control%1").arg(control));
        EXPECT_EQ(form.focusWidget(), &field);
        EXPECT_EQ(field.selectedText(), text);
    }

    template <class Dialog> Dialog sunDialog() {
        return {48.14,
                11.58,
                15.0,
                COleDateTime(2026, 6, 21, 0, 0, 0),
                COleDateTime(2026, 6, 21, 6, 0, 0),
                COleDateTime(2026, 6, 21, 20, 0, 0),
                L"note",
                names({L"png", L"jpg", L"bmp"}),
                1,
                names({L"Wireframe", L"Rendered"}),
                1,
                names({L"Top", L"Front", L"Right", L"Perspective", L"Garden"}),
                2,
                30,
                nullptr};
    }

    DesktopFrontEnd m_front_end;
    Session m_session{m_front_end, optionsOfTheSources()};
};

CTurnTableDialog turntable(int viewport_selection) {
    return {100,
            L"Turntable",
            names({L"CounterClockwise", L"Clockwise"}),
            1,
            names({L"png", L"jpg"}),
            1,
            names({L"Wireframe", L"Rendered"}),
            0,
            names({L"Top", L"Front", L"Right", L"Perspective"}),
            viewport_selection,
            nullptr};
}

TEST_F(PlugInFormsTest, TurntableFormFillsEveryMember) {
    CTurnTableDialog dialog = turntable(1);
    const int result = show(dialog, [](QWidget& form) {
        EXPECT_EQ(part<QLineEdit>(form, "control6005").text(), "100");
        EXPECT_EQ(part<QLineEdit>(form, "control6009").text(), "Turntable");
        EXPECT_EQ(shownEntry(form, CTurnTableDialog::direction_id), 1);
        EXPECT_EQ(shownEntry(form, CTurnTableDialog::viewport_id), 1);
        type(form, CTurnTableDialog::frame_count_id, "36");
        type(form, CTurnTableDialog::name_id, "Round the house");
        pick(form, CTurnTableDialog::direction_id, 0);
        pick(form, CTurnTableDialog::file_type_id, 0);
        pick(form, CTurnTableDialog::capture_id, 1);
        pick(form, CTurnTableDialog::viewport_id, 3);
        QTest::keyClick(&part(form, "control6009"), Qt::Key_Return);
    });
    EXPECT_EQ(result, 1);
    EXPECT_EQ(dialog.m_frame_count, 36);
    EXPECT_EQ(dialog.m_name.View(), L"Round the house");
    EXPECT_EQ(dialog.m_direction.m_selection, 0);
    EXPECT_EQ(dialog.m_file_type.m_selection, 0);
    EXPECT_EQ(dialog.m_capture.m_selection, 1);
    EXPECT_EQ(dialog.m_viewport.m_selection, 3);
}

TEST_F(PlugInFormsTest, TurntableFormMeasuresItsViewportAgainstTheFileTypes) {
    CTurnTableDialog dialog = turntable(3);
    show(dialog, [](QWidget& form) {
        EXPECT_EQ(shownEntry(form, CTurnTableDialog::viewport_id), 0);
        press(form, "ok");
    });
    EXPECT_EQ(dialog.m_viewport.m_selection, 0);
}

TEST_F(PlugInFormsTest, TurntableFormRefusesAFrameCountThatIsNoWholeNumber) {
    CTurnTableDialog dialog = turntable(0);
    const int result = show(dialog, [](QWidget& form) {
        for (const char* text : {"many", "1.5", "99999999999"})
            expectRefusal(form, CTurnTableDialog::frame_count_id, text, "Enter a whole number");
        press(form, "cancel");
    });
    EXPECT_EQ(result, 2);
    EXPECT_EQ(dialog.m_frame_count, 100);
}

TEST_F(PlugInFormsTest, FormsThatAreGivenUpChangeNothing) {
    const std::function<void(QWidget&)> ways[] = {
        [](QWidget& form) { press(form, "cancel"); },
        [](QWidget& form) { QTest::keyClick(&form, Qt::Key_Escape); },
        [](QWidget& form) { form.close(); }};
    for (const auto& way : ways) {
        CTurnTableDialog dialog = turntable(1);
        const int result = show(dialog, [&](QWidget& form) {
            type(form, CTurnTableDialog::frame_count_id, "7");
            pick(form, CTurnTableDialog::capture_id, 1);
            way(form);
        });
        EXPECT_EQ(result, 2);
        EXPECT_EQ(dialog.m_frame_count, 100);
        EXPECT_EQ(dialog.m_capture.m_selection, 0);
    }
}

TEST_F(PlugInFormsTest, PathFormFillsEveryMember) {
    CPathAnimationDialog dialog(100, L"Walk", names({L"png", L"jpg"}), 0,
                                names({L"Wireframe", L"Rendered"}), 0,
                                names({L"Top", L"Perspective"}), 1, nullptr);
    const int result = show(dialog, [](QWidget& form) {
        type(form, CPathAnimationDialog::frame_count_id, "250");
        type(form, CPathAnimationDialog::name_id, "Evening walk");
        pick(form, CPathAnimationDialog::file_type_id, 1);
        pick(form, CPathAnimationDialog::capture_id, 1);
        pick(form, CPathAnimationDialog::viewport_id, 0);
        press(form, "ok");
    });
    EXPECT_EQ(result, 1);
    EXPECT_EQ(dialog.m_frame_count, 250);
    EXPECT_EQ(dialog.m_name.View(), L"Evening walk");
    EXPECT_EQ(dialog.m_file_type.m_selection, 1);
    EXPECT_EQ(dialog.m_capture.m_selection, 1);
    EXPECT_EQ(dialog.m_viewport.m_selection, 0);
}

TEST_F(PlugInFormsTest, OneDayFormFillsEveryMember) {
    auto dialog = sunDialog<CSunDialog>();
    const int result = show(dialog, [](QWidget& form) {
        EXPECT_EQ(shownEntry(form, CSunDialog::viewport_id), 2);
        type(form, CSunDialog::latitude_id, "-33,87");
        type(form, CSunDialog::longitude_id, "151.21");
        type(form, CSunDialog::north_angle_id, "360");
        part<QDateEdit>(form, "control6000").setDate(QDate(2026, 12, 21));
        part<QTimeEdit>(form, "control6001").setTime(QTime(5, 30));
        part<QTimeEdit>(form, "control6002").setTime(QTime(21, 15));
        type(form, CSunDialog::frame_step_id, "10");
        type(form, CSunDialog::text_id, "Sydney");
        pick(form, CSunDialog::file_type_id, 2);
        pick(form, CSunDialog::capture_id, 0);
        pick(form, CSunDialog::viewport_id, 4);
        press(form, "ok");
    });
    EXPECT_EQ(result, 1);
    EXPECT_DOUBLE_EQ(dialog.m_latitude, -33.87);
    EXPECT_DOUBLE_EQ(dialog.m_longitude, 151.21);
    EXPECT_DOUBLE_EQ(dialog.m_north_angle, 360);
    EXPECT_TRUE(dialog.m_first_date_time == COleDateTime(2026, 12, 21, 0, 0, 0));
    EXPECT_TRUE(dialog.m_second_date_time == COleDateTime(2026, 6, 21, 5, 30, 0));
    EXPECT_TRUE(dialog.m_third_date_time == COleDateTime(2026, 6, 21, 21, 15, 0));
    EXPECT_EQ(dialog.m_frame_step, 10);
    EXPECT_EQ(dialog.m_text.View(), L"Sydney");
    EXPECT_EQ(dialog.m_file_type.m_selection, 2);
    EXPECT_EQ(dialog.m_capture.m_selection, 0);
    EXPECT_EQ(dialog.m_viewport.m_selection, 4);
}

TEST_F(PlugInFormsTest, OneDayFormRefusesWhatIsOutOfRangeAndTakesTheLimits) {
    auto dialog = sunDialog<CSunDialog>();
    const int result = show(dialog, [](QWidget& form) {
        expectRefusal(form, CSunDialog::latitude_id, "90.5", "Enter a number between -90 and 90");
        expectRefusal(form, CSunDialog::latitude_id, "north", "Enter a number");
        type(form, CSunDialog::latitude_id, "-90");
        expectRefusal(form, CSunDialog::longitude_id, "180.01",
                      "Enter a number between -180 and 180");
        type(form, CSunDialog::longitude_id, "-180");
        expectRefusal(form, CSunDialog::north_angle_id, "-1", "Enter a number between 0 and 360");
        type(form, CSunDialog::north_angle_id, "0");
        expectRefusal(form, CSunDialog::frame_step_id, "x", "Enter a whole number");
        type(form, CSunDialog::frame_step_id, "15");
        press(form, "ok");
    });
    EXPECT_EQ(result, 1);
    EXPECT_DOUBLE_EQ(dialog.m_latitude, -90);
    EXPECT_DOUBLE_EQ(dialog.m_longitude, -180);
    EXPECT_DOUBLE_EQ(dialog.m_north_angle, 0);
}

TEST_F(PlugInFormsTest, LocationButtonFillsTheFieldsWithWhatWasChosen) {
    auto dialog = sunDialog<CSunDialog>();
    show(dialog, [&](QWidget& form) {
        onceShown("location", [](QWidget& window) {
            EXPECT_EQ(window.windowTitle(), "Set Animation Location");
            EXPECT_EQ(part<QLineEdit>(window, "latitude").text(), "48.14");
            const auto enter = [&](const char* name, const char* text) {
                auto& field = part<QLineEdit>(window, name);
                field.selectAll();
                QTest::keyClicks(&field, text);
            };
            enter("latitude", "12.3456");
            enter("longitude", "-65.4321");
            press(window, "ok");
        });
        press(form, "control6015");
        EXPECT_EQ(part<QLineEdit>(form, "control6004").text(), "12.35");
        EXPECT_EQ(part<QLineEdit>(form, "control6005").text(), "-65.43");
        EXPECT_DOUBLE_EQ(dialog.m_latitude, 12.3456);
        press(form, "ok");
    });
    EXPECT_DOUBLE_EQ(dialog.m_latitude, 12.35);
    EXPECT_DOUBLE_EQ(dialog.m_longitude, -65.43);
}

TEST_F(PlugInFormsTest, LocationThatIsGivenUpLeavesTheFieldsAsTheyAre) {
    auto dialog = sunDialog<CSunDialog>();
    show(dialog, [](QWidget& form) {
        type(form, CSunDialog::latitude_id, "1.5");
        onceShown("location", [](QWidget& window) { press(window, "cancel"); });
        press(form, "control6015");
        EXPECT_EQ(part<QLineEdit>(form, "control6004").text(), "1.5");
        press(form, "cancel");
    });
    EXPECT_DOUBLE_EQ(dialog.m_latitude, 48.14);
}

TEST_F(PlugInFormsTest, SeasonFormFillsItsDatesAndTheTimeOfDay) {
    auto dialog = sunDialog<CSeasonDialog>();
    const int result = show(dialog, [](QWidget& form) {
        part<QDateEdit>(form, "control6000").setDate(QDate(2026, 3, 20));
        part<QDateEdit>(form, "control6001").setDate(QDate(2026, 9, 23));
        part<QTimeEdit>(form, "control6002").setTime(QTime(12, 0));
        type(form, CSeasonDialog::frame_step_id, "7");
        press(form, "ok");
    });
    EXPECT_EQ(result, 1);
    EXPECT_TRUE(dialog.m_first_date_time == COleDateTime(2026, 3, 20, 0, 0, 0));
    EXPECT_TRUE(dialog.m_second_date_time == COleDateTime(2026, 9, 23, 6, 0, 0));
    EXPECT_TRUE(dialog.m_third_date_time == COleDateTime(2026, 6, 21, 12, 0, 0));
    EXPECT_EQ(dialog.m_frame_step, 7);
}

TEST_F(PlugInFormsTest, SecondDialogIsNotShownWhileOneIsOpen) {
    auto dialog = sunDialog<CSunDialog>();
    int second_result = 0;
    const int result = show(dialog, [&](QWidget& form) {
        CTurnTableDialog second = turntable(0);
        onceShown("message", [](QWidget& box) { box.close(); });
        second_result = second.DoModal();
        EXPECT_TRUE(form.isVisible());
        press(form, "ok");
    });
    EXPECT_EQ(second_result, -1);
    EXPECT_EQ(result, 1);
}

} // namespace
} // namespace quarn::desktop
