#include "host/commands/RenderSettingsForm.h"

#include "engine/render/RenderRequest.h"
#include "ground/PathText.h"
#include "host/commands/ColorText.h"
#include "host/commands/FormAsking.h"
#include "host/commands/LightWords.h"
#include "host/document/ViewState.h"
#include "host/prompt/NumberText.h"

#include <algorithm>
#include <string>

namespace quarn {

namespace {

void fill(CComboBox& box, std::span<const LightWord> words, int chosen) {
    for (std::size_t i = 0; i < words.size(); ++i)
        box.InsertString(static_cast<int>(i), words[i].text());
    box.SetCurSel(chosen);
}

/// What a combo box shows; the present value where the window has no such box.
template <class Value> Value selected(const CComboBox& box, Value present) {
    const int selection = box.GetCurSel();
    return selection < 0 ? present : static_cast<Value>(selection);
}

bool isBlank(std::wstring_view text) {
    return std::ranges::all_of(text, [](wchar_t letter) { return letter == L' '; });
}

} // namespace

RenderSettingsForm::RenderSettingsForm(const RenderSettings& present, RenderSettingsSources sources)
    : CDialog(form_id, nullptr), settings(present), m_sources(std::move(sources)) {
    AttachComboBox(light_id, m_light);
    AttachComboBox(background_id, m_background);
    AttachComboBox(ground_id, m_ground);
}

int RenderSettingsForm::OnInitDialog() {
    fill(m_light, SURROUNDINGS_WORDS, static_cast<int>(settings.light.surroundings));
    fill(m_background, BACKGROUND_WORDS, static_cast<int>(settings.light.background));
    m_ground.InsertString(on, QnLocalizeString(L"On", 42457));
    m_ground.InsertString(off, QnLocalizeString(L"Off", 42458));
    m_ground.SetCurSel(settings.light.has_ground ? on : off);
    return CDialog::OnInitDialog();
}

void RenderSettingsForm::DoDataExchange(CQnDialogExchange& exchange) {
    constexpr int most_px = ViewState::largest_side_px;
    constexpr int most_samples = RenderRequest::most_samples;
    exchangeWhole(exchange, width_id, settings.width_px, 1, most_px);
    exchangeWhole(exchange, height_id, settings.height_px, 1, most_px);
    exchangeWhole(exchange, samples_id, settings.samples, 1, most_samples);
    exchangeWhole(exchange, preview_samples_id, settings.preview_samples, 1, most_samples);
    exchangeLight(exchange);
}

void RenderSettingsForm::exchangeLight(CQnDialogExchange& exchange) {
    LightChoice& light = settings.light;
    if (exchange.IsStoring()) {
        light.surroundings = selected(m_light, light.surroundings);
        light.background = selected(m_background, light.background);
        light.has_ground = selected(m_ground, light.has_ground ? on : off) == on;
    }
    exchangePicture(exchange);
    exchangeExposure(exchange);
    exchangeColor(exchange);
}

/// What stands there counts only where the light is a picture.
void RenderSettingsForm::exchangePicture(CQnDialogExchange& exchange) {
    LightChoice& light = settings.light;
    const bool counts = light.surroundings == Surroundings::picture;
    if (exchange.IsStoring() && !counts)
        return;
    KM_wString text = textFromPath(light.picture);
    DDX_Text(exchange, picture_id, text);
    if (!exchange.IsStoring() || exchange.HasFailed())
        return;
    std::error_code error;
    const std::filesystem::path file = pathFromText(text.View());
    if (const auto is_read = m_sources.read_picture(std::filesystem::absolute(file, error));
        !is_read)
        exchange.Fail(picture_id, KM_wString::FromUtf8(is_read.message()));
    else
        light.picture = std::filesystem::absolute(file, error);
}

void RenderSettingsForm::exchangeExposure(CQnDialogExchange& exchange) {
    std::optional<double>& exposure = settings.light.exposure;
    if (!exchange.IsStoring()) {
        SetDlgItemText(exposure_id, exposure ? numberText(*exposure) : KM_wString());
        return;
    }
    if (exchange.HasFailed())
        return;
    if (isBlank(GetDlgItemText(exposure_id).View())) {
        exposure.reset();
        return;
    }
    double stops = 0.0;
    DDX_Text(exchange, exposure_id, stops);
    DDV_MinMaxDouble(exchange, stops, -LightChoice::most_stops, LightChoice::most_stops);
    if (!exchange.HasFailed())
        exposure = stops;
}

void RenderSettingsForm::exchangeColor(CQnDialogExchange& exchange) {
    LightChoice& light = settings.light;
    if (exchange.IsStoring() && light.background != BackgroundKind::color)
        return;
    KM_wString text = colorText(light.background_color);
    DDX_Text(exchange, color_id, text);
    if (!exchange.IsStoring() || exchange.HasFailed())
        return;
    if (const auto color = colorFromText(text.View()))
        light.background_color = *color;
    else
        exchange.Fail(color_id, noColorText(text.Array()));
}

void RenderSettingsForm::OnButton(int control) {
    if (control == view_size_id)
        fillInViewSize();
    else if (control == choose_picture_id)
        choosePicture();
}

void RenderSettingsForm::fillInViewSize() {
    SetDlgItemText(width_id, std::to_wstring(m_sources.view_width_px).c_str());
    SetDlgItemText(height_id, std::to_wstring(m_sources.view_height_px).c_str());
}

/// Who chooses a picture wants its light.
void RenderSettingsForm::choosePicture() {
    const std::filesystem::path present = pathFromText(GetDlgItemText(picture_id).View());
    const std::filesystem::path chosen = m_sources.choose_picture(present);
    if (chosen.empty())
        return;
    SetDlgItemText(picture_id, textFromPath(chosen));
    m_light.SetCurSel(static_cast<int>(Surroundings::picture));
}

} // namespace quarn
