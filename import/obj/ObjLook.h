#pragma once

#include "engine/scene/Material.h"
#include "import/obj/MaterialFile.h"
#include "import/textures/TexturePlace.h"
#include "import/textures/TextureStore.h"

#include <memory>

namespace quarn {

/// A material of an OBJ file, and what a mesh must know of it.
struct ObjMaterial {
    std::shared_ptr<const Material> material; ///< null: none
    TexturePlace texture_place;
};

/// What a material of a material file looks like, with its pictures. Numbers may be out of range.
/// @param textures  tells of pictures that were left out
ObjMaterial lookOf(const FileMaterial& source, TextureStore& textures);

} // namespace quarn
