#pragma once

#include <string>
#include <string_view>

struct aiScene;

namespace quarn {

/// The sentence about what the reading library loses of a text without a word; empty where that is
/// nothing.
/// @param format  of the file, its extension in small letters
std::string libraryLossText(std::string_view format, std::string_view text, const aiScene& scene);

} // namespace quarn
