#pragma once

#include <filesystem>
#include <optional>

namespace quarn {

/// The folder for the user's documents: what was configured, else the documents folder of the
/// desktop's `user-dirs.dirs` (XDG user directories), else `Documents` in the home folder.
///
/// @param configured  empty when nothing was configured
/// @return nothing when no such folder is known, or the one that the environment names is not there
std::optional<std::filesystem::path> documentsFolder(const std::filesystem::path& configured);

} // namespace quarn
