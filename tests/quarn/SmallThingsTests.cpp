#include "tests/quarn/Pictures.h"
#include "tests/quarn/Recording.h"

#include <fstream>
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <sstream>

namespace quarn::test {
namespace {

/// The house, which is 4 long, at a length of a millionth.
void writeTinyHouse(const Studio& studio) {
    std::istringstream large(readFile(studio / "house.obj"));
    std::ofstream tiny(studio / "tiny.obj");
    tiny.precision(15);
    constexpr double scale = 0.25e-6;
    for (std::string line; std::getline(large, line);) {
        std::istringstream words(line);
        std::string word;
        double x = 0.0;
        double y = 0.0;
        double z = 0.0;
        if (words >> word >> x >> y >> z && word == "v")
            tiny << "v " << scale * x << ' ' << scale * y << ' ' << scale * z << '\n';
        else
            tiny << line << '\n';
    }
}

/// Every way of capture.
class SmallThings : public testing::TestWithParam<const char*> {};

TEST_P(SmallThings, AModelOfAMillionthLooksAsItDoesAtItsSize) {
    const Studio studio;
    writeTinyHouse(studio);
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

INSTANTIATE_TEST_SUITE_P(Modes, SmallThings,
                         testing::Values("Wireframe", "Shaded", "Rendered", "Translucent", "X-Ray",
                                         "Drawing", "Clay", "RenderFull", "RenderPreview"),
                         [](const auto& mode) {
                             std::string name = mode.param;
                             std::erase(name, '-');
                             return name;
                         });

} // namespace
} // namespace quarn::test
