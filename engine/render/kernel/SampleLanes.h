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

/// One sample of each pixel of a tile: where it stands among the samples.
struct SampleNumber {
    const SampleTable& table;
    const TileSamples& tile;
    std::uint32_t reversed; ///< reversedBits of the sample's number
};

/// The places of one sample. Its number within the stretch is shuffled differently for each pixel
/// and use, so that uses do not go together; any beginning of a stretch stays well spread (S. Laine
/// and T. Karras, "Stratified Sampling for Stochastic Transparency", Computer Graphics Forum 30(4),
/// 2011; constants: B. Burley, "Practical Hash-based Owen Scrambling", JCGT 9(4), 2020).
inline LanePlaces wellSpread(const SampleNumber& sample, int use) {
    LaneInts x = wordSum(load(sample.tile.order[use]), sample.reversed);
    constexpr std::uint32_t factors[] = {0x6C50B47CU, 0xB82F1E52U, 0xC7AFE638U, 0x8D22F6E6U};
    for (const std::uint32_t factor : factors)
        x = x ^ wordProduct(x, factor);
    const LaneInts row = wordShiftedRight(x, 32 - sample.table.log2_length);
    return {unitFloats(gathered(sample.table.first, row) ^ load(sample.tile.first[use])),
            unitFloats(gathered(sample.table.second, row) ^ load(sample.tile.second[use]))};
}

/// Mixes all bits of numbers with each other (A. Appleby, MurmurHash3's last step, 2011).
inline LaneInts mixedBits(LaneInts x) {
    x = wordProduct(x ^ wordShiftedRight(x, 16), 0x85EBCA6BU);
    x = wordProduct(x ^ wordShiftedRight(x, 13), 0xC2B2AE35U);
    return x ^ wordShiftedRight(x, 16);
}

/// The places of one sample for some use of a surface that it comes to.
/// @param surface  0 for the first one
inline LanePlaces placesAt(const SampleNumber& sample, SampleUse use, int surface) {
    const int at = static_cast<int>(use);
    if (surface < surfaces_well_spread)
        return wellSpread(sample, at + uses_of_surface * surface);
    const auto salt = static_cast<std::uint32_t>(at + uses_of_surface * surface);
    const LaneInts first = mixedBits(
        wordSum(load(sample.tile.order[at]) ^ mixedBits(wordSum(LaneInts(0), sample.reversed)),
                salt * 0x9E3779B9U));
    return {unitFloats(first), unitFloats(mixedBits(wordSum(first, 0x9E3779B9U)))};
}

} // namespace
} // namespace quarn
