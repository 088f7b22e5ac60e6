#pragma once

#include "ground/Result.h"

#include <filesystem>
#include <string>
#include <vector>

namespace quarn {

/// The texts of a viewer page in English and in each language that has a table, as JSON: language
/// to key to text. A text that a language lacks is left out.
/// @param folders  of the host's string tables; the first that has a table of a language counts
std::string pageTextsJson(const std::vector<std::filesystem::path>& folders);

} // namespace quarn
