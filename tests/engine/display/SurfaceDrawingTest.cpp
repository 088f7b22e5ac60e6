#include "tests/engine/display/DisplayFixture.h"

#include "engine/display/kernel/FrameSetup.h"

#include <gtest/gtest.h>

#include <tbb/task_arena.h>

#include <limits>

namespace quarn {
namespace {

constexpr KM_Color red{220, 30, 30, 255};
constexpr KM_Color blue{30, 30, 220, 255};

/// 100 by 100 pixels that show [-5, 5]^2 from above: pixel (x, y) has its middle at
/// (x / 10 - 4.95, 4.95 - y / 10).
Image seenFromAbove(const SceneContent& content, const wchar_t* mode, int level = 0,
                    DepthImage* depth = nullptr) {
    return drawn(content, topView(5.0), modeNamed(mode, level), 100, 100, depth);
}

bool isReddish(const Image& image, int x, int y) {
    const auto pixel = image.pixel(x, y);
    return pixel[0] > pixel[1] + 60;
}

int countReddish(const Image& image) {
    int count = 0;
    for (int y = 0; y < image.height; ++y)
        for (int x = 0; x < image.width; ++x)
            count += isReddish(image, x, y) ? 1 : 0;
    return count;
}

TEST(SurfaceDrawing, RectangleCoversExactlyThePixelsWhoseMiddlesLieInIt) {
    SceneContent content;
    addMesh(content, floorMesh(-2.0F, -1.0F, 3.0F, 2.0F, 0.0F), red);
    const Image image = seenFromAbove(content, L"Shaded");
    for (int y = 0; y < 100; ++y)
        for (int x = 0; x < 100; ++x)
            EXPECT_EQ(isReddish(image, x, y), x >= 30 && x < 80 && y >= 30 && y < 60)
                << x << ' ' << y;
}

TEST(SurfaceDrawing, TriangleCoversHalfOfItsSquare) {
    SceneContent content;
    KM_Mesh mesh = floorMesh(-4.0F, -4.0F, 4.0F, 4.0F, 0.0F);
    mesh.m_F.pop_back(); // leaves the half below the diagonal x = y
    addMesh(content, std::move(mesh), red);
    const Image image = seenFromAbove(content, L"Shaded");
    EXPECT_NEAR(countReddish(image), 80 * 80 / 2, 80);
    EXPECT_TRUE(isReddish(image, 85, 80));
    EXPECT_FALSE(isReddish(image, 15, 20));
}

TEST(SurfaceDrawing, DepthIsTheDistanceAlongTheViewDirection) {
    SceneContent content;
    addMesh(content, floorMesh(-2.0F, -2.0F, 2.0F, 2.0F, 30.0F));
    DepthImage depth;
    seenFromAbove(content, L"Shaded", 0, &depth);
    EXPECT_NEAR(depth.depth(50, 50), 70.0, 1e-3); // the camera stands at z = 100
    EXPECT_EQ(depth.depth(5, 5), std::numeric_limits<float>::infinity());

    const KM_Viewport viewport = perspectiveView({0.0, -20.0, 30.0}, {0.0, 0.0, 30.0});
    content = {};
    addMesh(content, boxMesh({-1.0, 0.0, 29.0}, {1.0, 2.0, 31.0}));
    drawn(content, viewport, modeNamed(L"Rendered"), 99, 99, &depth);
    EXPECT_NEAR(depth.depth(49, 49), 20.0, 1e-3);
    EXPECT_NEAR(depth.depth(51, 47), 20.0, 1e-3); // along the direction, not along the ray
}

TEST(SurfaceDrawing, NearerSurfaceHidesTheFartherOneWhateverTheirOrder) {
    for (const bool red_first : {true, false}) {
        SceneContent content;
        if (red_first)
            addMesh(content, floorMesh(-2.0F, -2.0F, 2.0F, 2.0F, 1.0F), red);
        addMesh(content, floorMesh(-4.0F, -4.0F, 4.0F, 4.0F, 0.0F), blue);
        if (!red_first)
            addMesh(content, floorMesh(-2.0F, -2.0F, 2.0F, 2.0F, 1.0F), red);
        EXPECT_EQ(countReddish(seenFromAbove(content, L"Shaded")), 40 * 40);
    }
}

TEST(SurfaceDrawing, HiddenObjectIsNotDrawnAndComesBack) {
    SceneContent content;
    const std::size_t small = addMesh(content, floorMesh(-2.0F, -2.0F, 2.0F, 2.0F, 9.0F), red);
    addMesh(content, floorMesh(-4.0F, -4.0F, 4.0F, 4.0F, 6.0F), blue);
    const std::size_t large = addMesh(content, hillMesh(70), {30, 200, 30, 255});
    DisplayScene scene;
    DisplayPipeline pipeline;
    Image image;
    const auto redPixels = [&] {
        EXPECT_TRUE(scene.update(content).ok());
        EXPECT_TRUE(pipeline.draw(scene, topView(5.0), modeNamed(L"Shaded"), 100, 100, image).ok());
        return countReddish(image);
    };
    EXPECT_EQ(redPixels(), 1600);
    const Image before = image;
    content.meshes[small].visible = false;
    EXPECT_EQ(redPixels(), 0);
    content.meshes[large].visible = false;
    EXPECT_EQ(redPixels(), 0);
    EXPECT_GT(before.pixel(2, 2)[1], before.pixel(2, 2)[2] + 50);
    // The ground where the hills were.
    EXPECT_NEAR(image.pixel(2, 2)[1], image.pixel(2, 2)[2], 10);
    content.meshes[small].visible = true;
    EXPECT_EQ(redPixels(), 1600);
    content.meshes[large].visible = true;
    EXPECT_EQ(redPixels(), 1600);
    EXPECT_EQ(image.rgba, before.rgba);
}

TEST(SurfaceDrawing, TwoObjectsOfOneMeshAreHiddenOneByOne) {
    SceneContent content;
    addMesh(content, hillMesh(70), red);
    content.meshes.push_back(content.meshes[0]);
    content.meshes[1].visible = false;
    EXPECT_GT(countReddish(seenFromAbove(content, L"Shaded")), 9000);
    content.meshes[0].visible = false;
    EXPECT_EQ(countReddish(seenFromAbove(content, L"Shaded")), 0);
}

TEST(SurfaceDrawing, SceneIsBuiltAnewWhenTheRevisionChanges) {
    SceneContent content;
    addMesh(content, floorMesh(-2.0F, -2.0F, 2.0F, 2.0F, 0.0F), red);
    DisplayScene scene;
    ASSERT_TRUE(scene.update(content).ok());
    addMesh(content, floorMesh(-5.0F, -5.0F, 5.0F, 5.0F, 4.0F), blue);
    ASSERT_TRUE(scene.update(content).ok());
    EXPECT_EQ(scene.boundingBox().m_max.z, 4.0);
    DisplayPipeline pipeline;
    Image image;
    ASSERT_TRUE(pipeline.draw(scene, topView(5.0), modeNamed(L"Shaded"), 100, 100, image).ok());
    EXPECT_EQ(countReddish(image), 0);
}

TEST(SurfaceDrawing, AnyNumberOfThreadsDrawsTheSamePicture) {
    SceneContent content;
    addMesh(content, hillMesh(60), {150, 170, 120, 255});
    addMesh(content, sphereMesh({0.0, 0.0, 8.0}, 6.0F, 20), red);
    addMesh(content, boxMesh({10.0, 10.0, 0.0}, {14.0, 14.0, 12.0}), blue);
    content.lights.push_back(sunLight({0.5, 0.6, -0.7}));
    SceneCurve curve;
    curve.polyline.Append(KM_3dPoint(-20.0, -20.0, 5.0));
    curve.polyline.Append(KM_3dPoint(20.0, 20.0, 9.0));
    content.curves.push_back(curve);
    const KM_Viewport viewport = perspectiveView({-30.0, -60.0, 30.0}, {0.0, 0.0, 0.0});
    for (const DisplayModeAttributes& standard : standardDisplayModes()) {
        DisplayModeAttributes mode = standard;
        mode.antialiasing_level = 2;
        std::vector<Image> images;
        for (const int threads : {1, 2, 7}) {
            tbb::task_arena arena(threads);
            images.push_back(
                arena.execute([&] { return drawn(content, viewport, mode, 317, 203); }));
        }
        EXPECT_EQ(images[0].rgba, images[1].rgba) << KM_wString(standard.english_name).ToUtf8();
        EXPECT_EQ(images[0].rgba, images[2].rgba) << KM_wString(standard.english_name).ToUtf8();
    }
}

TEST(SurfaceDrawing, LoopsForEveryProcessorDrawTheSamePicture) {
    SceneContent content;
    addMesh(content, hillMesh(60), {150, 170, 120, 255});
    addMesh(content, sphereMesh({0.0, 0.0, 8.0}, 6.0F, 20), red);
    content.lights.push_back(sunLight({0.5, 0.6, -0.7}));
    const KM_Viewport viewport = perspectiveView({-30.0, -60.0, 30.0}, {0.0, 0.0, 0.0});
    DisplayScene scene;
    ASSERT_TRUE(scene.update(content).ok());
    for (const DisplayModeAttributes& standard : standardDisplayModes()) {
        DisplayModeAttributes mode = standard;
        mode.antialiasing_level = 2;
        Image best;
        ASSERT_TRUE(DisplayPipeline().draw(scene, viewport, mode, 317, 203, best).ok());
        Image plain;
        ASSERT_TRUE(
            DisplayPipeline(baseline_ray_kernel).draw(scene, viewport, mode, 317, 203, plain).ok());
        EXPECT_EQ(best.rgba, plain.rgba) << KM_wString(standard.english_name).ToUtf8();
    }
}

TEST(SurfaceDrawing, SmoothingChangesOnlyPixelsAtEdges) {
    SceneContent content;
    KM_Mesh mesh;
    mesh.m_V = {{-4.0F, -3.0F, 0.0F}, {4.0F, -1.0F, 0.0F}, {-1.0F, 4.0F, 0.0F}};
    mesh.m_F = {{{0, 1, 2}}};
    addMesh(content, std::move(mesh), red);
    const auto seen = [&](int level) {
        DisplayModeAttributes mode = modeNamed(L"Shaded", level);
        mode.has_ground_plane = false; // else its soft shadow changes too
        return drawn(content, topView(5.0), mode, 100, 100);
    };
    const Image rough = seen(0);
    const Image smooth = seen(2);
    int changed = 0;
    for (int y = 1; y < 99; ++y)
        for (int x = 1; x < 99; ++x) {
            if (samePixel(rough, x, y, smooth, x, y))
                continue;
            ++changed;
            const bool here = isReddish(rough, x, y);
            EXPECT_TRUE(isReddish(rough, x - 1, y) != here || isReddish(rough, x + 1, y) != here ||
                        isReddish(rough, x, y - 1) != here || isReddish(rough, x, y + 1) != here)
                << x << ' ' << y;
        }
    EXPECT_GT(changed, 150); // the sides are about 82, 58 and 76 pixels long
    EXPECT_LT(changed, 600);
}

TEST(SurfaceDrawing, SmoothedEdgeThroughAPixelsMiddleIsHalfCovered) {
    SceneContent content;
    DisplayModeAttributes mode = modeNamed(L"Drawing", 2);
    mode.draws_edges = false;
    mode.draws_outlines = false;
    mode.surface_style = SurfaceStyle::clay;
    mode.background_top = {0, 0, 0, 255};
    mode.background_bottom = {0, 0, 0, 255};
    addMesh(content, floorMesh(-5.0F, -5.0F, 0.05F, 5.0F, 0.0F)); // through the middles of x = 50
    const Image image = drawn(content, topView(5.0), mode, 100, 100);
    const auto linear = [](int value) { return value * value; }; // near enough for a ratio
    const double full = linear(image.pixel(20, 50)[0]);
    const double half = linear(image.pixel(50, 50)[0]);
    EXPECT_NEAR(half / full, 0.5, 0.12); // four or five of nine samples
    EXPECT_EQ(image.pixel(52, 50)[0], 0);
}

TEST(SurfaceDrawing, SceneWithoutAnythingShowsTheBackground) {
    const Image image = drawn({}, topView(5.0), modeNamed(L"Shaded", 2), 64, 48);
    const DisplayModeAttributes mode = modeNamed(L"Shaded");
    EXPECT_NEAR(image.pixel(10, 0)[0], mode.background_top.r, 1);
    EXPECT_NEAR(image.pixel(10, 47)[2], mode.background_bottom.b, 1);
    for (const DisplayModeAttributes& each : standardDisplayModes())
        EXPECT_GT(meanBrightness(drawn({}, topView(5.0), each, 33, 17)), 100.0);
}

TEST(SurfaceDrawing, OddAndTinySizesAreDrawnWhole) {
    SceneContent content;
    addMesh(content, floorMesh(-80.0F, -80.0F, 80.0F, 80.0F, 0.0F), red);
    for (const auto& [width, height] :
         {std::pair{1, 1}, {1, 7}, {13, 1}, {5, 3}, {67, 35}, {127, 129}}) {
        const Image image = drawn(content, topView(5.0), modeNamed(L"Rendered", 2), width, height);
        EXPECT_EQ(countReddish(image), width * height) << width << ' ' << height;
    }
}

TEST(SurfaceDrawing, SizesOutOfRangeAreRefusedWithTheSizeInTheMessage) {
    DisplayScene scene;
    DisplayPipeline pipeline;
    Image image;
    for (const auto& [width, height] : {std::pair{0, 10}, {10, -3}, {16385, 10}}) {
        const auto result =
            pipeline.draw(scene, topView(5.0), modeNamed(L"Shaded"), width, height, image);
        ASSERT_FALSE(result.ok());
        EXPECT_NE(result.message().find(std::to_string(width)), std::string::npos);
        EXPECT_TRUE(image.rgba.empty());
    }
}

TEST(SurfaceDrawing, DegenerateAndHostileMeshesAreDrawnWithoutHarm) {
    SceneContent content;
    KM_Mesh collapsed = floorMesh(0.0F, 0.0F, 0.0F, 0.0F, 1.0F);
    addMesh(content, collapsed, red);
    KM_Mesh line = floorMesh(-1.0F, 0.0F, 1.0F, 0.0F, 1.0F);
    line.ComputeVertexNormals();
    addMesh(content, line, red);
    KM_Mesh not_numbers = floorMesh(-1.0F, -1.0F, 1.0F, 1.0F, 2.0F);
    not_numbers.m_V[2].x = std::numeric_limits<float>::quiet_NaN();
    addMesh(content, not_numbers, red);
    KM_Mesh wrong_index = floorMesh(-1.0F, -1.0F, 1.0F, 1.0F, 2.0F);
    wrong_index.m_F[1].vi[2] = 77;
    addMesh(content, wrong_index, red);
    KM_Mesh short_normals = floorMesh(-1.0F, -1.0F, 1.0F, 1.0F, 2.0F);
    short_normals.m_N.emplace_back(0.0F, 0.0F, 1.0F);
    addMesh(content, short_normals, red);
    addMesh(content, KM_Mesh(), red);
    addMesh(content, floorMesh(-4.0F, -4.0F, 4.0F, 4.0F, 0.0F), blue);
    content.lights.push_back(sunLight({0.0, 0.0, -1.0}));
    for (const DisplayModeAttributes& mode : standardDisplayModes())
        EXPECT_GT(meanBrightness(drawn(content, topView(5.0), mode, 100, 100)), 20.0);
    const Image image = seenFromAbove(content, L"Shaded");
    EXPECT_GT(image.pixel(20, 80)[2], image.pixel(20, 80)[0] + 60); // the blue floor is there
}

TEST(SurfaceDrawing, CameraInsideAModelSeesItsWalls) {
    SceneContent content;
    addMesh(content, boxMesh({-5.0, -5.0, 0.0}, {5.0, 5.0, 3.0}), red);
    const KM_Viewport viewport = perspectiveView({0.0, 0.0, 1.5}, {3.0, 1.0, 1.5});
    const Image image = drawn(content, viewport, modeNamed(L"Shaded", 2), 80, 60);
    EXPECT_EQ(countReddish(image), 80 * 60);
}

TEST(SurfaceDrawing, PerspectiveShowsDoubleTheSizeAtHalfTheDistance) {
    SceneContent content;
    addMesh(content, boxMesh({-1.0, 0.0, -1.0}, {1.0, 0.5, 1.0}), red);
    const auto columns = [&](double distance) {
        const Image image = drawn(content, perspectiveView({0.0, -distance, 0.0}, {0.0, 0.0, 0.0}),
                                  modeNamed(L"Shaded"), 400, 400);
        int count = 0;
        for (int x = 0; x < 400; ++x)
            count += isReddish(image, x, 200) ? 1 : 0;
        return count;
    };
    EXPECT_NEAR(columns(10.0), 2 * columns(20.0), 2);
}

TEST(SurfaceDrawing, VertexColorsAndTexturesShowInRendered) {
    SceneContent content;
    KM_Mesh painted = floorMesh(-4.0F, -4.0F, 0.0F, 4.0F, 0.0F);
    painted.m_C.assign(4, KM_Color{255, 0, 0, 255});
    addMesh(content, std::move(painted), {255, 255, 255, 255});
    KM_Mesh tiled = floorMesh(0.0F, -4.0F, 4.0F, 4.0F, 0.0F);
    tiled.m_T = {{0.0F, 0.0F}, {1.0F, 0.0F}, {1.0F, 1.0F}, {0.0F, 1.0F}};
    addMesh(content, std::move(tiled), {255, 255, 255, 255});
    auto texture = std::make_shared<Texture>();
    texture->width = 1;
    texture->height = 2; // blue above green
    texture->rgba = {0, 0, 255, 255, 0, 255, 0, 255};
    texture->wrap_v = TextureWrap::clamp;
    auto material = std::make_shared<Material>();
    material->base_color = {255, 255, 255, 255};
    material->base_color_texture = texture;
    content.meshes[1].placed.material = material;
    const Image image = seenFromAbove(content, L"Rendered");
    EXPECT_TRUE(isReddish(image, 30, 50));
    EXPECT_GT(image.pixel(70, 15)[2], image.pixel(70, 15)[1] + 60);
    EXPECT_GT(image.pixel(70, 85)[1], image.pixel(70, 85)[2] + 60);
}

TEST(SurfaceDrawing, CutOutPartsOfASurfaceLetRaysAndSunlightPass) {
    SceneContent content;
    addMesh(content, floorMesh(-5.0F, -5.0F, 5.0F, 5.0F, 0.0F), blue);
    KM_Mesh leaf = floorMesh(-4.0F, -4.0F, 4.0F, 4.0F, 3.0F);
    leaf.m_T = {{0.0F, 0.0F}, {1.0F, 0.0F}, {1.0F, 1.0F}, {0.0F, 1.0F}};
    addMesh(content, std::move(leaf), red);
    auto texture = std::make_shared<Texture>();
    texture->width = 2;
    texture->height = 1; // the left half is clear
    texture->rgba = {255, 255, 255, 0, 255, 255, 255, 255};
    texture->wrap_u = TextureWrap::clamp;
    auto material = std::make_shared<Material>();
    material->base_color = red;
    material->base_color_texture = texture;
    material->alpha_cutout = true;
    content.meshes[1].placed.material = material;
    content.lights.push_back(sunLight({0.0, 0.0, -1.0}));
    const Image image = seenFromAbove(content, L"Rendered");
    EXPECT_TRUE(isReddish(image, 70, 50));
    EXPECT_FALSE(isReddish(image, 30, 50));
    EXPECT_TRUE(samePixel(image, 30, 50, image, 3, 50)); // as bright as the open floor
}

} // namespace
} // namespace quarn
