#include "host/app/Application.h"
#include "host/commands/HostCommands.h"
#include "sdk/qncore/QnGet.h"
#include "sdk/qncore/QnLocalize.h"

namespace quarn {

CQuarnCommand::result runJpegQuality(const CQuarnCommandContext&) {
    Application& application = *Application::current();
    CQuarnGetInteger get;
    get.SetCommandPrompt(QnLocalizeString(L"Quality of JPEG pictures", 42841));
    get.SetDefaultInteger(application.jpegQuality());
    get.SetLowerLimit(1);
    get.SetUpperLimit(100);
    if (get.GetNumber() == CQuarnGet::number)
        application.setJpegQuality(get.Number());
    return get.CommandResult();
}

} // namespace quarn
