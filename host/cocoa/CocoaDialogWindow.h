#pragma once

#include "host/cocoa/BoundKeys.h"
#include "host/front_end/DialogWindow.h"
#include "sdk/cocoa/QXDialogController.h"

namespace quarn {

/// The window of a dialog's controller. Controls are found by their tags; a control that shows a
/// date is not known here, since no dialog with one names a controller.
class CocoaDialogWindow final : public DialogWindow, private DialogEvents {
public:
    /// @param controller  with its window loaded; it and its keys must outlive this
    CocoaDialogWindow(QXDialogController* controller, const BoundKeys& keys);

    void run(DialogEvents& events) override;
    void close() override;

    bool hasControl(int control) const override;
    std::wstring text(int control) const override;
    void setText(int control, std::wstring_view text) override;
    COleDateTime dateTime(int control) const override;
    void setDateTime(int control, const COleDateTime& value) override;
    /// @return null: the controller handed its pop-up buttons over when its window was loaded
    std::unique_ptr<IQnComboBoxControl> comboBox(int control) override;
    void focus(int control) override;

private:
    void confirmed() override;
    void givenUp() override;
    void buttonClicked(int control) override;
    NSControl* find(int control) const;

    QXDialogController* m_controller;
    const BoundKeys& m_keys;
    DialogEvents* m_events = nullptr; ///< while it runs
    bool m_is_closed = false;
};

} // namespace quarn
