#pragma once

#include <filesystem>
#include <string>

namespace quarn {

/// Checks the faces of a text file whose reading library takes what comes: indices of more than 32
/// bits, negative ones and words become other vertices there, and a line that is too short takes
/// from the next one. Knows OFF; of other files nothing is said.
///
/// @return what is wrong, with the number of its line, as a part of a sentence; empty when nothing
///   is, or where the file is no text
std::string whyBadIndices(const std::filesystem::path& path);

} // namespace quarn
