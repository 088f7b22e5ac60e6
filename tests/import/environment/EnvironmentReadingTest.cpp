#include "import/environment/EnvironmentReading.h"

#include "tests/import/environment/RadianceBytes.h"
#include "tests/support/TempFolder.h"

#include <gmock/gmock.h>

#include <algorithm>
#include <cmath>

namespace quarn::test {
namespace {

using ::testing::Each;
using ::testing::ElementsAre;
using ::testing::HasSubstr;

Result<EnvironmentReading> decoded(const std::string& bytes) {
    return decodeEnvironment({reinterpret_cast<const std::uint8_t*>(bytes.data()), bytes.size()});
}

std::string whyRefused(const std::string& bytes) {
    const auto reading = decoded(bytes);
    return reading ? "" : reading.message();
}

TEST(EnvironmentReading, RowsAndColumnsStandAsInTheFile) {
    const auto reading = decoded(flatRadiance(
        2, 2, {{128, 0, 0, ONE}, {0, 64, 0, ONE}, {0, 0, 32, ONE}, {128, 128, 128, ONE + 3}}));
    ASSERT_TRUE(reading) << reading.message();
    EXPECT_EQ(reading.value().picture.width, 2);
    EXPECT_EQ(reading.value().picture.height, 2);
    EXPECT_THAT(reading.value().picture.rgb, ElementsAre(1, 0, 0, 0, 0.5, 0, 0, 0, 0.25, 8, 8, 8));
    EXPECT_EQ(reading.value().moved_pixels, 0U);
}

TEST(EnvironmentReading, RunsOfPixelsAreUnpacked) {
    const auto reading = decoded(plainRadiance(300, 3, {64, 64, 64, ONE}));
    ASSERT_TRUE(reading) << reading.message();
    EXPECT_EQ(reading.value().picture.rgb.size(), 3U * 300 * 3);
    EXPECT_THAT(reading.value().picture.rgb, Each(0.5F));
}

TEST(EnvironmentReading, WhatIsBrighterThanAMillionKeepsItsColourAndIsCounted) {
    // 255 * 2^119 is 1.7e38.
    const auto reading = decoded(flatRadiance(2, 1, {{255, 51, 0, 255}, {128, 0, 0, ONE}}));
    ASSERT_TRUE(reading) << reading.message();
    const std::vector<float>& rgb = reading.value().picture.rgb;
    EXPECT_FLOAT_EQ(rgb[0], 1e6F);
    EXPECT_FLOAT_EQ(rgb[1], 2e5F);
    EXPECT_EQ(rgb[2], 0.0F);
    EXPECT_EQ(rgb[3], 1.0F);
    EXPECT_EQ(reading.value().moved_pixels, 1U);
}

TEST(EnvironmentReading, APictureThatIsCutOffAnywhereIsRefused) {
    for (const std::string& whole : {flatRadiance(3, 2, std::vector<Rgbe>(6, {128, 64, 32, ONE})),
                                     plainRadiance(200, 4, {128, 64, 32, ONE})}) {
        ASSERT_EQ(whyRefused(whole), "");
        for (std::size_t bytes = 0; bytes < whole.size(); ++bytes)
            EXPECT_NE(whyRefused(whole.substr(0, bytes)), "") << bytes;
        EXPECT_EQ(whyRefused(whole.substr(0, whole.size() - 1)), "it is cut off");
    }
}

TEST(EnvironmentReading, SizesThatNobodyCanHoldAreRefusedBeforeMemoryIsTaken) {
    EXPECT_THAT(whyRefused(radianceHead(100000, 100000)),
                HasSubstr("100000 by 100000 pixels, and at most 33554432 are taken"));
    EXPECT_THAT(whyRefused(radianceHead(8193, 4096)), HasSubstr("at most 33554432"));
    for (const int none : {0, -1, -100000}) {
        EXPECT_EQ(whyRefused(radianceHead(none, 10)), "it has no pixels");
        EXPECT_EQ(whyRefused(radianceHead(10, none)), "it has no pixels");
    }
    EXPECT_EQ(whyRefused(radianceHead(8192, 4096)), "it is cut off");
}

TEST(EnvironmentReading, FilesOfAnotherKindAreRefused) {
    for (const char* other : {"", "hello", "#?RADIANCE\n", "#?RADIANCE\nFORMAT=32-bit_rle_xyze\n\n",
                              "#?RADIANCE\nFORMAT=32-bit_rle_rgbe\n\n+Y 2 +X 2\n"})
        EXPECT_EQ(whyRefused(other), "it is no Radiance picture with its first row on top");
}

TEST(EnvironmentReading, RunsThatAreLongerThanTheirRowAreRefused) {
    std::string bytes = radianceHead(8, 1) + std::string({2, 2, 0, 8});
    bytes += std::string(200, static_cast<char>(0xFF));
    EXPECT_EQ(whyRefused(bytes), "it is damaged");
}

TEST(EnvironmentReading, AFileIsNamedWithWhyAndWhatToDo) {
    const TempFolder folder;
    const auto missing = readEnvironment(folder / "sky.hdr");
    ASSERT_FALSE(missing);
    EXPECT_THAT(missing.message(),
                HasSubstr("Cannot read the picture " + (folder / "sky.hdr").string() + ": "));
    writeFile(folder / "sky.hdr", plainRadiance(8, 4, {128, 64, 32, ONE}).substr(0, 80));
    const auto cut = readEnvironment(folder / "sky.hdr");
    ASSERT_FALSE(cut);
    EXPECT_THAT(cut.message(), HasSubstr("sky.hdr: it is cut off. Give a Radiance picture, a file "
                                         "that ends in .hdr, that is whole."));
    EXPECT_FALSE(readEnvironment(folder.path()));
}

} // namespace
} // namespace quarn::test
