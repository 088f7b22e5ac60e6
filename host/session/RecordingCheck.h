#pragma once

#include "sdk/qncore/QnExport.h"

#include <filesystem>
#include <optional>
#include <string>

namespace quarn {

/// A recording that a program is about to have made.
struct RecordingTarget {
    std::filesystem::path folder; ///< may not be there yet
    std::string name;             ///< of the animation, UTF-8
    std::string extension;        ///< of the pictures, without a point
    int frames = 0;
    bool overwrites = false; ///< as SessionOptions has it
    bool may_go_on = false;  ///< with a recording that other programs make frames of now
};

/// Looks at the folder as RecordAnimation will once more, before what takes time is begun.
/// @return why nothing may be recorded there, in a sentence of the user's language that says what
/// to
///         do; nothing when it may
QNCORE_API std::optional<std::string> whyRecordingIsRefused(const RecordingTarget& target);

/// Reads which frames of an animation are meant, as NextRecording does: "0-9,20-30:2", "none".
/// @return why they cannot be read, in a sentence of the user's language; nothing when they can
QNCORE_API std::optional<std::string> whyFramesAreRefused(const std::string& ranges);

/// Whether a folder that nobody asked for may be recorded into: it is not there, nothing is in it,
/// or recordings have been made into it before.
QNCORE_API bool isFolderForRecordings(const std::filesystem::path& folder);

/// Looks whether an animation of so many frames fits into the memory that is free.
/// @return what it would take and what is free, in a sentence of the user's language; nothing when
///         it fits
QNCORE_API std::optional<std::string> whyTooManyFrames(int frames);

} // namespace quarn
