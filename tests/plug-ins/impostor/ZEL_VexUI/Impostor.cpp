#include "tests/plug-ins/TestPlugIn.h"

// Has the dialog plug-in's file name, but another id.

namespace {
TestApplication the_application;
TestPlugIn the_plug_in("0B7E9B0C-6C1E-4C5B-8C55-3A8D0C9F1A70");
} // namespace

TEST_PLUGIN_EXPORTS
