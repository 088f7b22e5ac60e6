#pragma once

#include "kelmar/KM_wString.h"

#include <filesystem>
#include <string_view>

namespace quarn {

/// The path that a text names; file names are UTF-8 whatever the locale says.
std::filesystem::path pathFromText(std::wstring_view text);

/// The text of a path; bytes that are not UTF-8 are shown as U+FFFD.
KM_wString textFromPath(const std::filesystem::path& path);

} // namespace quarn
