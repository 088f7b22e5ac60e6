#include "sdk/vexui/VexUi.h"
#include "tests/plug-ins/TestPlugIn.h"

// A dialog plug-in without a single dialog.

namespace {

class DialogPlugIn final : public TestPlugIn {
public:
    DialogPlugIn() : TestPlugIn("00000000-0000-0000-0000-000000000000") {}
    KM_UUID PlugInID() const override { return ZelVexUiPlugInId; }
};

TestApplication the_application;
DialogPlugIn the_plug_in;

} // namespace

TEST_PLUGIN_EXPORTS
