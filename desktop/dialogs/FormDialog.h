#pragma once

#include "host/front_end/DialogTemplate.h"
#include "host/front_end/DialogWindow.h"

#include <QDialog>

#include <map>

class QFormLayout;
class QHBoxLayout;

namespace quarn::desktop {

/// The widget of a form. It does not close itself: it tells its events what the person did.
class FormDialog final : public QDialog {
public:
    FormDialog(const DialogTemplate& form, QWidget* owner);

    /// Shows it; what the person does is told to `events` until leave() is called.
    void open(DialogEvents& events);
    /// Hides it.
    void leave();

    /// The widget of a control; null when there is none. The first of several with one id.
    QWidget* field(int control) const;

    // ---- Of QDialog: OK and Enter; Cancel, Escape and the window's own button.
    void accept() override;
    void reject() override;

private:
    using QDialog::open;
    void addControl(const DialogControl& control, const QString& label, QFormLayout& rows);
    void addButtons(QLayout& column);

    std::map<int, QWidget*> m_fields;
    QHBoxLayout* m_row = nullptr; ///< the last one, that further controls may join
    QWidget* m_last = nullptr;    ///< in the order of the Tab key
    DialogEvents* m_events = nullptr;
};

} // namespace quarn::desktop
