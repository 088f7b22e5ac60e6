#pragma once

#include "ground/Result.h"
#include "import/ReadingBudget.h"
#include "import/ReadingWatch.h"
#include "import/assembly/SourceScene.h"
#include "import/files/ModelFolder.h"

#include <cstdint>
#include <filesystem>
#include <span>

namespace quarn {

/// What the reader of a format works with. All that it refers to outlives the reading.
struct ModelReading {
    const std::filesystem::path& path;
    std::span<const std::uint8_t> bytes; ///< of the file
    const ModelFolder& folder;           ///< the only place of other files that the model names
    UpAxis up;
    double tolerance; ///< see ReadingOptions
    ReadingBudget& budget;
    ReadingWatch& watch;
};

} // namespace quarn
