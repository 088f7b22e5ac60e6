#include "host/commands/HostCommands.h"

#include "host/app/PendingObjects.h"
#include "sdk/qncore/QnLocalize.h"

namespace quarn {

namespace {

/// Every command of the host: one line here, one function anywhere in this folder.
constexpr HostCommandEntry HOST_COMMANDS[] = {
    {L"Exit", "B9C1E0A4-2F1D-4C52-9A0B-6E4C0D5A7F01", L"Ends the program", 41001, runExit},
    {L"Help", "5D0E7A36-8B7C-4F0E-A3C9-1B2D47E6C802", L"Lists the commands, or tells what one does",
     41002, runHelp},
    {L"LoadPlugIn", "E27F5C18-64A9-4D3B-8E15-90BD1C3A5F03", L"Loads a plug-in file", 41003,
     runLoadPlugIn},
    {L"Run", "0A6D3B92-C57E-4E81-B6F4-3D9E21A8C704",
     L"Opens a file with the desktop's program for it", 41004, runRun},
};

class HostCommand final : public CQuarnCommand {
public:
    explicit HostCommand(const HostCommandEntry& entry) : m_entry(&entry) {}

    KM_UUID CommandUUID() override { return KM_UuidFromString(m_entry->id); }
    const wchar_t* EnglishCommandName() override { return m_entry->name; }
    const wchar_t* CommandDescription() override {
        return QnLocalizeString(m_entry->description, m_entry->description_id);
    }
    result RunCommand(const CQuarnCommandContext& context) override {
        return m_entry->run(context);
    }

private:
    const HostCommandEntry* m_entry;
};

} // namespace

std::vector<std::unique_ptr<CQuarnCommand>> makeHostCommands() {
    const PendingObjects::Scope unannounced;
    std::vector<std::unique_ptr<CQuarnCommand>> commands;
    for (const HostCommandEntry& entry : HOST_COMMANDS)
        commands.push_back(std::make_unique<HostCommand>(entry));
    return commands;
}

} // namespace quarn
