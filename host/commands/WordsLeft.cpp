#include "host/commands/WordsLeft.h"

#include "host/app/Application.h"

namespace quarn {

bool hasWordsLeft() {
    const RunningCommand* command = Application::current()->runner().current();
    return command && !command->words.empty();
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
