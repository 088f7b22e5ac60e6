#include "kelmar/KM_BinaryArchive.h"
#include "tests/vexui/VexUiFixture.h"

#include <QCloseEvent>
#include <QGroupBox>
#include <QMainWindow>
#include <QTimer>

#include <algorithm>
#include <set>

using testing::ElementsAre;
using testing::HasSubstr;

namespace {

class FormBehaviour : public VexUiFixture {
protected:
    FormBehaviour() { record.SetHtmlFilename(L"Walk"); }

    std::vector<QnZoetrixVexUiDialog> allDialogs() const {
        return {QnZoetrixVexUiTurnTable(), QnZoetrixVexUiPathAnimation(), QnZoetrixVexUiDay(),
                QnZoetrixVexUiSeason()};
    }
    void openEach(const Person& person) {
        for (const QnZoetrixVexUiDialog dialog : allDialogs())
            open(dialog, person);
    }
    /// Opens each form, changes everything in it, and gives it up in this way.
    void expectNothingChanges(const Person& give_up) {
        for (const QnZoetrixVexUiDialog dialog : allDialogs()) {
            const DialogLists lists_before = lists;
            const KM_3dmAnimationProperties before = record;
            EXPECT_FALSE(open(dialog, [&](QDialog& form) {
                changeAll(form);
                give_up(form);
            }));
            EXPECT_EQ(lists_before.files.selection, lists.files.selection);
            EXPECT_EQ(lists_before.captures.selection, lists.captures.selection);
            EXPECT_EQ(lists_before.viewports.selection, lists.viewports.selection);
            EXPECT_EQ(lists_before.directions.selection, lists.directions.selection);
            EXPECT_EQ(bytesOf(before), bytesOf(record));
        }
    }

private:
    static void changeAll(QDialog& form) {
        for (QSpinBox* spin : form.findChildren<QSpinBox*>())
            spin->setValue(77);
        for (QDateEdit* date : form.findChildren<QDateEdit*>())
            date->setDate({2030, 1, 2});
        for (QTimeEdit* time : form.findChildren<QTimeEdit*>())
            time->setTime({3, 4});
        for (QComboBox* box : form.findChildren<QComboBox*>())
            box->setCurrentIndex(0);
        for (const char* name : {"latitude", "longitude", "northAngle"})
            if (auto* number = form.findChild<QLineEdit*>(name))
                number->setText("1");
        field<QLineEdit>(form, "name").setText("Other");
    }
    static std::vector<std::uint8_t> bytesOf(const KM_3dmAnimationProperties& record) {
        KM_BinaryArchive archive = KM_BinaryArchive::ForWriting();
        EXPECT_TRUE(record.Write(archive));
        const auto bytes = archive.Bytes();
        return {bytes.begin(), bytes.end()};
    }
};

/// The names of the fields that Tab reaches, from the first on until it comes round. In a date or a
/// time it goes through the parts.
std::vector<std::string> tabOrder(QDialog& form) {
    std::vector<std::string> names;
    while (names.empty() || form.focusWidget()->objectName().toStdString() != names.front()) {
        names.push_back(form.focusWidget()->objectName().toStdString());
        QTest::keyClick(form.focusWidget(), Qt::Key_Tab);
    }
    names.erase(std::unique(names.begin(), names.end()), names.end());
    return names;
}

/// The letters that Alt reaches a field with.
std::vector<char16_t> mnemonics(QDialog& form) {
    std::vector<char16_t> letters;
    const auto add = [&](const QString& text) {
        const QKeySequence sequence = QKeySequence::mnemonic(text);
        if (!sequence.isEmpty())
            letters.push_back(static_cast<char16_t>(sequence[0].key()));
    };
    for (const QLabel* label : form.findChildren<QLabel*>())
        if (label->buddy())
            add(label->text());
    for (const QPushButton* button : form.findChildren<QPushButton*>())
        add(button->text());
    return letters;
}

class FormLanguages : public VexUiFixture, public testing::WithParamInterface<const char*> {
protected:
    FormLanguages() : VexUiFixture(GetParam()) {}
};

} // namespace

TEST_F(FormBehaviour, EscapeChangesNothing) {
    expectNothingChanges([](QDialog& form) { press(*form.focusWidget(), Qt::Key_Escape); });
}

TEST_F(FormBehaviour, CancelChangesNothing) {
    expectNothingChanges([](QDialog& form) { click(form, "cancel"); });
}

TEST_F(FormBehaviour, TheWindowButtonChangesNothing) {
    expectNothingChanges([](QDialog& form) {
        QCloseEvent event;
        QApplication::sendEvent(&form, &event);
    });
}

TEST_F(FormBehaviour, EnterConfirmsFromEveryField) {
    for (const QnZoetrixVexUiDialog dialog : allDialogs()) {
        std::vector<std::string> names;
        EXPECT_FALSE(open(dialog, [&](QDialog& form) {
            names = tabOrder(form);
            form.reject();
        }));
        for (const std::string& name : names) {
            if (name == "cancel")
                continue;
            EXPECT_TRUE(open(dialog, [&](QDialog& form) {
                QWidget& widget = field<QWidget>(form, name.c_str());
                widget.setFocus();
                press(widget, Qt::Key_Return);
            })) << name;
        }
    }
    EXPECT_TRUE(front_end.locationQuestions().empty());
}

TEST_F(FormBehaviour, TabReachesTheFieldsFromTopToBottom) {
    std::vector<std::string> order;
    const Person look = [&](QDialog& form) {
        order = tabOrder(form);
        form.reject();
    };
    openTurntable(look);
    EXPECT_THAT(order, ElementsAre("frames", "direction", "fileType", "captureMethod", "viewport",
                                   "name", "ok", "cancel"));
    openPath(look);
    EXPECT_THAT(order, ElementsAre("frames", "fileType", "captureMethod", "viewport", "name", "ok",
                                   "cancel"));
    openDay(look);
    EXPECT_THAT(order,
                ElementsAre("latitude", "longitude", "choosePlace", "northAngle", "clocks", "date",
                            "namedDay", "startTime", "endTime", "minutes", "fileType",
                            "captureMethod", "viewport", "name", "ok", "cancel"));
    openSeason(look);
    EXPECT_THAT(order, ElementsAre("latitude", "longitude", "choosePlace", "northAngle", "clocks",
                                   "startDate", "endDate", "timeOfDay", "days", "fileType",
                                   "captureMethod", "viewport", "name", "ok", "cancel"));
}

TEST_F(FormBehaviour, AltAndTheLetterOfALabelGoToItsField) {
    openTurntable([](QDialog& form) {
        QTest::keyClick(&form, Qt::Key_N, Qt::AltModifier);
        EXPECT_TRUE(field<QLineEdit>(form, "name").hasFocus());
        QTest::keyClick(&form, Qt::Key_D, Qt::AltModifier);
        EXPECT_TRUE(field<QComboBox>(form, "direction").hasFocus());
        form.reject();
    });
}

TEST_F(FormBehaviour, EveryFieldHasAToolTipANameAndALabel) {
    openEach([](QDialog& form) {
        std::set<QWidget*> labelled;
        for (const QLabel* label : form.findChildren<QLabel*>())
            labelled.insert(label->buddy());
        for (const std::string& name : tabOrder(form)) {
            QWidget& widget = field<QWidget>(form, name.c_str());
            EXPECT_FALSE(widget.toolTip().isEmpty()) << name;
            if (qobject_cast<QPushButton*>(&widget))
                continue;
            EXPECT_TRUE(labelled.contains(&widget)) << name;
            EXPECT_THAT(widget.accessibleName().toStdString(), testing::Not(HasSubstr("&")));
            EXPECT_FALSE(widget.accessibleName().isEmpty()) << name;
        }
        form.reject();
    });
}

TEST_F(FormBehaviour, AMarkedFieldSaysWhyAndItsToolTipComesBack) {
    openPath([](QDialog& form) {
        QWidget& frames = field<QWidget>(form, "frames");
        const QString tip = frames.toolTip();
        typeInto(form, "frames", "0");
        EXPECT_EQ("An animation has at least 1 frame.", frames.toolTip().toStdString());
        EXPECT_EQ("An animation has at least 1 frame.",
                  frames.accessibleDescription().toStdString());
        typeInto(form, "frames", "2");
        EXPECT_EQ(tip, frames.toolTip());
        EXPECT_TRUE(frames.accessibleDescription().isEmpty());
        form.reject();
    });
}

TEST_F(FormBehaviour, MarkedFieldsStayReadableOnADarkPalette) {
    const QPalette before = QApplication::palette();
    QPalette dark(QColor(45, 45, 48));
    dark.setColor(QPalette::Base, QColor(30, 30, 30));
    dark.setColor(QPalette::Text, Qt::white);
    dark.setColor(QPalette::WindowText, Qt::white);
    QApplication::setPalette(dark);
    openPath([](QDialog& form) {
        typeInto(form, "frames", "0");
        const QPalette marked = field<QWidget>(form, "frames").palette();
        EXPECT_GT(marked.color(QPalette::Base).red(), marked.color(QPalette::Base).blue() + 30);
        EXPECT_LT(marked.color(QPalette::Base).lightness(), 90);
        EXPECT_GT(marked.color(QPalette::Text).lightness(), 200);
        form.reject();
    });
    QApplication::setPalette(before);
}

TEST_F(FormBehaviour, ASecondFormIsRefusedWhileOneIsOpen) {
    DialogLists others = lists;
    KM_3dmAnimationProperties other = record;
    EXPECT_TRUE(openTurntable([&](QDialog& form) {
        for (const QnZoetrixVexUiDialog dialog : allDialogs()) {
            front_end.clearPrinted();
            QObject during_the_call;
            QTimer::singleShot(0, &during_the_call, [] {
                ADD_FAILURE() << "a second form waits for its answer";
                QApplication::activeModalWidget()->close();
            });
            EXPECT_FALSE(dialog(others, other));
            EXPECT_EQ(L"The form of another animation is open. Close it first. Nothing done\n",
                      printed());
        }
        EXPECT_TRUE(form.isVisible());
        form.accept();
    }));
    EXPECT_TRUE(openTurntable([](QDialog& form) { form.accept(); }));
}

TEST_F(FormBehaviour, TheFormStandsBeforeItsOwner) {
    QMainWindow owner;
    QWidget inner(&owner);
    for (QWidget* window : {static_cast<QWidget*>(&owner), &inner}) {
        lists.parent = window;
        openEach([&](QDialog& form) {
            EXPECT_EQ(&owner, form.parentWidget());
            EXPECT_TRUE(form.isModal());
            form.reject();
        });
    }
}

TEST_F(FormBehaviour, AWindowThatIsNoWidgetIsNoOwner) {
    int something_else = 0;
    lists.parent = reinterpret_cast<QWidget*>(&something_else);
    openEach([](QDialog& form) {
        EXPECT_EQ(nullptr, form.parentWidget());
        form.reject();
    });
}

TEST_F(FormBehaviour, AnOwnerThatGoesTakesItsFormAlong) {
    auto owner = std::make_unique<QMainWindow>();
    lists.parent = owner.get();
    EXPECT_FALSE(openTurntable([&](QDialog&) { owner.reset(); }));
    EXPECT_EQ(36, record.FrameCount());
    lists.parent = nullptr;
    EXPECT_TRUE(openTurntable([](QDialog& form) { form.accept(); }));
}

TEST_F(FormBehaviour, AFormGrowsAndShrinksWithinItsBounds) {
    openEach([](QDialog& form) {
        const int height = form.height();
        const int width = form.width();
        const int name_width = field<QLineEdit>(form, "name").width();
        form.resize(width + 300, height + 200);
        QTest::qWait(10);
        EXPECT_EQ(width + 300, form.width());
        EXPECT_GT(field<QLineEdit>(form, "name").width(), name_width + 100);
        form.resize(10, 10);
        QTest::qWait(10);
        EXPECT_GE(form.width(), 460);
        EXPECT_LE(form.width(), width);
        EXPECT_LE(form.height(), height);
        form.reject();
    });
}

TEST_P(FormLanguages, EveryFormSpeaksTheLanguageAndItsLettersAreItsOwn) {
    std::vector<std::string> english;
    for (const QnZoetrixVexUiDialog dialog :
         {QnZoetrixVexUiTurnTable(), QnZoetrixVexUiPathAnimation(), QnZoetrixVexUiDay(),
          QnZoetrixVexUiSeason()}) {
        open(dialog, [](QDialog& form) {
            const auto letters = mnemonics(form);
            const std::set<char16_t> different(letters.begin(), letters.end());
            EXPECT_EQ(letters.size(), different.size()) << form.windowTitle().toStdString();
            const auto labels = form.findChildren<QLabel*>();
            const auto labelled = std::ranges::count_if(
                labels, [](const QLabel* label) { return label->buddy() != nullptr; });
            EXPECT_GE(static_cast<long>(letters.size()), labelled);
            form.reject();
        });
    }
}

INSTANTIATE_TEST_SUITE_P(All, FormLanguages, testing::Values("C", "de", "es", "fr", "ja", "zh"));

TEST_F(FormBehaviour, AGermanFormIsGerman) {
    start("de");
    openTurntable([](QDialog& form) {
        EXPECT_EQ("Drehteller-Animation", form.windowTitle().toStdString());
        EXPECT_EQ("Abbrechen", field<QPushButton>(form, "cancel").text().toStdString());
        EXPECT_EQ("36 Bilder; die Kamera dreht sich von einem zum nächsten um etwa 10°.",
                  lineOf(form));
        EXPECT_EQ("Bilder", field<QWidget>(form, "frames").accessibleName().toStdString());
        form.reject();
    });
}

TEST_F(FormBehaviour, AJapaneseFieldIsCalledWithoutItsLetter) {
    start("ja");
    openPath([](QDialog& form) {
        EXPECT_EQ("フレーム数", field<QWidget>(form, "frames").accessibleName().toStdString());
        form.reject();
    });
}
