#include "host/dialogs/DialogState.h"

#include "host/app/Application.h"
#include "host/border/Border.h"
#include "host/dialogs/DialogTemplates.h"
#include "sdk/qncore/QnLocalize.h"

#include <algorithm>
#include <dlfcn.h>
#include <typeinfo>

namespace quarn {

namespace {

/// The file of the plug-in, or of the program, that the dialog's class is part of.
std::filesystem::path libraryOf(const CDialog& dialog) {
    Dl_info library{};
    if (!dladdr(&typeid(dialog), &library) || !library.dli_fname)
        return {};
    std::error_code error;
    const std::filesystem::path whole = std::filesystem::canonical(library.dli_fname, error);
    return error ? std::filesystem::path(library.dli_fname) : whole;
}

/// Whether the dialog may be opened now; tells why not.
bool mayOpen(Application& application) {
    if (application.openDialog())
        application.tell(
            KM_wString(QnLocalizeString(L"Another dialog is open. Close it first.", 42410))
                .ToUtf8());
    return !application.openDialog();
}

/// The dialog is the open one for as long as this lives.
class OpenDialog {
public:
    OpenDialog(Application& application, DialogState& state, DialogWindow& window)
        : m_application(application), m_state(state) {
        m_application.setOpenDialog(&state.dialog);
        m_state.window = &window;
        m_state.result.reset();
    }
    ~OpenDialog() {
        m_state.window = nullptr;
        m_application.setOpenDialog(nullptr);
    }
    OpenDialog(const OpenDialog&) = delete;
    OpenDialog& operator=(const OpenDialog&) = delete;

private:
    Application& m_application;
    DialogState& m_state;
};

} // namespace

int DialogState::show() {
    if (const std::optional<int> ended = showWhereThereAreDialogs())
        return *ended;
    Application::current()->tell(
        KM_wString::FormatToString(QnLocalizeString(L"The dialog \"%s\" cannot be shown: there is "
                                                    L"no window here.",
                                                    42411),
                                   form.title.Array())
            .ToUtf8());
    return QnDialogNotShown;
}

std::optional<int> DialogState::showWhereThereAreDialogs() {
    Application* application = Application::forCall("CDialog::DoModal");
    if (!application || !mayOpen(*application))
        return QnDialogNotShown;
    Result<DialogTemplate> read = readForm(*application);
    if (!read) {
        application->tell(read.message());
        return QnDialogNotShown;
    }
    form = std::move(read.value());
    const auto made = application->frontEnd().makeDialog(form, parent ? parent->m_hWnd : nullptr);
    return made ? std::optional(runIn(*application, *made)) : std::nullopt;
}

Result<DialogTemplate> DialogState::readForm(Application& application) const {
    const auto folders =
        dialogTemplateFolders(libraryOf(dialog), application.options().dialog_folders);
    return findDialogTemplate(template_id, folders, application.texts());
}

int DialogState::showIn(DialogWindow& shown_window) {
    Application* application = Application::forCall("CQuarnDialog::DoModalIn");
    if (!application || !mayOpen(*application))
        return QnDialogNotShown;
    Result<DialogTemplate> read = readForm(*application);
    form = read ? std::move(read.value()) : DialogTemplate{};
    form.controls.clear();
    return runIn(*application, shown_window);
}

int DialogState::runIn(Application& application, DialogWindow& shown_window) {
    const OpenDialog open(application, *this, shown_window);
    const AttachedComboBoxes attached(*this, shown_window);
    int takes_focus = 1;
    call("OnInitDialog", [&] { takes_focus = dialog.OnInitDialog(); });
    if (takes_focus != 0 && !form.controls.empty())
        shown_window.focus(form.controls.front().id);
    if (!result)
        shown_window.run(*this);
    return result.value_or(QnDialogGivenUp);
}

void DialogState::end(int how) {
    if (!window || result)
        return;
    result = how;
    window->close();
}

std::optional<DialogControl::Kind> DialogState::kindOf(int control) const {
    const auto found = std::ranges::find(form.controls, control, &DialogControl::id);
    return found == form.controls.end() ? std::nullopt : std::optional(found->kind);
}

void DialogState::confirmed() {
    call("OnOK", [this] { dialog.OnOK(); });
}

void DialogState::givenUp() {
    call("OnCancel", [this] { dialog.OnCancel(); });
}

void DialogState::buttonClicked(int control) {
    call("OnButton", [this, control] { dialog.OnButton(control); });
}

void DialogState::call(const char* name, const std::function<void()>& operation) {
    if (result)
        return;
    const Result<void> called = acrossBorder(operation);
    if (called)
        return;
    Application::current()->tell(std::string(name) + " of the dialog " +
                                 std::to_string(template_id) +
                                 " stopped with an error: " + called.message() + ".");
    end(QnDialogNotShown);
}

AttachedComboBoxes::AttachedComboBoxes(const DialogState& state, DialogWindow& window) {
    for (const auto& [control, combo_box] : state.combo_boxes) {
        if (std::unique_ptr<IQnComboBoxControl> list = window.comboBox(control)) {
            combo_box->SetControl(std::move(list));
            m_attached.push_back(combo_box);
        }
    }
}

AttachedComboBoxes::~AttachedComboBoxes() {
    for (CComboBox* combo_box : m_attached)
        combo_box->SetControl(nullptr);
}

} // namespace quarn
