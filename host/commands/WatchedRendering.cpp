#include "host/commands/WatchedRendering.h"

#include "host/app/Application.h"
#include "host/document/Document.h"
#include "host/document/DocumentDrawing.h"
#include "host/front_end/FrontEnd.h"
#include "sdk/qncore/QnPlatform.h"

namespace quarn {

Result<RenderEnd> renderWatched(Document& document, const KM_Viewport& viewport,
                                const RenderRequest& request, Image& picture,
                                const SceneChanges& changes, const Renderer::Shown& shown) {
    FrontEnd& front_end = document.frontEnd();
    const auto watch = [&](double share) {
        front_end.pictureRendered(share);
        front_end.pumpEvents(0);
        if (RunningRecording* const recording = Application::current()->recording())
            recording->beat();
        return !front_end.isInterrupted() && !front_end.isKeyDown(VK_ESCAPE);
    };
    auto end = document.drawing().render(viewport, request, watch, picture, changes, shown);
    front_end.pictureRendered(1.0);
    return end;
}

} // namespace quarn
