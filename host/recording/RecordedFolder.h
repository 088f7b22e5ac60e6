#pragma once

#include "host/recording/FramesManifest.h"

namespace quarn {

/// The frames of a folder.
struct RecordedFolder {
    std::filesystem::path folder;
    FramesManifest manifest;
    bool has_manifest = false; ///< else the manifest tells what the names of the files tell
    /// What is wrong with the folder, in sentences of the user's language that say what it means:
    /// frames that are missing, that were changed since, a manifest that cannot be read.
    std::vector<std::string> warnings;
};

/// Looks through a folder that a recording was made into.
/// @param folder  or a file NAME.frames.json in it, where the folder holds several recordings
/// @return the frames that are there, of which there is at least one; an error, in one sentence,
///         where there is no folder, no recording in it, or more than one
Result<RecordedFolder> readRecordedFolder(const std::filesystem::path& folder);

} // namespace quarn
