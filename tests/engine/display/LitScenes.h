#pragma once

#include "engine/display/FrameSetupBuilder.h"
#include "tests/engine/display/LookScenes.h"

namespace quarn {

/// What the ray loops get for a picture in Rendered. The scene that it points into is kept with it.
struct LitFrame {
    std::unique_ptr<DisplayScene> scene;
    FrameSetup frame;
};
LitFrame frameOf(const SceneContent& content, const KM_Viewport& viewport);

/// The ambient light of the green channel on a surface with this normal.
double ambientOn(const FrameSetup& frame, double x, double y, double z);

/// A picture in Rendered.
Image litPicture(const SceneContent& content, const KM_Viewport& viewport, int width, int height,
                 int antialiasing_level = 0);

/// A box of 0.2 m with its middle over the origin, which stands on the ground.
SceneContent cubeOnGround(KM_Color color = {204, 204, 204, 255});
/// A camera a metre from it, to its front and right.
KM_Viewport productView();

/// A picture of the surroundings of one colour a call: colour(azimuth, altitude), in degrees, the
/// azimuth clockwise from +y.
std::shared_ptr<const EnvironmentPicture>
surroundingsBy(const std::function<std::array<float, 3>(float, float)>& color);

/// Linear light of a pixel's green channel.
double linearLight(const Image& image, int x, int y);

} // namespace quarn
