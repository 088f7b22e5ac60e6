#pragma once

#include "ground/Result.h"

#include <filesystem>
#include <string>
#include <string_view>

namespace quarn {

/// The error "Cannot read 'x.obj': <why>. <what to do>" for a model file.
Error cannotReadModel(const std::filesystem::path& path, std::string_view why,
                      std::string_view advice);

/// The extension in lower case without its dot: "glb".
std::string modelFormat(const std::filesystem::path& path);

/// Looks at a model file before it is read: it is there, is a file, has bytes, not too many of
/// them, and can be opened.
Result<void> checkModelFile(const std::filesystem::path& path);

} // namespace quarn
