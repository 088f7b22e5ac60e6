#include "zoetrix/plugin/ZoetrixApp.h"

bool CZoetrixApp::InitInstance() {
    CWinApp::InitInstance();
    return true;
}
