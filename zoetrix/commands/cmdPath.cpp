#include "zoetrix/commands/cmdPath.h"

#include "sdk/qncore/QnLocalize.h"
#include "zoetrix/commands/UnavailableCommand.h"

CCommandPathAnimation::CCommandPathAnimation() : CQuarnCommand(false, false, nullptr, false) {}

CCommandPathAnimation::~CCommandPathAnimation() = default;

KM_UUID CCommandPathAnimation::CommandUUID() {
    // BBFB4E20-1E39-4047-8109-D953556A2441
    return {0xBBFB4E20, 0x1E39, 0x4047, {0x81, 0x09, 0xD9, 0x53, 0x55, 0x6A, 0x24, 0x41}};
}

const wchar_t* CCommandPathAnimation::EnglishCommandName() {
    return L"SetPathAnimation";
}

const wchar_t* CCommandPathAnimation::CommandDescription() {
    return QnLocalizeString(L"Sets up an animation along a camera path", 40108);
}

CQuarnCommand::result CCommandPathAnimation::RunCommand(const CQuarnCommandContext&) {
    return ReportUnavailable(EnglishCommandName());
}
