#pragma once

#include "host/recording/FramesManifest.h"
#include "host/recording/JsonNumbers.h"

namespace quarn {

// A frame as the list of frames and the journals hold it. What reads throws where something is not
// as it should be: std::out_of_range, or what the library throws.

using ManifestJson = nlohmann::ordered_json;

ManifestJson jsonOf(const ManifestFrame& frame);
ManifestFrame manifestFrameOf(const ManifestJson& object);

/// The name of a file in the folder, and nothing that leads out of it.
std::string fileNameOf(const std::string& name);

} // namespace quarn
