#pragma once

#include "engine/display/DisplayTable.h"
#include "engine/display/kernel/Lanes.h"

namespace quarn {
namespace {

/// The display table's byte for each lane.
inline LaneInts displayed(const FrameSetup& frame, const Lanes& light) {
    constexpr float darkest = DisplayTable::darkest;
    constexpr float brightest = DisplayTable::brightest;
    const LaneInts step =
        shiftedRight(bitsOf(least(greatest(light, darkest), brightest)), DisplayTable::shift);
    return gathered(frame.display_table, step - LaneInts(DisplayTable::first));
}

} // namespace
} // namespace quarn
