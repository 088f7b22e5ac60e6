#include "engine/render/RenderSetupBuilder.h"

#include "engine/display/DisplayMode.h"
#include "engine/display/DisplayScene.h"
#include "engine/display/FrameSetupBuilder.h"
#include "engine/render/SampleSequence.h"
#include "kelmar/KM_Point.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace quarn {

namespace {

/// How many directions the light of the sky is summed up from: rings of equal light, each of
/// sixteen directions.
constexpr int sky_rings = 32;

void store(float (&to)[3], const KM_3dVector& v) {
    to[0] = static_cast<float>(v.x);
    to[1] = static_cast<float>(v.y);
    to[2] = static_cast<float>(v.z);
}

SunDisc discAround(const float (&toward)[3]) {
    const KM_3dVector axis(toward[0], toward[1], toward[2]);
    KM_3dVector across = std::abs(axis.z) < 0.9 ? KM_CrossProduct(KM_3dVector::ZAxis, axis)
                                                : KM_CrossProduct(KM_3dVector::XAxis, axis);
    across.Unitize();
    const double radius = std::tan(0.5 * sun_diameter_deg * std::numbers::pi / 180.0);
    SunDisc disc{};
    store(disc.across, radius * across);
    store(disc.along, radius * KM_CrossProduct(axis, across));
    return disc;
}

/// The directions of one ring, equally likely by the cosine with straight up.
void ringDirections(int ring, float (&directions)[3][lane_count]) {
    const double square = (ring + 0.5) / sky_rings;
    for (int lane = 0; lane < lane_count; ++lane) {
        const double around = 2.0 * std::numbers::pi * (lane + 0.5 * (ring % 2)) / lane_count;
        directions[0][lane] = static_cast<float>(std::sqrt(square) * std::cos(around));
        directions[1][lane] = static_cast<float>(std::sqrt(square) * std::sin(around));
        directions[2][lane] = static_cast<float>(std::sqrt(1.0 - square));
    }
}

/// Means over all directions, by their cosine, of numbers by the cosine.
void setMeans(const float* entries, float (&means)[SplitSum::side]) {
    constexpr int side = SplitSum::side;
    for (int row = 0; row < side; ++row) {
        double sum = 0.0;
        for (int i = 0; i + 1 < side; ++i) {
            const double lower = entries[row * side + i];
            const double upper = entries[row * side + i + 1];
            // The integral of a number that grows evenly, times its cosine, from one to the next.
            sum += i * 0.5 * (lower + upper) + lower / 6.0 + upper / 3.0;
        }
        means[row] = static_cast<float>(2.0 * sum / ((side - 1.0) * (side - 1.0)));
    }
}

/// The light that a white surface which faces up gets from the sky as it is seen.
void lightOfSky(const FrameSetup& frame, const RenderKernel& kernel, double (&light)[3]) {
    alignas(64) float directions[3][lane_count];
    alignas(64) float colors[3][lane_count];
    std::fill_n(light, 3, 0.0);
    for (int ring = 0; ring < sky_rings; ++ring) {
        ringDirections(ring, directions);
        kernel.light_around(frame, directions, colors);
        for (int c = 0; c < 3; ++c)
            for (const float color : colors[c])
                light[c] += color / (double{sky_rings} * lane_count);
    }
}

} // namespace

void completeRenderSetup(RenderSetup& setup, const RenderKernel& kernel, RenderTables& tables) {
    const FrameSetup& frame = setup.frame;
    setup.bounce = frame;
    FrameSetup& bounce = setup.bounce;
    bounce.fixed_count = 0;
    bounce.rays.parallel = false;
    std::fill_n(bounce.sky_disc, 3, 0.0F); // the suns are lights of their own
    double light[3];
    lightOfSky(bounce, kernel, light);
    for (int c = 0; c < 3; ++c) {
        const double wanted =
            frame.ambient_base[c] + frame.ambient_slope[c][2] + 2.0 * frame.ambient_square[c][2];
        setup.sky_scale[c] = light[c] > 0.0 ? static_cast<float>(wanted / light[c]) : 0.0F;
    }
    tables.environment.find(bounce, kernel);
    setup.environment = tables.environment.table();
    for (int k = 0; k < frame.sun_count; ++k)
        setup.discs[k] = discAround(frame.suns[k].toward);
    if (!frame.has_mirrors)
        return;
    setMeans(frame.split_sum, setup.mean_a);
    setMeans(frame.split_sum + std::size_t{SplitSum::side} * SplitSum::side, setup.mean_b);
}

RenderSetup makeRenderSetup(const DisplayScene& scene, const KM_Viewport& viewport, int width,
                            int height, const SampleSequence& sequence, const RenderKernel& kernel,
                            RenderTables& tables) {
    RenderSetup setup;
    setup.frame =
        makeFrameSetup(scene, viewport, *findDisplayMode(rendered_mode_id), width, height);
    setup.samples = sequence.table();
    completeRenderSetup(setup, kernel, tables);
    tables.emitters.find(scene);
    setup.emitters = tables.emitters.table();
    return setup;
}

} // namespace quarn
