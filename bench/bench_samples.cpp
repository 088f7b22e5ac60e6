// The samples of a rendered picture without their filter: how long they take, and how far they are
// from 4096, as the root of the mean squared difference of the pictures' bytes (0 to 255). Tells
// also what a peer program needs to make its own picture of the scene (peers/blender_samples.py).
//
// usage: bench_samples [FOLDER]   FOLDER takes the model and the camera

#include "bench/RenderedPavilion.h"
#include "engine/render/RenderEncoding.h"
#include "engine/render/RenderLayers.h"
#include "engine/render/RenderSetupBuilder.h"
#include "engine/render/Renderer.h"
#include "engine/render/SampleSequence.h"
#include "engine/render/SampleTaking.h"

#include <cmath>
#include <fstream>

namespace {

constexpr int width_px = 320;
constexpr int height_px = 180;
constexpr int reference_samples = 4096;

quarn::Image sampled(const quarn::DisplayScene& scene, int samples) {
    const quarn::RenderKernel& kernel = quarn::renderKernelInForce();
    const quarn::SampleSequence sequence(samples);
    quarn::RenderTables tables;
    const quarn::RenderSetup setup = quarn::makeRenderSetup(
        scene, bench::fromTheStreet(scene), width_px, height_px, sequence, kernel, tables);
    quarn::RenderLayers layers(width_px, height_px);
    quarn::SampleTaking(setup, kernel, layers, samples).run(false, [](double) { return true; });
    quarn::Image image;
    image.resize(width_px, height_px);
    for (int y = 0; y < height_px; ++y)
        quarn::encodeRow(layers, setup.frame, y, image);
    return image;
}

/// What the sky sheds on level ground, over pi: the radiance of an even sky that does the same.
void addEvenSky(const quarn::RenderSetup& setup, const quarn::RenderKernel& kernel,
                float (&color)[3]) {
    constexpr int rings = 64;
    for (int ring = 0; ring < rings; ++ring) {
        // Rings whose projections onto the ground are of one size.
        const double across = std::sqrt((ring + 0.5) / rings);
        alignas(64) float directions[3][quarn::lane_count];
        for (int i = 0; i < quarn::lane_count; ++i) {
            const double turn = 2.0 * 3.14159265358979 * i / quarn::lane_count;
            directions[0][i] = static_cast<float>(across * std::cos(turn));
            directions[1][i] = static_cast<float>(across * std::sin(turn));
            directions[2][i] = static_cast<float>(std::sqrt(1.0 - across * across));
        }
        alignas(64) float colors[3][quarn::lane_count];
        kernel.light_around(setup.bounce, directions, colors);
        for (int c = 0; c < 3; ++c)
            for (const float light : colors[c])
                color[c] += light * setup.sky_scale[c] / (rings * quarn::lane_count);
    }
}

/// Lines of three numbers: the eye, what it looks at, where the sun stands, the colour of the sun
/// and that of an even sky; and half the vertical angle of view in radians.
void writeScene(const quarn::DisplayScene& scene, const std::filesystem::path& folder) {
    std::filesystem::create_directories(folder);
    if (!pavilion::write(folder))
        bench::fail("the example model cannot be written");
    const KM_3dPoint target = scene.boundingBox().Center();
    const KM_3dPoint eye = bench::fromTheStreet(scene).CameraLocation();
    const KM_3dVector sun = -bench::afternoonSun().Direction();
    std::ofstream file(folder / "view.txt");
    for (const KM_3dVector& v : {eye - KM_3dPoint::Origin, target - KM_3dPoint::Origin, sun})
        file << v.x << ' ' << v.y << ' ' << v.z << '\n';
    const quarn::RenderKernel& kernel = quarn::renderKernelInForce();
    const quarn::SampleSequence sequence(1);
    quarn::RenderTables tables;
    const quarn::RenderSetup setup = quarn::makeRenderSetup(
        scene, bench::fromTheStreet(scene), width_px, height_px, sequence, kernel, tables);
    const float(&sun_color)[3] = setup.frame.suns[0].color;
    float sky[3] = {};
    addEvenSky(setup, kernel, sky);
    file << sun_color[0] << ' ' << sun_color[1] << ' ' << sun_color[2] << '\n';
    file << sky[0] << ' ' << sky[1] << ' ' << sky[2] << '\n';
    double vertical = 0.0;
    double horizontal = 0.0;
    bench::fromTheStreet(scene).GetCameraHalfAngles(&vertical, &horizontal);
    file << vertical << " 0 0\n";
}

} // namespace

int main(int count, char** words) {
    quarn::DisplayScene scene;
    bench::require(scene.update(bench::pavilionContent()));
    if (count > 1)
        writeScene(scene, words[1]);
    const quarn::Image reference = sampled(scene, reference_samples);
    std::printf("%-10s %12s %12s %12s\n", "samples", "seconds", "processor s", "difference");
    for (const int samples : {1, 4, 16, 64, 256}) {
        const auto start = bench::Clock::now();
        const double processor_start = bench::processorSeconds();
        const quarn::Image image = sampled(scene, samples);
        std::printf(
            "%-10d %12.2f %12.2f %12.2f\n", samples, bench::millisecondsSince(start) / 1000.0,
            bench::processorSeconds() - processor_start, bench::difference(image, reference));
        std::fflush(stdout);
    }
    return 0;
}
