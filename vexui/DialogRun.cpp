#include "vexui/DialogRun.h"

#include "sdk/qncore/QnApp.h"
#include "sdk/qncore/QnLocalize.h"
#include "vexui/forms/Form.h"

#include <QApplication>
#include <QPointer>
#include <QThread>

#include <algorithm>

namespace vexui {

namespace {

bool isFormOpen() {
    const QWidgetList windows = QApplication::topLevelWidgets();
    return std::ranges::any_of(
        windows, [](QWidget* window) { return dynamic_cast<Form*>(window) != nullptr; });
}

/// The widget that a window of the front end is. One that is not of this program's Qt is none, and
/// is not touched.
QWidget* widgetOf(HWND window) {
    auto* const candidate = reinterpret_cast<QWidget*>(window);
    return QApplication::allWidgets().contains(candidate) ? candidate->window() : nullptr;
}

/// Deletes the form also when its owner has not done so before.
struct FormScope {
    QPointer<Form> form;
    ~FormScope() { delete form; }
};

bool confirmed(const MakeForm& make_form, IZoetrixDataUI& lists,
               KM_3dmAnimationProperties& record) {
    const FormScope scope{make_form(widgetOf(lists.Parent()))};
    if (scope.form->exec() != QDialog::Accepted || !scope.form)
        return false;
    scope.form->takeInto(lists, record);
    return true;
}

} // namespace

bool canShowWindows() {
    const auto* application = qobject_cast<QApplication*>(QCoreApplication::instance());
    return application && application->thread() == QThread::currentThread();
}

bool runForm(const MakeForm& make_form, IZoetrixDataUI& lists, KM_3dmAnimationProperties& record) {
    // No exception may leave the library: the host was not built to catch it.
    try {
        if (!canShowWindows())
            return false;
        if (!isFormOpen())
            return confirmed(make_form, lists, record);
        QuarnApp().Print(QnLocalizeString(
            L"The form of another animation is open. Close it first. Nothing done\n", 44120));
        return false;
    } catch (...) {
        return false;
    }
}

} // namespace vexui
