#include "kelmar/KM_Crc32.h"

#include <array>
#include <utility>

namespace {

// Sixteen bytes a step, each looked up in a table of its own: M. Kounavis and F. Berry, "Novel
// Table Lookup-Based Algorithms for High-Performance CRC Generation", IEEE Transactions on
// Computers 57(11), 2008, carried on from 8 tables to 16.
constexpr std::size_t stride = 16;

// The polynomial with its bits in reverse order, as the lowest bit of a byte comes first.
constexpr std::uint32_t reversed_polynomial = 0xEDB88320;

// Entry [k][b] is what byte b adds to the register when k more bytes follow it.
using Tables = std::array<std::array<std::uint32_t, 256>, stride>;

constexpr std::uint32_t shiftOutByte(std::uint32_t crc) {
    for (int bit = 0; bit < 8; ++bit)
        crc = (crc >> 1) ^ ((crc & 1) != 0 ? reversed_polynomial : 0);
    return crc;
}

constexpr Tables makeTables() {
    Tables tables = {};
    for (std::uint32_t byte = 0; byte < 256; ++byte)
        tables[0][byte] = shiftOutByte(byte);
    for (std::size_t k = 1; k < stride; ++k) {
        for (std::size_t byte = 0; byte < 256; ++byte) {
            const std::uint32_t before = tables[k - 1][byte];
            tables[k][byte] = (before >> 8) ^ tables[0][before & 0xFF];
        }
    }
    return tables;
}

constexpr Tables tables = makeTables();

template <std::size_t... i>
std::uint32_t lookUp(const std::uint8_t* bytes, std::uint32_t crc, std::index_sequence<i...>) {
    const auto entering = [crc](std::size_t index) {
        return static_cast<std::uint8_t>(index < 4 ? crc >> (8 * index) : 0);
    };
    return (tables[stride - 1 - i][bytes[i] ^ entering(i)] ^ ...);
}

} // namespace

std::uint32_t KM_Crc32(std::span<const std::uint8_t> bytes, std::uint32_t crc_before) {
    std::uint32_t crc = ~crc_before;
    for (; bytes.size() >= stride; bytes = bytes.subspan(stride))
        crc = lookUp(bytes.data(), crc, std::make_index_sequence<stride>());
    for (const std::uint8_t byte : bytes)
        crc = (crc >> 8) ^ tables[0][(crc ^ byte) & 0xFF];
    return ~crc;
}
