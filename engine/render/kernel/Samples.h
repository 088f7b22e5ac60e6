#pragma once

// Part of the render loops: what one sample of each pixel of a tile adds to the sums.

#include "engine/render/kernel/SoftLight.h"

namespace quarn {
namespace {

/// The sums of one tile while its samples are taken.
struct TileSums {
    Lanes plane[RenderPlane::count];

    void add(int at, const Lanes& value) { plane[at] = plane[at] + value; }
    void add(int at, const LaneColors& value) {
        add(at, value.r);
        add(at + 1, value.g);
        add(at + 2, value.b);
    }
};

/// Rec. 709 luminance.
inline Lanes luminance(const LaneColors& c) {
    return c.r * 0.2126F + c.g * 0.7152F + c.b * 0.0722F;
}

/// Light of the lights that cast no shadow.
inline LaneColors fixedLight(const FrameSetup& frame, const SurfaceLanes& surfaces) {
    LaneColors light{0.0F, 0.0F, 0.0F};
    for (int k = 0; k < frame.fixed_count; ++k)
        addLight(frame.fixed[k].color, greatest(dot(surfaces.normal, frame.fixed[k].toward), 0.0F),
                 light);
    return light;
}

inline void addSurfaces(const FrameSetup& frame, const RayPacket& packet,
                        const SurfaceLanes& surfaces, const Lanes& weight, TileSums& sums) {
    const Lanes near = frame.rays.parallel ? Lanes(frame.rays.far_depth) - packet.distance
                                           : Lanes(1.0F) / packet.distance;
    sums.add(RenderPlane::nearness, select(weight > 0.0F, weight * near, 0.0F));
    sums.add(RenderPlane::normal_x, weight * surfaces.normal.x);
    sums.add(RenderPlane::normal_y, weight * surfaces.normal.y);
    sums.add(RenderPlane::normal_z, weight * surfaces.normal.z);
    sums.add(RenderPlane::cover, weight);
}

/// The places of one sample of each pixel of a tile, and the rays that it needs.
struct SampleRays {
    const RenderSetup& setup;
    LanePlaces sky;
    LanePlaces sun;
    RayPacket& packet;
    RayPacket& bounce;
};

/// The light that surfaces get.
struct ArrivingLight {
    LaneColors sky;
    LaneColors sun;
};

inline ArrivingLight lightOn(SampleRays& rays, const SurfaceLanes& surfaces, const LaneMask& lit) {
    const StartLanes start = startLanes(rays.setup.frame, rays.packet, surfaces, lit);
    return {skyLight(rays.setup, rays.packet, surfaces, start, lit, rays.sky, rays.bounce),
            sunLight(rays.setup, rays.packet, surfaces, start, lit, rays.sun)};
}

/// How much of what the packet met counts; adds the background.
/// @param part  of what the rays see that comes through panes before it; 0 for idle rays
/// @return 0 to 1, as a share of `part`
inline Lanes weightOfMet(const FrameSetup& frame, RayPacket& packet, SurfaceLanes& surfaces,
                         const Lanes& part, TileSums& sums) {
    Lanes weight = select(packet.hit, 1.0F, 0.0F);
    if (!any(packet.active & ~packet.hit))
        return weight;
    if (frame.has_ground)
        weight = greatest(weight, meetGround(frame, packet, surfaces).weight);
    sums.add(RenderPlane::direct_r,
             backgroundColors(frame, packet) * (part * (Lanes(1.0F) - weight)));
    return weight;
}

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

/// One sample of each pixel of a tile whose rays met see-through surfaces, maybe: it takes the
/// light of all surfaces along the way, each as far as it is seen. So what is left to chance is the
/// same as without panes.
/// @param surfaces  what the packet met first
[[gnu::noinline]] void addSampleThroughPanes(SampleRays& rays, SurfaceLanes& surfaces,
                                             TileSums& sums) {
    const FrameSetup& frame = rays.setup.frame;
    RayPacket& packet = rays.packet;
    const LaneMask active = packet.active;
    constexpr float none[3] = {0.0F, 0.0F, 0.0F};
    LaneColors albedo_sum = uniformColor(none);
    LaneColors sky_sum = albedo_sum;
    LaneColors sun_sum = albedo_sum;
    Lanes weight_sum = 0.0F;
    Lanes left = 1.0F; // what still comes through
    for (int pane = 0;; ++pane) {
        const Lanes opacity = pane < most_panes ? paneOpacities(frame, packet, surfaces) : 1.0F;
        const LaneMask goes_on = packet.active & packet.hit & (opacity < 1.0F) &
                                 (left * (Lanes(1.0F) - opacity) > least_light);
        const Lanes part = select(packet.active, left * opacity, 0.0F);
        const Lanes met = part * weightOfMet(frame, packet, surfaces, part, sums);
        const LaneMask lit = packet.active & (met > 0.0F);
        if (any(lit)) {
            const Lanes weight = select(lit, met, 0.0F);
            const LaneColors albedo = surfaces.albedo * weight;
            const ArrivingLight light = lightOn(rays, surfaces, lit);
            sums.add(RenderPlane::direct_r, albedo * fixedLight(frame, surfaces));
            albedo_sum = albedo_sum + albedo;
            sky_sum = sky_sum + albedo * light.sky;
            sun_sum = sun_sum + albedo * light.sun;
            weight_sum = weight_sum + weight;
            addSurfaces(frame, packet, surfaces, weight, sums);
        }
        left = left - part;
        packet.active = goes_on;
        if (!any(goes_on))
            break;
        goOn(frame, packet, surfaces);
    }
    store(packet.rays.ray.tnear, 0.0F);
    packet.active = active;
    const Lanes sky_light = luminance(withoutAlbedo(sky_sum, albedo_sum));
    const Lanes sun_light = luminance(withoutAlbedo(sun_sum, albedo_sum));
    sums.add(RenderPlane::albedo_r, albedo_sum);
    sums.add(RenderPlane::sky_r, sky_sum);
    sums.add(RenderPlane::sun_r, sun_sum);
    sums.add(RenderPlane::sky_square, weight_sum * sky_light * sky_light);
    sums.add(RenderPlane::sun_square, weight_sum * sun_light * sun_light);
}

/// One sample of each pixel of a tile.
inline void addSample(SampleRays& rays, TileSums& sums) {
    const FrameSetup& frame = rays.setup.frame;
    RayPacket& packet = rays.packet;
    aim(frame, packet);
    intersect(frame, packet);
    SurfaceLanes surfaces;
    readSurfaces(frame, packet, surfaces);
    if (frame.has_see_through)
        return addSampleThroughPanes(rays, surfaces, sums);
    const Lanes met = weightOfMet(frame, packet, surfaces, 1.0F, sums);
    const LaneMask lit = packet.active & (met > 0.0F);
    if (!any(lit))
        return;
    const Lanes weight = select(lit, met, 0.0F);
    const LaneColors albedo = surfaces.albedo * weight;
    const ArrivingLight light = lightOn(rays, surfaces, lit);
    const Lanes sky_light = luminance(light.sky);
    const Lanes sun_light = luminance(light.sun);
    sums.add(RenderPlane::direct_r, albedo * fixedLight(frame, surfaces));
    sums.add(RenderPlane::albedo_r, albedo);
    sums.add(RenderPlane::sky_r, albedo * light.sky);
    sums.add(RenderPlane::sun_r, albedo * light.sun);
    sums.add(RenderPlane::sky_square, weight * sky_light * sky_light);
    sums.add(RenderPlane::sun_square, weight * sun_light * sun_light);
    addSurfaces(frame, packet, surfaces, weight, sums);
}

} // namespace
} // namespace quarn
