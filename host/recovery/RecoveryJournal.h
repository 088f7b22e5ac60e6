#pragma once

#include "ground/ProcessIdentity.h"
#include "ground/Result.h"
#include "host/document/file/SharedPlaces.h"
#include "host/recovery/AppendedFile.h"
#include "host/recovery/RecoveryState.h"

#include <atomic>
#include <cstddef>
#include <cstdint>
#include <filesystem>
#include <memory>
#include <unordered_map>
#include <vector>

namespace quarn {

/// Writes the recovery file of a document, state behind state. Meshes, materials and textures that
/// stand in it are not written again; where they have grown to be more that nobody needs than what
/// is needed, a new file with the last state takes the place of the old one.
///
/// Used by one thread at a time, but for stop.
class RecoveryJournal {
public:
    /// @param state_folder  where marks are, and recovery files that cannot stand beside their
    ///                      documents
    RecoveryJournal(std::filesystem::path state_folder, ProcessIdentity writer);

    /// Adds a state, and waits until it is on the disk. The first one makes the file and its mark;
    /// one of a document with another file begins anew.
    /// @return an error, one sentence, when it could not be written; what was kept before stays
    Result<void> write(const RecoveryState& state);
    /// Removes the file and its mark.
    void remove();
    /// Lets a write that is going on end soon, and every one until remove, with an error.
    void stop() { m_is_stopped = true; }

private:
    Result<void> writeSomewhere(const RecoveryState& state);
    Result<void> begin(const RecoveryState& state);
    Result<void> beginElsewhere(const RecoveryState& state);
    Result<void> beginAt(const std::filesystem::path& file, const RecoveryState& state);
    Result<void> rewrite(const RecoveryState& state);
    Result<void> writeWhole(AppendedFile& file, const RecoveryState& state);
    Result<void> append(const RecoveryState& state);
    Result<void> appendParts(AppendedFile& file, const RecoveryState& state, bool has_picture);
    Result<void> appendShared(AppendedFile& file, const DocumentContent& content);
    Result<void> appendTo(AppendedFile& file, const Result<std::vector<std::uint8_t>>& chunk) const;
    Result<void> appendThing(AppendedFile& file, const void* thing,
                             const Result<std::vector<std::uint8_t>>& chunk);
    void forgetGone();
    bool takePicture(const Image& picture);
    std::uint64_t sizeNeeded(const RecoveryState& state) const;

    const std::filesystem::path m_folder;
    const ProcessIdentity m_writer;
    std::atomic<bool> m_is_stopped = false;

    std::filesystem::path m_mark;     ///< empty while there is no file
    std::filesystem::path m_path;     ///< of the file
    std::filesystem::path m_document; ///< whose states they are
    AppendedFile m_file;              ///< closed where it cannot be appended to any more
    SharedPlaces m_places;
    struct Shared {
        std::weak_ptr<const void> thing;
        std::uint64_t size = 0; ///< bytes in the file
    };
    std::unordered_map<const void*, Shared> m_shared; ///< what stands in the file
    std::vector<std::byte> m_picture;                 ///< the last one, a PNG file
    std::uint64_t m_state_size = 0;                   ///< of the last one
};

} // namespace quarn
