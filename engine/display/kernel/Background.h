#pragma once

#include "engine/display/kernel/SquareMaps.h"

namespace quarn {
namespace {

inline Lanes power4(const Lanes& a) {
    const Lanes square = a * a;
    return square * square;
}
inline Lanes power8(const Lanes& a) {
    return power4(a * a);
}

inline Lanes mixed(float from, float to, const Lanes& t) {
    return Lanes(from) + t * (to - from);
}

/// From the top of the picture to its bottom.
inline LaneColors gradient(const FrameSetup& frame, const Lanes& y, const float (&top)[3],
                           const float (&bottom)[3]) {
    const Lanes s = clamped(y * (1.0F / static_cast<float>(frame.height)));
    const Lanes t = s * s * (Lanes(3.0F) - Lanes(2.0F) * s);
    return {mixed(top[0], bottom[0], t), mixed(top[1], bottom[1], t), mixed(top[2], bottom[2], t)};
}

inline LaneColors gradientColors(const FrameSetup& frame, const Lanes& y) {
    return gradient(frame, y, frame.background_top, frame.background_bottom);
}

/// The sky without the sun's disc, in a direction of length 1 / scale. Zenith and horizon blend
/// with the fourth power of what is missing to straight up, so that the sky is pale over a narrow
/// band, which is of another colour below the sun than across from it. Around the sun there is a
/// glow.
/// @param toward  cosine of the angle to the sun
inline LaneColors skyWithoutDisc(const FrameSetup& frame, const LaneVectors& d, const Lanes& scale,
                                 const Lanes& elevation, const Lanes& toward) {
    const Lanes up = Lanes(1.0F) - power4(Lanes(1.0F) - clamped(elevation));
    const Lanes down = Lanes(1.0F) - power4(power4(Lanes(1.0F) - clamped(-elevation)));
    const Lanes near_sun = power8(clamped(toward));
    const Lanes above = Lanes(1.0F) - down;
    const Lanes glow = (near_sun * 0.35F + power8(near_sun) * 0.65F) * above;
    const Lanes sunward = d.x * frame.toward_sun[0] + d.y * frame.toward_sun[1];
    const Lanes side = sunward * scale * (Lanes(1.0F) - up);
    const auto blend = [&](int c) {
        const float horizon = frame.sky_horizon[c];
        return Lanes(horizon) + up * (frame.sky_zenith[c] - horizon) + side * frame.sky_side[c] +
               down * (frame.sky_nadir[c] - horizon) + glow * frame.sky_glow[c];
    };
    return {blend(0), blend(1), blend(2)};
}

/// The sky with the sun's disc, which sets behind the horizon. In a parallel view all rays look the
/// same way; there the place in the picture adds to their elevation.
inline LaneColors skyColors(const FrameSetup& frame, const RayPacket& packet) {
    const Lanes scale = Lanes(1.0F) / squareRoot(dot(packet.direction(), packet.direction()));
    const float tilt = frame.rays.parallel ? 0.5F / static_cast<float>(frame.height) : 0.0F;
    const float middle = 0.5F * static_cast<float>(frame.height);
    const Lanes elevation = packet.direction().z * scale + (Lanes(middle) - packet.y) * tilt;
    const Lanes toward = dot(packet.direction(), frame.toward_sun) * scale;
    const LaneColors sky = skyWithoutDisc(frame, packet.direction(), scale, elevation, toward);
    // The disc is drawn with a soft border from 0.6 to 0.4 degrees from the sun's middle, a little
    // larger than it is: cameras see it so.
    const Lanes risen = clamped(elevation * 1000.0F);
    const Lanes disc = clamped((toward - 0.999945F) * (1.0F / 0.000031F)) * risen;
    return {sky.r + disc * frame.sky_disc[0], sky.g + disc * frame.sky_disc[1],
            sky.b + disc * frame.sky_disc[2]};
}

/// The picture of what lies around. A parallel view, whose rays all look the same way, shows of it
/// what a camera with a usual lens would see.
inline LaneColors pictureColors(const FrameSetup& frame, const RayPacket& packet) {
    LaneVectors direction = packet.direction();
    if (frame.rays.parallel) {
        constexpr float opening = 0.7F;
        const float step = opening / static_cast<float>(frame.height);
        const Lanes right = (packet.x - 0.5F * static_cast<float>(frame.width)) * step;
        const Lanes up = (Lanes(0.5F * static_cast<float>(frame.height)) - packet.y) * step;
        const auto axis = [](const float(&a)[3]) { return LaneVectors{a[0], a[1], a[2]}; };
        direction = along(along(direction, axis(frame.rays.camera_x), right),
                          axis(frame.rays.camera_y), up);
    }
    return seenOnMap<PictureMap>(frame.picture.sharp, frame.picture.scale, direction);
}

/// What is seen where there is neither surface nor ground.
inline LaneColors backgroundColors(const FrameSetup& frame, const RayPacket& packet) {
    if (frame.has_clear_background)
        return {0.0F, 0.0F, 0.0F};
    if (!frame.has_sky)
        return gradientColors(frame, packet.y);
    return frame.picture.sharp ? pictureColors(frame, packet) : skyColors(frame, packet);
}

} // namespace
} // namespace quarn
