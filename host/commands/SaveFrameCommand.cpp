#include "engine/display/DisplayMode.h"
#include "engine/images/ImageFile.h"
#include "ground/PathText.h"
#include "host/app/Application.h"
#include "host/app/PictureOpacity.h"
#include "host/border/Border.h"
#include "host/commands/CommandEnd.h"
#include "host/commands/FileAsking.h"
#include "host/commands/HostCommands.h"
#include "host/commands/PictureSizePrompt.h"
#include "host/commands/StoredAnimation.h"
#include "host/commands/WatchedRendering.h"
#include "host/document/DisplayModeList.h"
#include "host/document/Document.h"
#include "host/document/DocumentDrawing.h"
#include "host/document/SceneChanges.h"
#include "sdk/qncore/QnDib.h"
#include "sdk/qncore/QnGet.h"

namespace quarn {

namespace {

/// What the person wants to have written.
struct FrameWish {
    int frame = 0; ///< from 0, as in file names
    int width_px = 0;
    int height_px = 0;
    std::filesystem::path file;
};

/// A frame made ready for drawing.
struct FrameScene {
    KM_Viewport viewport;
    SceneChanges changes;
};

/// @param wish  receives frame and size; holds the size to begin with
CQuarnCommand::result askFrame(const KM_3dmAnimationProperties& record, FrameWish& wish) {
    const int last = record.FrameCount() - 1;
    const int current = record.CurrentFrame();
    CQuarnGetInteger get;
    get.SetCommandPrompt(QnLocalizeString(L"Frame, from 0 as in file names", 42200));
    get.SetDefaultInteger(current >= 0 && current <= last ? current : 0);
    get.SetLowerLimit(0);
    get.SetUpperLimit(last);
    get.AddCommandOption(QnLocalizeCommandOptionName(L"Size", 42200));
    CQuarnGet::result answer = get.GetNumber();
    while (answer == CQuarnGet::option) {
        const CQuarnCommand::result asked = askPictureSize(wish.width_px, wish.height_px);
        if (asked != CQuarnCommand::success)
            return asked;
        answer = get.GetNumber();
    }
    wish.frame = get.Number();
    return get.CommandResult();
}

/// Why no picture can be written there, as far as that is seen before one is drawn.
Result<void> checkImageFile(const Document& document, const std::filesystem::path& file) {
    const std::string name = textFromPath(file).ToUtf8();
    if (!imageFormatFor(file.extension().string()))
        return Error{"Cannot write " + name +
                     ": no image format has this extension. Give a file that ends in .jpg, .jpeg, "
                     ".png, .bmp or .tga."};
    if (const auto why = whyNotSeeThrough(document, file.extension().string()))
        return Error{*why};
    const std::filesystem::path folder = file.has_parent_path() ? file.parent_path() : ".";
    std::error_code error;
    if (!std::filesystem::is_directory(folder, error))
        return Error{"Cannot write " + name + ": there is no folder " +
                     textFromPath(folder).ToUtf8() + ". Make it first."};
    return {};
}

CQuarnCommand::result askImageFile(const CQuarnCommandContext& context, FrameWish& wish) {
    const CQuarnCommand::result asked =
        askFile(context, FileUse::save_frame, QnLocalizeString(L"Image file", 42201), wish.file);
    if (asked != CQuarnCommand::success)
        return asked;
    const auto checked = checkImageFile(Document::of(context.Document()), wish.file);
    return checked ? CQuarnCommand::success : fail(checked.message());
}

CQuarnCommand::result askWish(const CQuarnCommandContext& context, const StoredAnimation& animation,
                              FrameWish& wish) {
    const PictureSize size = animation.pictureSize();
    wish.width_px = size.width_px;
    wish.height_px = size.height_px;
    const CQuarnCommand::result asked = askFrame(*animation.record, wish);
    return asked == CQuarnCommand::success ? askImageFile(context, wish) : asked;
}

Result<FrameScene> sunAtFrame(const StoredAnimation& animation, int frame) {
    FrameScene scene;
    scene.viewport = animation.view->viewport();
    KM_Light sun;
    const auto found = acrossBorder([&] {
        return animation.access->AnimatedSunAtFrame(animation.view->document().face(),
                                                    *animation.record, frame + 1, sun);
    });
    if (!found || !found.value())
        return Error{"The sun of frame " + std::to_string(frame) +
                     " cannot be placed. Set the sun study up again."};
    scene.changes.sun = sun;
    return scene;
}

Result<FrameScene> cameraAtFrame(const StoredAnimation& animation, int frame) {
    FrameScene scene;
    const auto found = acrossBorder([&] {
        return animation.access->AnimatedViewAtFrame(animation.view->document().face(),
                                                     *animation.record, frame + 1, scene.viewport);
    });
    if (!found || !found.value())
        return Error{
            "The camera of frame " + std::to_string(frame) +
            " cannot be placed: its point and its target must be two different points, and "
            "the view needs a direction for it that points up. Set the animation up again, "
            "in a view with a level horizon."};
    for (const KM_UUID& curve : animation.record->FollowedCurves())
        scene.changes.hidden.push_back(curve);
    return scene;
}

/// A picture of the view's own size is seen as the view is, to the last bit.
void fitToPicture(KM_Viewport& viewport, const ViewState& view, const FrameWish& wish) {
    if (wish.width_px != view.frameWidth() || wish.height_px != view.frameHeight())
        viewport.SetScreenPort(wish.width_px, wish.height_px);
}

/// What the animation is recorded with; the view's own mode where the record's is none of the
/// host's; null when there is neither.
const CDisplayPipelineAttributes* recordedMode(const StoredAnimation& animation) {
    const KM_UUID id = animation.record->IsSunStudy() ? rendered_mode_id
                       : KM_UuidIsNil(animation.record->DisplayMode())
                           ? wireframe_mode_id
                           : animation.record->DisplayMode();
    const CDisplayPipelineAttributes* mode = DisplayModeList::instance().find(id);
    return mode ? mode : animation.view->currentAttributes();
}

CQuarnCommand::result drawFrame(const StoredAnimation& animation, const FrameWish& wish,
                                const FrameScene& scene, Image& picture) {
    const CDisplayPipelineAttributes* mode = recordedMode(animation);
    if (!mode)
        return fail("Neither the animation nor its view has a display mode. Choose one with "
                    "DisplayMode.");
    DisplayModeAttributes attributes = drawingAttributes(*mode);
    attributes.antialiasing_level = static_cast<int>(AntialiasingLevel::capture);
    const auto drawn = animation.view->document().drawing().draw(
        scene.viewport, attributes, wish.width_px, wish.height_px, picture, scene.changes);
    return drawn ? CQuarnCommand::success : fail(drawn.message());
}

CQuarnCommand::result renderFrame(const StoredAnimation& animation, const FrameWish& wish,
                                  const FrameScene& scene, Image& picture) {
    Document& document = animation.view->document();
    const RenderSettings& settings = document.renderWindow().settings;
    const int samples =
        animation.record->RenderFull() ? settings.samples : settings.preview_samples;
    const auto end = renderWatched(
        document, scene.viewport, {wish.width_px, wish.height_px, samples}, picture, scene.changes);
    if (!end)
        return fail(end.message());
    return end.value() == RenderEnd::done ? CQuarnCommand::success : CQuarnCommand::cancel;
}

CQuarnCommand::result saveFrame(const StoredAnimation& animation, const FrameWish& wish) {
    auto scene = animation.record->IsSunStudy() ? sunAtFrame(animation, wish.frame)
                                                : cameraAtFrame(animation, wish.frame);
    if (!scene)
        return fail(scene.message());
    fitToPicture(scene.value().viewport, *animation.view, wish);
    CQuarnDib picture;
    const CQuarnCommand::result made =
        animation.isRendered() ? renderFrame(animation, wish, scene.value(), picture.Image())
                               : drawFrame(animation, wish, scene.value(), picture.Image());
    if (made != CQuarnCommand::success)
        return made;
    animation.view->tellCameraOutOfRange();
    return picture.WriteToFile(textFromPath(wish.file), 0) ? CQuarnCommand::success
                                                           : CQuarnCommand::failure;
}

} // namespace

CQuarnCommand::result runSaveFrame(const CQuarnCommandContext& context) {
    const auto animation = storedAnimation(Document::of(context.Document()));
    if (!animation)
        return fail(animation.message());
    FrameWish wish;
    const CQuarnCommand::result asked = askWish(context, animation.value(), wish);
    return asked == CQuarnCommand::success ? saveFrame(animation.value(), wish) : asked;
}

} // namespace quarn
