#include "sdk/qncore/QnExport.h"

// The host looks these up by name before it touches any object of the plug-in.

QN_PLUGIN_ENTRY unsigned int QuarnPlugInSdkVersion() {
    return QUARN_SDK_VERSION;
}

QN_PLUGIN_ENTRY unsigned int QuarnPlugInSdkServiceRelease() {
    return QUARN_SDK_VERSION;
}

QN_PLUGIN_ENTRY const wchar_t* QuarnPlugInUpdateURL() {
    return L"https://quarn.example/download";
}

QN_PLUGIN_ENTRY const wchar_t* QuarnPlugInDeveloperOrganization() {
    return L"Quarn";
}

QN_PLUGIN_ENTRY const wchar_t* QuarnPlugInDeveloperAddress() {
    return L"1 Example Street";
}

QN_PLUGIN_ENTRY const wchar_t* QuarnPlugInDeveloperCountry() {
    return L"Example Country";
}

QN_PLUGIN_ENTRY const wchar_t* QuarnPlugInDeveloperPhone() {
    return L"+1 555 0100";
}

QN_PLUGIN_ENTRY const wchar_t* QuarnPlugInDeveloperFax() {
    return L"+1 555 0101";
}

QN_PLUGIN_ENTRY const wchar_t* QuarnPlugInDeveloperEmail() {
    return L"dialogs@quarn.example";
}

QN_PLUGIN_ENTRY const wchar_t* QuarnPlugInDeveloperWebsite() {
    return L"https://quarn.example/zoetrix";
}
