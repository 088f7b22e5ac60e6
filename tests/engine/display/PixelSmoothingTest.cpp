#include "engine/images/ColorSpace.h"
#include "tests/engine/display/DisplayFixture.h"

#include <gtest/gtest.h>
#include <tbb/global_control.h>

#include <algorithm>
#include <array>
#include <cmath>
#include <cstdlib>

namespace quarn {
namespace {

/// A box and a ball on a floor in low sunlight: outlines, creases and edges of shadows.
SceneContent boxAndBall() {
    SceneContent content;
    addMesh(content, floorMesh(-30, -30, 30, 30, 0.0F));
    addMesh(content, boxMesh({-3, -3, 0}, {0, 0, 4}), {200, 30, 30, 255});
    addMesh(content, sphereMesh({3, -1, 2}, 2.0F, 24), {240, 240, 240, 255});
    content.lights.push_back(sunLight({0.8, 0.4, -0.5}));
    return content;
}

KM_Viewport obliqueView() {
    return perspectiveView({-9, -17, 9}, {0, 0, 1.5});
}

/// The mean of blocks of 8 by 8 pixels, in linear light.
std::array<int, 3> meanOfBlock(const Image& fine, int x, int y) {
    float sum[3] = {0.0F, 0.0F, 0.0F};
    for (int j = 0; j < 8; ++j)
        for (int i = 0; i < 8; ++i)
            for (std::size_t c = 0; c < 3; ++c)
                sum[c] += linearFromSrgbByte(fine.pixel(8 * x + i, 8 * y + j)[c]);
    return {srgbByteFromLinear(sum[0] / 64), srgbByteFromLinear(sum[1] / 64),
            srgbByteFromLinear(sum[2] / 64)};
}

double distance(const Image& image, int x, int y, const std::array<int, 3>& color) {
    double sum = 0.0;
    for (std::size_t c = 0; c < 3; ++c)
        sum += std::abs(image.pixel(x, y)[c] - color[c]);
    return sum / 3.0;
}

TEST(PixelSmoothing, MoreRaysComeNearerToAPictureOf64RaysAPixel) {
    const SceneContent content = boxAndBall();
    constexpr int width = 240;
    constexpr int height = 180;
    const Image fine =
        drawn(content, obliqueView(), modeNamed(L"Rendered", 0), 8 * width, 8 * height);
    Image images[3];
    for (int level = 0; level < 3; ++level)
        images[level] = drawn(content, obliqueView(), modeNamed(L"Rendered", level), width, height);
    double error[3] = {0.0, 0.0, 0.0};
    int edge_pixels = 0;
    for (int y = 0; y < height; ++y)
        for (int x = 0; x < width; ++x) {
            const std::array<int, 3> wanted = meanOfBlock(fine, x, y);
            if (distance(images[0], x, y, wanted) < 4.0)
                continue;
            ++edge_pixels;
            for (int level = 0; level < 3; ++level)
                error[level] += distance(images[level], x, y, wanted);
        }
    ASSERT_GT(edge_pixels, 500);
    EXPECT_LT(error[1], 0.45 * error[0]);
    EXPECT_LT(error[2], 0.80 * error[1]);
    EXPECT_LT(error[2] / edge_pixels, 6.0);
}

bool stepsVisibly(const Image& image, int x, int y, int other_x, int other_y) {
    if (other_x < 0 || other_y < 0 || other_x >= image.width || other_y >= image.height)
        return false;
    for (std::size_t c = 0; c < 3; ++c)
        if (std::abs(image.pixel(x, y)[c] - image.pixel(other_x, other_y)[c]) > visible_step)
            return true;
    return false;
}

/// The pixels of a picture without smoothing that differ from one of their four neighbours.
std::size_t edgePixelsOf(const Image& image) {
    std::size_t count = 0;
    for (int y = 0; y < image.height; ++y)
        for (int x = 0; x < image.width; ++x)
            count += stepsVisibly(image, x, y, x - 1, y) || stepsVisibly(image, x, y, x + 1, y) ||
                     stepsVisibly(image, x, y, x, y - 1) || stepsVisibly(image, x, y, x, y + 1);
    return count;
}

TEST(PixelSmoothing, FindsEveryVisibleStepWhateverTheSizeOfThePicture) {
    SceneContent content;
    addMesh(content, boxMesh({-3, -3, 0}, {0, 0, 4}), {200, 10, 10, 255}); // unlike all behind it
    content.lights.push_back(sunLight({0.8, 0.4, -0.5}));
    DisplayScene scene;
    ASSERT_TRUE(scene.update(content).ok());
    DisplayPipeline pipeline;
    Image image;
    for (int width = 1; width < 22; ++width)
        for (const int height : {1, 2, 7, 8, 9, 16, 23}) {
            ASSERT_TRUE(
                pipeline.draw(scene, obliqueView(), modeNamed(L"Rendered", 0), width, height, image)
                    .ok());
            const std::size_t expected = edgePixelsOf(image);
            ASSERT_TRUE(
                pipeline.draw(scene, obliqueView(), modeNamed(L"Rendered", 2), width, height, image)
                    .ok());
            EXPECT_EQ(pipeline.smoothedPixelCount(), expected) << width << " x " << height;
        }
}

TEST(PixelSmoothing, ThePictureIsTheSameForAnyNumberOfThreads) {
    const SceneContent content = boxAndBall();
    for (const int level : {1, 2}) {
        Image first;
        for (const std::size_t threads : {1U, 2U, 7U}) {
            const tbb::global_control limit(tbb::global_control::max_allowed_parallelism, threads);
            const Image image =
                drawn(content, obliqueView(), modeNamed(L"Rendered", level), 321, 203);
            if (threads == 1U)
                first = image;
            EXPECT_EQ(image.rgba, first.rgba) << threads;
        }
    }
}

TEST(PixelSmoothing, EvenPicturesAreLeftAlone) {
    SceneContent content;
    addMesh(content, floorMesh(-100, -100, 100, 100, 0.0F));
    content.lights.push_back(sunLight({0.8, 0.4, -0.5}));
    const auto at = [&](int level) {
        return drawn(content, topView(5.0), modeNamed(L"Rendered", level), 100, 80);
    };
    EXPECT_EQ(at(2).rgba, at(0).rgba);
}

} // namespace
} // namespace quarn
