#include "tests/engine/display/LitScenes.h"

#include <gtest/gtest.h>

#include <limits>

namespace quarn {
namespace {

constexpr int SIZE = 48;

/// Linear light of the middle of the box's top.
double lightAt(SceneContent content, std::optional<double> stops) {
    content.light.exposure = stops;
    return linearLight(litPicture(content, topView(0.3), SIZE, SIZE), SIZE / 2, SIZE / 2);
}

/// Bytes of such light differ by 2 % at the most.
void expectDoubles(const SceneContent& content) {
    EXPECT_NEAR(lightAt(content, -1.0) / lightAt(content, -2.0), 2.0, 0.06);
    EXPECT_NEAR(lightAt(content, -2.0) / lightAt(content, -3.0), 2.0, 0.08);
}

TEST(Exposure, AStopDoublesTheLightInTheStudioUnderTheSkyAndInAPicture) {
    SceneContent content = cubeOnGround();
    expectDoubles(content);
    content.light.surroundings = Surroundings::sky;
    expectDoubles(content);
    content.lights.push_back(sunLight({0.3, 0.3, -1.0}));
    expectDoubles(content);
    content.light.surroundings = Surroundings::picture;
    content.light.picture = surroundingsBy([](float, float altitude) {
        return std::array<float, 3>{0.5F + 0.01F * altitude, 1.0F, 1.0F};
    });
    expectDoubles(content);
}

TEST(Exposure, AStopDoublesWhatASurfaceGivesOff) {
    SceneContent content;
    addLook(content, boxMesh({-0.1, -0.1, 0.0}, {0.1, 0.1, 0.2}), [](Material& material) {
        material.base_color = {0, 0, 0, 255};
        material.emission = {0.8F, 0.8F, 0.8F};
    });
    expectDoubles(content);
}

TEST(Exposure, ItFallsSteadilyWhileASunRisesOverAStudio) {
    SceneContent content = cubeOnGround();
    content.light.surroundings = Surroundings::studio;
    content.lights.resize(1);
    float before = 1.0F;
    for (double altitude = -10.0; altitude <= 90.0; altitude += 0.5) {
        const double a = altitude * KM_PI / 180.0;
        content.lights[0] = sunLight({std::cos(a), 0.0, -std::sin(a)});
        const float exposure = frameOf(content, productView()).frame.exposure;
        EXPECT_LE(exposure, before) << altitude;
        EXPECT_GT(exposure, before - 0.01F) << altitude;
        before = exposure;
    }
    EXPECT_LT(before, 0.6F);
}

TEST(Exposure, NoneIsThatOfNoStops) {
    for (const Surroundings surroundings : {Surroundings::studio, Surroundings::sky}) {
        SceneContent content = cubeOnGround();
        content.light.surroundings = surroundings;
        EXPECT_EQ(lightAt(content, std::nullopt), lightAt(content, 0.0));
    }
}

TEST(Exposure, NumbersWithoutSenseEndInBlackAndWhite) {
    const SceneContent content = cubeOnGround();
    EXPECT_EQ(lightAt(content, 1e300), 1.0);
    EXPECT_EQ(lightAt(content, -1e300), 0.0);
    EXPECT_EQ(lightAt(content, std::numeric_limits<double>::quiet_NaN()), lightAt(content, 0.0));
}

} // namespace
} // namespace quarn
