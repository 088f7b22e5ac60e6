#include "quarn/arguments/ProgramArguments.h"
#include "quarn/terminal/ShownText.h"

#include <cstdio>
#include <exception>

namespace {

using namespace quarn::program;

Outcome runProgram(int argument_count, char** arguments) {
    try {
        return runArguments(argument_count, arguments);
    } catch (const std::exception& error) {
        return Outcome::failure(std::string("cannot go on: ") + error.what());
    }
}

void tell(const std::string& text, std::FILE* stream) {
    if (text.empty())
        return;
    std::fflush(stdout); // what was printed before stands before it
    std::fputs(shownText(text).c_str(), stream);
    if (text.back() != '\n')
        std::fputc('\n', stream);
}

} // namespace

int main(int argument_count, char** arguments) {
    const Outcome outcome = runProgram(argument_count, arguments);
    tell(outcome.text, outcome.exit_code == Outcome::done ? stdout : stderr);
    if (std::fflush(stdout) == 0)
        return outcome.exit_code;
    tell("quarn: cannot write to the standard output", stderr);
    return outcome.exit_code == Outcome::done ? Outcome::failed : outcome.exit_code;
}
