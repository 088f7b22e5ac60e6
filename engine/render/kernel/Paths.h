#pragma once

#include "engine/display/kernel/LookShading.h"
#include "engine/display/kernel/OneSided.h"
#include "engine/display/kernel/SeeThroughShading.h"
#include "engine/display/kernel/ShadowCatcher.h"
#include "engine/render/kernel/Glass.h"
#include "engine/render/kernel/TileSums.h"

namespace quarn {
namespace {

// Paths of light from the camera, surface by surface (J. Kajiya, "The Rendering Equation", SIGGRAPH
// 1986). A pane that is partly see-through is passed or met by chance.

/// A path comes to so many surfaces at most, panes that it passes among them.
constexpr int most_surfaces = 40;
/// And is sent on by so many that are not clear glass.
constexpr int most_bounces = 7;
/// From here on it may end by chance, the sooner the less light it brings.
constexpr int sure_bounces = 1;

/// What one sample of each pixel of a tile brings.
struct PathLight {
    LaneColors direct{0.0F, 0.0F, 0.0F};
    LaneColors sky{0.0F, 0.0F, 0.0F};
    LaneColors sun{0.0F, 0.0F, 0.0F};
    LaneColors gloss{0.0F, 0.0F, 0.0F};
    LaneColors albedo{0.0F, 0.0F, 0.0F}; ///< of the surface that is seen
};

/// Sixteen paths on their way.
struct PathLanes {
    LaneMask going;
    LaneColors weight{1.0F, 1.0F, 1.0F};     ///< of what is found from here on
    LaneColors matt_share{0.0F, 0.0F, 0.0F}; ///< of it, what the first surface scattered
    LaneColors around{1.0F, 1.0F, 1.0F};     ///< see scatteredPart; by what the last surface did
    LaneMask first;                          ///< the lane has met nothing but panes that it passed
    LaneMask clear;       ///< nor anything but glass that mirrors or lets through
    LaneMask unturned;    ///< nor did any of it mirror
    Lanes density = 0.0F; ///< of the last direction, by solid angle; 0: it was the only one
    LaneInts bounces = 0;
};

/// Light that was scattered on its way brings no more than this many times the light of a white
/// surface: what is found so seldom, and is so bright, would be a lone bright pixel.
constexpr float most_scattered = 6.0F;

/// Adds light from farther on to what it belongs to.
inline void addFound(const PathLanes& path, const LaneMask& lanes, const LaneColors& light,
                     PathLight& found) {
    const LaneColors none{0.0F, 0.0F, 0.0F};
    LaneColors brought = select(lanes, path.weight * light, none);
    const Lanes bright = luminance(brought);
    const LaneMask dazzling = ~path.clear & (bright > most_scattered);
    if (any(dazzling))
        brought = brought * select(dazzling, Lanes(most_scattered) / bright, 1.0F);
    found.direct = found.direct + select(path.first, brought, none);
    const LaneColors later = select(path.first, none, brought);
    const LaneColors scattered = later * path.matt_share;
    found.sky = found.sky + scattered;
    found.gloss = found.gloss + (later - scattered);
}

/// The light from infinitely far away in the lanes of `missed`.
inline void addBackground(const RenderSetup& setup, const RayPacket& packet, const PathLanes& path,
                          const LaneMask& missed, const Lanes& ground, PathLight& found) {
    LaneColors light{0.0F, 0.0F, 0.0F};
    if (any(missed & path.unturned))
        light = backgroundColors(setup.frame, packet);
    if (any(missed & ~path.unturned)) {
        const LaneVectors direction = ofUnitLength(packet.direction());
        LaneColors around = lightAround(setup.bounce, direction) * path.around;
        if (setup.environment.rows) {
            const LaneMask weighed = path.density > 0.0F;
            const Lanes weight = weightBeside(path.density, environmentDensity(setup, direction));
            around = around * select(weighed, weight, 1.0F);
        }
        light = select(path.unturned, light, around);
    }
    addFound(path, missed, light * (Lanes(1.0F) - ground), found);
}

/// The light that surfaces give off by themselves; ends the paths at those that do nothing else.
inline void addShining(const MetLanes& met, PathLanes& path, PathLight& found) {
    const FrameSetup& frame = met.setup.frame;
    const LookLanes& looks = *met.looks;
    LaneColors light = emissionOf(frame, looks.numbers);
    const LaneMask shining = path.going & met.packet.hit & (luminance(light) > 0.0F);
    if (any(shining)) {
        if (met.setup.emitters.count > 0) {
            const Lanes other = emitterDensity(met.setup, met.packet, met.surfaces, shining);
            light = light * select(path.density > 0.0F, weightBeside(path.density, other), 1.0F);
        }
        addFound(path, shining, light, found);
    }
    const LaneMask unlit = path.going & met.packet.hit & looks.unlit;
    if (!any(unlit))
        return;
    addFound(path, unlit, lightShownAs(frame, met.surfaces.albedo), found);
    path.going = path.going & ~unlit;
}

/// A choice that was used up to `chance` is as good as new on either side of it.
inline Lanes usedChoice(const Lanes& choice, const Lanes& chance, const LaneMask& below) {
    const Lanes used = select(below, choice / greatest(chance, 1e-9F),
                              (choice - chance) / greatest(Lanes(1.0F) - chance, 1e-9F));
    return least(clamped(used), 0.99999994F);
}

/// What comes through panes of the other colours than their own is less, the more opaque they are;
/// see passedByPane.
inline LaneColors hueBehind(const LaneColors& albedo, const Lanes& opacity) {
    const Lanes brightest = greatest(greatest(albedo.r, albedo.g), albedo.b);
    const LaneMask has_hue = brightest > 1e-12F;
    const auto channel = [&](const Lanes& color) {
        const Lanes hue = select(has_hue, color / greatest(brightest, 1e-12F), 1.0F);
        return Lanes(1.0F) - opacity * (Lanes(1.0F) - hue);
    };
    return {channel(albedo.r), channel(albedo.g), channel(albedo.b)};
}

/// Lets paths pass panes.
/// @return the lanes that do
inline LaneMask passPanes(const MetLanes& met, PathLanes& path, Lanes& choice) {
    const Lanes opacity = paneOpacities(met.setup.frame, met.packet, met.surfaces);
    const LaneMask maybe = path.going & met.packet.hit & (opacity < 1.0F);
    if (!any(maybe))
        return maybe;
    const LaneMask passes = maybe & ~(choice < opacity);
    choice = select(maybe, usedChoice(choice, opacity, choice < opacity), choice);
    const LaneColors tinted = path.weight * hueBehind(met.surfaces.albedo, opacity);
    path.weight = select(passes & ~path.first, tinted, path.weight);
    return passes;
}

/// Light that has been scattered goes through glass straight on, as that of lamps does, so that
/// neither way of finding it misses what the other finds.
/// @return the lanes that pass
inline LaneMask passGlass(const MetLanes& met, PathLanes& path, Lanes& choice) {
    const LookNumbers<Lanes>& look = met.looks->numbers;
    const LaneMask glass = path.going & met.packet.hit & ~path.clear & (look.transmission > 0.0F);
    if (!any(glass))
        return glass;
    const Lanes mirrored = luminance(met.lobes.base.sent);
    const Lanes chance = select(
        glass, look.transmission * (Lanes(1.0F) - look.metalness) * (Lanes(1.0F) - mirrored), 0.0F);
    const LaneMask passes = glass & (choice < chance);
    choice = select(glass, usedChoice(choice, chance, choice < chance), choice);
    const LaneColors left{look.passing[0], look.passing[1], look.passing[2]};
    const LaneColors tint =
        met.surfaces.albedo * left * (Lanes(1.0F) / greatest(look.transmission, 1e-6F));
    path.weight = select(passes, path.weight * tint, path.weight);
    path.weight =
        select(glass & ~passes, path.weight * (Lanes(1.0F) / (Lanes(1.0F) - chance)), path.weight);
    return passes;
}

/// Chooses the lanes whose surfaces are glass for paths that have met nothing else.
inline LaneMask chooseGlass(const MetLanes& met, const PathLanes& path, Lanes& choice) {
    const LookNumbers<Lanes>& look = met.looks->numbers;
    const Lanes chance = look.transmission * (Lanes(1.0F) - look.metalness);
    const LaneMask glass = path.going & met.packet.hit & path.clear & (chance > 0.0F);
    if (!any(glass))
        return glass;
    const LaneMask chosen = glass & (choice < chance);
    choice = select(glass, usedChoice(choice, chance, choice < chance), choice);
    return chosen;
}

/// Adds what surfaces send on of the lights, in the lanes of `met.lit`.
inline void addLights(const MetLanes& met, const PathLanes& path, const LanePlaces& place,
                      const Lanes& choice, PathLight& found) {
    SentLight sun = sentOfSuns(met, place);
    if (met.setup.frame.lamp_count > 0)
        addSentOfLamps(met, sun);
    SentLight around;
    if (met.setup.environment.rows)
        addEnvironment(met, place, around);
    if (met.setup.emitters.count > 0)
        addEmitters(met, choice, place, around);
    const LaneColors none{0.0F, 0.0F, 0.0F};
    const LaneMask seen = met.lit & path.first;
    if (any(seen)) {
        const LaneColors weight = select(seen, path.weight, none);
        found.sun = found.sun + weight * sun.matt;
        found.sky = found.sky + weight * around.matt;
        found.gloss = found.gloss + weight * (sun.gloss + around.gloss);
    }
    const LaneMask later = met.lit & ~path.first;
    if (any(later))
        addFound(path, later, sun.matt + sun.gloss + around.matt + around.gloss, found);
}

/// The light that follows the camera, on what is seen, in mirrors and through glass too.
inline void addFixed(const MetLanes& met, const LaneMask& seen, const PathLanes& path,
                     PathLight& found) {
    LaneColors light{0.0F, 0.0F, 0.0F};
    addFixedLights(met.setup.frame, met.surfaces.normal, light);
    addFound(path, seen, met.lobes.matt * light, found);
}

/// Sends the paths of `met.lit` on.
inline void scatter(const MetLanes& met, const LanePlaces& place, const Lanes& choice,
                    PathLanes& path, LaneVectors& origin, LaneVectors& direction) {
    const NextRay next = nextRay(met.setup, met.lobes, met.looks, choice, place);
    const LaneMask lanes = met.lit & ~met.glass;
    const LaneColors all = next.matt + next.gloss;
    const auto share = [](const Lanes& matt, const Lanes& sum) {
        return select(sum > 0.0F, matt / select(sum > 0.0F, sum, 1.0F), 1.0F);
    };
    const LaneColors matt_share{share(next.matt.r, all.r), share(next.matt.g, all.g),
                                share(next.matt.b, all.b)};
    path.matt_share = select(lanes & path.first, matt_share, path.matt_share);
    const LaneColors none{0.0F, 0.0F, 0.0F};
    const LaneColors gloss_share = select(lanes, complement(matt_share), none);
    path.around = select(lanes, gloss_share + matt_share * scatteredPart(met.setup), path.around);
    path.weight = select(lanes, path.weight * all, path.weight);
    path.density = select(lanes, next.density, path.density);
    const LaneMask turned = lanes & ~(next.density > 0.0F);
    path.clear = path.clear & (~lanes | turned);
    path.unturned = path.unturned & ~lanes;
    path.first = path.first & ~lanes;
    origin = select(lanes, met.start.off, origin);
    direction = select(lanes, aboveFace(next.direction, met.surfaces.face), direction);
    path.bounces = select(lanes, path.bounces + LaneInts(1), path.bounces);
}

/// Lets the paths of `met.glass` through, or mirrors them.
/// @param place   of the small mirrors
inline void goThroughGlass(const MetLanes& met, const GlassLanes& glass, const LanePlaces& place,
                           const Lanes& choice, PathLanes& path, LaneVectors& origin,
                           LaneVectors& direction) {
    const LookNumbers<Lanes>& look = met.looks->numbers;
    const GlassRay ray = glassRay(met.lobes, glass, choice, onDisc(place));
    const LaneMask through = met.glass & ~ray.mirrored;
    const LaneColors left{look.passing[0], look.passing[1], look.passing[2]};
    const LaneColors of_sheet = left * (Lanes(1.0F) / greatest(look.transmission, 1e-6F));
    const LaneColors tint =
        met.surfaces.albedo * select(glass.thin, of_sheet, LaneColors{1.0F, 1.0F, 1.0F});
    path.weight = select(through, path.weight * tint, path.weight);
    path.density = select(met.glass, Lanes(0.0F), path.density);
    path.around = select(met.glass, LaneColors{1.0F, 1.0F, 1.0F}, path.around);
    path.unturned = path.unturned & ~(met.glass & ray.mirrored);
    path.first = path.first & ~met.glass;
    const LaneVectors behind = along(met.start.place, met.start.off, -1.0F);
    const LaneVectors start = select(through, along(met.start.place, behind, 1.0F), met.start.off);
    origin = select(met.glass, start, origin);
    direction = select(met.glass, ray.direction, direction);
}

/// What the inside of glass takes of the light of paths that come to its surface from there.
inline void takeInside(const MetLanes& met, const GlassLanes& glass, const LaneMask& lanes,
                       PathLanes& path) {
    const LaneMask inside = lanes & ~glass.front & ~glass.thin;
    if (!any(inside))
        return;
    const LaneVectors way = met.packet.direction();
    const Lanes length = select(inside, met.packet.distance, 0.0F) * squareRoot(dot(way, way));
    path.weight = select(inside, path.weight * leftBehind(glass.absorption, length), path.weight);
}

/// Ends paths that bring little, by chance, so that others stand for them.
inline void endSome(const Lanes& choice, PathLanes& path) {
    const Lanes most = greatest(greatest(path.weight.r, path.weight.g), path.weight.b);
    const LaneMask maybe = path.going & (path.bounces > LaneInts(sure_bounces));
    const Lanes chance = select(maybe, least(most, 0.95F), 1.0F);
    path.going = path.going & (choice < chance) & ~(path.bounces > LaneInts(most_bounces));
    path.weight = path.weight * (Lanes(1.0F) / greatest(chance, 1e-6F));
}

/// One sample of each pixel of a tile on its way: the rays, and what they found.
class PathTracing {
public:
    /// @param packet  rays from the camera
    PathTracing(const RenderSetup& setup, const SampleNumber& sample, RayPacket& packet,
                TileSums& sums)
        : m_setup(setup), m_sample(sample), m_packet(packet), m_sums(sums) {
        m_path.going = packet.active;
        m_path.first = m_path.clear = m_path.unturned = ~noLanes();
    }

    const PathLight& follow() {
        const LaneMask active = m_packet.active;
        for (int step = 0; step < most_surfaces && any(m_path.going); ++step)
            meetSurfaces(step);
        store(m_packet.rays.ray.tnear, 0.0F);
        m_packet.active = active;
        return m_found;
    }

private:
    LanePlaces places(SampleUse use) const { return placesAt(m_sample, use, m_surface); }

    /// Ends the paths that met nothing; others may meet the ground.
    /// @return how much of it they see
    Lanes meetGroundOrNothing(const FrameSetup& frame, SurfaceLanes& surfaces) {
        Lanes ground = 0.0F;
        m_caught = noLanes();
        const LaneMask missed = m_path.going & ~m_packet.hit;
        if (!any(missed))
            return ground;
        if (frame.has_ground)
            ground = meetGround(frame, m_packet, surfaces).weight;
        addBackground(m_setup, m_packet, m_path, missed, ground, m_found);
        const LaneMask on_ground = missed & (ground > 0.0F);
        if (frame.has_clear_background)
            addNothing(missed & m_path.unturned, ground);
        const LaneMask seen = on_ground & m_path.unturned;
        if (frame.catches_shadows && any(seen))
            catchShadows(frame, seen, ground, surfaces);
        m_path.weight = select(on_ground, m_path.weight * ground, m_path.weight);
        m_path.going = m_path.going & (m_packet.hit | on_ground);
        return ground;
    }

    /// Where nothing is seen before a clear background: ground that takes shadows is none in
    /// itself.
    void addNothing(const LaneMask& missed, const Lanes& ground) {
        const Lanes none = luminance(m_path.weight);
        const LaneMask known = m_setup.frame.catches_shadows ? missed & m_path.first : noLanes();
        const Lanes seen = select(known, ground, 0.0F);
        m_sums.add(RenderPlane::nothing, select(missed, none * (Lanes(1.0F) - seen), 0.0F));
    }

    /// Where nothing shadows it the ground looks like what lies behind it. Its part of the picture
    /// is kept apart, unless it is seen through glass or all is light from far away: shadows take
    /// from what is shown, which is found when all samples are there.
    void catchShadows(const FrameSetup& frame, const LaneMask& lanes, const Lanes& ground,
                      SurfaceLanes& surfaces) {
        const Lanes t = select(lanes, m_packet.distance, 0.0F);
        // The light that follows the camera casts no shadows, and is left out of both sides.
        LaneColors fixed{0.0F, 0.0F, 0.0F};
        addFixedLights(m_setup.frame, {0.0F, 0.0F, 1.0F}, fixed);
        const LaneColors open =
            lightOnOpenGround(m_setup.frame, along(m_packet.origin(), m_packet.direction(), t)) -
            fixed;
        const LaneColors part{Lanes(1.0F) / greatest(open.r, 1e-6F),
                              Lanes(1.0F) / greatest(open.g, 1e-6F),
                              Lanes(1.0F) / greatest(open.b, 1e-6F)};
        LaneMask apart = noLanes();
        m_caught = lanes;
        if (!frame.has_sky) {
            apart = lanes & m_path.first;
            const Lanes weight = select(apart, ground, 0.0F);
            m_sums.add(RenderPlane::catcher, weight);
            m_sums.add(RenderPlane::catcher_r, part * weight);
        }
        const LaneColors behind =
            select(apart, LaneColors{1.0F, 1.0F, 1.0F}, backgroundColors(m_setup.frame, m_packet));
        surfaces.albedo = select(lanes, part * behind, surfaces.albedo);
    }

    /// Keeps what is seen there: the first surfaces that are no panes.
    void takeSeen(const MetLanes& met, const LaneMask& seen, const Lanes& ground) {
        const Lanes weight = select(seen, select(met.packet.hit, Lanes(1.0F), ground), 0.0F);
        m_found.albedo = m_found.albedo + met.lobes.matt * weight;
        addSurfaces(m_setup.frame, met.packet, met.surfaces, weight, m_sums);
    }

    void meetSurfaces(int step) {
        const FrameSetup& frame = step == 0 ? m_setup.frame : m_setup.bounce;
        m_packet.active = m_path.going;
        intersectFronts(frame, m_packet,
                        step == 0 ? RTC_INTERSECT_CONTEXT_FLAG_COHERENT
                                  : RTC_INTERSECT_CONTEXT_FLAG_INCOHERENT);
        SurfaceLanes surfaces;
        readSurfaces(frame, m_packet, surfaces);
        const Lanes ground = meetGroundOrNothing(frame, surfaces);
        if (!any(m_path.going))
            return;
        LookLanes looks;
        const bool has_looks = frame.has_looks && readLooks(frame, m_packet, surfaces, looks);
        MetLanes met{m_setup, m_packet, surfaces, has_looks ? &looks : nullptr, {}, {}, {}, {}};
        startLobes(m_setup, m_packet, surfaces, met.looks, met.lobes);
        const LanePlaces chance = places(SampleUse::choice);
        Lanes choice = select(m_passed, m_choice, chance.u);
        m_passed = step < most_panes ? passSome(met, choice) : noLanes();
        m_choice = choice;
        const LaneMask passes = m_passed;
        const LaneMask stays = m_path.going & ~passes;
        if (any(stays & m_path.first))
            takeSeen(met, stays & m_path.first, ground);
        m_path.going = stays;
        if (has_looks)
            addShining(met, m_path, m_found);
        met.lit = m_path.going;
        met.glass = noLanes();
        LaneVectors origin = m_packet.origin();
        LaneVectors direction = m_packet.direction();
        if (any(met.lit)) {
            sendOn(met, chance.v, choice, origin, direction);
            ++m_surface;
        }
        m_path.going = m_path.going | passes;
        endSome(chance.v, m_path);
        const Lanes beyond = m_packet.distance * 1.00002F + 1e-5F * frame.scene_size;
        store(m_packet.rays.ray.tnear, select(passes, beyond, 0.0F));
        setOrigin(m_packet.rays.ray, origin);
        setDirection(m_packet.rays.ray, direction);
    }

    LaneMask passSome(MetLanes& met, Lanes& choice) {
        LaneMask passes = noLanes();
        if (m_setup.frame.has_see_through)
            passes = passPanes(met, m_path, choice);
        if (met.lobes.has_mirrors && any(met.looks->numbers.transmission > 0.0F))
            passes = passes | (passGlass(met, m_path, choice) & ~passes);
        return passes;
    }

    void sendOn(MetLanes& met, const Lanes& chance, Lanes& choice, LaneVectors& origin,
                LaneVectors& direction) {
        met.start = startLanes(m_setup.frame, m_packet, met.surfaces, met.lit);
        GlassLanes glass = noGlass();
        if (met.lobes.has_mirrors && any(met.looks->numbers.transmission > 0.0F))
            startGlass(met, glass, choice);
        const LaneMask followed = met.lit & m_path.clear & ~m_caught;
        if (m_setup.frame.fixed_count > 0 && any(followed))
            addFixed(met, followed, m_path, m_found);
        addLights(met, m_path, places(SampleUse::light), chance, m_found);
        const LanePlaces place = places(SampleUse::direction);
        scatter(met, place, choice, m_path, origin, direction);
        if (any(met.glass))
            goThroughGlass(met, glass, place, choice, m_path, origin, direction);
    }

    /// Surfaces of glass scatter nothing; those that are glass in part do one or the other.
    void startGlass(MetLanes& met, GlassLanes& glass, Lanes& choice) {
        const LookNumbers<Lanes>& look = met.looks->numbers;
        const LaneMask lanes = met.lit & m_packet.hit & (look.transmission > 0.0F);
        glass = readGlass(m_setup.frame, m_packet, met.surfaces, lanes);
        met.glass = chooseGlass(met, m_path, choice);
        takeInside(met, glass, met.glass, m_path);
        const LaneMask scattering = lanes & ~met.glass & ~m_path.clear;
        const LaneColors none{0.0F, 0.0F, 0.0F};
        met.lobes.matt = select(met.glass, none, met.lobes.matt);
        met.lobes.matt =
            select(scattering, met.lobes.matt * (Lanes(1.0F) - look.transmission), met.lobes.matt);
    }

    const RenderSetup& m_setup;
    const SampleNumber& m_sample;
    RayPacket& m_packet;
    TileSums& m_sums;
    PathLanes m_path;
    PathLight m_found;
    int m_surface = 0;             ///< how many of those that send light on the paths have come to
    LaneMask m_caught = noLanes(); ///< the lanes that are on ground that shows shadows alone
    LaneMask m_passed = noLanes(); ///< the lanes that passed the last surface,
    Lanes m_choice = 0.0F;         ///< and what is left of their choices
};

} // namespace
} // namespace quarn
