#include "host/recording/FramesManifest.h"

#include "kelmar/KM_Viewport.h"

#include <algorithm>
#include <array>

namespace quarn {

namespace {

constexpr std::array FRAME_RATES = {10, 12, 15, 20, 24, 25, 30};
constexpr int SHORTEST_FILM_S = 4;

} // namespace

std::string manifestName(const std::string& animation) {
    return animation + ".frames.json";
}

int standardFrameRate(int frames) {
    int best = FRAME_RATES.front();
    for (const int rate : FRAME_RATES)
        if (rate <= frames / SHORTEST_FILM_S)
            best = rate;
    return best;
}

FrameCamera frameCameraOf(const KM_Viewport& viewport) {
    FrameCamera camera;
    camera.place = viewport.CameraLocation();
    camera.target = viewport.TargetPoint().IsValid() ? viewport.TargetPoint()
                                                     : camera.place - viewport.CameraZ();
    camera.up = viewport.CameraY();
    camera.is_parallel = viewport.IsParallelProjection();
    if (camera.is_parallel) {
        double left = 0.0, right = 0.0, bottom = 0.0, top = 0.0;
        viewport.GetFrustum(&left, &right, &bottom, &top, nullptr, nullptr);
        camera.width = right - left;
        camera.height = top - bottom;
    } else {
        viewport.GetCamera35mmLensLength(&camera.lens_mm);
    }
    return camera;
}

} // namespace quarn
