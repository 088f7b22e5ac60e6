#include "host/document/ObjectTable.h"
#include "host/document/ViewFit.h"
#include "host/document/file/DocumentCoding.h"

#include <gtest/gtest.h>

#include <limits>

namespace quarn {
namespace {

std::shared_ptr<const KM_Mesh> unitTriangle() {
    KM_Mesh mesh;
    mesh.m_V = {{0.0F, 0.0F, 0.0F}, {1.0F, 0.0F, 0.0F}, {0.0F, 1.0F, 0.0F}};
    mesh.m_F = {{{0, 1, 2}}};
    return std::make_shared<const KM_Mesh>(std::move(mesh));
}

KM_Xform quarterTurnAt(double x, double y, double z) {
    return KM_Xform::Translation(x, y, z) *
           KM_Xform::Rotation(KM_PI / 2.0, KM_3dVector::ZAxis, KM_3dPoint::Origin);
}

/// A document of two objects that share a mesh.
DocumentContent twoPlaced() {
    DocumentContent content;
    const auto mesh = unitTriangle();
    for (const KM_Xform& place : {quarterTurnAt(4.5e6, 5.2e6, 100.0), KM_Xform()}) {
        ObjectContent object;
        object.id = KM_CreateUuid();
        object.placed.mesh = mesh;
        object.placed.world_from_mesh = place;
        content.objects.push_back(std::move(object));
    }
    return content;
}

TEST(PlacedObject, BoxIsThatOfItsVerticesInTheWorld) {
    ObjectTable objects;
    const DocumentObject& object =
        objects.addMesh(L"", {unitTriangle(), nullptr, quarterTurnAt(4.5e6, 5.2e6, 100.0)});
    // A quarter turn carries (1, 0) to (0, 1) and (0, 1) to (-1, 0).
    EXPECT_EQ(object.boundingBox().m_min, KM_3dPoint(4.5e6 - 1.0, 5.2e6, 100.0));
    EXPECT_EQ(object.boundingBox().m_max, KM_3dPoint(4.5e6, 5.2e6 + 1.0, 100.0));
}

TEST(PlacedObject, ViewIsFittedToWhereItStands) {
    ObjectTable objects;
    objects.addMesh(L"", {unitTriangle(), nullptr, KM_Xform::Translation(4.5e6, 5.2e6, 100.0)});
    KM_Viewport viewport;
    const Result<KM_Viewport> fitted = fitViewport(viewport, objects, ViewFit());
    ASSERT_TRUE(fitted.ok()) << fitted.message();
    const KM_3dPoint middle(4.5e6 + 0.5, 5.2e6 + 0.5, 100.0);
    EXPECT_LT(fitted.value().TargetPoint().DistanceTo(middle), 1e-6);
    EXPECT_LT(fitted.value().CameraLocation().DistanceTo(middle), 20.0);
}

TEST(PlacedObject, ComesBackFromAFileWithItsPlaceAndStillShared) {
    const DocumentContent content = twoPlaced();
    const auto bytes = encodeDocument(content);
    ASSERT_TRUE(bytes.ok());
    const auto read = decodeDocument(bytes.value());
    ASSERT_TRUE(read.ok()) << read.message();
    ASSERT_EQ(read.value().objects.size(), 2U);
    const auto& objects = read.value().objects;
    EXPECT_EQ(objects[0].placed.mesh, objects[1].placed.mesh);
    EXPECT_EQ(objects[0].placed.world_from_mesh, content.objects[0].placed.world_from_mesh);
    EXPECT_TRUE(objects[1].placed.world_from_mesh.IsIdentity());
}

TEST(PlacedObject, PlaceThatFlattensOrIsNoNumberIsNotWritten) {
    for (const double factor : {0.0, std::numeric_limits<double>::quiet_NaN()}) {
        DocumentContent content = twoPlaced();
        content.objects[0].placed.world_from_mesh = KM_Xform::Diagonal(1.0, 1.0, factor);
        EXPECT_FALSE(encodeDocument(content).ok()) << factor;
    }
}

} // namespace
} // namespace quarn
