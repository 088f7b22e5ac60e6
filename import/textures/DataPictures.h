#pragma once

#include "engine/scene/Material.h"

#include <memory>

namespace quarn {

/// Why a picture of heights is left out, a part of a sentence.
inline constexpr const char* HEIGHTS_NOT_DRAWN =
    "it holds heights, which are not drawn; a map of normals is";

/// A white, opaque picture of this one's size and wrap modes.
std::shared_ptr<Texture> whiteLike(const Texture& texture);

/// A picture of roughness and one of metalness, each the mean of its colours, as one: green is
/// roughness, blue is metalness. It has the size and the wrap modes of the roughness, where there
/// is one.
/// @param roughness  null: 1 everywhere
/// @param metalness  null: 1 everywhere; not both are null
std::shared_ptr<Texture> metalRoughPicture(const Texture* roughness, const Texture* metalness);

/// Roughness, as green, by the glossiness in a picture's alpha.
/// @param glossiness  0 to 1: what alpha is multiplied by
std::shared_ptr<Texture> roughnessOfGlossiness(const Texture& glossy, float glossiness);

/// True for normals; false for heights, which are grey. Both go by one name in many files.
bool holdsNormals(const Texture& picture);

} // namespace quarn
