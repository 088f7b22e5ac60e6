#pragma once

#include "ground/Result.h"

#include <filesystem>

namespace quarn {

/// The file that a path means: where its symbolic links lead, whether that is there or not. Where
/// anybody may make files, as in the folder for temporary ones, a link is followed only if this
/// user or the folder's owner made it.
/// @return an error, part of a sentence: the links lead in a circle, or must not be followed
Result<std::filesystem::path> fileBehindLinks(const std::filesystem::path& path);

} // namespace quarn
