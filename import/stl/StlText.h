#pragma once

#include "import/ModelReading.h"

namespace quarn {

/// Reads a text: each solid becomes an object of its name.
Result<SourceScene> readTextStl(const ModelReading& reading);

} // namespace quarn
