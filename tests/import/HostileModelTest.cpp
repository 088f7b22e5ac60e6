#include "tests/import/ModelFixtures.h"

#include <gmock/gmock.h>

namespace quarn::test {
namespace {

using ::testing::AllOf;
using ::testing::Contains;
using ::testing::HasSubstr;

const std::filesystem::path hostile = QUARN_SOURCE_DIR "/tests/data/hostile";

struct Refusal {
    const char* file;
    const char* reason;
};

class RefusedModel : public ::testing::TestWithParam<Refusal> {};

TEST_P(RefusedModel, GivesOneMessageThatNamesTheFileAndTheReason) {
    const auto path = hostile / GetParam().file;
    const auto model = readModelFile(path);
    ASSERT_FALSE(model.ok());
    EXPECT_THAT(model.message(), AllOf(HasSubstr("Cannot read '" + path.string() + "': "),
                                       HasSubstr(GetParam().reason)));
    EXPECT_EQ(model.message().find('\n'), std::string::npos);
    EXPECT_EQ(model.message().back(), '.');
}

INSTANTIATE_TEST_SUITE_P(
    Hostile, RefusedModel,
    ::testing::Values(
        Refusal{"empty.obj", "the file is empty. Choose a model file"},
        Refusal{"no_such_file.obj", "there is no such file"}, Refusal{"", "it is a folder"},
        Refusal{"escaping_names.mtl", "files of this kind are not known"},
        Refusal{"index_out_of_range.obj",
                "Line 4 names the vertex 9, but the file has 3 vertices."},
        Refusal{"negative_index_out_of_range.obj", "Line 4 names the vertex -9,"},
        Refusal{"header_only.ply", "its PLY header is damaged"},
        Refusal{"truncated.ply", "claims 2 elements of kind 'face' but ends before them"},
        Refusal{"huge_count.ply", "claims 2147483648 elements of kind 'face'"},
        Refusal{"huge_list.ply", "elements of kind 'face' but ends before them"},
        Refusal{"bad_index.ply", "out of range"},
        Refusal{"wrapped_index.ply", "line 13 holds the index 4294967298, which is out of range"},
        Refusal{"negative_index.ply", "line 13 holds the index -1, which is out of range"},
        Refusal{"short_face.ply", "line 13 ends after 2 of 3 corners"},
        Refusal{"wrapped_index.off", "line 6 holds the index 4294967298, which is out of range"},
        Refusal{"text.stl", "triangles but holds only 0"},
        Refusal{"wrong_count.stl", "claims 1000 triangles but holds only 1"},
        Refusal{"huge_count.stl", "claims 4294967295 triangles but holds only 1"},
        Refusal{"text.glb", "not a GLB file"},
        Refusal{"bad_length.glb", "lengths in its header do not fit"},
        Refusal{"cut_short.glb", "lengths in its header do not fit"},
        Refusal{"huge_accessor.gltf", "out of range"},
        Refusal{"escaping_buffer.gltf",
                "its buffer 0 is the file '../../../../../../etc/passwd', which lies outside the "
                "model's folder"},
        Refusal{"huge_count.off", "more vertices or faces than it holds"}));

TEST(HostileModel, TrianglesWithACoordinateThatIsNoNumberAreLeftOutWithAWarning) {
    const ImportedModel model = readOrFail(hostile / "one_nan_vertex.obj");
    ASSERT_EQ(model.meshes.size(), 1U);
    EXPECT_EQ(model.triangleCount(), 1U);
    EXPECT_EQ(model.meshes[0].placed.mesh->VertexCount(), 3);
    EXPECT_TRUE(model.meshes[0].placed.mesh->IsValid());
    EXPECT_THAT(model.warnings, Contains(HasSubstr("1 of 2 triangles were left out")));
}

TEST(HostileModel, CoordinatesThatCannotBeDrawnAreKept) {
    const ImportedModel model = readOrFail(hostile / "huge_coordinates.obj");
    ASSERT_EQ(model.meshes.size(), 1U);
    EXPECT_EQ(model.meshes[0].placed.mesh->m_V[2], KM_3fPoint(1e30F, 1e30F, 0.0F));
    EXPECT_TRUE(model.meshes[0].placed.mesh->IsValid());
}

TEST(HostileModel, ObjectsThatANodeMovesOutOfRangeAreKept) {
    const ImportedModel model = readOrFail(hostile / "far_instance.gltf");
    ASSERT_EQ(model.meshes.size(), 2U);
    EXPECT_EQ(model.meshes[1].placed.mesh, model.meshes[0].placed.mesh);
    EXPECT_GT(model.meshes[1].placed.box().m_min.x, 9e18);
}

TEST(HostileModel, NamesThatLeaveTheFolderAreNotFollowed) {
    const ImportedModel model = readOrFail(hostile / "escaping_names.obj");
    EXPECT_EQ(model.triangleCount(), 2U);
    for (const ImportedMesh& mesh : model.meshes) {
        ASSERT_NE(mesh.placed.material, nullptr);
        EXPECT_EQ(mesh.placed.material->base_color_texture, nullptr);
    }
    EXPECT_THAT(model.warnings, Contains("The texture '/etc/passwd' was left out: it lies outside "
                                         "the model's folder; copy it beside the model."));
    EXPECT_THAT(model.warnings, Contains(HasSubstr("'../../CMakeLists.txt' was left out")));
}

TEST(HostileModel, MaterialFileOutsideTheFolderIsNotRead) {
    const TemporaryFolder folder;
    folder.write("secret.mtl", "newmtl red\nKd 1 0 0\n");
    const auto path = folder.write(
        "model/a.obj", "mtllib ../secret.mtl\nv 0 0 0\nv 1 0 0\nv 0 1 0\nusemtl red\nf 1 2 3\n");
    const ImportedModel model = readOrFail(path);
    ASSERT_EQ(model.meshes.size(), 1U);
    const auto& material = model.meshes[0].placed.material;
    EXPECT_TRUE(material == nullptr || material->base_color != (KM_Color{255, 0, 0, 255}));
    EXPECT_THAT(model.warnings,
                Contains(AllOf(HasSubstr("secret.mtl"), HasSubstr("outside the model's folder"))));
}

TEST(HostileModel, LinkOutOfTheFolderIsNotFollowed) {
    const TemporaryFolder folder;
    folder.write("secret.mtl", "newmtl red\nKd 1 0 0\n");
    const auto path = folder.write(
        "model/a.obj", "mtllib a.mtl\nv 0 0 0\nv 1 0 0\nv 0 1 0\nusemtl red\nf 1 2 3\n");
    std::filesystem::create_symlink("../secret.mtl", folder.path() / "model/a.mtl");
    const ImportedModel model = readOrFail(path);
    ASSERT_EQ(model.meshes.size(), 1U);
    const auto& material = model.meshes[0].placed.material;
    EXPECT_TRUE(material == nullptr || material->base_color != (KM_Color{255, 0, 0, 255}));
}

TEST(HostileModel, FileWithOnlyCommentsHasNothingToShow) {
    const TemporaryFolder folder;
    const auto model = readModelFile(folder.write("a.obj", "# no vertex, no face, only words\n"));
    ASSERT_FALSE(model.ok());
    EXPECT_THAT(model.message(), HasSubstr("a.obj"));
}

TEST(HostileModel, UnreadableFileIsRefusedUnlessOneIsRoot) {
    const TemporaryFolder folder;
    const auto path = folder.write("a.obj", "v 0 0 0\nv 1 0 0\nv 0 1 0\nf 1 2 3\n");
    std::filesystem::permissions(path, std::filesystem::perms::none);
    const auto model = readModelFile(path);
    const bool is_root = geteuid() == 0;
    EXPECT_EQ(model.ok(), is_root);
    if (!is_root) {
        EXPECT_THAT(model.message(), HasSubstr("it cannot be opened"));
    }
}

TEST(HostileModel, NodesNestedAHundredThousandDeepAreFollowed) {
    constexpr int depth = 100'000;
    std::string nodes;
    for (int i = 1; i <= depth; ++i) {
        nodes += R"({"children":[)" + std::to_string(i) + R"(],"translation":[0,0.001,0]},)";
    }
    const TemporaryFolder folder;
    const auto path = folder.write(
        "deep.gltf",
        R"({"asset":{"version":"2.0"},"scene":0,"scenes":[{"nodes":[0]}],"nodes":[)" + nodes +
            R"({"mesh":0}],"meshes":[{"primitives":[{"attributes":{"POSITION":0}}]}],)"
            R"("accessors":[{"bufferView":0,"componentType":5126,"count":3,"type":"VEC3"}],)"
            R"("bufferViews":[{"buffer":0,"byteLength":36}],"buffers":[{"byteLength":36,"uri":)"
            R"("data:application/octet-stream;base64,AAAAAAAAAAAAAAAAAACAPwAAAAAAAAAAAAAAAAAAgD8AAAAA"}]})");
    const ImportedModel model = readOrFail(path);
    ASSERT_EQ(model.triangleCount(), 1U);
    EXPECT_NEAR(boundsOf(model).m_min.z, 100.0, 0.01); // Y is up in the file, 1 mm a level
}

} // namespace
} // namespace quarn::test
