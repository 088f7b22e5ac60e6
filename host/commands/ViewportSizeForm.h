#pragma once

#include "sdk/qncore/QnDialog.h"

namespace quarn {

/// Asks for the size of a view in pixels. A size that memory does not hold is refused.
class ViewportSizeForm final : public CDialog {
public:
    static constexpr int form_id = 4204;
    enum control_id : int { width_id = 4301, height_id = 4302 };

    ViewportSizeForm(int width_px, int height_px);

    int width_px;
    int height_px;

protected:
    void DoDataExchange(CQnDialogExchange& exchange) override;
};

} // namespace quarn
