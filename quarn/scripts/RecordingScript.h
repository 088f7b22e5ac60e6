#pragma once

#include "quarn/scripts/RecordingRequest.h"

#include <optional>
#include <string>
#include <vector>

namespace quarn::program {

/// The host commands of one kind of animation: one line each, in UTF-8.
struct AnimationLines {
    std::vector<std::string> preparing;  ///< what is needed before: the camera, curves
    std::vector<std::string> setting_up; ///< the commands that set the animation up
    std::vector<std::string> notes{};    ///< what a person is told before it is recorded
};

/// The host commands of a whole recording.
struct RecordingScript {
    std::vector<std::string> notes;  ///< for a person
    std::string reading;             ///< of the model file
    std::vector<std::string> set_up; ///< from the model to the animation
    /// Keeps the document before the recording begins, so that one which is stopped keeps it too.
    std::optional<std::string> saving;
    /// What is to be made of the recording while it runs.
    std::vector<std::string> following;
    std::string beginning; ///< how the recording begins in a folder that holds one already
    std::string recording; ///< this, `saving` and `following` need the folder to be there
    std::vector<std::string> sharing; ///< what is made of the frames afterwards
};

RecordingScript composeRecording(const RecordingRequest& request, const AnimationLines& lines);

/// The answers to what every set-up command asks at its end: format, capture mode, view and name.
std::string sharedAnswers(const RecordingRequest& request);

/// How a recording begins in a folder that holds frames of one.
enum class RecordingStartKind {
    anew,    ///< makes all frames
    if_same, ///< keeps frames of the same recording; those of another one are made anew
    resume,  ///< keeps them; where another one is there, it is told and nothing is written
};

/// The host command that chooses how the next recording begins.
/// @param frames  that it is to make, "0-9,20-30:2"; empty: all
std::string beginningLine(RecordingStartKind start, const std::string& frames = "");

/// The host command that records into the folder.
std::string recordingLine(const std::filesystem::path& folder);

/// The script as a person reads it, or runs it again with `quarn run`.
std::string scriptText(const RecordingScript& script);

} // namespace quarn::program
