#pragma once

#include "engine/display/kernel/Background.h"
#include "engine/display/kernel/SurfaceShading.h"

namespace quarn {
namespace {

/// How much of the ground lies in a direction, as it is seen from the middle of the scene.
inline Lanes groundAround(const FrameSetup& frame, const LaneVectors& direction) {
    const LaneMask downward = direction.z < -1e-5F;
    const Lanes across = squareRoot(direction.x * direction.x + direction.y * direction.y);
    const Lanes away = across * frame.ground_eye / select(downward, -direction.z, 1.0F);
    const float fade = 1.0F / (frame.ground_fade_end - frame.ground_fade_start);
    const Lanes s = clamped((Lanes(frame.ground_fade_end) - away) * fade);
    return select(downward, s * s * (Lanes(3.0F) - Lanes(2.0F) * s), 0.0F);
}

/// How much of a soft box is seen in a direction.
inline Lanes softBoxAround(const FrameSoftBox& box, const LaneVectors& direction) {
    const Lanes ahead = dot(direction, box.toward);
    const LaneMask before = ahead > 0.01F;
    const Lanes scale = Lanes(1.0F) / select(before, ahead, 1.0F);
    const auto within = [&](const float(&axis)[3], float half) {
        const Lanes beyond = absolute(dot(direction, axis)) * scale - half;
        const Lanes s = clamped(Lanes(0.5F) - beyond * (0.5F / box.border));
        return s * s * (Lanes(3.0F) - Lanes(2.0F) * s);
    };
    return select(before, within(box.across, box.half_width) * within(box.along, box.half_height),
                  0.0F);
}

/// The light that comes from far away in a direction of unit length, as if there were no ground.
/// The suns are not in it: they are lights of their own.
inline LaneColors lightAround(const FrameSetup& frame, const LaneVectors& direction) {
    if (frame.picture.sharp)
        return seenOnMap<PictureMap>(frame.picture.sharp, frame.picture.scale, direction);
    const Lanes toward_sun = dot(direction, frame.toward_sun);
    LaneColors light = skyWithoutDisc(frame, direction, 1.0F, direction.z, toward_sun);
    for (int i = 0; i < frame.soft_box_count; ++i) {
        const FrameSoftBox& box = frame.soft_boxes[i];
        addLight(box.color, softBoxAround(box, direction), light);
    }
    return light;
}

/// True where mirrors show the ground. A picture of what lies around has its own.
inline bool mirrorsGround(const FrameSetup& frame) {
    return frame.has_ground && !frame.picture.sharp;
}

/// Lays the ground, as it is seen from the middle of the scene, over what lies around.
inline LaneColors aboveGround(const FrameSetup& frame, const LaneVectors& direction,
                              const LaneColors& light) {
    if (!mirrorsGround(frame))
        return light;
    return blended(light, uniformColor(frame.ground_light), groundAround(frame, direction));
}

/// The light that comes from far away and from the ground in a direction of unit length. The suns
/// are not in it.
inline LaneColors surroundingLight(const FrameSetup& frame, const LaneVectors& direction) {
    return aboveGround(frame, direction, lightAround(frame, direction));
}

/// The same for surfaces that are rough enough not to tell apart what lies side by side.
inline LaneColors broadLight(const FrameSetup& frame, const LaneVectors& direction) {
    if (!frame.picture.broad)
        return surroundingLight(frame, direction);
    return aboveGround(frame, direction,
                       seenOnMap<BroadMap>(frame.picture.broad, frame.picture.scale, direction));
}

/// The light of picture `level` of the environment map, from 1 on.
inline LaneColors pictureAt(const FrameSetup& frame, const LaneInts& level, const MapPlace& place) {
    constexpr int texels = environment_map::texels;
    constexpr int stride = environment_map::stride;
    const LaneInts first = (level - LaneInts(1)) * LaneInts(environment_map::channels * texels);
    return {channelAt(frame.environment, stride, first, place),
            channelAt(frame.environment + texels, stride, first, place),
            channelAt(frame.environment + 2 * texels, stride, first, place)};
}

/// The light from around as a surface of some roughness mirrors it.
/// @param direction  where a perfect mirror would look; of unit length
inline LaneColors mirroredSurroundings(const FrameSetup& frame, const LaneVectors& direction,
                                       const Lanes& roughness) {
    const Lanes level = roughness * static_cast<float>(environment_map::levels);
    const LaneInts whole = limited(wholePart(level), environment_map::levels - 1);
    const Lanes part = level - floatsOf(whole);
    const MapPlace place = placeOnMap<environment_map::side>(direction);
    const LaneColors rougher = pictureAt(frame, whole + LaneInts(1), place);
    const LaneMask is_sharp = whole == LaneInts(0);
    LaneColors sharper = pictureAt(frame, select(is_sharp, LaneInts(1), whole), place);
    if (any(is_sharp))
        sharper = select(is_sharp, surroundingLight(frame, direction), sharper);
    return blended(sharper, rougher, part);
}

} // namespace
} // namespace quarn
