#pragma once

#include <cstdint>

/// An sRGB colour with 8 bits a channel. Alpha is coverage: 0 transparent, 255 opaque.
struct KM_Color {
    std::uint8_t r = 0;
    std::uint8_t g = 0;
    std::uint8_t b = 0;
    std::uint8_t a = 255;

    friend bool operator==(const KM_Color&, const KM_Color&) = default;
};
