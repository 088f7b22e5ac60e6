#pragma once

#include "sdk/qncore/QnCommand.h"

#include <string_view>

namespace quarn {

/// Tells why a command could not do its work.
/// @param message  UTF-8, a sentence without a line break at its end
/// @return failure
CQuarnCommand::result fail(std::string_view message);

} // namespace quarn
