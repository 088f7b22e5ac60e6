#include "engine/display/SmallMirrors.h"

#include <cmath>
#include <cstdint>

namespace quarn {

namespace {

constexpr float TWO_PI = 6.28318531F;

/// The bits behind the binary point, in reverse order.
float radicalInverse(std::uint32_t bits) {
    std::uint32_t reversed = 0;
    for (int i = 0; i < 32; ++i)
        reversed |= (bits >> i & 1U) << (31 - i);
    return static_cast<float>(reversed >> 8) * 0x1p-24F;
}

} // namespace

MirrorNormal smallMirror(int i, int count, float alpha) {
    const float part = (static_cast<float>(i) + 0.5F) / static_cast<float>(count);
    const float turn = TWO_PI * radicalInverse(static_cast<std::uint32_t>(i));
    const float square = (1.0F - part) / (1.0F + (alpha * alpha - 1.0F) * part);
    const float sine = std::sqrt(1.0F - square);
    return {sine * std::cos(turn), sine * std::sin(turn), std::sqrt(square)};
}

} // namespace quarn
