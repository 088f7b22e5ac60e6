#include "host/commands/CommandEnd.h"

#include "host/app/Application.h"

namespace quarn {

CQuarnCommand::result fail(std::string_view message) {
    Application::current()->tell(message);
    return CQuarnCommand::failure;
}

CQuarnCommand::result fail(const KM_wString& message) {
    return fail(message.ToUtf8());
}

} // namespace quarn
