#pragma once

#include "ground/Result.h"
#include "host/clock/ZoneRules.h"

#include <filesystem>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace quarn {

/// Where the system keeps its time zone files.
inline const std::filesystem::path ZONE_FOLDER = "/usr/share/zoneinfo";

struct DatabaseZone {
    std::string name;
    std::shared_ptr<const ZoneRules> rules;
};

/// A zone of the system's time zone database. The changes of its clocks are those that its file
/// lists; after the last of them its rule holds.
///
/// @param name    case makes no difference, and a blank is as good as an underscore
/// @param folder  of the zone files
/// @return an error when the database has no such zone (with names that are like it), is missing,
///         or cannot be read
Result<DatabaseZone> databaseZone(std::string_view name,
                                  const std::filesystem::path& folder = ZONE_FOLDER);

} // namespace quarn
