#include "host/display/EdgePixels.h"

#include "host/display/ColorSpace.h"
#include "host/display/FlushDenormals.h"

#include <tbb/parallel_for.h>

#include <algorithm>
#include <span>

namespace quarn {

namespace {

constexpr int band_height = 8;

struct Offset {
    float x;
    float y;
};

/// Turned grids, in pixels from the pixel's middle: no two samples share a row or a column.
constexpr Offset four_samples[] = {
    {-0.125F, -0.375F}, {0.375F, -0.125F}, {0.125F, 0.375F}, {-0.375F, 0.125F}};
constexpr Offset eight_samples[] = {{0.0625F, -0.1875F},  {-0.0625F, 0.1875F}, {0.3125F, 0.0625F},
                                    {-0.1875F, -0.3125F}, {-0.3125F, 0.3125F}, {-0.4375F, -0.0625F},
                                    {0.1875F, 0.4375F},   {0.4375F, -0.4375F}};

std::span<const Offset> samplePattern(int rays_per_pixel) {
    return rays_per_pixel > 4 ? std::span<const Offset>(eight_samples)
                              : std::span<const Offset>(four_samples);
}

std::uint8_t channel(std::uint32_t pixel, int index) {
    return static_cast<std::uint8_t>(pixel >> (8 * index));
}

/// The sum of some pixels in linear light.
struct LinearSum {
    float channels[3] = {0.0F, 0.0F, 0.0F};
    int count = 0;

    void add(std::uint32_t pixel) {
        for (int c = 0; c < 3; ++c)
            channels[c] += linearFromSrgbByte(channel(pixel, c));
        ++count;
    }
    std::uint32_t mean() const {
        std::uint32_t pixel = 0xFF000000U;
        for (int c = 0; c < 3; ++c) {
            const float linear = channels[c] / static_cast<float>(count);
            pixel |= static_cast<std::uint32_t>(srgbByteFromLinear(linear)) << (8 * c);
        }
        return pixel;
    }
};

/// Marks the pixels of one row that differ visibly from those of another. Colours are compared
/// byte by byte, which the compiler turns into vectors.
void markSteps(const std::uint32_t* pixels, const std::uint32_t* other,
               const std::uint32_t* objects, const std::uint32_t* other_objects, std::size_t count,
               std::uint32_t* marks) {
    const auto* const a = reinterpret_cast<const std::uint8_t*>(pixels);
    const auto* const b = reinterpret_cast<const std::uint8_t*>(other);
    auto* const mark = reinterpret_cast<std::uint8_t*>(marks);
    for (std::size_t i = 0; i < 4 * count; ++i) {
        const std::uint8_t larger = std::max(a[i], b[i]);
        const std::uint8_t smaller = std::min(a[i], b[i]);
        const auto step = static_cast<std::uint8_t>(larger - smaller);
        mark[i] |= step > EdgePixels::color_threshold ? std::uint8_t{1} : std::uint8_t{0};
    }
    for (std::size_t i = 0; i < count; ++i)
        marks[i] |= objects[i] ^ other_objects[i];
}

/// A single ray may slip through between two triangles. All others agreeing on another object,
/// it is left out.
bool centerIsOutlier(std::uint32_t center_object, std::span<const std::uint32_t> objects) {
    return objects.front() != center_object &&
           std::all_of(objects.begin(), objects.end(),
                       [&](std::uint32_t object) { return object == objects.front(); });
}

/// The pixels whose samples travel in one packet.
class SampleBatch {
public:
    SampleBatch(const FrameSetup& frame, const RayKernel& kernel, std::span<const Offset> pattern)
        : m_frame(frame), m_kernel(kernel), m_pattern(pattern),
          m_capacity(lane_count / static_cast<int>(pattern.size())) {}

    void add(std::uint32_t pixel) {
        m_pixels[m_count++] = pixel;
        const auto width = static_cast<std::uint32_t>(m_frame.width);
        for (const Offset& offset : m_pattern) {
            m_samples.x[m_samples.count] = static_cast<float>(pixel % width) + 0.5F + offset.x;
            m_samples.y[m_samples.count] = static_cast<float>(pixel / width) + 0.5F + offset.y;
            ++m_samples.count;
        }
        if (m_count == m_capacity)
            finish();
    }

    void finish() {
        if (m_count == 0)
            return;
        m_kernel.trace_samples(m_frame, m_samples);
        for (int i = 0; i < m_count; ++i)
            average(i);
        m_count = 0;
        m_samples.count = 0;
    }

private:
    void average(int index) {
        const std::size_t first = static_cast<std::size_t>(index) * m_pattern.size();
        const std::span<const std::uint32_t> objects(m_samples.objects + first, m_pattern.size());
        std::uint32_t& pixel = m_frame.pixels[m_pixels[index]];
        LinearSum sum;
        if (!centerIsOutlier(m_frame.objects[m_pixels[index]], objects))
            sum.add(pixel);
        for (std::size_t i = 0; i < m_pattern.size(); ++i)
            sum.add(m_samples.pixels[first + i]);
        pixel = sum.mean();
    }

    const FrameSetup& m_frame;
    const RayKernel& m_kernel;
    std::span<const Offset> m_pattern;
    int m_capacity;
    int m_count = 0;
    std::uint32_t m_pixels[lane_count] = {};
    SamplePacket m_samples;
};

} // namespace

void EdgePixels::findRow(const FrameSetup& frame, int row, Band& band) {
    const auto width = static_cast<std::size_t>(frame.width);
    const std::size_t start = static_cast<std::size_t>(row) * width;
    const std::uint32_t* const pixels = frame.pixels + start;
    const std::uint32_t* const objects = frame.objects + start;
    band.marks.assign(width, 0);
    std::uint32_t* const marks = band.marks.data();
    markSteps(pixels, pixels + 1, objects, objects + 1, width - 1, marks);
    markSteps(pixels + 1, pixels, objects + 1, objects, width - 1, marks + 1);
    if (row > 0)
        markSteps(pixels, pixels - width, objects, objects - width, width, marks);
    if (row + 1 < frame.height)
        markSteps(pixels, pixels + width, objects, objects + width, width, marks);
    for (std::size_t x = 0; x < width; ++x)
        if (marks[x])
            band.pixels.push_back(static_cast<std::uint32_t>(start + x));
}

void EdgePixels::refine(const FrameSetup& frame, const RayKernel& kernel, int rays_per_pixel) {
    const int band_count = (frame.height + band_height - 1) / band_height;
    m_bands.resize(static_cast<std::size_t>(band_count));
    // All edges are found before the first is smoothed: bands look at each other's pixels.
    tbb::parallel_for(0, band_count, [&](int index) {
        Band& band = m_bands[static_cast<std::size_t>(index)];
        band.pixels.clear();
        const int end = std::min(frame.height, (index + 1) * band_height);
        for (int row = index * band_height; row < end; ++row)
            findRow(frame, row, band);
    });
    tbb::parallel_for(0, band_count, [&](int index) {
        const FlushDenormals flush;
        SampleBatch batch(frame, kernel, samplePattern(rays_per_pixel));
        for (const std::uint32_t pixel : m_bands[static_cast<std::size_t>(index)].pixels)
            batch.add(pixel);
        batch.finish();
    });
}

std::size_t EdgePixels::count() const {
    std::size_t total = 0;
    for (const auto& band : m_bands)
        total += band.pixels.size();
    return total;
}

} // namespace quarn
