#include "host/commands/CameraForm.h"

#include "host/commands/FormAsking.h"
#include "sdk/qncore/QnLocalize.h"

namespace quarn {

namespace {

double lensInPerspective(KM_Viewport viewport) {
    constexpr double usual_mm = 50.0;
    double lens_mm = 0.0;
    viewport.SetProjection(KM_perspective_view);
    return viewport.GetCamera35mmLensLength(&lens_mm) ? lens_mm : usual_mm;
}

} // namespace

CameraForm::CameraForm(const KM_Viewport& viewport)
    : CDialog(form_id, nullptr), m_present(viewport), m_present_target(cameraTarget(viewport)),
      m_present_lens_mm(lensInPerspective(viewport)), m_location(viewport.CameraLocation()),
      m_target(m_present_target), m_lens_mm(m_present_lens_mm),
      m_is_parallel(viewport.IsParallelProjection()) {
    AttachComboBox(projection_id, m_projection);
}

CameraWish CameraForm::wish() const {
    CameraWish wish;
    wish.parallel = m_is_parallel;
    if (m_location != m_present.CameraLocation())
        wish.location = m_location;
    if (m_target != m_present_target)
        wish.target = m_target;
    if (!m_is_parallel && m_lens_mm != m_present_lens_mm)
        wish.lens_mm = m_lens_mm;
    return wish;
}

int CameraForm::OnInitDialog() {
    m_projection.InsertString(perspective, QnLocalizeString(L"Perspective", 42441));
    m_projection.InsertString(parallel, QnLocalizeString(L"Parallel", 42442));
    m_projection.SetCurSel(m_is_parallel ? parallel : perspective);
    return CDialog::OnInitDialog();
}

void CameraForm::DoDataExchange(CQnDialogExchange& exchange) {
    if (exchange.IsStoring())
        m_is_parallel = m_projection.GetCurSel() == parallel;
    exchangePoint(exchange, location_x_id, m_location);
    exchangePoint(exchange, target_x_id, m_target);
    exchangeLens(exchange);
    checkWish(exchange);
}

/// The fields of y and z follow that of x.
void CameraForm::exchangePoint(CQnDialogExchange& exchange, int x_id, KM_3dPoint& point) {
    exchangeRounded(exchange, x_id, point.x, roundedLength(point.x));
    exchangeRounded(exchange, x_id + 1, point.y, roundedLength(point.y));
    exchangeRounded(exchange, x_id + 2, point.z, roundedLength(point.z));
}

/// What stands there for a parallel view does not count.
void CameraForm::exchangeLens(CQnDialogExchange& exchange) {
    if (exchange.IsStoring() && m_is_parallel)
        return;
    exchangeRounded(exchange, lens_id, m_lens_mm, roundedLength(m_lens_mm));
    DDV_MinMaxDouble(exchange, m_lens_mm, SHORTEST_LENS_MM, LONGEST_LENS_MM);
}

/// Tries the wish out, so that one that cannot be is mended in the form.
void CameraForm::checkWish(CQnDialogExchange& exchange) {
    if (!exchange.IsStoring() || exchange.HasFailed())
        return;
    KM_Viewport tried = m_present;
    if (const Result<void> moved = fulfil(wish(), tried); !moved)
        exchange.Fail(location_x_id, KM_wString::FromUtf8(moved.message()));
}

} // namespace quarn
