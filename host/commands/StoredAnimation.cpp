#include "host/commands/StoredAnimation.h"

#include "host/border/Border.h"

namespace quarn {

namespace {

Result<ViewState*> viewOf(const KM_3dmAnimationProperties& record, const Document& document) {
    KM_wString name = record.ViewportName();
    name.TrimLeftAndRight();
    if (name.IsEmpty())
        return Error{"The animation names no view. Set it up again."};
    ViewState* view = document.findView(name.View());
    if (!view)
        return Error{"The animation was made for the view \"" + name.ToUtf8() +
                     "\", which the document does not have. Set the animation up again."};
    return view;
}

} // namespace

PictureSize StoredAnimation::pictureSize() const {
    const RenderSettings& settings = view->document().renderWindow().settings;
    return isRendered() ? PictureSize{settings.width_px, settings.height_px}
                        : PictureSize{view->frameWidth(), view->frameHeight()};
}

Result<StoredAnimation> storedAnimation(Document& document) {
    StoredAnimation animation;
    animation.access = Zoetrix_QuarnDynamicAccess();
    if (!animation.access)
        return Error{"No plug-in keeps an animation. Load one with LoadPlugIn first."};
    const auto record =
        acrossBorder([&] { return &animation.access->AnimationProperties(document.face()); });
    if (!record)
        return Error{"The animation cannot be read: " + record.message()};
    animation.record = record.value();
    if (!animation.record->IsPlayable())
        return Error{"The document has no animation. Set one up, such as with "
                     "SetTurntableAnimation, or open a document that has one."};
    const auto view = viewOf(*animation.record, document);
    if (!view)
        return Error{view.message()};
    animation.view = view.value();
    return animation;
}

} // namespace quarn
