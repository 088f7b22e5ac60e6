#include "zoetrix/commands/cmdSeasonalSun.h"

#include "sdk/qncore/QnLocalize.h"
#include "zoetrix/commands/UnavailableCommand.h"

CCommandSeasonalSun::CCommandSeasonalSun() : CQuarnCommand(false, false, nullptr, false) {}

CCommandSeasonalSun::~CCommandSeasonalSun() = default;

KM_UUID CCommandSeasonalSun::CommandUUID() {
    // A768A27F-B022-4296-8549-FE87042CDF17
    return {0xA768A27F, 0xB022, 0x4296, {0x85, 0x49, 0xFE, 0x87, 0x04, 0x2C, 0xDF, 0x17}};
}

const wchar_t* CCommandSeasonalSun::EnglishCommandName() {
    return L"SetSeasonalSunAnimation";
}

const wchar_t* CCommandSeasonalSun::CommandDescription() {
    return QnLocalizeString(L"Sets up a sun study of a season", 40111);
}

CQuarnCommand::result CCommandSeasonalSun::RunCommand(const CQuarnCommandContext&) {
    return ReportUnavailable(EnglishCommandName());
}
