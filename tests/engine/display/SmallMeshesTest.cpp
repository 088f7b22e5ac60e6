#include "tests/engine/display/DisplayFixture.h"

#include <gtest/gtest.h>

namespace quarn {
namespace {

constexpr int spheres_in_row = 6;
constexpr std::size_t in_the_middle = 14;

/// Thirty-six spheres of 960 triangles each, beside each other, each an object.
SceneContent manySpheres() {
    SceneContent content;
    for (int i = 0; i < spheres_in_row * spheres_in_row; ++i) {
        const KM_3dPoint center(2.0 * (i % spheres_in_row) - 5.0, 2.0 * (i / spheres_in_row) - 5.0,
                                0.0);
        addMesh(content, sphereMesh(center, 0.9F, 16),
                i % 2 == 0 ? KM_Color{220, 90, 60, 255} : KM_Color{60, 120, 220, 255});
    }
    return content;
}

Image pictureOf(const DisplayScene& scene) {
    DisplayPipeline pipeline;
    Image image;
    const Result<void> result =
        pipeline.draw(scene, topView(6.0), modeNamed(L"Rendered"), 120, 120, image);
    EXPECT_TRUE(result.ok()) << result.message();
    return image;
}

TEST(SmallMeshes, ManyShareOneSearchStructureUntilOneIsHidden) {
    SceneContent content = manySpheres();
    DisplayScene scene;
    ASSERT_TRUE(scene.update(content).ok());
    EXPECT_EQ(scene.rays().buildCount(), 1U);
    EXPECT_FALSE(scene.rays().hasInstances());
    content.meshes[in_the_middle].visible = false;
    ASSERT_TRUE(scene.update(content).ok());
    EXPECT_TRUE(scene.rays().hasInstances());
    EXPECT_EQ(scene.rays().geometryCount(), content.meshes.size());
}

TEST(SmallMeshes, OnceOneWasHiddenShowingItAgainRebuildsOnlyItsNeighbours) {
    SceneContent content = manySpheres();
    DisplayScene scene;
    ASSERT_TRUE(scene.update(content).ok());
    content.meshes[in_the_middle].visible = false;
    ASSERT_TRUE(scene.update(content).ok());
    const std::size_t built = scene.rays().buildCount();
    content.meshes[in_the_middle].visible = true;
    ASSERT_TRUE(scene.update(content).ok());
    EXPECT_EQ(scene.rays().buildCount(), built + 2); // the neighbours and what stands above all
}

TEST(SmallMeshes, AHiddenOneIsGoneAndAllOthersKeepTheirColors) {
    SceneContent content = manySpheres();
    DisplayScene scene;
    ASSERT_TRUE(scene.update(content).ok());
    const Image before = pictureOf(scene);
    content.meshes[in_the_middle].visible = false;
    ASSERT_TRUE(scene.update(content).ok());
    const Image after = pictureOf(scene);
    for (int i = 0; i < spheres_in_row * spheres_in_row; ++i) {
        const int x = 20 * (i % spheres_in_row) + 10;
        const int y = 120 - (20 * (i / spheres_in_row) + 10);
        const bool hidden = i == static_cast<int>(in_the_middle);
        EXPECT_EQ(samePixel(before, x, y, after, x, y), !hidden) << "sphere " << i;
    }
}

TEST(SmallMeshes, HiddenFromTheBeginningOrLaterThePictureIsTheSame) {
    SceneContent content = manySpheres();
    DisplayScene scene;
    ASSERT_TRUE(scene.update(content).ok());
    content.meshes[in_the_middle].visible = false;
    ASSERT_TRUE(scene.update(content).ok());
    DisplayScene hidden_from_the_beginning;
    ASSERT_TRUE(hidden_from_the_beginning.update(content).ok());
    EXPECT_EQ(pictureOf(scene).rgba, pictureOf(hidden_from_the_beginning).rgba);
}

} // namespace
} // namespace quarn
