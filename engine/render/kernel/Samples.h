#pragma once

// Part of the render loops: what one sample of each pixel of a tile adds to the sums.

#include "engine/render/kernel/Paths.h"

namespace quarn {
namespace {

/// Light without the albedo of the surfaces that sent it, of which `sum` and `albedo` are sums: in
/// a channel in which they are black that of the channel in which they are brightest.
inline LaneColors withoutAlbedo(const LaneColors& sum, const LaneColors& albedo) {
    const LaneMask red = ~(albedo.g > albedo.r) & ~(albedo.b > albedo.r);
    const LaneMask green = ~(albedo.b > albedo.g);
    const Lanes brightest = select(red, albedo.r, select(green, albedo.g, albedo.b));
    const Lanes light = select(red, sum.r, select(green, sum.g, sum.b));
    const Lanes sure = light / greatest(brightest, 1e-12F);
    const auto channel = [&](const Lanes& s, const Lanes& a) {
        const LaneMask tells = a > brightest * 0.02F;
        return select(tells, s / select(tells, a, 1.0F), sure);
    };
    return {channel(sum.r, albedo.r), channel(sum.g, albedo.g), channel(sum.b, albedo.b)};
}

/// One sample of each pixel of a tile.
/// @param packet  knows the places of the picture
inline void addSample(const RenderSetup& setup, const SampleNumber& sample, RayPacket& packet,
                      TileSums& sums) {
    aim(setup.frame, packet);
    const PathLight found = PathTracing(setup, sample, packet, sums).follow();
    const Lanes sky_light = luminance(withoutAlbedo(found.sky, found.albedo));
    const Lanes sun_light = luminance(withoutAlbedo(found.sun, found.albedo));
    const Lanes gloss = luminance(found.gloss);
    sums.add(RenderPlane::direct_r, found.direct);
    sums.add(RenderPlane::albedo_r, found.albedo);
    sums.add(RenderPlane::sky_r, found.sky);
    sums.add(RenderPlane::sun_r, found.sun);
    sums.add(RenderPlane::gloss_r, found.gloss);
    sums.add(RenderPlane::sky_square, sky_light * sky_light);
    sums.add(RenderPlane::sun_square, sun_light * sun_light);
    sums.add(RenderPlane::gloss_square, gloss * gloss);
}

} // namespace
} // namespace quarn
