#include "tests/plug-ins/TestPlugIn.h"

#include <stdexcept>

// Refuses, or throws, in the call that QUARN_TEST_FAULT names: "init=refuse", "load=throw", ...

namespace {

bool Allows(const std::string& call) {
    const char* fault = std::getenv("QUARN_TEST_FAULT");
    const std::string wanted = fault ? fault : "";
    if (wanted == call + "=throw")
        throw std::runtime_error("thrown in " + call);
    return wanted != call + "=refuse";
}

class RefusingApplication final : public TestApplication {
public:
    bool InitInstance() override { return TestApplication::InitInstance() && Allows("init"); }
    int ExitInstance() override {
        Allows("exit");
        return TestApplication::ExitInstance();
    }
};

class RefusingPlugIn final : public TestPlugIn {
public:
    using TestPlugIn::TestPlugIn;
    KM_UUID PlugInID() const override {
        return Allows("id") ? TestPlugIn::PlugInID() : KM_nil_uuid;
    }
    bool OnLoadPlugIn() override { return TestPlugIn::OnLoadPlugIn() && Allows("load"); }
    void OnUnloadPlugIn() override {
        TestPlugIn::OnUnloadPlugIn();
        Allows("unload");
    }
};

class RefusingCommand final : public TestCommand {
public:
    using TestCommand::TestCommand;
    result RunCommand(const CQuarnCommandContext&) override {
        return Allows("run") ? success : failure;
    }
};

RefusingApplication the_application;
RefusingPlugIn the_plug_in("0B7E9B0C-6C1E-4C5B-8C55-3A8D0C9F1A30");
RefusingCommand the_command(L"TestRefusing", "0B7E9B0C-6C1E-4C5B-8C55-3A8D0C9F1A31");

} // namespace

TEST_PLUGIN_EXPORTS
