#pragma once

#include "sdk/qncore/QnExport.h"

#include <filesystem>

namespace quarn {

/// The folder for what the user's programs of this family keep from one run to the next: `quarn` in
/// $XDG_STATE_HOME, else in ~/.local/state. It need not be there yet. Empty where the environment
/// names neither by a whole path.
QNCORE_API std::filesystem::path userStateFolder();

/// Makes the folder and those above it, where they are missing; one that is made is the user's
/// alone.
/// @return whether it is there
QNCORE_API bool makeStateFolder(const std::filesystem::path& folder);

} // namespace quarn
