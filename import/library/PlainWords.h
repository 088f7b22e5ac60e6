#pragma once

#include <string>
#include <string_view>

namespace quarn {

/// An error text of the reading library as a part of a sentence of ours, without its names for the
/// parts of its own scene where a person could not know them.
std::string inPlainWords(std::string_view error);

} // namespace quarn
