#pragma once

#include "sdk/qncore/QnDib.h"
#include "sdk/qncore/QnDisplayAttributes.h"
#include "sdk/qncore/QnExport.h"

namespace quarn {
class ViewState;
}

/// Draws a viewport. Owned by its viewport. All calls belong on the main thread.
///
/// After its view was closed, or on another thread, every call is a breach of the interface: it is
/// reported, changes nothing and returns 0, null or false.
class QNCORE_API CQuarnDisplayPipeline {
public:
    int FrameWidth() const;  ///< pixels of the view's frame buffer
    int FrameHeight() const; ///< pixels of the view's frame buffer

    /// The attributes that the view is drawn with: a copy of its display mode's, which the caller
    /// may change, made anew when the viewport's display mode is set. Null when the viewport has no
    /// display mode. Valid until the view closes.
    CDisplayPipelineAttributes* CurrentDisplayAttributes();

    /// Draws the scene once into a picture.
    /// @param width, height  pixels, from 1 to 16384
    /// @return false, with the picture unchanged, for a size outside these limits, and once the
    ///         person has asked the program to stop
    bool DrawToDib(CQuarnDib& dib, int width, int height,
                   const CDisplayPipelineAttributes& attributes);

    /// Copies a picture into the view's frame buffer; it is seen at the next redraw with flag 4.
    /// @return false for a picture that has not the frame buffer's size
    bool CopyToFrameBuffer(const CQuarnDib& dib);

private:
    friend class quarn::ViewState;
    explicit CQuarnDisplayPipeline(quarn::ViewState& view) : m_view(&view) {}
    quarn::ViewState* m_view;
};
