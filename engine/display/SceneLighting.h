#pragma once

#include "engine/display/SkyModel.h"
#include "engine/scene/LightSettings.h"

namespace quarn {

class DisplayScene;
struct DisplayModeAttributes;

/// The light of a scene in a display mode, scaled by its exposure, see FrameLighting.h.
/// @param eye  where the camera is, in the world
Lighting lightingOf(const DisplayScene& scene, const DisplayModeAttributes& mode,
                    const CameraFrame& camera, const KM_3dPoint& eye);

/// What lies around a scene in a mode that is lit by it; sky for all other modes.
Surroundings surroundingsIn(const DisplayScene& scene, const DisplayModeAttributes& mode);

} // namespace quarn
