// The renderer on the example model: seconds a picture of 1280 by 720 pixels, and how far smaller
// pictures of few samples are from one of 4096, as the root of the mean squared difference of
// their bytes (0 to 255).

#include "bench/PavilionScene.h"
#include "engine/display/DisplayScene.h"
#include "engine/render/Renderer.h"
#include "kelmar/KM_Viewport.h"

#include <cmath>
#include <cstdio>

namespace {

constexpr int reference_samples = 4096;

KM_Viewport fromTheStreet(const quarn::DisplayScene& scene) {
    const KM_BoundingBox& box = scene.boundingBox();
    const KM_3dPoint eye =
        box.Center() + 1.05 * box.Diagonal().Length() * KM_3dVector(0.45, -0.75, 0.42);
    KM_Viewport viewport;
    viewport.SetCameraLocation(eye);
    viewport.SetCameraDirection(box.Center() - eye);
    viewport.SetCameraUp(KM_3dVector::ZAxis);
    return viewport;
}

quarn::Image rendered(const quarn::DisplayScene& scene, const quarn::RenderRequest& request) {
    quarn::Image image;
    const auto end = quarn::Renderer().render(
        scene, fromTheStreet(scene), request, [](double) { return true; }, image);
    if (!end)
        bench::fail(end.message());
    return image;
}

double difference(const quarn::Image& a, const quarn::Image& b) {
    double sum = 0.0;
    for (std::size_t i = 0; i < a.rgba.size(); ++i) {
        const double step = static_cast<double>(a.rgba[i]) - static_cast<double>(b.rgba[i]);
        sum += step * step;
    }
    // Opacity, one byte in four, is the same everywhere.
    return std::sqrt(sum / (0.75 * static_cast<double>(a.rgba.size())));
}

} // namespace

int main() {
    quarn::DisplayScene scene;
    bench::require(scene.update(bench::pavilionContent()));
    std::printf("%-10s %12s\n", "samples", "seconds");
    for (const int samples : {8, 64}) {
        const auto start = bench::Clock::now();
        rendered(scene, {1280, 720, samples});
        std::printf("%-10d %12.2f\n", samples, bench::millisecondsSince(start) / 1000.0);
    }
    const quarn::Image reference = rendered(scene, {240, 135, reference_samples});
    std::printf("%-10s %12s\n", "samples", "difference");
    for (const int samples : {1, 4, 8, 16, 64, 256})
        std::printf("%-10d %12.2f\n", samples,
                    difference(rendered(scene, {240, 135, samples}), reference));
    return 0;
}
