#pragma once

#include "sdk/qncore/QnExport.h"

#include <string>
#include <vector>

namespace quarn {

/// The endings of the model files that Open and Import read, without a dot and in lower case: the
/// usual ones first, the others by the alphabet.
QNCORE_API std::vector<std::string> modelFileExtensions();

/// The ending of document files, without a dot.
QNCORE_API std::string documentFileExtension();

} // namespace quarn
