#pragma once

#include "engine/scene/UnitLength.h"
#include "ground/Result.h"
#include "host/commands/StoredAnimation.h"
#include "host/recording/FramesManifest.h"
#include "kelmar/KM_BoundingBox.h"

#include <optional>
#include <string>
#include <vector>

namespace quarn {

/// Where the camera is in a frame, in model units.
struct CameraKey {
    FrameCamera camera;
    KM_3dVector direction; ///< of view; unit
};

/// The sun of a frame of a sun study.
struct SunKey {
    KM_3dVector to_sun; ///< unit, from the model toward the sun
    std::optional<FrameSun> moment;
};

/// What a camera sees in front of it, in model units.
struct CameraOpening {
    bool is_parallel = false;
    /// What the picture spans along the camera's axes, from its line of sight: of a perspective
    /// camera at one unit in front of it.
    double left = 0.0, right = 0.0, bottom = 0.0, top = 0.0;
    /// The planes that bound what is seen. The host's own pictures are not cut by them.
    double near_distance = 0.0, far_distance = 0.0;

    double width() const { return right - left; }
    double height() const { return top - bottom; }
};

/// The angle between the upper and the lower border of a perspective camera's picture.
double verticalAngle_deg(const CameraOpening& opening);

/// The camera of each frame of an animation, for other programs.
struct CameraTrack {
    std::string name; ///< of the animation, UTF-8
    UnitSystem units = UnitSystem::none;
    int frame_rate = 0; ///< frames a second
    PictureSize picture{};
    CameraOpening opening;       ///< of all frames
    std::vector<CameraKey> keys; ///< one a frame; one alone where the camera stands still
    std::vector<SunKey> suns;    ///< one a frame of a sun study; else empty
    KM_BoundingBox scene;        ///< of all that is visible; not valid where nothing is

    /// In a sun study the camera stands still.
    bool isSunStudy() const { return !suns.empty(); }
    int frameCount() const { return static_cast<int>(isSunStudy() ? suns.size() : keys.size()); }
    const CameraKey& key(int frame) const {
        return keys[isSunStudy() ? 0 : static_cast<std::size_t>(frame)];
    }
    double time_s(int frame) const { return static_cast<double>(frame) / frame_rate; }
};

/// Goes through an animation as a recording does, without drawing: from the camera that the view
/// has now, and through all frames, as the horizon is kept level from each to the next. Document
/// and view stay as they are. A frame whose camera cannot be placed has that of the frame before.
/// @return an error, in a sentence of the user's language, where a frame has no sun; nothing where
///         a person asked the program to stop
Result<std::optional<CameraTrack>> cameraTrack(const StoredAnimation& animation, int frame_rate);

} // namespace quarn
