#include "tests/plug-ins/TestPlugIn.h"

namespace {
TestApplication the_application;
TestPlugIn the_plug_in("0B7E9B0C-6C1E-4C5B-8C55-3A8D0C9F1A10");
TestCommand the_command(L"TestGood", "0B7E9B0C-6C1E-4C5B-8C55-3A8D0C9F1A11");
} // namespace

QN_PLUGIN_ENTRY unsigned int QuarnPlugInSdkVersion() {
    return QUARN_SDK_VERSION;
}
TEST_PLUGIN_CONTACTS
