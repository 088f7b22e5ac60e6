#pragma once

#include <filesystem>
#include <string>

namespace quarn::program {

/// How a person wants a viewer page.
struct ViewerRequest {
    bool is_wanted = false;
    bool is_one_file = false; ///< with the pictures inside
    std::string title;        ///< UTF-8; empty: the animation's name
};

/// The host command that writes the page of recorded frames.
/// @param recorded  their folder, or the file NAME.frames.json in it
std::string viewerLine(const std::filesystem::path& recorded, const ViewerRequest& request);

} // namespace quarn::program
