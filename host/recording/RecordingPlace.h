#pragma once

#include "ground/Result.h"
#include "host/recording/RecordingFile.h"

#include <chrono>
#include <filesystem>
#include <optional>
#include <string>

namespace quarn {

/// Where an animation is recorded to, and which files that takes.
struct RecordingPlace {
    std::filesystem::path folder;
    std::string animation; ///< its name, UTF-8; no path
    std::string extension; ///< of the pictures, without a point
    int frames = 0;

    std::filesystem::path recordingFile() const;
    std::filesystem::path page() const;
};

/// The files in a folder that recordings of one name have written there.
struct OwnFiles {
    bool owns_page = false;
    PicturesByExtension pictures;

    bool owns(const std::string& extension, int frame) const;
};

/// For how long a journal counts after it was renewed: long enough for the slowest drawing of a
/// scene, and for a disk far away.
constexpr std::chrono::seconds JOURNAL_LEASE{60};

/// The time of the disk that a folder is on, which the files on it are dated with.
std::filesystem::file_time_type timeOfDisk(const std::filesystem::path& folder);

/// Another program that records the animation into the folder now, as far as can be told; nothing
/// where there is none.
/// @param own_journal  of who asks; empty: none
std::optional<ProcessIdentity> whoRecords(const RecordingPlace& place,
                                          const std::filesystem::path& own_journal = {},
                                          std::chrono::seconds lease = JOURNAL_LEASE);
/// Says so, in a sentence of the user's language that says what to do.
Error isRecorded(const RecordingPlace& place, const ProcessIdentity& writer);

/// Looks whether an animation may be recorded there anew: no file is in its way that no recording
/// of this name has written. A folder that is not there yet is free.
/// @param overwrites  files of others may be replaced
/// @return what earlier recordings of this name have written there; or why not, in a sentence of
/// the
///         user's language that says what to do
Result<OwnFiles> checkRecordingPlace(const RecordingPlace& place, bool overwrites);

} // namespace quarn
