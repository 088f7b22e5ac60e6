#pragma once

#include "kelmar/KM_Viewport.h"
#include "kelmar/KM_wString.h"
#include "sdk/qncore/QnDisplayAttributes.h"
#include "sdk/qncore/QnDisplayPipeline.h"
#include "sdk/qncore/QnExport.h"

class CQuarnDoc;
namespace quarn {
class ViewState;
}

/// The camera and the name of a view. Owned by its view. All calls belong on the main thread.
///
/// After its view was closed the object stays until the session ends, and every call on it is a
/// breach of the interface: it is reported, changes nothing and returns false, an empty name, the
/// camera of a new KM_Viewport or that one's target. So does a call on another thread.
class QNCORE_API CQuarnViewport {
public:
    const wchar_t* Name() const; ///< valid until the view is renamed

    /// The camera and projection.
    const KM_Viewport& VP() const;
    /// Replaces camera and projection whole.
    /// @param update_target     take the target point over too (otherwise it stays)
    /// @param update_frame_size keep the frame's aspect, so that nothing is stretched
    /// @return false, and nothing changes, when the camera is not valid
    bool SetVP(const KM_Viewport& viewport, bool update_target, bool update_frame_size);

    /// The point that the camera looks at and turns about.
    KM_3dPoint Target() const;

    /// Moves the camera, with a level horizon: up stays the world's Z unless the camera looks along
    /// it; then the old up turned with the direction is kept.
    /// @param update_target   store the target point
    /// @param update_up       keep the horizon level (false keeps the old up where it can be kept)
    /// @return false, and nothing changes, for points that are not valid or coincide
    bool SetTargetAndCameraLocation(const KM_3dPoint& target, const KM_3dPoint& camera,
                                    bool update_target, bool update_up);

    /// Chooses the display mode; it is seen at the next redraw.
    /// @return false, and nothing changes, for an id that is no display mode's
    bool SetDisplayMode(const KM_UUID& display_mode_id);

    /// What draws the viewport; never null. After the view was closed its calls are breaches too.
    CQuarnDisplayPipeline* DisplayPipeline();

private:
    friend class quarn::ViewState;
    explicit CQuarnViewport(quarn::ViewState& view) : m_view(&view) {}
    quarn::ViewState* m_view;
};

/// A named window onto a document. Owned by the document. All calls belong on the main thread.
///
/// A view never closes while a command runs. A plug-in that keeps a pointer longer keeps an object
/// that stays until the session ends, but once the view was closed every call on it is a breach of
/// the interface: it is reported, as in "CQuarnView::Redraw: the view was closed", and does
/// nothing. The viewports and the document that it returns then are the ones it had;
/// DisplayAttributes is null. So it is for a call on another thread. Look a view up by its name
/// instead of keeping it.
class QNCORE_API CQuarnView {
public:
    virtual ~CQuarnView();
    CQuarnView(const CQuarnView&) = delete;
    CQuarnView& operator=(const CQuarnView&) = delete;

    /// What a redraw does.
    enum redraw_flag : unsigned int {
        draw_scene = 0,        ///< draws the scene again
        show_frame_buffer = 4, ///< shows the frame buffer as it is
    };

    /// The viewport that has the view's name.
    CQuarnViewport& MainViewport();
    const CQuarnViewport& MainViewport() const;
    /// The viewport that is worked in.
    virtual CQuarnViewport& ActiveViewport();
    /// The same as MainViewport().
    CQuarnViewport& Viewport() { return MainViewport(); }

    CQuarnDoc& Document() const;

    /// The display mode that the view is drawn in; null when it has none. Valid until the mode
    /// changes.
    const CDisplayPipelineAttributes* DisplayAttributes() const;

    /// Draws or shows the view, see redraw_flag. Once a person asked to stop, nothing is drawn.
    void Redraw(unsigned int flags = draw_scene);

private:
    friend class quarn::ViewState;
    explicit CQuarnView(quarn::ViewState& view) : m_view(&view) {}
    quarn::ViewState* m_view;
};
