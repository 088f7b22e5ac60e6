#include "sdk/qncore/QnApp.h"

#include "host/app/Application.h"

namespace {

std::wstring_view viewOf(const wchar_t* text) {
    return text ? text : L"";
}

} // namespace

CQuarnApp& QuarnApp() {
    static CQuarnApp application;
    return application;
}

CQuarnDoc* CQuarnApp::ActiveDoc() const {
    quarn::Application* application = quarn::Application::forCall("CQuarnApp::ActiveDoc");
    quarn::Document* document = application ? application->documents().active() : nullptr;
    return document ? &document->face() : nullptr;
}

CQuarnView* CQuarnApp::ActiveView() const {
    quarn::Application* application = quarn::Application::forCall("CQuarnApp::ActiveView");
    quarn::Document* document = application ? application->documents().active() : nullptr;
    return document ? &document->activeView().face() : nullptr;
}

void CQuarnApp::Print(const wchar_t* text) const {
    if (quarn::Application* application = quarn::Application::forCall("CQuarnApp::Print"))
        application->print(viewOf(text));
}

bool CQuarnApp::RunScript(unsigned int document_serial_number, const wchar_t* script,
                          int echo) const {
    quarn::Application* application = quarn::Application::forCall("CQuarnApp::RunScript");
    if (!application)
        return false;
    quarn::Document* document = application->documents().find(document_serial_number);
    if (!document) {
        quarn::reportBreach("CQuarnApp::RunScript", "it names no open document");
        return false;
    }
    if (echo)
        application->print(L"Command: " + std::wstring(viewOf(script)) + L"\n");
    const quarn::CommandOrigin origin{&document->face(), false, {}};
    return application->runner().runNested(viewOf(script), origin) == CQuarnCommand::success;
}

void CQuarnApp::Wait(unsigned int milliseconds) const {
    quarn::Application* application = quarn::Application::forCall("CQuarnApp::Wait");
    if (!application)
        return;
    quarn::RunningRecording* const recording = application->recording();
    const bool has_nothing_to_show = recording && recording->hasPassedOver();
    application->frontEnd().pumpEvents(has_nothing_to_show ? 0 : milliseconds);
    if (has_nothing_to_show)
        application->cutWaitShort(milliseconds);
    if (recording)
        recording->beat();
}

HWND CQuarnApp::MainWnd() const {
    quarn::Application* application = quarn::Application::forCall("CQuarnApp::MainWnd");
    return application ? application->frontEnd().mainWindow() : nullptr;
}

int QuarnMessageBox(const wchar_t* text, const wchar_t* title, unsigned int flags) {
    quarn::Application* application = quarn::Application::forCall("QuarnMessageBox");
    return application ? application->frontEnd().showMessage(viewOf(text), viewOf(title), flags)
                       : 1;
}
