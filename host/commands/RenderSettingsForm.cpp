#include "host/commands/RenderSettingsForm.h"

#include "engine/render/RenderRequest.h"
#include "host/commands/FormAsking.h"
#include "host/document/ViewState.h"

#include <string>

namespace quarn {

RenderSettingsForm::RenderSettingsForm(const RenderSettings& present, int view_width_px,
                                       int view_height_px)
    : CDialog(form_id, nullptr), settings(present), m_view_width_px(view_width_px),
      m_view_height_px(view_height_px) {}

void RenderSettingsForm::DoDataExchange(CQnDialogExchange& exchange) {
    constexpr int most_px = ViewState::largest_side_px;
    constexpr int most_samples = RenderRequest::most_samples;
    exchangeWhole(exchange, width_id, settings.width_px, 1, most_px);
    exchangeWhole(exchange, height_id, settings.height_px, 1, most_px);
    exchangeWhole(exchange, samples_id, settings.samples, 1, most_samples);
    exchangeWhole(exchange, preview_samples_id, settings.preview_samples, 1, most_samples);
}

void RenderSettingsForm::OnButton(int control) {
    if (control != view_size_id)
        return;
    SetDlgItemText(width_id, std::to_wstring(m_view_width_px).c_str());
    SetDlgItemText(height_id, std::to_wstring(m_view_height_px).c_str());
}

} // namespace quarn
