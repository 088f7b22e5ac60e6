#pragma once

#include "engine/scene/LightSettings.h"
#include "kelmar/KM_BoundingBox.h"
#include "kelmar/KM_Light.h"

#include <span>

namespace quarn {

/// What is larger, along its longest side, is no product any more but a building.
inline constexpr double LARGEST_PRODUCT_M = 5.0;

/// What lies around a scene: what its settings say, and where they leave it open the sky for
/// buildings and the studio for products. A scene is a building when a sun shines in it, that is a
/// directional light of the world, at whatever height it stands; or when it is larger than
/// LARGEST_PRODUCT_M. It also has the sky when there are no surfaces in it.
///
/// @param lights  those that are on
/// @param box     of all surfaces, shown or hidden, so that the choice holds throughout a film
/// @return studio, sky or picture; picture only with a picture that isPicture
Surroundings surroundingsOf(const LightSettings& settings, std::span<const KM_Light> lights,
                            const KM_BoundingBox& box);

/// True for a picture that has as many numbers as its size says, and at least one pixel.
bool isPicture(const EnvironmentPicture& picture);

} // namespace quarn
