#pragma once

#include "ground/Result.h"
#include "host/recording/RecordingFile.h"

#include <filesystem>
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

/// Looks whether an animation may be recorded there: nobody else records it into the folder now,
/// and no file is in its way that no recording of this name has written. A folder that is not there
/// yet is free.
/// @param overwrites  files of others may be replaced; a recording that runs may not be disturbed
/// @return what earlier recordings of this name have written there; or why not, in a sentence of
/// the
///         user's language that says what to do
Result<OwnFiles> checkRecordingPlace(const RecordingPlace& place, bool overwrites);

/// Seconds since 1970 in UTC.
std::int64_t unixSeconds();

} // namespace quarn
