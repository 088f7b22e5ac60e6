#include "import/environment/RadiancePicture.h"

#include <algorithm>
#include <cstring>
#include <iterator>
#include <memory>
#include <string>

#define STB_IMAGE_STATIC
#define STB_IMAGE_IMPLEMENTATION
#define STBI_NO_STDIO
#define STBI_ONLY_HDR
#include <stb_image.h>

namespace quarn {

namespace {

constexpr const char* CUT_OFF = "it is cut off";

struct FreePixels {
    void operator()(float* pixels) const { stbi_image_free(pixels); }
};

/// Hands a file to the library and notes when it asks for more than there is. Behind its end the
/// library would go on with zeros, and never come to the end of a row that is cut off. Line feeds
/// end it: they close a head, and among pixels they are runs of ten.
class CheckedBytes {
public:
    explicit CheckedBytes(std::span<const std::uint8_t> bytes) : m_bytes(bytes) {}

    bool isCutOff() const { return m_is_cut_off; }

    static stbi_io_callbacks callbacks() { return {read, skip, isAtEnd}; }

private:
    static int read(void* self, char* to, int size) {
        return static_cast<CheckedBytes*>(self)->read(to, size);
    }
    static void skip(void* self, int count) {
        auto& bytes = *static_cast<CheckedBytes*>(self);
        const auto wanted = static_cast<std::size_t>(std::max(0, count));
        bytes.m_bytes = bytes.m_bytes.subspan(std::min(wanted, bytes.m_bytes.size()));
    }
    static int isAtEnd(void* self) { return static_cast<CheckedBytes*>(self)->m_bytes.empty(); }

    /// A buffer may be filled in part; a pixel of up to four bytes is asked for at once.
    int read(char* to, int size) {
        constexpr int PIXEL_BYTES = 4;
        const auto wanted = static_cast<std::size_t>(size);
        const std::size_t given = std::min(wanted, m_bytes.size());
        std::memcpy(to, m_bytes.data(), given);
        m_bytes = m_bytes.subspan(given);
        if (given > 0 && (given == wanted || size > PIXEL_BYTES))
            return static_cast<int>(given);
        m_is_cut_off = true;
        std::memset(to + given, '\n', wanted - given);
        return size;
    }

    std::span<const std::uint8_t> m_bytes;
    bool m_is_cut_off = false;
};

struct Size {
    int width = 0;
    int height = 0;
};

/// The fewest bytes that the pixels of a picture can be packed into: runs of 127, two bytes for
/// each of the four channels, behind the four bytes that begin a row.
std::int64_t leastBytes(const Size& size) {
    constexpr std::int64_t longest_run = 127;
    const std::int64_t runs = (size.width + longest_run - 1) / longest_run;
    const bool is_packed = size.width >= 8 && size.width < 32768;
    return size.height * (is_packed ? 4 + 8 * runs : std::int64_t{4} * size.width);
}

Result<Size> sizeOf(std::span<const std::uint8_t> bytes, std::int64_t most_pixels) {
    CheckedBytes file(bytes);
    const stbi_io_callbacks callbacks = CheckedBytes::callbacks();
    Size size;
    if (bytes.empty() ||
        stbi_info_from_callbacks(&callbacks, &file, &size.width, &size.height, nullptr) == 0)
        return Error{"it is no Radiance picture with its first row on top"};
    if (size.width < 1 || size.height < 1)
        return Error{"it has no pixels"};
    if (std::int64_t{size.width} * size.height > most_pixels)
        return Error{"it has " + std::to_string(size.width) + " by " + std::to_string(size.height) +
                     " pixels, and at most " + std::to_string(most_pixels) +
                     " are taken, such as 8192 by 4096"};
    if (std::ssize(bytes) < leastBytes(size))
        return Error{CUT_OFF};
    return size;
}

} // namespace

Result<EnvironmentPicture> decodeRadiance(std::span<const std::uint8_t> bytes,
                                          std::int64_t most_pixels) {
    const auto size = sizeOf(bytes, most_pixels);
    if (!size)
        return size.error();
    constexpr int CHANNELS = 3;
    CheckedBytes file(bytes);
    const stbi_io_callbacks callbacks = CheckedBytes::callbacks();
    EnvironmentPicture picture;
    const std::unique_ptr<float, FreePixels> pixels(stbi_loadf_from_callbacks(
        &callbacks, &file, &picture.width, &picture.height, nullptr, CHANNELS));
    if (file.isCutOff())
        return Error{CUT_OFF};
    if (pixels == nullptr || picture.width != size.value().width ||
        picture.height != size.value().height)
        return Error{"it is damaged"};
    const std::size_t count = std::size_t{CHANNELS} * static_cast<std::size_t>(picture.width) *
                              static_cast<std::size_t>(picture.height);
    picture.rgb.assign(pixels.get(), pixels.get() + count);
    return picture;
}

} // namespace quarn
