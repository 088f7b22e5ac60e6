#pragma once

#include "bench/PavilionScene.h"
#include "engine/display/DisplayScene.h"
#include "engine/images/Image.h"
#include "kelmar/KM_Viewport.h"

#include <cmath>
#include <ctime>

namespace bench {

inline KM_Viewport fromTheStreet(const quarn::DisplayScene& scene) {
    const KM_BoundingBox& box = scene.boundingBox();
    const KM_3dPoint eye =
        box.Center() + 1.05 * box.Diagonal().Length() * KM_3dVector(0.45, -0.75, 0.42);
    KM_Viewport viewport;
    viewport.SetCameraLocation(eye);
    viewport.SetCameraDirection(box.Center() - eye);
    viewport.SetCameraUp(KM_3dVector::ZAxis);
    return viewport;
}

/// Of all threads.
inline double processorSeconds() {
    std::timespec time{};
    clock_gettime(CLOCK_PROCESS_CPUTIME_ID, &time);
    return static_cast<double>(time.tv_sec) + 1e-9 * static_cast<double>(time.tv_nsec);
}

/// Root of the mean squared difference of two pictures' bytes.
inline double difference(const quarn::Image& a, const quarn::Image& b) {
    double sum = 0.0;
    for (std::size_t i = 0; i < a.rgba.size(); ++i) {
        const double step = static_cast<double>(a.rgba[i]) - static_cast<double>(b.rgba[i]);
        sum += step * step;
    }
    // Opacity, one byte in four, is the same everywhere.
    return std::sqrt(sum / (0.75 * static_cast<double>(a.rgba.size())));
}

} // namespace bench
