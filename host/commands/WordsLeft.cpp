#include "host/commands/WordsLeft.h"

#include "host/app/Application.h"

namespace quarn {

bool hasWordsLeft() {
    const RunningCommand* command = Application::current()->runner().current();
    return command && !command->words.empty();
}

} // namespace quarn
