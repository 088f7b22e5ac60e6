#pragma once

#include "engine/display/kernel/OpenSky.h"
#include "engine/render/kernel/SampleLanes.h"

namespace quarn {
namespace {

/// A place on the disc of radius 1.
struct DiscLanes {
    Lanes x;
    Lanes y;
    Lanes square; ///< x * x + y * y
};

/// Carries the unit square onto the disc; areas keep their ratio and neighbours stay neighbours
/// (P. Shirley and K. Chiu, "A Low Distortion Map Between Disk and Square", Journal of Graphics
/// Tools 2(3), 1997). Sine and cosine are needed up to 45 degrees only: their Taylor polynomials.
inline DiscLanes onDisc(const LanePlaces& place) {
    const Lanes a = place.u * 2.0F - 1.0F;
    const Lanes b = place.v * 2.0F - 1.0F;
    const LaneMask wide = absolute(a) > absolute(b);
    const Lanes radius = select(wide, a, b);
    const LaneMask off_center = absolute(radius) > Lanes(0.0F);
    const Lanes ratio = select(wide, b, a) / select(off_center, radius, 1.0F);
    const Lanes t = ratio * 0.785398163F;
    const Lanes s = t * t;
    const Lanes sine = t * (Lanes(1.0F) + s * (Lanes(-1.0F / 6.0F) +
                                               s * (Lanes(1.0F / 120.0F) + s * (-1.0F / 5040.0F))));
    const Lanes cosine =
        Lanes(1.0F) + s * (Lanes(-0.5F) + s * (Lanes(1.0F / 24.0F) + s * (-1.0F / 720.0F)));
    return {radius * select(wide, cosine, sine), radius * select(wide, sine, cosine),
            radius * radius};
}

/// Directions around unit normals, the more the nearer to the normal: by its cosine.
inline LaneVectors aroundNormals(const LaneVectors& normal, const DiscLanes& disc) {
    const LaneFrame frame = frameAround(normal);
    const Lanes height = squareRoot(greatest(Lanes(1.0F) - disc.square, 0.0F));
    return along(along(normal * height, frame.a, disc.x), frame.b, disc.y);
}

} // namespace
} // namespace quarn
