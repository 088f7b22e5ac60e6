#pragma once

#include "host/document/file/DocumentContent.h"
#include "host/document/file/SharedPlaces.h"

namespace quarn {

// What a material is beyond its base colour: the payload of a chunk that stands directly behind
// that of the material. A program that does not know the chunk passes over it.

/// Whether a material is more than the chunk of the material itself tells.
bool hasSurface(const Material& material);

/// Whether what objects of a content wear is more than files of a version hold.
bool losesSurfaces(const DocumentContent& content);

/// @param material  written as makeDrawable leaves it
/// @param places    of all textures that it has
bool writeSurface(KM_BinaryArchive& archive, const Material& material, const SharedPlaces& places);
/// Gives what is read, as makeDrawable leaves it, to the material that was read last; there must be
/// one.
/// @return false, with the archive failed, when it cannot be part of a document
bool readSurface(KM_BinaryArchive& archive, SharedContent& shared);

} // namespace quarn
