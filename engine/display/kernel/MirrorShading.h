#pragma once

#include "engine/display/kernel/LookLanes.h"
#include "engine/display/kernel/MirroredLight.h"

namespace quarn {
namespace {

/// The mirrors of a surface and of the clear coat over it.
struct MirrorLayers {
    MirrorLanes base;
    MirrorLanes coat;
    LaneMask coated; ///< there is a coat; its mirrors are known if any lane has one
    bool has_coat;
};

/// What metals mirror has their colour; what others do, mostly none.
inline MirrorLayers mirrorLayers(const FrameSetup& frame, const RayPacket& packet,
                                 const SurfaceLanes& surfaces, const LookLanes& looks) {
    const LookNumbers<Lanes>& look = looks.numbers;
    MirrorLayers layers;
    layers.base.f0 = blended({look.f0[0], look.f0[1], look.f0[2]}, surfaces.albedo, look.metalness);
    layers.base.f90 = look.f90 + look.metalness * (Lanes(1.0F) - look.f90);
    layers.base.roughness = look.roughness;
    findMirrors(frame, packet, surfaces.face, surfaces.normal, layers.base);
    layers.coated = look.clearcoat > 0.0F;
    layers.has_coat = any(layers.coated);
    if (!layers.has_coat)
        return layers;
    layers.coat.f0 = {coat_f0, coat_f0, coat_f0};
    layers.coat.f90 = 1.0F;
    layers.coat.roughness = look.clearcoat_roughness;
    findMirrors(frame, packet, surfaces.face, looks.coat_normal, layers.coat);
    return layers;
}

/// What the light of suns and lamps does on a surface.
struct SunnyLanes {
    LaneColors scattered; ///< on a white surface
    LaneColors spots;
    LaneColors coat_spots;
};

/// A highlight of less is not worth a shadow ray.
constexpr float least_spot = 0.001F;

/// The highlights of one light after the other, see addLights.
class Highlights {
public:
    /// @param scattering  the lanes that do not mirror all light
    Highlights(const MirrorLayers& layers, const LaneMask& scattering, SunnyLanes& sunny)
        : m_layers(layers), m_scattering(scattering), m_sunny(sunny) {}

    LaneMask show(const LaneColors& light, const LaneVectors& toward, const Lanes& facing) {
        const LaneMask before = facing > 0.0F;
        m_spot = highlight(m_layers.base, toward);
        LaneMask seen = m_scattering | (brightest(m_spot * light) > least_spot);
        if (m_layers.has_coat) {
            m_coat_spot = highlight(m_layers.coat, toward) * select(before, 1.0F, 0.0F);
            seen = seen | (brightest(m_coat_spot * light) > least_spot);
        }
        return before & seen;
    }

    void add(const LaneColors& light) {
        m_sunny.spots = m_sunny.spots + m_spot * light;
        if (m_layers.has_coat)
            m_sunny.coat_spots = m_sunny.coat_spots + m_coat_spot * light;
    }

private:
    static Lanes brightest(const LaneColors& color) {
        return greatest(greatest(color.r, color.g), color.b);
    }

    const MirrorLayers& m_layers;
    const LaneMask m_scattering;
    SunnyLanes& m_sunny;
    LaneColors m_spot;
    LaneColors m_coat_spot;
};

inline SunnyLanes sunlight(const FrameSetup& frame, const RayPacket& packet,
                           const SurfaceLanes& surfaces, const LookNumbers<Lanes>& look,
                           const MirrorLayers& layers, const LaneMask& lit) {
    const LaneColors black{0.0F, 0.0F, 0.0F};
    SunnyLanes sunny{black, black, black};
    const LaneMask scattering = (look.metalness < 1.0F) & (look.transmission < 1.0F);
    Highlights highlights(layers, scattering, sunny);
    addLights(frame, packet, surfaces, lit, sunny.scattered, highlights);
    return sunny;
}

/// Up to the first roughness glass is clear, from the second on frosted.
constexpr float roughness_of_clear_glass = 0.2F;
constexpr float roughness_of_frosted_glass = 0.5F;

/// What comes through the surfaces from behind.
/// @param roughness  by which they blur it
/// @param passing    the part of it that passes; takes what is left for the one who looks behind
inline LaneColors frostedLight(const FrameSetup& frame, const LaneVectors& observer,
                               const Lanes& roughness, bool is_looked_through,
                               LaneColors& passing) {
    constexpr float fade = 1.0F / (roughness_of_frosted_glass - roughness_of_clear_glass);
    const Lanes clear = is_looked_through
                            ? clamped((Lanes(roughness_of_frosted_glass) - roughness) * fade)
                            : Lanes(0.0F);
    const LaneColors behind = mirroredSurroundings(frame, observer * Lanes(-1.0F), roughness);
    const LaneColors frosted = passing * (Lanes(1.0F) - clear) * behind;
    passing = passing * clear;
    return frosted;
}

/// The part of even light that gets to what is no metal: of half a metal the other half is as it is
/// without the metal.
inline LaneColors enteringLight(const LookNumbers<Lanes>& look, const MirrorLanes& base) {
    LaneColors first;
    LaneColors further;
    findSent(base, {look.f0[0], look.f0[1], look.f0[2]}, look.f90, first, further);
    return (LaneColors{1.0F, 1.0F, 1.0F} - first - further) * (Lanes(1.0F) - look.metalness);
}

/// Surfaces some of which mirror. What they mirror is no longer there to be scattered or to come
/// through.
inline LaneColors shadeMirrors(const FrameSetup& frame, const RayPacket& packet,
                               const SurfaceLanes& surfaces, const LookLanes& looks,
                               const LaneMask& lit, bool sends_rays, LaneColors* through) {
    const LookNumbers<Lanes>& look = looks.numbers;
    const MirrorLayers layers = mirrorLayers(frame, packet, surfaces, looks);
    const SunnyLanes sunny = sunlight(frame, packet, surfaces, look, layers, lit);
    const LaneColors sky = skyLight(frame, packet, surfaces, lit) * look.occlusion;
    LaneColors light = sky + sunny.scattered;
    addFixedLights(frame, surfaces.normal, light);
    const LaneMask sending = sends_rays && frame.mirrors_scene ? looks.mirrors & lit : noLanes();
    const MirrorLanes& base = layers.base;
    const LaneColors entering = enteringLight(look, base) * surfaces.albedo;
    LaneColors sent = entering * (Lanes(1.0F) - look.transmission) * light +
                      base.first * mirroredLight(frame, packet, surfaces, base,
                                                 sending & ~layers.coated, look.occlusion) +
                      base.further * sky + sunny.spots + emissionOf(frame, look);
    LaneColors passing{0.0F, 0.0F, 0.0F};
    if (any(look.transmission > 0.0F)) {
        passing = entering * LaneColors{look.passing[0], look.passing[1], look.passing[2]};
        sent = sent + frostedLight(frame, base.observer, base.roughness * look.bend,
                                   through != nullptr, passing);
    }
    if (layers.has_coat) {
        const LaneColors mirrored = layers.coat.first * look.clearcoat;
        const LaneColors below = LaneColors{1.0F, 1.0F, 1.0F} - mirrored;
        sent = sent * below +
               mirrored * mirroredLight(frame, packet, surfaces, layers.coat,
                                        sending & layers.coated, look.occlusion) +
               sunny.coat_spots * look.clearcoat;
        passing = passing * below;
    }
    if (through)
        *through = passing;
    return sent;
}

} // namespace
} // namespace quarn
