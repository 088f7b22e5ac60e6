#include "host/render/SampleSequence.h"

#include <array>
#include <cstddef>

namespace quarn {

namespace {

/// Pixels are ordered within squares of 2^8 by 2^8; from square to square the order begins anew.
constexpr int square_bits = 8;

/// Scatters the bits of a number (C. Wellons, "Prospecting for Hash Functions", 2018: lowbias32).
constexpr std::uint32_t scattered(std::uint32_t x) {
    x ^= x >> 16;
    x *= 0x7FEB352DU;
    x ^= x >> 15;
    x *= 0x846CA68BU;
    return x ^ (x >> 16);
}

constexpr std::uint32_t scattered(std::uint32_t a, std::uint32_t b) {
    return scattered(a ^ (scattered(b) + 0x9E3779B9U));
}

/// Spreads eight bits so that a free bit follows each.
constexpr std::uint32_t spread(std::uint32_t bits) {
    bits = (bits | bits << 4) & 0x0F0FU;
    bits = (bits | bits << 2) & 0x3333U;
    return (bits | bits << 1) & 0x5555U;
}

/// The n-th order of the digits 0 to 3, with n below 24.
constexpr std::array<std::uint8_t, 4> digitOrder(unsigned n) {
    std::array<std::uint8_t, 4> left{0, 1, 2, 3};
    std::array<std::uint8_t, 4> order{};
    for (unsigned count = 4; count > 0; --count) {
        const unsigned pick = n % count;
        n /= count;
        order[4 - count] = left[pick];
        for (unsigned i = pick; i + 1 < count; ++i)
            left[i] = left[i + 1];
    }
    return order;
}

constexpr auto makeDigitOrders() {
    std::array<std::array<std::uint8_t, 4>, 24> orders{};
    for (unsigned n = 0; n < orders.size(); ++n)
        orders[n] = digitOrder(n);
    return orders;
}

constexpr auto digit_orders = makeDigitOrders();

/// A pixel's place along the Z-shaped curve through its square, with the four quarters of every
/// square within it in an order of their own.
std::uint32_t shuffledPlace(std::uint32_t x, std::uint32_t y, std::uint32_t seed) {
    const std::uint32_t place = spread(x & 0xFFU) | spread(y & 0xFFU) << 1;
    std::uint32_t shuffled = 0;
    for (int shift = 2 * square_bits - 2; shift >= 0; shift -= 2) {
        const std::uint32_t above = place >> shift >> 2;
        const std::uint32_t pick =
            scattered(above + (static_cast<std::uint32_t>(shift) << 16), seed);
        shuffled = shuffled << 2 | digit_orders[pick % 24][place >> shift & 3U];
    }
    return shuffled;
}

void startPixel(std::uint32_t x, std::uint32_t y, int log2_length, int use, int lane,
                TileSamples& samples) {
    const auto seed = static_cast<std::uint32_t>(use);
    const std::uint32_t square = scattered(scattered(x >> square_bits, y >> square_bits), seed);
    const std::uint32_t start = shuffledPlace(x, y, square) << log2_length;
    samples.order[use][lane] = scattered(scattered(x, y), seed);
    samples.first[use][lane] = firstCoordinate(start) ^ scattered(square, 1);
    samples.second[use][lane] = secondCoordinate(start) ^ scattered(square, 2);
}

std::uint32_t reversed(std::uint32_t number, int bits) {
    return firstCoordinate(number) >> (32 - bits);
}

} // namespace

std::uint32_t firstCoordinate(std::uint32_t number) {
    std::uint32_t fraction = 0;
    for (std::uint32_t direction = 0x80000000U; number != 0; number >>= 1, direction >>= 1)
        if (number & 1U)
            fraction ^= direction;
    return fraction;
}

std::uint32_t secondCoordinate(std::uint32_t number) {
    std::uint32_t fraction = 0;
    for (std::uint32_t direction = 0x80000000U; number != 0;
         number >>= 1, direction ^= direction >> 1)
        if (number & 1U)
            fraction ^= direction;
    return fraction;
}

SampleSequence::SampleSequence(int samples) {
    while (1 << m_log2_length < samples)
        ++m_log2_length;
    const auto length = std::uint32_t{1} << m_log2_length;
    m_first.resize(length);
    m_second.resize(length);
    for (std::uint32_t row = 0; row < length; ++row) {
        const std::uint32_t number = reversed(row, m_log2_length);
        m_first[row] = firstCoordinate(number);
        m_second[row] = secondCoordinate(number);
    }
}

void startTile(int x, int y, int log2_length, TileSamples& samples) {
    for (int lane = 0; lane < lane_count; ++lane)
        for (int use = 0; use < sample_use_count; ++use)
            startPixel(static_cast<std::uint32_t>(x + lane % tile_size),
                       static_cast<std::uint32_t>(y + lane / tile_size), log2_length, use, lane,
                       samples);
}

} // namespace quarn
