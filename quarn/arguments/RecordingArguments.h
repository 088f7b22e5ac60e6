#pragma once

#include "quarn/arguments/OptionAdder.h"
#include "quarn/runs/Recording.h"
#include "quarn/scripts/RecordingRequest.h"

#include <optional>

namespace quarn::program {

/// What is to be recorded, and whether it is recorded or only shown.
template <class Request> struct Asked {
    Request request{};
    ScriptUse use;
};

/// What every command takes that runs the host.
void addCommonOptions(CLI::App& command, CommonOptions& common);
void addShowScript(CLI::App& command, bool& is_only_shown);
/// What every command takes that may record.
void addOverwrite(CLI::App& command, CommonOptions& common);

/// Whether a page for others is made of the frames.
void addViewer(CLI::App& command, ViewerRequest& viewer);

/// What goes in and out, which a person looks for first.
void addModelAndFolder(const OptionAdder& add, RecordingRequest& request);

/// How many pictures a camera takes on its way.
void addFrames(const OptionAdder& add, RecordingRequest& request, const std::string& description);
/// @param rest  of the description: what is taken where nobody chooses
void addLens(const OptionAdder& add, std::optional<double>& lens_mm, const std::string& rest);

/// The rest of what every recording takes.
void addRecordingOptions(CLI::App& command, RecordingRequest& request, ScriptUse& use,
                         CaptureSubject subject = CaptureSubject::moving_camera);

/// Fills in what was left open, once all words are read.
/// @return what does not go together, or nothing
std::optional<std::string> settle(RecordingRequest& request);

} // namespace quarn::program
