#include "sdk/qncore/QnWnd.h"

#include "host/app/Application.h"

CWnd* CWnd::FromHandle(HWND window) {
    quarn::Application* application = quarn::Application::forCall("CWnd::FromHandle");
    return application ? application->windowFor(window) : nullptr;
}

CWnd::~CWnd() = default;
