#pragma once

// Part of the render loops: what sampling does with whole numbers. See Lanes.h.

#include "engine/display/kernel/Lanes.h"

namespace quarn {
namespace {

typedef std::uint32_t NativeWords __attribute__((vector_size(sizeof(NativeInts))));

inline LaneInts operator^(const LaneInts& a, const LaneInts& b) {
    return eachPart<LaneInts>([&](int p) { return a.part[p] ^ b.part[p]; });
}

/// The low 32 bits of the product, as of numbers without a sign.
inline LaneInts wordProduct(const LaneInts& a, std::uint32_t b) {
    return eachPart<LaneInts>([&](int p) {
        return reinterpret_cast<NativeInts>(reinterpret_cast<NativeWords>(a.part[p]) * b);
    });
}

inline LaneInts wordSum(const LaneInts& a, std::uint32_t b) {
    return eachPart<LaneInts>([&](int p) {
        return reinterpret_cast<NativeInts>(reinterpret_cast<NativeWords>(a.part[p]) + b);
    });
}

/// Zeros fill up.
inline LaneInts wordShiftedRight(const LaneInts& a, int bits) {
    return eachPart<LaneInts>([&](int p) {
        return reinterpret_cast<NativeInts>(reinterpret_cast<NativeWords>(a.part[p]) >> bits);
    });
}

/// From a fraction of 32 bits to a number of [0, 1).
inline Lanes unitFloats(const LaneInts& fraction) {
    return floatsOf(wordShiftedRight(fraction, 8)) * 0x1p-24F;
}

} // namespace
} // namespace quarn
