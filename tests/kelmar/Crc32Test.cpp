#include "kelmar/KM_Crc32.h"
#include "tests/kelmar/Bytes.h"

#include <gtest/gtest.h>

#include <random>

namespace {

// The definition, bit by bit: the remainder of a division by the polynomial.
std::uint32_t crcBitByBit(std::span<const std::uint8_t> bytes) {
    std::uint32_t remainder = 0xFFFFFFFF;
    for (const std::uint8_t byte : bytes) {
        for (int bit = 0; bit < 8; ++bit) {
            const bool divides = ((remainder ^ (byte >> bit)) & 1) != 0;
            remainder = (remainder >> 1) ^ (divides ? 0xEDB88320 : 0);
        }
    }
    return ~remainder;
}

} // namespace

// The check value that catalogues of check sequences give for CRC-32.
TEST(Crc32, DigitsOneToNineGiveThePublishedCheckValue) {
    EXPECT_EQ(KM_Crc32(bytesOf("123456789")), 0xCBF43926U);
}

TEST(Crc32, NoBytesGiveZero) {
    EXPECT_EQ(KM_Crc32({}), 0U);
}

TEST(Crc32, EveryLengthAgreesWithDivisionBitByBit) {
    std::mt19937 random(7);
    Bytes bytes;
    for (int length = 0; length < 100; ++length) {
        EXPECT_EQ(KM_Crc32(bytes), crcBitByBit(bytes)) << length;
        bytes.push_back(static_cast<std::uint8_t>(random()));
    }
}

TEST(Crc32, CanBeTakenInParts) {
    const Bytes bytes = bytesOf("a text that is longer than two steps of sixteen bytes");
    for (std::size_t cut = 0; cut <= bytes.size(); ++cut) {
        const std::span all(bytes);
        EXPECT_EQ(KM_Crc32(all.subspan(cut), KM_Crc32(all.first(cut))), KM_Crc32(all)) << cut;
    }
}
