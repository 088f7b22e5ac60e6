#include "engine/images/Image.h"
#include "host/border/Contract.h"
#include "host/document/Document.h"
#include "host/document/DocumentList.h"

using quarn::mayCallView;

namespace {

/// The camera of a view that is not there.
const KM_Viewport& noCamera() {
    static const KM_Viewport viewport;
    return viewport;
}

bool isWanted(const quarn::ViewState& view) {
    return view.document().list().wantsPictures();
}

/// Notes a view that a plug-in placed.
/// @return whether it did
bool placed(quarn::ViewState& view, bool is_done) {
    if (is_done)
        view.document().list().viewPlaced(view);
    return is_done;
}

} // namespace

// ---- CQuarnViewport

const wchar_t* CQuarnViewport::Name() const {
    return mayCallView(*m_view, "CQuarnViewport::Name") ? m_view->name().Array() : L"";
}

const KM_Viewport& CQuarnViewport::VP() const {
    return mayCallView(*m_view, "CQuarnViewport::VP") ? m_view->viewport() : noCamera();
}

bool CQuarnViewport::SetVP(const KM_Viewport& viewport, bool update_target,
                           bool update_frame_size) {
    return mayCallView(*m_view, "CQuarnViewport::SetVP") &&
           placed(*m_view, m_view->setViewport(viewport, update_target, update_frame_size));
}

KM_3dPoint CQuarnViewport::Target() const {
    const bool allowed = mayCallView(*m_view, "CQuarnViewport::Target");
    return allowed ? m_view->viewport().TargetPoint() : noCamera().TargetPoint();
}

bool CQuarnViewport::SetTargetAndCameraLocation(const KM_3dPoint& target, const KM_3dPoint& camera,
                                                bool update_target, bool update_up) {
    return mayCallView(*m_view, "CQuarnViewport::SetTargetAndCameraLocation") &&
           placed(*m_view, m_view->setTargetAndCamera(target, camera, update_target, update_up));
}

bool CQuarnViewport::SetDisplayMode(const KM_UUID& display_mode_id) {
    return mayCallView(*m_view, "CQuarnViewport::SetDisplayMode") &&
           placed(*m_view, m_view->setDisplayMode(display_mode_id));
}

CQuarnDisplayPipeline* CQuarnViewport::DisplayPipeline() {
    mayCallView(*m_view, "CQuarnViewport::DisplayPipeline");
    return &m_view->m_pipeline_face;
}

// ---- CQuarnView

CQuarnView::~CQuarnView() = default;

CQuarnViewport& CQuarnView::MainViewport() {
    mayCallView(*m_view, "CQuarnView::MainViewport");
    return m_view->m_viewport_face;
}

const CQuarnViewport& CQuarnView::MainViewport() const {
    mayCallView(*m_view, "CQuarnView::MainViewport");
    return m_view->m_viewport_face;
}

CQuarnViewport& CQuarnView::ActiveViewport() {
    mayCallView(*m_view, "CQuarnView::ActiveViewport");
    return m_view->m_viewport_face;
}

CQuarnDoc& CQuarnView::Document() const {
    mayCallView(*m_view, "CQuarnView::Document");
    return m_view->document().face();
}

const CDisplayPipelineAttributes* CQuarnView::DisplayAttributes() const {
    return mayCallView(*m_view, "CQuarnView::DisplayAttributes") ? m_view->displayMode() : nullptr;
}

void CQuarnView::Redraw(unsigned int flags) {
    if (mayCallView(*m_view, "CQuarnView::Redraw") && isWanted(*m_view))
        m_view->redraw(flags);
}

// ---- CQuarnDisplayPipeline

int CQuarnDisplayPipeline::FrameWidth() const {
    return mayCallView(*m_view, "CQuarnDisplayPipeline::FrameWidth") ? m_view->frameWidth() : 0;
}

int CQuarnDisplayPipeline::FrameHeight() const {
    return mayCallView(*m_view, "CQuarnDisplayPipeline::FrameHeight") ? m_view->frameHeight() : 0;
}

CDisplayPipelineAttributes* CQuarnDisplayPipeline::CurrentDisplayAttributes() {
    const bool allowed = mayCallView(*m_view, "CQuarnDisplayPipeline::CurrentDisplayAttributes");
    return allowed ? m_view->currentAttributes() : nullptr;
}

bool CQuarnDisplayPipeline::DrawToDib(CQuarnDib& dib, int width, int height,
                                      const CDisplayPipelineAttributes& attributes) {
    return mayCallView(*m_view, "CQuarnDisplayPipeline::DrawToDib") &&
           (!isWanted(*m_view) || m_view->draw(dib.Image(), width, height, attributes));
}

bool CQuarnDisplayPipeline::CopyToFrameBuffer(const CQuarnDib& dib) {
    return mayCallView(*m_view, "CQuarnDisplayPipeline::CopyToFrameBuffer") &&
           m_view->copyToFrameBuffer(dib.Image());
}
