#pragma once

#include "ground/AtomicFile.h"
#include "ground/ProcessIdentity.h"
#include "ground/Result.h"
#include "host/recording/FrameSet.h"

#include <cstdint>
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

    friend bool operator==(const RecordingSettings&, const RecordingSettings&) = default;
};

/// Pictures by their extension.
using PicturesByExtension = std::map<std::string, FrameSet>;

/// What the file NAME.recording beside the pictures of an animation holds: who records or recorded
/// them, and which files are therefore the recording's own. docs/recording-file.md describes it.
struct RecordingFile {
    std::string animation; ///< the name
    bool is_running = false;
    ProcessIdentity writer;
    /// While it runs: seconds since 1970 in UTC until which the writer counts as alive.
    std::int64_t lease_until_s = 0;
    RecordingSettings settings;
    FrameSet written;            ///< by this recording
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

/// Whether another process records now, as far as can be told: its lease lives, and it has not
/// ended on this machine.
/// @param now_s  seconds since 1970 in UTC
bool isRecordedElsewhere(const RecordingFile& recording, std::int64_t now_s);

} // namespace quarn
