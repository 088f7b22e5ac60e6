#include "host/app/Application.h"
#include "host/app/PathText.h"
#include "host/commands/FileOpener.h"
#include "host/commands/HostCommands.h"
#include "sdk/qncore/QnGet.h"

namespace quarn {

CQuarnCommand::result runRun(const CQuarnCommandContext&) {
    Application& application = *Application::current();
    CQuarnGetString get;
    get.SetCommandPrompt(QnLocalizeString(L"File to open", 41103));
    if (get.GetString() != CQuarnGet::string)
        return get.CommandResult();
    const Result<void> opened = openWithDesktop(pathFromText(get.String()), application.frontEnd());
    if (opened)
        return CQuarnCommand::success;
    application.tell(opened.message());
    return CQuarnCommand::failure;
}

} // namespace quarn
