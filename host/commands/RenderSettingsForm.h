#pragma once

#include "host/document/RenderSettings.h"
#include "sdk/qncore/QnDialog.h"

namespace quarn {

/// Asks for the size and the samples of rendered pictures. A button fills in the size of the view.
class RenderSettingsForm final : public CDialog {
public:
    static constexpr int form_id = 4202;
    enum control_id : int {
        width_id = 4301,
        height_id = 4302,
        view_size_id = 4303,
        samples_id = 4304,
        preview_samples_id = 4305,
    };

    /// @param view_width_px, view_height_px  the size of the view that is rendered
    RenderSettingsForm(const RenderSettings& present, int view_width_px, int view_height_px);

    RenderSettings settings;

protected:
    void DoDataExchange(CQnDialogExchange& exchange) override;
    void OnButton(int control) override;

private:
    int m_view_width_px;
    int m_view_height_px;
};

} // namespace quarn
