#include "tests/quarn/Pictures.h"

#include "tests/support/TempFolder.h"

#include <algorithm>
#include <cmath>

namespace quarn::test {

namespace {

int byteAt(const std::string& bytes, std::size_t index) {
    return index < bytes.size() ? static_cast<unsigned char>(bytes[index]) : 0;
}
int bigEndian16(const std::string& bytes, std::size_t index) {
    return byteAt(bytes, index) * 256 + byteAt(bytes, index + 1);
}
int littleEndian16(const std::string& bytes, std::size_t index) {
    return byteAt(bytes, index) + 256 * byteAt(bytes, index + 1);
}
int littleEndian32(const std::string& bytes, std::size_t index) {
    return littleEndian16(bytes, index) + 65536 * littleEndian16(bytes, index + 2);
}

/// ITU T.81: the size stands in the frame segment (SOF0 to SOF2); the file ends with EOI.
std::optional<PictureHeader> readJpeg(const std::string& bytes) {
    if (bytes.substr(bytes.size() - 2) != "\xFF\xD9")
        return std::nullopt;
    for (std::size_t at = 2; at + 9 < bytes.size(); at += 2 + bigEndian16(bytes, at + 2)) {
        const int marker = byteAt(bytes, at + 1);
        if (marker >= 0xC0 && marker <= 0xC2)
            return PictureHeader{"jpg", bigEndian16(bytes, at + 7), bigEndian16(bytes, at + 5)};
    }
    return std::nullopt;
}

} // namespace

std::optional<PictureHeader> readPictureHeader(const std::filesystem::path& file) {
    const std::string bytes = readFile(file);
    if (bytes.starts_with("\xFF\xD8"))
        return readJpeg(bytes);
    if (bytes.starts_with("\x89PNG\r\n\x1A\n") && bytes.substr(bytes.size() - 8, 4) == "IEND")
        return PictureHeader{"png", bigEndian16(bytes, 18), bigEndian16(bytes, 22)};
    if (bytes.starts_with("BM") && littleEndian32(bytes, 2) == static_cast<int>(bytes.size()))
        return PictureHeader{"bmp", littleEndian32(bytes, 18), std::abs(littleEndian32(bytes, 22))};
    const int tga_kind = byteAt(bytes, 2);
    if (byteAt(bytes, 1) == 0 && (tga_kind == 2 || tga_kind == 10) && bytes.size() > 18)
        return PictureHeader{"tga", littleEndian16(bytes, 12), littleEndian16(bytes, 14)};
    return std::nullopt;
}

Picture readBitmap(const std::filesystem::path& file) {
    const std::string bytes = readFile(file);
    if (!bytes.starts_with("BM") || littleEndian16(bytes, 28) != 24)
        return {};
    Picture picture{littleEndian32(bytes, 18), std::abs(littleEndian32(bytes, 22)), {}};
    const std::size_t start = static_cast<std::size_t>(littleEndian32(bytes, 10));
    const std::size_t used = static_cast<std::size_t>(picture.width_px) * 3;
    const std::size_t row = (used + 3) / 4 * 4;
    for (int y = 0; y < picture.height_px; ++y)
        for (std::size_t x = 0; x < used; ++x)
            picture.bytes.push_back(static_cast<std::uint8_t>(
                byteAt(bytes, start + static_cast<std::size_t>(y) * row + x)));
    return picture;
}

double meanDifference(const Picture& a, const Picture& b) {
    if (a.bytes.size() != b.bytes.size() || a.bytes.empty())
        return 1.0;
    double sum = 0.0;
    for (std::size_t i = 0; i < a.bytes.size(); ++i)
        sum += std::abs(a.bytes[i] - b.bytes[i]);
    return sum / (255.0 * static_cast<double>(a.bytes.size()));
}

std::vector<std::string> filesIn(const std::filesystem::path& folder) {
    std::vector<std::string> names;
    for (const auto& entry : std::filesystem::directory_iterator(folder))
        names.push_back(entry.path().filename().string());
    std::sort(names.begin(), names.end());
    return names;
}

} // namespace quarn::test
