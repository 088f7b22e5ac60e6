#pragma once

#include "ground/AtomicFile.h"
#include "ground/ProcessIdentity.h"
#include "ground/Result.h"
#include "host/recording/FrameSet.h"
#include "host/recording/RecordingFingerprint.h"

#include <filesystem>
#include <map>
#include <optional>
#include <string>
#include <string_view>

namespace quarn {

/// What is recorded, and how.
struct RecordingSettings {
    std::string kind; ///< "turntable", "path", "flythrough", "one_day_sun" or "seasonal_sun"
    int frames = 0;
    int width_px = 0;
    int height_px = 0;
    std::string mode;      ///< English name of the display mode or the render method
    std::string extension; ///< of the pictures, without a point
    int jpeg_quality = 0;  ///< 1 to 100; 0: not known, or no JPEG pictures

    friend bool operator==(const RecordingSettings&, const RecordingSettings&) = default;
};

/// Pictures by their extension.
using PicturesByExtension = std::map<std::string, FrameSet>;

/// What the file NAME.recording beside the pictures of an animation holds: what is or was recorded,
/// and which files are therefore the recording's own. docs/recording-file.md describes it.
struct RecordingFile {
    std::string animation;          ///< the name
    std::filesystem::path document; ///< absolute path of the document's file; empty: it has none
    bool is_running = false;        ///< it has not come to its end
    bool is_shared = false;         ///< other programs may record frames of it too
    ProcessIdentity writer;         ///< who began it
    RecordingSettings settings;
    /// Without an instruction set where no frame was made yet; empty in files of earlier versions.
    RecordingFingerprint fingerprint;
    FrameSet written;            ///< by this recording, once it has ended
    bool owns_page = false;      ///< the page is this recording's, or that of an earlier one
    PicturesByExtension earlier; ///< written by earlier recordings of this name

    friend bool operator==(const RecordingFile&, const RecordingFile&) = default;
};

/// Reads such a file.
/// @return nothing where there is none; an error, in one sentence, where the file is something else
///         or of a later version of the program
Result<std::optional<RecordingFile>> readRecordingFile(const std::filesystem::path& file);

/// Writes such a file; it appears whole or not at all.
Result<void> writeRecordingFile(const std::filesystem::path& file, const RecordingFile& recording,
                                Protection protection = Protection::respected);

/// What such a file holds as bytes.
std::string recordingFileText(const RecordingFile& recording);
/// Reads that back.
/// @param file  for the message
/// @return errors as of readRecordingFile
Result<RecordingFile> parseRecordingFile(std::string_view text, const std::filesystem::path& file);

} // namespace quarn
