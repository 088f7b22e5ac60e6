#pragma once

#include "sdk/qncore/QnComboBox.h"
#include "sdk/qncore/QnDateTime.h"
#include "sdk/qncore/QnExport.h"

#include <memory>
#include <string>
#include <string_view>

namespace quarn {

/// What a person does in a dialog's window. The window calls it while it runs.
class QNCORE_API DialogEvents {
public:
    virtual ~DialogEvents();
    /// The OK button, or Enter.
    virtual void confirmed() = 0;
    /// The Cancel button, Escape, or the window's own button.
    virtual void givenUp() = 0;
    /// Another button of the template.
    virtual void buttonClicked(int control) = 0;
};

/// The window of a dialog, made by a front end from a template. Its controls are addressed by id;
/// one that is not there reads as empty, and writing to it does nothing.
class QNCORE_API DialogWindow {
public:
    virtual ~DialogWindow();

    /// Shows the window and works on its events until close() is called.
    virtual void run(DialogEvents& events) = 0;
    /// Makes run() return.
    virtual void close() = 0;

    virtual bool hasControl(int control) const = 0;
    virtual std::wstring text(int control) const = 0;
    virtual void setText(int control, std::wstring_view text) = 0;
    /// What a date or time control shows; the part that it does not show is not looked at.
    virtual COleDateTime dateTime(int control) const = 0;
    virtual void setDateTime(int control, const COleDateTime& value) = 0;
    /// The list of a combo box, for its CComboBox to own; it must not be used once the window is
    /// gone. Null where the control is no combo box.
    virtual std::unique_ptr<IQnComboBoxControl> comboBox(int control) = 0;
    /// Gives a control the keyboard, with its text selected.
    virtual void focus(int control) = 0;
};

} // namespace quarn
