#include "engine/render/SampleSequence.h"

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

/// Places along the Z-shaped curve through a square, with the four quarters of every square within
/// it in an order of their own. All pixels of a tile share the way to it.
class ShuffledTile {
public:
    ShuffledTile(std::uint32_t x, std::uint32_t y, std::uint32_t seed)
        : m_tile((spread(x & 0xFFU) | spread(y & 0xFFU) << 1) >> tile_bits), m_seed(seed) {
        for (int shift = 2 * square_bits - 2; shift >= tile_bits; shift -= 2)
            m_start = m_start << 2 | digit(m_tile >> (shift - tile_bits), shift);
        m_start <<= tile_bits;
        for (std::uint32_t quarter = 0; quarter < 4; ++quarter) {
            const std::uint32_t place = m_tile << 2 | quarter;
            m_quarters[quarter] = digit(place, 2) << 2;
            m_orders[quarter] = orderOf(place, 0);
        }
    }

    /// Where the tile begins.
    std::uint32_t start() const { return m_start; }
    /// How far behind that a pixel of it stands, 0 to 15.
    std::uint32_t placeIn(int lane) const {
        const auto column = static_cast<std::uint32_t>(lane % tile_size);
        const auto row = static_cast<std::uint32_t>(lane / tile_size);
        const std::uint32_t place = spread(column) | spread(row) << 1;
        return m_quarters[place >> 2] | digit_orders[m_orders[place >> 2]][place & 3U];
    }

private:
    static constexpr int tile_bits = 4;

    std::uint32_t orderOf(std::uint32_t above, int shift) const {
        return scattered(above + (static_cast<std::uint32_t>(shift) << 16), m_seed) % 24;
    }
    /// @param place  from the digit on upward
    std::uint32_t digit(std::uint32_t place, int shift) const {
        return digit_orders[orderOf(place >> 2, shift)][place & 3U];
    }

    std::uint32_t m_tile;
    std::uint32_t m_seed;
    std::uint32_t m_start = 0;
    std::uint32_t m_quarters[4] = {};
    std::uint32_t m_orders[4] = {};
};

/// The coordinates of the sixteen stretches behind each other, which are those of every tile but
/// for what the tile's start adds: coordinates of a sum without carries are those of its parts
/// together.
struct StretchCoordinates {
    explicit StretchCoordinates(int log2_length) {
        for (std::uint32_t i = 0; i < lane_count; ++i) {
            first[i] = firstCoordinate(i << log2_length);
            second[i] = secondCoordinate(i << log2_length);
        }
    }
    std::uint32_t first[lane_count];
    std::uint32_t second[lane_count];
};

void startUse(std::uint32_t x, std::uint32_t y, int log2_length, int use,
              const StretchCoordinates& stretches, TileSamples& samples) {
    const auto seed = static_cast<std::uint32_t>(use);
    const std::uint32_t square = scattered(scattered(x >> square_bits, y >> square_bits), seed);
    const ShuffledTile tile(x, y, square);
    const std::uint32_t start = tile.start() << log2_length;
    const std::uint32_t first = firstCoordinate(start) ^ scattered(square, 1);
    const std::uint32_t second = secondCoordinate(start) ^ scattered(square, 2);
    for (int lane = 0; lane < lane_count; ++lane) {
        const auto column = static_cast<std::uint32_t>(lane % tile_size);
        const auto row = static_cast<std::uint32_t>(lane / tile_size);
        const std::uint32_t place = tile.placeIn(lane);
        samples.order[use][lane] = scattered(scattered(x + column, y + row), seed);
        samples.first[use][lane] = first ^ stretches.first[place];
        samples.second[use][lane] = second ^ stretches.second[place];
    }
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
    const StretchCoordinates stretches(log2_length);
    for (int use = 0; use < sample_use_count; ++use)
        startUse(static_cast<std::uint32_t>(x), static_cast<std::uint32_t>(y), log2_length, use,
                 stretches, samples);
}

} // namespace quarn
