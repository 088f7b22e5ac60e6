#pragma once

#include <string>
#include <vector>

namespace quarn {

/// The endings of the model files that readModelFile reads, without a dot and in lower case: the
/// usual ones first, the others by the alphabet.
std::vector<std::string> modelFileExtensions();

} // namespace quarn
