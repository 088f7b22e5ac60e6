#pragma once

#include "host/session/StudiedSite.h"

#include <QSize>

#include <filesystem>
#include <string>

namespace quarn::desktop {

/// What a form about the sun is filled with at first.
struct SunOffer {
    StudiedSite site;
    std::string name; ///< UTF-8: of the model
    std::filesystem::path folder;
    QSize view_size; ///< of the active view's pictures, in pixels
};

} // namespace quarn::desktop
