#include "host/commands/CommandEnd.h"

#include "host/app/Application.h"

namespace quarn {

CQuarnCommand::result fail(std::string_view message) {
    Application::current()->tell(message);
    return CQuarnCommand::failure;
}

CQuarnCommand::result failForWord(const wchar_t* word, const char* expected) {
    return fail("\"" + KM_wString(word).ToUtf8() + "\" is no option here. Give " + expected + ".");
}

} // namespace quarn
