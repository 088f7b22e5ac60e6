#include "tests/host/dialogs/DialogFixture.h"

#include "tests/host/border/BreachList.h"

#include <stdexcept>
#include <thread>

using namespace quarn;
using namespace quarn::test;
using testing::HasSubstr;

namespace {

class Dialog : public DialogTest {};
using Texts = std::vector<std::wstring>;

/// A window that tells of OK twice, and of its being closed, before it goes.
class EagerWindow final : public DialogWindow {
public:
    void run(DialogEvents& events) override {
        events.confirmed();
        events.confirmed();
        events.givenUp();
    }
    void close() override { ++closings; }
    bool hasControl(int) const override { return false; }
    std::wstring text(int) const override { return {}; }
    void setText(int, std::wstring_view) override {}
    COleDateTime dateTime(int) const override { return {}; }
    void setDateTime(int, const COleDateTime&) override {}
    std::unique_ptr<IQnComboBoxControl> comboBox(int) override { return nullptr; }
    void focus(int) override {}

    int closings = 0;
};

/// A dialog of a class that has a record of its own.
class RecordedDialog : public SampleDialog {
public:
    static constexpr CQnRuntimeClass ClassRecord = {"RecordedDialog", &CQuarnDialog::ClassRecord};
    const CQnRuntimeClass* GetRuntimeClass() const override { return &ClassRecord; }
};

} // namespace

// ---- Showing

TEST_F(Dialog, ShowsItsMembersInTheControls) {
    show(sample, [](HeadlessDialogWindow& window) {
        EXPECT_EQ(L"Walk", window.text(text_id));
        EXPECT_EQ(L"12.5", window.text(number_id));
        EXPECT_EQ(L"24", window.text(integer_id));
        EXPECT_EQ(COleDateTime(2026, 6, 21, 4, 5, 6), window.dateTime(date_id));
        EXPECT_EQ(14, window.dateTime(time_id).GetHour());
        EXPECT_EQ(Texts({L"red", L"green", L"blue"}), window.entries(list_id));
        EXPECT_EQ(1, window.pickedEntry(list_id));
        EXPECT_EQ(text_id, window.focusedControl());
    });
    EXPECT_EQ(1, sample.inits);
}

TEST_F(Dialog, ConfirmedIsOneAndTheMembersHoldWhatWasEntered) {
    const int result = show(sample, [](HeadlessDialogWindow& window) {
        EXPECT_TRUE(window.type(text_id, L"Flight"));
        EXPECT_TRUE(window.type(number_id, L"-7.25"));
        EXPECT_TRUE(window.type(integer_id, L"120"));
        EXPECT_TRUE(window.choose(date_id, COleDateTime(2027, 2, 3, 0, 0, 0)));
        EXPECT_TRUE(window.choose(time_id, COleDateTime(2000, 1, 1, 6, 45, 0)));
        EXPECT_TRUE(window.pressOk());
        EXPECT_FALSE(window.isOpen());
    });
    EXPECT_EQ(1, result);
    EXPECT_EQ(L"Flight", sample.name.View());
    EXPECT_EQ(-7.25, sample.angle);
    EXPECT_EQ(120, sample.count);
    EXPECT_EQ(0, sample.give_ups);
    EXPECT_TRUE(front_end.messages().empty());
}

TEST_F(Dialog, CancelTheWindowsOwnButtonAndAnEndedScriptAreTwoAndKeepTheMembers) {
    const auto typeSomething = [](HeadlessDialogWindow& window) { window.type(text_id, L"x"); };
    EXPECT_EQ(2, show(sample, [&](HeadlessDialogWindow& window) {
                  typeSomething(window);
                  EXPECT_TRUE(window.pressCancel());
              }));
    EXPECT_EQ(2, show(sample, [&](HeadlessDialogWindow& window) {
                  typeSomething(window);
                  EXPECT_TRUE(window.pressClose());
              }));
    EXPECT_EQ(2, show(sample, typeSomething));
    EXPECT_EQ(3, sample.give_ups);
    EXPECT_EQ(L"Walk", sample.name.View());
}

TEST_F(Dialog, CanBeShownAgainAfterItWasClosed) {
    EXPECT_EQ(2, show(sample, [](HeadlessDialogWindow& window) { window.pressCancel(); }));
    EXPECT_EQ(1, show(sample, [](HeadlessDialogWindow& window) { window.pressOk(); }));
    EXPECT_EQ(2, sample.inits);
}

TEST_F(Dialog, WithoutAWindowIsMinusOneWithAMessage) {
    EXPECT_EQ(-1, sample.DoModal());
    EXPECT_EQ("The dialog \"Sample\" cannot be shown: there is no window here.\n", printed());
    EXPECT_EQ(0, sample.inits);
}

TEST_F(Dialog, WithoutATemplateIsMinusOneWithAMessageThatNamesTheFile) {
    std::filesystem::remove(folder / "7001.dialog.json");
    EXPECT_EQ(-1, sample.DoModal());
    EXPECT_THAT(printed(), HasSubstr("There is no dialog template 7001.dialog.json in "));
    EXPECT_THAT(printed(), HasSubstr(folder.path().string()));
}

TEST_F(Dialog, SecondOneWhileOneIsOpenIsRefusedWithAMessage) {
    SampleDialog second;
    int second_result = 0;
    EXPECT_EQ(1, show(sample, [&](HeadlessDialogWindow& window) {
                  second_result = second.DoModal();
                  EXPECT_EQ(-1, sample.DoModal()) << "it is open itself";
                  window.pressOk();
              }));
    EXPECT_EQ(-1, second_result);
    EXPECT_EQ(0, second.inits);
    EXPECT_EQ("Another dialog is open. Close it first.\n"
              "Another dialog is open. Close it first.\n",
              printed());
    EXPECT_EQ(2, show(second, nullptr)) << "the way is free again";
}

TEST_F(Dialog, CanBeEndedBeforeItIsShown) {
    sample.on_init = [](SampleDialog& dialog) { dialog.EndDialog(7); };
    bool was_shown = false;
    EXPECT_EQ(7, show(sample, [&](HeadlessDialogWindow&) { was_shown = true; }));
    EXPECT_FALSE(was_shown);
}

TEST_F(Dialog, FirstEndCounts) {
    sample.on_button = [](SampleDialog& dialog) {
        dialog.EndDialog(5);
        dialog.EndDialog(6);
    };
    EXPECT_EQ(5, show(sample, [](HeadlessDialogWindow& window) {
                  EXPECT_TRUE(window.click(button_id));
                  EXPECT_FALSE(window.pressOk()) << "it is closed";
              }));
}

TEST_F(Dialog, TellsItsButtonsById) {
    show(sample, [](HeadlessDialogWindow& window) {
        EXPECT_TRUE(window.click(button_id));
        EXPECT_TRUE(window.click(button_id));
        EXPECT_FALSE(window.click(text_id)) << "that is no button";
        EXPECT_TRUE(window.isOpen());
    });
    EXPECT_EQ(2, sample.buttons_clicked);
    EXPECT_EQ(button_id, sample.last_button);
}

TEST_F(Dialog, GivesComboBoxesTheirControlsOnlyWhileItIsOpen) {
    EXPECT_FALSE(sample.colours.HasControl());
    show(sample, [&](HeadlessDialogWindow& window) {
        EXPECT_TRUE(sample.colours.HasControl());
        EXPECT_TRUE(window.pick(list_id, 2));
        EXPECT_EQ(2, sample.colours.GetCurSel());
    });
    EXPECT_FALSE(sample.colours.HasControl());
    EXPECT_EQ(0, sample.colours.GetCount());
}

TEST_F(Dialog, KnowsItsParentAndItsTemplate) {
    CWnd parent;
    SampleDialog owned(&parent);
    EXPECT_EQ(&parent, owned.Parent());
    EXPECT_EQ(sample_form, owned.TemplateId());
    EXPECT_EQ(nullptr, sample.Parent());
    EXPECT_EQ(2, show(owned, nullptr));
}

// ---- What overridden operations throw

TEST_F(Dialog, ThatThrowsOnOkIsToldAndClosed) {
    sample.on_ok = [](SampleDialog&) { throw std::runtime_error("out of paint"); };
    EXPECT_EQ(-1, show(sample, [](HeadlessDialogWindow& window) {
        window.pressOk();
        EXPECT_FALSE(window.isOpen());
    }));
    EXPECT_EQ("OnOK of the dialog 7001 stopped with an error: out of paint.\n", printed());
    EXPECT_FALSE(sample.IsOpen());
}

TEST_F(Dialog, ThatThrowsWhileItIsFilledIsToldAndNotShown) {
    sample.on_init = [](SampleDialog&) { throw 7; };
    bool was_shown = false;
    EXPECT_EQ(-1, show(sample, [&](HeadlessDialogWindow&) { was_shown = true; }));
    EXPECT_FALSE(was_shown);
    EXPECT_THAT(printed(), HasSubstr("OnInitDialog of the dialog 7001 stopped with an error"));
}

TEST_F(Dialog, ThatThrowsForAButtonIsToldAndClosed) {
    sample.on_button = [](SampleDialog&) { throw std::runtime_error("stuck"); };
    EXPECT_EQ(-1, show(sample, [](HeadlessDialogWindow& window) { window.click(button_id); }));
    EXPECT_EQ("OnButton of the dialog 7001 stopped with an error: stuck.\n", printed());
}

// ---- Texts of controls

TEST_F(Dialog, ReadsAndWritesTheTextsOfItsControlsWhileItIsOpen) {
    show(sample, [&](HeadlessDialogWindow& window) {
        sample.SetDlgItemText(number_id, L"45.00");
        EXPECT_EQ(L"45.00", window.text(number_id));
        EXPECT_EQ(L"45.00", sample.GetDlgItemText(number_id).View());
        sample.SetDlgItemText(number_id, nullptr);
        EXPECT_EQ(L"", window.text(number_id));
        sample.SetDlgItemText(no_id, L"x");
        EXPECT_TRUE(sample.GetDlgItemText(no_id).IsEmpty());
    });
    sample.SetDlgItemText(number_id, L"1");
    EXPECT_TRUE(sample.GetDlgItemText(number_id).IsEmpty());
    EXPECT_EQ(12.5, sample.angle);
}

TEST_F(Dialog, ExchangesNothingWhileItIsClosed) {
    EXPECT_FALSE(sample.UpdateData(true));
    EXPECT_FALSE(sample.UpdateData(false));
    CQnDialogExchange exchange(sample, true);
    EXPECT_TRUE(exchange.HasFailed());
    EXPECT_FALSE(exchange.Window().hasControl(text_id));
    DDX_Text(exchange, text_id, sample.name);
    EXPECT_EQ(L"Walk", sample.name.View());
}

// ---- Windows of another making

TEST_F(Dialog, RunsInAWindowOfAnotherMaking) {
    DialogTemplate form;
    form.controls = {{text_id, DialogControl::Kind::text, L"Name", {}, false}};
    HeadlessDialogWindow window(form, [](HeadlessDialogWindow& shown) {
        shown.type(text_id, L"Flight");
        shown.pressOk();
    });
    EXPECT_EQ(1, sample.DoModalIn(window));
    EXPECT_EQ(L"Flight", sample.name.View());
    EXPECT_EQ(12.5, sample.angle) << "a control that is not there leaves its member alone";
    EXPECT_TRUE(front_end.dialogs().empty());
}

TEST_F(Dialog, InAWindowWithoutTheComboBoxKeepsTheControlThatItWasGiven) {
    DialogTemplate list_form;
    list_form.controls = {{list_id, DialogControl::Kind::combo_box, L"Colour", {}, false}};
    HeadlessDialogWindow elsewhere(list_form, nullptr);
    sample.colours.SetControl(elsewhere.comboBox(list_id));
    HeadlessDialogWindow window({}, [](HeadlessDialogWindow& shown) { shown.pressOk(); });
    EXPECT_EQ(1, sample.DoModalIn(window));
    EXPECT_TRUE(sample.colours.HasControl());
    EXPECT_EQ(Texts({L"red", L"green", L"blue"}), elsewhere.entries(list_id));
    sample.colours.SetControl(nullptr);
}

TEST_F(Dialog, HearsNothingMoreOfItsWindowOnceItIsClosed) {
    int confirmations = 0;
    sample.on_ok = [&](SampleDialog& dialog) {
        ++confirmations;
        dialog.EndDialog(1);
    };
    EagerWindow window;
    EXPECT_EQ(1, sample.DoModalIn(window));
    EXPECT_EQ(1, confirmations);
    EXPECT_EQ(0, sample.give_ups);
    EXPECT_EQ(1, window.closings);
}

TEST_F(Dialog, TakesTheTitleOfMessagesFromTheTemplateInAWindowOfAnotherMaking) {
    DialogTemplate form;
    form.controls = {{integer_id, DialogControl::Kind::integer, L"Count", {}, false}};
    HeadlessDialogWindow window(form, [](HeadlessDialogWindow& shown) {
        shown.type(integer_id, L"x");
        shown.pressOk();
    });
    EXPECT_EQ(2, sample.DoModalIn(window));
    ASSERT_EQ(1U, front_end.messages().size());
    EXPECT_EQ(L"Sample", front_end.messages()[0].title);
}

// ---- Classes at run time

TEST_F(Dialog, KnowsItsClassAndTheOnesItStandsOn) {
    const RecordedDialog recorded;
    EXPECT_STREQ("RecordedDialog", recorded.GetRuntimeClass()->m_class_name);
    EXPECT_TRUE(recorded.GetRuntimeClass()->IsDerivedFrom(RecordedDialog::ClassRecord));
    EXPECT_TRUE(recorded.GetRuntimeClass()->IsDerivedFrom(CQuarnDialog::ClassRecord));
    EXPECT_TRUE(recorded.GetRuntimeClass()->IsDerivedFrom(CDialog::ClassRecord));
    EXPECT_EQ(&CQuarnDialog::ClassRecord, sample.GetRuntimeClass());
    EXPECT_FALSE(sample.GetRuntimeClass()->IsDerivedFrom(RecordedDialog::ClassRecord));
    EXPECT_STREQ("CDialog", CDialog::ClassRecord.m_class_name);
    EXPECT_EQ(nullptr, sample.ControllerName());
}

TEST_F(Dialog, OfTheBaseClassShowsItsTemplateAndClosesByItself) {
    CDialog plain(sample_form, nullptr);
    EXPECT_EQ(&CDialog::ClassRecord, plain.GetRuntimeClass());
    EXPECT_EQ(1, show(plain, [](HeadlessDialogWindow& window) {
                  EXPECT_TRUE(window.click(button_id));
                  EXPECT_TRUE(window.isOpen());
                  window.pressOk();
              }));
}

// ---- Rules

TEST_F(Dialog, IsCalledOnTheMainThreadOnly) {
    BreachList breaches;
    front_end.addDialog(nullptr);
    std::thread elsewhere([this] {
        EXPECT_EQ(-1, sample.DoModal());
        EXPECT_FALSE(sample.UpdateData(true));
    });
    elsewhere.join();
    EXPECT_EQ((std::vector<std::string>{
                  "CDialog::DoModal: only the main thread may call it",
                  "CDialog::UpdateData: only the main thread may call it",
              }),
              breaches.take());
    EXPECT_TRUE(front_end.dialogs().empty());
}
