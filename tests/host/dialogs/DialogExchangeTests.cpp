#include "tests/host/app/TestCommand.h"
#include "tests/host/dialogs/DialogFixture.h"

#include <limits>

using namespace quarn;
using namespace quarn::test;

namespace {

class DialogExchange : public DialogTest {
protected:
    /// The angle that `text` gives; nothing when it is refused.
    std::optional<double> angleOf(std::wstring_view text) {
        sample.angle = -1.0;
        const std::wstring why = refusal(number_id, text);
        EXPECT_TRUE(why.empty() || sample.angle == -1.0) << "a refused text changes nothing";
        return why.empty() ? std::optional(sample.angle) : std::nullopt;
    }
};

/// A window whose date controls show no date.
class UndatedWindow final : public DialogWindow {
public:
    void run(DialogEvents& events) override { events.confirmed(); }
    void close() override { is_closed = true; }
    bool hasControl(int control) const override { return control == date_id; }
    std::wstring text(int) const override { return {}; }
    void setText(int, std::wstring_view) override {}
    COleDateTime dateTime(int) const override { return {2026, 2, 30, 0, 0, 0}; }
    void setDateTime(int, const COleDateTime&) override {}
    std::unique_ptr<IQnComboBoxControl> comboBox(int) override { return nullptr; }
    void focus(int control) override { focused = control; }

    bool is_closed = false;
    int focused = 0;
};

} // namespace

// ---- Numbers

TEST_F(DialogExchange, NumberMayHaveAPointOrACommaASignAnExponentAndBlanksAround) {
    EXPECT_EQ(51.5, angleOf(L"51.5"));
    EXPECT_EQ(51.5, angleOf(L"51,5"));
    EXPECT_EQ(-7.25, angleOf(L"  -7.25\t"));
    EXPECT_EQ(8.0, angleOf(L"+8"));
    EXPECT_EQ(15.0, angleOf(L"1.5e1"));
    EXPECT_EQ(0.5, angleOf(L",5"));
    EXPECT_EQ(0.0, angleOf(L"0"));
}

TEST_F(DialogExchange, TextThatIsNoNumberIsRefusedWhereANumberIsWanted) {
    for (const wchar_t* text :
         {L"", L"   ", L"north", L"12 34", L"12deg", L"1.2.3", L"1,2,3", L"1,234.5", L"1.234,5",
          L"--1", L"1e400", L"-1e400", L"nan", L"inf", L"0x10", L",", L"."})
        EXPECT_EQ(L"Enter a number", refusal(number_id, text)) << KM_wString(text).ToUtf8();
    EXPECT_EQ(12.5, sample.angle);
}

TEST_F(DialogExchange, WholeNumberIsTakenFromTheLeastIntToTheGreatest) {
    EXPECT_EQ(L"", refusal(integer_id, L" +42 "));
    EXPECT_EQ(42, sample.count);
    EXPECT_EQ(L"", refusal(integer_id, L"2147483647"));
    EXPECT_EQ(std::numeric_limits<int>::max(), sample.count);
    EXPECT_EQ(L"", refusal(integer_id, L"-2147483648"));
    EXPECT_EQ(std::numeric_limits<int>::min(), sample.count);
    EXPECT_EQ(L"", refusal(integer_id, L"0"));
    EXPECT_EQ(0, sample.count);
}

TEST_F(DialogExchange, TextThatNoIntHoldsIsRefusedWhereAWholeNumberIsWanted) {
    for (const wchar_t* text : {L"", L"  ", L"many", L"1.0", L"1,5", L"1e2", L"2147483648",
                                L"-2147483649", L"99999999999999999999", L"1 2"})
        EXPECT_EQ(L"Enter a whole number", refusal(integer_id, text)) << KM_wString(text).ToUtf8();
    EXPECT_EQ(24, sample.count);
}

TEST_F(DialogExchange, FramesBeyondMemoryAreRefusedWhereATurntableAsksForThem) {
    std::wstring told;
    TestCommand turn(L"Turn", [&](const CQuarnCommandContext&) {
        told = refusal(integer_id, L"2147483647");
        return CQuarnCommand::success;
    });
    ASSERT_TRUE(Application::current()->commands().add(turn));
    session.runCommand(L"Turn");
    EXPECT_EQ(L"", told) << "this command asks for another number";
    // SetTurntableAnimation: 24E39B43-B4C1-44AC-8479-4CB1AB388ED5
    turn.m_id = {0x24E39B43, 0xB4C1, 0x44AC, {0x84, 0x79, 0x4C, 0xB1, 0xAB, 0x38, 0x8E, 0xD5}};
    session.runCommand(L"Turn");
    EXPECT_THAT(told, testing::HasSubstr(L"2147483647 frames would take about 3400.0 GB"));
}

TEST_F(DialogExchange, NumbersAreShownAsTheyReadBack) {
    for (const double angle : {0.1, -12.3456, 1.0 / 3.0, 90.0, 1e-5}) {
        sample.angle = angle;
        show(sample, [](HeadlessDialogWindow& window) { window.pressOk(); });
        EXPECT_EQ(angle, sample.angle);
    }
    sample.angle = 0.1;
    show(sample, [](HeadlessDialogWindow& window) { EXPECT_EQ(L"0.1", window.text(number_id)); });
}

TEST_F(DialogExchange, LimitsBelongToTheRange) {
    EXPECT_EQ(90.0, angleOf(L"90"));
    EXPECT_EQ(-90.0, angleOf(L"-90.0"));
}

TEST_F(DialogExchange, NumberOutsideTheRangeIsRefusedWithItsLimits) {
    EXPECT_EQ(L"Enter a number between -90 and 90", refusal(number_id, L"90.5"));
    EXPECT_EQ(L"Enter a number between -90 and 90", refusal(number_id, L"-90,0001"));
    EXPECT_EQ(L"Enter a number between -90 and 90", refusal(number_id, L"1e308"));
}

TEST_F(DialogExchange, RangeIsNotLookedAtWhenMembersAreShown) {
    sample.angle = 1000.0;
    show(sample, [](HeadlessDialogWindow& window) { EXPECT_EQ(L"1000", window.text(number_id)); });
    EXPECT_TRUE(front_end.messages().empty());
}

// ---- Texts

TEST_F(DialogExchange, TextIsTakenAsItStands) {
    EXPECT_EQ(L"", refusal(text_id, L"  Größe 東京  "));
    EXPECT_EQ(L"  Größe 東京  ", sample.name.View());
    EXPECT_EQ(L"", refusal(text_id, L""));
    EXPECT_TRUE(sample.name.IsEmpty());
}

// ---- Dates and times

TEST_F(DialogExchange, DateLeavesTheTimeOfDayAloneAndATimeTheDate) {
    show(sample, [](HeadlessDialogWindow& window) {
        window.choose(date_id, COleDateTime(2028, 2, 29, 23, 59, 58));
        window.choose(time_id, COleDateTime(2001, 5, 6, 7, 8, 9));
        window.pressOk();
    });
    EXPECT_EQ(COleDateTime(2028, 2, 29, 4, 5, 6), sample.day);
    EXPECT_EQ(COleDateTime(1999, 12, 31, 7, 8, 9), sample.hour);
}

TEST_F(DialogExchange, ValueThatIsNoDateIsNotShownAndTakesAllThatIsChosen) {
    sample.hour = COleDateTime();
    show(sample, [](HeadlessDialogWindow& window) {
        EXPECT_EQ(COleDateTime(2000, 1, 1, 0, 0, 0), window.dateTime(time_id));
        window.choose(time_id, COleDateTime(2001, 5, 6, 7, 8, 9));
        window.pressOk();
    });
    EXPECT_EQ(COleDateTime(2001, 5, 6, 7, 8, 9), sample.hour);
}

TEST_F(DialogExchange, DateThatNoCalendarShowsIsRefused) {
    UndatedWindow window;
    EXPECT_EQ(2, sample.DoModalIn(window));
    ASSERT_EQ(1U, front_end.messages().size());
    EXPECT_EQ(L"Enter a date", front_end.messages()[0].text);
    EXPECT_EQ(date_id, window.focused);
    EXPECT_FALSE(window.is_closed);
    EXPECT_EQ(COleDateTime(2026, 6, 21, 4, 5, 6), sample.day);
}

// ---- Refusals

TEST_F(DialogExchange, RefusalIsAWarningUnderTheDialogsTitleAndTheDialogStaysOpen) {
    const int result = show(sample, [&](HeadlessDialogWindow& window) {
        window.type(integer_id, L"many");
        window.type(text_id, L"Flight");
        EXPECT_EQ(text_id, window.focusedControl());
        EXPECT_TRUE(window.pressOk());
        EXPECT_TRUE(window.isOpen());
        EXPECT_EQ(integer_id, window.focusedControl());
        ASSERT_EQ(1U, front_end.messages().size());
        EXPECT_EQ(L"Sample", front_end.messages()[0].title);
        EXPECT_EQ(48U, front_end.messages()[0].flags);
        window.type(integer_id, L"12");
        EXPECT_TRUE(window.pressOk());
        EXPECT_FALSE(window.isOpen());
    });
    EXPECT_EQ(1, result);
    EXPECT_EQ(12, sample.count);
    EXPECT_EQ(1U, front_end.messages().size());
}

TEST_F(DialogExchange, OnlyTheFirstRefusalIsToldAndWhatStandsBehindItIsNotRead) {
    show(sample, [&](HeadlessDialogWindow& window) {
        window.type(text_id, L"Flight");
        window.type(number_id, L"x");
        window.type(integer_id, L"y");
        window.choose(date_id, COleDateTime(2028, 2, 29, 0, 0, 0));
        window.pressOk();
    });
    ASSERT_EQ(1U, front_end.messages().size());
    EXPECT_EQ(L"Enter a number", front_end.messages()[0].text);
    EXPECT_EQ(L"Flight", sample.name.View()) << "exchanged before it";
    EXPECT_EQ(2026, sample.day.GetYear());
}

TEST_F(DialogExchange, ControlThatIsNotThereIsPassedOver) {
    writeFile(folder / "7001.dialog.json",
              R"({"id": 7001, "title": {"text": "Short"}, "controls": [
                  {"id": 7103, "kind": "integer", "label": {"text": "Count"}}]})");
    const int result = show(sample, [](HeadlessDialogWindow& window) {
        window.type(integer_id, L"5");
        window.pressOk();
    });
    EXPECT_EQ(1, result);
    EXPECT_EQ(5, sample.count);
    EXPECT_EQ(12.5, sample.angle);
    EXPECT_EQ(L"Walk", sample.name.View());
    EXPECT_FALSE(sample.colours.HasControl());
}
