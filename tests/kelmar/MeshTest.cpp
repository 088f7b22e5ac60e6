#include "kelmar/KM_Mesh.h"

#include "kelmar/KM_Xform.h"
#include "kelmar/KM_wString.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>

namespace {

// Two triangles in the ground plane, seen from above anticlockwise.
KM_Mesh square() {
    KM_Mesh mesh;
    mesh.m_V = {{0, 0, 0}, {2, 0, 0}, {2, 2, 0}, {0, 2, 0}};
    mesh.m_F = {{{0, 1, 2}}, {{0, 2, 3}}};
    return mesh;
}

// The corner of a cube at the origin: three faces along the negative axes, normals outward.
KM_Mesh cubeCorner() {
    KM_Mesh mesh;
    mesh.m_V = {{0, 0, 0},   {-1, 0, 0},  {0, -1, 0}, {0, 0, -1},
                {-1, -1, 0}, {-1, 0, -1}, {0, -1, -1}};
    // The face across z is cut through the corner, the other two are single triangles there.
    mesh.m_F = {{{0, 1, 4}}, {{0, 4, 2}}, {{0, 2, 3}}, {{0, 3, 1}}};
    return mesh;
}

std::string problemOf(const KM_Mesh& mesh) {
    KM_wString why;
    EXPECT_FALSE(mesh.IsValid(&why));
    return why.ToUtf8();
}

} // namespace

TEST(Mesh, ASoundMeshIsValidAndSaysNothing) {
    KM_wString why(L"old");
    EXPECT_TRUE(square().IsValid(&why));
    EXPECT_TRUE(why.IsEmpty());
    EXPECT_TRUE(square().IsValid());
    EXPECT_EQ(square().VertexCount(), 4);
    EXPECT_EQ(square().TriangleCount(), 2);
}

TEST(Mesh, ValidityNamesTheTriangleAndTheVertex) {
    KM_Mesh mesh = square();
    mesh.m_F[1].vi[2] = 4;
    EXPECT_EQ(problemOf(mesh), "Triangle 1 names vertex 4, but there are 4 vertices.");
    mesh.m_F[1].vi[2] = std::numeric_limits<std::uint32_t>::max();
    EXPECT_EQ(problemOf(mesh), "Triangle 1 names vertex 4294967295, but there are 4 vertices.");
}

TEST(Mesh, ValidityNamesWhatIsNotFinite) {
    KM_Mesh mesh = square();
    mesh.m_V[2].y = std::nanf("");
    EXPECT_EQ(problemOf(mesh), "Vertex 2 is not finite.");
    mesh = square();
    mesh.ComputeVertexNormals();
    mesh.m_N[3].x = INFINITY;
    EXPECT_EQ(problemOf(mesh), "Normal 3 is not finite.");
    mesh = square();
    mesh.m_T.resize(4);
    mesh.m_T[1].x = std::nanf("");
    EXPECT_EQ(problemOf(mesh), "Texture coordinate 1 is not finite.");
}

TEST(Mesh, ValidityComparesTheSizesOfTheArrays) {
    KM_Mesh mesh = square();
    mesh.m_N.resize(3);
    EXPECT_EQ(problemOf(mesh), "There are 3 normals for 4 vertices.");
    mesh = square();
    mesh.m_T.resize(5);
    EXPECT_EQ(problemOf(mesh), "There are 5 texture coordinates for 4 vertices.");
    mesh = square();
    mesh.m_C.resize(1);
    EXPECT_EQ(problemOf(mesh), "There are 1 colors for 4 vertices.");
    EXPECT_EQ(problemOf(KM_Mesh()), "The mesh has no triangles.");
}

TEST(Mesh, BoundingBoxHoldsTheFiniteVertices) {
    KM_Mesh mesh = square();
    mesh.m_V.push_back({std::nanf(""), 9, 9});
    EXPECT_EQ(mesh.BoundingBox(), KM_BoundingBox({0, 0, 0}, {2, 2, 0}));
    EXPECT_FALSE(KM_Mesh().BoundingBox().IsValid());
}

TEST(Mesh, FlatMeshesHaveTheNormalOfTheirPlane) {
    KM_Mesh mesh = square();
    mesh.ComputeVertexNormals();
    ASSERT_EQ(mesh.m_N.size(), 4U);
    for (const KM_3fVector& normal : mesh.m_N)
        EXPECT_EQ(normal, KM_3fVector(0, 0, 1));
}

TEST(Mesh, NormalsDoNotDependOnHowAFaceIsCut) {
    KM_Mesh mesh = cubeCorner();
    mesh.ComputeVertexNormals();
    const float third = static_cast<float>(1.0 / std::sqrt(3.0));
    EXPECT_NEAR(mesh.m_N[0].x, third, 1e-6);
    EXPECT_NEAR(mesh.m_N[0].y, third, 1e-6);
    EXPECT_NEAR(mesh.m_N[0].z, third, 1e-6);
}

TEST(Mesh, NormalsPassOverTrianglesThatAreNone) {
    KM_Mesh mesh = square();
    mesh.m_V.push_back({9, 9, 9});
    mesh.m_F.push_back({{0, 0, 1}});
    mesh.m_F.push_back({{0, 1, 99}});
    mesh.ComputeVertexNormals();
    EXPECT_EQ(mesh.m_N[0], KM_3fVector(0, 0, 1));
    EXPECT_EQ(mesh.m_N[4], KM_3fVector(0, 0, 1)) << "a vertex of no triangle";
}

TEST(Mesh, NormalsStayPerpendicularUnderUnevenScales) {
    KM_Mesh mesh;
    mesh.m_V = {{0, 0, 1}, {1, 0, 0}, {0, 1, 0}};
    mesh.m_F = {{{1, 2, 0}}};
    mesh.ComputeVertexNormals();
    ASSERT_TRUE(mesh.Transform(KM_Xform::Diagonal(1, 1, 3)));
    EXPECT_EQ(mesh.m_V[0], KM_3fPoint(0, 0, 3));
    // The plane x + y + z / 3 = 1
    const KM_3dVector normal = mesh.m_N[0].ToDouble();
    const KM_3dVector wanted = KM_3dVector(3, 3, 1) / std::sqrt(19.0);
    EXPECT_LE((normal - wanted).Length(), 1e-6);
}

TEST(Mesh, MirrorsTurnTheTrianglesSoThatOutsideStaysOutside) {
    KM_Mesh mesh = square();
    mesh.ComputeVertexNormals();
    ASSERT_TRUE(mesh.Transform(KM_Xform::Diagonal(-1, 1, 1)));
    EXPECT_EQ(mesh.m_F[0], (KM_MeshTriangle{{0, 2, 1}}));
    EXPECT_EQ(mesh.m_N[0], KM_3fVector(0, 0, 1));
    mesh.ComputeVertexNormals();
    EXPECT_EQ(mesh.m_N[0], KM_3fVector(0, 0, 1)) << "winding and normals agree";
}

TEST(Mesh, ATransformThatCannotBeLeavesTheMeshAlone) {
    KM_Mesh mesh = square();
    EXPECT_FALSE(mesh.Transform(KM_Xform::Diagonal(1, 1, 0)));
    EXPECT_FALSE(mesh.Transform(KM_Xform::Diagonal(1e300, 1, 1)));
    EXPECT_EQ(mesh.m_V, square().m_V);
}

TEST(Mesh, AppendShiftsTheIndices) {
    KM_Mesh mesh = square();
    ASSERT_TRUE(mesh.Append(square()));
    EXPECT_EQ(mesh.VertexCount(), 8);
    ASSERT_EQ(mesh.TriangleCount(), 4);
    EXPECT_EQ(mesh.m_F[3], (KM_MeshTriangle{{4, 6, 7}}));
    EXPECT_TRUE(mesh.IsValid());
    ASSERT_TRUE(mesh.Append(mesh)) << "a mesh may be added to itself";
    EXPECT_EQ(mesh.TriangleCount(), 8);
    EXPECT_TRUE(mesh.IsValid());
}

TEST(Mesh, AppendFillsColoursAndNormalsAndDropsHalfATexture) {
    KM_Mesh mesh = square();
    KM_Mesh other = square();
    other.m_C.assign(4, KM_Color{1, 2, 3, 255});
    other.m_T.resize(4);
    other.ComputeVertexNormals();
    ASSERT_TRUE(mesh.Append(other));
    EXPECT_TRUE(mesh.IsValid());
    ASSERT_EQ(mesh.m_C.size(), 8U);
    EXPECT_EQ(mesh.m_C[0], (KM_Color{255, 255, 255, 255}));
    EXPECT_EQ(mesh.m_C[4], (KM_Color{1, 2, 3, 255}));
    EXPECT_EQ(mesh.m_N.size(), 8U);
    EXPECT_TRUE(mesh.m_T.empty());
    KM_Mesh empty;
    ASSERT_TRUE(empty.Append(other));
    EXPECT_EQ(empty.m_T.size(), 4U) << "an empty mesh takes all of the other";
}

TEST(Mesh, PaddingMakesRoomBehindTheLastVertex) {
    KM_Mesh mesh = square();
    mesh.m_V.shrink_to_fit();
    mesh.PadForRayTracing();
    EXPECT_GT(mesh.m_V.capacity(), mesh.m_V.size());
    EXPECT_EQ(mesh.m_V.size(), 4U);
    EXPECT_EQ(sizeof(KM_3fPoint), 12U);
    EXPECT_EQ(sizeof(KM_MeshTriangle), 12U);
}

TEST(Mesh, ClearFreesTheStorage) {
    KM_Mesh mesh = square();
    mesh.Clear();
    EXPECT_EQ(mesh.m_V.capacity(), 0U);
    EXPECT_EQ(mesh.m_F.capacity(), 0U);
}
