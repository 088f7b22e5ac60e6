#include "host/share/Base64Text.h"

#include <cstdint>

namespace quarn {

std::string base64Text(std::span<const std::byte> bytes) {
    constexpr char DIGITS[] = "ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789+/";
    std::string text;
    text.reserve((bytes.size() + 2) / 3 * 4);
    for (std::size_t i = 0; i < bytes.size(); i += 3) {
        std::uint32_t group = 0;
        for (std::size_t k = i; k < i + 3; ++k)
            group = group << 8 | (k < bytes.size() ? std::to_integer<std::uint32_t>(bytes[k]) : 0);
        for (std::size_t digit = 0; digit < 4; ++digit)
            text += i + digit > bytes.size() ? '=' : DIGITS[group >> (18 - 6 * digit) & 63];
    }
    return text;
}

} // namespace quarn
