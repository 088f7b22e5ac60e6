#pragma once

#include "host/share/camera/CameraTrack.h"

#include <string>

namespace quarn {

// The camera of each frame in model units, with Z up, to the last digit. docs/camera-files.md
// describes both.

/// As JSON.
std::string trackJson(const CameraTrack& track);
/// As a table of values with commas between (RFC 4180), with a line of names first.
std::string trackCsv(const CameraTrack& track);

} // namespace quarn
