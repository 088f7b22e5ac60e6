#pragma once

#include "engine/display/EnvironmentMap.h"
#include "engine/display/kernel/RayPacket.h"

namespace quarn {
namespace {

inline LaneInts limited(const LaneInts& a, int greatest_value) {
    const LaneInts from_0 = select(a > LaneInts(0), a, LaneInts(0));
    const LaneInts last(greatest_value);
    return select(from_0 > last, last, from_0);
}

/// A place on a square map: between four texels.
struct MapPlace {
    LaneInts texel; ///< the one at the upper left
    Lanes right;
    Lanes below;
};

/// @param side  texels of the map without its border
template <int side> inline MapPlace placeOnMap(const LaneVectors& d) {
    constexpr float half = 0.5F * side;
    const Lanes scale = Lanes(1.0F) / (magnitude(d.x) + magnitude(d.y) + magnitude(d.z));
    const Lanes u = d.x * scale;
    const Lanes v = d.y * scale;
    const LaneMask folded = d.z < 0.0F;
    const Lanes x =
        select(folded, withSignOf(greatest(Lanes(1.0F) - magnitude(v), 0.0F), u), u) * half +
        (half + 0.5F);
    const Lanes y =
        select(folded, withSignOf(greatest(Lanes(1.0F) - magnitude(u), 0.0F), v), v) * half +
        (half + 0.5F);
    // Whatever the direction is, nothing but the map is read.
    const LaneInts column = limited(wholePart(x), side);
    const LaneInts row = limited(wholePart(y), side);
    return {row * LaneInts(side + 2) + column, x - floatsOf(column), y - floatsOf(row)};
}

/// @param stride  texels of the map with its border
/// @param first   of each lane the first texel of the channel
inline Lanes channelAt(const float* map, int stride, const LaneInts& first, const MapPlace& place) {
    const auto* const from = reinterpret_cast<const std::uint32_t*>(map);
    const LaneInts at = first + place.texel;
    const auto texel = [&](int offset) { return floatsWith(gathered(from + offset, at)); };
    const Lanes upper_left = texel(0);
    const Lanes lower_left = texel(stride);
    const Lanes upper = upper_left + place.right * (texel(1) - upper_left);
    const Lanes lower = lower_left + place.right * (texel(stride + 1) - lower_left);
    return upper + place.below * (lower - upper);
}

/// What a map of a picture of the surroundings shows in a direction.
template <class Map>
[[gnu::noinline]] inline LaneColors seenOnMap(const float* map, float scale,
                                              const LaneVectors& direction) {
    const MapPlace place = placeOnMap<Map::side>(direction);
    const auto channel = [&](int c) {
        return channelAt(map + c * Map::texels, Map::stride, LaneInts(0), place) * scale;
    };
    return {channel(0), channel(1), channel(2)};
}

} // namespace
} // namespace quarn
