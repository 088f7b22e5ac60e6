#include "import/library/Utf16Text.h"

#include "import/files/ModelFileCheck.h"
#include "kelmar/KM_wString.h"

#include <algorithm>
#include <array>
#include <cstdint>
#include <fstream>
#include <iterator>
#include <string_view>

namespace quarn {
namespace {

bool isTextFormat(std::string_view format) {
    constexpr std::array<std::string_view, 12> formats{
        "obj", "dae", "xml", "irr", "irrmesh", "ase", "ac", "amf", "x3d", "xgl", "off", "nff"};
    return std::find(formats.begin(), formats.end(), format) != formats.end();
}

/// Joins the two halves of a character beyond 16 bits (Unicode 15.0, section 3.9, D91). A half
/// alone stays as it is, which is no character.
void appendUnit(std::wstring& text, wchar_t unit) {
    const bool is_low = unit >= 0xDC00 && unit < 0xE000;
    const bool is_second = is_low && !text.empty() && text.back() >= 0xD800 && text.back() < 0xDC00;
    if (is_second)
        text.back() = 0x10000 + ((text.back() - 0xD800) << 10) + (unit - 0xDC00);
    else
        text += unit;
}

/// An XML file states its encoding once more; what is handed on is no longer true to it.
void correctDeclaration(std::string& text) {
    const std::size_t end = text.starts_with("<?xml") ? text.find("?>") : std::string::npos;
    const std::size_t at = text.find("encoding");
    const std::size_t quote = at < end ? text.find_first_of("\"'", at) : std::string::npos;
    if (end == std::string::npos || quote >= end) {
        return;
    }
    const std::size_t closing = text.find(text[quote], quote + 1);
    if (closing < end) {
        text.replace(quote + 1, closing - quote - 1, "UTF-8");
    }
}

} // namespace

std::optional<std::string> utf8OfWideFile(const std::filesystem::path& path) {
    std::ifstream file(path, std::ios::binary);
    std::array<unsigned char, 2> mark{};
    file.read(reinterpret_cast<char*>(mark.data()), mark.size());
    const bool is_big = mark[0] == 0xFE && mark[1] == 0xFF;
    const bool is_little = mark[0] == 0xFF && mark[1] == 0xFE;
    if (!(is_big || is_little) || !isTextFormat(modelFormat(path))) {
        return std::nullopt;
    }
    std::wstring wide;
    std::array<unsigned char, 2> bytes{};
    while (file.read(reinterpret_cast<char*>(bytes.data()), bytes.size())) {
        const int first = bytes[0];
        const int second = bytes[1];
        appendUnit(wide, is_big ? first << 8 | second : second << 8 | first);
    }
    std::string text = KM_wString(wide).ToUtf8();
    correctDeclaration(text);
    return text;
}

} // namespace quarn
