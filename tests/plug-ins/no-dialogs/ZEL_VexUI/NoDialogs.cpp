// A dialog plug-in that has no dialogs.

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
