#pragma once

#include "engine/scene/Material.h"

namespace quarn {

// What formats say that know diffuse colour, highlight and exponent alone, as the material of today
// says it.

/// The roughness of a highlight by its exponent. Its width is sqrt(2 / (exponent + 2)) (Walter,
/// Marschner, Li, Torrance, "Microfacet Models for Refraction through Rough Surfaces", 2007,
/// section 5.2), and the roughness the root of that (Burley, "Physically-Based Shading at Disney",
/// 2012, section 5.4).
/// @param exponent  from 0; less counts as 0
float roughnessOfExponent(float exponent);

/// Makes a surface mirror as much as the colour of its highlight says: 0.08 of it when seen
/// straight on (Burley 2012, section 5.5), so that half of white is what an index of refraction of
/// 1.5 mirrors. Black mirrors nothing.
void setHighlight(Material& material, const LinearRgb& color);

/// Light stated as colours are, in sRGB. What is brighter than 1 is as many times the colour of its
/// hue.
LinearRgb lightOfColor(const LinearRgb& stated);

} // namespace quarn
