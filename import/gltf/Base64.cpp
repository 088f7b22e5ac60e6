#include "import/gltf/Base64.h"

#include <array>

namespace quarn {

namespace {

constexpr std::uint8_t NO_DIGIT = 255;

constexpr std::array<std::uint8_t, 256> digits() {
    std::array<std::uint8_t, 256> values{};
    values.fill(NO_DIGIT);
    for (std::uint8_t i = 0; i < 26; ++i) {
        values[static_cast<std::size_t>('A') + i] = i;
        values[static_cast<std::size_t>('a') + i] = static_cast<std::uint8_t>(26 + i);
    }
    for (std::uint8_t i = 0; i < 10; ++i)
        values[static_cast<std::size_t>('0') + i] = static_cast<std::uint8_t>(52 + i);
    values['+'] = values['-'] = 62;
    values['/'] = values['_'] = 63;
    return values;
}

constexpr std::array<std::uint8_t, 256> DIGITS = digits();

} // namespace

Result<std::vector<std::uint8_t>> fromBase64(std::string_view text) {
    while (text.ends_with('='))
        text.remove_suffix(1);
    std::vector<std::uint8_t> bytes;
    bytes.reserve(text.size() / 4 * 3 + 3);
    std::uint32_t bits = 0;
    int count = 0;
    for (std::size_t i = 0; i < text.size(); ++i) {
        const std::uint8_t digit = DIGITS[static_cast<unsigned char>(text[i])];
        if (digit == NO_DIGIT)
            return Error{"its character " + std::to_string(i + 1) + " is not of Base64"};
        bits = bits << 6 | digit;
        count += 6;
        if (count >= 8) {
            count -= 8;
            bytes.push_back(static_cast<std::uint8_t>(bits >> count));
        }
    }
    return bytes;
}

} // namespace quarn
