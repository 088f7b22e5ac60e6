#pragma once

#include "host/front_end/DialogTemplate.h"
#include "host/front_end/DialogWindow.h"
#include "sdk/qncore/QnExport.h"

#include <functional>
#include <map>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace quarn {

/// A dialog's window that nobody sees: a plain model of its controls, and a script in the place of
/// the person. What the person does comes true only while the dialog runs and returns whether it
/// could be done, as a control that is not there, or a list without such an entry, cannot be used.
///
/// A date or time control shows 2000-01-01 00:00:00 until it is given another; as in every window,
/// it takes dates of the calendar only.
class QNCORE_API HeadlessDialogWindow final : public DialogWindow {
public:
    /// What a person does in the window, from its being shown to its being closed. A script that
    /// ends with the window open has closed it with the window's own button.
    using Script = std::function<void(HeadlessDialogWindow&)>;

    HeadlessDialogWindow(DialogTemplate form, Script script);
    ~HeadlessDialogWindow() override;
    HeadlessDialogWindow(const HeadlessDialogWindow&) = delete;
    HeadlessDialogWindow& operator=(const HeadlessDialogWindow&) = delete;

    // ---- What a person does

    /// Replaces the text of a text, number or integer control.
    bool type(int control, std::wstring_view text);
    /// Chooses a date or a time.
    bool choose(int control, const COleDateTime& value);
    /// Picks an entry of a combo box. @param index  from 0
    bool pick(int control, int index);
    /// Clicks a button of the template.
    bool click(int control);
    bool pressOk();
    bool pressCancel();
    /// The window's own button, or Escape.
    bool pressClose();

    // ---- What a person sees

    const DialogTemplate& form() const { return m_form; }
    bool isOpen() const { return m_events != nullptr; }
    /// The entries of a combo box; none where the control is none.
    std::vector<std::wstring> entries(int control) const;
    /// The index of the entry that a combo box shows; -1 for none.
    int pickedEntry(int control) const;
    /// The control that has the keyboard; the first one of the form until another got it, and 0 in
    /// a form without controls.
    int focusedControl() const { return m_focused; }

    void run(DialogEvents& events) override;
    void close() override;
    bool hasControl(int control) const override;
    std::wstring text(int control) const override;
    void setText(int control, std::wstring_view text) override;
    COleDateTime dateTime(int control) const override;
    void setDateTime(int control, const COleDateTime& value) override;
    std::unique_ptr<IQnComboBoxControl> comboBox(int control) override;
    void focus(int control) override;

private:
    struct List;
    class ListControl;
    enum class Content { none, text, date_time, list, button };

    Content contentOf(int control) const;
    const List* listOf(int control) const;

    DialogTemplate m_form;
    Script m_script;
    DialogEvents* m_events = nullptr; ///< while the window is open
    int m_focused = 0;
    std::map<int, std::wstring> m_texts;
    std::map<int, COleDateTime> m_dates;
    std::map<int, std::unique_ptr<List>> m_lists;
};

} // namespace quarn
