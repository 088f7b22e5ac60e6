#include "desktop/dialogs/FormWindow.h"

#include "desktop/dialogs/ComboBoxControl.h"
#include "desktop/dialogs/DialogOwner.h"
#include "desktop/dialogs/FormDialog.h"
#include "desktop/dialogs/FormField.h"
#include "desktop/texts/Texts.h"

#include <QEventLoop>
#include <QPointer>

#include <map>
#include <utility>

namespace quarn::desktop {
namespace {

class FormWindow final : public DialogWindow {
public:
    FormWindow(const DialogTemplate& form, QWidget* owner)
        : m_dialog(new FormDialog(form, owner)) {}

    ~FormWindow() override { delete m_dialog.data(); }

    void run(DialogEvents& events) override;
    void close() override;

    bool hasControl(int control) const override { return field(control) != nullptr; }
    std::wstring text(int control) const override;
    void setText(int control, std::wstring_view text) override;
    COleDateTime dateTime(int control) const override;
    void setDateTime(int control, const COleDateTime& value) override;
    std::unique_ptr<IQnComboBoxControl> comboBox(int control) override;
    void focus(int control) override;

private:
    QWidget* field(int control) const { return m_dialog ? m_dialog->field(control) : nullptr; }

    QPointer<FormDialog> m_dialog;
    QPointer<QEventLoop> m_loop; ///< while it runs
    bool m_is_closed = false;
    std::map<int, COleDateTime> m_written; ///< date-times whose control shows a part of them
};

/// Also when the widget is destroyed, or the program ends, the dialog hears that it is over.
void FormWindow::run(DialogEvents& events) {
    if (m_loop)
        return;
    if (m_dialog && !m_is_closed) {
        QEventLoop loop;
        m_loop = &loop;
        QObject::connect(m_dialog, &QObject::destroyed, &loop, &QEventLoop::quit);
        m_dialog->open(events);
        loop.exec();
    }
    m_loop = nullptr;
    if (!m_is_closed)
        events.givenUp();
    if (m_dialog)
        m_dialog->leave();
    m_is_closed = false;
}

void FormWindow::close() {
    m_is_closed = true;
    if (m_dialog)
        m_dialog->leave();
    if (m_loop)
        m_loop->quit();
}

std::wstring FormWindow::text(int control) const {
    const QWidget* const widget = field(control);
    return widget ? fieldText(*widget) : std::wstring();
}

void FormWindow::setText(int control, std::wstring_view text) {
    if (QWidget* const widget = field(control))
        setFieldText(*widget, text);
}

COleDateTime FormWindow::dateTime(int control) const {
    const QWidget* const widget = field(control);
    if (!widget)
        return {};
    const auto written = m_written.find(control);
    return fieldDateTime(*widget, written == m_written.end() ? COleDateTime() : written->second);
}

void FormWindow::setDateTime(int control, const COleDateTime& value) {
    QWidget* const widget = field(control);
    if (!widget || !value.IsValid())
        return;
    m_written[control] = value;
    setFieldDateTime(*widget, value);
}

std::unique_ptr<IQnComboBoxControl> FormWindow::comboBox(int control) {
    auto* const box = qobject_cast<QComboBox*>(field(control));
    return box ? std::make_unique<ComboBoxControl>(box) : nullptr;
}

void FormWindow::focus(int control) {
    if (QWidget* const widget = field(control))
        focusField(*widget);
}

} // namespace

std::unique_ptr<DialogWindow> makeFormWindow(const DialogTemplate& form, QWidget* owner) {
    return std::make_unique<FormWindow>(form, topmostOwner(owner));
}

} // namespace quarn::desktop
