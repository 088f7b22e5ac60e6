#pragma once

#include "engine/render/kernel/LaneBits.h"
#include "engine/render/kernel/RenderSetup.h"

namespace quarn {
namespace {

/// A place in the unit square for each lane.
struct LanePlaces {
    Lanes u;
    Lanes v;
};

inline std::uint32_t reversedBits(std::uint32_t x) {
    x = __builtin_bswap32(x);
    x = (x >> 4 & 0x0F0F0F0FU) | (x & 0x0F0F0F0FU) << 4;
    x = (x >> 2 & 0x33333333U) | (x & 0x33333333U) << 2;
    return (x >> 1 & 0x55555555U) | (x & 0x55555555U) << 1;
}

/// The places of one sample. Its number within the stretch is shuffled differently for each pixel
/// and use, so that uses do not go together; any beginning of a stretch stays well spread (S. Laine
/// and T. Karras, "Stratified Sampling for Stochastic Transparency", Computer Graphics Forum 30(4),
/// 2011; constants: B. Burley, "Practical Hash-based Owen Scrambling", JCGT 9(4), 2020).
/// @param reversed  reversedBits of the sample's number
inline LanePlaces placesAt(const SampleTable& table, const TileSamples& tile, SampleUse use,
                           std::uint32_t reversed) {
    const int at = static_cast<int>(use);
    LaneInts x = wordSum(load(tile.order[at]), reversed);
    constexpr std::uint32_t factors[] = {0x6C50B47CU, 0xB82F1E52U, 0xC7AFE638U, 0x8D22F6E6U};
    for (const std::uint32_t factor : factors)
        x = x ^ wordProduct(x, factor);
    const LaneInts row = wordShiftedRight(x, 32 - table.log2_length);
    return {unitFloats(gathered(table.first, row) ^ load(tile.first[at])),
            unitFloats(gathered(table.second, row) ^ load(tile.second[at]))};
}

} // namespace
} // namespace quarn
