#include "zoetrix/commands/cmdFlyThru.h"

#include "sdk/qncore/QnLocalize.h"
#include "zoetrix/commands/UnavailableCommand.h"

CCommandFlythroughAnimation::CCommandFlythroughAnimation()
    : CQuarnCommand(false, false, nullptr, false) {}

CCommandFlythroughAnimation::~CCommandFlythroughAnimation() = default;

KM_UUID CCommandFlythroughAnimation::CommandUUID() {
    // 66C3E01D-DE14-43D9-B796-DA7B7411E343
    return {0x66C3E01D, 0xDE14, 0x43D9, {0xB7, 0x96, 0xDA, 0x7B, 0x74, 0x11, 0xE3, 0x43}};
}

const wchar_t* CCommandFlythroughAnimation::EnglishCommandName() {
    return L"SetFlythroughAnimation";
}

const wchar_t* CCommandFlythroughAnimation::CommandDescription() {
    return QnLocalizeString(L"Sets up a flight along a curve", 40109);
}

CQuarnCommand::result CCommandFlythroughAnimation::RunCommand(const CQuarnCommandContext&) {
    return ReportUnavailable(EnglishCommandName());
}
