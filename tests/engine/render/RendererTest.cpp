#include "tests/engine/render/RenderFixture.h"

#include <tbb/global_control.h>
#include <tbb/task_arena.h>

#include <bit>
#include <set>

namespace quarn {
namespace {

SceneContent village() {
    SceneContent content;
    addMesh(content, floorMesh(-30.0F, -30.0F, 30.0F, 30.0F, 0.0F));
    addMesh(content, boxMesh({-5.0, -5.0, 0.0}, {5.0, 5.0, 6.0}), {200, 80, 60, 255});
    addMesh(content, sphereMesh({9.0, -6.0, 3.0}, 3.0F, 16), {60, 90, 200, 255});
    content.lights = {sunLight({1.0, 0.5, -0.8})};
    return content;
}

/// The village with a glass house, and a path through it.
SceneContent glassVillage() {
    SceneContent content = village();
    addPane(content, boxMesh({-2.0, -16.0, 0.0}, {6.0, -9.0, 4.0}), {90, 170, 120, 110});
    addPane(content, sphereMesh({12.0, 4.0, 2.0}, 2.0F, 12), {220, 60, 40, 90});
    SceneCurve path;
    path.id = KM_CreateUuid();
    for (const KM_3dPoint& corner : {KM_3dPoint(-20, -18, 0), {2, -12, 1}, {18, 6, 0}})
        path.polyline.Append(corner);
    content.curves.push_back(path);
    content.points.push_back({KM_CreateUuid(), {2.0, -12.0, 2.0}, {200, 0, 0, 255}, true});
    return content;
}

KM_Viewport fromTheStreet() {
    return perspectiveView({25.0, -30.0, 14.0}, {0.0, 0.0, 2.0});
}

TEST(Renderer, SamePictureForAnyNumberOfThreads) {
    const SceneContent content = glassVillage();
    const auto with = [&](int threads) {
        const tbb::global_control limit(tbb::global_control::max_allowed_parallelism,
                                        static_cast<std::size_t>(std::max(threads, 2)));
        tbb::task_arena arena(threads);
        Image image;
        arena.execute([&] { image = rendered(content, fromTheStreet(), {150, 90, 40}); });
        return image.rgba;
    };
    const auto one = with(1);
    EXPECT_TRUE(one == with(2));
    EXPECT_TRUE(one == with(7));
}

TEST(Renderer, SamePictureOnEveryKindOfProcessor) {
    const SceneContent content = glassVillage();
    const Image plain = rendered(content, fromTheStreet(), {100, 60, 8}, &baseline_render_kernel);
    const Image best = rendered(content, fromTheStreet(), {100, 60, 8});
    EXPECT_TRUE(plain.rgba == best.rgba);
}

/// Mean of the squared differences of two pictures' bytes.
double difference(const Image& a, const Image& b) {
    double sum = 0.0;
    for (std::size_t i = 0; i < a.rgba.size(); ++i)
        sum += (double{1.0} * a.rgba[i] - b.rgba[i]) * (double{1.0} * a.rgba[i] - b.rgba[i]);
    return sum / static_cast<double>(a.rgba.size());
}

TEST(Renderer, MoreSamplesComeNearerToTheEnd) {
    const SceneContent content = village();
    const Image best = rendered(content, fromTheStreet(), {120, 68, 2048});
    const double few = difference(rendered(content, fromTheStreet(), {120, 68, 4}), best);
    const double some = difference(rendered(content, fromTheStreet(), {120, 68, 32}), best);
    const double many = difference(rendered(content, fromTheStreet(), {120, 68, 256}), best);
    EXPECT_LT(some, 0.5 * few);
    EXPECT_LT(many, 0.5 * some);
    EXPECT_LT(std::sqrt(some), 2.0) << "of 255";
}

TEST(Renderer, SmallestPictureAndNumberOfSamplesWork) {
    const Image image = rendered(village(), fromTheStreet(), {1, 1, 1});
    EXPECT_EQ(image.rgba.size(), 4U);
    EXPECT_EQ(image.rgba[3], 255);
}

TEST(Renderer, OddSizesAreFilledToTheLastPixel) {
    const Image image = rendered(village(), topView(10.0), {67, 35, 3});
    for (const auto& [x, y] : {std::pair(66, 34), std::pair(0, 34), std::pair(66, 0)})
        EXPECT_GT(brightness(image, x, y), 20.0) << x << ' ' << y;
}

TEST(Renderer, EmptySceneShowsTheSkyOfRenderedMode) {
    SceneContent content;
    content.lights = {sunLight({0.0, -1.0, -1.0})};
    const KM_Viewport view = perspectiveView({0, 0, 0}, {100, 0, 20});
    const Image slow = rendered(content, view, {32, 18, 16});
    const Image fast = drawn(content, view, modeNamed(L"Rendered"), 32, 18);
    for (int y = 0; y < 18; ++y)
        EXPECT_NEAR(brightness(slow, 16, y), brightness(fast, 16, y), 2.0) << y;
}

TEST(Renderer, CancelInTheMiddleLeavesThePicture) {
    DisplayScene scene;
    ASSERT_TRUE(scene.update(village()).ok());
    Image image;
    image.resize(2, 2);
    double last = 0.0;
    int asked = 0;
    const auto watch = [&](double share) {
        EXPECT_GE(share, last);
        last = share;
        return ++asked < 3;
    };
    const auto end = Renderer().render(scene, fromTheStreet(), {640, 360, 64}, watch, image);
    ASSERT_TRUE(end.ok()) << end.message();
    EXPECT_EQ(end.value(), RenderEnd::cancelled);
    EXPECT_EQ(asked, 3);
    EXPECT_LT(last, 0.9);
    EXPECT_EQ(image.width, 2);
}

TEST(Renderer, ManySamplesOfASmallPictureComeToAnEnd) {
    DisplayScene scene;
    ASSERT_TRUE(scene.update(village()).ok());
    Image image;
    int asked = 0;
    const auto watch = [&](double) { return ++asked < 1000; };
    const auto end = Renderer().render(scene, fromTheStreet(), {12, 8, 2048}, watch, image);
    ASSERT_TRUE(end.ok()) << end.message();
    EXPECT_EQ(end.value(), RenderEnd::done);
    EXPECT_LE(asked, 4 + 2 + 2 + 2048 / 32) << "samples are taken 32 at a time, and fewer at first";
}

TEST(Renderer, RefusesWhatItCannotRender) {
    const DisplayScene scene;
    const auto why = [&](const RenderRequest& request) {
        Image image;
        const auto end = Renderer().render(
            scene, topView(1.0), request, [](double) { return true; }, image);
        return end.ok() ? std::string("done") : end.message();
    };
    EXPECT_NE(why({0, 10, 1}).find("each side must be from 1 to 16384"), std::string::npos);
    EXPECT_NE(why({10, 16385, 1}).find("each side must be"), std::string::npos);
    EXPECT_NE(why({10, 10, 0}).find("must be from 1 to 16384"), std::string::npos);
    EXPECT_NE(why({10, 10, 16385}).find("with 16385 samples"), std::string::npos);
}

TEST(Renderer, SizeThatDoesNotFitIsRefusedBeforeItStarts) {
    const std::uint64_t gigabyte = 1000000000;
    EXPECT_TRUE(Renderer::checkMemory({1280, 720, 64}, gigabyte).ok());
    const auto refused = Renderer::checkMemory({16384, 16384, 64}, 8 * gigabyte);
    ASSERT_FALSE(refused.ok());
    EXPECT_NE(refused.message().find("16384 by 16384"), std::string::npos);
    EXPECT_NE(refused.message().find("8000 MB are free"), std::string::npos);
    EXPECT_NE(refused.message().find("RenderSettings"), std::string::npos);
}

TEST(SampleSequence, EveryStretchHasOnePlaceInEachBox) {
    // Any aligned run of 16 has one place in each of the 16 boxes of 1/2^a by 1/2^(4-a).
    for (std::uint32_t run = 0; run < 64; ++run)
        for (int a = 0; a <= 4; ++a) {
            std::set<std::pair<std::uint32_t, std::uint32_t>> boxes;
            for (std::uint32_t i = 16 * run; i < 16 * run + 16; ++i)
                boxes.insert({a ? firstCoordinate(i) >> (32 - a) : 0,
                              a < 4 ? secondCoordinate(i) >> (28 + a) : 0});
            EXPECT_EQ(boxes.size(), 16U) << run << ' ' << a;
        }
}

TEST(SampleSequence, PixelsOfATileHaveStretchesOfTheirOwn) {
    TileSamples samples;
    startTile(252, 8, 6, samples); // the last tile of its square
    for (int use = 0; use < sample_use_count; ++use) {
        std::set<std::pair<std::uint32_t, std::uint32_t>> starts;
        for (int lane = 0; lane < lane_count; ++lane)
            starts.insert({samples.first[use][lane], samples.second[use][lane]});
        EXPECT_EQ(starts.size(), 16U);
    }
}

TEST(SampleSequence, PixelsOfASquareShareTheSequenceOut) {
    // The sixteen tiles of a 16 by 16 square are an aligned run of 256 stretches of 2^3 places:
    // bits 3 to 10 of where they begin take each value once, and with them, mirrored, bits 28 to 21
    // of the first coordinate.
    for (const int use : {0, 1, 2}) {
        std::set<std::uint32_t> values;
        for (int y = 32; y < 48; y += tile_size)
            for (int x = 64; x < 80; x += tile_size) {
                TileSamples samples;
                startTile(x, y, 3, samples);
                for (const std::uint32_t first : samples.first[use])
                    values.insert(first >> 21 & 0xFFU);
            }
        EXPECT_EQ(values.size(), 256U) << use;
    }
}

} // namespace
} // namespace quarn
