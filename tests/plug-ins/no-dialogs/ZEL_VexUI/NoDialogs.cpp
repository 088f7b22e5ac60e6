#include "sdk/vexui/VexUi.h"
#include "tests/plug-ins/TestPlugIn.h"

// A dialog plug-in without a single dialog. Where the environment variable QUARN_DIALOG_PLUG_IN
// says "disabled" it is marked as never to be loaded, where it says "refuses" it does not let
// itself load.

namespace {

bool Is(const std::string& kind) {
    const char* wanted = std::getenv("QUARN_DIALOG_PLUG_IN");
    return wanted && wanted == kind;
}

class DialogPlugIn final : public TestPlugIn {
public:
    DialogPlugIn() : TestPlugIn("00000000-0000-0000-0000-000000000000") {}
    KM_UUID PlugInID() const override { return ZelVexUiPlugInId; }
    plugin_load_time PlugInLoadTime() const override {
        return Is("disabled") ? load_disabled : load_when_needed;
    }
    bool OnLoadPlugIn() override { return !Is("refuses"); }
};

TestApplication the_application;
DialogPlugIn the_plug_in;

} // namespace

TEST_PLUGIN_EXPORTS
