#include "tests/engine/display/DisplayFixture.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>

namespace quarn {
namespace {

constexpr int width = 96;
constexpr int height = 64;

/// The sun at an altitude in the west (azimuth 270) or at another azimuth, in degrees.
KM_Light sunAt(double altitude, double azimuth = 270.0) {
    const double a = altitude * KM_PI / 180.0;
    const double z = azimuth * KM_PI / 180.0;
    return sunLight({-std::sin(z) * std::cos(a), -std::cos(z) * std::cos(a), -std::sin(a)});
}

/// A grey floor with a box on it, which stands in the middle of pictures.
SceneContent boxOnFloor() {
    SceneContent content;
    addMesh(content, boxMesh({-2, -2, 0}, {2, 2, 4}));
    content.lights.push_back(sunAt(45.0));
    return content;
}

/// A view from ten units above the ground to an azimuth, the horizon near the middle.
KM_Viewport levelView(double azimuth) {
    const double z = azimuth * KM_PI / 180.0;
    return perspectiveView({-30 * std::sin(z), -30 * std::cos(z), 10}, {0, 0, 8});
}

Image frameAt(SceneContent& content, const KM_Viewport& viewport, double altitude) {
    content.lights[0] = sunAt(altitude);
    return drawn(content, viewport, modeNamed(L"Rendered"), width, height);
}

double meanOfRows(const Image& image, int from, int to) {
    double sum = 0.0;
    for (int y = from; y < to; ++y)
        for (int x = 0; x < image.width; ++x)
            sum += brightness(image, x, y);
    return sum / ((to - from) * image.width);
}

/// Red less blue, over some rows.
double warmthOfRows(const Image& image, int from, int to) {
    double sum = 0.0;
    for (int y = from; y < to; ++y)
        for (int x = 0; x < image.width; ++x)
            sum += double{1.0} * image.pixel(x, y)[0] - image.pixel(x, y)[2];
    return sum / ((to - from) * image.width);
}

TEST(SkyByTheSun, LightGrowsSteadilyWithTheSunFromNightToNoon) {
    SceneContent content = boxOnFloor();
    const KM_Viewport across = levelView(0.0); // the sun stands to the left
    double sky_before = 0.0;
    double ground_before = 0.0;
    for (double altitude = -18.0; altitude <= 90.0; altitude += 0.5) {
        const Image image = frameAt(content, across, altitude);
        const double sky = meanOfRows(image, 0, 12);
        const double ground = meanOfRows(image, height - 8, height);
        if (altitude > -18.0) {
            EXPECT_GT(sky, sky_before - 0.5) << altitude;
            EXPECT_LT(sky, sky_before + 6.0) << altitude;
            EXPECT_GT(ground, ground_before - 0.5) << altitude;
            EXPECT_LT(ground, ground_before + 6.0) << altitude;
        }
        sky_before = sky;
        ground_before = ground;
    }
    EXPECT_GT(sky_before, 180.0);
    EXPECT_GT(ground_before, 180.0);
}

TEST(SkyByTheSun, FramesOfATenMinuteStudyChangeByLittle) {
    SceneContent content = boxOnFloor();
    const KM_Viewport viewport = levelView(230.0);
    Image before;
    for (double altitude = -18.0; altitude <= 60.0; altitude += 2.5) { // at the equator
        const Image image = frameAt(content, viewport, altitude);
        if (!before.rgba.empty()) {
            EXPECT_LT(std::fabs(meanBrightness(image) - meanBrightness(before)), 22.0) << altitude;
        }
        before = image;
    }
}

TEST(SkyByTheSun, SunsetIsWarmBelowTheSunAndCoolAcross) {
    SceneContent content = boxOnFloor();
    for (const double altitude : {-2.0, 0.0, 2.0, 5.0}) {
        const Image west = frameAt(content, levelView(270.0), altitude);
        const Image east = frameAt(content, levelView(90.0), altitude);
        EXPECT_GT(warmthOfRows(west, 10, 25), 40.0) << altitude;
        EXPECT_LT(warmthOfRows(east, 0, 20), 5.0) << altitude;
    }
}

TEST(SkyByTheSun, DayAndNightHaveABlueSky) {
    SceneContent content = boxOnFloor();
    for (const double altitude : {-16.0, 40.0})
        for (const double azimuth : {0.0, 90.0, 180.0}) {
            const Image image = frameAt(content, levelView(azimuth), altitude);
            EXPECT_LT(warmthOfRows(image, 0, 15), -10.0) << altitude << " " << azimuth;
        }
}

/// How many pixels are nearly as bright as the disc makes them.
int glaringPixels(const Image& image) {
    int count = 0;
    for (int y = 0; y < image.height; ++y)
        for (int x = 0; x < image.width; ++x)
            count += image.pixel(x, y)[1] > 248;
    return count;
}

TEST(SkyByTheSun, DiscStandsWhereTheSunIsAndSetsBehindTheHorizon) {
    SceneContent content = boxOnFloor();
    const double rise = std::tan(10.0 * KM_PI / 180.0);
    KM_Viewport viewport = perspectiveView({0, 0, 30}, {-100, 0, 30 + 100 * rise});
    viewport.SetCamera35mmLensLength(400.0); // 3.4 degrees from the bottom to the top
    const auto glaring = [&](double altitude) {
        content.lights[0] = sunAt(altitude);
        return glaringPixels(drawn(content, viewport, modeNamed(L"Rendered"), 200, 200));
    };
    // A disc of half a degree's radius covers 0.785 of 3.43^2 square degrees: 2670 of the pixels.
    EXPECT_NEAR(glaring(10.0), 2670, 900);
    EXPECT_EQ(glaring(13.0), 0);
    viewport = perspectiveView({0, 0, 30}, {-100, 0, 30});
    viewport.SetCamera35mmLensLength(400.0);
    const int half = glaring(0.0);
    EXPECT_GT(half, 2670 / 4);
    EXPECT_LT(half, 2670 * 3 / 4);
    EXPECT_EQ(glaring(-1.0), 0);
}

TEST(SkyByTheSun, ParallelViewTowardTheSunIsNotFilledByItsDisc) {
    SceneContent content = boxOnFloor();
    KM_Viewport viewport = perspectiveView({30, 0, 2}, {0, 0, 2});
    viewport.SetProjection(KM_parallel_view);
    viewport.SetFrustum(-10, 10, -10, 10, 1, 100);
    content.lights[0] = sunAt(0.0);
    EXPECT_EQ(glaringPixels(drawn(content, viewport, modeNamed(L"Rendered"), 60, 60)), 0);
}

TEST(SkyByTheSun, GroundMeetsTheHorizonWithoutALine) {
    SceneContent content = boxOnFloor();
    content.meshes[0].placed.mesh = shared(boxMesh({-2, -2, 0}, {2, 2, 0.1}));
    for (const double altitude : {-15.0, -6.0, 0.5, 3.0, 10.0, 45.0, 90.0})
        for (const double azimuth : {0.0, 90.0, 200.0}) {
            content.lights[0] = sunAt(altitude);
            const Image image =
                drawn(content, levelView(azimuth), modeNamed(L"Rendered"), 300, 300);
            double most = 0.0;
            for (int y = 1; y < 300; ++y)
                for (int x = 0; x < 80; ++x) // the model and its shadow lie further right
                    most = std::max(
                        most, std::fabs(brightness(image, x, y) - brightness(image, x, y - 1)));
            EXPECT_LT(most, 6.0) << altitude << " " << azimuth;
        }
}

TEST(SkyByTheSun, NightIsDarkAndTheModelStandsOutFromIt) {
    SceneContent content = boxOnFloor();
    for (const double altitude : {-18.0, -30.0, -90.0})
        for (const double azimuth : {0.0, 120.0, 240.0}) {
            content.lights[0] = sunAt(altitude);
            const double z = azimuth * KM_PI / 180.0;
            DepthImage depth;
            const Image image = drawn(
                content, perspectiveView({-20 * std::sin(z), -20 * std::cos(z), 6}, {0, 0, 2}),
                modeNamed(L"Rendered"), width, height, &depth);
            EXPECT_GT(meanBrightness(image), 45.0);
            EXPECT_LT(meanBrightness(image), 100.0);
            double model = 0.0;
            double behind = 0.0;
            int model_pixels = 0;
            for (int y = 0; y < height; ++y)
                for (int x = 0; x < width; ++x) {
                    const bool on_model = std::isfinite(depth.depth(x, y));
                    model_pixels += on_model;
                    (on_model ? model : behind) += brightness(image, x, y);
                }
            ASSERT_GT(model_pixels, 300);
            const double contrast = model / model_pixels - behind / (width * height - model_pixels);
            EXPECT_GT(contrast, 5.0) << azimuth;
        }
}

TEST(SkyByTheSun, WhiteIsNotOverexposedAtNoon) {
    SceneContent content;
    addMesh(content, sphereMesh({0, 0, 3}, 3.0F, 60), {255, 255, 255, 255});
    content.lights.push_back(sunAt(75.0));
    DepthImage depth;
    const Image image = drawn(content, perspectiveView({0, -16, 7}, {0, 0, 3}),
                              modeNamed(L"Rendered"), 200, 200, &depth);
    double most = 0.0;
    double least = 255.0;
    for (int y = 0; y < 200; ++y)
        for (int x = 0; x < 200; ++x)
            if (std::isfinite(depth.depth(x, y))) {
                most = std::max(most, brightness(image, x, y));
                least = std::min(least, brightness(image, x, y));
            }
    EXPECT_LT(most, 252.0);
    EXPECT_GT(most, 230.0);
    EXPECT_LT(least, most - 60.0); // it keeps its modelling
}

} // namespace
} // namespace quarn
