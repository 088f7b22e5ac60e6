#include "tests/zoetrix/ui/FormFixture.h"
#include "zoetrix/ui/TurnTableDialog.h"

namespace {

class TurnTableForm : public FormFixture {
protected:
    /// The selections in the order of the lists.
    CTurnTableDialog form(int direction, int file_type, int capture, int viewport) {
        return {36,       L"Spin", directions, direction, file_types, file_type,
                captures, capture, viewports,  viewport,  nullptr};
    }

    Names directions = {L"Clockwise", L"AntiClockwise"};
    Names file_types = {L"jpg", L"bmp", L"png", L"tga"};
    Names captures = {L"RenderFull", L"Shaded", L"Clay"};
    Names viewports = {L"Top", L"Front", L"Right", L"Perspective"};
};

using Form = CTurnTableDialog;

} // namespace

TEST_F(TurnTableForm, ShowsFramesNameAndTheListsWithTheirSelections) {
    CTurnTableDialog turntable = form(1, 2, 0, 3);
    EXPECT_EQ(
        2, show(turntable, [](FormWindow& window) {
            EXPECT_EQ(L"36", window.text(6005));
            EXPECT_EQ(L"Spin", window.text(6009));
            EXPECT_EQ(Texts({L"Clockwise", L"AntiClockwise"}), window.entries(Form::direction_id));
            EXPECT_EQ(Texts({L"jpg", L"bmp", L"png", L"tga"}), window.entries(Form::file_type_id));
            EXPECT_EQ(Texts({L"RenderFull", L"Shaded", L"Clay"}), window.entries(Form::capture_id));
            EXPECT_EQ(Texts({L"Top", L"Front", L"Right", L"Perspective"}),
                      window.entries(Form::viewport_id));
            EXPECT_EQ(1, window.pickedEntry(Form::direction_id));
            EXPECT_EQ(2, window.pickedEntry(Form::file_type_id));
            EXPECT_EQ(0, window.pickedEntry(Form::capture_id));
            EXPECT_EQ(3, window.pickedEntry(Form::viewport_id));
        }));
    EXPECT_EQ(6004, front_end.dialogs().at(0).id);
}

TEST_F(TurnTableForm, HandsBackWhatWasEntered) {
    CTurnTableDialog turntable = form(0, 0, 0, 0);
    EXPECT_EQ(1, show(turntable, [](FormWindow& window) {
                  window.type(6005, L"120");
                  window.type(6009, L"Round trip");
                  window.pick(Form::direction_id, 1);
                  window.pick(Form::file_type_id, 3);
                  window.pick(Form::capture_id, 2);
                  window.pick(Form::viewport_id, 1);
                  window.pressOk();
              }));
    EXPECT_EQ(120, turntable.m_frame_count);
    EXPECT_EQ(L"Round trip", turntable.m_name.View());
    EXPECT_EQ(1, turntable.m_direction.m_selection);
    EXPECT_EQ(3, turntable.m_file_type.m_selection);
    EXPECT_EQ(2, turntable.m_capture.m_selection);
    EXPECT_EQ(1, turntable.m_viewport.m_selection);
}

TEST_F(TurnTableForm, CancelKeepsTheMembers) {
    CTurnTableDialog turntable = form(1, 2, 0, 3);
    EXPECT_EQ(2, show(turntable, [](FormWindow& window) {
                  window.type(6005, L"120");
                  window.pick(Form::direction_id, 0);
                  window.pressCancel();
              }));
    EXPECT_EQ(36, turntable.m_frame_count);
    EXPECT_EQ(1, turntable.m_direction.m_selection);
    EXPECT_EQ(3, turntable.m_viewport.m_selection);
}

TEST_F(TurnTableForm, SelectionThatIsNotBelowTheCountShowsTheFirstEntry) {
    CTurnTableDialog turntable = form(2, 4, 3, 0);
    confirm(turntable);
    EXPECT_EQ(0, turntable.m_direction.m_selection);
    EXPECT_EQ(0, turntable.m_file_type.m_selection);
    EXPECT_EQ(0, turntable.m_capture.m_selection);
}

TEST_F(TurnTableForm, ViewportSelectionIsMeasuredAgainstTheCountOfFileTypes) {
    file_types = {L"jpg", L"png"};
    CTurnTableDialog turntable = form(0, 0, 0, 3);
    show(turntable,
         [](FormWindow& window) { EXPECT_EQ(0, window.pickedEntry(Form::viewport_id)); });
    file_types = names(5);
    viewports = {L"Top", L"Front"};
    CTurnTableDialog many_types = form(0, 0, 0, 4);
    show(many_types,
         [](FormWindow& window) { EXPECT_EQ(-1, window.pickedEntry(Form::viewport_id)); });
}

TEST_F(TurnTableForm, NegativeSelectionShowsNoEntry) {
    CTurnTableDialog turntable = form(-1, 0, 0, 0);
    show(turntable,
         [](FormWindow& window) { EXPECT_EQ(-1, window.pickedEntry(Form::direction_id)); });
}

TEST_F(TurnTableForm, ShowsEmptyListsWithNothingSelected) {
    directions = file_types = captures = viewports = {};
    CTurnTableDialog turntable = form(0, 0, 0, 0);
    EXPECT_EQ(1, confirm(turntable));
    EXPECT_EQ(-1, turntable.m_direction.m_selection);
    EXPECT_EQ(-1, turntable.m_viewport.m_selection);
}

TEST_F(TurnTableForm, NamesWithPercentSignsAreShownAsTheyStand) {
    viewports = {L"50%s", L"%d%n"};
    CTurnTableDialog turntable = form(0, 0, 0, 0);
    show(turntable, [](FormWindow& window) {
        EXPECT_EQ(Texts({L"50%s", L"%d%n"}), window.entries(Form::viewport_id));
    });
}

TEST_F(TurnTableForm, FrameCountThatIsNoWholeNumberIsRefusedUnderTheFormsTitle) {
    CTurnTableDialog turntable = form(0, 0, 0, 0);
    EXPECT_EQ(2, show(turntable, [](FormWindow& window) {
                  window.type(6005, L"2147483648");
                  window.pick(Form::direction_id, 1);
                  window.pressOk();
                  EXPECT_TRUE(window.isOpen());
                  EXPECT_EQ(6005, window.focusedControl());
              }));
    EXPECT_EQ(L"Enter a whole number", lastMessage());
    EXPECT_EQ(L"Turntable Animation", front_end.messages().back().title);
    EXPECT_EQ(36, turntable.m_frame_count);
    EXPECT_EQ(1, turntable.m_direction.m_selection) << "stored before the exchange";
}

TEST_F(TurnTableForm, FrameCountsThatTheCommandWillRefuseAreHandedOnAsTheyAre) {
    CTurnTableDialog turntable = form(0, 0, 0, 0);
    for (const auto& [text, count] : {std::pair{L"0", 0}, std::pair{L"-3", -3}}) {
        EXPECT_EQ(1, show(turntable, [&](FormWindow& window) {
                      window.type(6005, text);
                      window.pressOk();
                  }));
        EXPECT_EQ(count, turntable.m_frame_count);
    }
}

TEST_F(TurnTableForm, FillsItsListsAnewEachTime) {
    CTurnTableDialog turntable = form(1, 1, 1, 1);
    confirm(turntable);
    show(turntable, [](FormWindow& window) {
        EXPECT_EQ(2U, window.entries(Form::direction_id).size());
        EXPECT_EQ(1, window.pickedEntry(Form::direction_id));
    });
}

TEST_F(TurnTableForm, IsShownByItsControllerWhereWindowsAreMadeWithCocoa) {
    const CTurnTableDialog turntable = form(0, 0, 0, 0);
    EXPECT_STREQ(L"QXTurnTableDialogController", turntable.ControllerName());
    EXPECT_EQ(&CTurnTableDialog::ClassRecord, turntable.GetRuntimeClass());
    EXPECT_STREQ("CTurnTableDialog", turntable.GetRuntimeClass()->m_class_name);
    EXPECT_TRUE(turntable.GetRuntimeClass()->IsDerivedFrom(CQuarnDialog::ClassRecord));
}

TEST_F(TurnTableForm, KeepsItsParent) {
    CWnd parent;
    const CTurnTableDialog turntable(1, L"", directions, 0, file_types, 0, captures, 0, viewports,
                                     0, &parent);
    EXPECT_EQ(&parent, turntable.Parent());
}
