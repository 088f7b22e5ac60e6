#include "host/commands/CommandEnd.h"

#include "host/app/Application.h"

namespace quarn {

CQuarnCommand::result fail(std::string_view message) {
    Application::current()->tell(message);
    return CQuarnCommand::failure;
}

} // namespace quarn
