#include "tests/import/GltfFixture.h"

#include <gmock/gmock.h>

namespace quarn::test {
namespace {

using ::testing::HasSubstr;
using ::testing::SizeIs;

/// A text PLY of vertices and triangles.
std::string ply(int vertices, const std::string& more_properties, int faces,
                const std::string& lines, const std::string& index_type = "int") {
    return "ply\nformat ascii 1.0\nelement vertex " + std::to_string(vertices) +
           "\nproperty float x\nproperty float y\nproperty float z\n" + more_properties +
           "element face " + std::to_string(faces) + "\nproperty list uchar " + index_type +
           " vertex_indices\nend_header\n" + lines;
}

TEST(PlyColours, BytesAreKeptWithTheirAlpha) {
    const TemporaryFolder folder;
    const std::string properties = "property uchar red\nproperty uchar green\n"
                                   "property uchar blue\nproperty uchar alpha\n";
    const ImportedModel model = readOrFail(folder.write(
        "a.ply", ply(3, properties, 1,
                     "0 0 0 255 0 10 255\n1 0 0 20 200 30 128\n0 1 0 1 2 3 0\n3 0 1 2\n")));
    ASSERT_THAT(model.meshes, SizeIs(1));
    const auto& colors = model.meshes[0].placed.mesh->m_C;
    ASSERT_THAT(colors, SizeIs(3));
    EXPECT_EQ(colors[0], (KM_Color{255, 0, 10, 255}));
    EXPECT_EQ(colors[1], (KM_Color{20, 200, 30, 128}));
    EXPECT_EQ(colors[2], (KM_Color{1, 2, 3, 0}));
}

TEST(PlyColours, NumbersFromNothingToOneAreSharesOfFullColour) {
    const TemporaryFolder folder;
    const std::string properties = "property float red\nproperty float green\n"
                                   "property float blue\n";
    const ImportedModel model = readOrFail(
        folder.write("a.ply", ply(3, properties, 1,
                                  "0 0 0 1 0 0.2\n1 0 0 0.4 0.6 0.8\n0 1 0 0 0 0\n3 0 1 2\n")));
    ASSERT_THAT(model.meshes, SizeIs(1));
    const auto& colors = model.meshes[0].placed.mesh->m_C;
    ASSERT_THAT(colors, SizeIs(3));
    EXPECT_EQ(colors[0], (KM_Color{255, 0, 51, 255}));
    EXPECT_EQ(colors[1], (KM_Color{102, 153, 204, 255}));
    EXPECT_EQ(colors[2], (KM_Color{0, 0, 0, 255}));
}

class MeshWithoutArea : public testing::TestWithParam<const char*> {};

TEST_P(MeshWithoutArea, IsReadWithAMessage) {
    const TemporaryFolder folder;
    Result<ImportedModel> model = readModelFile(folder.write("a.ply", GetParam()));
    if (!model.ok()) {
        EXPECT_THAT(model.message(), HasSubstr("a.ply"));
        EXPECT_THAT(model.message(), HasSubstr("no area"));
        return;
    }
    ASSERT_THAT(model.value().warnings, SizeIs(1));
    EXPECT_THAT(model.value().warnings[0], HasSubstr("no area"));
}

const std::string one_place = ply(3, "", 2, "1 2 3\n1 2 3\n1 2 3\n3 0 1 2\n3 2 1 0\n");
const std::string one_vertex = ply(3, "", 1, "1 2 3\n4 5 6\n1 0 3\n3 1 1 1\n");
const std::string one_line = ply(3, "", 1, "0 0 0\n1 1 1\n3 3 3\n3 0 1 2\n");

INSTANTIATE_TEST_SUITE_P(Ply, MeshWithoutArea,
                         testing::Values(one_place.c_str(), one_vertex.c_str(), one_line.c_str()));

TEST(MeshWithArea, IsReadWithoutAMessageHoweverManyTrianglesHaveNone) {
    const TemporaryFolder folder;
    const ImportedModel model = readOrFail(
        folder.write("a.ply", ply(3, "", 3, "0 0 0\n1 0 0\n0 1 0\n3 0 0 0\n3 1 1 2\n3 0 1 2\n")));
    EXPECT_THAT(model.warnings, SizeIs(0));
    const ImportedModel tiny =
        readOrFail(folder.write("b.ply", ply(3, "", 1, "0 0 0\n1e-20 0 0\n0 1e-20 0\n3 0 1 2\n")));
    EXPECT_THAT(tiny.warnings, SizeIs(0));
}

void expectRefused(const std::filesystem::path& path) {
    const Result<ImportedModel> model = readModelFile(path);
    ASSERT_FALSE(model.ok());
    EXPECT_THAT(model.message(), HasSubstr(path.string()));
    EXPECT_THAT(model.message(), HasSubstr("out of range"));
}

class PlyIndex : public testing::TestWithParam<const char*> {};

TEST_P(PlyIndex, BeyondTheVerticesIsRefused) {
    const TemporaryFolder folder;
    const std::string lines = std::string("0 0 0\n1 0 0\n0 1 0\n3 0 1 ") + GetParam() + "\n";
    expectRefused(folder.write("int.ply", ply(3, "", 1, lines)));
    expectRefused(folder.write("uint.ply", ply(3, "", 1, lines, "uint")));
}

INSTANTIATE_TEST_SUITE_P(Ply, PlyIndex,
                         testing::Values("3", "2147483646", "2147483647", "2147483648",
                                         "4294967293", "4294967295"));

class BinaryPlyIndex : public testing::TestWithParam<std::uint32_t> {};

TEST_P(BinaryPlyIndex, BeyondTheVerticesIsRefused) {
    const TemporaryFolder folder;
    for (const char* const type : {"int", "uint"}) {
        std::string bytes = ply(3, "", 1, "", type);
        bytes.replace(bytes.find("ascii"), 5, "binary_little_endian");
        const float places[9] = {0, 0, 0, 1, 0, 0, 0, 1, 0};
        bytes.append(reinterpret_cast<const char*>(places), sizeof(places));
        bytes += '\3';
        const std::uint32_t indices[3] = {0, 1, GetParam()};
        bytes.append(reinterpret_cast<const char*>(indices), sizeof(indices));
        expectRefused(folder.write("a.ply", bytes));
    }
}

class GltfIndex : public testing::TestWithParam<std::uint32_t> {};

TEST_P(GltfIndex, BeyondTheVerticesLeavesItsTriangleOut) {
    const TemporaryFolder folder;
    GltfSquare square;
    square.indices[5] = GetParam();
    EXPECT_EQ(readOrFail(square.write(folder)).triangleCount(), 1U);
}

const auto beyond = testing::Values(4U, 0x7FFFFFFFU, 0x80000000U, 0xFFFFFFFDU, 0xFFFFFFFFU);
INSTANTIATE_TEST_SUITE_P(Ply, BinaryPlyIndex, beyond);
INSTANTIATE_TEST_SUITE_P(Gltf, GltfIndex, beyond);

} // namespace
} // namespace quarn::test
