#pragma once

#include "ground/Result.h"
#include "host/document/file/DocumentContent.h"
#include "host/document/file/SharedPlaces.h"

#include <cstdint>
#include <span>
#include <vector>

namespace quarn {

/// The bytes of a document file with this content, for the version that the content names.
/// docs/document-format.md describes them.
/// @return an error that names what cannot be written (a curve or a camera that is not valid), or
///         that memory lacks
Result<std::vector<std::uint8_t>> encodeDocument(const DocumentContent& content);

/// The same, but what objects share stands elsewhere: its chunks are left out, and objects name it
/// by these places.
/// @param places  of all that objects of the content share
Result<std::vector<std::uint8_t>> encodeDocument(const DocumentContent& content,
                                                 const SharedPlaces& places);

/// Reads a document file's bytes. Everything is checked before it is believed: lengths and counts
/// against the bytes that are there, indices against what they name, numbers against what the
/// things can hold.
/// @return the whole content; or an error, a part of a sentence, that tells what is wrong: no
///         document file, of a newer version, cut off, damaged
/// @param shared  what stands elsewhere of what objects share; what the bytes hold comes behind it
Result<DocumentContent> decodeDocument(std::span<const std::uint8_t> bytes,
                                       SharedContent shared = {});

} // namespace quarn
