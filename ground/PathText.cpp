#include "ground/PathText.h"

namespace quarn {

namespace {

constexpr std::size_t most_bytes_a_character = 4;

/// @return the bytes of a character, which is none when it is no Unicode character
std::size_t encode(char32_t c, char (&bytes)[most_bytes_a_character]) {
    const auto tail = [c](int shift) { return static_cast<char>(0x80 | (c >> shift & 0x3F)); };
    if (c < 0x80) {
        bytes[0] = static_cast<char>(c);
        return 1;
    }
    if (c < 0x800) {
        bytes[0] = static_cast<char>(0xC0 | c >> 6);
        bytes[1] = tail(0);
        return 2;
    }
    if (c < 0x10000) {
        bytes[0] = static_cast<char>(0xE0 | c >> 12);
        bytes[1] = tail(6);
        bytes[2] = tail(0);
        return c < 0xD800 || c > 0xDFFF ? 3 : 0;
    }
    bytes[0] = static_cast<char>(0xF0 | c >> 18);
    bytes[1] = tail(12);
    bytes[2] = tail(6);
    bytes[3] = tail(0);
    return c <= 0x10FFFF ? 4 : 0;
}

} // namespace

SystemPath::SystemPath(std::wstring_view text) {
    std::size_t length = 0;
    for (const wchar_t character : text) {
        char bytes[most_bytes_a_character];
        const std::size_t count = encode(static_cast<char32_t>(character), bytes);
        if (count == 0 || length + count >= most_short_bytes) {
            m_long = KM_wString(text).ToUtf8();
            return;
        }
        for (std::size_t i = 0; i < count; ++i)
            m_short[length++] = bytes[i];
    }
    m_short[length] = '\0';
}

std::filesystem::path pathFromText(std::wstring_view text) {
    return KM_wString(text).ToUtf8();
}

KM_wString textFromPath(const std::filesystem::path& path) {
    return KM_wString::FromUtf8(path.native());
}

} // namespace quarn
