#include "kelmar/KM_wString.h"

#include <cstdint>

namespace {

constexpr char32_t replacement_character = 0xFFFD;

bool isSurrogate(char32_t code) {
    return code >= 0xD800 && code <= 0xDFFF;
}

void appendUtf8(std::string& bytes, char32_t code) {
    const auto tail = [&](int shift) {
        bytes += static_cast<char>(0x80 | ((code >> shift) & 0x3F));
    };
    if (code < 0x80) {
        bytes += static_cast<char>(code);
    } else if (code < 0x800) {
        bytes += static_cast<char>(0xC0 | (code >> 6));
        tail(0);
    } else if (code < 0x10000) {
        bytes += static_cast<char>(0xE0 | (code >> 12));
        tail(6);
        tail(0);
    } else {
        bytes += static_cast<char>(0xF0 | (code >> 18));
        tail(12);
        tail(6);
        tail(0);
    }
}

static_assert(sizeof(wchar_t) == 4, "a character is one wchar_t");

char32_t characterOf(wchar_t character) {
    const auto code = static_cast<char32_t>(character);
    return isSurrogate(code) || code > 0x10FFFF ? replacement_character : code;
}

// What may follow a lead byte: The Unicode Standard, table 3-7. The narrower range of the second
// byte is what shuts out overlong forms, surrogates and values that are too large.
struct Sequence {
    int length;
    std::uint8_t second_min;
    std::uint8_t second_max;
};

Sequence sequenceOf(std::uint8_t lead) {
    if (lead < 0x80)
        return {1, 0, 0};
    if (lead >= 0xC2 && lead <= 0xDF)
        return {2, 0x80, 0xBF};
    if (lead == 0xE0)
        return {3, 0xA0, 0xBF};
    if (lead == 0xED)
        return {3, 0x80, 0x9F};
    if (lead >= 0xE1 && lead <= 0xEF)
        return {3, 0x80, 0xBF};
    if (lead == 0xF0)
        return {4, 0x90, 0xBF};
    if (lead >= 0xF1 && lead <= 0xF3)
        return {4, 0x80, 0xBF};
    if (lead == 0xF4)
        return {4, 0x80, 0x8F};
    return {0, 0, 0};
}

// Reads one character, or the longest ill-formed start of one, and moves past it.
char32_t nextCharacter(std::string_view bytes, std::size_t& position) {
    const auto lead = static_cast<std::uint8_t>(bytes[position++]);
    const Sequence sequence = sequenceOf(lead);
    if (sequence.length == 0)
        return replacement_character;
    if (sequence.length == 1)
        return lead;
    char32_t code = lead & (0x7F >> sequence.length);
    for (int i = 1; i < sequence.length; ++i) {
        if (position >= bytes.size())
            return replacement_character;
        const auto byte = static_cast<std::uint8_t>(bytes[position]);
        const std::uint8_t min = i == 1 ? sequence.second_min : 0x80;
        const std::uint8_t max = i == 1 ? sequence.second_max : 0xBF;
        if (byte < min || byte > max)
            return replacement_character;
        code = (code << 6) | (byte & 0x3F);
        ++position;
    }
    return code;
}

} // namespace

std::string KM_wString::ToUtf8() const {
    std::string bytes;
    bytes.reserve(m_text.size());
    for (const wchar_t character : m_text)
        appendUtf8(bytes, characterOf(character));
    return bytes;
}

KM_wString KM_wString::FromUtf8(std::string_view bytes) {
    KM_wString string;
    string.m_text.reserve(bytes.size());
    for (std::size_t position = 0; position < bytes.size();)
        string.m_text += static_cast<wchar_t>(nextCharacter(bytes, position));
    return string;
}
