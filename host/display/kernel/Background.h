#pragma once

#include "host/display/kernel/RayPacket.h"

namespace quarn {
namespace {

inline float power4(float a) {
    return a * a * a * a;
}
inline float power8(float a) {
    return power4(a * a);
}

/// From the top of the picture to its bottom.
inline void gradientColors(const FrameSetup& frame, const Lanes& y, LaneColors& color) {
    const float scale = 1.0F / static_cast<float>(frame.height);
    for (int i = 0; i < lane_count; ++i) {
        const float s = clamped(y.v[i] * scale);
        const float t = s * s * (3.0F - 2.0F * s);
        const float* const top = frame.background_top;
        const float* const bottom = frame.background_bottom;
        color.r.v[i] = top[0] + t * (bottom[0] - top[0]);
        color.g.v[i] = top[1] + t * (bottom[1] - top[1]);
        color.b.v[i] = top[2] + t * (bottom[2] - top[2]);
    }
}

/// Sine of the angle above the horizon under which each ray looks. In a parallel view all rays
/// look the same way; there the picture's height stands in.
inline void elevations(const FrameSetup& frame, const RayPacket& packet, Lanes& elevation) {
    const RTCRay16& ray = packet.rays.ray;
    const float tilt = frame.rays.parallel ? 0.5F / static_cast<float>(frame.height) : 0.0F;
    const float middle = 0.5F * static_cast<float>(frame.height);
    for (int i = 0; i < lane_count; ++i) {
        const float x = ray.dir_x[i];
        const float y = ray.dir_y[i];
        const float z = ray.dir_z[i];
        const float sine = z / squareRoot(x * x + y * y + z * z);
        elevation.v[i] = sine + tilt * (middle - packet.y.v[i]);
    }
}

/// Zenith and horizon blend with the fourth power of what is missing to straight up, so that the
/// sky is pale over a narrow band; around the sun there is a glow, and its disc.
inline void skyColors(const FrameSetup& frame, const RayPacket& packet, LaneColors& color) {
    const RTCRay16& ray = packet.rays.ray;
    const float* const sun = frame.toward_sun;
    Lanes elevation;
    elevations(frame, packet, elevation);
    for (int i = 0; i < lane_count; ++i) {
        const float e = elevation.v[i];
        const float up = 1.0F - power4(1.0F - clamped(e));
        const float down = 1.0F - power4(power4(1.0F - clamped(-e)));
        const float x = ray.dir_x[i];
        const float y = ray.dir_y[i];
        const float z = ray.dir_z[i];
        const float toward =
            (x * sun[0] + y * sun[1] + z * sun[2]) / squareRoot(x * x + y * y + z * z);
        const float near_sun = clamped(toward);
        const float glow =
            (0.35F * power8(near_sun) + 0.65F * power8(power8(near_sun))) * (1.0F - down);
        // The disc is drawn a little larger than the sun's half degree, with a soft border.
        const float disc = clamped((toward - 0.99984F) * (1.0F / 0.00006F)) * (1.0F - down);
        const auto blend = [&](int c) {
            const float horizon = frame.sky_horizon[c];
            return horizon + up * (frame.sky_zenith[c] - horizon) +
                   down * (frame.sky_nadir[c] - horizon) + glow * frame.sky_glow[c] +
                   disc * frame.sky_disc[c];
        };
        color.r.v[i] = blend(0);
        color.g.v[i] = blend(1);
        color.b.v[i] = blend(2);
    }
}

inline void backgroundColors(const FrameSetup& frame, const RayPacket& packet, LaneColors& color) {
    if (frame.has_sky)
        skyColors(frame, packet, color);
    else
        gradientColors(frame, packet.y, color);
}

} // namespace
} // namespace quarn
