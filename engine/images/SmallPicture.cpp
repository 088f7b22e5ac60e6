#include "engine/images/SmallPicture.h"

#include <algorithm>
#include <array>
#include <cstdint>
#include <vector>

namespace quarn {

namespace {

/// Pixels of the large picture that are looked at in each direction for one of the small picture.
constexpr std::size_t SAMPLES = 3;
using Samples = std::array<std::size_t, SAMPLES>;

/// For each pixel of a small side those of the large one that it is made of.
std::vector<Samples> samplesOf(int large_px, int small_px) {
    std::vector<Samples> samples(static_cast<std::size_t>(small_px));
    const auto parts = static_cast<std::int64_t>(2 * SAMPLES) * small_px;
    for (std::size_t pixel = 0; pixel < samples.size(); ++pixel)
        for (std::size_t i = 0; i < SAMPLES; ++i) {
            const auto middle = static_cast<std::int64_t>(2 * (SAMPLES * pixel + i) + 1);
            samples[pixel][i] = static_cast<std::size_t>(middle * large_px / parts);
        }
    return samples;
}

int smallSide(int side_px, int longest_px, int most_px) {
    return std::max(1, static_cast<int>(std::int64_t{side_px} * most_px / longest_px));
}

std::array<std::uint8_t, 4> meanOf(const ImageView& picture, const Samples& rows,
                                   const Samples& columns) {
    constexpr unsigned count = SAMPLES * SAMPLES;
    std::array<unsigned, 4> sum{};
    for (const std::size_t row : rows)
        for (const std::size_t column : columns) {
            const std::size_t pixel = row * static_cast<std::size_t>(picture.width) + column;
            for (std::size_t i = 0; i < sum.size(); ++i)
                sum[i] += picture.rgba[4 * pixel + i];
        }
    std::array<std::uint8_t, 4> mean{};
    for (std::size_t i = 0; i < sum.size(); ++i)
        mean[i] = static_cast<std::uint8_t>((sum[i] + count / 2) / count);
    return mean;
}

} // namespace

Image smallPicture(const ImageView& picture, int most_px) {
    Image small;
    const int longest_px = std::max(picture.width, picture.height);
    if (picture.width < 1 || picture.height < 1)
        return small;
    if (longest_px <= most_px) {
        small.width = picture.width;
        small.height = picture.height;
        small.rgba.assign(picture.rgba.begin(), picture.rgba.end());
        return small;
    }
    small.resize(smallSide(picture.width, longest_px, most_px),
                 smallSide(picture.height, longest_px, most_px));
    const std::vector<Samples> columns = samplesOf(picture.width, small.width);
    auto out = small.rgba.begin();
    for (const Samples& rows : samplesOf(picture.height, small.height))
        for (const Samples& column : columns)
            out = std::ranges::copy(meanOf(picture, rows, column), out).out;
    return small;
}

} // namespace quarn
