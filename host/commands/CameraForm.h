#pragma once

#include "host/commands/CameraWish.h"
#include "sdk/qncore/QnComboBox.h"
#include "sdk/qncore/QnDialog.h"

namespace quarn {

/// Asks where a camera stands, what it looks at, and for its projection and lens. Numbers that the
/// person leaves as they are keep all their digits.
class CameraForm final : public CDialog {
public:
    static constexpr int form_id = 4201;
    enum control_id : int {
        location_x_id = 4301,
        location_y_id = 4302,
        location_z_id = 4303,
        target_x_id = 4304,
        target_y_id = 4305,
        target_z_id = 4306,
        projection_id = 4307,
        lens_id = 4308,
    };
    enum projection : int { perspective = 0, parallel = 1 };

    /// @param viewport  the camera as it is now
    explicit CameraForm(const KM_Viewport& viewport);

    /// What was entered, where it is another than the camera has.
    CameraWish wish() const;

protected:
    void DoDataExchange(CQnDialogExchange& exchange) override;
    int OnInitDialog() override;

private:
    void exchangePoint(CQnDialogExchange& exchange, int x_id, KM_3dPoint& point);
    void exchangeLens(CQnDialogExchange& exchange);
    void checkWish(CQnDialogExchange& exchange);

    const KM_Viewport m_present;
    const KM_3dPoint m_present_target;
    double m_present_lens_mm; ///< of a parallel view: the one it has when it becomes perspective
    KM_3dPoint m_location;
    KM_3dPoint m_target;
    double m_lens_mm;
    bool m_is_parallel;
    CComboBox m_projection;
};

} // namespace quarn
