#pragma once

#include <chrono>
#include <optional>
#include <string>
#include <string_view>

namespace quarn {

/// Reads what clocks are ahead of UTC: "+05:30", "-3", "UTC", "UTC+5:30", at most 24 hours.
/// @return nothing for another text
std::optional<std::chrono::minutes> writtenOffset(std::string_view text);

/// "UTC+5:30"; "UTC" for none.
std::string offsetText(std::chrono::minutes east);

/// The abbreviation as a person reads it. Where a zone has no letters of its own the database gives
/// its distance from UTC ("+0530"); that becomes an offsetText.
std::string letteredName(const std::string& abbreviation, std::chrono::seconds offset);

} // namespace quarn
