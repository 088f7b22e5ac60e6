#pragma once

namespace quarn {

/// The years that the interface's sun has positions for.
inline constexpr int FIRST_SUN_YEAR = 1800;
inline constexpr int LAST_SUN_YEAR = 2199;

constexpr bool isSunYear(int year) {
    return year >= FIRST_SUN_YEAR && year <= LAST_SUN_YEAR;
}

} // namespace quarn
