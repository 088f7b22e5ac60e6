#include "zoetrix/commands/CommandGuard.h"

#include "sdk/qncore/QnApp.h"
#include "sdk/qncore/QnLocalize.h"

void ReportUnfinishedCommand() noexcept {
    try {
        QuarnApp().Print(QnLocalizeString(L"Not enough memory. Nothing done\n", 40003));
    } catch (...) {
        // Without memory for the message the command still ends as a failure.
    }
}
