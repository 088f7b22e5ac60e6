#include "host/share/viewer/PagePictures.h"

#include "engine/images/ImageFile.h"
#include "engine/images/Opacity.h"
#include "ground/FileBytes.h"
#include "ground/PathText.h"
#include "host/share/frames/FramePicture.h"

#include <algorithm>
#include <array>
#include <fstream>
#include <string_view>

namespace quarn {

namespace {

constexpr int COARSEST_STEP = 8;
constexpr int FIRST_PASS = 64;
constexpr std::size_t ENDS = 12; // bytes of a file's head and end that are looked at

using namespace std::string_view_literals;
constexpr std::string_view JPEG_HEAD = "\xFF\xD8"sv;
constexpr std::string_view JPEG_END = "\xFF\xD9"sv;
constexpr std::string_view PNG_HEAD = "\x89PNG\r\n\x1A\n"sv;
constexpr std::string_view PNG_END = "\0\0\0\0IEND\xAE\x42\x60\x82"sv;

std::optional<ImageFormat> formatOf(const std::filesystem::path& file) {
    return imageFormatFor(file.extension().string());
}

} // namespace

std::vector<int> coarseToFine(int frames) {
    int step = COARSEST_STEP;
    while (frames > FIRST_PASS * step)
        step *= 2;
    std::vector<int> order;
    for (int frame = 0; frame < frames; frame += step)
        order.push_back(frame);
    for (; step > 1; step /= 2)
        for (int frame = step / 2; frame < frames; frame += step)
            order.push_back(frame);
    return order;
}

bool isShownByBrowsers(const std::string& extension) {
    return imageFormatFor(extension) != ImageFormat::tga;
}

bool isWholePicture(const std::filesystem::path& file) {
    std::ifstream stream(file, std::ios::binary);
    std::array<char, ENDS> head{};
    std::array<char, ENDS> end{};
    stream.read(head.data(), ENDS);
    stream.seekg(-static_cast<std::streamoff>(ENDS), std::ios::end);
    stream.read(end.data(), ENDS);
    if (!stream)
        return false;
    const std::string_view begins(head.data(), ENDS);
    const std::string_view ends(end.data(), ENDS);
    const auto format = formatOf(file);
    if (format == ImageFormat::jpeg)
        return begins.starts_with(JPEG_HEAD) && ends.ends_with(JPEG_END);
    if (format == ImageFormat::png)
        return begins.starts_with(PNG_HEAD) && ends.ends_with(PNG_END);
    return true;
}

Result<std::vector<std::byte>> framesJpeg(const std::filesystem::path& file) {
    if (formatOf(file) == ImageFormat::jpeg) {
        const Result<FileBytes> bytes = readFileBytes(file);
        if (!bytes)
            return Error{"Cannot read the frame " + textFromPath(file).ToUtf8() + ": " +
                         bytes.message() + '.'};
        const auto span = std::as_bytes(bytes.value().bytes());
        return std::vector<std::byte>(span.begin(), span.end());
    }
    const Result<Image> picture = readFramePicture(file);
    if (!picture)
        return picture.error();
    Image on_white;
    return encodeImage(onWhite(picture.value(), on_white), ImageFormat::jpeg);
}

} // namespace quarn
