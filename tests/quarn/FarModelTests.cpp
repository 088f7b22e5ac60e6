#include "tests/quarn/Pictures.h"
#include "tests/quarn/Recording.h"

#include <fstream>
#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <sstream>

namespace quarn::test {
namespace {

/// The house with 4,500,000, 5,200,000 and 100 added to its coordinates.
void writeSurveyedHouse(const Studio& studio) {
    std::istringstream near(readFile(studio / "house.obj"));
    std::ofstream far(studio / "far.obj");
    far.precision(15);
    for (std::string line; std::getline(near, line);) {
        std::istringstream words(line);
        std::string word;
        double x = 0.0;
        double y = 0.0;
        double z = 0.0;
        if (words >> word >> x >> y >> z && word == "v")
            far << "v " << 4.5e6 + x << ' ' << 5.2e6 + y << ' ' << 100.0 + z << '\n';
        else
            far << line << '\n';
    }
}

TEST(FarModel, TurnsBeforeTheCameraAsItDoesAtTheOrigin) {
    const Studio studio;
    writeSurveyedHouse(studio);
    for (const char* const mode : {"Rendered", "Shaded", "Drawing"}) {
        const std::vector<std::string> options = {"--mode", mode,     "--format",
                                                  "bmp",    "--size", "320x200"};
        const auto recorded = [&](const std::string& name, const std::string& target) {
            auto more = options;
            more.insert(more.end(), {"--target", target, "--out", name});
            const Ended ended = run(studio.turntableOf(name + ".obj", 6, more));
            EXPECT_EQ(ended.exit_code, 0) << ended.err;
        };
        recorded("house", "2,1,0.5");
        recorded("far", "4500002,5200001,100.5");
        for (int frame = 0; frame < 6; ++frame) {
            const std::string number = "00" + std::to_string(frame) + ".bmp";
            const Picture here = readBitmap(studio / ("house/house" + number));
            const Picture there = readBitmap(studio / ("far/far" + number));
            ASSERT_EQ(here.width_px, 320);
            EXPECT_LT(meanDifference(here, there), 0.0001) << mode << " " << frame;
        }
    }
}

} // namespace
} // namespace quarn::test
