#include "host/display/EdgePixels.h"

#include "host/display/ColorSpace.h"
#include "host/display/FlushDenormals.h"

#include <tbb/parallel_for.h>

#include <emmintrin.h>

#include <algorithm>
#include <array>
#include <cstdlib>
#include <span>

namespace quarn {

namespace {

constexpr int band_height = 8;
/// Edge pixels are visited in cells of this width and a band's height, so that those which travel
/// together lie near each other.
constexpr std::size_t cell_width = 16;
/// How many pixels share a packet, and how many rays each has in it.
constexpr int pixels_a_packet = 4;
constexpr int rays_a_pixel = lane_count / pixels_a_packet;

struct Offset {
    float x;
    float y;
};
using Pattern = std::array<Offset, rays_a_pixel>;

/// Turned grids, in pixels from the pixel's middle: no two samples share a row or a column, within
/// a pattern and between the outer and the inner one. The outer one finds what crosses a pixel.
constexpr Pattern only_samples{
    {{-0.125F, -0.375F}, {0.375F, -0.125F}, {0.125F, 0.375F}, {-0.375F, 0.125F}}};
constexpr Pattern outer_samples{
    {{-0.4375F, -0.0625F}, {0.4375F, -0.4375F}, {0.1875F, 0.4375F}, {-0.3125F, 0.3125F}}};
constexpr Pattern inner_samples{
    {{0.0625F, -0.1875F}, {-0.0625F, 0.1875F}, {0.3125F, 0.0625F}, {-0.1875F, -0.3125F}}};

std::uint8_t channel(std::uint32_t pixel, int index) {
    return static_cast<std::uint8_t>(pixel >> (8 * index));
}

/// A row of the picture.
struct EdgeRow {
    const std::uint32_t* pixels;
    const std::uint32_t* objects;
};

/// How much the first rays of a pixel must differ, in steps of 255, for it to be worth more rays.
constexpr int pixel_threshold = 12;

/// The sum of some pixels in linear light.
struct LinearSum {
    float channels[3] = {0.0F, 0.0F, 0.0F};
    int count = 0;

    void add(std::uint32_t pixel, const SrgbTables& srgb) {
        for (int c = 0; c < 3; ++c)
            channels[c] += srgb.linear(channel(pixel, c));
        ++count;
    }
    std::uint32_t mean(const SrgbTables& srgb) const {
        std::uint32_t pixel = 0xFF000000U;
        for (int c = 0; c < 3; ++c) {
            const float linear = channels[c] / static_cast<float>(count);
            pixel |= static_cast<std::uint32_t>(srgb.byte(linear)) << (8 * c);
        }
        return pixel;
    }
};

/// Four pixels at a time.
__m128i loadFour(const std::uint32_t* from) {
    return _mm_loadu_si128(reinterpret_cast<const __m128i*>(from));
}

/// All bits set in each of four pixels that differ visibly from the other four.
__m128i stepsOfFour(const EdgeRow& row, const EdgeRow& other, std::size_t at) {
    const __m128i a = loadFour(row.pixels + at);
    const __m128i b = loadFour(other.pixels + at);
    const __m128i difference = _mm_or_si128(_mm_subs_epu8(a, b), _mm_subs_epu8(b, a));
    const __m128i beyond = _mm_subs_epu8(difference, _mm_set1_epi8(EdgePixels::color_threshold));
    const __m128i objects = _mm_xor_si128(loadFour(row.objects + at), loadFour(other.objects + at));
    const __m128i same = _mm_cmpeq_epi32(_mm_or_si128(beyond, objects), _mm_setzero_si128());
    return _mm_xor_si128(same, _mm_set1_epi32(-1));
}

bool differs(const EdgeRow& row, const EdgeRow& other, std::size_t at) {
    bool step = row.objects[at] != other.objects[at];
    for (int c = 0; c < 4; ++c)
        step |= std::abs(channel(row.pixels[at], c) - channel(other.pixels[at], c)) >
                EdgePixels::color_threshold;
    return step;
}

/// Marks the pixels of a row that differ visibly from those of another one.
/// @param other_marks  those of the other row; null when it has none
void markSteps(const EdgeRow& row, const EdgeRow& other, std::size_t count, std::uint8_t* marks,
               std::uint8_t* other_marks) {
    const auto mark = [&](std::size_t at) {
        marks[at] = 1;
        if (other_marks)
            other_marks[at] = 1;
    };
    std::size_t at = 0;
    for (; at + 4 <= count; at += 4) {
        int found = _mm_movemask_ps(_mm_castsi128_ps(stepsOfFour(row, other, at)));
        for (; found != 0; found &= found - 1)
            mark(at + static_cast<std::size_t>(__builtin_ctz(static_cast<unsigned>(found))));
    }
    for (; at < count; ++at)
        if (differs(row, other, at))
            mark(at);
}

/// A single ray may slip through between two triangles. All others agreeing on another object,
/// it is left out.
bool centerIsOutlier(std::uint32_t center_object, std::span<const std::uint32_t> objects) {
    return objects.front() != center_object &&
           std::all_of(objects.begin(), objects.end(),
                       [&](std::uint32_t object) { return object == objects.front(); });
}

/// An edge pixel and what its rays have seen so far.
struct SampledPixel {
    std::uint32_t place = 0;
    LinearSum sum;
};

/// Looks at pixels again, four of them in one packet of rays.
class SampleBatch {
public:
    SampleBatch(const FrameSetup& frame, const RayKernel& kernel, const Pattern& pattern)
        : m_frame(frame), m_kernel(kernel), m_pattern(pattern) {}

    void add(const SampledPixel& pixel) {
        m_pixels[m_count++] = pixel;
        const auto width = static_cast<std::uint32_t>(m_frame.width);
        for (const Offset& offset : m_pattern) {
            m_samples.x[m_samples.count] =
                static_cast<float>(pixel.place % width) + 0.5F + offset.x;
            m_samples.y[m_samples.count] =
                static_cast<float>(pixel.place / width) + 0.5F + offset.y;
            ++m_samples.count;
        }
    }
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
    using Colors = std::span<const std::uint32_t, rays_a_pixel>;

private:
    const FrameSetup& m_frame;
    const RayKernel& m_kernel;
    const Pattern& m_pattern;
    int m_count = 0;
    SampledPixel m_pixels[pixels_a_packet];
    SamplePacket m_samples;
};

/// Smooths the edge pixels of one band.
class BandSmoother {
public:
    BandSmoother(const FrameSetup& frame, const RayKernel& kernel, bool twice)
        : m_frame(frame), m_twice(twice),
          m_first(frame, kernel, twice ? outer_samples : only_samples),
          m_second(frame, kernel, inner_samples) {}

    void add(std::uint32_t place) {
        m_first.add({place, {}});
        if (m_first.isFull())
            shootFirst();
    }
    void finish() {
        shootFirst();
        shootSecond();
    }

private:
    using Colors = SampleBatch::Colors;

    void shootFirst() {
        m_first.shoot([&](SampledPixel& pixel, const Colors& colors, const Colors& objects) {
            std::uint32_t& center = m_frame.pixels[pixel.place];
            const bool outlier = centerIsOutlier(m_frame.objects[pixel.place], objects);
            const bool varied = m_twice && (outlier || isVaried(center, colors));
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
    void shootSecond() {
        m_second.shoot([&](SampledPixel& pixel, const Colors& colors, const Colors&) {
            addAll(pixel.sum, colors);
            m_frame.pixels[pixel.place] = pixel.sum.mean(m_srgb);
        });
    }

    void addAll(LinearSum& sum, const Colors& colors) const {
        for (const std::uint32_t color : colors)
            sum.add(color, m_srgb);
    }

    /// Whether something crosses the pixel that more rays would draw better.
    static bool isVaried(std::uint32_t center, const Colors& colors) {
        for (int c = 0; c < 3; ++c)
            for (const std::uint32_t color : colors)
                if (std::abs(channel(color, c) - channel(center, c)) > pixel_threshold)
                    return true;
        return false;
    }

    const FrameSetup& m_frame;
    const SrgbTables& m_srgb = srgbTables();
    bool m_twice;
    SampleBatch m_first;
    SampleBatch m_second;
};

EdgeRow rowOf(const FrameSetup& frame, int row) {
    const std::size_t start = static_cast<std::size_t>(row) * static_cast<std::size_t>(frame.width);
    return {frame.pixels + start, frame.objects + start};
}

} // namespace

void EdgePixels::findBand(const FrameSetup& frame, int first_row, Band& band) {
    const auto width = static_cast<std::size_t>(frame.width);
    const int end = std::min(frame.height, first_row + band_height);
    const auto rows = static_cast<std::size_t>(end - first_row);
    band.marks.assign(rows * width, 0);
    for (int y = first_row; y < end; ++y) {
        const EdgeRow row = rowOf(frame, y);
        std::uint8_t* const marks =
            band.marks.data() + static_cast<std::size_t>(y - first_row) * width;
        markSteps(row, {row.pixels + 1, row.objects + 1}, width - 1, marks, marks + 1);
        if (y == first_row && y > 0)
            markSteps(row, rowOf(frame, y - 1), width, marks, nullptr);
        if (y + 1 < frame.height)
            markSteps(row, rowOf(frame, y + 1), width, marks,
                      y + 1 < end ? marks + width : nullptr);
    }
    band.pixels.clear();
    for (std::size_t left = 0; left < width; left += cell_width)
        for (std::size_t y = 0; y < rows; ++y)
            for (std::size_t x = left; x < std::min(width, left + cell_width); ++x)
                if (band.marks[y * width + x])
                    band.pixels.push_back(static_cast<std::uint32_t>(
                        (static_cast<std::size_t>(first_row) + y) * width + x));
}

void EdgePixels::refine(const FrameSetup& frame, const RayKernel& kernel, int rays_per_pixel) {
    const int band_count = (frame.height + band_height - 1) / band_height;
    m_bands.resize(static_cast<std::size_t>(band_count));
    // All edges are found before the first is smoothed: bands look at each other's pixels.
    tbb::parallel_for(0, band_count, [&](int index) {
        findBand(frame, index * band_height, m_bands[static_cast<std::size_t>(index)]);
    });
    tbb::parallel_for(0, band_count, [&](int index) {
        const FlushDenormals flush;
        BandSmoother smoother(frame, kernel, rays_per_pixel > rays_a_pixel);
        for (const std::uint32_t pixel : m_bands[static_cast<std::size_t>(index)].pixels)
            smoother.add(pixel);
        smoother.finish();
    });
}

std::size_t EdgePixels::count() const {
    std::size_t total = 0;
    for (const auto& band : m_bands)
        total += band.pixels.size();
    return total;
}

} // namespace quarn
