#include "engine/display/AmbientFromAround.h"

#include <algorithm>
#include <cmath>
#include <numbers>
#include <vector>

namespace quarn {

namespace {

constexpr int PACKETS = 256;
constexpr int DIRECTIONS = PACKETS * lane_count;

struct DirectionPacket {
    alignas(64) float axes[3][lane_count];
};

/// Directions all over the sphere, equally spaced: a spiral by the golden angle (R. Swinbank and
/// R. J. Purser, "Fibonacci Grids", Quarterly Journal of the Royal Meteorological Society, 2006).
std::vector<DirectionPacket> makeDirections() {
    const double golden_angle = std::numbers::pi * (3.0 - std::sqrt(5.0));
    std::vector<DirectionPacket> packets(PACKETS);
    for (int i = 0; i < DIRECTIONS; ++i) {
        const double z = 1.0 - (2.0 * i + 1.0) / DIRECTIONS;
        const double across = std::sqrt(1.0 - z * z);
        auto& axes = packets[static_cast<std::size_t>(i / lane_count)].axes;
        axes[0][i % lane_count] = static_cast<float>(across * std::cos(golden_angle * i));
        axes[1][i % lane_count] = static_cast<float>(across * std::sin(golden_angle * i));
        axes[2][i % lane_count] = static_cast<float>(z);
    }
    return packets;
}

const std::vector<DirectionPacket>& directions() {
    static const std::vector<DirectionPacket> packets = makeDirections();
    return packets;
}

/// Calls take(x, y, z, colour) for each direction.
template <class Take> void lookAround(const FrameSetup& frame, const Take& take) {
    const RayKernel& kernel = rayKernelInForce();
    alignas(64) float colors[3][lane_count];
    for (const DirectionPacket& packet : directions()) {
        kernel.find_light_around(frame, packet.axes, colors);
        for (int i = 0; i < lane_count; ++i) {
            const float color[3] = {colors[0][i], colors[1][i], colors[2][i]};
            take(packet.axes[0][i], packet.axes[1][i], packet.axes[2][i], color);
        }
    }
}

/// What open ground gets, and sends.
void setGroundLight(FrameSetup& frame) {
    FrameSetup open = frame;
    open.has_ground = false;
    double sum[3] = {};
    lookAround(open, [&](float, float, float z, const float(&color)[3]) {
        for (int c = 0; c < 3; ++c)
            sum[c] += std::max(z, 0.0F) * color[c];
    });
    for (int c = 0; c < 3; ++c) {
        double light = 4.0 / DIRECTIONS * sum[c];
        for (int k = 0; k < frame.sun_count; ++k)
            light += frame.suns[k].color[c] * std::max(frame.suns[k].toward[2], 0.0F);
        frame.ground_light[c] = frame.ground_albedo[c] * static_cast<float>(light);
    }
}

} // namespace

void setAmbientFromAround(FrameSetup& frame) {
    setGroundLight(frame);
    double sums[3][9] = {};
    lookAround(frame, [&](double x, double y, double z, const float(&color)[3]) {
        const double terms[9] = {1.0, x, y, z, x * y, y * z, 3 * z * z - 1, x * z, x * x - y * y};
        for (int c = 0; c < 3; ++c)
            for (int i = 0; i < 9; ++i)
                sums[c][i] += terms[i] * color[c];
    });
    // Each sum is an integral over the sphere by 4 pi / DIRECTIONS; the products of the sphere's
    // functions and of the cosine's are those of the source, over pi.
    constexpr double mean = 1.0 / DIRECTIONS;
    constexpr double squares[5] = {15.0 / 4.0, 15.0 / 4.0, 5.0 / 16.0, 15.0 / 4.0, 15.0 / 16.0};
    for (int c = 0; c < 3; ++c) {
        frame.ambient_base[c] = static_cast<float>(mean * sums[c][0]);
        for (int i = 0; i < 3; ++i)
            frame.ambient_slope[c][i] = static_cast<float>(2.0 * mean * sums[c][1 + i]);
        for (int i = 0; i < 5; ++i)
            frame.ambient_square[c][i] = static_cast<float>(squares[i] * mean * sums[c][4 + i]);
    }
    frame.has_ambient_square = true;
}

} // namespace quarn
