// Meshes that the file bends or repeats: skins, morph targets, instances.

#include "tests/import/gltf/GltfWriter.h"

#include <gmock/gmock.h>

#include <cmath>

namespace quarn::test {
namespace {

using ::testing::HasSubstr;
using ::testing::SizeIs;

using Json = GltfWriter::Json;

/// A triangle whose first two vertices follow joint 0 and whose third follows joint 1. Node 0 is
/// the mesh, nodes 1 and 2 are the joints, of which the second hangs on the first.
GltfWriter skinned(const std::vector<float>& weights, std::uint8_t last_joint = 1) {
    GltfWriter gltf;
    gltf.triangle();
    const std::vector<std::uint8_t> joints{0, 0, 0, 0, 0, 0, 0, 0, last_joint, 0, 0, 0};
    gltf.primitive()["attributes"]["JOINTS_0"] =
        gltf.accessor(gltf.view(GltfWriter::bytesOf(joints)), 3, "VEC4", 5121);
    gltf.primitive()["attributes"]["WEIGHTS_0"] = gltf.floats(weights, "VEC4");
    gltf.primitive()["attributes"]["NORMAL"] = gltf.floats({0, 0, 1, 0, 0, 1, 0, 1, 0}, "VEC3");
    // The bind pose had joint 1 at (0, 1, 0): columns of the inverse.
    const std::vector<float> inverse{1, 0, 0, 0, 0, 1, 0, 0, 0, 0, 1, 0, 0, 0,  0, 1,
                                     1, 0, 0, 0, 0, 1, 0, 0, 0, 0, 1, 0, 0, -1, 0, 1};
    gltf.json["skins"] = {
        {{"joints", {1, 2}}, {"inverseBindMatrices", gltf.floats(inverse, "MAT4")}}};
    gltf.node()["skin"] = 0;
    gltf.json["nodes"].push_back({{"children", {2}}, {"translation", {10, 0, 0}}});
    // Joint 1 is turned by a quarter about x: y becomes z.
    const double half = std::sqrt(0.5);
    gltf.json["nodes"].push_back({{"translation", {0, 4, 0}}, {"rotation", {half, 0, 0, half}}});
    return gltf;
}

const std::vector<float> FULL{1, 0, 0, 0, 1, 0, 0, 0, 1, 0, 0, 0};

TEST(GltfSkin, StandsInThePoseOfTheNodesWhateverTheNodeOfTheMeshDoes) {
    GltfWriter gltf = skinned(FULL);
    for (const Json& move : {Json{0, 0, 0}, Json{100, 50, 20}}) {
        gltf.node()["translation"] = move;
        const ImportedModel model = gltf.read();
        ASSERT_THAT(model.meshes, SizeIs(1));
        expectCorners(model.meshes[0], {{10, 0, 0}, {11, 0, 0}, {10, 4, 0}});
        const KM_Mesh& mesh = *model.meshes[0].placed.mesh;
        // (0, 1, 0) turns to (0, 0, 1), which points to -y where z is up.
        const KM_3fVector& normal = mesh.m_N[mesh.m_F[0].vi[2]];
        EXPECT_NEAR(normal.y, -1.0F, 1e-6F);
    }
}

TEST(GltfSkin, TakesTheMeanOfItsJointsByWeightsThatNeedNotMakeOne) {
    GltfWriter gltf = skinned(FULL);
    // The second vertex follows both joints, 3 to 1. Joint 1 takes (1, 0, 0), which lies at
    // (1, -1, 0) from it, to (11, 4, -1).
    const std::vector<std::uint8_t> joints{0, 0, 0, 0, 0, 1, 0, 0, 1, 0, 0, 0};
    gltf.primitive()["attributes"]["JOINTS_0"] =
        gltf.accessor(gltf.view(GltfWriter::bytesOf(joints)), 3, "VEC4", 5121);
    gltf.primitive()["attributes"]["WEIGHTS_0"] =
        gltf.floats({2, 0, 0, 0, 6, 2, 0, 0, 0.5F, 0, 0, 0}, "VEC4");
    const ImportedModel model = gltf.read();
    ASSERT_THAT(model.meshes, SizeIs(1));
    expectCorners(model.meshes[0], {{10, 0, 0}, {11, 1, -0.25}, {10, 4, 0}});
}

TEST(GltfSkin, WhoseVerticesFollowAJointThatIsNotThereIsRefused) {
    EXPECT_THAT(skinned(FULL, 2).refusal(),
                HasSubstr("vertex 2 of accessor 0 follows a joint that is out of range: its skin "
                          "has 2"));
    GltfWriter idle = skinned({1, 0, 0, 0, 1, 0, 0, 0, 0, 1, 0, 0}, 2);
    EXPECT_EQ(idle.read().triangleCount(), 1U) << "a joint without a weight counts for nothing";
}

TEST(GltfSkin, WithTooFewMatricesOrAStrangeJointIsRefused) {
    GltfWriter few = skinned(FULL);
    few.json["skins"][0]["joints"] = {1, 2, 1};
    EXPECT_THAT(few.refusal(), HasSubstr("2 matrices for 3 joints"));
    GltfWriter strange = skinned(FULL);
    strange.json["skins"][0]["joints"] = {1, 99};
    EXPECT_THAT(strange.refusal(), HasSubstr("joint 1 of a skin is a node that is not there"));
}

/// Two targets, of which the first lifts the last vertex by 2 and the second moves it by 8.
GltfWriter morphed() {
    GltfWriter gltf;
    gltf.triangle();
    gltf.primitive()["attributes"]["NORMAL"] = gltf.floats({0, 0, 1, 0, 0, 1, 0, 0, 1}, "VEC3");
    gltf.primitive()["targets"] = {
        {{"POSITION", gltf.floats({0, 0, 0, 0, 0, 0, 0, 2, 0}, "VEC3")},
         {"NORMAL", gltf.floats({0, 0, 0, 0, 0, 0, 2, 0, -2}, "VEC3")}},
        {{"POSITION", gltf.floats({0, 0, 0, 0, 0, 0, 8, 0, 0}, "VEC3")}}};
    return gltf;
}

TEST(GltfMorph, TakesTheWeightsOfTheMesh) {
    GltfWriter gltf = morphed();
    gltf.json["meshes"][0]["weights"] = {0.5, 0.25};
    const ImportedModel model = gltf.read();
    ASSERT_THAT(model.meshes, SizeIs(1));
    expectCorners(model.meshes[0], {{0, 0, 0}, {1, 0, 0}, {2, 2, 0}});
    const KM_Mesh& mesh = *model.meshes[0].placed.mesh;
    EXPECT_EQ(mesh.m_N[mesh.m_F[0].vi[2]], KM_3fVector(1.0F, 0.0F, 0.0F));
}

TEST(GltfMorph, TakesTheWeightsOfTheNodeBeforeThoseOfTheMesh) {
    GltfWriter gltf = morphed();
    gltf.json["meshes"][0]["weights"] = {0.5, 0.25};
    gltf.json["nodes"].push_back({{"mesh", 0}, {"weights", {1, 0}}});
    gltf.json["nodes"].push_back({{"mesh", 0}});
    const ImportedModel model = gltf.read();
    ASSERT_THAT(model.meshes, SizeIs(3));
    expectCorners(model.meshes[1], {{0, 0, 0}, {1, 0, 0}, {0, 3, 0}});
    EXPECT_EQ(model.meshes[0].placed.mesh, model.meshes[2].placed.mesh);
}

TEST(GltfMorph, WithoutWeightsChangesNothing) {
    const ImportedModel model = morphed().read();
    ASSERT_THAT(model.meshes, SizeIs(1));
    expectCorners(model.meshes[0], {{0, 0, 0}, {1, 0, 0}, {0, 1, 0}});
}

TEST(GltfInstances, StandWhereTheirListsSayAndShareTheirMesh) {
    GltfWriter gltf;
    gltf.triangle();
    std::vector<float> moves;
    std::vector<float> turns;
    std::vector<float> scales;
    for (int i = 0; i < 25; ++i) {
        moves.insert(moves.end(), {static_cast<float>(i), 0, 0});
        turns.insert(turns.end(), {0, 0, std::sqrt(0.5F), std::sqrt(0.5F)}); // x becomes y
        scales.insert(scales.end(), {2, 3, 1});
    }
    gltf.json["extensionsRequired"] = {"EXT_mesh_gpu_instancing"};
    gltf.node()["translation"] = {0, 100, 0};
    gltf.node()["extensions"]["EXT_mesh_gpu_instancing"]["attributes"] = {
        {"TRANSLATION", gltf.floats(moves, "VEC3")},
        {"ROTATION", gltf.floats(turns, "VEC4")},
        {"SCALE", gltf.floats(scales, "VEC3")}};
    const ImportedModel model = gltf.read();
    ASSERT_THAT(model.meshes, SizeIs(25));
    for (int i = 0; i < 25; ++i) {
        const ImportedMesh& instance = model.meshes[static_cast<std::size_t>(i)];
        EXPECT_EQ(instance.placed.mesh, model.meshes[0].placed.mesh);
        expectCorners(instance, {{1.0 * i, 100, 0}, {1.0 * i, 102, 0}, {i - 3.0, 100, 0}}, 1e-5);
    }
}

TEST(GltfInstances, OfACountThatNothingHoldsAreRefused) {
    GltfWriter gltf;
    gltf.triangle();
    const std::size_t list = gltf.floats({0, 0, 0}, "VEC3");
    gltf.node()["extensions"]["EXT_mesh_gpu_instancing"]["attributes"]["TRANSLATION"] = list;
    gltf.json["accessors"][list]["count"] = 1e19;
    EXPECT_THAT(gltf.refusal(), HasSubstr("accessor 1 is out of range"));
    gltf.json["accessors"][list].erase("bufferView");
    EXPECT_THAT(gltf.refusal(), HasSubstr("its repeated objects need"));
    gltf.json["meshes"][0]["primitives"] = Json::array();
    EXPECT_THAT(gltf.refusal(), HasSubstr("it holds no triangles"));
}

} // namespace
} // namespace quarn::test
