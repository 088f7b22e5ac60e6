#pragma once

#include "engine/scene/EnvironmentPicture.h"
#include "kelmar/KM_Color.h"

#include <memory>
#include <optional>

namespace quarn {

/// What lies around a scene and lights it, and what smooth surfaces mirror.
enum class Surroundings : int {
    automatic, ///< by what the scene is
    studio,    ///< soft lights of a neutral studio
    sky,       ///< the sky with the sun
    picture,   ///< a picture of one's own
};

/// What a scene stands before.
enum class BackgroundKind : int {
    automatic,   ///< by what lies around it
    color,       ///< one colour
    transparent, ///< nothing: pictures have an opacity of their own there
};

/// How a scene is lit beside the lights in it, and what it stands before and on.
struct LightSettings {
    Surroundings surroundings = Surroundings::automatic;
    /// For Surroundings::picture; null is taken for automatic.
    std::shared_ptr<const EnvironmentPicture> picture;
    /// In stops: each doubles the light. None: what suits the scene.
    std::optional<double> exposure;
    BackgroundKind background = BackgroundKind::automatic;
    KM_Color background_color{255, 255, 255, 255}; ///< for BackgroundKind::color
    /// The first of the scene's lights is the sun: it shines under the sky alone.
    bool first_light_is_sun = false;
    bool has_ground = true;       ///< else there is none, and no shadow on it
    double metres_per_unit = 1.0; ///< of the scene's coordinates

    friend bool operator==(const LightSettings&, const LightSettings&) = default;
};

} // namespace quarn
