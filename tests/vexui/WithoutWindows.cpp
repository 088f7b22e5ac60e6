#include "tests/vexui/WithoutWindows.h"

#include "tests/vexui/VexUiSession.h"

#include <iostream>

namespace {

std::string utf8(const std::wstring& text) {
    return KM_wString(text.c_str()).ToUtf8();
}

} // namespace

int runWithoutWindows() {
    quarn::ScriptedFrontEnd front_end;
    const quarn::test::TempFolder folder;
    quarn::Session session(front_end, vexUiOptions(folder.path(), "C"));
    session.loadPlugIn(ZOETRIX_PLUGIN_PATH);
    int others = 0;
    for (const wchar_t* command :
         {L"SetTurntableAnimation", L"SetOneDaySunAnimation", L"SetSeasonalSunAnimation"})
        others += session.runCommand(command, true) == CQuarnCommand::failure ? 0 : 1;
    std::cout << utf8(front_end.printed());
    for (const auto& message : front_end.messages())
        std::cout << "[" << utf8(message.title) << "] " << utf8(message.text) << "\n";
    return others;
}
