#pragma once

#include "host/recording/RecordingFile.h"

#include <functional>

namespace quarn {

/// How a recording deals with what its folder holds of earlier ones.
enum class RecordingBegin {
    anew,    ///< replaces all that is its own, and nobody else records it meanwhile
    if_same, ///< goes on with one that has the same fingerprint; anew where there is none
    resume,  ///< the same, but is refused where the folder holds another one of this name
};

/// What the next recording is to make.
struct RecordingChoice {
    RecordingBegin begin = RecordingBegin::anew;
    /// Only these frames, and neither the page nor the list of frames; nothing: all frames, and
    /// both once all of them are there.
    std::optional<FrameSet> frames;
};

/// All that is known of a recording before it begins.
struct RecordingPlan {
    std::string animation; ///< its name, UTF-8
    RecordingSettings settings;
    std::filesystem::path document; ///< absolute path of its file; empty: it has none
    double metres_per_unit = 0.0;
    std::string place; ///< of a sun study, UTF-8; empty: none is known
    /// What its pictures are made of now.
    std::function<RecordingFingerprint()> fingerprint;
    RecordingChoice choice;
    bool overwrites = false; ///< files of others may be replaced
    std::string refusal;     ///< why it must not begin, in a sentence; empty: it may
};

/// What NAME.recording tells of a recording that begins anew.
RecordingFile recordingFileOf(const RecordingPlan& plan, const RecordingFingerprint& fingerprint);

/// Why a recording is not the one that a folder holds.
/// @return nothing where it is; else what is different and what to do, in sentences of the user's
///         language
std::optional<std::string> whyAnotherRecording(const RecordingFile& there, const RecordingFile& own,
                                               const std::filesystem::path& folder);

} // namespace quarn
