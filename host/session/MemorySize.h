#pragma once

#include "sdk/qncore/QnExport.h"

#include <cstdint>
#include <optional>
#include <string_view>

namespace quarn {

/// An amount of memory as a person types it: a number of megabytes (M) or gigabytes (G), such as
/// "500M" or "1.5G", in either case, of at least 1M.
/// @return bytes; nothing for other words
QNCORE_API std::optional<std::uint64_t> memorySize(std::string_view word);

} // namespace quarn
