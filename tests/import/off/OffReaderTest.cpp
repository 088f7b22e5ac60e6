#include "tests/import/ModelFixtures.h"

#include <gmock/gmock.h>

namespace quarn::test {
namespace {

using ::testing::AllOf;
using ::testing::ElementsAre;
using ::testing::HasSubstr;
using ::testing::IsEmpty;
using ::testing::SizeIs;

const std::string vertices = "0 0 0\n1 0 0\n0 1 0\n";

ImportedModel readOffText(const std::string& text) {
    const TemporaryFolder folder;
    return readOrFail(folder.write("a.off", text));
}

void expectRefused(const std::string& text, const std::string& why) {
    const TemporaryFolder folder;
    const auto path = folder.write("a.off", text);
    const Result<ImportedModel> model = readModelFile(path);
    ASSERT_FALSE(model.ok()) << text;
    EXPECT_THAT(model.message(), AllOf(HasSubstr("'" + path.string() + "': "), HasSubstr(why)));
}

TEST(OffHead, StandsInManyShapes) {
    for (const std::string head : {"OFF\n3 1 0\n", "OFF 3 1 0\n", "OFF\n\n# made by hand\n3\n1 0\n",
                                   "3 1 0\n", "OFF # shape\n3 1 0 # counts\n\n", "nOFF\n3\n3 1 0\n",
                                   "nOFF 3 3 1 0\n", "\xEF\xBB\xBFOFF\r\n3 1 0\r\n"}) {
        const ImportedModel model =
            readOffText(head + "0 0 0 # first\n\n1 0 0\n# second\n0 1 0\n3 0 1 2 # all\n");
        EXPECT_EQ(model.triangleCount(), 1U) << head;
        EXPECT_THAT(model.warnings, IsEmpty()) << head;
    }
}

TEST(OffHead, OfKindsThatAreNotReadIsTold) {
    expectRefused("OFF BINARY\n", "it is a binary OFF file");
    expectRefused("nOFF\n5\n3 1 0\n", "its vertices have '5' coordinates");
    expectRefused("XOFF\n3 1 0\n" + vertices, "line 1 begins with 'XOFF'");
}

TEST(OffHead, ThatClaimsMoreThanTheFileHoldsIsTold) {
    expectRefused("OFF\n3 100 0\n" + vertices + "3 0 1 2\n",
                  "more vertices or faces than it holds");
    expectRefused("OFF\n18446744073709551615 1 0\n" + vertices, "more vertices or faces");
    expectRefused("OFF\n3 4\n0.1 0.2 0.3\n0.2 0.3 0.4\n",
                  "line 3 holds '0.1' where the numbers of vertices, faces and edges belong");
    expectRefused("OFF\n", "holds '' where the numbers of vertices");
}

TEST(OffVertices, HaveColoursNormalsAndTextureCoordinatesInTheirOrder) {
    const ImportedModel model =
        readOffText("STCN4OFF\n3 1 0\n0 0 0 1  0 0 2  255 0 0 255  0 0\n"
                    "2 0 0 2  0 0 1  0 255 0 255  1 0\n0 1 0 1  0 0 1  0 0 255 51  0 1\n"
                    "3 0 1 2\n");
    ASSERT_EQ(model.meshes.size(), 1U);
    const KM_Mesh& mesh = *model.meshes[0].placed.mesh;
    EXPECT_EQ(mesh.m_V[1], KM_3fPoint(1.0F, 0.0F, 0.0F)); // 2 / 2
    EXPECT_EQ(mesh.m_N[0], KM_3fVector(0.0F, 0.0F, 1.0F));
    EXPECT_THAT(mesh.m_C, ElementsAre(KM_Color{255, 0, 0, 255}, KM_Color{0, 255, 0, 255},
                                      KM_Color{0, 0, 255, 51}));
    EXPECT_THAT(mesh.m_T, ElementsAre(KM_2fPoint(0, 0), KM_2fPoint(1, 0), KM_2fPoint(0, 1)));
}

TEST(OffVertices, MayHaveColoursFromZeroToOne) {
    const ImportedModel model =
        readOffText("COFF\n3 1 0\n0 0 0 1 0 0\n1 0 0 0 0.5 0 1\n0 1 0 0 0 0\n3 0 1 2\n");
    ASSERT_EQ(model.meshes.size(), 1U);
    EXPECT_THAT(
        model.meshes[0].placed.mesh->m_C,
        ElementsAre(KM_Color{255, 0, 0, 255}, KM_Color{0, 128, 0, 255}, KM_Color{0, 0, 0, 255}));
}

TEST(OffVertices, KeepTheDigitsOfFarPlaces) {
    const ImportedModel model =
        readOffText("OFF\n3 1 0\n4500000.125 5200000 0\n4500010 5200000 0\n4500000.5 5200010 0\n"
                    "3 0 1 2\n");
    expectNear(boundsOf(model).m_min, {4500000.125, 5200000, 0}, 1e-6);
    EXPECT_THAT(model.warnings, IsEmpty());
}

TEST(OffVertices, WithoutFacesAreACloudOfPoints) {
    EXPECT_EQ(readOffText("OFF 3 0 0\n" + vertices).points.Count(), 3);
}

TEST(OffVertices, ThatAreNoUsableNumbersLeaveTheirTrianglesOut) {
    const ImportedModel model =
        readOffText("OFF\n4 2 0\n" + vertices + "nan 0 0\n3 0 1 2\n3 0 1 3\n");
    EXPECT_EQ(model.triangleCount(), 1U);
    EXPECT_THAT(model.warnings, ElementsAre(HasSubstr("1 of 2 triangles were left out")));
}

TEST(OffFaces, HaveColoursOfTheirOwn) {
    const ImportedModel model =
        readOffText("OFF\n4 3 0\n0 0 0\n1 0 0\n1 1 0\n0 1 0\n3 0 1 2 255 0 0\n3 0 2 3 0 0 255 128\n"
                    "3 1 2 3\n");
    ASSERT_EQ(model.meshes.size(), 1U);
    const KM_Mesh& mesh = *model.meshes[0].placed.mesh;
    ASSERT_EQ(mesh.m_F.size(), 3U);
    const KM_Color expected[] = {{255, 0, 0, 255}, {0, 0, 255, 128}, {255, 255, 255, 255}};
    for (std::size_t face = 0; face < 3; ++face)
        for (const std::uint32_t v : mesh.m_F[face].vi)
            EXPECT_EQ(mesh.m_C[v], expected[face]) << face;
}

TEST(OffFaces, OfOneColourShareTheirVertices) {
    const ImportedModel model =
        readOffText("OFF\n4 2 0\n0 0 0\n1 0 0\n1 1 0\n0 1 0\n3 0 1 2 9 9 9\n3 0 2 3 9 9 9\n");
    ASSERT_EQ(model.meshes.size(), 1U);
    EXPECT_EQ(model.meshes[0].placed.mesh->m_V.size(), 4U);
}

TEST(OffFaces, OfFewOrManyCornersAreLinesPointsAndTriangles) {
    const ImportedModel model =
        readOffText("OFF\n5 4 0\n0 0 0\n4 0 0\n4 4 0\n2 1 0\n0 4 0\n5 0 1 2 3 4\n2 0 1\n1 2\n0\n");
    EXPECT_EQ(model.triangleCount(), 3U);
    EXPECT_THAT(model.curves, SizeIs(1));
    EXPECT_EQ(model.points.Count(), 1);
    EXPECT_THAT(model.warnings, ElementsAre("1 faces were left out: they have no corners."));
}

TEST(OffFaces, InTheirThousandsAreReadInTheirOrder) {
    constexpr int strips = 30'000; // more than one thread takes at a time
    std::string text =
        "OFF\n" + std::to_string(2 * strips) + " " + std::to_string(strips - 1) + " 0\n";
    for (int i = 0; i < strips; ++i)
        text += std::to_string(i) + ".0 0.0 0.0\n" + std::to_string(i) + ".0 1.0 0.0\n\n";
    for (int i = 1; i < strips; ++i)
        text += "4 " + std::to_string(2 * i - 2) + " " + std::to_string(2 * i) + " " +
                std::to_string(2 * i + 1) + " " + std::to_string(2 * i - 1) + "\n# next\n";
    const ImportedModel model = readOffText(text);
    ASSERT_EQ(model.triangleCount(), 2U * (strips - 1));
    for (const KM_3fVector& n : model.meshes[0].placed.mesh->m_N)
        ASSERT_EQ(n, KM_3fVector(0.0F, 0.0F, 1.0F));
}

TEST(OffFaces, WithAnIndexThatIsNoVertexAreToldWithTheirLine) {
    for (const char* const index : {"3", "-1", "4294967298", "18446744073709551618"})
        expectRefused("OFF\n# made by hand\n3 1 0\n" + vertices + "3 0 1 " + index + "\n",
                      "line 7 holds the index " + std::string(index) +
                          ", which is out of range: there are 3 vertices.");
    expectRefused("OFF\n3 1 0\n" + vertices + "3 0 1 x\n",
                  "line 6 holds 'x', which is no index of a vertex");
    expectRefused("OFF\n3 1 0\n" + vertices + "x 0 1 2\n",
                  "line 6 holds 'x' where the number of corners belongs");
}

TEST(OffFile, ThatIsCutShortIsTold) {
    expectRefused("OFF\n3 2 0\n" + vertices + "3 0 1 2\n",
                  "it claims 3 vertices and 2 faces but ends before them");
    expectRefused("OFF\n3 1 0\n" + vertices + "3 0 1", "line 6 ends after 2 of 3 corners");
    expectRefused("OFF\n3 1 0\n0 0 0\n1 0\n0 1 0\n3 0 1 2\n",
                  "line 4 holds 2 of the 3 coordinates of a vertex");
    expectRefused("OFF\n3 1 0\n0 0 0\n1 0 up\n0 1 0\n3 0 1 2\n",
                  "line 4 holds 'up' where a coordinate belongs");
}

TEST(OffFile, TakesNoMoreMemoryThanItMay) {
    const TemporaryFolder folder;
    const auto path = folder.write("a.off", "OFF\n3 1 0\n" + vertices + "3 0 1 2\n");
    EXPECT_TRUE(readModelFile(path, {.most_memory = 100'000}).ok());
    const Result<ImportedModel> model = readModelFile(path, {.most_memory = 100});
    ASSERT_FALSE(model.ok());
    EXPECT_THAT(model.message(), HasSubstr("of memory"));
}

} // namespace
} // namespace quarn::test
