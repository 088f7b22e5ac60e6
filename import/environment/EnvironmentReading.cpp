#include "import/environment/EnvironmentReading.h"

#include "ground/FileBytes.h"
#include "ground/PathText.h"
#include "import/environment/RadiancePicture.h"

#include <algorithm>
#include <cmath>
#include <new>

namespace quarn {

namespace {

constexpr float BRIGHTEST = 1e6F;
/// Four bytes a pixel where nothing is compressed, and a head.
constexpr std::size_t MOST_BYTES = 4 * static_cast<std::size_t>(MOST_ENVIRONMENT_PIXELS) + 65536;

using Pixel = std::span<float, 3>;

/// @return whether the pixel was another one before
bool makeDrawable(Pixel pixel) {
    bool is_moved = false;
    for (float& channel : pixel)
        if (!(channel >= 0.0F)) {
            channel = 0.0F;
            is_moved = true;
        }
    const float most = std::max({pixel[0], pixel[1], pixel[2]});
    if (most <= BRIGHTEST)
        return is_moved;
    for (float& channel : pixel)
        channel = std::isinf(channel) ? BRIGHTEST : channel / most * BRIGHTEST;
    return true;
}

} // namespace

Result<EnvironmentReading> decodeEnvironment(std::span<const std::uint8_t> bytes) {
    try {
        auto picture = decodeRadiance(bytes, MOST_ENVIRONMENT_PIXELS);
        if (!picture)
            return picture.error();
        EnvironmentReading reading{std::move(picture.value())};
        std::vector<float>& rgb = reading.picture.rgb;
        for (std::size_t i = 0; i < rgb.size(); i += 3)
            reading.moved_pixels += makeDrawable(Pixel(&rgb[i], 3)) ? 1 : 0;
        return reading;
    } catch (const std::bad_alloc&) {
        return Error{"there is too little memory"};
    }
}

Result<EnvironmentReading> readEnvironment(const std::filesystem::path& file) {
    const auto refused = [&](const std::string& why) {
        return Error{"Cannot read the picture " + textFromPath(file).ToUtf8() + ": " + why +
                     ". Give a Radiance picture, a file that ends in .hdr, that is whole."};
    };
    const auto bytes = readFileBytes(file, MOST_BYTES);
    if (!bytes)
        return refused(bytes.message());
    auto reading = decodeEnvironment(bytes.value().bytes());
    return reading ? std::move(reading) : refused(reading.message());
}

} // namespace quarn
