#pragma once

#include "engine/scene/Material.h"

struct aiMaterial;

namespace quarn {

/// Sets what the numbers of a material of the reading library say of metalness, roughness,
/// highlight and light. Where it states neither metalness nor roughness, a highlight that is there
/// stands for them. Numbers may be out of range afterwards.
void readSurfaceNumbers(const aiMaterial& source, Material& material);

} // namespace quarn
