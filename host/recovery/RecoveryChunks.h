#pragma once

#include "host/document/file/ChunkIds.h"

#include <array>
#include <chrono>
#include <cstdint>
#include <optional>

namespace quarn {

/// As DOCUMENT_MAGIC, for recovery files.
inline constexpr std::array<std::uint8_t, 8> RECOVERY_MAGIC = {0x89, 'Q',  'R',  'R',
                                                               '\r', '\n', 0x1A, '\n'};
inline constexpr std::int32_t RECOVERY_VERSION = 2;
/// Magic and version.
inline constexpr std::size_t RECOVERY_BEGINNING_SIZE = RECOVERY_MAGIC.size() + 4;

namespace chunk {
inline constexpr std::uint32_t PICTURE = named("PICT");
inline constexpr std::uint32_t STATE = named("STAT");
} // namespace chunk

/// The time that a state begins with, in milliseconds since 1970 as UTC.
inline std::int64_t millisecondsOf(std::chrono::system_clock::time_point time) {
    return std::chrono::floor<std::chrono::milliseconds>(time).time_since_epoch().count();
}
/// @return nothing for a number that is no time of these centuries
inline std::optional<std::chrono::system_clock::time_point> timeOf(std::int64_t milliseconds) {
    constexpr std::int64_t year_2200 = 7258118400000;
    if (milliseconds < 0 || milliseconds > year_2200)
        return std::nullopt;
    return std::chrono::system_clock::time_point(std::chrono::milliseconds(milliseconds));
}

} // namespace quarn
