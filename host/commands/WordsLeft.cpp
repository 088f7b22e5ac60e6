#include "host/commands/WordsLeft.h"

#include "host/app/Application.h"
#include "sdk/qncore/QnLocalize.h"

namespace quarn {

bool hasWordsLeft() {
    const RunningCommand* command = Application::current()->runner().current();
    return command && !command->words.empty();
}

bool tellWordsBehindFile() {
    if (!hasWordsLeft())
        return false;
    Application& application = *Application::current();
    const std::wstring words = application.runner().current()->wordsLeft();
    application.tell(
        KM_wString::FormatToString(
            QnLocalizeString(
                L"Nothing was written: behind the name of the file stands \"%s\". Put a "
                L"name with blanks in double quotes.",
                42550),
            words.c_str())
            .ToUtf8());
    return true;
}

bool mayAskAgain(bool from_line) {
    RunningCommand* command = Application::current()->runner().current();
    if (!from_line)
        return true;
    if (!command || !command->typed)
        return false;
    command->words.clear();
    return true;
}

} // namespace quarn
