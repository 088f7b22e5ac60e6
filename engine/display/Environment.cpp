#include "engine/display/Environment.h"

#include "engine/display/FlushDenormals.h"
#include "engine/display/SmallMirrors.h"

#include <tbb/parallel_for.h>

#include <array>
#include <cmath>

namespace quarn {

namespace {

using Samples = std::array<EnvironmentSamples, environment_map::levels>;

/// The width of the mirrors' spread at a level.
float spreadOf(int level) {
    const float roughness = static_cast<float>(level) / environment_map::levels;
    return roughness * roughness;
}

/// What a level adds to the blur of the one before: squares add up.
EnvironmentSamples samplesOf(int level) {
    const float before = spreadOf(level - 1);
    const float alpha = std::sqrt(spreadOf(level) * spreadOf(level) - before * before);
    EnvironmentSamples samples{};
    float sum = 0.0F;
    for (int i = 0; i < environment_map::samples; ++i) {
        const MirrorNormal half = smallMirror(i, environment_map::samples, alpha);
        samples.x[i] = 2.0F * half.z * half.x;
        samples.y[i] = 2.0F * half.z * half.y;
        samples.z[i] = 2.0F * half.z * half.z - 1.0F;
        samples.weight[i] = samples.z[i] > 0.0F ? samples.z[i] : 0.0F;
        sum += samples.weight[i];
    }
    for (float& weight : samples.weight)
        weight /= sum;
    return samples;
}

Samples makeSamples() {
    Samples samples{};
    for (int level = 1; level <= environment_map::levels; ++level)
        samples[static_cast<std::size_t>(level - 1)] = samplesOf(level);
    return samples;
}

const Samples& allSamples() {
    static const Samples samples = makeSamples();
    return samples;
}

} // namespace

void Environment::find(FrameSetup& frame, const RayKernel& kernel) {
    if (!m_light)
        m_light = std::make_unique<float[]>(environment_map::floats);
    frame.environment = m_light.get();
    for (int level = 1; level <= environment_map::levels; ++level) {
        const EnvironmentSamples& samples = allSamples()[static_cast<std::size_t>(level - 1)];
        tbb::parallel_for(0, environment_map::stride, [&](int row) {
            const FlushDenormals flush;
            kernel.find_environment(frame, samples, level, row);
        });
    }
}

} // namespace quarn
