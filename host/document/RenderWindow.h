#pragma once

#include "engine/images/Image.h"
#include "host/document/RenderSettings.h"

namespace quarn {

/// The render window of a document: how pictures are rendered, and the one rendered last.
struct RenderWindow {
    RenderSettings settings;
    Image picture; ///< of no size while the window is closed

    bool isOpen() const { return picture.width > 0; }
    /// Frees the picture.
    void close() { picture = Image(); }
};

} // namespace quarn
