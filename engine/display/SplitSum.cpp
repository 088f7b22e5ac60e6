#include "engine/display/SplitSum.h"

#include "engine/display/SmallMirrors.h"

#include <algorithm>
#include <cmath>

namespace quarn {

namespace {

/// Directions that the light of an entry is summed up from.
constexpr int SAMPLES = 2048;
/// Seen along its very face a surface sends nothing.
constexpr float LEAST_FACING = 0.002F;
/// Roughness squared; a perfect mirror would be one direction.
constexpr float LEAST_ALPHA = 1e-4F;

struct Parts {
    float a = 0.0F;
    float b = 0.0F;
};

/// What one small mirror adds.
/// @param half    the mirror's normal; the surface's is (0, 0, 1)
/// @param facing  cosine between the surface's normal and the observer
Parts partOf(const MirrorNormal& half, float facing, float alpha) {
    const float across = std::sqrt(1.0F - facing * facing);
    const float to_mirror = across * half.x + facing * half.z;
    const float lit = 2.0F * to_mirror * half.z - facing;
    if (lit <= 0.0F || to_mirror <= 0.0F)
        return {};
    const float square = alpha * alpha;
    const auto hidden = [&](float cosine) {
        return std::sqrt(square + (1.0F - square) * cosine * cosine);
    };
    const float visible = 2.0F * lit / (lit * hidden(facing) + facing * hidden(lit));
    const float weight = visible * to_mirror / half.z;
    const float turned = 1.0F - to_mirror;
    const float along_face = turned * turned * turned * turned * turned; // Schlick 1994
    return {(1.0F - along_face) * weight, along_face * weight};
}

Parts sumOf(float facing, float roughness) {
    const float alpha = std::max(roughness * roughness, LEAST_ALPHA);
    Parts sum;
    for (int i = 0; i < SAMPLES; ++i) {
        const Parts part = partOf(smallMirror(i, SAMPLES, alpha), facing, alpha);
        sum.a += part.a / SAMPLES;
        sum.b += part.b / SAMPLES;
    }
    return sum;
}

} // namespace

SplitSum::SplitSum() {
    constexpr auto last = static_cast<float>(side - 1);
    for (int row = 0; row < side; ++row)
        for (int column = 0; column < side; ++column) {
            const float facing = std::max(static_cast<float>(column) / last, LEAST_FACING);
            const Parts sum = sumOf(std::min(facing, 1.0F), static_cast<float>(row) / last);
            const auto at = static_cast<std::size_t>(row * side + column);
            m_entries[at] = sum.a;
            m_entries[at + std::size_t{side} * side] = sum.b;
        }
}

const SplitSum& splitSum() {
    static const SplitSum table;
    return table;
}

} // namespace quarn
