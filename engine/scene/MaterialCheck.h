#pragma once

#include "engine/scene/Material.h"

#include <string>

namespace quarn {

/// The brightest light that a surface gives off, in each channel.
inline constexpr float MOST_EMISSION = 1e6F;
/// Beyond it a surface mirrors all but two thousandths of the light.
inline constexpr float MOST_INDEX_OF_REFRACTION = 1000.0F;

/// Makes a material one that can be drawn, whatever it came from. Numbers beyond their limits are
/// moved to them, and what is no number gets its default; so do an index of refraction below 1 and
/// a distance of attenuation that is not above 0. Light that is too bright keeps its hue. A texture
/// with another number of bytes than its size says is left out, and a texture's place that is no
/// place becomes that of the mesh's coordinates. Doing it again changes nothing.
/// @return what was changed, for a person: "metalness, index of refraction"; empty: nothing
std::string makeDrawable(Material& material);

} // namespace quarn
