// A plug-in with one command. Load it with the host command LoadPlugIn, then run Hello.

#include "sdk/qncore/qncore.h"

namespace {

class HelloPlugIn final : public CQuarnUtilityPlugIn {
public:
    const wchar_t* PlugInName() const override { return L"Hello"; }
    const wchar_t* PlugInVersion() const override { return L"1.0"; }
    KM_UUID PlugInID() const override {
        return KM_UuidFromString("F1C42C64-6F3D-489B-91B5-F32482760F4D");
    }
};

class HelloCommand final : public CQuarnCommand {
public:
    KM_UUID CommandUUID() override {
        return KM_UuidFromString("63492558-8AE5-4430-90ED-945D03F92617");
    }
    const wchar_t* EnglishCommandName() override { return L"Hello"; }
    const wchar_t* CommandDescription() override { return L"Greets whoever reads along"; }

    result RunCommand(const CQuarnCommandContext&) override {
        QuarnApp().Print(L"Hello from a plug-in\n");
        return success;
    }
};

// Announced to the host in this order as the file is opened.
CWinApp the_application;
HelloPlugIn the_plug_in;
HelloCommand the_hello_command;

} // namespace

QN_PLUGIN_ENTRY unsigned int QuarnPlugInSdkVersion() {
    return QUARN_SDK_VERSION;
}
QN_PLUGIN_ENTRY unsigned int QuarnPlugInSdkServiceRelease() {
    return QUARN_SDK_VERSION;
}
QN_PLUGIN_ENTRY const wchar_t* QuarnPlugInUpdateURL() {
    return L"https://quarn.example/";
}
QN_PLUGIN_ENTRY const wchar_t* QuarnPlugInDeveloperOrganization() {
    return L"Your name";
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
    return L"you@quarn.example";
}
QN_PLUGIN_ENTRY const wchar_t* QuarnPlugInDeveloperWebsite() {
    return L"https://quarn.example/";
}
