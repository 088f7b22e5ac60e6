#include "host/app/Application.h"
#include "host/commands/DesktopOpener.h"
#include "host/commands/FileAsking.h"
#include "host/commands/HostCommands.h"
#include "sdk/qncore/QnLocalize.h"

namespace quarn {

CQuarnCommand::result runRun(const CQuarnCommandContext& context) {
    Application& application = *Application::current();
    std::filesystem::path file;
    const CQuarnCommand::result asked =
        askFile(context, FileUse::run, QnLocalizeString(L"File to open", 41103), file);
    if (asked != CQuarnCommand::success)
        return asked;
    const Result<void> opened = openWithDesktop(file, application.frontEnd());
    if (opened)
        return CQuarnCommand::success;
    application.tell(opened.message());
    return CQuarnCommand::failure;
}

} // namespace quarn
