#include "tests/plug-ins/TestPlugIn.h"

#include "sdk/vexui/VexUi.h"

// Stands in for the dialog plug-in and says what it does; refuses where QUARN_TEST_FAULT asks for
// it.

namespace {

class TalkativePlugIn final : public TestPlugIn {
public:
    using TestPlugIn::TestPlugIn;
    KM_UUID PlugInID() const override { return ZelVexUiPlugInId; }
    bool OnLoadPlugIn() override {
        QuarnApp().Print(L"I look around.\n");
        return !std::getenv("QUARN_TEST_FAULT");
    }
};

TestApplication the_application;
TalkativePlugIn the_plug_in("0B7E9B0C-6C1E-4C5B-8C55-3A8D0C9F1A80"); // its own id is another one

} // namespace

TEST_PLUGIN_EXPORTS
