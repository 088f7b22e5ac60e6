#pragma once

#include "ground/Result.h"
#include "host/front_end/DialogTemplate.h"
#include "host/front_end/DialogWindow.h"
#include "sdk/qncore/QnDialog.h"

#include <functional>
#include <optional>
#include <utility>
#include <vector>

namespace quarn {

class Application;

/// What a dialog is while it is open and before: the parts of a CDialog that plug-ins do not see.
struct DialogState final : DialogEvents {
    DialogState(CDialog& owner, int id, CWnd* parent_window)
        : dialog(owner), template_id(id), parent(parent_window) {}

    // ---- Showing

    /// Reads the template, has the front end make the window, and runs in it.
    /// @return as CDialog::DoModal
    int show();
    /// As show, but for a front end without dialogs, which is no fault here and not told.
    /// @return nothing where there are no dialogs
    std::optional<int> showWhereThereAreDialogs();
    /// Runs in a window. @return as CDialog::DoModal
    int showIn(DialogWindow& shown_window);
    /// Closes the window; only the first call counts.
    void end(int result);

    /// What a control of the template is; nothing in a window of another making.
    std::optional<DialogControl::Kind> kindOf(int control) const;

    // ---- What the person does

    void confirmed() override;
    void givenUp() override;
    void buttonClicked(int control) override;

    static DialogState& of(const CDialog& dialog) { return *dialog.m_state; }

    CDialog& dialog;
    const int template_id;
    CWnd* const parent;
    std::vector<std::pair<int, CComboBox*>> combo_boxes;
    DialogTemplate form;            ///< without controls in a window of another making
    DialogWindow* window = nullptr; ///< while the dialog is open
    std::optional<int> result;      ///< once the dialog has ended

private:
    Result<DialogTemplate> readForm(Application& application) const;
    int runIn(Application& application, DialogWindow& shown_window);
    /// Calls an overridden operation; one that throws ends the dialog.
    void call(const char* name, const std::function<void()>& operation);
};

/// Gives combo boxes their controls of a window, and takes them away again before the window goes.
class AttachedComboBoxes {
public:
    AttachedComboBoxes(const DialogState& state, DialogWindow& window);
    ~AttachedComboBoxes();
    AttachedComboBoxes(const AttachedComboBoxes&) = delete;
    AttachedComboBoxes& operator=(const AttachedComboBoxes&) = delete;

private:
    std::vector<CComboBox*> m_attached;
};

} // namespace quarn
