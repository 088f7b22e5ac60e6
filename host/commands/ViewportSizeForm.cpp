#include "host/commands/ViewportSizeForm.h"

#include "engine/images/PictureMemory.h"
#include "host/commands/FormAsking.h"
#include "host/document/ViewState.h"

namespace quarn {

ViewportSizeForm::ViewportSizeForm(int width, int height)
    : CDialog(form_id, nullptr), width_px(width), height_px(height) {}

void ViewportSizeForm::DoDataExchange(CQnDialogExchange& exchange) {
    exchangeWhole(exchange, width_id, width_px, 1, ViewState::largest_side_px);
    exchangeWhole(exchange, height_id, height_px, 1, ViewState::largest_side_px);
    if (!exchange.IsStoring() || exchange.HasFailed())
        return;
    if (const Result<void> fits = checkPictureMemory(width_px, height_px); !fits)
        exchange.Fail(height_id, KM_wString::FromUtf8(fits.message()));
}

} // namespace quarn
