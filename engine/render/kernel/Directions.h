#pragma once

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

/// Directions around unit normals, the more the nearer to the normal: by its cosine. The frame of
/// a normal is that of T. Duff, J. Burgess, P. Christensen, C. Hery, A. Kensler, M. Liani and
/// R. Villemin, "Building an Orthonormal Basis, Revisited", JCGT 6(1), 2017.
inline LaneVectors aroundNormals(const LaneVectors& n, const LanePlaces& place) {
    const DiscLanes disc = onDisc(place);
    const Lanes height = squareRoot(greatest(Lanes(1.0F) - disc.square, 0.0F));
    const Lanes sign = select(n.z < Lanes(0.0F), -1.0F, 1.0F);
    const Lanes a = Lanes(-1.0F) / (sign + n.z);
    const Lanes b = n.x * n.y * a;
    const Lanes p = disc.x;
    const Lanes q = disc.y;
    return {p * (Lanes(1.0F) + sign * n.x * n.x * a) + q * b + height * n.x,
            p * sign * b + q * (sign + n.y * n.y * a) + height * n.y,
            height * n.z - p * sign * n.x - q * n.y};
}

} // namespace
} // namespace quarn
