#pragma once

#include "engine/display/kernel/SurroundingLight.h"
#include "engine/render/kernel/RenderSetup.h"
#include "engine/render/kernel/SampleLanes.h"

namespace quarn {
namespace {

// Light that comes from infinitely far away, but for the suns. Where it is uneven rays are sent to
// where it is bright (M. Pharr, W. Jakob and G. Humphreys, "Physically Based Rendering", third
// edition, 2016, 14.2.4), by cells of an octahedron folded open.

/// What matt surfaces get of it beside what mirrors show.
inline LaneColors scatteredPart(const RenderSetup& setup) {
    return uniformColor(setup.sky_scale);
}

/// A place on the octahedron whose coordinates run from -1 to 1, and the inverse of how much a
/// step there is of the sphere, see `densityAt`.
struct FoldedPlace {
    Lanes u;
    Lanes v;
    Lanes spread;
};

inline FoldedPlace foldedPlace(const LaneVectors& d) {
    const Lanes sum = magnitude(d.x) + magnitude(d.y) + magnitude(d.z);
    const Lanes scale = Lanes(1.0F) / sum;
    const Lanes u = d.x * scale;
    const Lanes v = d.y * scale;
    const LaneMask folded = d.z < 0.0F;
    return {select(folded, withSignOf(greatest(Lanes(1.0F) - magnitude(v), 0.0F), u), u),
            select(folded, withSignOf(greatest(Lanes(1.0F) - magnitude(u), 0.0F), v), v),
            scale * scale * scale};
}

/// A face of the octahedron lies 1 / sqrt(3) from the middle and is sqrt(3) times as large as its
/// share of the square, so a step du dv is |p|^3 as large as what is seen of it.
inline Lanes densityAt(const RenderSetup& setup, const LaneInts& cell, const Lanes& spread) {
    const auto* const from = reinterpret_cast<const std::uint32_t*>(setup.environment.density);
    return floatsWith(gathered(from, cell)) * spread;
}

/// How densely rays are sent in a direction of unit length, by solid angle.
inline Lanes environmentDensity(const RenderSetup& setup, const LaneVectors& direction) {
    constexpr int side = EnvironmentTable::side;
    const FoldedPlace place = foldedPlace(direction);
    const Lanes half = 0.5F * side;
    const LaneInts column = limited(wholePart((place.u + 1.0F) * half), side - 1);
    const LaneInts row = limited(wholePart((place.v + 1.0F) * half), side - 1);
    return densityAt(setup, row * LaneInts(side) + column, place.spread);
}

/// The last entry that is not above `wanted`, of a row of side + 1 that grow from 0 to 1.
/// @param part  takes how far it is to the next one, 0 to 1
inline LaneInts entryBelow(const float* entries, const LaneInts& first, const Lanes& wanted,
                           Lanes& part) {
    const auto* const from = reinterpret_cast<const std::uint32_t*>(entries);
    LaneInts at = 0;
    for (int step = EnvironmentTable::side / 2; step > 0; step /= 2) {
        const LaneInts next = at + LaneInts(step);
        const LaneMask is_above = floatsWith(gathered(from, first + next)) > wanted;
        at = select(is_above, at, next);
    }
    const Lanes lower = floatsWith(gathered(from, first + at));
    const Lanes upper = floatsWith(gathered(from + 1, first + at));
    part = clamped((wanted - lower) / greatest(upper - lower, 1e-20F));
    return at;
}

/// A direction of unit length, where the environment is likely to be bright.
inline LaneVectors towardEnvironment(const RenderSetup& setup, const LanePlaces& place,
                                     Lanes& density) {
    constexpr int side = EnvironmentTable::side;
    Lanes x;
    Lanes y;
    const LaneInts row = entryBelow(setup.environment.rows, LaneInts(0), place.v, y);
    const LaneInts column =
        entryBelow(setup.environment.cells, row * LaneInts(side + 1), place.u, x);
    const Lanes step = 2.0F / side;
    const Lanes u = (floatsOf(column) + x) * step - 1.0F;
    const Lanes v = (floatsOf(row) + y) * step - 1.0F;
    const Lanes z = Lanes(1.0F) - magnitude(u) - magnitude(v);
    const LaneMask folded = z < 0.0F;
    const LaneVectors p{select(folded, withSignOf(Lanes(1.0F) - magnitude(v), u), u),
                        select(folded, withSignOf(Lanes(1.0F) - magnitude(u), v), v), z};
    const Lanes scale = Lanes(1.0F) / squareRoot(dot(p, p));
    // |p| is 1 / |d| of the direction d by its coordinates' sum.
    const Lanes length = Lanes(1.0F) / scale;
    density = densityAt(setup, row * LaneInts(side) + column, length * length * length);
    return p * scale;
}

} // namespace
} // namespace quarn
