#pragma once

#include <cstdint>

namespace quarn {

/// What a length of 1 means in a document. The numbers are those of document files.
enum class UnitSystem : std::int32_t {
    none = 0, ///< nobody said
    millimeters = 1,
    centimeters = 2,
    meters = 3,
    kilometers = 4,
    inches = 5,
    feet = 6,
};

inline constexpr UnitSystem LAST_UNIT_SYSTEM = UnitSystem::feet;

} // namespace quarn
