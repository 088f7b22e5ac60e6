#pragma once

#include <array>
#include <cstddef>
#include <cstdint>
#include <type_traits>

namespace kelmar {

/// The unsigned integer as wide as the number `T`.
template <class T>
using BitsOf =
    std::conditional_t<sizeof(T) == 1, std::uint8_t,
                       std::conditional_t<sizeof(T) == 4, std::uint32_t,
                                          std::conditional_t<sizeof(T) == 8, std::uint64_t, void>>>;

/// The bytes of an unsigned integer, lowest first, whatever the machine's own order.
template <class Bits> constexpr std::array<std::uint8_t, sizeof(Bits)> toLittleEndian(Bits bits) {
    std::array<std::uint8_t, sizeof(Bits)> bytes = {};
    for (std::size_t i = 0; i < sizeof(Bits); ++i)
        bytes[i] = static_cast<std::uint8_t>(bits >> (8 * i));
    return bytes;
}

/// The unsigned integer whose bytes, lowest first, begin at `bytes`.
template <class Bits> constexpr Bits fromLittleEndian(const std::uint8_t* bytes) {
    Bits bits = 0;
    for (std::size_t i = 0; i < sizeof(Bits); ++i)
        bits = static_cast<Bits>(bits | static_cast<Bits>(bytes[i]) << (8 * i));
    return bits;
}

} // namespace kelmar
