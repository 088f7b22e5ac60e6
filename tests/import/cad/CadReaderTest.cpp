#include "tests/import/cad/CadFixtures.h"

#include <BRepBuilderAPI_MakeEdge.hxx>
#include <BRepPrimAPI_MakeBox.hxx>
#include <BRepPrimAPI_MakeCylinder.hxx>
#include <BRepPrimAPI_MakeSphere.hxx>
#include <gmock/gmock.h>
#include <gp_Circ.hxx>

#include <cmath>
#include <numbers>

namespace quarn::test {
namespace {

using testing::HasSubstr;
using testing::SizeIs;

/// By the divergence theorem; positive where the triangles look outward.
double volumeOf(const KM_Mesh& mesh) {
    double volume = 0.0;
    for (const KM_MeshTriangle& t : mesh.m_F) {
        const auto at = [&](int k) { return mesh.m_V[t.vi[k]].ToDouble() - KM_3dPoint::Origin; };
        volume += at(0) * KM_CrossProduct(at(1), at(2)) / 6.0;
    }
    return volume;
}

TEST_F(CadFiles, AnAssemblyRepeatsTheMeshesOfItsParts) {
    addBoltedPlate();
    const ImportedModel model = readOrFail(writeStep("a.step"));
    ASSERT_THAT(model.meshes, SizeIs(5));
    EXPECT_EQ(model.meshes[0].name, KM_wString(L"Plate"));
    EXPECT_EQ(model.units, UnitSystem::millimeters);
    expectNear(boundsOf(model).m_min, {0, 0, 0}, 1e-4);
    expectNear(boundsOf(model).m_max, {100, 60, 30}, 1e-4);
    for (std::size_t bolt = 1; bolt < 5; ++bolt) {
        EXPECT_EQ(model.meshes[bolt].name, KM_wString(L"Bolt"));
        EXPECT_EQ(model.meshes[bolt].placed.mesh, model.meshes[1].placed.mesh);
    }
    expectNear(model.meshes[1].placed.box().m_min, {6, 6, 10}, 0.1);
    expectNear(model.meshes[4].placed.box().m_max, {94, 54, 30}, 0.1);
}

TEST_F(CadFiles, ColorsAreThoseThatTheFileStates) {
    addBoltedPlate();
    const ImportedModel model = readOrFail(writeStep("a.stp"));
    ASSERT_THAT(model.meshes, SizeIs(5));
    ASSERT_TRUE(model.meshes[0].placed.material);
    EXPECT_EQ(model.meshes[0].placed.material->base_color, KM_Color(204, 51, 26, 255));
    EXPECT_EQ(model.meshes[1].placed.material->base_color, KM_Color(26, 51, 204, 255));
    EXPECT_EQ(model.meshes[0].placed.material->roughness, 0.5F); // a satin finish
}

TEST_F(CadFiles, TrianglesLookOutwardWithTheNormalsOfTheSurface) {
    addPart(BRepPrimAPI_MakeSphere(10.0).Shape(), "Ball");
    const ImportedModel model = readOrFail(writeStep("a.step"));
    ASSERT_THAT(model.meshes, SizeIs(1));
    const KM_Mesh& mesh = *model.meshes[0].placed.mesh;
    EXPECT_NEAR(volumeOf(mesh), 4.0 / 3.0 * std::numbers::pi * 1000.0, 60.0);
    for (std::size_t v = 0; v < mesh.m_V.size(); ++v) {
        const KM_3dVector out = mesh.m_V[v].ToDouble() - KM_3dPoint::Origin;
        EXPECT_NEAR(out.Length(), 10.0, 1e-4);
        EXPECT_NEAR(mesh.m_N[v].ToDouble() * out, 10.0, 0.01);
    }
}

/// How far the middles of a ball's triangles lie inside it, at most.
double farthestInside(const ImportedModel& model, double radius) {
    double farthest = 0.0;
    const KM_Mesh& mesh = *model.meshes.at(0).placed.mesh;
    for (const KM_MeshTriangle& t : mesh.m_F) {
        KM_3dVector middle;
        for (const std::uint32_t v : t.vi)
            middle = middle + (mesh.m_V[v].ToDouble() - KM_3dPoint::Origin) / 3.0;
        farthest = std::max(farthest, radius - middle.Length());
    }
    return farthest;
}

TEST_F(CadFiles, TheMeshLiesAsNearToTheSurfaceAsWasAsked) {
    addPart(BRepPrimAPI_MakeSphere(10.0).Shape(), "Ball");
    const std::filesystem::path file = writeStep("a.step");
    const auto fine = readModelFile(file, {.tolerance = 0.01});
    const auto usual = readModelFile(file);
    ASSERT_TRUE(fine.ok() && usual.ok());
    EXPECT_LT(farthestInside(fine.value(), 10.0), 0.01);
    EXPECT_LT(farthestInside(usual.value(), 10.0), 0.05);
    EXPECT_GT(fine.value().triangleCount(), 2 * usual.value().triangleCount());
}

TEST_F(CadFiles, ASmallCircleHasThirtySidesHoweverLargeTheModelIs) {
    addPart(BRepPrimAPI_MakeBox(10000.0, 10000.0, 1.0).Shape(), "Field");
    addPart(BRepPrimAPI_MakeCylinder(1.0, 1.0).Shape(), "Pin");
    const ImportedModel model = readOrFail(writeStep("a.step"));
    ASSERT_THAT(model.meshes, SizeIs(2));
    // Two triangles a side, and two caps of as many as there are sides less two.
    EXPECT_GE(model.meshes[1].placed.mesh->TriangleCount(), 4 * 30 - 4);
}

TEST_F(CadFiles, LengthsComeOutInMillimetresWhateverTheFileCountsIn) {
    addPart(BRepPrimAPI_MakeBox(254.0, 508.0, 25.4).Shape(), "Box");
    for (const char* unit : {"INCH", "M", "MM"})
        expectNear(boundsOf(readOrFail(writeStep("a.step", unit))).m_max, {254.0, 508.0, 25.4},
                   1e-3);
}

TEST_F(CadFiles, AnIgesFileIsReadWithItsColor) {
    color(addPart(BRepPrimAPI_MakeSphere(10.0).Shape(), "Ball"), srgb(0.0, 1.0, 0.0));
    const ImportedModel model = readOrFail(writeIges("a.igs"));
    ASSERT_THAT(model.meshes, SizeIs(1));
    EXPECT_EQ(model.meshes[0].placed.material->base_color, KM_Color(0, 255, 0, 255));
    expectNear(boundsOf(model).m_max, {10, 10, 10}, 0.1);
    EXPECT_THAT(model.warnings, SizeIs(0));
}

TEST_F(CadFiles, CurvesWithoutFacesBecomePolylines) {
    const gp_Circ circle(gp_Ax2(gp_Pnt(1, 2, 3), gp_Dir(0, 0, 1)), 5.0);
    addPart(BRepBuilderAPI_MakeEdge(circle).Shape(), "Ring");
    const ImportedModel model = readOrFail(writeStep("a.step"));
    ASSERT_THAT(model.curves, SizeIs(1));
    const KM_3dPointArray& points = model.curves[0].points;
    EXPECT_GE(points.Count(), 20);
    for (const KM_3dPoint& point : points)
        EXPECT_NEAR(point.DistanceTo({1, 2, 3}), 5.0, 1e-6);
}

TEST_F(CadFiles, ABrepFileIsRead) {
    const ImportedModel model =
        readOrFail(writeBrep("a.brep", BRepPrimAPI_MakeBox(1.0, 2.0, 3.0).Shape()));
    ASSERT_THAT(model.meshes, SizeIs(1));
    EXPECT_EQ(model.meshes[0].name, KM_wString(L"a"));
    EXPECT_EQ(model.triangleCount(), 12U);
    expectNear(boundsOf(model).m_max, {1, 2, 3}, 1e-6);
}

TEST_F(CadFiles, AFileThatWasCutOffIsTold) {
    addBoltedPlate();
    const std::filesystem::path file = writeStep("a.step");
    std::filesystem::resize_file(file, std::filesystem::file_size(file) - 30);
    const auto cut = readModelFile(file);
    if (cut)
        EXPECT_THAT(cut.value().warnings, testing::Contains(HasSubstr("was cut off")));
    else
        EXPECT_THAT(cut.message(), HasSubstr("a.step"));
    std::filesystem::resize_file(file, 3000);
    const auto half = readModelFile(file);
    ASSERT_FALSE(half.ok());
    EXPECT_THAT(half.message(), HasSubstr("Cannot read"));
}

TEST_F(CadFiles, TextOfAnotherKindIsRefused) {
    for (const char* name : {"a.step", "a.igs", "a.brep"}) {
        const auto read = readModelFile(folder.write(name, "my notes\nand more of them\n"));
        ASSERT_FALSE(read.ok()) << name;
        EXPECT_THAT(read.message(), HasSubstr(name));
    }
}

class GivesUp final : public ReadingWatch {
    bool goesOn(ReadingStep, double) override { return false; }
};

TEST_F(CadFiles, ReadingMayBeGivenUp) {
    addBoltedPlate();
    GivesUp watch;
    const auto read = readModelFile(writeStep("a.step"), {.watch = &watch});
    ASSERT_FALSE(read.ok());
    EXPECT_THAT(read.message(), HasSubstr("given up"));
}

TEST_F(CadFiles, WhatTheMemoryDoesNotHoldIsRefused) {
    addPart(BRepPrimAPI_MakeSphere(10.0).Shape(), "Ball");
    const auto read = readModelFile(writeStep("a.step"), {.tolerance = 0.01, .most_memory = 20000});
    ASSERT_FALSE(read.ok());
    EXPECT_THAT(read.message(), HasSubstr("its triangles need"));
}

} // namespace
} // namespace quarn::test
