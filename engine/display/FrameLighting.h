#pragma once

#include "engine/display/kernel/FrameSetup.h"

class KM_Viewport;

namespace quarn {

class DisplayScene;
struct DisplayModeAttributes;

/// Sets all the light of a picture, its ground and its background. Under a document's light these
/// follow from the scene's settings (LightSettings), see surroundingsOf:
///
/// - The light under a sky is so bright as its sun's height makes it, and that of a studio is
/// always
///   the same. A picture is made so bright that a white surface gets about as much light in it.
///   Where lamps, or suns beside studio or picture, bring light of their own, exposure falls so
///   that the whole stays about the same; under the sky lamps are half as bright instead. The
///   exposure of the settings comes on top, and applies to light that surfaces give off, too.
/// - Ground that stands under the sky is a surface; any other looks as what is behind it, so that
/// it
///   shows shadows alone.
///
/// Nothing of this depends on the camera, but for lights that go with it, nor on what is shown or
/// hidden of the scene.
/// @param frame  its rays and scene are known
void setLighting(FrameSetup& frame, const DisplayScene& scene, const KM_Viewport& viewport,
                 const DisplayModeAttributes& mode);

} // namespace quarn
