#pragma once

#include "engine/display/kernel/FrameSetup.h"
#include "engine/images/ColorSpace.h"

#include <array>
#include <cstdint>
#include <span>

namespace quarn {

/// How many marked pixels share a packet of rays, and how many rays each has in it.
inline constexpr int pixels_a_packet = 4;
inline constexpr int rays_a_pixel = lane_count / pixels_a_packet;

/// Where a pixel's rays pass, in pixels from its middle.
struct SampleOffset {
    float x;
    float y;
};
using SamplePattern = std::array<SampleOffset, rays_a_pixel>;

/// The sum of some pixels in linear light, each counting as far as it is opaque.
struct LinearSum {
    float channels[3] = {0.0F, 0.0F, 0.0F};
    float opacity = 0.0F;
    int count = 0;

    void add(std::uint32_t pixel, const SrgbTables& srgb);
    std::uint32_t mean(const SrgbTables& srgb) const;
};

/// A marked pixel and what its rays have seen so far.
struct SampledPixel {
    int x = 0;
    int y = 0;
    LinearSum sum;
};

/// Pixels to look at again, four of them in one packet of rays.
class SampleBatch {
public:
    using Colors = std::span<const std::uint32_t, rays_a_pixel>;

    SampleBatch(const FrameSetup& frame, const RayKernel& kernel, const SamplePattern& pattern)
        : m_frame(frame), m_kernel(kernel), m_pattern(pattern) {}

    void add(const SampledPixel& pixel);
    bool isFull() const { return m_count == pixels_a_packet; }

    /// Shoots the rays; then calls take(pixel, colours, objects) for each pixel.
    template <class Take> void shoot(const Take& take) {
        if (m_count == 0)
            return;
        m_kernel.trace_samples(m_frame, m_samples);
        for (int i = 0; i < m_count; ++i)
            take(m_pixels[i], Colors(m_samples.pixels + i * rays_a_pixel, rays_a_pixel),
                 Colors(m_samples.objects + i * rays_a_pixel, rays_a_pixel));
        m_count = 0;
        m_samples.count = 0;
    }

private:
    const FrameSetup& m_frame;
    const RayKernel& m_kernel;
    const SamplePattern& m_pattern;
    int m_count = 0;
    SampledPixel m_pixels[pixels_a_packet];
    SamplePacket m_samples;
};

/// Replaces pixels by the mean, in linear light, of their own colour and of more rays' through
/// them. Lives for one part of one picture, on one thread.
class PixelSmoother {
public:
    /// @param frame  outlives this; its rays must keep no layers
    /// @param twice  four more rays where the first four saw different colours
    PixelSmoother(const FrameSetup& frame, const RayKernel& kernel, bool twice);

    /// @param x, y  of a pixel, which changes at once or when work is finished
    void add(int x, int y);
    void finish();
    /// How many pixels were added.
    std::size_t count() const { return m_count; }

private:
    using Colors = SampleBatch::Colors;

    std::size_t offset(const SampledPixel& pixel) const {
        return static_cast<std::size_t>(pixel.y) * static_cast<std::size_t>(m_frame.width) +
               static_cast<std::size_t>(pixel.x);
    }
    void shootFirst();
    void shootSecond();
    void addAll(LinearSum& sum, const Colors& colors) const;

    const FrameSetup& m_frame;
    const SrgbTables& m_srgb = srgbTables();
    std::size_t m_count = 0;
    bool m_twice;
    int m_threshold;
    SampleBatch m_first;
    SampleBatch m_second;
};

} // namespace quarn
