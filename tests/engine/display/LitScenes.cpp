#include "tests/engine/display/LitScenes.h"

#include "engine/images/ColorSpace.h"

#include <gtest/gtest.h>

namespace quarn {

LitFrame frameOf(const SceneContent& content, const KM_Viewport& viewport) {
    LitFrame lit;
    lit.scene = std::make_unique<DisplayScene>();
    EXPECT_TRUE(lit.scene->update(content).ok());
    lit.frame = makeFrameSetup(*lit.scene, viewport, modeNamed(L"Rendered"), 64, 64);
    return lit;
}

double ambientOn(const FrameSetup& frame, double x, double y, double z) {
    const float(&slope)[3] = frame.ambient_slope[1];
    const float(&square)[5] = frame.ambient_square[1];
    return frame.ambient_base[1] + slope[0] * x + slope[1] * y + slope[2] * z + square[0] * x * y +
           square[1] * y * z + square[2] * (3 * z * z - 1) + square[3] * x * z +
           square[4] * (x * x - y * y);
}

Image litPicture(const SceneContent& content, const KM_Viewport& viewport, int width, int height,
                 int antialiasing_level) {
    return drawn(content, viewport, modeNamed(L"Rendered", antialiasing_level), width, height);
}

SceneContent cubeOnGround(KM_Color color) {
    SceneContent content;
    addMesh(content, boxMesh({-0.1, -0.1, 0.0}, {0.1, 0.1, 0.2}), color);
    return content;
}

KM_Viewport productView() {
    return perspectiveView({0.4, -0.9, 0.5}, {0.0, 0.0, 0.1});
}

std::shared_ptr<const EnvironmentPicture>
surroundingsBy(const std::function<std::array<float, 3>(float, float)>& color) {
    auto picture = std::make_shared<EnvironmentPicture>();
    picture->width = 256;
    picture->height = 128;
    for (int y = 0; y < picture->height; ++y)
        for (int x = 0; x < picture->width; ++x)
            for (const float c : color((static_cast<float>(x) + 0.5F) * 360.0F / 256.0F - 180.0F,
                                       90.0F - (static_cast<float>(y) + 0.5F) * 180.0F / 128.0F))
                picture->rgb.push_back(c);
    return picture;
}

double linearLight(const Image& image, int x, int y) {
    return linearFromSrgbByte(image.pixel(x, y)[1]);
}

} // namespace quarn
