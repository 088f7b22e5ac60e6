#pragma once

#include "ground/Result.h"
#include "host/recording/RecordedFolder.h"

#include <cstddef>
#include <vector>

namespace quarn {

/// The order in which pictures come: every 8th, every 4th between them, every 2nd, the rest; of
/// long recordings the first pass takes at most 64. The page's script asks for them in this order.
std::vector<int> coarseToFine(int frames);

/// Whether browsers show pictures of this extension.
bool isShownByBrowsers(const std::string& extension);

/// Whether a picture's file is there from its head to its end, as far as the two tell.
bool isWholePicture(const std::filesystem::path& file);

/// A frame as a page carries it: a JPEG file, as it was recorded where it is one.
/// @return an error, one sentence, where it cannot be read
Result<std::vector<std::byte>> framesJpeg(const std::filesystem::path& file);

} // namespace quarn
