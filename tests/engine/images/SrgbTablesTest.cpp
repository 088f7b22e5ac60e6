#include "engine/images/ColorSpace.h"

#include <gtest/gtest.h>

namespace quarn {
namespace {

TEST(SrgbTables, EveryByteComesBackFromItsLinearValue) {
    for (int value = 0; value < 256; ++value) {
        const auto byte = static_cast<std::uint8_t>(value);
        EXPECT_EQ(srgbTables().linear(byte), linearFromSrgbByte(byte));
        EXPECT_EQ(srgbTables().byte(srgbTables().linear(byte)), byte);
    }
}

TEST(SrgbTables, LinearValuesGoToTheirNearestByte) {
    for (int i = 0; i <= 1'000'000; ++i) {
        const float linear = static_cast<float>(i) * 1e-6F;
        ASSERT_EQ(srgbTables().byte(linear), srgbByteFromLinear(linear)) << linear;
    }
}

// Half way between bytes 0 and 1 the straight part of IEC 61966-2-1 is at 0.5 / 255 / 12.92.
TEST(SrgbTables, ABytesLeastValueIsItsOwn) {
    const float least = 0.5F / 255.0F / 12.92F;
    EXPECT_EQ(srgbTables().byte(least * 1.00001F), 1);
    EXPECT_EQ(srgbTables().byte(least * 0.99999F), 0);
    EXPECT_EQ(srgbTables().byte(0.0F), 0);
    EXPECT_EQ(srgbTables().byte(1.0F), 255);
}

} // namespace
} // namespace quarn
