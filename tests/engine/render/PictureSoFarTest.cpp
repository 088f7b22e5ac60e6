#include "engine/render/SampleTaking.h"
#include "tests/engine/render/RenderFixture.h"

#include <chrono>
#include <cmath>
#include <thread>

namespace quarn {
namespace {

SceneContent hall() {
    SceneContent content;
    addMesh(content, floorMesh(-300.0F, -300.0F, 300.0F, 300.0F, 0.0F));
    addMesh(content, boxMesh({-5.0, -5.0, 0.0}, {5.0, 5.0, 6.0}), {200, 80, 60, 255});
    content.lights = {sunLight({0.3, 0.2, -1.0})};
    return content;
}

double difference(const Image& a, const Image& b) {
    double sum = 0.0;
    for (std::size_t i = 0; i < a.rgba.size(); ++i)
        sum += std::abs(double{1.0} * a.rgba[i] - b.rgba[i]);
    return sum / static_cast<double>(a.rgba.size());
}

TEST(PictureSoFar, IsShownWhileTheSameSamplesAreTaken) {
    DisplayScene scene;
    ASSERT_TRUE(scene.update(hall()).ok());
    using Clock = std::chrono::steady_clock;
    std::vector<Image> so_far;
    std::vector<Clock::time_point> times{Clock::now()};
    const auto slowly = [](double) {
        std::this_thread::sleep_for(std::chrono::milliseconds(150));
        return true;
    };
    Image image;
    const auto end = Renderer().render(scene, topView(10.0), {70, 50, 64}, slowly, image,
                                       [&](const Image& picture) {
                                           so_far.push_back(picture);
                                           times.push_back(Clock::now());
                                       });
    ASSERT_TRUE(end.ok() && end.value() == RenderEnd::done);
    ASSERT_FALSE(so_far.empty());
    for (std::size_t i = 1; i < times.size(); ++i)
        EXPECT_GE(times[i] - times[i - 1], std::chrono::milliseconds(500));
    for (const Image& picture : so_far) {
        ASSERT_EQ(picture.width, 70);
        ASSERT_EQ(picture.height, 50);
        EXPECT_LT(difference(picture, image), 12.0) << "a little noise is left";
    }
    EXPECT_TRUE(image.rgba == rendered(hall(), topView(10.0), {70, 50, 64}).rgba);
}

TEST(PictureSoFar, KnowsHowManySamplesEachPixelHas) {
    DisplayScene scene;
    ASSERT_TRUE(scene.update(hall()).ok());
    const SampleSequence sequence(40);
    const RenderKernel& kernel = renderKernelInForce();
    RenderTables tables;
    const RenderSetup setup =
        makeRenderSetup(scene, topView(10.0), 700, 130, sequence, kernel, tables);
    RenderLayers layers(700, 130);
    SampleTaking taking(setup, kernel, layers, 40);
    bool was_between = false;
    const auto look = [&](double) {
        // Surfaces fill all of the picture: each sample adds 1 to the cover.
        for (const auto& [x, y] : {std::pair(0, 0), {63, 31}, {64, 31}, {63, 32}, {699, 129}})
            EXPECT_EQ(layers.at(RenderPlane::cover, x, y),
                      static_cast<float>(layers.samplesAt(x, y)));
        was_between |= layers.samplesAt(0, 0) != layers.samplesAt(699, 129);
        return true;
    };
    EXPECT_EQ(taking.run(true, look), RenderEnd::done);
    EXPECT_TRUE(was_between) << "55 blocks, at first four at a time";
    EXPECT_GE(layers.samplesAt(699, 129), 8);
    EXPECT_LE(layers.samplesAt(699, 129), 40);
}

TEST(PictureSoFar, IsCancelledLikeAnyOther) {
    DisplayScene scene;
    ASSERT_TRUE(scene.update(hall()).ok());
    Image image;
    int asked = 0;
    const auto end = Renderer().render(
        scene, topView(10.0), {70, 50, 64}, [&](double) { return ++asked < 2; }, image,
        [](const Image&) {});
    ASSERT_TRUE(end.ok());
    EXPECT_EQ(end.value(), RenderEnd::cancelled);
    EXPECT_EQ(image.width, 0);
}

} // namespace
} // namespace quarn
