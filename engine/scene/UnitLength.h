#pragma once

#include "engine/scene/UnitSystem.h"

namespace quarn {

/// How many metres a length of 1 is; 0 for none.
constexpr double metresPerUnit(UnitSystem units) {
    switch (units) {
    case UnitSystem::none:
        break;
    case UnitSystem::millimeters:
        return 0.001;
    case UnitSystem::centimeters:
        return 0.01;
    case UnitSystem::meters:
        return 1.0;
    case UnitSystem::kilometers:
        return 1000.0;
    case UnitSystem::inches:
        return 0.0254;
    case UnitSystem::feet:
        return 0.3048;
    }
    return 0.0;
}

} // namespace quarn
