#include "host/share/camera/CameraTrack.h"

#include "host/app/StudyMoments.h"
#include "host/border/Border.h"
#include "host/document/CameraMove.h"
#include "host/front_end/FrontEnd.h"
#include "sdk/qncore/QnLocalize.h"

#include <cmath>

namespace quarn {

namespace {

/// What a frame's camera is aimed by.
struct Aim {
    KM_3dPoint camera;
    KM_3dPoint target;
};

/// Of a record that follows curves the plug-in knows where they are now.
std::optional<Aim> followedAim(const StoredAnimation& animation, int frame) {
    KM_Viewport placed;
    const auto found = acrossBorder([&] {
        return animation.access->AnimatedViewAtFrame(animation.view->document().face(),
                                                     *animation.record, frame + 1, placed);
    });
    if (!found || !found.value())
        return std::nullopt;
    return Aim{placed.CameraLocation(), placed.TargetPoint()};
}

std::optional<Aim> aimOf(const StoredAnimation& animation, int frame) {
    const KM_3dmAnimationProperties& record = *animation.record;
    if (record.FollowsCurves())
        return followedAim(animation, frame);
    const KM_3dPoint* const camera = record.CameraPoints().At(frame);
    const KM_3dPoint* const target = record.TargetPoints().At(frame);
    if (!camera || !target)
        return std::nullopt;
    return Aim{*camera, *target};
}

CameraKey keyOf(const KM_Viewport& viewport) {
    return {frameCameraOf(viewport), -viewport.CameraZ()};
}

CameraOpening openingOf(const KM_Viewport& viewport) {
    CameraOpening opening;
    opening.is_parallel = viewport.IsParallelProjection();
    viewport.GetFrustum(&opening.left, &opening.right, &opening.bottom, &opening.top,
                        &opening.near_distance, &opening.far_distance);
    if (!opening.is_parallel)
        for (double* const side : {&opening.left, &opening.right, &opening.bottom, &opening.top})
            *side /= opening.near_distance;
    return opening;
}

/// The view's camera as the pictures have it.
KM_Viewport pictureCamera(const StoredAnimation& animation) {
    KM_Viewport viewport = animation.view->frameCamera();
    const PictureSize size = animation.pictureSize();
    if (animation.isRendered())
        viewport.SetScreenPort(size.width_px, size.height_px);
    return viewport;
}

bool isStopped(const StoredAnimation& animation) {
    return animation.view->document().frontEnd().isInterrupted();
}

/// @return whether it came to the end
bool followCamera(const StoredAnimation& animation, CameraTrack& track) {
    KM_Viewport viewport = pictureCamera(animation);
    const int count = animation.record->FrameCount();
    track.keys.reserve(static_cast<std::size_t>(count));
    for (int frame = 0; frame < count; ++frame) {
        if (isStopped(animation))
            return false;
        if (const auto aim = aimOf(animation, frame))
            setTargetAndCamera(viewport, aim->target, aim->camera, true, true);
        track.keys.push_back(keyOf(viewport));
    }
    return true;
}

Error noSun(int frame) {
    return {KM_wString::FormatToString(
                QnLocalizeString(
                    L"The sun of frame %d has no direction. Set the sun study up again.", 42829),
                frame)
                .ToUtf8()};
}

Result<void> followSun(const StoredAnimation& animation, CameraTrack& track) {
    const KM_3dmAnimationProperties& record = *animation.record;
    track.keys.push_back(keyOf(pictureCamera(animation)));
    const std::optional<Zone> zone = studyZone(animation.view->document(), record);
    for (int frame = 0; frame < record.FrameCount(); ++frame) {
        const auto aim = aimOf(animation, frame);
        KM_3dVector to_sun = aim ? aim->camera - aim->target : KM_3dVector();
        if (!to_sun.IsValid() || !to_sun.Unitize())
            return noSun(frame);
        track.suns.push_back({to_sun, sunOfFrame(record, frame, zone)});
    }
    return {};
}

} // namespace

double verticalAngle_deg(const CameraOpening& opening) {
    return (std::atan(opening.top) - std::atan(opening.bottom)) * 180.0 / KM_PI;
}

Result<std::optional<CameraTrack>> cameraTrack(const StoredAnimation& animation, int frame_rate) {
    const Document& document = animation.view->document();
    CameraTrack track;
    track.name = animation.record->HtmlFilename().ToUtf8();
    track.units = document.units();
    track.frame_rate = frame_rate;
    track.picture = animation.pictureSize();
    track.opening = openingOf(pictureCamera(animation));
    track.scene = document.objects().visibleBox();
    if (!animation.record->IsSunStudy())
        return followCamera(animation, track) ? std::optional(std::move(track)) : std::nullopt;
    if (const auto followed = followSun(animation, track); !followed)
        return followed.error();
    return std::optional(std::move(track));
}

} // namespace quarn
