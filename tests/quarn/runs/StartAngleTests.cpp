// The cameras that turntables are recorded with, as the list of their frames tells them.
#include "tests/quarn/Studio.h"

#include <cmath>
#include <gtest/gtest.h>
#include <nlohmann/json.hpp>
#include <numbers>

namespace quarn::test {
namespace {

nlohmann::json camera(const Studio& studio, int frame) {
    const auto list = nlohmann::json::parse(readFile(studio / "out/house.frames.json"));
    return list.at("images").at(static_cast<std::size_t>(frame)).at("camera");
}

/// Of the camera about its target, anticlockwise from the X axis as seen from above.
double azimuth_deg(const nlohmann::json& camera) {
    const auto across = [&](std::size_t axis) {
        return camera["place"][axis].get<double>() - camera["target"][axis].get<double>();
    };
    return std::atan2(across(1), across(0)) * 180.0 / std::numbers::pi;
}

double apart_deg(double a, double b) {
    return std::remainder(a - b, 360.0);
}

void record(const Studio& studio, int frames, std::vector<std::string> options) {
    options.insert(options.end(), {"--mode", "Wireframe"});
    const Ended ended = run(studio.turntable(frames, options));
    ASSERT_EQ(ended.exit_code, 0) << ended.err;
}

TEST(StartAngle, IsThatOfTheFirstFrameInBothDirections) {
    for (const char* direction : {"clockwise", "anticlockwise"})
        for (const int frames : {1, 2, 3, 4, 5, 7}) {
            const Studio studio;
            const double angle = 30.0 - 50.0 * frames;
            record(studio, frames,
                   {"--start-angle", std::to_string(angle), "--direction", direction});
            EXPECT_NEAR(apart_deg(azimuth_deg(camera(studio, 0)), angle), 0.0, 1e-9)
                << direction << " " << frames;
        }
}

TEST(StartAngle, IsWhereTheTurnGoesOnFromTheWayThatTheDirectionSays) {
    for (const char* direction : {"clockwise", "anticlockwise"}) {
        const Studio studio;
        record(studio, 8, {"--start-angle", "90", "--direction", direction});
        const double first_step =
            apart_deg(azimuth_deg(camera(studio, 1)), azimuth_deg(camera(studio, 0)));
        EXPECT_GT(first_step * (std::string(direction) == "clockwise" ? 1.0 : -1.0), 20.0)
            << "the model seems to turn the other way than the camera goes";
    }
}

TEST(StartAngle, IsAboutAnyTarget) {
    const Studio studio;
    record(studio, 5, {"--start-angle", "-120", "--target", "100,-20,3", "--elevation", "60"});
    EXPECT_NEAR(apart_deg(azimuth_deg(camera(studio, 0)), -120.0), 0.0, 1e-9);
    EXPECT_EQ(camera(studio, 0)["target"], nlohmann::json({100.0, -20.0, 3.0}));
}

TEST(Lens, IsThatOfTheFramesAndTheModelStillFillsThem) {
    const Studio studio;
    const auto distance = [&](const char* lens) {
        record(studio, 2, {"--lens", lens});
        EXPECT_NEAR(camera(studio, 0)["lens_mm"].get<double>(), std::stod(lens), 1e-9);
        double squares = 0.0;
        for (std::size_t axis = 0; axis < 3; ++axis)
            squares += std::pow(camera(studio, 0)["place"][axis].get<double>() -
                                    camera(studio, 0)["target"][axis].get<double>(),
                                2);
        return std::sqrt(squares);
    };
    const double near = distance("50");
    EXPECT_GT(distance("200"), 3.0 * near) << "from farther away, with the longer lens";
}

} // namespace
} // namespace quarn::test
