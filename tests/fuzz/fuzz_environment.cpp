// Pictures of surroundings: any bytes are a picture or are refused, and all numbers of a picture
// can be drawn with.
#include "import/environment/EnvironmentReading.h"

#include <cstdlib>

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size) {
    const auto reading = quarn::decodeEnvironment({bytes, size});
    if (!reading)
        return 0;
    const quarn::EnvironmentPicture& picture = reading.value().picture;
    const auto pixels =
        static_cast<std::size_t>(picture.width) * static_cast<std::size_t>(picture.height);
    if (picture.rgb.size() != 3 * pixels ||
        pixels > static_cast<std::size_t>(quarn::MOST_ENVIRONMENT_PIXELS))
        std::abort();
    for (const float number : picture.rgb)
        if (!(number >= 0.0F && number <= 1e6F))
            std::abort();
    return 0;
}
