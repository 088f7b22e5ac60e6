#include "tests/plug-ins/TestPlugIn.h"

namespace {

/// Asks for a number in a form of the plug-in's own.
class NumberDialog final : public CQuarnDialog {
public:
    NumberDialog() : CQuarnDialog(400, nullptr) {}
    int m_number = 12;

private:
    void DoDataExchange(CQnDialogExchange& exchange) override { DDX_Text(exchange, 401, m_number); }
};

/// Prints the number that was entered, where a person can be shown a form.
class FormCommand final : public TestCommand {
public:
    using TestCommand::TestCommand;
    result RunCommand(const CQuarnCommandContext& context) override {
        NumberDialog dialog;
        if (!context.IsInteractive())
            return nothing;
        const int answer = dialog.DoModal();
        if (answer != 1)
            return answer == 2 ? cancel : failure;
        QuarnApp().Print(KM_wString::FormatToString(L"It is %d\n", dialog.m_number));
        return success;
    }
};

TestApplication the_application;
TestPlugIn the_plug_in("0B7E9B0C-6C1E-4C5B-8C55-3A8D0C9F1A71");
FormCommand the_command(L"TestForm", "0B7E9B0C-6C1E-4C5B-8C55-3A8D0C9F1A72");

} // namespace

TEST_PLUGIN_EXPORTS
