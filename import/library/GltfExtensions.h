#pragma once

#include "import/library/GltfDescription.h"

namespace quarn {

/// The extension that changes how vertices are stored, that a file cannot do without, and that the
/// reading library takes no notice of: it would read other vertices. Empty when there is none.
std::string unreadableExtension(const GltfDescription& description);

/// Sentences about other extensions that a file says it cannot do without, and that are not known.
std::vector<std::string> tellUnknownExtensions(const GltfDescription& description);

} // namespace quarn
