#include "tests/zoetrix/ui/FormFixture.h"
#include "zoetrix/ui/PathAnimationDialog.h"

namespace {

class PathForm : public FormFixture {
protected:
    CPathAnimationDialog form(int file_type, int capture, int viewport) {
        return {48,      L"Walk",   file_types, file_type, captures,
                capture, viewports, viewport,   nullptr};
    }

    Names file_types = {L"jpg", L"bmp", L"png", L"tga"};
    Names captures = {L"RenderFull", L"Shaded", L"Clay"};
    Names viewports = {L"Top", L"Front", L"Right", L"Perspective"};
};

using Form = CPathAnimationDialog;

} // namespace

TEST_F(PathForm, ShowsFramesNameAndTheListsWithTheirSelections) {
    CPathAnimationDialog path = form(2, 1, 3);
    show(path, [](FormWindow& window) {
        EXPECT_EQ(L"48", window.text(6005));
        EXPECT_EQ(L"Walk", window.text(6009));
        EXPECT_EQ(Texts({L"jpg", L"bmp", L"png", L"tga"}), window.entries(Form::file_type_id));
        EXPECT_EQ(Texts({L"RenderFull", L"Shaded", L"Clay"}), window.entries(Form::capture_id));
        EXPECT_EQ(Texts({L"Top", L"Front", L"Right", L"Perspective"}),
                  window.entries(Form::viewport_id));
        EXPECT_EQ(2, window.pickedEntry(Form::file_type_id));
        EXPECT_EQ(1, window.pickedEntry(Form::capture_id));
        EXPECT_EQ(3, window.pickedEntry(Form::viewport_id));
    });
    EXPECT_EQ(6005, front_end.dialogs().at(0).id);
}

TEST_F(PathForm, HandsBackWhatWasEntered) {
    CPathAnimationDialog path = form(0, 0, 0);
    EXPECT_EQ(1, show(path, [](FormWindow& window) {
                  window.type(6005, L"300");
                  window.type(6009, L"Flight");
                  window.pick(Form::file_type_id, 1);
                  window.pick(Form::capture_id, 2);
                  window.pick(Form::viewport_id, 3);
                  window.pressOk();
              }));
    EXPECT_EQ(300, path.m_frame_count);
    EXPECT_EQ(L"Flight", path.m_name.View());
    EXPECT_EQ(1, path.m_file_type.m_selection);
    EXPECT_EQ(2, path.m_capture.m_selection);
    EXPECT_EQ(3, path.m_viewport.m_selection);
}

TEST_F(PathForm, SelectionThatIsNotBelowTheCountShowsTheFirstEntry) {
    CPathAnimationDialog path = form(4, 3, 4);
    confirm(path);
    EXPECT_EQ(0, path.m_file_type.m_selection);
    EXPECT_EQ(0, path.m_capture.m_selection);
    EXPECT_EQ(0, path.m_viewport.m_selection);
}

TEST_F(PathForm, ThirdSelectionIsMeasuredAgainstTheFirstList) {
    file_types = {L"jpg", L"png"};
    CPathAnimationDialog few_types = form(0, 0, 3);
    confirm(few_types);
    EXPECT_EQ(0, few_types.m_viewport.m_selection);
    file_types = names(6);
    CPathAnimationDialog many_types = form(0, 0, 3);
    confirm(many_types);
    EXPECT_EQ(3, many_types.m_viewport.m_selection);
    CPathAnimationDialog behind_the_viewports = form(0, 0, 5);
    confirm(behind_the_viewports);
    EXPECT_EQ(-1, behind_the_viewports.m_viewport.m_selection);
}

TEST_F(PathForm, CancelKeepsTheMembers) {
    CPathAnimationDialog path = form(2, 1, 3);
    EXPECT_EQ(2, show(path, [](FormWindow& window) {
                  window.type(6009, L"Flight");
                  window.pick(Form::capture_id, 2);
                  window.pressClose();
              }));
    EXPECT_EQ(L"Walk", path.m_name.View());
    EXPECT_EQ(1, path.m_capture.m_selection);
}

TEST_F(PathForm, HasNoControllerOfItsOwn) {
    const CPathAnimationDialog path = form(0, 0, 0);
    EXPECT_EQ(nullptr, path.ControllerName());
    EXPECT_STREQ("CPathAnimationDialog", path.GetRuntimeClass()->m_class_name);
    EXPECT_TRUE(path.GetRuntimeClass()->IsDerivedFrom(CDialog::ClassRecord));
}
