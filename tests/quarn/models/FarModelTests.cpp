#include "tests/quarn/Pictures.h"
#include "tests/quarn/models/PlacedHouse.h"

#include <array>
#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace quarn::test {
namespace {

/// Records the house at the origin and the far one, and compares their frames.
/// @param targets  of the one and of the other; empty: found by the program
void expectSameFrames(const std::array<std::string, 2>& targets) {
    const Studio studio;
    writePlacedHouse(studio, "far.obj", 1.0, {4.5e6, 5.2e6, 100.0});
    for (const char* const mode : {"Rendered", "Shaded", "Drawing"}) {
        const auto recorded = [&](const std::string& name, const std::string& target) {
            std::vector<std::string> options = {"--mode", mode,      "--format", "bmp",
                                                "--size", "320x200", "--out",    name};
            if (!target.empty())
                options.insert(options.end(), {"--target", target});
            const Ended ended = run(studio.turntableOf(name + ".obj", 6, options));
            EXPECT_EQ(ended.exit_code, 0) << ended.err;
        };
        recorded("house", targets[0]);
        recorded("far", targets[1]);
        for (int frame = 0; frame < 6; ++frame) {
            const std::string number = "00" + std::to_string(frame) + ".bmp";
            const Picture here = readBitmap(studio / ("house/house" + number));
            const Picture there = readBitmap(studio / ("far/far" + number));
            ASSERT_EQ(here.width_px, 320);
            EXPECT_LT(meanDifference(here, there), 0.0001) << mode << " " << frame;
        }
    }
}

TEST(FarModel, TurnsBeforeTheCameraAsItDoesAtTheOrigin) {
    expectSameFrames({"2,1,0.5", "4500002,5200001,100.5"});
}

TEST(FarModel, IsFramedAsItIsAtTheOrigin) {
    expectSameFrames({"", ""});
}

} // namespace
} // namespace quarn::test
