#include "tests/plug-ins/TestPlugIn.h"

namespace {
TestApplication the_application;
TestCommand the_command(L"TestGood", "0B7E9B0C-6C1E-4C5B-8C55-3A8D0C9F1A51");
} // namespace

TEST_PLUGIN_EXPORTS
