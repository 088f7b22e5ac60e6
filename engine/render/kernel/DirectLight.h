#pragma once

#include "engine/display/kernel/LampLight.h"
#include "engine/render/kernel/Emitters.h"
#include "engine/render/kernel/EnvironmentLight.h"
#include "engine/render/kernel/Lobes.h"

namespace quarn {
namespace {

/// Surfaces that rays met, and all that is known of them.
struct MetLanes {
    const RenderSetup& setup;
    const RayPacket& packet;
    const SurfaceLanes& surfaces;
    const LookLanes* looks; ///< null where no surface has one
    LobeLanes lobes;
    StartLanes start;
    LaneMask lit;   ///< the lanes that ask for light
    LaneMask glass; ///< of these, the ones that scatter nothing
};

/// Light that surfaces send to the observer, scattered and mirrored.
struct SentLight {
    LaneColors matt{0.0F, 0.0F, 0.0F};
    LaneColors gloss{0.0F, 0.0F, 0.0F};

    void add(const SentLanes& sent, const LaneColors& light) {
        matt = matt + sent.matt * light;
        gloss = gloss + sent.gloss * light;
    }
};

/// A sun is no point, and its image on a mirror neither: highlights are as wide at least. Squared
/// roughness.
constexpr float sun_spread = 0.015F;

/// Light of this color on surfaces that face it has the radiance pi in the direction.
inline LaneColors ofFacingLight(const float (&color)[3]) {
    return uniformColor(color) * Lanes(pi);
}

inline LaneMask facingLanes(const MetLanes& met, const LaneVectors& toward) {
    return met.lit & (dot(met.lobes.normal, toward) > 0.0F);
}

/// The suns' light, from one place of their discs.
inline SentLight sentOfSuns(const MetLanes& met, const LanePlaces& place) {
    SentLight light;
    const FrameSetup& frame = met.setup.frame;
    const DiscLanes disc = onDisc(place);
    for (int k = 0; k < frame.sun_count; ++k) {
        const FrameLight& sun = frame.suns[k];
        const float(&across)[3] = met.setup.discs[k].across;
        const float(&up)[3] = met.setup.discs[k].along;
        const LaneVectors middle{sun.toward[0], sun.toward[1], sun.toward[2]};
        const LaneVectors toward{disc.x * across[0] + disc.y * up[0] + sun.toward[0],
                                 disc.x * across[1] + disc.y * up[1] + sun.toward[1],
                                 disc.x * across[2] + disc.y * up[2] + sun.toward[2]};
        const LaneMask facing = facingLanes(met, middle);
        if (!any(facing))
            continue;
        const LaneColors arriving = lightReaching(frame, met.packet, met.surfaces, met.start,
                                                  toward, unlimited, sun.shadow, facing);
        light.add(sentFrom(met.setup, met.lobes, met.looks, middle, sun_spread),
                  arriving * ofFacingLight(sun.color));
    }
    return light;
}

/// The light of lamps, each of which is a point.
inline void addSentOfLamps(const MetLanes& met, SentLight& light) {
    const FrameSetup& frame = met.setup.frame;
    for (int k = 0; k < frame.lamp_count; ++k) {
        const FrameLamp& lamp = frame.lamps[k];
        const LampLanes seen = lampAt(lamp, met.start.place);
        const LaneMask facing = facingLanes(met, seen.toward) & (seen.amount > 0.0F);
        if (!any(facing))
            continue;
        const LaneColors arriving =
            lightReaching(frame, met.packet, met.surfaces, met.start, seen.toward,
                          seen.distance * part_to_lamp, lamp.shadow, facing);
        light.add(sentFrom(met.setup, met.lobes, met.looks, seen.toward, sun_spread),
                  arriving * ofFacingLight(lamp.color) * select(facing, seen.amount, 0.0F));
    }
}

/// The light of the environment, from a direction where it is likely to be bright.
inline void addEnvironment(const MetLanes& met, const LanePlaces& place, SentLight& light) {
    Lanes density;
    const LaneVectors toward = towardEnvironment(met.setup, place, density);
    const LaneMask facing = facingLanes(met, toward) & ~met.glass & (density > 0.0F);
    if (!any(facing))
        return;
    const LaneColors arriving = lightReaching(met.setup.frame, met.packet, met.surfaces, met.start,
                                              toward, unlimited, 1.0F, facing);
    const SentLanes sent = sentFrom(met.setup, met.lobes, met.looks, toward);
    const Lanes weight = weightBeside(density, sent.density) / greatest(density, 1e-20F);
    const LaneColors around =
        arriving * lightAround(met.setup.bounce, toward) * select(facing, weight, 0.0F);
    light.matt = light.matt + sent.matt * around * scatteredPart(met.setup);
    light.gloss = light.gloss + sent.gloss * around;
}

/// The light of surfaces that shine, from one place on one of them.
inline void addEmitters(const MetLanes& met, const Lanes& choice, const LanePlaces& place,
                        SentLight& light) {
    const EmitterPlaces at = placesOnEmitters(met.setup, choice, place);
    const LaneVectors way = along(at.place, met.start.off, -1.0F);
    const Lanes square = greatest(dot(way, way), 1e-20F);
    const LaneVectors toward = ofUnitLength(way);
    const Lanes cosine = magnitude(dot(at.normal, toward));
    const LaneMask facing = facingLanes(met, toward) & ~met.glass & (cosine > 1e-4F);
    if (!any(facing))
        return;
    const LaneColors shining = shiningAt(met.setup, met.start.off, way, facing);
    const LaneMask seen = facing & (luminance(shining) > 0.0F);
    if (!any(seen))
        return;
    const LaneColors arriving = lightReaching(met.setup.frame, met.packet, met.surfaces, met.start,
                                              way, 1.0F - 2.0F * same_place, 1.0F, seen);
    const Lanes density = at.density * square / greatest(cosine, 1e-4F);
    const SentLanes sent = sentFrom(met.setup, met.lobes, met.looks, toward);
    const Lanes weight = weightBeside(density, sent.density) / greatest(density, 1e-20F);
    light.add(sent, arriving * shining * select(seen, weight, 0.0F));
}

} // namespace
} // namespace quarn
