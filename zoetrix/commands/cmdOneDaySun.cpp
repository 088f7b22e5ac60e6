#include "zoetrix/commands/cmdOneDaySun.h"

#include "sdk/qncore/QnLocalize.h"
#include "zoetrix/commands/UnavailableCommand.h"

CCommandOneDaySun::CCommandOneDaySun() : CQuarnCommand(false, false, nullptr, false) {}

CCommandOneDaySun::~CCommandOneDaySun() = default;

KM_UUID CCommandOneDaySun::CommandUUID() {
    // 99C50CFF-7C59-4F46-B3A9-B1FB70C3A343
    return {0x99C50CFF, 0x7C59, 0x4F46, {0xB3, 0xA9, 0xB1, 0xFB, 0x70, 0xC3, 0xA3, 0x43}};
}

const wchar_t* CCommandOneDaySun::EnglishCommandName() {
    return L"SetOneDaySunAnimation";
}

const wchar_t* CCommandOneDaySun::CommandDescription() {
    return QnLocalizeString(L"Sets up a sun study of one day", 40110);
}

CQuarnCommand::result CCommandOneDaySun::RunCommand(const CQuarnCommandContext&) {
    return ReportUnavailable(EnglishCommandName());
}
