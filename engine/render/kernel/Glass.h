#pragma once

#include "engine/render/kernel/DirectLight.h"

namespace quarn {
namespace {

// Light that goes through surfaces: of bodies it is bent and takes colour on its way (B. Walter, S.
// Marschner, H. Li and K. Torrance, "Microfacet Models for Refraction through Rough Surfaces", EGSR
// 2007), of thin sheets it goes straight on.

/// What glass is made of.
struct GlassLanes {
    Lanes index;
    LaneMask thin;
    LaneColors absorption; ///< by the way's length, as powers of e
    LaneMask front;        ///< the ray comes from outside
};

inline GlassLanes noGlass() {
    return {1.5F, noLanes(), {0.0F, 0.0F, 0.0F}, noLanes()};
}

/// Reads what the surfaces of `mask` are made of.
inline GlassLanes readGlass(const FrameSetup& frame, const RayPacket& packet,
                            const SurfaceLanes& surfaces, const LaneMask& mask) {
    GlassLanes glass = noGlass();
    alignas(64) std::uint32_t met[lane_count];
    store(met, surfaces.surface);
    for (unsigned rest = bits(mask); rest != 0;) {
        const std::uint32_t index = met[__builtin_ctz(rest)];
        const LaneMask same =
            mask & (surfaces.surface == LaneInts(static_cast<std::int32_t>(index)));
        rest &= ~bits(same);
        const RaySurface& surface = frame.surfaces[index];
        const SurfaceLook& look = *surface.look;
        LaneVectors outward = geometricNormals(frame, packet);
        if (surface.place)
            outward = turned(surface.place->cofactors, outward) * Lanes(surface.place->hand);
        glass.front = glass.front | (same & (dot(outward, packet.direction()) < 0.0F));
        glass.index = select(same, Lanes(look.index), glass.index);
        if (look.is_thin)
            glass.thin = glass.thin | same;
        glass.absorption = select(same, uniformColor(look.absorption), glass.absorption);
    }
    return glass;
}

/// e to the power of x, for x from -80 to 0, to a few parts in a million: whole powers of two, and
/// a polynomial (the exponential series to the sixth power) between them.
inline Lanes exponential(const Lanes& x) {
    const Lanes scaled = greatest(x, -80.0F) * 1.44269504F;
    const LaneInts whole = wholePart(scaled - 0.5F);
    const Lanes t = (scaled - floatsOf(whole)) * 0.69314718F;
    const Lanes series =
        Lanes(1.0F) +
        t * (Lanes(1.0F) +
             t * (Lanes(1.0F / 2) +
                  t * (Lanes(1.0F / 6) +
                       t * (Lanes(1.0F / 24) + t * (Lanes(1.0F / 120) + t * (1.0F / 720))))));
    return series * floatsWith(shiftedLeft(whole + LaneInts(127), 23));
}

/// What is left of light behind a way through glass (A. Beer's law).
inline LaneColors leftBehind(const LaneColors& absorption, const Lanes& length) {
    return {exponential(-(absorption.r * length)), exponential(-(absorption.g * length)),
            exponential(-(absorption.b * length))};
}

/// The part of light that the border of two media mirrors (A. Fresnel's equations).
/// @param ratio   of the index on the ray's side to that on the other
/// @param beyond  takes the cosine on the other side; 0 where nothing gets there
inline Lanes mirroredByBorder(const Lanes& cosine, const Lanes& ratio, Lanes& beyond) {
    const Lanes square = Lanes(1.0F) - ratio * ratio * (Lanes(1.0F) - cosine * cosine);
    const LaneMask passes = square > 0.0F;
    beyond = squareRoot(greatest(square, 0.0F));
    const Lanes across = (ratio * cosine - beyond) / greatest(ratio * cosine + beyond, 1e-9F);
    const Lanes with = (cosine - ratio * beyond) / greatest(cosine + ratio * beyond, 1e-9F);
    return select(passes, (across * across + with * with) * 0.5F, 1.0F);
}

/// Where light goes at glass.
struct GlassRay {
    LaneVectors direction;
    LaneMask mirrored; ///< it stays on its side
};

/// @param choice  of what happens, 0 to 1
inline GlassRay glassRay(const LobeLanes& lobes, const GlassLanes& glass, const Lanes& choice,
                         const DiscLanes& disc) {
    LaneVectors half;
    GlassRay ray;
    const LaneVectors mirrored = mirroredBy(lobes.base, lobes.observer, disc, half);
    const Lanes cosine = clamped(dot(lobes.observer, half));
    const LaneMask outside = glass.front | glass.thin;
    const Lanes ratio = select(outside, Lanes(1.0F) / glass.index, glass.index);
    Lanes beyond;
    const Lanes part = mirroredByBorder(cosine, ratio, beyond);
    // Where nothing gets through all is mirrored, however strong the material's mirrors are.
    const LaneMask all = ~(part < 1.0F);
    ray.mirrored = choice < select(all, part, part * least(lobes.base.f90, 1.0F));
    const LaneVectors bent = along(lobes.observer * -ratio, half, ratio * cosine - beyond);
    // Through a thin sheet light is spread as it is by mirrors, to the other side.
    const LaneVectors straight = along(mirrored, lobes.normal, dot(mirrored, lobes.normal) * -2.0F);
    ray.direction = select(ray.mirrored, mirrored, select(glass.thin, straight, bent));
    return ray;
}

} // namespace
} // namespace quarn
