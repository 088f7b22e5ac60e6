#pragma once

#include "engine/scene/Material.h"

struct aiMaterial;

namespace quarn {

/// Sets what the numbers of a material of the reading library say of metalness, roughness,
/// highlight and light. Where it states no roughness, the exponent of a highlight that is there
/// stands for it: the library fills in exponents where files have no highlight. Numbers may be out
/// of range.
void readSurfaceNumbers(const aiMaterial& source, Material& material);

} // namespace quarn
