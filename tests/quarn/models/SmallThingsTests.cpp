#include "tests/quarn/Pictures.h"
#include "tests/quarn/models/CaptureWays.h"
#include "tests/quarn/models/PlacedHouse.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace quarn::test {
namespace {

/// Every way of capture.
class SmallThings : public testing::TestWithParam<const char*> {};

TEST_P(SmallThings, AModelOfAMillionthLooksAsItDoesAtItsSize) {
    const Studio studio;
    writePlacedHouse(studio, "tiny.obj", 0.25e-6, {});
    for (const std::string name : {"house", "tiny"}) {
        const Ended ended = run(studio.turntableOf(
            name + ".obj", 2,
            {"--mode", GetParam(), "--format", "bmp", "--size", "96x64", "--out", name}));
        ASSERT_EQ(ended.exit_code, 0) << ended.err;
    }
    for (const std::string number : {"000.bmp", "001.bmp"}) {
        const Picture large = readBitmap(studio / ("house/house" + number));
        const Picture tiny = readBitmap(studio / ("tiny/tiny" + number));
        ASSERT_EQ(large.width_px, 96);
        EXPECT_LT(meanDifference(large, tiny), 0.0001) << number;
    }
}

TEST_P(SmallThings, APictureOfOnePixelIsRecorded) {
    const Studio studio;
    const Ended ended =
        run(studio.turntable(1, {"--mode", GetParam(), "--format", "bmp", "--size", "1x1"}));
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
    const auto header = readPictureHeader(studio / "out/house000.bmp");
    ASSERT_TRUE(header.has_value());
    EXPECT_EQ(header->width_px, 1);
    EXPECT_EQ(header->height_px, 1);
}

INSTANTIATE_TEST_SUITE_P(Modes, SmallThings, everyWayOfCapture(), nameOfWay);

} // namespace
} // namespace quarn::test
