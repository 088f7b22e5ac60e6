#include "engine/display/PixelSmoother.h"

#include "engine/display/SurfaceLook.h"

#include <algorithm>
#include <cstdlib>

namespace quarn {

namespace {

/// Turned grids: no two samples share a row or a column, within a pattern and between the outer and
/// the inner one. The outer one finds what crosses a pixel.
constexpr SamplePattern only_samples{
    {{-0.125F, -0.375F}, {0.375F, -0.125F}, {0.125F, 0.375F}, {-0.375F, 0.125F}}};
constexpr SamplePattern outer_samples{
    {{-0.4375F, -0.0625F}, {0.4375F, -0.4375F}, {0.1875F, 0.4375F}, {-0.3125F, 0.3125F}}};
constexpr SamplePattern inner_samples{
    {{0.0625F, -0.1875F}, {-0.0625F, 0.1875F}, {0.3125F, 0.0625F}, {-0.1875F, -0.3125F}}};

/// How much the first rays of a pixel must differ, in steps of 255, for it to be worth more rays.
/// Where surfaces let others through, steps are soft and rays dear; so they are within one mirror.
constexpr int pixel_threshold = 12;
constexpr int layered_pixel_threshold = 40;
constexpr int mirror_threshold = 40;

std::uint8_t channel(std::uint32_t pixel, int index) {
    return static_cast<std::uint8_t>(pixel >> (8 * index));
}

/// A single ray may slip through between two triangles. All others agreeing on another object,
/// it is left out.
bool centerIsOutlier(std::uint32_t center_object, std::span<const std::uint32_t> objects) {
    return objects.front() != center_object &&
           std::all_of(objects.begin(), objects.end(),
                       [&](std::uint32_t object) { return object == objects.front(); });
}

/// Whether something crosses the pixel that more rays would draw better.
bool isVaried(std::uint32_t center, const SampleBatch::Colors& colors, int threshold) {
    for (int c = 0; c < 4; ++c)
        for (const std::uint32_t color : colors)
            if (std::abs(channel(color, c) - channel(center, c)) > threshold)
                return true;
    return false;
}

/// Whether all rays of a pixel met one surface, which mirrors the scene.
bool isWithinMirror(const FrameSetup& frame, std::uint32_t center_object,
                    std::span<const std::uint32_t> objects) {
    if (!frame.mirrors_scene || center_object == 0)
        return false;
    const SurfaceLook* const look = frame.surfaces[center_object - 1].look;
    return look && look->shows_scene &&
           std::all_of(objects.begin(), objects.end(),
                       [&](std::uint32_t object) { return object == center_object; });
}

} // namespace

void LinearSum::add(std::uint32_t pixel, const SrgbTables& srgb) {
    const float part = static_cast<float>(channel(pixel, 3)) / 255.0F;
    for (int c = 0; c < 3; ++c)
        channels[c] += part * srgb.linear(channel(pixel, c));
    opacity += part;
    ++count;
}

std::uint32_t LinearSum::mean(const SrgbTables& srgb) const {
    if (opacity <= 0.0F)
        return 0;
    const float part = opacity / static_cast<float>(count);
    std::uint32_t pixel = static_cast<std::uint32_t>(255.0F * part + 0.5F) << 24;
    for (int c = 0; c < 3; ++c) {
        const float linear = std::min(channels[c] / opacity, 1.0F);
        pixel |= static_cast<std::uint32_t>(srgb.byte(linear)) << (8 * c);
    }
    return pixel;
}

void SampleBatch::add(const SampledPixel& pixel) {
    m_pixels[m_count++] = pixel;
    const float x = static_cast<float>(pixel.x) + 0.5F;
    const float y = static_cast<float>(pixel.y) + 0.5F;
    for (const SampleOffset& offset : m_pattern) {
        m_samples.x[m_samples.count] = x + offset.x;
        m_samples.y[m_samples.count] = y + offset.y;
        ++m_samples.count;
    }
}

PixelSmoother::PixelSmoother(const FrameSetup& frame, const RayKernel& kernel, bool twice)
    : m_frame(frame), m_twice(twice),
      m_threshold(frame.layers.count > 1 ? layered_pixel_threshold : pixel_threshold),
      m_first(frame, kernel, twice ? outer_samples : only_samples),
      m_second(frame, kernel, inner_samples) {}

void PixelSmoother::add(int x, int y) {
    ++m_count;
    m_first.add({x, y, {}});
    if (m_first.isFull())
        shootFirst();
}

void PixelSmoother::finish() {
    shootFirst();
    shootSecond();
}

void PixelSmoother::shootFirst() {
    m_first.shoot([&](SampledPixel& pixel, const Colors& colors, const Colors& objects) {
        std::uint32_t& center = m_frame.pixels[offset(pixel)];
        const std::uint32_t object = m_frame.objects[offset(pixel)];
        const bool outlier = centerIsOutlier(object, objects);
        const int threshold =
            isWithinMirror(m_frame, object, objects) ? mirror_threshold : m_threshold;
        const bool varied = m_twice && (outlier || isVaried(center, colors, threshold));
        if (!outlier)
            pixel.sum.add(center, m_srgb);
        addAll(pixel.sum, colors);
        if (!varied) {
            center = pixel.sum.mean(m_srgb);
            return;
        }
        m_second.add(pixel);
        if (m_second.isFull())
            shootSecond();
    });
}

void PixelSmoother::shootSecond() {
    m_second.shoot([&](SampledPixel& pixel, const Colors& colors, const Colors&) {
        addAll(pixel.sum, colors);
        m_frame.pixels[offset(pixel)] = pixel.sum.mean(m_srgb);
    });
}

void PixelSmoother::addAll(LinearSum& sum, const Colors& colors) const {
    for (const std::uint32_t color : colors)
        sum.add(color, m_srgb);
}

} // namespace quarn
