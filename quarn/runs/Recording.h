#pragma once

#include "quarn/scripts/RecordingScript.h"
#include "quarn/session/HostSession.h"
#include "quarn/words/Outcome.h"

#include <optional>

namespace quarn::program {

/// What becomes of a script that was composed.
struct ScriptUse {
    bool is_only_shown = false;
    CommonOptions common;
};

/// Composes the script of a recording, and runs it or, where it is only to be shown, returns it.
///
/// @param lines  the commands of this kind of animation
Outcome recordOrShow(const RecordingRequest& request, const AnimationLines& lines,
                     const ScriptUse& use);

/// Looks whether a film can be made of a recording, before what takes time is begun.
/// @param film    with no file: none is wanted
/// @param folder  of the recording
/// @return why it cannot, or nothing
std::optional<Outcome> refuseFilm(const FilmRequest& film, const std::filesystem::path& folder,
                                  bool overwrites);

} // namespace quarn::program
