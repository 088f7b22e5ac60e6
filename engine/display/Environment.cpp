#include "engine/display/Environment.h"

#include "engine/display/FlushDenormals.h"
#include "engine/display/SmallMirrors.h"

#include <tbb/parallel_for.h>

#include <array>
#include <bit>
#include <cmath>
#include <iterator>
#include <utility>

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

/// All numbers that light from around goes by; none where it is a picture.
std::vector<float> aroundOf(const FrameSetup& frame) {
    std::vector<float> numbers;
    if (frame.picture.sharp)
        return numbers;
    const auto add = [&](const auto& values) {
        numbers.insert(numbers.end(), std::begin(values), std::end(values));
    };
    for (const auto* const color : {&frame.toward_sun, &frame.sky_horizon, &frame.sky_side,
                                    &frame.sky_zenith, &frame.sky_nadir, &frame.sky_glow})
        add(*color);
    for (int i = 0; i < frame.soft_box_count; ++i) {
        const FrameSoftBox& box = frame.soft_boxes[i];
        for (const auto* const values : {&box.toward, &box.across, &box.along, &box.color})
            add(*values);
        add(std::array{box.half_width, box.half_height, box.border});
    }
    if (frame.has_ground) {
        add(frame.ground_light);
        add(std::array{frame.ground_eye, frame.ground_fade_start, frame.ground_fade_end});
    }
    return numbers;
}

/// Rounded to its upper half.
std::uint32_t upperHalf(float number) {
    return (std::bit_cast<std::uint32_t>(number) + 0x8000U) >> 16;
}

} // namespace

void Environment::find(FrameSetup& frame, const RayKernel& kernel) {
    if (!m_light) {
        m_light = std::make_unique<float[]>(environment_map::floats);
        m_pairs = std::make_unique<std::uint32_t[]>(environment_map::pairs);
    }
    frame.environment = m_light.get();
    frame.environment_pairs = m_pairs.get();
    std::vector<float> around = aroundOf(frame);
    if (!around.empty() && around == m_around)
        return;
    m_around = std::move(around);
    for (int level = 1; level <= environment_map::levels; ++level) {
        const EnvironmentSamples& samples = allSamples()[static_cast<std::size_t>(level - 1)];
        tbb::parallel_for(0, environment_map::stride, [&](int row) {
            const FlushDenormals flush;
            kernel.find_environment(frame, samples, level, row);
        });
    }
    packPairs();
}

void Environment::packPairs() {
    constexpr int step = environment_map::channels * environment_map::texels;
    for (std::size_t i = 0; i < std::size_t{environment_map::pairs}; ++i)
        m_pairs[i] = upperHalf(m_light[i]) << 16 | upperHalf(m_light[i + step]);
}

} // namespace quarn
