#include "tests/plug-ins/TestPlugIn.h"

namespace {

/// Says to which plug-in it belongs, and in the user's language what it found.
class WhoseCommand final : public TestCommand {
public:
    using TestCommand::TestCommand;
    result RunCommand(const CQuarnCommandContext&) override {
        QuarnApp().Print(QnLocalizeString(L"I belong to ", 7));
        QuarnApp().Print(PlugIn() ? PlugIn()->PlugInName() : L"nobody");
        QuarnApp().Print(L"\n");
        return success;
    }
};

TestApplication the_application;
TestPlugIn the_plug_in("0B7E9B0C-6C1E-4C5B-8C55-3A8D0C9F1A01");
TestCommand the_command(L"TestGood", "0B7E9B0C-6C1E-4C5B-8C55-3A8D0C9F1A02");
WhoseCommand the_whose_command(L"TestWhose", "0B7E9B0C-6C1E-4C5B-8C55-3A8D0C9F1A03");

} // namespace

TEST_PLUGIN_EXPORTS
