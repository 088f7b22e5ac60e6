#pragma once

#include "engine/display/LampModel.h"
#include "engine/images/ColorSpace.h"

#include <span>
#include <vector>

namespace quarn {

class PictureLight;

/// A light that shines everywhere from the same direction.
struct DirectionalLight {
    float toward[3] = {0.0F, 0.0F, 1.0F}; ///< unit vector to the light, world coordinates
    LinearColor color;                    ///< scene light on a white surface that faces it
    float shadow = 0.0F;                  ///< part of it that an occluder takes away, 0 to 1
};

/// Light from all sides that changes linearly with the direction in which a surface faces:
/// channel c on a surface with unit normal n gets base[c] + slope[c] . n. Where that is too plain,
/// square[c] times (x y, y z, 3 z^2 - 1, x z, x^2 - y^2) of the normal is added: R. Ramamoorthi and
/// P. Hanrahan, "An Efficient Representation for Irradiance Environment Maps", SIGGRAPH 2001.
struct AmbientLight {
    float base[3] = {0.0F, 0.0F, 0.0F};
    float slope[3][3] = {};
    bool has_square = false;
    float square[3][5] = {};
};

/// The sky's colours in scene light.
struct Sky {
    LinearColor horizon; ///< sideways of the sun
    LinearColor side;    ///< added to the horizon below the sun and taken away opposite
    LinearColor zenith;
    LinearColor nadir; ///< straight down, where no ground is seen
    LinearColor glow;  ///< added around the sun
    LinearColor disc;  ///< added on the sun's disc
    float toward_sun[3] = {0.0F, 0.0F, 1.0F};
};

/// A soft rectangle of light, far away: surfaces are lit by it and mirror it.
struct SoftBox {
    float toward[3] = {0.0F, 0.0F, 1.0F}; ///< unit vector to its middle, world coordinates
    float half_width_deg = 30.0F;         ///< level
    float half_height_deg = 30.0F;
    float border = 0.2F; ///< over which it fades, as a part of what is one unit away
    LinearColor color;   ///< scene light
};

/// All the light of one picture.
struct Lighting {
    AmbientLight ambient;
    std::vector<DirectionalLight> fixed; ///< cast no shadows
    std::vector<DirectionalLight> suns;  ///< cast shadows as far as their `shadow` says
    Sky sky;
    std::vector<SoftBox> boxes;
    std::vector<Lamp> lamps;
    const PictureLight* picture = nullptr; ///< instead of sky and boxes; `ambient` follows from it
    float picture_scale = 1.0F;            ///< from its numbers to scene light
    /// All of this is multiplied by it already; what surfaces give off is not.
    float exposure = 1.0F;
};

/// The camera frame's unit vectors in world coordinates.
struct CameraFrame {
    const float* x;
    const float* y;
    const float* z; ///< toward the observer
};

/// A neutral studio light that goes with the camera: a soft key light from the upper left, a weak
/// fill from the right, more light from above than from below. No surface is overexposed.
Lighting studioLighting(const CameraFrame& camera);

/// Light of sky and document. The directional lights are suns: the first one's height decides
/// between day, dusk and night, and one below the horizon shines on nothing. At night a dim blue
/// light keeps the model readable. Without a directional light a bright, even sky and a head light
/// make the picture.
/// @param lights         the lights that are on; lamps add nothing
/// @param casts_shadows  whether the suns are shadowed
Lighting skyLighting(std::span<const KM_Light> lights, bool casts_shadows,
                     const CameraFrame& camera);

/// The suns of a document: its directional lights, dark ones too.
std::vector<DirectionalLight> documentSuns(std::span<const KM_Light> lights, bool casts_shadows,
                                           const CameraFrame& camera);

} // namespace quarn
