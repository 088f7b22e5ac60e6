#pragma once

#include "kelmar/KM_wString.h"
#include "sdk/qncore/QnCommand.h"

#include <string_view>

namespace quarn {

/// Tells why a command could not do its work.
/// @param message  UTF-8, a sentence without a line break at its end
/// @return failure
CQuarnCommand::result fail(std::string_view message);
/// The same in the user's language.
CQuarnCommand::result fail(const KM_wString& message);

} // namespace quarn
