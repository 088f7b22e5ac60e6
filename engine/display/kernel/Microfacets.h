#pragma once

#include "engine/display/SplitSum.h"
#include "engine/display/kernel/SurroundingLight.h"

namespace quarn {
namespace {

/// What a clear coat mirrors seen straight on: it is of index 1.5.
constexpr float coat_f0 = 0.04F;

/// Surfaces that mirror: rough ones are of many small mirrors. See SplitSum for the sources.
struct MirrorLanes {
    LaneColors f0; ///< what is mirrored seen straight on; 0: the lane mirrors nothing
    Lanes f90;     ///< seen along the face
    Lanes roughness;
    LaneVectors normal;
    Lanes facing;          ///< cosine between normal and observer
    LaneVectors observer;  ///< unit vector
    LaneVectors direction; ///< where a perfect mirror would look; of unit length
    Lanes straight;        ///< see readSplitSum
    Lanes along_face;
    LaneColors first;   ///< of even light what is sent after one mirror
    LaneColors further; ///< and after several
    Lanes gain;         ///< of highlights, for what several mirrors send
};

/// a f0 + b f90 is `first`.
inline void readSplitSum(const FrameSetup& frame, const Lanes& facing, const Lanes& roughness,
                         Lanes& a, Lanes& b) {
    constexpr int side = SplitSum::side;
    const auto* const from = reinterpret_cast<const std::uint32_t*>(frame.split_sum);
    const Lanes x = facing * static_cast<float>(side - 1);
    const Lanes y = roughness * static_cast<float>(side - 1);
    const LaneInts column = limited(wholePart(x), side - 2);
    const LaneInts row = limited(wholePart(y), side - 2);
    const Lanes right = x - floatsOf(column);
    const Lanes below = y - floatsOf(row);
    const LaneInts at = row * LaneInts(side) + column;
    const auto entry = [&](int first) {
        const auto number = [&](int offset) {
            return floatsWith(gathered(from + first + offset, at));
        };
        const Lanes upper_left = number(0);
        const Lanes lower_left = number(side);
        const Lanes upper = upper_left + right * (number(1) - upper_left);
        const Lanes lower = lower_left + right * (number(side + 1) - lower_left);
        return upper + below * (lower - upper);
    };
    a = entry(0);
    b = entry(side * side);
}

/// What mirrors that lie like these send of even light, if they mirror f0 and f90 of it.
inline void findSent(const MirrorLanes& mirrors, const LaneColors& f0, const Lanes& f90,
                     LaneColors& first, LaneColors& further) {
    const Lanes lost = Lanes(1.0F) - (mirrors.straight + mirrors.along_face);
    const auto find = [&](const Lanes& facing, Lanes& once, Lanes& more) {
        once = facing * mirrors.straight + f90 * mirrors.along_face;
        const Lanes mean = facing + (f90 - facing) * (1.0F / 21.0F);
        more = once * mean * lost / (Lanes(1.0F) - lost * mean);
    };
    find(f0.r, first.r, further.r);
    find(f0.g, first.g, further.g);
    find(f0.b, first.b, further.b);
}

/// Completes `mirrors`, of which f0, f90 and roughness are known. Light that goes from mirror to
/// mirror: C. Fdez-Aguera, "A Multiple-Scattering Microfacet Model for Real-Time Image-Based
/// Lighting", JCGT 2019.
inline void findMirrors(const FrameSetup& frame, const RayPacket& packet, const LaneVectors& face,
                        const LaneVectors& normal, MirrorLanes& mirrors) {
    mirrors.normal = normal;
    mirrors.observer = ofUnitLength(packet.direction() * Lanes(-1.0F));
    const Lanes cosine = dot(normal, mirrors.observer);
    mirrors.facing = least(greatest(cosine, 0.001F), 1.0F);
    const Lanes twice = cosine + cosine;
    const LaneVectors mirrored{twice * normal.x - mirrors.observer.x,
                               twice * normal.y - mirrors.observer.y,
                               twice * normal.z - mirrors.observer.z};
    // Smooth and mapped normals would let some mirrors look into the surface itself.
    const Lanes lift = greatest(Lanes(0.01F) - dot(mirrored, face), 0.0F);
    mirrors.direction = ofUnitLength(along(mirrored, face, lift));
    readSplitSum(frame, mirrors.facing, mirrors.roughness, mirrors.straight, mirrors.along_face);
    mirrors.gain = Lanes(1.0F) / (mirrors.straight + mirrors.along_face) - 1.0F;
    findSent(mirrors, mirrors.f0, mirrors.f90, mirrors.first, mirrors.further);
}

/// A sun is no point, and its image on a mirror neither.
constexpr float least_spread = 0.015F;

/// The highlight of a light of color 1, beside what a white surface that faces it sends.
inline LaneColors highlight(const MirrorLanes& mirrors, const LaneVectors& toward) {
    const Lanes facing = greatest(dot(mirrors.normal, toward), 0.0F);
    const LaneVectors half =
        ofUnitLength({mirrors.observer.x + toward.x, mirrors.observer.y + toward.y,
                      mirrors.observer.z + toward.z});
    const Lanes spread = greatest(mirrors.roughness * mirrors.roughness, least_spread);
    const Lanes square = spread * spread;
    const Lanes cosine = clamped(dot(mirrors.normal, half));
    const Lanes width = cosine * cosine * (square - 1.0F) + 1.0F;
    const auto hidden = [&](const Lanes& c) {
        return squareRoot(square + (Lanes(1.0F) - square) * c * c);
    };
    const Lanes visible =
        Lanes(0.5F) / (facing * hidden(mirrors.facing) + mirrors.facing * hidden(facing) + 1e-6F);
    const Lanes amount = facing * visible * square / (width * width);
    const Lanes turned = Lanes(1.0F) - clamped(dot(mirrors.observer, half));
    const Lanes along_face = power4(turned) * turned; // Schlick 1994
    const auto channel = [&](const Lanes& f0) {
        const Lanes mirrored = f0 + along_face * (mirrors.f90 - f0);
        return amount * mirrored * (f0 * mirrors.gain + 1.0F);
    };
    return {channel(mirrors.f0.r), channel(mirrors.f0.g), channel(mirrors.f0.b)};
}

} // namespace
} // namespace quarn
