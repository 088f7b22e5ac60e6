#pragma once

#include "ground/Result.h"
#include "host/document/Document.h"
#include "sdk/qncore/QnZoetrixDynamicAccess.h"

namespace quarn {

/// In pixels.
struct PictureSize {
    int width_px;
    int height_px;
};

/// The animation of a document. The record is not copied: its point lists may be long.
struct StoredAnimation {
    IQnZoetrixDynamicAccess* access = nullptr;
    const KM_3dmAnimationProperties* record = nullptr; ///< valid while the command runs
    ViewState* view = nullptr;                         ///< that it is made for

    /// Whether a render method makes its pictures, which have a size of their own then.
    bool isRendered() const { return record->RenderFull() || record->RenderPreview(); }
    /// Of the pictures that it is recorded in.
    PictureSize pictureSize() const;
};

/// @return an error, in one sentence that says what to do, where no plug-in keeps an animation, the
///         document has none that can be shown, or the view that it was made for is gone
Result<StoredAnimation> storedAnimation(Document& document);

} // namespace quarn
