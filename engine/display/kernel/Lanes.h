#pragma once

// Part of the ray loops, which are compiled once for each kind of processor. Everything here has
// internal linkage, and nothing inline is taken from other headers, so that the linker never puts
// code for a newer processor in place of code for an older one.

#include "engine/display/kernel/FrameSetup.h"
#include "engine/display/kernel/NativeVectors.h"

#include <cstdint>

namespace quarn {
namespace {

constexpr int lane_parts = lane_count / native_lanes;

/// A number for each ray of a packet. Arithmetic and comparisons work lane by lane.
struct alignas(64) Lanes {
    NativeFloats part[lane_parts];
    Lanes() = default;
    Lanes(float all) { // NOLINT: plain numbers stand for sixteen equal ones
        for (auto& p : part)
            p = NativeFloats{} + all;
    }
};

/// A whole number for each ray.
struct alignas(64) LaneInts {
    NativeInts part[lane_parts];
    LaneInts() = default;
    LaneInts(std::int32_t all) { // NOLINT
        for (auto& p : part)
            p = NativeInts{} + all;
    }
};

/// -1 for the rays that are meant, 0 for the others, as the ray tracer wants it.
struct alignas(64) LaneMask {
    NativeInts part[lane_parts];
    const int* data() const { return reinterpret_cast<const int*>(part); }
    bool operator[](int lane) const { return part[lane / native_lanes][lane % native_lanes] != 0; }
};

template <class Result, class Operation> inline Result eachPart(const Operation& operation) {
    Result result;
    for (int p = 0; p < lane_parts; ++p)
        result.part[p] = operation(p);
    return result;
}

#define QUARN_LANES_OPERATOR(Type, Result, op)                                                     \
    inline Result operator op(const Type& a, const Type& b) {                                      \
        return eachPart<Result>([&](int p) { return a.part[p] op b.part[p]; });                    \
    }
QUARN_LANES_OPERATOR(Lanes, Lanes, +)
QUARN_LANES_OPERATOR(Lanes, Lanes, -)
QUARN_LANES_OPERATOR(Lanes, Lanes, *)
QUARN_LANES_OPERATOR(Lanes, Lanes, /)
QUARN_LANES_OPERATOR(Lanes, LaneMask, <)
QUARN_LANES_OPERATOR(Lanes, LaneMask, >)
QUARN_LANES_OPERATOR(LaneInts, LaneInts, +)
QUARN_LANES_OPERATOR(LaneInts, LaneInts, -)
QUARN_LANES_OPERATOR(LaneInts, LaneInts, *)
QUARN_LANES_OPERATOR(LaneInts, LaneInts, &)
QUARN_LANES_OPERATOR(LaneInts, LaneInts, |)
QUARN_LANES_OPERATOR(LaneInts, LaneMask, ==)
QUARN_LANES_OPERATOR(LaneInts, LaneMask, !=)
QUARN_LANES_OPERATOR(LaneInts, LaneMask, >)
QUARN_LANES_OPERATOR(LaneMask, LaneMask, &)
QUARN_LANES_OPERATOR(LaneMask, LaneMask, |)
#undef QUARN_LANES_OPERATOR

inline LaneMask operator~(const LaneMask& a) {
    return eachPart<LaneMask>([&](int p) { return ~a.part[p]; });
}
inline Lanes operator-(const Lanes& a) {
    return eachPart<Lanes>([&](int p) { return -a.part[p]; });
}
inline LaneInts shiftedLeft(const LaneInts& a, int bits) {
    return eachPart<LaneInts>([&](int p) { return a.part[p] << bits; });
}
/// The sign fills up.
inline LaneInts shiftedRight(const LaneInts& a, int bits) {
    return eachPart<LaneInts>([&](int p) { return a.part[p] >> bits; });
}

template <class Type> inline Type select(const LaneMask& mask, const Type& a, const Type& b) {
    return eachPart<Type>([&](int p) { return mask.part[p] ? a.part[p] : b.part[p]; });
}
inline Lanes select(const LaneMask& mask, const Lanes& a, float b) {
    return select<Lanes>(mask, a, Lanes(b));
}
inline Lanes select(const LaneMask& mask, float a, float b) {
    return select<Lanes>(mask, Lanes(a), Lanes(b));
}

inline Lanes least(const Lanes& a, const Lanes& b) {
    return eachPart<Lanes>([&](int p) { return nativeLeast(a.part[p], b.part[p]); });
}
inline Lanes greatest(const Lanes& a, const Lanes& b) {
    return eachPart<Lanes>([&](int p) { return nativeGreatest(a.part[p], b.part[p]); });
}
inline Lanes squareRoot(const Lanes& a) {
    return eachPart<Lanes>([&](int p) { return nativeRoot(a.part[p]); });
}
inline Lanes absolute(const Lanes& a) {
    return greatest(a, -a);
}
/// The absolute value without its sign's bit.
inline Lanes magnitude(const Lanes& a) {
    return eachPart<Lanes>([&](int p) {
        return reinterpret_cast<NativeFloats>(reinterpret_cast<NativeInts>(a.part[p]) & 0x7FFFFFFF);
    });
}
/// @param a  not negative
inline Lanes withSignOf(const Lanes& a, const Lanes& sign) {
    return eachPart<Lanes>([&](int p) {
        constexpr auto sign_bit = static_cast<std::int32_t>(0x80000000U);
        return reinterpret_cast<NativeFloats>(
            reinterpret_cast<NativeInts>(a.part[p]) |
            (reinterpret_cast<NativeInts>(sign.part[p]) & sign_bit));
    });
}
/// 1 / sqrt(a) to five parts in a million for positive numbers; some large number for 0. Quicker
/// than a root and a division. The first guess halves the exponent and is bettered by two of
/// Newton's steps (C. Lomont, "Fast Inverse Square Root", 2003).
inline Lanes inverseRoot(const Lanes& a) {
    return eachPart<Lanes>([&](int p) {
        const NativeFloats x = a.part[p];
        NativeFloats y =
            reinterpret_cast<NativeFloats>(0x5F375A86 - (reinterpret_cast<NativeInts>(x) >> 1));
        const NativeFloats half = x * 0.5F;
        y = y * (1.5F - half * y * y);
        return y * (1.5F - half * y * y);
    });
}
inline Lanes clamped(const Lanes& a) {
    return least(greatest(a, 0.0F), 1.0F);
}

inline Lanes floatsOf(const LaneInts& a) {
    return eachPart<Lanes>([&](int p) { return __builtin_convertvector(a.part[p], NativeFloats); });
}
/// What stands before the point, for numbers that fit; cut off toward 0.
inline LaneInts wholePart(const Lanes& a) {
    return eachPart<LaneInts>(
        [&](int p) { return __builtin_convertvector(a.part[p], NativeInts); });
}
/// One lane's number.
inline float laneOf(const Lanes& a, int lane) {
    return a.part[lane / native_lanes][lane % native_lanes];
}
/// The bits of each float.
inline LaneInts bitsOf(const Lanes& a) {
    return eachPart<LaneInts>([&](int p) { return reinterpret_cast<NativeInts>(a.part[p]); });
}
/// The float that has these bits.
inline Lanes floatsWith(const LaneInts& a) {
    return eachPart<Lanes>([&](int p) { return reinterpret_cast<NativeFloats>(a.part[p]); });
}
/// from[index] for each lane.
inline LaneInts gathered(const std::uint32_t* from, const LaneInts& index) {
    return eachPart<LaneInts>([&](int p) { return nativeGather(from, index.part[p]); });
}

/// One bit a lane, the lowest for the first.
inline unsigned bits(const LaneMask& mask) {
    unsigned all = 0;
    for (int p = 0; p < lane_parts; ++p)
        all |= nativeSigns(mask.part[p]) << (p * native_lanes);
    return all;
}
inline bool any(const LaneMask& mask) {
    return bits(mask) != 0;
}

inline LaneMask noLanes() {
    return Lanes(0.0F) < 0.0F;
}

// Arrays of the ray tracer's packets: sixteen numbers, aligned.

inline Lanes load(const float* from) {
    return eachPart<Lanes>(
        [&](int p) { return *(reinterpret_cast<const NativeFloats*>(from) + p); });
}
inline LaneInts load(const unsigned* from) {
    return eachPart<LaneInts>(
        [&](int p) { return *(reinterpret_cast<const NativeInts*>(from) + p); });
}
/// 0 to 15.
inline LaneInts laneNumbers() {
    alignas(64) constexpr unsigned numbers[lane_count] = {0, 1, 2,  3,  4,  5,  6,  7,
                                                          8, 9, 10, 11, 12, 13, 14, 15};
    return load(numbers);
}
inline void store(float* to, const Lanes& a) {
    for (int p = 0; p < lane_parts; ++p)
        *(reinterpret_cast<NativeFloats*>(to) + p) = a.part[p];
}
inline void store(unsigned* to, const LaneInts& a) {
    for (int p = 0; p < lane_parts; ++p)
        *(reinterpret_cast<NativeInts*>(to) + p) = a.part[p];
}

struct LaneVectors {
    Lanes x;
    Lanes y;
    Lanes z;
};

struct LaneColors {
    Lanes r;
    Lanes g;
    Lanes b;
};

inline Lanes dot(const LaneVectors& a, const LaneVectors& b) {
    return a.x * b.x + a.y * b.y + a.z * b.z;
}
inline Lanes dot(const LaneVectors& a, const float (&b)[3]) {
    return a.x * b[0] + a.y * b[1] + a.z * b[2];
}
inline LaneVectors operator*(const LaneVectors& a, const Lanes& s) {
    return {a.x * s, a.y * s, a.z * s};
}
inline LaneVectors along(const LaneVectors& from, const LaneVectors& direction, const Lanes& t) {
    return {from.x + t * direction.x, from.y + t * direction.y, from.z + t * direction.z};
}
inline LaneVectors select(const LaneMask& mask, const LaneVectors& a, const LaneVectors& b) {
    return {select(mask, a.x, b.x), select(mask, a.y, b.y), select(mask, a.z, b.z)};
}
inline LaneColors select(const LaneMask& mask, const LaneColors& a, const LaneColors& b) {
    return {select(mask, a.r, b.r), select(mask, a.g, b.g), select(mask, a.b, b.b)};
}
inline LaneColors operator*(const LaneColors& a, const LaneColors& b) {
    return {a.r * b.r, a.g * b.g, a.b * b.b};
}
inline LaneColors operator*(const LaneColors& a, const Lanes& s) {
    return {a.r * s, a.g * s, a.b * s};
}
inline LaneColors operator-(const LaneColors& a, const LaneColors& b) {
    return {a.r - b.r, a.g - b.g, a.b - b.b};
}
inline LaneColors operator+(const LaneColors& a, const LaneColors& b) {
    return {a.r + b.r, a.g + b.g, a.b + b.b};
}
inline LaneColors blended(const LaneColors& under, const LaneColors& over, const Lanes& weight) {
    return {under.r + weight * (over.r - under.r), under.g + weight * (over.g - under.g),
            under.b + weight * (over.b - under.b)};
}
inline Lanes mean(const LaneColors& a) {
    return (a.r + a.g + a.b) * (1.0F / 3.0F);
}
inline LaneColors uniformColor(const float (&c)[3]) {
    return {c[0], c[1], c[2]};
}

} // namespace
} // namespace quarn
