#pragma once

#include "host/document/RangeWarnings.h"
#include "kelmar/KM_Viewport.h"
#include "kelmar/KM_wString.h"
#include "sdk/qncore/QnView.h"

#include <cstdint>
#include <memory>

namespace quarn {

class Document;
struct Image;

/// A view: a named camera onto a document, its frame buffer and its display mode, with the three
/// faces that plug-ins see of it. Owned by its document, also when it was closed: a plug-in may
/// keep a pointer to a face.
class ViewState {
public:
    static constexpr int default_width_px = 1280;
    static constexpr int default_height_px = 720;
    static constexpr int largest_side_px = 16384;
    static bool isPictureSide(int side_px) { return side_px >= 1 && side_px <= largest_side_px; }

    ViewState(Document& document, const KM_wString& name, const KM_Viewport& viewport);
    ~ViewState();
    ViewState(const ViewState&) = delete;
    ViewState& operator=(const ViewState&) = delete;

    /// The state behind a view that plug-ins see.
    static ViewState& of(const CQuarnView& view);

    Document& document() const { return m_document; }
    const KM_wString& name() const { return m_name; }
    CQuarnView& face() { return m_view_face; }

    /// Called by the document when it closes the view: its picture is freed, and from now on every
    /// call on its faces is a breach.
    void close();
    bool isOpen() const { return m_is_open; }

    // ---- Camera

    const KM_Viewport& viewport() const { return m_viewport; }
    /// The camera as the view's pictures have it: with the frame's size and aspect, also where a
    /// plug-in set another one.
    KM_Viewport frameCamera() const;
    /// As CQuarnViewport::SetVP.
    bool setViewport(const KM_Viewport& viewport, bool update_target, bool update_frame_size);
    /// As CQuarnViewport::SetTargetAndCameraLocation.
    bool setTargetAndCamera(const KM_3dPoint& target, const KM_3dPoint& camera, bool update_target,
                            bool update_up);

    // ---- Display mode

    /// The mode that the view is drawn in; null when it has none.
    const CDisplayPipelineAttributes* displayMode() const { return m_mode; }
    /// @return false, with nothing changed, for an id that is no display mode's
    bool setDisplayMode(const KM_UUID& id);
    /// The copy of the mode that is drawn with; null when the view has no mode.
    CDisplayPipelineAttributes* currentAttributes();

    // ---- Picture

    int frameWidth() const { return m_frame_width; }
    int frameHeight() const { return m_frame_height; }
    /// Sets the size of the frame buffer; the camera gets its aspect, so that nothing is stretched.
    /// What the view showed is gone until the next redraw.
    /// @return false, with nothing changed, unless both sides are from 1 to largest_side_px
    bool setFrameSize(int width_px, int height_px);

    /// Draws the scene once.
    /// @return false, with the picture unchanged, for a side outside 1 to largest_side_px, once the
    ///         person has asked the program to stop, and, with a message, when memory lacks
    bool draw(Image& picture, int width_px, int height_px,
              const CDisplayPipelineAttributes& attributes);
    /// Tells a person when the picture of this view that was drawn or rendered just now shows the
    /// background alone.
    void tellCameraOutOfRange();
    /// @return false for a picture of another size than the frame buffer's
    bool copyToFrameBuffer(const Image& picture);
    /// As CQuarnView::Redraw.
    void redraw(unsigned int flags);

    /// The picture that the view shows; of no size as long as nothing was drawn.
    const Image& frameBuffer() const { return *m_frame_buffer; }
    /// How often the scene was drawn for this view, into its frame buffer or elsewhere.
    std::uint64_t drawCount() const { return m_draw_count; }
    /// How often a picture was shown.
    std::uint64_t showCount() const { return m_show_count; }

private:
    bool render(Image& picture, int width_px, int height_px,
                const CDisplayPipelineAttributes& attributes);

    Document& m_document;
    KM_wString m_name;
    KM_Viewport m_viewport;
    const CDisplayPipelineAttributes* m_mode = nullptr;
    CDisplayPipelineAttributes m_current_attributes;
    int m_frame_width = default_width_px;
    int m_frame_height = default_height_px;
    std::unique_ptr<Image> m_frame_buffer;
    CameraRangeWarning m_camera_warning;
    std::uint64_t m_draw_count = 0;
    std::uint64_t m_show_count = 0;
    bool m_is_open = true;
    CQuarnView m_view_face;
    CQuarnViewport m_viewport_face;
    CQuarnDisplayPipeline m_pipeline_face;

    friend class ::CQuarnView;
    friend class ::CQuarnViewport;
};

} // namespace quarn
