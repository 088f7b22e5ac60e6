// Models that others made, from the Debian package assimp-testmodels. The expected numbers were
// counted from the files themselves: polygons of n corners are n - 2 triangles, and the corners
// that they use span the box (of glTF after the nodes' matrices, with Y turned to Z).

#include "tests/import/ModelFixtures.h"

#include <gmock/gmock.h>

namespace quarn::test {
namespace {

const std::filesystem::path samples = QUARN_SAMPLE_MODELS;

struct Sample {
    const char* file;
    std::size_t triangles;
    KM_3dPoint low;
    KM_3dPoint high;
};

class SampleModel : public ::testing::TestWithParam<Sample> {};

TEST_P(SampleModel, HasTheTrianglesAndTheSizeThatItsFileStates) {
    const Sample& sample = GetParam();
    const ImportedModel model = readOrFail(samples / sample.file);
    EXPECT_EQ(model.triangleCount(), sample.triangles);
    const KM_BoundingBox bounds = boundsOf(model);
    const double tolerance = 1e-5 * (sample.high - sample.low).Length();
    expectNear(bounds.m_min, sample.low, tolerance);
    expectNear(bounds.m_max, sample.high, tolerance);
    for (const ImportedMesh& mesh : model.meshes) {
        KM_wString why;
        EXPECT_TRUE(mesh.placed.mesh->IsValid(&why)) << why.ToUtf8();
        EXPECT_EQ(mesh.placed.mesh->m_N.size(), mesh.placed.mesh->m_V.size());
        EXPECT_FALSE(mesh.name.IsEmpty());
    }
}

INSTANTIATE_TEST_SUITE_P(
    Debian, SampleModel,
    ::testing::Values(Sample{"OBJ/spider.obj",
                             1368,
                             {-92.655235, -42.233826, -106.6912},
                             {57.936218, 37.503952, 86.6912}},
                      Sample{"STL/Spider_binary.stl",
                             1368,
                             {-3.1148949, -4.0, -1.6493286},
                             {3.1148949, 4.0, 1.6493286}},
                      Sample{"PLY/Wuson.ply",
                             3732,
                             {-0.459976, -0.000566, -1.622242},
                             {0.459976, 1.515251, 1.622242}},
                      Sample{"glTF2/2CylinderEngine-glTF-Binary/2CylinderEngine.glb",
                             121496,
                             {-371.692263, -127.999996, -180.971558},
                             {371.692169, 139.999993, 92.041562}}));

TEST(SampleModels, ObjFindsItsMaterialsAndTheTexturesBesideIt) {
    const ImportedModel model = readOrFail(samples / "OBJ/spider.obj");
    EXPECT_EQ(model.meshes.size(), 19U);
    for (const ImportedMesh& mesh : model.meshes) {
        ASSERT_NE(mesh.placed.material, nullptr) << mesh.name.ToUtf8();
        EXPECT_NE(mesh.placed.material->base_color_texture, nullptr) << mesh.name.ToUtf8();
    }
    EXPECT_THAT(model.warnings, ::testing::IsEmpty());
}

TEST(SampleModels, GlbHoldsItsTextureInItself) {
    const ImportedModel model =
        readOrFail(samples / "glTF2/BoxTextured-glTF-Binary/BoxTextured.glb");
    ASSERT_EQ(model.meshes.size(), 1U);
    ASSERT_NE(model.meshes[0].placed.material, nullptr);
    ASSERT_NE(model.meshes[0].placed.material->base_color_texture, nullptr);
    EXPECT_EQ(model.meshes[0].placed.material->base_color_texture->width, 211);
}

TEST(SampleModels, FbxFindsByNameWhatItStatesByThePathOfAnotherMachine) {
    const ImportedModel model = readOrFail(samples / "FBX/spider.fbx");
    EXPECT_EQ(model.triangleCount(), 1368U);
    const KM_3dVector size = boundsOf(model).Diagonal();
    EXPECT_LT(size.z, size.y); // a spider is flatter than it is long, and stands on its feet
    EXPECT_EQ(model.cameras.size(), 1U);
}

TEST(SampleModels, InfiniteCoordinatesAreRefused) {
    const auto model =
        readModelFile(samples / "glTF2/BoxWithInfinites-glTF-Binary/BoxWithInfinites.glb");
    ASSERT_FALSE(model.ok());
    EXPECT_THAT(model.message(), ::testing::HasSubstr("12 triangles were left out"));
}

} // namespace
} // namespace quarn::test
