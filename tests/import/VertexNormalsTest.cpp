#include "import/assembly/VertexNormals.h"

#include <cmath>
#include <gtest/gtest.h>
#include <numbers>

namespace quarn::test {
namespace {

/// The side of a prism with `sides` faces and radius 1, each face cut into two triangles.
KM_Mesh prism(int sides) {
    KM_Mesh mesh;
    for (int i = 0; i < sides; ++i) {
        const double a = 2.0 * std::numbers::pi * i / sides;
        for (const float z : {0.0F, 1.0F}) {
            mesh.m_V.emplace_back(static_cast<float>(std::cos(a)), static_cast<float>(std::sin(a)),
                                  z);
        }
    }
    for (int i = 0; i < sides; ++i) {
        const auto a = static_cast<std::uint32_t>(2 * i);
        const auto b = static_cast<std::uint32_t>(2 * ((i + 1) % sides));
        mesh.m_F.push_back({{a, b, b + 1}});
        mesh.m_F.push_back({{a, b + 1, a + 1}});
    }
    return mesh;
}

TEST(VertexNormals, SidesFlatterThanTheCreaseAreRoundWhateverWayTheyAreCut) {
    KM_Mesh mesh = prism(12); // 30 degrees from side to side
    smoothVertexNormals(mesh, 40.0);
    ASSERT_EQ(mesh.VertexCount(), 24);
    for (std::size_t v = 0; v < mesh.m_V.size(); ++v) {
        EXPECT_NEAR(mesh.m_N[v].x, mesh.m_V[v].x, 1e-5);
        EXPECT_NEAR(mesh.m_N[v].y, mesh.m_V[v].y, 1e-5);
        EXPECT_NEAR(mesh.m_N[v].z, 0.0, 1e-6);
    }
}

TEST(VertexNormals, SidesSteeperThanTheCreaseAreFlat) {
    KM_Mesh mesh = prism(6); // 60 degrees from side to side
    smoothVertexNormals(mesh, 40.0);
    EXPECT_EQ(mesh.VertexCount(), 24); // each of twelve corners once for either side
    EXPECT_TRUE(mesh.IsValid());
    for (const KM_MeshTriangle& face : mesh.m_F) {
        EXPECT_NEAR(mesh.m_N[face.vi[0]].x, mesh.m_N[face.vi[1]].x, 1e-5);
        EXPECT_NEAR(mesh.m_N[face.vi[0]].y, mesh.m_N[face.vi[2]].y, 1e-5);
    }
}

TEST(VertexNormals, SeamOfTheTextureIsSmoothedOver) {
    KM_Mesh mesh = prism(12);
    mesh.m_T.assign(mesh.m_V.size(), KM_2fPoint(0.5F, 0.5F));
    mesh.m_V.push_back(mesh.m_V[0]); // the seam: vertex 0 once more, with other coordinates
    mesh.m_T.emplace_back(1.0F, 0.0F);
    mesh.m_F[0].vi[0] = 24;
    smoothVertexNormals(mesh, 40.0);
    ASSERT_EQ(mesh.VertexCount(), 25);
    EXPECT_NEAR(mesh.m_N[0].x, 1.0, 1e-5);
    EXPECT_NEAR(mesh.m_N[24].x, 1.0, 1e-5);
}

TEST(VertexNormals, TriangleWithoutAreaStillHasAUnitNormal) {
    KM_Mesh mesh;
    mesh.m_V = {KM_3fPoint(0, 0, 0), KM_3fPoint(1, 0, 0), KM_3fPoint(2, 0, 0)};
    mesh.m_F = {{{0, 1, 2}}};
    smoothVertexNormals(mesh, 40.0);
    for (const KM_3fVector& n : mesh.m_N) {
        EXPECT_FLOAT_EQ(std::hypot(n.x, n.y, n.z), 1.0F);
    }
}

TEST(VertexNormals, OnlyMissingNormalsAreFilled) {
    KM_Mesh mesh;
    mesh.m_V = {KM_3fPoint(0, 0, 0), KM_3fPoint(1, 0, 0), KM_3fPoint(0, 1, 0)};
    mesh.m_N = {KM_3fVector(1, 0, 0), KM_3fVector(0, 0, 0), KM_3fVector(0, 1, 0)};
    mesh.m_F = {{{0, 1, 2}}};
    fillMissingNormals(mesh);
    EXPECT_EQ(mesh.m_N[0], KM_3fVector(1, 0, 0));
    EXPECT_EQ(mesh.m_N[1], KM_3fVector(0, 0, 1));
    EXPECT_EQ(mesh.m_N[2], KM_3fVector(0, 1, 0));
}

TEST(VertexNormals, TinyAndHugeTrianglesKeepTheirDirection) {
    for (const float size : {1e-18F, 1e15F}) {
        KM_Mesh mesh;
        mesh.m_V = {KM_3fPoint(0, 0, 0), KM_3fPoint(size, 0, 0), KM_3fPoint(0, size, 0)};
        mesh.m_F = {{{0, 1, 2}}};
        smoothVertexNormals(mesh, 40.0);
        EXPECT_FLOAT_EQ(mesh.m_N[0].z, 1.0F) << size;
    }
}

} // namespace
} // namespace quarn::test
