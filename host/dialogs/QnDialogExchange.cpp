#include "host/app/Application.h"
#include "host/dialogs/DialogState.h"
#include "host/front_end/HeadlessDialogWindow.h"
#include "host/prompt/FrameCountAnswer.h"
#include "host/prompt/NumberText.h"
#include "host/prompt/UsersNumber.h"
#include "sdk/qncore/QnDialog.h"
#include "sdk/qncore/QnLocalize.h"

#include <string>

namespace {

using quarn::DialogState;
using Kind = quarn::DialogControl::Kind;

/// Of QuarnMessageBox: a warning.
constexpr unsigned WARNING_ICON = 48;

/// Whether the exchange goes on with this control, which a range check then speaks of.
bool begins(CQnDialogExchange& exchange, int control) {
    if (exchange.HasFailed() || !exchange.Window().hasControl(control))
        return false;
    exchange.SetLastControl(control);
    return true;
}

std::optional<KM_wString> refusedFrameCount(int number) {
    quarn::Application* application = quarn::Application::forCall("DDX_Text");
    return application ? quarn::refuseFrameCount(*application, number) : std::nullopt;
}

/// What a control shows; the part that it does not show is taken from `kept`.
COleDateTime mergedDateTime(const COleDateTime& shown, const COleDateTime& kept,
                            std::optional<Kind> kind) {
    if (!kept.IsValid() || !shown.IsValid() || (kind != Kind::date && kind != Kind::time))
        return shown;
    const COleDateTime& day = kind == Kind::date ? shown : kept;
    const COleDateTime& time = kind == Kind::time ? shown : kept;
    return {day.GetYear(),  day.GetMonth(),   day.GetDay(),
            time.GetHour(), time.GetMinute(), time.GetSecond()};
}

} // namespace

CQnDialogExchange::CQnDialogExchange(CDialog& dialog, bool store)
    : m_dialog(dialog), m_store(store), m_failed(!dialog.IsOpen()) {}

quarn::DialogWindow& CQnDialogExchange::Window() const {
    static quarn::HeadlessDialogWindow no_window({}, nullptr);
    quarn::DialogWindow* window = DialogState::of(m_dialog).window;
    return window ? *window : no_window;
}

void CQnDialogExchange::Fail(int control, const wchar_t* why) {
    if (m_failed)
        return;
    m_failed = true;
    quarn::Application* application = quarn::Application::forCall("CQnDialogExchange::Fail");
    if (!application)
        return;
    application->frontEnd().showMessage(why ? why : L"",
                                        DialogState::of(m_dialog).form.title.View(), WARNING_ICON);
    Window().focus(control);
}

void DDX_Text(CQnDialogExchange& exchange, int control, double& value) {
    if (!begins(exchange, control))
        return;
    if (!exchange.IsStoring()) {
        exchange.Window().setText(control, quarn::numberText(value).View());
        return;
    }
    const auto number = quarn::readUsersNumber(exchange.Window().text(control));
    if (number)
        value = *number;
    else
        exchange.Fail(control, QnLocalizeString(L"Enter a number", 42412));
}

void DDX_Text(CQnDialogExchange& exchange, int control, int& value) {
    if (!begins(exchange, control))
        return;
    if (!exchange.IsStoring()) {
        exchange.Window().setText(control, std::to_wstring(value));
        return;
    }
    const auto number = quarn::readWholeNumber(exchange.Window().text(control));
    if (!number)
        exchange.Fail(control, QnLocalizeString(L"Enter a whole number", 42413));
    else if (const auto refusal = refusedFrameCount(*number))
        exchange.Fail(control, refusal->Array());
    else
        value = *number;
}

void DDX_Text(CQnDialogExchange& exchange, int control, KM_wString& value) {
    if (!begins(exchange, control))
        return;
    if (exchange.IsStoring())
        value = std::wstring_view(exchange.Window().text(control));
    else
        exchange.Window().setText(control, value.View());
}

void DDX_DateTimeCtrl(CQnDialogExchange& exchange, int control, COleDateTime& value) {
    if (!begins(exchange, control))
        return;
    if (!exchange.IsStoring()) {
        if (value.IsValid())
            exchange.Window().setDateTime(control, value);
        return;
    }
    const auto kind = DialogState::of(exchange.Dialog()).kindOf(control);
    const COleDateTime shown = mergedDateTime(exchange.Window().dateTime(control), value, kind);
    if (shown.IsValid())
        value = shown;
    else
        exchange.Fail(control, QnLocalizeString(L"Enter a date", 42414));
}

void DDV_MinMaxDouble(CQnDialogExchange& exchange, double value, double least, double greatest) {
    if (!exchange.IsStoring() || exchange.HasFailed() || (value >= least && value <= greatest))
        return;
    const KM_wString why = KM_wString::FormatToString(
        QnLocalizeString(L"Enter a number between %s and %s", 42415),
        quarn::numberText(least).Array(), quarn::numberText(greatest).Array());
    exchange.Fail(exchange.LastControl(), why);
}
