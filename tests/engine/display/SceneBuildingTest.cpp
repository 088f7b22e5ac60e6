#include "engine/display/BuildProgress.h"
#include "tests/engine/display/DisplayFixture.h"

#include <gtest/gtest.h>

namespace quarn {
namespace {

constexpr int ROWS_OF_LARGE = 64; // 16 128 triangles: it has a search structure of its own

void addSphere(SceneContent& content, double x, int rows) {
    addMesh(content, sphereMesh({x, 0.0, 0.0}, 0.9F, rows), {220, 90, 60, 255});
    ++content.revision;
}

std::vector<std::uint8_t> pictureOf(const DisplayScene& scene) {
    DisplayPipeline pipeline;
    Image image;
    const Result<void> result =
        pipeline.draw(scene, topView(3.0), modeNamed(L"Rendered"), 120, 120, image);
    EXPECT_TRUE(result.ok()) << result.message();
    return image.rgba;
}

std::vector<std::uint8_t> freshPictureOf(const SceneContent& content) {
    DisplayScene scene;
    EXPECT_TRUE(scene.update(content).ok());
    return pictureOf(scene);
}

TEST(SceneBuilding, TellsHowFarItIs) {
    SceneContent content;
    addSphere(content, -1.0, ROWS_OF_LARGE);
    addSphere(content, 1.0, 16);
    DisplayScene scene;
    BuildProgress progress;
    ASSERT_TRUE(scene.update(content, &progress).ok());
    EXPECT_DOUBLE_EQ(progress.share, 1.0);
    EXPECT_EQ(pictureOf(scene), freshPictureOf(content));
}

TEST(SceneBuilding, ThatIsGivenUpLeavesNothingAndNoError) {
    const auto mesh = std::make_shared<const RayMesh>(
        std::make_shared<const KM_Mesh>(sphereMesh({0.0, 0.0, 0.0}, 0.9F, ROWS_OF_LARGE)));
    std::vector<RayScene::Member> members = {{mesh, {}, true, KM_Xform()}};
    RayScene rays;
    BuildProgress given_up;
    given_up.is_given_up = true;
    rays.build(members, &given_up);
    EXPECT_EQ(rays.root(), nullptr);
    EXPECT_EQ(rays.buildCount(), 0U);
    EXPECT_EQ(rays.takeError(), "");
    rays.build(members);
    EXPECT_NE(rays.root(), nullptr) << "the next one is built";
    EXPECT_EQ(rays.takeError(), "");
}

TEST(SceneBuilding, GivenUpEarlyLeavesAnEmptySceneThatTheNextUpdateFills) {
    SceneContent content;
    addSphere(content, 0.0, 16);
    DisplayScene scene;
    BuildProgress progress;
    progress.is_given_up = true;
    EXPECT_FALSE(scene.update(content, &progress).ok());
    EXPECT_TRUE(scene.meshes().empty());
    ASSERT_TRUE(scene.update(content).ok());
    EXPECT_EQ(pictureOf(scene), freshPictureOf(content));
}

TEST(SceneBuilding, ASceneThatSharesBuildsOnlyWhatIsNew) {
    SceneContent content;
    addSphere(content, -1.0, ROWS_OF_LARGE);
    DisplayScene earlier;
    ASSERT_TRUE(earlier.update(content).ok());
    const auto picture = pictureOf(earlier);

    addSphere(content, 1.0, ROWS_OF_LARGE);
    DisplayScene scene;
    scene.shareWith(earlier);
    ASSERT_TRUE(scene.update(content).ok());
    EXPECT_EQ(scene.rays().buildCount(), 2U) << "the new sphere and what stands above both";
    EXPECT_EQ(pictureOf(scene), freshPictureOf(content));
    EXPECT_EQ(pictureOf(earlier), picture);
}

TEST(SceneBuilding, ASceneThatSharesOutlivesTheOtherOne) {
    SceneContent content;
    addSphere(content, -1.0, ROWS_OF_LARGE);
    DisplayScene scene;
    {
        DisplayScene earlier;
        ASSERT_TRUE(earlier.update(content).ok());
        scene.shareWith(earlier);
    }
    addSphere(content, 1.0, 16);
    ASSERT_TRUE(scene.update(content).ok());
    EXPECT_EQ(pictureOf(scene), freshPictureOf(content));
}

TEST(SceneBuilding, ACurveThatIsAddedBuildsNoMeshAgain) {
    SceneContent content;
    addSphere(content, -1.0, 16);
    addSphere(content, 1.0, 16);
    content.meshes.front().visible = false;
    DisplayScene scene;
    ASSERT_TRUE(scene.update(content).ok());
    const std::size_t built = scene.rays().buildCount();
    KM_3dPointArray line;
    line.Append(KM_3dPoint(-2.0, 2.0, 0.0));
    line.Append(KM_3dPoint(2.0, 2.0, 0.0));
    content.curves.push_back({KM_CreateUuid(), line});
    ++content.revision;
    ASSERT_TRUE(scene.update(content).ok());
    EXPECT_EQ(scene.rays().buildCount(), built);
    EXPECT_EQ(pictureOf(scene), freshPictureOf(content));
}

} // namespace
} // namespace quarn
