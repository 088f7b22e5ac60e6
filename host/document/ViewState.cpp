#include "host/document/ViewState.h"

#include "engine/images/Image.h"
#include "host/document/CameraMove.h"
#include "host/document/DisplayModeList.h"
#include "host/document/Document.h"
#include "host/document/DocumentDrawing.h"
#include "host/front_end/FrontEnd.h"

namespace quarn {

namespace {

bool hasScreenPort(const KM_Viewport& viewport, int width_px, int height_px) {
    int width = 0;
    int height = 0;
    viewport.GetScreenPort(&width, &height);
    return width == width_px && height == height_px;
}

} // namespace

ViewState::ViewState(Document& document, const KM_wString& name, const KM_Viewport& viewport)
    : m_document(document), m_name(name), m_frame_buffer(std::make_unique<Image>()),
      m_view_face(*this), m_viewport_face(*this), m_pipeline_face(*this) {
    setViewport(viewport, true, true);
}

ViewState::~ViewState() = default;

ViewState& ViewState::of(const CQuarnView& view) {
    return *view.m_view;
}

void ViewState::close() {
    m_is_open = false;
    *m_frame_buffer = Image();
}

bool ViewState::setViewport(const KM_Viewport& viewport, bool update_target,
                            bool update_frame_size) {
    if (!viewport.IsValidCamera())
        return false;
    const KM_3dPoint old_target = m_viewport.TargetPoint();
    m_viewport = viewport;
    if (!update_target)
        m_viewport.SetTargetPoint(old_target);
    // A size that is right already is left alone, so that a camera that was saved comes back
    // without the rounding of a division.
    if (update_frame_size && !hasScreenPort(m_viewport, m_frame_width, m_frame_height))
        m_viewport.SetScreenPort(m_frame_width, m_frame_height);
    return true;
}

KM_Viewport ViewState::frameCamera() const {
    KM_Viewport camera = m_viewport;
    if (!hasScreenPort(camera, m_frame_width, m_frame_height))
        camera.SetScreenPort(m_frame_width, m_frame_height);
    return camera;
}

bool ViewState::setTargetAndCamera(const KM_3dPoint& target, const KM_3dPoint& camera,
                                   bool update_target, bool update_up) {
    return quarn::setTargetAndCamera(m_viewport, target, camera, update_target, update_up);
}

bool ViewState::setDisplayMode(const KM_UUID& id) {
    const CDisplayPipelineAttributes* mode = DisplayModeList::instance().find(id);
    if (!mode)
        return false;
    m_mode = mode;
    m_current_attributes = *mode;
    return true;
}

CDisplayPipelineAttributes* ViewState::currentAttributes() {
    return m_mode ? &m_current_attributes : nullptr;
}

bool ViewState::setFrameSize(int width_px, int height_px) {
    if (!isPictureSide(width_px) || !isPictureSide(height_px))
        return false;
    m_frame_width = width_px;
    m_frame_height = height_px;
    *m_frame_buffer = Image();
    m_viewport.SetScreenPort(width_px, height_px);
    return true;
}

bool ViewState::draw(Image& picture, int width_px, int height_px,
                     const CDisplayPipelineAttributes& attributes) {
    if (!isPictureSide(width_px) || !isPictureSide(height_px))
        return false;
    if (m_document.frontEnd().isInterrupted())
        return false;
    return render(picture, width_px, height_px, attributes);
}

bool ViewState::render(Image& picture, int width_px, int height_px,
                       const CDisplayPipelineAttributes& attributes) {
    const auto drawn = m_document.drawing().draw(m_viewport, drawingAttributes(attributes),
                                                 width_px, height_px, picture);
    if (!drawn) {
        m_document.frontEnd().print(KM_wString::FromUtf8(drawn.message() + "\n").View());
        return false;
    }
    ++m_draw_count;
    tellCameraOutOfRange();
    return true;
}

void ViewState::tellCameraOutOfRange() {
    m_camera_warning.tell(m_document, m_document.drawing().showedScene());
}

bool ViewState::copyToFrameBuffer(const Image& picture) {
    if (picture.width != m_frame_width || picture.height != m_frame_height)
        return false;
    *m_frame_buffer = picture;
    return true;
}

void ViewState::redraw(unsigned int flags) {
    const bool shows_what_is_there = flags & CQuarnView::show_frame_buffer;
    if (!shows_what_is_there && m_document.frontEnd().isInterrupted())
        return;
    if (!shows_what_is_there && m_mode)
        render(*m_frame_buffer, m_frame_width, m_frame_height, m_current_attributes);
    ++m_show_count;
    if (m_frame_buffer->width > 0)
        m_document.frontEnd().viewShown(
            m_view_face, {m_frame_buffer->width, m_frame_buffer->height, m_frame_buffer->rgba});
}

} // namespace quarn
