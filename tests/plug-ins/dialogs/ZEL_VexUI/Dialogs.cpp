// A dialog plug-in whose turntable dialog is answered by the test.

#include "sdk/qncore/QnPlugIn.h"
#include "sdk/qncore/QnWinApp.h"
#include "sdk/vexui/VexUi.h"

namespace {

class DialogPlugIn final : public CQuarnUtilityPlugIn {
public:
    const wchar_t* PlugInName() const override { return L"Dialogs"; }
    const wchar_t* PlugInVersion() const override { return L"1"; }
    KM_UUID PlugInID() const override { return ZelVexUiPlugInId; }
};

CWinApp the_app;
DialogPlugIn the_plug_in;
QnZoetrixVexUiDialog the_answer = nullptr;

} // namespace

QN_PLUGIN_ENTRY unsigned int QuarnPlugInSdkVersion() {
    return QUARN_SDK_VERSION;
}
QN_PLUGIN_ENTRY unsigned int QuarnPlugInSdkServiceRelease() {
    return QUARN_SDK_VERSION;
}
QN_PLUGIN_ENTRY const wchar_t* QuarnPlugInUpdateURL() {
    return L"";
}
QN_PLUGIN_ENTRY const wchar_t* QuarnPlugInDeveloperOrganization() {
    return L"";
}
QN_PLUGIN_ENTRY const wchar_t* QuarnPlugInDeveloperAddress() {
    return L"";
}
QN_PLUGIN_ENTRY const wchar_t* QuarnPlugInDeveloperCountry() {
    return L"";
}
QN_PLUGIN_ENTRY const wchar_t* QuarnPlugInDeveloperPhone() {
    return L"";
}
QN_PLUGIN_ENTRY const wchar_t* QuarnPlugInDeveloperFax() {
    return L"";
}
QN_PLUGIN_ENTRY const wchar_t* QuarnPlugInDeveloperEmail() {
    return L"";
}
QN_PLUGIN_ENTRY const wchar_t* QuarnPlugInDeveloperWebsite() {
    return L"";
}

/// Chooses what answers the dialog from now on; without one it is closed unconfirmed.
QN_PLUGIN_ENTRY void AnswerTurnTableWith(QnZoetrixVexUiDialog answer) {
    the_answer = answer;
}

QN_PLUGIN_ENTRY bool ZelVexUiTurnTable(IZoetrixDataUI& lists, KM_3dmAnimationProperties& record) {
    return the_answer && the_answer(lists, record);
}
