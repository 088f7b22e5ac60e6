#pragma once

#include <filesystem>

namespace quarn {

/// Lets this process open only the files of a model's folder and what the system's libraries need,
/// for good, and nothing for writing.
/// @return false where the kernel has no such rules
bool restrictFiles(const std::filesystem::path& model);

} // namespace quarn
