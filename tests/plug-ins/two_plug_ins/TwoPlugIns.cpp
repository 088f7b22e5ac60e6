#include "tests/plug-ins/TestPlugIn.h"

namespace {
TestApplication the_application;
TestPlugIn the_plug_in("0B7E9B0C-6C1E-4C5B-8C55-3A8D0C9F1A40");
TestPlugIn the_other_plug_in("0B7E9B0C-6C1E-4C5B-8C55-3A8D0C9F1A41");
} // namespace

TEST_PLUGIN_EXPORTS
