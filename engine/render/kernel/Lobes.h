#pragma once

#include "engine/display/kernel/LookLanes.h"
#include "engine/display/kernel/Microfacets.h"
#include "engine/display/kernel/OpenSky.h"
#include "engine/render/kernel/Directions.h"

namespace quarn {
namespace {

// How surfaces send light on: matt ones evenly, those of many small mirrors around where a mirror
// would, and a clear coat over them once more. Light that goes from small mirror to small mirror is
// sent evenly as well (C. Kulla and A. Conty, "Revisiting Physically Based Shading at Imageworks",
// SIGGRAPH 2017 course), and what is scattered under the mirrors is what these let in and out again
// (C. Kelemen and L. Szirmay-Kalos, "A Microfacet Based Coupled Specular-Matte BRDF Model with
// Importance Sampling", Eurographics 2001), so that nothing is lost and both ways are alike.

constexpr float pi = 3.14159265F;

/// Smoother ones are perfect mirrors: floats could not tell their highlight from one direction.
constexpr float least_rough = 0.045F;

/// Many small mirrors of one roughness, as one observer sees them.
struct FacetLanes {
    LaneVectors normal;
    LaneFrame around;
    Lanes facing; ///< cosine between normal and observer
    Lanes alpha;  ///< roughness squared
    LaneColors f0;
    Lanes f90;
    LaneMask perfect; ///< all mirrors lie alike
    LaneColors sent;  ///< the part of even light that comes off them, by any way
};

/// All that a surface does with light.
struct LobeLanes {
    LaneVectors observer; ///< unit vector
    LaneVectors normal;
    LaneColors matt; ///< colour of what is scattered
    LaneMask mirrors;
    bool has_mirrors;
    FacetLanes base;
    Lanes roughness;
    LaneColors f0_of_matt; ///< what mirrors over what is matt: none of the metal's
    Lanes f90_of_matt;
    LaneColors further_of_matt;
    LaneColors let_in;  ///< to what is matt, from the observer's side, beside the mean
    LaneColors further; ///< what comes off in the end of light that went from mirror to mirror
    Lanes lost;         ///< of the observer's side by single mirrors, beside the mean
    bool has_coat;
    Lanes coat; ///< how much of the surface is under one
    FacetLanes over;
    Lanes even; ///< the brightness of what goes from mirror to mirror, seen by the observer
    Lanes mirror_chance; ///< that a ray goes by the mirrors
    Lanes coat_chance;
};

/// The light that a direction sends to the observer, of a radiance of 1 there: split by whether
/// it was scattered or mirrored; and how densely rays are sent that way.
struct SentLanes {
    LaneColors matt;
    LaneColors gloss;
    Lanes density; ///< by solid angle; 0 for perfect mirrors
};

inline Lanes luminance(const LaneColors& c) {
    return c.r * 0.2126F + c.g * 0.7152F + c.b * 0.0722F; // Rec. 709
}

inline Lanes power5(const Lanes& x) {
    return power4(x) * x;
}

inline LaneColors complement(const LaneColors& c) {
    return LaneColors{1.0F, 1.0F, 1.0F} - c;
}

/// Schlick 1994.
inline LaneColors mirroredPart(const FacetLanes& facets, const Lanes& cosine) {
    const Lanes t = power5(Lanes(1.0F) - clamped(cosine));
    return {facets.f0.r + t * (facets.f90 - facets.f0.r),
            facets.f0.g + t * (facets.f90 - facets.f0.g),
            facets.f0.b + t * (facets.f90 - facets.f0.b)};
}

inline LaneColors ofSplitSum(const LaneColors& f0, const Lanes& f90, const Lanes& a,
                             const Lanes& b) {
    const Lanes along_face = f90 * b;
    return {f0.r * a + along_face, f0.g * a + along_face, f0.b * a + along_face};
}

/// The mean of a split sum over all directions, by their cosine.
inline void readSplitMeans(const RenderSetup& setup, const Lanes& roughness, Lanes& a, Lanes& b) {
    constexpr int side = SplitSum::side;
    const Lanes y = roughness * static_cast<float>(side - 1);
    const LaneInts row = limited(wholePart(y), side - 2);
    const Lanes below = y - floatsOf(row);
    const auto entry = [&](const float* means) {
        const auto* const from = reinterpret_cast<const std::uint32_t*>(means);
        const Lanes upper = floatsWith(gathered(from, row));
        return upper + below * (floatsWith(gathered(from + 1, row)) - upper);
    };
    a = entry(setup.mean_a);
    b = entry(setup.mean_b);
}

/// Of light that went from mirror to mirror, what comes off in the end.
inline LaneColors furtherPart(const LaneColors& f0, const Lanes& f90, const Lanes& single_mean) {
    const Lanes lost = Lanes(1.0F) - single_mean;
    const auto channel = [&](const Lanes& straight) {
        const Lanes mean = straight + (f90 - straight) * (1.0F / 21.0F);
        return mean * mean * single_mean / (Lanes(1.0F) - mean * lost);
    };
    return {channel(f0.r), channel(f0.g), channel(f0.b)};
}

inline void startFacets(const LobeLanes& lobes, const LaneVectors& normal, const Lanes& roughness,
                        FacetLanes& facets) {
    facets.normal = normal;
    facets.around = frameAround(normal);
    facets.facing = least(greatest(dot(normal, lobes.observer), 0.001F), 1.0F);
    facets.alpha = greatest(roughness * roughness, least_rough * least_rough);
    facets.perfect = roughness < least_rough;
}

inline void startMirrors(const RenderSetup& setup, const SurfaceLanes& surfaces,
                         const LookLanes& looks, LobeLanes& lobes) {
    const LookNumbers<Lanes>& look = looks.numbers;
    lobes.matt = lobes.matt * (Lanes(1.0F) - look.metalness);
    FacetLanes& base = lobes.base;
    lobes.roughness = look.roughness;
    lobes.f0_of_matt = {look.f0[0], look.f0[1], look.f0[2]};
    lobes.f90_of_matt = look.f90;
    base.f0 = blended(lobes.f0_of_matt, surfaces.albedo, look.metalness);
    base.f90 = look.f90 + look.metalness * (Lanes(1.0F) - look.f90);
    startFacets(lobes, surfaces.normal, look.roughness, base);
    Lanes a;
    Lanes b;
    readSplitSum(setup.frame, base.facing, look.roughness, a, b);
    Lanes mean_a;
    Lanes mean_b;
    readSplitMeans(setup, look.roughness, mean_a, mean_b);
    const Lanes lost = Lanes(1.0F) - a - b;
    const Lanes lost_mean = Lanes(1.0F) - mean_a - mean_b;
    lobes.further_of_matt = furtherPart(lobes.f0_of_matt, lobes.f90_of_matt, mean_a + mean_b);
    lobes.further = blended(lobes.further_of_matt,
                            furtherPart(surfaces.albedo, 1.0F, mean_a + mean_b), look.metalness);
    lobes.lost = lost / greatest(lost_mean, 1e-6F);
    const LaneColors further = lobes.further * lost;
    base.sent = ofSplitSum(base.f0, base.f90, a, b) + further;
    lobes.even = luminance(further);
    const LaneColors mean = ofSplitSum(lobes.f0_of_matt, lobes.f90_of_matt, mean_a, mean_b) +
                            lobes.further_of_matt * lost_mean;
    const LaneColors sent =
        ofSplitSum(lobes.f0_of_matt, lobes.f90_of_matt, a, b) + lobes.further_of_matt * lost;
    const auto channel = [&](const Lanes& part, const Lanes& part_mean) {
        return (Lanes(1.0F) - part) / greatest(Lanes(1.0F) - part_mean, 1e-4F);
    };
    lobes.let_in = {channel(sent.r, mean.r), channel(sent.g, mean.g), channel(sent.b, mean.b)};
}

inline void startCoat(const RenderSetup& setup, const LookLanes& looks, LobeLanes& lobes) {
    const LookNumbers<Lanes>& look = looks.numbers;
    lobes.coat = look.clearcoat;
    lobes.has_coat = any(look.clearcoat > 0.0F);
    lobes.coat_chance = 0.0F;
    if (!lobes.has_coat)
        return;
    FacetLanes& over = lobes.over;
    over.f0 = {coat_f0, coat_f0, coat_f0};
    over.f90 = 1.0F;
    startFacets(lobes, looks.coat_normal, look.clearcoat_roughness, over);
    Lanes a;
    Lanes b;
    readSplitSum(setup.frame, over.facing, look.clearcoat_roughness, a, b);
    over.sent = ofSplitSum(over.f0, over.f90, a, b);
    lobes.coat_chance = lobes.coat * greatest(over.sent.r, 0.25F);
}

/// Rays go by what is sent each way of even light, but to matt surfaces and mirrors at least now
/// and then: what they show may be far brighter than the rest.
inline Lanes chanceOfMirrors(const LobeLanes& lobes) {
    const Lanes mirrored = greatest(luminance(lobes.base.sent) - lobes.even, 0.0F);
    const Lanes scattered = luminance(lobes.matt * complement(lobes.base.sent));
    const Lanes share = mirrored / greatest(mirrored + scattered + lobes.even, 1e-6F);
    const LaneMask is_matt = scattered > 0.01F;
    const Lanes chance = select(is_matt, least(greatest(share, 0.2F), 0.9F), share);
    return select(lobes.mirrors & (mirrored > 0.0F), chance, 0.0F);
}

/// @param looks  null where no surface of the packet has one
inline void startLobes(const RenderSetup& setup, const RayPacket& packet,
                       const SurfaceLanes& surfaces, const LookLanes* looks, LobeLanes& lobes) {
    lobes.normal = surfaces.normal;
    lobes.matt = surfaces.albedo;
    lobes.has_mirrors = looks && any(looks->mirrors);
    lobes.has_coat = false;
    if (!lobes.has_mirrors)
        return;
    lobes.mirrors = looks->mirrors;
    lobes.observer = ofUnitLength(packet.direction() * Lanes(-1.0F));
    startMirrors(setup, surfaces, *looks, lobes);
    startCoat(setup, *looks, lobes);
    lobes.mirror_chance = chanceOfMirrors(lobes) * (Lanes(1.0F) - lobes.coat_chance);
}

/// What facets send from one direction, and how densely they are asked for it. The mirrors hide
/// each other as in E. Heitz, "Understanding the Masking-Shadowing Function in Microfacet-Based
/// BRDFs", JCGT 2014.
/// @param facing  cosine between normal and the direction
inline LaneColors facetsSend(const FacetLanes& facets, const LaneVectors& observer,
                             const LaneVectors& toward, const Lanes& facing, const Lanes& alpha,
                             Lanes& density) {
    const LaneVectors half = ofUnitLength(along(observer, toward, 1.0F));
    const Lanes square = alpha * alpha;
    const Lanes cosine = clamped(dot(facets.normal, half));
    const Lanes width = cosine * cosine * (square - 1.0F) + 1.0F;
    const Lanes amount = square / (width * width * pi);
    const auto hidden = [&](const Lanes& c) {
        return squareRoot(square + (Lanes(1.0F) - square) * c * c);
    };
    const Lanes hidden_out = hidden(facets.facing);
    const Lanes visible =
        Lanes(0.5F) / (facing * hidden_out + facets.facing * hidden(facing) + 1e-6F);
    density = amount * 0.5F / (facets.facing + hidden_out);
    return mirroredPart(facets, dot(observer, half)) * (amount * visible * facing);
}

/// A direction in which facets mirror: J. Dupuy and A. Benyoub, "Sampling Visible GGX Normals with
/// Spherical Caps", Computer Graphics Forum 42(8), 2023.
/// @param half  takes the mirror's normal
inline LaneVectors mirroredBy(const FacetLanes& facets, const LaneVectors& observer,
                              const DiscLanes& disc, LaneVectors& half) {
    const LaneFrame& around = facets.around;
    const LaneVectors seen = ofUnitLength({dot(observer, around.a) * facets.alpha,
                                           dot(observer, around.b) * facets.alpha,
                                           greatest(dot(observer, facets.normal), 0.001F)});
    const Lanes z = (Lanes(1.0F) - disc.square) * (seen.z + 1.0F) - seen.z;
    const Lanes across = squareRoot(greatest(Lanes(1.0F) - z * z, 0.0F));
    const Lanes turn = across / greatest(squareRoot(disc.square), 1e-9F);
    const LaneVectors small =
        ofUnitLength({(disc.x * turn + seen.x) * facets.alpha,
                      (disc.y * turn + seen.y) * facets.alpha, greatest(z + seen.z, 1e-6F)});
    const LaneVectors rough =
        along(along(facets.normal * small.z, around.a, small.x), around.b, small.y);
    half = select(facets.perfect, facets.normal, rough);
    return along(observer * Lanes(-1.0F), half, dot(observer, half) * 2.0F);
}

/// What the coat leaves of the light that comes from one direction; the same both ways.
inline Lanes underCoat(const RenderSetup& setup, const LobeLanes& lobes, const LookLanes& looks,
                       const Lanes& facing) {
    Lanes a;
    Lanes b;
    readSplitSum(setup.frame, greatest(facing, 0.001F), looks.numbers.clearcoat_roughness, a, b);
    return Lanes(1.0F) - lobes.coat * greatest(lobes.over.sent.r, a * coat_f0 + b);
}

/// The mirrors' part of `sentFrom`.
/// @param least_alpha  lights that are no points are mirrored so softly at least
inline void addMirrored(const RenderSetup& setup, const LobeLanes& lobes, const LookLanes& looks,
                        const LaneVectors& toward, const Lanes& facing, float least_alpha,
                        SentLanes& sent) {
    Lanes a;
    Lanes b;
    readSplitSum(setup.frame, greatest(facing, 0.001F), lobes.roughness, a, b);
    const Lanes lost = Lanes(1.0F) - a - b;
    const LaneColors part = lobes.further * lost;
    const Lanes even = facing * (1.0F / pi);
    const LaneColors entering = complement(ofSplitSum(lobes.f0_of_matt, lobes.f90_of_matt, a, b) +
                                           lobes.further_of_matt * lost);
    sent.matt = sent.matt * select(lobes.mirrors, lobes.let_in * entering, {1.0F, 1.0F, 1.0F});
    Lanes density;
    const LaneColors mirrored = facetsSend(lobes.base, lobes.observer, toward, facing,
                                           greatest(lobes.base.alpha, least_alpha), density);
    const LaneMask shown =
        lobes.mirrors & (least_alpha > 0.0F ? facing > 0.0F : ~lobes.base.perfect);
    const LaneColors none{0.0F, 0.0F, 0.0F};
    sent.gloss =
        select(shown, mirrored, none) + select(lobes.mirrors, part * (even * lobes.lost), none);
    const Lanes matt_chance =
        Lanes(1.0F) - lobes.mirror_chance - (lobes.has_coat ? lobes.coat_chance : Lanes(0.0F));
    sent.density = even * matt_chance + select(shown, density * lobes.mirror_chance, 0.0F);
    if (!lobes.has_coat)
        return;
    const Lanes below = underCoat(setup, lobes, looks, facing);
    sent.matt = sent.matt * below;
    sent.gloss = sent.gloss * below;
    const Lanes coat_facing = clamped(dot(lobes.over.normal, toward));
    const LaneColors coated = facetsSend(lobes.over, lobes.observer, toward, coat_facing,
                                         greatest(lobes.over.alpha, least_alpha), density);
    const LaneMask shine = least_alpha > 0.0F ? facing > 0.0F : ~lobes.over.perfect;
    sent.gloss = sent.gloss + select(shine, coated * lobes.coat, none);
    sent.density = sent.density + select(shine, density * lobes.coat_chance, 0.0F);
}

/// What surfaces send to the observer of light from one direction of unit length; nothing from
/// below them.
inline SentLanes sentFrom(const RenderSetup& setup, const LobeLanes& lobes, const LookLanes* looks,
                          const LaneVectors& toward, float least_alpha = 0.0F) {
    const Lanes facing = clamped(dot(lobes.normal, toward));
    SentLanes sent;
    sent.density = facing * (1.0F / pi);
    sent.matt = lobes.matt * sent.density;
    sent.gloss = {0.0F, 0.0F, 0.0F};
    if (lobes.has_mirrors)
        addMirrored(setup, lobes, *looks, toward, facing, least_alpha, sent);
    return sent;
}

/// A direction that a surface asks for light.
struct NextRay {
    LaneVectors direction; ///< unit vector
    LaneColors matt;       ///< of the light from there what is sent to the observer, scattered
    LaneColors gloss;      ///< and mirrored
    Lanes density;         ///< 0 where it is the only one possible
};

/// Lets directions that point below the very triangle to the other side of it.
inline LaneVectors aboveFace(const LaneVectors& direction, const LaneVectors& face) {
    const Lanes below = least(dot(direction, face), 0.0F);
    return along(direction, face, below * -2.0F);
}

inline void takeMirrored(const RenderSetup& setup, const LobeLanes& lobes, const LookLanes& looks,
                         const Lanes& choice, const DiscLanes& disc, NextRay& next) {
    LaneMask by_coat = noLanes();
    const Lanes coat_chance = lobes.has_coat ? lobes.coat_chance : Lanes(0.0F);
    const LaneMask by_mirrors =
        ~(choice < coat_chance) & (choice < coat_chance + lobes.mirror_chance);
    LaneVectors half;
    next.direction =
        select(by_mirrors, mirroredBy(lobes.base, lobes.observer, disc, half), next.direction);
    if (lobes.has_coat) {
        by_coat = choice < coat_chance;
        next.direction =
            select(by_coat, mirroredBy(lobes.over, lobes.observer, disc, half), next.direction);
    }
    const SentLanes sent = sentFrom(setup, lobes, &looks, next.direction);
    const Lanes scale =
        select(sent.density > 1e-9F, Lanes(1.0F) / greatest(sent.density, 1e-9F), 0.0F);
    next.matt = sent.matt * scale;
    next.gloss = sent.gloss * scale;
    next.density = sent.density;
    const auto takeOnly = [&](const LaneMask& lanes, const FacetLanes& facets, const Lanes& part,
                              const Lanes& chance) {
        const LaneColors only =
            mirroredPart(facets, facets.facing) * (part / greatest(chance, 1e-6F));
        next.gloss = select(lanes, only, next.gloss);
        next.matt = select(lanes, {0.0F, 0.0F, 0.0F}, next.matt);
        next.density = select(lanes, Lanes(0.0F), next.density);
    };
    const LaneMask perfect = by_mirrors & lobes.base.perfect;
    if (any(perfect))
        takeOnly(perfect, lobes.base,
                 lobes.has_coat ? underCoat(setup, lobes, looks, lobes.base.facing) : Lanes(1.0F),
                 lobes.mirror_chance);
    if (lobes.has_coat)
        takeOnly(by_coat & lobes.over.perfect, lobes.over, lobes.coat, coat_chance);
}

/// Chooses where to look for the light that surfaces send on.
/// @param choice  of what they do, from 0 to 1
inline NextRay nextRay(const RenderSetup& setup, const LobeLanes& lobes, const LookLanes* looks,
                       const Lanes& choice, const LanePlaces& place) {
    NextRay next;
    const DiscLanes disc = onDisc(place);
    next.direction = aroundNormals(lobes.normal, disc);
    next.matt = lobes.matt;
    next.gloss = {0.0F, 0.0F, 0.0F};
    if (lobes.has_mirrors)
        takeMirrored(setup, lobes, *looks, choice, disc, next);
    else
        next.density = clamped(dot(lobes.normal, next.direction)) * (1.0F / pi);
    return next;
}

} // namespace
} // namespace quarn
