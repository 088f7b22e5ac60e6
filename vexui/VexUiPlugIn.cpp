#include "vexui/VexUiPlugIn.h"

#include "sdk/qncore/QnApp.h"
#include "sdk/qncore/QnLocalize.h"
#include "sdk/qncore/QnWinApp.h"
#include "sdk/vexui/VexUi.h"
#include "vexui/DialogRun.h"

namespace {

// Announced to the host as the file is opened.
CWinApp the_application;
CVexUiPlugIn the_plug_in;

} // namespace

const wchar_t* CVexUiPlugIn::PlugInName() const {
    return L"Vex UI";
}

const wchar_t* CVexUiPlugIn::LocalPlugInName() const {
    return QnLocalizeString(L"Vex UI", 44122);
}

const wchar_t* CVexUiPlugIn::PlugInVersion() const {
    return L"1.0";
}

KM_UUID CVexUiPlugIn::PlugInID() const {
    return ZelVexUiPlugInId;
}

CQuarnPlugIn::plugin_load_time CVexUiPlugIn::PlugInLoadTime() const {
    return load_when_needed;
}

bool CVexUiPlugIn::OnLoadPlugIn() {
    if (vexui::canShowWindows())
        return CQuarnUtilitySystemPlugIn::OnLoadPlugIn();
    QuarnApp().Print(
        QnLocalizeString(L"Vex UI was not loaded: this program shows no windows.\n", 44121));
    return false;
}
