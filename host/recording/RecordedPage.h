#pragma once

#include "host/recording/RecordingFile.h"

#include <filesystem>
#include <optional>
#include <string>

namespace quarn {

/// The pictures that the page of a recording plays. A folder without a NAME.recording may have been
/// recorded into before there were such files: then its page tells which pictures are that
/// recording's.
/// @param animation  the recording's name, which is the page's title
/// @return nothing where the file is no page of that recording
std::optional<PicturesByExtension> picturesOfPage(const std::filesystem::path& page,
                                                  const std::string& animation);

} // namespace quarn
