#pragma once

#include "ground/Result.h"
#include "import/ModelReading.h"

#include <string>
#include <string_view>
#include <vector>

namespace quarn {

using ModelReader = Result<SourceScene> (*)(const ModelReading& reading);

/// The reader of the files with this ending (lower case, no dot): the one of their format, else the
/// library's, which says what it does not know.
ModelReader readerOf(std::string_view extension);

/// Whether these files are read by code of our own from their first byte to their last.
bool hasOwnReader(std::string_view extension);

/// The endings of the model files that readModelFile reads, without a dot and in lower case: the
/// usual ones first, the others by the alphabet.
std::vector<std::string> modelFileExtensions();

} // namespace quarn
