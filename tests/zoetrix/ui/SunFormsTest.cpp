#include "tests/zoetrix/ui/FormFixture.h"
#include "zoetrix/ui/SeasonDialog.h"
#include "zoetrix/ui/SunDialog.h"

namespace {

using Form = CSunStudyDialog;

/// What both forms do alike.
template <class Dialog> class SunForms : public FormFixture {
protected:
    Dialog form() {
        return {latitude,  longitude, north,   first,     second,   third, L"note", file_types,
                file_type, captures,  capture, viewports, viewport, 15,    nullptr};
    }
    /// What a person is told when a field holds this text and OK is pressed; empty when it is
    /// taken.
    std::wstring refusal(int control, const wchar_t* text) {
        Dialog dialog = form();
        const std::size_t before = front_end.messages().size();
        const int result = show(dialog, [&](FormWindow& window) {
            EXPECT_TRUE(window.type(control, text));
            window.pressOk();
            if (window.isOpen()) {
                EXPECT_EQ(control, window.focusedControl());
            }
        });
        const bool was_told = front_end.messages().size() > before;
        EXPECT_EQ(was_told ? 2 : 1, result);
        return was_told ? lastMessage() : L"";
    }

    /// The form of a dialog, in which a control that takes dates and times takes texts, so that
    /// what it holds is refused as the date that it is not.
    quarn::DialogTemplate formRefusing(Dialog& dialog, int control) {
        confirm(dialog);
        quarn::DialogTemplate refusing = front_end.dialogs().back();
        for (quarn::DialogControl& candidate : refusing.controls)
            if (candidate.id == control && (candidate.kind == quarn::DialogControl::Kind::date ||
                                            candidate.kind == quarn::DialogControl::Kind::time))
                candidate.kind = quarn::DialogControl::Kind::text;
        return refusing;
    }
    /// The controls whose members are not any more as form() made them, in the order of exchange.
    std::vector<int> changed(const Dialog& dialog) const {
        const std::pair<int, bool> members[] = {
            {6004, dialog.m_latitude != latitude},     {6005, dialog.m_longitude != longitude},
            {6006, dialog.m_north_angle != north},     {6009, dialog.m_text != L"note"},
            {6000, dialog.m_first_date_time != first}, {6001, dialog.m_second_date_time != second},
            {6002, dialog.m_third_date_time != third}, {6010, dialog.m_frame_step != 15}};
        std::vector<int> controls;
        for (const auto& [control, is_changed] : members)
            if (is_changed)
                controls.push_back(control);
        return controls;
    }

    double latitude = 47.5;
    double longitude = 19.05;
    double north = 30.0;
    COleDateTime first{2026, 6, 21, 1, 2, 3};
    COleDateTime second{2026, 9, 22, 6, 30, 0};
    COleDateTime third{2026, 12, 21, 20, 15, 0};
    Names file_types = names(4);
    Names captures = names(3);
    Names viewports = names(4);
    int file_type = 0;
    int capture = 0;
    int viewport = 0;
};

using Dialogs = ::testing::Types<CSunDialog, CSeasonDialog>;
TYPED_TEST_SUITE(SunForms, Dialogs);

class OneDayForm : public SunForms<CSunDialog> {};
class SeasonForm : public SunForms<CSeasonDialog> {};

} // namespace

TYPED_TEST(SunForms, KeepEveryArgument) {
    CWnd parent;
    const TypeParam dialog(1.0, 2.0, 3.0, this->first, this->second, this->third, L"note",
                           this->names(1), 4, this->names(2), 5, this->names(3), 6, 7, &parent);
    EXPECT_EQ(1.0, dialog.m_latitude);
    EXPECT_EQ(2.0, dialog.m_longitude);
    EXPECT_EQ(3.0, dialog.m_north_angle);
    EXPECT_EQ(this->first, dialog.m_first_date_time);
    EXPECT_EQ(this->second, dialog.m_second_date_time);
    EXPECT_EQ(this->third, dialog.m_third_date_time);
    EXPECT_EQ(L"note", dialog.m_text.View());
    EXPECT_EQ(this->names(1), dialog.m_file_type.m_list);
    EXPECT_EQ(4, dialog.m_file_type.m_selection);
    EXPECT_EQ(this->names(2), dialog.m_capture.m_list);
    EXPECT_EQ(5, dialog.m_capture.m_selection);
    EXPECT_EQ(this->names(3), dialog.m_viewport.m_list);
    EXPECT_EQ(6, dialog.m_viewport.m_selection);
    EXPECT_EQ(7, dialog.m_frame_step);
    EXPECT_EQ(&parent, dialog.Parent());
}

TYPED_TEST(SunForms, ShowTheirMembersInTheControls) {
    TypeParam dialog = this->form();
    this->show(dialog, [&](FormWindow& window) {
        EXPECT_EQ(L"47.5", window.text(6004));
        EXPECT_EQ(L"19.05", window.text(6005));
        EXPECT_EQ(L"30", window.text(6006));
        EXPECT_EQ(this->first, window.dateTime(6000));
        EXPECT_EQ(this->second, window.dateTime(6001));
        EXPECT_EQ(this->third, window.dateTime(6002));
        EXPECT_EQ(L"note", window.text(6009));
        EXPECT_EQ(L"15", window.text(6010));
        EXPECT_EQ(Texts({L"A", L"B", L"C", L"D"}), window.entries(Form::file_type_id));
        EXPECT_EQ(Texts({L"A", L"B", L"C"}), window.entries(Form::capture_id));
        EXPECT_EQ(Texts({L"A", L"B", L"C", L"D"}), window.entries(Form::viewport_id));
    });
}

TYPED_TEST(SunForms, HandBackWhatWasEntered) {
    TypeParam dialog = this->form();
    EXPECT_EQ(1, this->show(dialog, [](FormWindow& window) {
        window.type(6004, L"-33,87");
        window.type(6005, L"151.21");
        window.type(6006, L"359.5");
        window.type(6009, L"x");
        window.type(6010, L"7");
        window.pick(Form::file_type_id, 3);
        window.pick(Form::capture_id, 2);
        window.pick(Form::viewport_id, 1);
        window.pressOk();
    }));
    EXPECT_EQ(-33.87, dialog.m_latitude);
    EXPECT_EQ(151.21, dialog.m_longitude);
    EXPECT_EQ(359.5, dialog.m_north_angle);
    EXPECT_EQ(L"x", dialog.m_text.View());
    EXPECT_EQ(7, dialog.m_frame_step);
    EXPECT_EQ(3, dialog.m_file_type.m_selection);
    EXPECT_EQ(2, dialog.m_capture.m_selection);
    EXPECT_EQ(1, dialog.m_viewport.m_selection);
}

TYPED_TEST(SunForms, TakePlacesAndNorthAnglesUpToTheirLimits) {
    for (const wchar_t* text : {L"-90", L"90"})
        EXPECT_EQ(L"", this->refusal(6004, text));
    for (const wchar_t* text : {L"-180", L"180"})
        EXPECT_EQ(L"", this->refusal(6005, text));
    for (const wchar_t* text : {L"0", L"360"})
        EXPECT_EQ(L"", this->refusal(6006, text));
}

TYPED_TEST(SunForms, RefusePlacesAndNorthAnglesBeyondTheirLimits) {
    for (const wchar_t* text : {L"90.5", L"-90.5", L"1e300"})
        EXPECT_EQ(L"Enter a number between -90 and 90", this->refusal(6004, text));
    for (const wchar_t* text : {L"180.5", L"-180,5"})
        EXPECT_EQ(L"Enter a number between -180 and 180", this->refusal(6005, text));
    for (const wchar_t* text : {L"-0.5", L"360.5"})
        EXPECT_EQ(L"Enter a number between 0 and 360", this->refusal(6006, text));
}

TYPED_TEST(SunForms, RefuseWhatIsNoNumberWhereOneIsWanted) {
    for (const int control : {6004, 6005, 6006})
        for (const wchar_t* text : {L"", L"  ", L"north", L"1e400"})
            EXPECT_EQ(L"Enter a number", this->refusal(control, text)) << control;
    for (const wchar_t* text : {L"", L"2.5", L"2147483648", L"often"})
        EXPECT_EQ(L"Enter a whole number", this->refusal(6010, text));
}

TYPED_TEST(SunForms, SelectionThatEqualsTheCountShowsTheFirstEntry) {
    this->file_type = 4;
    this->capture = 3;
    this->viewport = 4;
    TypeParam dialog = this->form();
    this->show(dialog, [](FormWindow& window) {
        EXPECT_EQ(0, window.pickedEntry(Form::file_type_id));
        EXPECT_EQ(0, window.pickedEntry(Form::capture_id));
        EXPECT_EQ(0, window.pickedEntry(Form::viewport_id));
    });
}

TYPED_TEST(SunForms, ViewportSelectionIsMeasuredAgainstTheCountOfFileTypes) {
    this->file_types = this->names(3);
    this->viewports = this->names(5);
    this->viewport = 4;
    TypeParam few_types = this->form();
    this->show(few_types,
               [](FormWindow& window) { EXPECT_EQ(0, window.pickedEntry(Form::viewport_id)); });
    this->file_types = this->names(5);
    this->viewports = this->names(3);
    TypeParam many_types = this->form();
    this->show(many_types, [](FormWindow& window) {
        EXPECT_EQ(-1, window.pickedEntry(Form::viewport_id)) << "handed on as it is: no such entry";
    });
    this->viewports = this->names(8);
    TypeParam many_viewports = this->form();
    this->show(many_viewports,
               [](FormWindow& window) { EXPECT_EQ(4, window.pickedEntry(Form::viewport_id)); });
}

TYPED_TEST(SunForms, PickedLocationIsShownWithTwoDigitsAndKeptWithAll) {
    this->front_end.addLocationChoice(quarn::Place{12.3456, -65.4321});
    TypeParam dialog = this->form();
    EXPECT_EQ(1, this->show(dialog, [&](FormWindow& window) {
        EXPECT_TRUE(window.click(Form::location_button_id));
        EXPECT_EQ(L"12.35", window.text(6004));
        EXPECT_EQ(L"-65.43", window.text(6005));
        EXPECT_EQ(12.3456, dialog.m_latitude);
        EXPECT_EQ(-65.4321, dialog.m_longitude);
        window.pressOk();
    }));
    EXPECT_EQ(12.35, dialog.m_latitude) << "read back from the field";
    EXPECT_EQ(-65.43, dialog.m_longitude);
    ASSERT_EQ(1U, this->front_end.locationQuestions().size());
    EXPECT_EQ(L"Set Animation Location", this->front_end.locationQuestions()[0].title);
    EXPECT_EQ(47.5, this->front_end.locationQuestions()[0].start.latitude_deg);
    EXPECT_EQ(19.05, this->front_end.locationQuestions()[0].start.longitude_deg);
}

TYPED_TEST(SunForms, LocationThatWasNotPickedLeavesEverythingAsItWas) {
    this->front_end.addLocationChoice(std::nullopt);
    TypeParam dialog = this->form();
    this->show(dialog, [&](FormWindow& window) {
        window.type(6004, L"1.23456");
        EXPECT_TRUE(window.click(Form::location_button_id));
        EXPECT_EQ(L"1.23456", window.text(6004));
        EXPECT_EQ(L"19.05", window.text(6005));
    });
    EXPECT_EQ(47.5, dialog.m_latitude);
    EXPECT_EQ(19.05, dialog.m_longitude);
    EXPECT_EQ(1U, this->front_end.locationQuestions().size());
}

TYPED_TEST(SunForms, LocationIsKeptWhenTheFormIsClosedAfterwards) {
    this->front_end.addLocationChoice(quarn::Place{12.3456, -65.4321});
    TypeParam dialog = this->form();
    EXPECT_EQ(2, this->show(dialog, [](FormWindow& window) {
        window.click(Form::location_button_id);
        window.pressCancel();
    }));
    EXPECT_EQ(12.3456, dialog.m_latitude);
}

TYPED_TEST(SunForms, FieldsAreExchangedInTheirOrderUntilOneIsRefused) {
    const std::vector<int> order = {6004, 6005, 6006, 6009, 6000, 6001, 6002, 6010};
    for (auto refused = order.begin(); refused != order.end(); ++refused) {
        if (*refused == 6009)
            continue; // Every text is taken.
        TypeParam dialog = this->form();
        FormWindow window(this->formRefusing(dialog, *refused), [&](FormWindow& shown) {
            for (const int control : order)
                EXPECT_TRUE(shown.type(control, control == *refused ? L"x" : L"7") ||
                            shown.choose(control, COleDateTime(2027, 1, 2, 4, 5, 6)));
            shown.pressOk();
        });
        EXPECT_EQ(2, dialog.DoModalIn(window));
        EXPECT_EQ(std::vector<int>(order.begin(), refused), this->changed(dialog)) << *refused;
    }
}

TYPED_TEST(SunForms, EachNumberIsMeasuredBeforeTheNextOneIsRead) {
    const std::vector<int> order = {6004, 6005, 6006};
    for (std::size_t k = 0; k < order.size(); ++k) {
        TypeParam dialog = this->form();
        this->show(dialog, [&](FormWindow& window) {
            window.type(order[k], L"999");
            window.type(k + 1 < order.size() ? order[k + 1] : 6010, L"x");
            window.pressOk();
            EXPECT_EQ(order[k], window.focusedControl());
        });
        EXPECT_EQ(0U, this->lastMessage().find(L"Enter a number between")) << k;
    }
}

TEST_F(OneDayForm, AsksForADayAndTwoTimes) {
    CSunDialog dialog = form();
    show(dialog, [](FormWindow& window) {
        EXPECT_EQ(L"One-Day Sun Study", window.form().title.View());
        window.choose(6000, COleDateTime(2027, 3, 20, 23, 59, 59));
        window.choose(6001, COleDateTime(2000, 1, 1, 5, 0, 0));
        window.choose(6002, COleDateTime(2000, 1, 1, 19, 45, 0));
        window.pressOk();
    });
    EXPECT_EQ(COleDateTime(2027, 3, 20, 1, 2, 3), dialog.m_first_date_time);
    EXPECT_EQ(COleDateTime(2026, 9, 22, 5, 0, 0), dialog.m_second_date_time);
    EXPECT_EQ(COleDateTime(2026, 12, 21, 19, 45, 0), dialog.m_third_date_time);
    EXPECT_STREQ("CSunDialog", dialog.GetRuntimeClass()->m_class_name);
    EXPECT_TRUE(dialog.GetRuntimeClass()->IsDerivedFrom(CQuarnDialog::ClassRecord));
    EXPECT_FALSE(dialog.GetRuntimeClass()->IsDerivedFrom(CSeasonDialog::ClassRecord));
    EXPECT_EQ(nullptr, dialog.ControllerName());
}

TEST_F(SeasonForm, AsksForTwoDatesAndATime) {
    CSeasonDialog dialog = form();
    show(dialog, [](FormWindow& window) {
        EXPECT_EQ(L"Seasonal Sun Study", window.form().title.View());
        window.choose(6000, COleDateTime(2027, 3, 20, 0, 0, 0));
        window.choose(6001, COleDateTime(2027, 9, 23, 0, 0, 0));
        window.choose(6002, COleDateTime(2000, 1, 1, 12, 0, 0));
        window.pressOk();
    });
    EXPECT_EQ(COleDateTime(2027, 3, 20, 1, 2, 3), dialog.m_first_date_time);
    EXPECT_EQ(COleDateTime(2027, 9, 23, 6, 30, 0), dialog.m_second_date_time);
    EXPECT_EQ(COleDateTime(2026, 12, 21, 12, 0, 0), dialog.m_third_date_time);
    EXPECT_STREQ("CSeasonDialog", dialog.GetRuntimeClass()->m_class_name);
}
