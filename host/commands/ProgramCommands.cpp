#include "host/app/Application.h"
#include "host/commands/CommandEnd.h"
#include "host/commands/FileAsking.h"
#include "host/commands/HostCommands.h"
#include "host/commands/WordsLeft.h"
#include "sdk/qncore/QnGet.h"

namespace quarn {

namespace {

void printLine(Application& application, const RegisteredCommand& entry) {
    const KM_wString name = KM_wString::FormatToString(L"%-24s ", entry.local_name.Array());
    application.print((name + entry.command->CommandDescription() + L"\n").View());
}

CQuarnCommand::result listCommands(Application& application) {
    for (const RegisteredCommand& entry : application.commands().sortedByName()) {
        if (!entry.command->IsHidden())
            printLine(application, entry);
    }
    return CQuarnCommand::success;
}

} // namespace

CQuarnCommand::result runExit(const CQuarnCommandContext&) {
    Application::current()->requestExit();
    return CQuarnCommand::success;
}

CQuarnCommand::result runHelp(const CQuarnCommandContext&) {
    Application& application = *Application::current();
    if (!hasWordsLeft())
        return listCommands(application);
    CQuarnGetString get;
    get.SetCommandPrompt(QnLocalizeString(L"Command", 41101));
    if (get.GetString() != CQuarnGet::string)
        return get.CommandResult();
    const RegisteredCommand* entry = application.commands().find(get.String());
    if (!entry)
        return fail("Unknown command: " + KM_wString(get.String()).ToUtf8() +
                    ". Type Help for the list.");
    printLine(application, *entry);
    return CQuarnCommand::success;
}

CQuarnCommand::result runLoadPlugIn(const CQuarnCommandContext& context) {
    Application& application = *Application::current();
    std::filesystem::path file;
    const CQuarnCommand::result asked =
        askFile(context, FileUse::load_plug_in, QnLocalizeString(L"Plug-in file", 41102), file);
    if (asked != CQuarnCommand::success)
        return asked;
    const PlugInLoad load = application.plugIns().load(file);
    if (!load.ok())
        return fail(load.message);
    application.tell("Loaded " + file.filename().string() + ".");
    return CQuarnCommand::success;
}

} // namespace quarn
