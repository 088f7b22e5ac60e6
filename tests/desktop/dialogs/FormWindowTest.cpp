#include "desktop/dialogs/FormWindow.h"
#include "desktop/dialogs/FieldMark.h"
#include "desktop/dialogs/LocationDialog.h"
#include "tests/desktop/dialogs/DialogDriver.h"

#include <gtest/gtest.h>

#include <QComboBox>
#include <QDateEdit>
#include <QLabel>
#include <QLineEdit>
#include <QLocale>
#include <QPushButton>
#include <QTest>
#include <QTimeEdit>

#include <vector>

namespace quarn::desktop {
namespace {

using Kind = DialogControl::Kind;
using test::onceShown;
using test::part;

/// A form with every kind of control.
DialogTemplate everyKind() {
    return {7001,
            L"Every kind",
            {{1, Kind::number, L"Latitude", L"Degrees", false},
             {2, Kind::button, L"Set Location...", L"", true},
             {3, Kind::integer, L"Frames", L"", false},
             {4, Kind::date, L"Day", L"", false},
             {5, Kind::time, L"Time", L"", true},
             {6, Kind::combo_box, L"File type", L"", false},
             {7, Kind::text, L"Name & title", L"", false}}};
}

/// What the window told, and what a dialog would do about it.
class Told final : public DialogEvents {
public:
    explicit Told(DialogWindow& window) : m_window(window) {}

    void confirmed() override {
        ++confirmations;
        if (takes_values)
            m_window.close();
    }
    void givenUp() override {
        ++refusals;
        m_window.close();
    }
    void buttonClicked(int control) override {
        clicked.push_back(control);
        if (when_clicked)
            when_clicked();
    }

    int confirmations = 0;
    int refusals = 0;
    std::vector<int> clicked;
    bool takes_values = true;
    std::function<void()> when_clicked;

private:
    DialogWindow& m_window;
};

class FormWindowTest : public testing::Test {
protected:
    /// Runs the form while a person does something in it.
    void run(std::function<void(QWidget&)> act) {
        onceShown("form7001", std::move(act));
        m_window->run(m_told);
    }

    static void press(QWidget& form, const char* button) {
        QTest::mouseClick(&part(form, button), Qt::LeftButton);
    }

    QWidget m_owner;
    std::unique_ptr<DialogWindow> m_window = makeFormWindow(everyKind(), &m_owner);
    Told m_told{*m_window};
};

TEST_F(FormWindowTest, HasEveryControlOfTheTemplateAndNoOther) {
    for (int control = 1; control <= 7; ++control)
        EXPECT_TRUE(m_window->hasControl(control)) << control;
    EXPECT_FALSE(m_window->hasControl(8));
    EXPECT_EQ(m_window->text(8), L"");
    EXPECT_FALSE(m_window->dateTime(8).IsValid());
    EXPECT_EQ(m_window->comboBox(8), nullptr);
    EXPECT_EQ(m_window->comboBox(1), nullptr);
    m_window->setText(8, L"nothing happens");
    m_window->focus(8);
}

TEST_F(FormWindowTest, ShowsWhatIsWrittenAndReadsWhatIsTyped) {
    m_window->setText(1, L"48.14");
    m_window->setText(7, L"Walk");
    run([&](QWidget& form) {
        EXPECT_EQ(form.windowTitle(), "Every kind");
        EXPECT_EQ(part<QLineEdit>(form, "control1").text(), "48.14");
        auto& name = part<QLineEdit>(form, "control7");
        name.setFocus();
        name.selectAll();
        QTest::keyClicks(&name, "Evening");
        press(form, "ok");
    });
    EXPECT_EQ(m_window->text(7), L"Evening");
    EXPECT_EQ(m_told.confirmations, 1);
    EXPECT_EQ(m_told.refusals, 0);
}

TEST(FormWindow, ShowsLabelsAndHintsAsTheyAreWrittenAndNotAsPages) {
    const auto window = makeFormWindow(
        {7002, L"Hints", {{1, Kind::text, L"<b>Name</b>", L"<img src=a>", false}}}, nullptr);
    Told told(*window);
    onceShown("form7002", [&](QWidget& form) {
        const auto labels = form.findChildren<QLabel*>();
        ASSERT_EQ(labels.size(), 1);
        EXPECT_EQ(labels[0]->textFormat(), Qt::PlainText);
        EXPECT_TRUE(labels[0]->toolTip().contains("&lt;img src=a&gt;"));
        EXPECT_TRUE(part(form, "control1").toolTip().contains("&lt;img src=a&gt;"));
        form.close();
    });
    window->run(told);
}

TEST_F(FormWindowTest, EnterConfirmsFromAnyField) {
    for (const char* control :
         {"control1", "control3", "control4", "control5", "control6", "control7"}) {
        run([&](QWidget& form) {
            QWidget& field = part(form, control);
            field.setFocus();
            QTest::keyClick(&field, Qt::Key_Return);
        });
    }
    EXPECT_EQ(m_told.confirmations, 6);
    EXPECT_EQ(m_told.refusals, 0);
}

TEST_F(FormWindowTest, EscapeCancelAndTheWindowsOwnButtonGiveUp) {
    run([](QWidget& form) { QTest::keyClick(&part(form, "control1"), Qt::Key_Escape); });
    EXPECT_EQ(m_told.refusals, 1);
    run([](QWidget& form) { press(form, "cancel"); });
    EXPECT_EQ(m_told.refusals, 2);
    run([](QWidget& form) { form.close(); });
    EXPECT_EQ(m_told.refusals, 3);
    EXPECT_EQ(m_told.confirmations, 0);
}

TEST_F(FormWindowTest, StaysOpenWhenTheDialogRefusesWhatWasTyped) {
    m_told.takes_values = false;
    run([&](QWidget& form) {
        press(form, "ok");
        EXPECT_TRUE(form.isVisible());
        m_told.takes_values = true;
        press(form, "ok");
        EXPECT_FALSE(form.isVisible());
    });
    EXPECT_EQ(m_told.confirmations, 2);
}

TEST_F(FormWindowTest, TellsWhichButtonWasClicked) {
    run([&](QWidget& form) {
        EXPECT_EQ(part<QPushButton>(form, "control2").text().remove('&'), "Set Location...");
        press(form, "control2");
        EXPECT_TRUE(form.isVisible());
        press(form, "ok");
    });
    EXPECT_EQ(m_told.clicked, std::vector<int>{2});
}

TEST_F(FormWindowTest, CanBeClosedOutOfAButton) {
    m_told.when_clicked = [&] { m_window->close(); };
    run([&](QWidget& form) { press(form, "control2"); });
    EXPECT_EQ(m_told.confirmations + m_told.refusals, 0);
}

TEST_F(FormWindowTest, DoesNotRunWhenItWasClosedBefore) {
    m_window->close();
    m_window->run(m_told);
    EXPECT_EQ(m_told.confirmations + m_told.refusals, 0);
}

TEST_F(FormWindowTest, ButtonThatJoinsARowStandsBesideItsField) {
    run([&](QWidget& form) {
        const QWidget& field = part(form, "control1");
        const QWidget& button = part(form, "control2");
        EXPECT_GT(button.x(), field.geometry().right());
        EXPECT_LT(std::abs(button.geometry().center().y() - field.geometry().center().y()), 4);
        EXPECT_GT(part(form, "control3").y(), field.geometry().bottom());
        press(form, "ok");
    });
}

TEST_F(FormWindowTest, TabGoesThroughTheControlsInTheirOrderAndThenToTheButtons) {
    run([&](QWidget& form) {
        std::vector<QString> order;
        EXPECT_EQ(form.focusWidget()->objectName(), "control1");
        // A date and a time take several steps, one for each of their parts.
        for (int step = 0; step < 25; ++step) {
            order.push_back(form.focusWidget()->objectName());
            QTest::keyClick(form.focusWidget(), Qt::Key_Tab);
        }
        EXPECT_EQ(order[1], "control2");
        EXPECT_EQ(order[2], "control3");
        const auto at = [&](const char* name) {
            return std::ranges::find(order, name) - order.begin();
        };
        EXPECT_LT(at("control3"), at("control4"));
        EXPECT_LT(at("control6"), at("control7"));
        EXPECT_LT(at("control7"), at("ok"));
        EXPECT_LT(at("ok"), at("cancel"));
        press(form, "ok");
    });
}

TEST_F(FormWindowTest, LabelsBelongToTheirControlsAndHaveAKeyEach) {
    run([&](QWidget& form) {
        QString keys;
        for (const QLabel* label : form.findChildren<QLabel*>()) {
            if (!label->buddy())
                continue;
            const QKeySequence key = QKeySequence::mnemonic(label->text());
            EXPECT_FALSE(key.isEmpty()) << label->text().toStdString();
            EXPECT_FALSE(keys.contains(key.toString() + ";")) << label->text().toStdString();
            keys += key.toString() + ";";
        }
        EXPECT_EQ(keys.count(';'), 6);
        EXPECT_EQ(part(form, "control1").toolTip(), "Degrees");
        EXPECT_EQ(part(form, "control7").accessibleName(), "Name & title");
        press(form, "ok");
    });
}

TEST_F(FormWindowTest, MarksFieldsWhoseTextIsPlainlyNoNumber) {
    run([&](QWidget& form) {
        const struct {
            const char* control;
            const char* text;
            bool is_marked;
        } examples[] = {{"control1", "48.14", false}, {"control1", "48,14", false},
                        {"control1", "north", true},  {"control1", "-.5", false},
                        {"control1", "1.2.3", true},  {"control1", "", false},
                        {"control3", "120", false},   {"control3", "-3", false},
                        {"control3", "1.5", true},    {"control3", "x", true}};
        for (const auto& example : examples) {
            auto& field = part<QLineEdit>(form, example.control);
            field.setText(example.text);
            EXPECT_EQ(isMarked(field), example.is_marked) << example.text;
        }
        press(form, "ok");
    });
    EXPECT_EQ(m_told.confirmations, 1);
}

TEST_F(FormWindowTest, FocusGivesTheKeyboardWithTheTextSelected) {
    m_window->setText(7, L"Walk");
    run([&](QWidget& form) {
        m_window->focus(7);
        EXPECT_EQ(form.focusWidget()->objectName(), "control7");
        EXPECT_EQ(part<QLineEdit>(form, "control7").selectedText(), "Walk");
        press(form, "ok");
    });
}

TEST_F(FormWindowTest, DateAndTimeKeepThePartThatTheyDoNotShow) {
    m_window->setDateTime(4, COleDateTime(2026, 6, 21, 14, 30, 15));
    m_window->setDateTime(5, COleDateTime(2026, 6, 21, 6, 5, 0));
    run([&](QWidget& form) {
        part<QDateEdit>(form, "control4").setDate(QDate(2024, 2, 29));
        part<QTimeEdit>(form, "control5").setTime(QTime(20, 45));
        press(form, "ok");
    });
    EXPECT_TRUE(m_window->dateTime(4) == COleDateTime(2024, 2, 29, 14, 30, 15));
    EXPECT_TRUE(m_window->dateTime(5) == COleDateTime(2026, 6, 21, 20, 45, 0));
}

TEST_F(FormWindowTest, DatesOfAllYearsAreTakenAndNoneThatNoCalendarHas) {
    for (const int year : {1, 1066, 1582, 9999}) {
        m_window->setDateTime(4, COleDateTime(year, 12, 31, 0, 0, 0));
        EXPECT_EQ(m_window->dateTime(4).GetYear(), year);
    }
    m_window->setDateTime(4, COleDateTime(2026, 4, 31, 0, 0, 0));
    EXPECT_EQ(m_window->dateTime(4).GetYear(), 9999);
    EXPECT_TRUE(m_window->dateTime(4).IsValid());
}

TEST_F(FormWindowTest, ShowsSecondsOnlyWhereThereAreAny) {
    const auto shown = [&] {
        QString text;
        run([&](QWidget& form) {
            text = part<QTimeEdit>(form, "control5").text();
            press(form, "ok");
        });
        return text;
    };
    m_window->setDateTime(5, COleDateTime(2026, 6, 21, 6, 5, 0));
    EXPECT_EQ(shown().count(':'), 1);
    m_window->setDateTime(5, COleDateTime(2026, 6, 21, 6, 5, 7));
    EXPECT_TRUE(shown().contains(":07"));
}

TEST_F(FormWindowTest, ComboBoxIsFilledAndReadThroughItsList) {
    const auto list = m_window->comboBox(6);
    ASSERT_NE(list, nullptr);
    list->Insert(0, L"png");
    list->Insert(0, L"jpg");
    EXPECT_EQ(list->Count(), 2);
    EXPECT_EQ(list->Selection(), -1);
    list->Select(1);
    run([&](QWidget& form) {
        auto& box = part<QComboBox>(form, "control6");
        EXPECT_EQ(box.currentText(), "png");
        box.setFocus();
        QTest::keyClick(&box, Qt::Key_Up);
        press(form, "ok");
    });
    EXPECT_EQ(list->Selection(), 0);
    list->Select(9);
    EXPECT_EQ(list->Selection(), -1);
    list->Reset();
    EXPECT_EQ(list->Count(), 0);
}

TEST_F(FormWindowTest, ListOutlivesItsWindowWithoutHarm) {
    const auto list = m_window->comboBox(6);
    list->Insert(0, L"png");
    m_window.reset();
    EXPECT_EQ(list->Count(), 0);
    EXPECT_EQ(list->Selection(), -1);
    list->Insert(0, L"jpg");
    list->Select(0);
    list->Reset();
}

TEST(FormWindow, OwnerThatIsDestroyedGivesTheDialogUp) {
    auto owner = std::make_unique<QWidget>();
    const auto window = makeFormWindow(everyKind(), owner.get());
    Told told(*window);
    onceShown("form7001", [&](QWidget&) { owner.reset(); });
    window->run(told);
    EXPECT_EQ(told.refusals, 1);
    EXPECT_FALSE(window->hasControl(1));
    EXPECT_EQ(window->text(1), L"");
}

TEST_F(FormWindowTest, SecondFormOpensBeforeTheFirstAndBothAreAnswered) {
    DialogTemplate second_form = everyKind();
    second_form.id = 7002;
    m_told.when_clicked = [&] {
        const auto second = makeFormWindow(second_form, &m_owner);
        Told told(*second);
        onceShown("form7002", [](QWidget& form) { press(form, "cancel"); });
        second->run(told);
        EXPECT_EQ(told.refusals, 1);
    };
    run([&](QWidget& form) {
        press(form, "control2");
        EXPECT_TRUE(form.isVisible());
        press(form, "ok");
    });
    EXPECT_EQ(m_told.confirmations, 1);
}

TEST_F(FormWindowTest, PlaceIsChosenBeforeTheFormAndWrittenIntoItsField) {
    m_window->setText(1, L"48.14");
    std::vector<std::optional<Place>> chosen;
    m_told.when_clicked = [&] {
        chosen.push_back(askPlace(&m_owner, L"Set Animation Location", {48.14, 11.58}));
        if (chosen.back())
            m_window->setText(1, L"12.35");
    };
    run([&](QWidget& form) {
        onceShown("location", [](QWidget& picker) { press(picker, "cancel"); });
        press(form, "control2");
        EXPECT_EQ(part<QLineEdit>(form, "control1").text(), "48.14");
        onceShown("location", [](QWidget& picker) {
            auto& latitude = part<QLineEdit>(picker, "latitude");
            EXPECT_EQ(latitude.text(), "48.14");
            latitude.setFocus();
            latitude.selectAll();
            QTest::keyClicks(&latitude, "12.3456");
            press(picker, "ok");
        });
        press(form, "control2");
        EXPECT_TRUE(form.isVisible());
        EXPECT_EQ(part<QLineEdit>(form, "control1").text(), "12.35");
        press(form, "ok");
    });
    ASSERT_EQ(chosen.size(), 2U);
    EXPECT_FALSE(chosen[0]);
    ASSERT_TRUE(chosen[1]);
    EXPECT_EQ(chosen[1]->latitude_deg, 12.3456);
    EXPECT_EQ(m_told.confirmations, 1);
}

TEST_F(FormWindowTest, RunsWhileTheOwnerWaitsInALoopOfItsOwn) {
    QEventLoop outer;
    QTimer::singleShot(0, &outer, [&] {
        run([](QWidget& form) { press(form, "ok"); });
        outer.quit();
    });
    outer.exec();
    EXPECT_EQ(m_told.confirmations, 1);
}

} // namespace
} // namespace quarn::desktop
