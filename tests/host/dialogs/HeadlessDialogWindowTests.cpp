#include "tests/host/dialogs/DialogFixture.h"

using namespace quarn;
using namespace quarn::test;

namespace {

/// Counts what the window tells, and closes on OK alone.
struct Counter final : DialogEvents {
    explicit Counter(HeadlessDialogWindow& shown) : window(shown) {}
    void confirmed() override {
        ++confirmations;
        window.close();
    }
    void givenUp() override { ++give_ups; }
    void buttonClicked(int) override {}

    HeadlessDialogWindow& window;
    int confirmations = 0;
    int give_ups = 0;
};

DialogTemplate sampleForm() {
    DialogTemplate form;
    using Kind = DialogControl::Kind;
    form.controls = {{text_id, Kind::text, L"a", {}, false},
                     {date_id, Kind::date, L"b", {}, false},
                     {list_id, Kind::combo_box, L"c", {}, false},
                     {button_id, Kind::button, L"d", {}, true}};
    return form;
}

} // namespace

TEST(HeadlessDialogWindow, CanBeUsedOnlyWhileItRuns) {
    HeadlessDialogWindow window(sampleForm(), nullptr);
    EXPECT_FALSE(window.isOpen());
    EXPECT_FALSE(window.type(text_id, L"x"));
    EXPECT_FALSE(window.choose(date_id, COleDateTime(2026, 1, 1, 0, 0, 0)));
    EXPECT_FALSE(window.pick(list_id, 0));
    EXPECT_FALSE(window.click(button_id));
    EXPECT_FALSE(window.pressOk());
    EXPECT_FALSE(window.pressCancel());
    EXPECT_FALSE(window.pressClose());
    EXPECT_EQ(L"", window.text(text_id));
}

TEST(HeadlessDialogWindow, RefusesWhatAPersonCouldNotDo) {
    HeadlessDialogWindow window(sampleForm(), [](HeadlessDialogWindow& shown) {
        EXPECT_FALSE(shown.type(list_id, L"x"));
        EXPECT_FALSE(shown.type(no_id, L"x"));
        EXPECT_FALSE(shown.choose(date_id, COleDateTime(2026, 2, 30, 0, 0, 0)));
        EXPECT_FALSE(shown.choose(text_id, COleDateTime(2026, 2, 3, 0, 0, 0)));
        EXPECT_FALSE(shown.pick(list_id, 0)) << "it has no entries";
        EXPECT_FALSE(shown.pick(text_id, 0));
        EXPECT_FALSE(shown.click(no_id));
        EXPECT_TRUE(shown.pressOk());
    });
    Counter counter(window);
    window.run(counter);
    EXPECT_EQ(1, counter.confirmations);
    EXPECT_EQ(0, counter.give_ups);
}

TEST(HeadlessDialogWindow, GivesUpAtTheEndOfItsScriptAndRunsNoLonger) {
    HeadlessDialogWindow window(sampleForm(), nullptr);
    Counter counter(window);
    window.run(counter);
    EXPECT_EQ(1, counter.give_ups);
    EXPECT_FALSE(window.isOpen());
}

TEST(HeadlessDialogWindow, KeyboardGoesWhereAPersonOrTheDialogPutsIt) {
    HeadlessDialogWindow window(sampleForm(), [](HeadlessDialogWindow& shown) {
        EXPECT_EQ(text_id, shown.focusedControl());
        shown.choose(date_id, COleDateTime(2026, 1, 1, 0, 0, 0));
        EXPECT_EQ(date_id, shown.focusedControl());
        shown.focus(button_id);
        EXPECT_EQ(button_id, shown.focusedControl());
        shown.focus(no_id);
        EXPECT_EQ(button_id, shown.focusedControl());
    });
    Counter counter(window);
    window.run(counter);
    EXPECT_EQ(0, HeadlessDialogWindow({}, nullptr).focusedControl());
}

TEST(HeadlessDialogWindow, ListKeepsTheSelectedEntryWhenOneIsPutBeforeIt) {
    HeadlessDialogWindow window(sampleForm(), nullptr);
    const std::unique_ptr<IQnComboBoxControl> list = window.comboBox(list_id);
    ASSERT_TRUE(list);
    list->Insert(0, L"b");
    list->Select(0);
    list->Insert(0, L"a");
    EXPECT_EQ(1, list->Selection());
    EXPECT_EQ(1, window.pickedEntry(list_id));
    list->Reset();
    EXPECT_EQ(-1, list->Selection());
    EXPECT_EQ(nullptr, window.comboBox(text_id));
    EXPECT_EQ(-1, window.pickedEntry(text_id));
    EXPECT_TRUE(window.entries(no_id).empty());
}

TEST(HeadlessDialogWindow, IgnoresTextsAndDatesOfControlsThatShowNone) {
    HeadlessDialogWindow window(sampleForm(), nullptr);
    window.setText(list_id, L"x");
    EXPECT_EQ(L"", window.text(list_id));
    window.setDateTime(text_id, COleDateTime(2026, 1, 1, 0, 0, 0));
    EXPECT_FALSE(window.dateTime(text_id).IsValid());
    window.setDateTime(date_id, COleDateTime(2026, 2, 30, 0, 0, 0));
    EXPECT_EQ(COleDateTime(2000, 1, 1, 0, 0, 0), window.dateTime(date_id));
}
