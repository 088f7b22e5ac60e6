#pragma once

#include "engine/display/SurfaceLook.h"
#include "engine/display/kernel/LookPaint.h"
#include "engine/display/kernel/SurfaceLanes.h"

namespace quarn {
namespace {

/// What the surfaces that a packet met look like beyond their base colours. Lanes whose surface has
/// no look, or that met none, are matt and dark.
struct LookLanes {
    LaneMask unlit;
    LaneMask mirrors;
    LookNumbers<Lanes> numbers;
    LaneVectors coat_normal; ///< as that of the surface without its map, or by one of its own
};

inline LaneColors emissionOf(const FrameSetup& frame, const LookNumbers<Lanes>& look) {
    return LaneColors{look.emission[0], look.emission[1], look.emission[2]} * frame.exposure;
}

constexpr int look_number_count = sizeof(LookNumbers<float>) / sizeof(float);
static_assert(sizeof(LookNumbers<Lanes>) == look_number_count * sizeof(Lanes));

inline void setNumbers(const LaneMask& mask, const LookNumbers<float>& from,
                       LookNumbers<Lanes>& numbers) {
    auto* const to = reinterpret_cast<Lanes*>(&numbers);
    const auto* const number = reinterpret_cast<const float*>(&from);
    for (int i = 0; i < look_number_count; ++i)
        to[i] = select(mask, Lanes(number[i]), to[i]);
}

inline LookLanes mattLooks(const LaneVectors& normal) {
    LookLanes looks;
    looks.unlit = looks.mirrors = noLanes();
    looks.coat_normal = normal;
    auto* const to = reinterpret_cast<Lanes*>(&looks.numbers);
    for (int i = 0; i < look_number_count; ++i)
        to[i] = reinterpret_cast<const float*>(&matt_look)[i];
    return looks;
}

/// One lane's part of numbers that lie behind each other.
class LaneColumn {
public:
    LaneColumn(Lanes* lanes, int lane) : m_first(reinterpret_cast<float*>(lanes) + lane) {}
    float& operator[](int i) const { return m_first[i * lane_count]; }

private:
    float* m_first;
};

inline void readLookTextures(const FrameSetup& frame, const RaySurface& surface,
                             const RayPacket& packet, unsigned lanes_meant, SurfaceLanes& surfaces,
                             LookLanes& looks) {
    for (; lanes_meant != 0; lanes_meant &= lanes_meant - 1) {
        const int lane = __builtin_ctz(lanes_meant);
        const float place[3] = {packet.rays.hit.u[lane], packet.rays.hit.v[lane],
                                packet.rays.ray.tfar[lane]};
        const LaneColumn normal(&surfaces.normal.x, lane);
        const LaneColumn coat_normal(&looks.coat_normal.x, lane);
        const LaneColumn numbers(reinterpret_cast<Lanes*>(&looks.numbers), lane);
        PaintedLook painted{surface.look->numbers,
                            {normal[0], normal[1], normal[2]},
                            {coat_normal[0], coat_normal[1], coat_normal[2]}};
        paintLookAt(frame, surface, packet.rays, lane, place, painted);
        for (int i = 0; i < 3; ++i) {
            normal[i] = painted.normal[i];
            coat_normal[i] = painted.coat_normal[i];
        }
        for (int i = 0; i < look_number_count; ++i)
            numbers[i] = reinterpret_cast<const float*>(&painted.numbers)[i];
    }
}

/// Fills `looks` for the rays that hit something, and turns normals as their maps say.
/// @return false where no surface has a look; then `looks` is not filled
inline bool readLooks(const FrameSetup& frame, const RayPacket& packet, SurfaceLanes& surfaces,
                      LookLanes& looks) {
    alignas(64) std::uint32_t met[lane_count];
    store(met, surfaces.surface);
    bool found = false;
    unsigned rest = bits(packet.hit);
    while (rest != 0) {
        const std::uint32_t index = met[__builtin_ctz(rest)];
        const LaneMask mask =
            packet.hit & (surfaces.surface == LaneInts(static_cast<std::int32_t>(index)));
        rest &= ~bits(mask);
        const SurfaceLook* const look = frame.surfaces[index].look;
        if (!look)
            continue;
        if (!found)
            looks = mattLooks(surfaces.normal);
        found = true;
        if (look->is_unlit)
            looks.unlit = looks.unlit | mask;
        if (look->mirrors)
            looks.mirrors = looks.mirrors | mask;
        setNumbers(mask, look->numbers, looks.numbers);
        if (look->has_textures)
            readLookTextures(frame, frame.surfaces[index], packet, bits(mask), surfaces, looks);
    }
    return found;
}

} // namespace
} // namespace quarn
