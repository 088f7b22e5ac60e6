#include "host/display/Image.h"
#include "host/document/Document.h"

const wchar_t* CQuarnViewport::Name() const {
    return m_view->name().Array();
}

const KM_Viewport& CQuarnViewport::VP() const {
    return m_view->viewport();
}

bool CQuarnViewport::SetVP(const KM_Viewport& viewport, bool update_target,
                           bool update_frame_size) {
    return m_view->setViewport(viewport, update_target, update_frame_size);
}

KM_3dPoint CQuarnViewport::Target() const {
    return m_view->viewport().TargetPoint();
}

bool CQuarnViewport::SetTargetAndCameraLocation(const KM_3dPoint& target, const KM_3dPoint& camera,
                                                bool update_target, bool update_up) {
    return m_view->setTargetAndCamera(target, camera, update_target, update_up);
}

bool CQuarnViewport::SetDisplayMode(const KM_UUID& display_mode_id) {
    return m_view->setDisplayMode(display_mode_id);
}

CQuarnDisplayPipeline* CQuarnViewport::DisplayPipeline() {
    return &m_view->m_pipeline_face;
}

CQuarnView::~CQuarnView() = default;

CQuarnViewport& CQuarnView::MainViewport() {
    return m_view->m_viewport_face;
}

const CQuarnViewport& CQuarnView::MainViewport() const {
    return m_view->m_viewport_face;
}

CQuarnViewport& CQuarnView::ActiveViewport() {
    return MainViewport();
}

CQuarnDoc& CQuarnView::Document() const {
    return m_view->document().face();
}

const CDisplayPipelineAttributes* CQuarnView::DisplayAttributes() const {
    return m_view->displayMode();
}

void CQuarnView::Redraw(unsigned int flags) {
    m_view->redraw(flags);
}

int CQuarnDisplayPipeline::FrameWidth() const {
    return m_view->frameWidth();
}

int CQuarnDisplayPipeline::FrameHeight() const {
    return m_view->frameHeight();
}

CDisplayPipelineAttributes* CQuarnDisplayPipeline::CurrentDisplayAttributes() {
    return m_view->currentAttributes();
}

bool CQuarnDisplayPipeline::DrawToDib(CQuarnDib& dib, int width, int height,
                                      const CDisplayPipelineAttributes& attributes) {
    return m_view->draw(dib.Image(), width, height, attributes);
}

bool CQuarnDisplayPipeline::CopyToFrameBuffer(const CQuarnDib& dib) {
    return m_view->copyToFrameBuffer(dib.Image());
}
