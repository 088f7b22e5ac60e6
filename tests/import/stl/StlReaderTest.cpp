#include "tests/import/ModelFixtures.h"

#include <gmock/gmock.h>

#include <cstring>

namespace quarn::test {
namespace {

using ::testing::Contains;
using ::testing::ElementsAre;
using ::testing::HasSubstr;
using ::testing::IsEmpty;
using ::testing::SizeIs;

constexpr float FIRST[9] = {0, 0, 0, 1, 0, 0, 0, 1, 0};
constexpr float SECOND[9] = {1, 0, 0, 1, 1, 0, 0, 1, 0};

std::string binary(std::string header, std::uint32_t claimed) {
    header.resize(80, '\0');
    header.append(reinterpret_cast<const char*>(&claimed), sizeof claimed);
    return header;
}

std::string facet(const float (&corners)[9], std::uint16_t attributes = 0) {
    std::string bytes(12, '\0');
    bytes.append(reinterpret_cast<const char*>(corners), sizeof corners);
    bytes.append(reinterpret_cast<const char*>(&attributes), sizeof attributes);
    return bytes;
}

std::string facetText(const std::string& a, const std::string& b, const std::string& c) {
    return "facet normal 0 0 1\n outer loop\n  vertex " + a + "\n  vertex " + b + "\n  vertex " +
           c + "\n endloop\nendfacet\n";
}

ImportedModel read(const std::string& bytes) {
    const TemporaryFolder folder;
    return readOrFail(folder.write("a.stl", bytes));
}

std::string whyNot(const std::string& bytes) {
    const TemporaryFolder folder;
    const auto model = readModelFile(folder.write("a.stl", bytes));
    return model.ok() ? "it was read" : model.message();
}

std::vector<KM_Color> colorsOf(const std::string& bytes) {
    const ImportedModel model = read(bytes);
    EXPECT_THAT(model.meshes, SizeIs(1));
    return model.meshes.empty() ? std::vector<KM_Color>() : model.meshes[0].placed.mesh->m_C;
}

TEST(StlReader, ABinaryFileMayBeginAsTextsDo) {
    const ImportedModel model =
        read(binary("solid of a program", 2) + facet(FIRST) + facet(SECOND));
    ASSERT_THAT(model.meshes, SizeIs(1));
    EXPECT_EQ(model.meshes[0].placed.mesh->VertexCount(), 4);
    EXPECT_THAT(model.meshes[0].placed.mesh->m_F,
                ElementsAre(KM_MeshTriangle{{0, 1, 2}}, KM_MeshTriangle{{1, 3, 2}}));
    std::string padded = binary("solid", 1) + facet(FIRST);
    std::fill(padded.begin() + 5, padded.begin() + 80, ' ');
    EXPECT_EQ(read(padded).triangleCount(), 1U);
}

TEST(StlReader, CornersOfManyTrianglesBecomeOneVertexWhereverTheyStand) {
    constexpr std::uint32_t SQUARES = 150; // along a side: more corners than one thread takes
    std::string bytes = binary("", 2 * SQUARES * SQUARES);
    for (std::uint32_t pass = 0; pass < 2; ++pass) // triangles of a square stand far apart
        for (std::uint32_t j = 0; j < SQUARES; ++j)
            for (std::uint32_t i = 0; i < SQUARES; ++i) {
                const auto x = static_cast<float>(i);
                const auto y = static_cast<float>(j);
                const float lower[9] = {x, y, 0, x + 1, y, 0, x + 1, y + 1, 0};
                const float upper[9] = {x, y, -0.0F, x + 1, y + 1, 0, x, y + 1, 0};
                bytes += facet(pass == 0 ? lower : upper);
            }
    const ImportedModel model = read(bytes);
    ASSERT_THAT(model.meshes, SizeIs(1));
    const KM_Mesh& mesh = *model.meshes[0].placed.mesh;
    EXPECT_EQ(mesh.VertexCount(), int{(SQUARES + 1) * (SQUARES + 1)});
    EXPECT_EQ(mesh.m_V[mesh.m_F.back().vi[1]], KM_3fPoint(SQUARES, SQUARES, 0));
    EXPECT_EQ(mesh.m_V[mesh.m_F[SQUARES * SQUARES].vi[2]], KM_3fPoint(0, 1, 0));
}

TEST(StlReader, ColoursOfBothConventionsAreRead) {
    constexpr std::uint16_t VALID = 0x8000;
    const auto plain = colorsOf(binary("", 2) + facet(FIRST, VALID | 31) + facet(SECOND));
    EXPECT_THAT(plain, Contains(KM_Color{0, 0, 255, 255}).Times(3));
    EXPECT_THAT(plain, Contains(KM_Color{255, 255, 255, 255}).Times(3));
    const std::string header = "COLOR=\x10\x80\xf0\xff";
    const auto own = colorsOf(binary(header, 2) + facet(FIRST, 31) + facet(SECOND, VALID));
    EXPECT_THAT(own, Contains(KM_Color{255, 0, 0, 255}).Times(3));
    EXPECT_THAT(own, Contains(KM_Color{16, 128, 240, 255}).Times(3));
    const ImportedModel whole = read(binary(header, 1) + facet(FIRST, VALID));
    ASSERT_THAT(whole.meshes, SizeIs(1));
    EXPECT_THAT(whole.meshes[0].placed.mesh->m_C, IsEmpty());
    ASSERT_NE(whole.meshes[0].placed.material, nullptr);
    EXPECT_EQ(whole.meshes[0].placed.material->base_color, (KM_Color{16, 128, 240, 255}));
    EXPECT_THAT(colorsOf(binary("", 1) + facet(FIRST, 31)), IsEmpty());
}

TEST(StlReader, ACountUnlikeTheLengthIsTold) {
    const ImportedModel more = read(binary("", 1) + facet(FIRST) + facet(SECOND));
    EXPECT_EQ(more.triangleCount(), 1U);
    EXPECT_THAT(more.warnings, ElementsAre(HasSubstr("claims 1 triangles but holds 2; 1 were")));
    const ImportedModel none = read(binary("", 0) + facet(FIRST) + facet(SECOND));
    EXPECT_EQ(none.triangleCount(), 2U);
    EXPECT_THAT(none.warnings, SizeIs(1));
    EXPECT_THAT(whyNot(binary("", 3) + facet(FIRST) + facet(SECOND)),
                HasSubstr("claims 3 triangles but holds only 2"));
    EXPECT_THAT(whyNot("short"), HasSubstr("the file is cut short"));
}

TEST(StlReader, SolidsOfATextBecomeObjectsOfTheirWholeNames) {
    const std::string one = facetText("0 0 0", "1 0 0", "0 1 0");
    const ImportedModel model = read("solid upper part\n" + one + "endsolid upper part\nsolid\n" +
                                     one + one + "endsolid\nsolid empty\nendsolid empty\n");
    ASSERT_THAT(model.meshes, SizeIs(2));
    EXPECT_EQ(model.meshes[0].name, L"upper part");
    EXPECT_EQ(model.meshes[1].name, L"a"); // as the file
    EXPECT_EQ(model.meshes[1].placed.mesh->TriangleCount(), 2);
    EXPECT_THAT(model.warnings, IsEmpty());
}

TEST(StlReader, ALongTextIsReadWholeAndInOrder) {
    constexpr int COUNT = 12'000; // of more bytes than one thread takes at a time
    std::string text = "solid a\n";
    for (int i = 0; i < COUNT; ++i) {
        const std::string x = std::to_string(i);
        text += facetText(x + " 0 0", x + " 1 0", x + " 0 1");
        if (i == COUNT / 2)
            text += "endsolid a\nsolid b\n";
    }
    const ImportedModel model = read(text + "endsolid b\n");
    ASSERT_THAT(model.meshes, SizeIs(2));
    EXPECT_EQ(model.meshes[0].placed.mesh->TriangleCount(), COUNT / 2 + 1);
    const KM_Mesh& second = *model.meshes[1].placed.mesh;
    EXPECT_EQ(second.m_V[second.m_F.front().vi[0]].x, COUNT / 2 + 1.0F);
    EXPECT_EQ(second.m_V[second.m_F.back().vi[0]].x, COUNT - 1.0F);
    EXPECT_THAT(model.warnings, IsEmpty());
}

TEST(StlReader, WordsMayBeCapitalsAndFacetsHaveMoreThanThreeCorners) {
    const ImportedModel model =
        read("SOLID A\nFACET NORMAL 0 0 1\nOUTER LOOP\nVERTEX 0 0 0\nVERTEX 1 0 0\nVERTEX 1 1 0\n"
             "VERTEX 0 1 0\nENDLOOP\nENDFACET\nENDSOLID A\n");
    EXPECT_EQ(model.triangleCount(), 2U);
}

TEST(StlReader, ATextThatIsCutOffIsTold) {
    const std::string one = facetText("0 0 0", "1 0 0", "0 1 0");
    const std::string whole = "solid a\n" + one + one;
    EXPECT_THAT(read(whole).warnings, ElementsAre(HasSubstr("may be cut short")));
    const std::string begun = "solid a\n" + one;
    for (std::size_t length = begun.size() + 1; length + 1 < whole.size(); ++length)
        EXPECT_THAT(whyNot(whole.substr(0, length)), HasSubstr("line ")) << length;
}

TEST(StlReader, WhatDoesNotBelongIsToldWithItsLine) {
    const std::string one = facetText("0 0 0", "1 0 0", "0 1 0");
    EXPECT_THAT(whyNot("solid a\n" + one + "stone\n"), HasSubstr("line 9 holds 'stone', which"));
    EXPECT_THAT(whyNot("solid a\n" + facetText("0 0 0", "1 x 0", "0 1 0")),
                HasSubstr("line 5 holds 'x' where a coordinate belongs"));
    EXPECT_THAT(
        whyNot("solid a\nfacet normal 0 0 1\nouter loop\nvertex 0 0 0\nendloop\nendfacet\n"),
        HasSubstr("line 6 ends a triangle of 1 corners"));
}

TEST(StlReader, CoordinatesThatAreNoNumbersTakeTheirTrianglesAway) {
    const std::string good = facetText("0 0 0", "1 0 0", "0 1 0");
    const ImportedModel text = read("solid a\n" + good + facetText("nan 0 0", "1 0 0", "0 1 0") +
                                    facetText("1.#QNAN 0 0", "1 0 0", "0 1e99 0") + "endsolid\n");
    EXPECT_EQ(text.triangleCount(), 1U);
    EXPECT_THAT(text.warnings, ElementsAre(HasSubstr("2 of 3 triangles were left out")));
    float bad[9] = {0, 0, 0, 1, 0, 0, 0, 1, 0};
    bad[4] = std::numeric_limits<float>::infinity();
    const ImportedModel binary_one = read(binary("", 2) + facet(bad) + facet(SECOND));
    EXPECT_EQ(binary_one.triangleCount(), 1U);
    EXPECT_EQ(binary_one.meshes[0].placed.mesh->VertexCount(), 3);
    EXPECT_THAT(binary_one.warnings, ElementsAre(HasSubstr("1 of 2 triangles were left out")));
}

TEST(StlReader, TextFarFromTheOriginKeepsItsDigits) {
    const ImportedModel model =
        read("solid a\n" + facetText("4500000.125 0 0", "4500001.25 0 0", "4500000 2 0") +
             "endsolid a\n");
    ASSERT_THAT(model.meshes, SizeIs(1));
    const PlacedMesh& placed = model.meshes[0].placed;
    EXPECT_DOUBLE_EQ((placed.world_from_mesh * placed.mesh->m_V[0].ToDouble()).x, 4500000.125);
}

TEST(StlReader, TheWritingProgramSettlesTheAxis) {
    const TakenUpAxis up = read(binary("Exported from Blender-2.79", 1) + facet(FIRST)).up;
    EXPECT_EQ(up.reason, TakenUpAxis::Reason::writer);
    EXPECT_EQ(up.axis, UpAxis::z);
    EXPECT_EQ(read(binary("", 1) + facet(FIRST)).up.reason, TakenUpAxis::Reason::habit);
}

} // namespace
} // namespace quarn::test
