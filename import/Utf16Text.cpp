#include "import/Utf16Text.h"

#include "import/ModelFileCheck.h"

#include <algorithm>
#include <array>
#include <cstdint>
#include <fstream>
#include <iterator>
#include <string_view>

namespace quarn {
namespace {

constexpr char32_t replacement = 0xFFFD;

bool isTextFormat(std::string_view format) {
    constexpr std::array<std::string_view, 12> formats{
        "obj", "dae", "xml", "irr", "irrmesh", "ase", "ac", "amf", "x3d", "xgl", "off", "nff"};
    return std::find(formats.begin(), formats.end(), format) != formats.end();
}

void appendUtf8(char32_t c, std::string& text) {
    const auto byte = [&text](char32_t bits) { text += static_cast<char>(bits); };
    const auto tail = [&byte, c](int shift) { byte(0x80 | (c >> shift & 0x3F)); };
    if (c < 0x80) {
        byte(c);
    } else if (c < 0x800) {
        byte(0xC0 | c >> 6);
        tail(0);
    } else if (c < 0x10000) {
        byte(0xE0 | c >> 12);
        tail(6);
        tail(0);
    } else {
        byte(0xF0 | c >> 18);
        tail(12);
        tail(6);
        tail(0);
    }
}

/// Joins the two halves of characters beyond 16 bits; a half alone becomes the replacement
/// character (Unicode 15.0, section 3.9, D91).
class Utf16Reading {
public:
    void append(char32_t unit) {
        const bool is_low = unit >= 0xDC00 && unit < 0xE000;
        if (m_high != 0) {
            appendUtf8(is_low ? 0x10000 + ((m_high - 0xD800) << 10) + (unit - 0xDC00) : replacement,
                       m_text);
        }
        const bool was_joined = m_high != 0 && is_low;
        m_high = unit >= 0xD800 && unit < 0xDC00 ? unit : 0;
        if (!was_joined && m_high == 0) {
            appendUtf8(is_low ? replacement : unit, m_text);
        }
    }

    std::string text() {
        if (m_high != 0) {
            appendUtf8(replacement, m_text);
        }
        return std::move(m_text);
    }

private:
    std::string m_text;
    char32_t m_high = 0; ///< a first half that waits for its second
};

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
    Utf16Reading reading;
    std::array<unsigned char, 2> bytes{};
    while (file.read(reinterpret_cast<char*>(bytes.data()), bytes.size())) {
        const char32_t first = bytes[0];
        const char32_t second = bytes[1];
        reading.append(is_big ? first << 8 | second : second << 8 | first);
    }
    std::string text = reading.text();
    correctDeclaration(text);
    return text;
}

} // namespace quarn
