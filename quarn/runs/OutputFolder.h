#pragma once

#include <filesystem>
#include <optional>
#include <string>

namespace quarn::program {

/// Makes the folder where it is not there, and makes sure that files can be written into it.
/// @return nothing when they can, else why not, naming the folder
std::optional<std::string> whyFolderCannotBeUsed(const std::filesystem::path& folder);

/// @param overwrites  whether --overwrite was given
/// @return why a file cannot be written: it is there already; nothing where it may
std::optional<std::string> whyNotReplaced(const std::filesystem::path& file, bool overwrites);

} // namespace quarn::program
