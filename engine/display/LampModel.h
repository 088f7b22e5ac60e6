#pragma once

#include "engine/images/ColorSpace.h"
#include "kelmar/KM_BoundingBox.h"
#include "kelmar/KM_Light.h"

#include <span>
#include <vector>

namespace quarn {

struct CameraFrame;

/// A light that shines from a place, in scene light.
struct Lamp {
    KM_3dPoint place;  ///< in the world
    LinearColor color; ///< on a white surface that faces it from one unit away
    KM_3dVector axis;  ///< where a spot shines to; of unit length
    bool is_spot = false;
    float shadow = 0.0F; ///< part of it that an occluder takes away, 0 to 1
};

/// Spots shine fully up to the first angle from their axis, and nothing beyond the second.
/// Documents keep no opening of spots.
inline constexpr float SPOT_INNER_DEG = 30.0F;
inline constexpr float SPOT_OUTER_DEG = 45.0F;

/// The lamps among lights: those that shine from a point or as a spot and are on.
///
/// The intensities of a document are relations, not powers. Lamps of intensity 1 are therefore made
/// so bright that, all together, they send scene light 1 to a white surface that faces them, at the
/// median of 27 places spread evenly over the box, as if nothing stood between and spots shone to
/// all sides. So a lamp may hang right beside a wall, and scenes of every size get enough light.
/// @param box     of all surfaces, shown or hidden; without one there are no lamps
/// @param camera  for lights that go with it
/// @param eye     where it is
std::vector<Lamp> lampsOf(std::span<const KM_Light> lights, const KM_BoundingBox& box,
                          const CameraFrame& camera, const KM_3dPoint& eye);

/// The brightness of the lamps' light at the median of those places.
float lightOfLamps(std::span<const Lamp> lamps, const KM_BoundingBox& box);

} // namespace quarn
