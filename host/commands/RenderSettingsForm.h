#pragma once

#include "ground/Result.h"
#include "host/document/RenderSettings.h"
#include "sdk/qncore/QnComboBox.h"
#include "sdk/qncore/QnDialog.h"

#include <functional>

namespace quarn {

/// What the form of the render settings takes from outside.
struct RenderSettingsSources {
    int view_width_px = 0; ///< of the view that is rendered
    int view_height_px = 0;
    /// Lets the person choose a picture of surroundings; empty where none was chosen.
    std::function<std::filesystem::path(const std::filesystem::path& present)> choose_picture;
    /// Reads one; an error in a sentence where it cannot be read.
    std::function<Result<void>(const std::filesystem::path& file)> read_picture;
};

/// Asks for the size and the samples of rendered pictures, and for the light. Buttons fill in the
/// size of the view and a picture of surroundings. An empty exposure is automatic.
class RenderSettingsForm final : public CDialog {
public:
    static constexpr int form_id = 4202;
    enum control_id : int {
        width_id = 4301,
        height_id = 4302,
        view_size_id = 4303,
        samples_id = 4304,
        preview_samples_id = 4305,
        light_id = 4306,
        picture_id = 4307,
        choose_picture_id = 4308,
        exposure_id = 4309,
        background_id = 4310,
        color_id = 4311,
        ground_id = 4312,
    };
    enum state : int { on = 0, off = 1 };

    RenderSettingsForm(const RenderSettings& present, RenderSettingsSources sources);

    RenderSettings settings;

protected:
    void DoDataExchange(CQnDialogExchange& exchange) override;
    int OnInitDialog() override;
    void OnButton(int control) override;

private:
    void exchangeLight(CQnDialogExchange& exchange);
    void exchangePicture(CQnDialogExchange& exchange);
    void exchangeExposure(CQnDialogExchange& exchange);
    void exchangeColor(CQnDialogExchange& exchange);
    void fillInViewSize();
    void choosePicture();

    RenderSettingsSources m_sources;
    CComboBox m_light;
    CComboBox m_background;
    CComboBox m_ground;
};

} // namespace quarn
