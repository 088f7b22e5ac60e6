#include "tests/import/ModelFixtures.h"

#include <gmock/gmock.h>

namespace quarn::test {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;
using ::testing::SizeIs;

/// The corners of the unit square, round it.
const std::string square = "v 0 0 0\nv 1 0 0\nv 1 1 0\nv 0 1 0\n";

ImportedModel readObjText(const std::string& text) {
    const TemporaryFolder folder;
    return readOrFail(folder.write("model.obj", text));
}

double areaOf(const KM_Mesh& mesh) {
    double area = 0.0;
    for (const KM_MeshTriangle& face : mesh.m_F) {
        const auto at = [&](int k) { return mesh.m_V[face.vi[k]].ToDouble(); };
        area += 0.5 * KM_CrossProduct(at(1) - at(0), at(2) - at(0)).Length();
    }
    return area;
}

std::vector<std::string> namesOf(const ImportedModel& model) {
    std::vector<std::string> names;
    for (const ImportedMesh& mesh : model.meshes)
        names.push_back(mesh.name.ToUtf8());
    return names;
}

TEST(ObjNumbers, OfAllShapesAreRead) {
    const ImportedModel model =
        readObjText("v .5 -.5 1.\nv +1 1e-3 -2.5E+1\nv 0 1e2 +.25\nf 1 2 3\n");
    ASSERT_EQ(model.triangleCount(), 1U);
    const std::vector<KM_3fPoint>& places = model.meshes[0].placed.mesh->m_V;
    EXPECT_EQ(places[0], KM_3fPoint(0.5F, -0.5F, 1.0F));
    EXPECT_EQ(places[1], KM_3fPoint(1.0F, 0.001F, -25.0F));
    EXPECT_EQ(places[2], KM_3fPoint(0.0F, 100.0F, 0.25F));
    EXPECT_THAT(model.warnings, IsEmpty());
}

TEST(ObjNumbers, AFourthCoordinateDividesTheOthers) {
    const ImportedModel model = readObjText("v 0 0 0 2\nv 4 0 0 2\nv 0 4 0 0.5\nf 1 2 3\n");
    expectNear(boundsOf(model).m_max, {2, 8, 0}, 0);
}

TEST(ObjLines, MayEndInEveryWayAndHoldComments) {
    for (const std::string end : {"\n", "\r\n", "\r", "\r\r\n"}) {
        std::string text = "\xEF\xBB\xBF# head" + end + "v 0 0 0" + end + "\tv  1 0 0 # right" +
                           end + end + "v 0 1 0  " + end + "f 1 2 3 # all" + end;
        const ImportedModel model = readObjText(text);
        EXPECT_EQ(model.triangleCount(), 1U) << end.size();
        EXPECT_THAT(model.warnings, IsEmpty());
    }
}

TEST(ObjLines, GoOnBelowWhereTheyEndWithABackslash) {
    const ImportedModel model =
        readObjText("o far \\\nhouse\nv 0 0 \\\n0\nv 1 0 0\nv 0 1 0\nf 1 \\\r\n2 \\\r\n3\n"
                    "# a comment does not \\\nf 3 2 1\n");
    EXPECT_EQ(model.triangleCount(), 2U);
    EXPECT_THAT(namesOf(model), ElementsAre("far  house"));
}

TEST(ObjLines, ManyThousandsAreReadInTheirOrder) {
    // Longer than what one thread takes at a time; indices count backward, so that each part must
    // know what stands before it.
    std::string text;
    constexpr int strips = 20'000;
    for (int i = 0; i < strips; ++i)
        text += "v " + std::to_string(i) + ".000000 0.000000 0.000000\nv " + std::to_string(i) +
                ".000000 1.000000 0.000000\n" + (i > 0 ? "f -4 -2 -1 \\\n-3\n" : "");
    const ImportedModel model = readObjText(text);
    ASSERT_EQ(model.meshes.size(), 1U);
    EXPECT_EQ(model.triangleCount(), 2U * (strips - 1));
    EXPECT_NEAR(areaOf(*model.meshes[0].placed.mesh), strips - 1.0, 1e-3);
    EXPECT_EQ(model.meshes[0].placed.mesh->m_V.size(), 2U * strips);
    EXPECT_THAT(model.warnings, IsEmpty());
}

TEST(ObjFaces, MayStandBeforeTheirVertices) {
    EXPECT_EQ(readObjText("f 1 2 3\n" + square).triangleCount(), 1U);
}

TEST(ObjFaces, AreCutWithinConcaveOutlines) {
    // A square of 16 with a notch of 6.
    const ImportedModel model =
        readObjText("v 0 0 0\nv 4 0 0\nv 4 4 0\nv 2 1 0\nv 0 4 0\nf 1 2 3 4 5\n");
    ASSERT_EQ(model.triangleCount(), 3U);
    EXPECT_NEAR(areaOf(*model.meshes[0].placed.mesh), 10.0, 1e-6);
}

TEST(ObjFaces, KeepHolesThatHangOnTheirOutline) {
    // A square of 16 with one of 4 in it, which an edge taken twice joins to it.
    const ImportedModel model =
        readObjText("v 0 0 0\nv 4 0 0\nv 4 4 0\nv 0 4 0\nv 1 1 0\nv 1 3 0\nv 3 3 0\nv 3 1 0\n"
                    "f 1 2 3 4 1 5 6 7 8 5\n");
    ASSERT_EQ(model.meshes.size(), 1U);
    EXPECT_NEAR(areaOf(*model.meshes[0].placed.mesh), 12.0, 1e-6);
}

TEST(ObjFaces, OfOneOrTwoCornersArePointsAndLines) {
    const ImportedModel model = readObjText(square + "f 4\nf 1 2\nf 1 2 3\n");
    EXPECT_EQ(model.triangleCount(), 1U);
    ASSERT_EQ(model.points.Count(), 1);
    EXPECT_EQ(model.points[0], KM_3dPoint(0, 1, 0));
    ASSERT_THAT(model.curves, SizeIs(1));
    EXPECT_EQ(model.curves[0].points[1], KM_3dPoint(1, 0, 0));
}

TEST(ObjFaces, TakeTextureCoordinatesAndNormalsByNumbersOfTheirOwn) {
    const ImportedModel model =
        readObjText(square + "vt 0 0\nvt 0.5 1 0\nvt 1\nvn 0 0 2\nvn 0 0 -1\n"
                             "f 1/1/1 2/3/1 3/2/1\nf 1//2 3//2 2//2\nf 1/1/ 3/2/ 4/-3/\n");
    ASSERT_EQ(model.meshes.size(), 1U);
    const KM_Mesh& mesh = *model.meshes[0].placed.mesh;
    ASSERT_EQ(mesh.m_F.size(), 3U);
    const auto corner = [&](std::size_t face, int k) { return mesh.m_F[face].vi[k]; };
    EXPECT_EQ(mesh.m_T[corner(0, 1)], KM_2fPoint(1.0F, 0.0F));
    EXPECT_EQ(mesh.m_T[corner(0, 2)], KM_2fPoint(0.5F, 1.0F));
    EXPECT_EQ(mesh.m_T[corner(2, 2)], KM_2fPoint(0.0F, 0.0F));
    EXPECT_EQ(mesh.m_N[corner(0, 0)], KM_3fVector(0.0F, 0.0F, 1.0F)); // of length 1
    EXPECT_EQ(mesh.m_N[corner(1, 0)], KM_3fVector(0.0F, 0.0F, -1.0F));
    EXPECT_EQ(mesh.m_N[corner(2, 2)], KM_3fVector(0.0F, 0.0F, 1.0F)); // made
    EXPECT_NE(corner(0, 0), corner(1, 0));
    EXPECT_TRUE(mesh.IsValid());
}

TEST(ObjFaces, ShareVerticesWhoseNumbersAgree) {
    // Four faces of each two triangles round one place, all with the same normal and texture.
    const ImportedModel model =
        readObjText("v 0 0 0\nv 1 0 0\nv 0 1 0\nv -1 0 0\nv 0 -1 0\nvt 0 0\nvt 1 1\nvn 0 0 1\n"
                    "f 1/2/1 2/1/1 3/1/1\nf 1/2/1 3/1/1 4/1/1\nf 1/2/1 4/1/1 5/1/1\n"
                    "f 1/2/1 5/1/1 2/1/1\nf 1/1/1 5/1/1 2/1/1\n");
    ASSERT_EQ(model.meshes.size(), 1U);
    EXPECT_EQ(model.meshes[0].placed.mesh->m_V.size(), 6U); // the middle one in two ways
}

TEST(ObjFaces, FindTheirVertexAmongAThousandsAtOnePlace) {
    std::string text = square;
    constexpr int turns = 3000;
    for (int i = 0; i < turns; ++i)
        text += "vt " + std::to_string(i) + " 0\n";
    for (int round = 0; round < 2; ++round)
        for (int i = 1; i <= turns; ++i)
            text += "f 1/" + std::to_string(i) + " 2/1 3/1\n";
    const ImportedModel model = readObjText(text);
    ASSERT_EQ(model.triangleCount(), 2U * turns);
    EXPECT_EQ(model.meshes[0].placed.mesh->m_V.size(), turns + 2U);
}

TEST(ObjColours, BehindTheVerticesCountToOneOrTo255) {
    for (const std::string colours : {" 1 0 0.5", " 255 0 127.5"}) {
        const ImportedModel model =
            readObjText("v 0 0 0" + colours + "\nv 1 0 0" + colours + "\nv 0 1 0\nf 1 2 3\n");
        ASSERT_EQ(model.meshes.size(), 1U);
        const auto& colors = model.meshes[0].placed.mesh->m_C;
        ASSERT_EQ(colors.size(), 3U);
        EXPECT_EQ(colors[1], (KM_Color{255, 0, 128, 255}));
        EXPECT_EQ(colors[2], (KM_Color{255, 255, 255, 255})); // it has none
    }
}

TEST(ObjObjects, AreNamedByTheLastGroupOrObjectStatementWithItsBlanks) {
    const ImportedModel model = readObjText(square + "f 1 2 3\no my  house\nf 1 2 3\ng left wing \n"
                                                     "f 1 2 3\ng left wing\nf 1 2 4\ng\nf 1 2 3\n");
    EXPECT_THAT(namesOf(model), ElementsAre("model", "my  house", "left wing", "model"));
    EXPECT_EQ(model.meshes[2].placed.mesh->TriangleCount(), 2);
}

TEST(ObjObjects, HaveAMeshForEachOfTheirMaterials) {
    const TemporaryFolder folder;
    folder.write("m.mtl", "newmtl red\nKd 1 0 0\nnewmtl blue\nKd 0 0 1\n");
    const ImportedModel model = readOrFail(folder.write(
        "model.obj", "mtllib m.mtl\n" + square +
                         "o A\nusemtl red\nf 1 2 3\nusemtl blue\nf 1 2 3\nusemtl red\nf 1 3 4\n"
                         "o B\nf 1 2 3\n"));
    EXPECT_THAT(namesOf(model), ElementsAre("A", "A", "B"));
    EXPECT_EQ(model.meshes[0].placed.mesh->TriangleCount(), 2);
    EXPECT_EQ(model.meshes[1].placed.material->name, L"blue");
    EXPECT_EQ(model.meshes[2].placed.material, model.meshes[0].placed.material);
}

TEST(ObjObjects, WithoutANameAreNamedAfterTheirMaterials) {
    const ImportedModel model =
        readObjText(square + "usemtl old oak\nf 1 2 3\nusemtl glass\nf 1 2 3\n");
    EXPECT_THAT(namesOf(model), ElementsAre("old oak", "glass"));
}

TEST(ObjElements, LinesTakeTextureCoordinatesAndPointsSeveralVertices) {
    const ImportedModel model = readObjText(square + "vt 0\no Way\nl 1/1 2/1 3/1\np 1 -1\np 2\n");
    ASSERT_THAT(model.curves, SizeIs(1));
    EXPECT_EQ(model.curves[0].points.Count(), 3);
    EXPECT_EQ(model.curves[0].name, L"Way");
    ASSERT_EQ(model.points.Count(), 3);
    EXPECT_EQ(model.points[1], KM_3dPoint(0, 1, 0));
}

TEST(ObjElements, VerticesWithoutAnyAreACloudOfPoints) {
    const ImportedModel model = readObjText("vn 0 0 1\n" + square + "v 4500000.125 0 0\n");
    ASSERT_EQ(model.points.Count(), 5);
    EXPECT_EQ(model.points[4].x, 4500000.125);
}

TEST(ObjElements, PolylinesAndPointsOfAFarModelStandWhereItsTrianglesDo) {
    const ImportedModel model = readObjText(
        "v 4500000 0 0\nv 4500001 0 0\nv 4500000 1 0\nv 4500000.5 1 2\nf 1 2 3\nl 3 4\np 4\n");
    expectNear(boundsOf(model).m_max, {4500001, 1, 0}, 1e-6);
    ASSERT_THAT(model.curves, SizeIs(1));
    expectNear(model.curves[0].points[1], {4500000.5, 1, 2}, 1e-6);
    expectNear(model.points[0], {4500000.5, 1, 2}, 1e-6);
}

TEST(ObjUpAxis, IsThatOfTheProgramThatSignedTheFile) {
    const std::string body = "v 0 0 0\nv 1 0 0\nv 0 2 0\nf 1 2 3\n";
    const ImportedModel signed_one = readObjText("# Blender 3.6.0\n" + body);
    EXPECT_EQ(signed_one.up.axis, UpAxis::y);
    EXPECT_EQ(signed_one.up.reason, TakenUpAxis::Reason::writer);
    EXPECT_EQ(signed_one.up.writer, "Blender");
    expectNear(boundsOf(signed_one).m_max, {1, 0, 2}, 0);
    const ImportedModel other = readObjText("# made by hand\n" + body);
    EXPECT_EQ(other.up.axis, UpAxis::z);
    EXPECT_EQ(other.up.reason, TakenUpAxis::Reason::habit);
}

} // namespace
} // namespace quarn::test
