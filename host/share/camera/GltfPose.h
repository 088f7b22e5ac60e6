#pragma once

#include "host/share/camera/CameraTrack.h"

#include <array>

namespace quarn {

// glTF counts in metres, with Y up and Z toward the viewer; its cameras and directional lights look
// along their own -Z. A document without units is taken to be in metres.

/// A turn as a unit quaternion: x, y, z, w.
using GltfTurn = std::array<double, 4>;

/// Where a node is and how it is turned.
struct GltfPose {
    std::array<double, 3> place{};
    GltfTurn turn{};
};

/// What a glTF camera sees, in metres and radians.
struct GltfLens {
    bool is_parallel = false;
    double half_width = 0.0;  ///< of a parallel camera
    double half_height = 0.0; ///< the same
    double aspect = 1.0;      ///< of a perspective one: width over height
    double vertical_angle = 0.0;
    double near_distance = 0.0;
    double far_distance = 0.0;
    /// How far a parallel camera stands back from where the document has it, so that all that its
    /// pictures show lies in front of it. What it sees stays the same.
    double setback = 0.0;
    /// Whether a perspective camera looks askew, which no glTF camera can: it is straightened.
    bool is_straightened = false;
};

GltfLens gltfLens(const CameraTrack& track);

GltfPose cameraPose(const CameraTrack& track, const GltfLens& lens, const CameraKey& key);
/// The turns of a light that shines from the sun, one a frame.
std::vector<GltfTurn> lightTurns(const std::vector<SunKey>& suns);

/// Of the two quaternions that mean this turn the one nearer to the turn before, so that whoever
/// goes from one to the other takes the short way.
GltfTurn continued(const GltfTurn& turn, const GltfTurn& before);

} // namespace quarn
