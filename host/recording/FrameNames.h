#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace quarn {

/// How the pictures of a recording are named: the name of the animation, the number of the frame
/// with at least three digits, a point and the extension. All in UTF-8.
struct FrameNames {
    std::string animation;
    std::string extension; ///< without a point

    /// @param frame  from 0
    std::string fileName(int frame) const;
    /// The frame that a file of this name is a picture of; nothing for every other file.
    std::optional<int> frameOf(std::string_view file_name) const;
};

/// The names of what stands beside the pictures.
std::string pageName(const std::string& animation);
std::string recordingFileName(const std::string& animation);

} // namespace quarn
