#pragma once

#include <string>
#include <vector>

namespace quarn {

/// The endings of the files that the reading library knows, without a dot and in lower case, each
/// once or more.
std::vector<std::string> libraryExtensions();

} // namespace quarn
