#include "zoetrix/commands/UnavailableCommand.h"

#include "sdk/qncore/QnApp.h"
#include "sdk/qncore/QnLocalize.h"

CQuarnCommand::result ReportUnavailable(const wchar_t* command_name) {
    const wchar_t* message =
        QnLocalizeString(L"%s is not available in this version. Nothing done\n", 40004);
    QuarnApp().Print(KM_wString::FormatToString(message, command_name));
    return CQuarnCommand::failure;
}
