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

/// "metres", "inches" and so on, in English; empty for none.
constexpr const wchar_t* unitName(UnitSystem units) {
    switch (units) {
    case UnitSystem::none:
        break;
    case UnitSystem::millimeters:
        return L"millimetres";
    case UnitSystem::centimeters:
        return L"centimetres";
    case UnitSystem::meters:
        return L"metres";
    case UnitSystem::kilometers:
        return L"kilometres";
    case UnitSystem::inches:
        return L"inches";
    case UnitSystem::feet:
        return L"feet";
    }
    return L"";
}

} // namespace quarn
