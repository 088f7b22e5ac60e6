#pragma once

#include "ground/Result.h"

#include <chrono>
#include <filesystem>
#include <string>

namespace quarn {

/// What stands at the end of a zone file: its list of changes ends somewhere, and a rule goes on
/// from there.
struct ZoneFileEnd {
    std::chrono::sys_seconds last_change; ///< the lowest number where none is listed
    std::string rule;                     ///< may be empty: nothing is known of later times
};

/// Reads the end of a file of the time zone database (RFC 9636, section 3; version 2 or later).
/// @return an error, a whole sentence, when it cannot be read or is no such file
Result<ZoneFileEnd> readZoneFileEnd(const std::filesystem::path& file);

} // namespace quarn
