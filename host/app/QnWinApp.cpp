#include "sdk/qncore/QnWinApp.h"

#include "host/app/PendingObjects.h"

CWinApp::CWinApp() {
    quarn::PendingObjects::announce(*this);
}

CWinApp::~CWinApp() {
    quarn::PendingObjects::forget(*this);
}

bool CWinApp::InitInstance() {
    return true;
}

int CWinApp::ExitInstance() {
    return 0;
}
