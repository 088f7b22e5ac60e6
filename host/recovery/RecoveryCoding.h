#pragma once

#include "ground/Result.h"
#include "host/document/file/SharedPlaces.h"
#include "host/recovery/RecoveryState.h"

#include <cstddef>
#include <cstdint>
#include <span>
#include <vector>

namespace quarn {

// A recovery file is its beginning and then chunks, in the form of those of a document file. What
// objects share comes in chunks of its own, once; a state is a whole document whose objects name
// what stands before. Only ever appended to, so the last whole state is what counts, whatever was
// cut off behind it. docs/recovery.md describes the bytes.

/// The bytes that every recovery file begins with.
std::vector<std::uint8_t> recoveryBeginning();

// Each of these makes what stands in the file for one thing. An error is part of a sentence.

Result<std::vector<std::uint8_t>> textureChunk(const Texture& texture);
/// The chunk of a material and, where it is more than its base colour, the one that says so.
/// @param places  of its textures
Result<std::vector<std::uint8_t>> materialChunks(const Material& material,
                                                 const SharedPlaces& places);
Result<std::vector<std::uint8_t>> meshChunk(const KM_Mesh& mesh);
/// @param png  a PNG file
Result<std::vector<std::uint8_t>> pictureChunk(std::span<const std::byte> png);
/// @param places  of all that objects of the state share
Result<std::vector<std::uint8_t>> stateChunk(const RecoveryState& state,
                                             const SharedPlaces& places);

/// What a recovery file gives back.
struct RecoveredState {
    std::chrono::system_clock::time_point kept_at;
    DocumentContent content;
    bool lost_its_end = false; ///< a further state was begun and is not whole
};

/// Reads a recovery file's bytes, which are checked as those of a document file are.
/// @return its last whole state; or an error, part of a sentence: it is no recovery file, of a
///         newer version, damaged before a state is whole
Result<RecoveredState> decodeRecovery(std::span<const std::uint8_t> bytes);

} // namespace quarn
