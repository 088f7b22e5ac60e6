#include "host/session/ViewFrame.h"

#include "host/document/Document.h"

namespace quarn {

bool setFrameSize(CQuarnView& view, int width_px, int height_px) {
    ViewState& state = ViewState::of(view);
    return state.isOpen() && state.document().setFrameSizeWhenIdle(state, width_px, height_px);
}

void activateView(CQuarnView& view) {
    ViewState& state = ViewState::of(view);
    if (state.isOpen())
        state.document().activateWhenIdle(state);
}

CQuarnView& activeView(CQuarnDoc& document) {
    return Document::of(document).activeView().face();
}

} // namespace quarn
