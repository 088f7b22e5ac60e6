#include "zoetrix/commands/CommandGuard.h"

#include "sdk/qncore/QnApp.h"
#include "sdk/qncore/QnLocalize.h"

#include <exception>
#include <new>
#include <stdexcept>

namespace {

void ReportLackOfMemory() {
    QuarnApp().Print(QnLocalizeString(L"Not enough memory. Nothing done\n", 40003));
}

void ReportError(const KM_wString& what) {
    QuarnApp().Print(KM_wString::FormatToString(
        QnLocalizeString(L"Unexpected error: %s. Nothing done\n", 40004), what.Array()));
}

void ReportHandledException() {
    try {
        throw;
    } catch (const std::bad_alloc&) {
        ReportLackOfMemory();
    } catch (const std::length_error&) { // more than a container can ever hold
        ReportLackOfMemory();
    } catch (const std::exception& error) {
        ReportError(KM_wString::FromUtf8(error.what()));
    } catch (...) {
        ReportError(QnLocalizeString(L"unknown", 40015));
    }
}

} // namespace

void ReportUnfinishedCommand() noexcept {
    try {
        ReportHandledException();
    } catch (...) {
        // Without memory for the message the command still ends as a failure.
    }
}
