#pragma once

// What the small plug-ins of the loader's tests share. Each is one source, so everything is inline
// or a macro that defines it once.

#include "sdk/qncore/qncore.h"

#include <cstdlib>
#include <string>

/// Adds a word to the journal, an environment variable that the test reads.
inline void AddToJournal(const std::string& word) {
    const char* journal = std::getenv("QUARN_TEST_JOURNAL");
    setenv("QUARN_TEST_JOURNAL", ((journal ? journal : "") + word + " ").c_str(), 1);
}

class TestApplication : public CWinApp {
public:
    bool InitInstance() override {
        AddToJournal("init");
        return true;
    }
    int ExitInstance() override {
        AddToJournal("exit");
        return 0;
    }
};

/// Writes its life into the journal.
class TestPlugIn : public CQuarnUtilityPlugIn {
public:
    explicit TestPlugIn(const char* id) : m_id(KM_UuidFromString(id)) { AddToJournal("construct"); }
    ~TestPlugIn() override { AddToJournal("destroy"); }
    const wchar_t* PlugInName() const override { return L"Test"; }
    const wchar_t* PlugInVersion() const override { return L"1"; }
    KM_UUID PlugInID() const override { return m_id; }
    bool OnLoadPlugIn() override {
        AddToJournal("load");
        return true;
    }
    void OnUnloadPlugIn() override { AddToJournal("unload"); }

private:
    KM_UUID m_id;
};

/// A command that tells the journal that it ran.
class TestCommand : public CQuarnCommand {
public:
    TestCommand(const wchar_t* name, const char* id) : m_name(name), m_id(KM_UuidFromString(id)) {}
    KM_UUID CommandUUID() override { return m_id; }
    const wchar_t* EnglishCommandName() override { return m_name; }
    result RunCommand(const CQuarnCommandContext&) override {
        AddToJournal("run");
        return success;
    }

private:
    const wchar_t* m_name;
    KM_UUID m_id;
};

#define TEST_PLUGIN_VERSIONS(version)                                                              \
    QN_PLUGIN_ENTRY unsigned int QuarnPlugInSdkVersion() {                                         \
        return version;                                                                            \
    }                                                                                              \
    QN_PLUGIN_ENTRY unsigned int QuarnPlugInSdkServiceRelease() {                                  \
        return version;                                                                            \
    }

#define TEST_PLUGIN_CONTACTS                                                                       \
    QN_PLUGIN_ENTRY const wchar_t* QuarnPlugInUpdateURL() {                                        \
        return L"";                                                                                \
    }                                                                                              \
    QN_PLUGIN_ENTRY const wchar_t* QuarnPlugInDeveloperOrganization() {                            \
        return L"";                                                                                \
    }                                                                                              \
    QN_PLUGIN_ENTRY const wchar_t* QuarnPlugInDeveloperAddress() {                                 \
        return L"";                                                                                \
    }                                                                                              \
    QN_PLUGIN_ENTRY const wchar_t* QuarnPlugInDeveloperCountry() {                                 \
        return L"";                                                                                \
    }                                                                                              \
    QN_PLUGIN_ENTRY const wchar_t* QuarnPlugInDeveloperPhone() {                                   \
        return L"";                                                                                \
    }                                                                                              \
    QN_PLUGIN_ENTRY const wchar_t* QuarnPlugInDeveloperFax() {                                     \
        return L"";                                                                                \
    }                                                                                              \
    QN_PLUGIN_ENTRY const wchar_t* QuarnPlugInDeveloperEmail() {                                   \
        return L"";                                                                                \
    }                                                                                              \
    QN_PLUGIN_ENTRY const wchar_t* QuarnPlugInDeveloperWebsite() {                                 \
        return L"";                                                                                \
    }

#define TEST_PLUGIN_EXPORTS                                                                        \
    TEST_PLUGIN_VERSIONS(QUARN_SDK_VERSION)                                                        \
    TEST_PLUGIN_CONTACTS
