#include "tests/import/ModelFixtures.h"

#include <gmock/gmock.h>

namespace quarn::test {
namespace {

using ::testing::HasSubstr;
using ::testing::IsEmpty;

/// A roof of two triangles over points that only a double can tell apart.
constexpr const char* surveyed =
    "v 4500012.125 5200034.25 100.5\nv 4500013.125 5200034.25 100.5\n"
    "v 4500012.125 5200035.25 101.0 1 0 0.5\nv 4500013.125 5200035.5 101\n"
    "f 1 2 3\nf 2 4 3\nl 1 2\n";

TEST(PlacedModel, SurveyedCoordinatesKeepAllTheirDigits) {
    const TemporaryFolder folder;
    const ImportedModel model = readOrFail(folder.write("site.obj", surveyed));
    ASSERT_EQ(model.meshes.size(), 1U);
    expectNear(boundsOf(model).m_min, {4500012.125, 5200034.25, 100.5}, 1e-6);
    expectNear(boundsOf(model).m_max, {4500013.125, 5200035.5, 101.0}, 1e-6);
    const KM_BoundingBox own = model.meshes[0].placed.mesh->BoundingBox();
    EXPECT_LT((own.Center() - KM_3dPoint::Origin).Length(), 1000.0);
    ASSERT_EQ(model.curves.size(), 1U);
    expectNear(model.curves[0].points[0], {4500012.125, 5200034.25, 100.5}, 1e-6);
    EXPECT_THAT(model.warnings, IsEmpty());
}

TEST(PlacedModel, TrianglesThatAreNearTheOriginStandWhereTheirVerticesSay) {
    const TemporaryFolder folder;
    const ImportedModel model =
        readOrFail(folder.write("a.obj", "v 20000 0 0\nv -20000 0 0\nv 0 20000 0.25\nf 1 2 3\n"));
    ASSERT_EQ(model.meshes.size(), 1U);
    EXPECT_TRUE(model.meshes[0].placed.world_from_mesh.IsIdentity());
    expectNear(model.meshes[0].placed.mesh->BoundingBox().m_max, {20000, 20000, 0.25}, 0.0);
}

TEST(PlacedModel, SurveyedModelThatIsYUpIsTurnedAsAWhole) {
    const TemporaryFolder folder;
    const auto model = readModelFile(folder.write("site.obj", surveyed), {.up = UpAxis::y});
    ASSERT_TRUE(model.ok());
    // x stays, z comes from y, y from -z.
    expectNear(boundsOf(model.value()).m_min, {4500012.125, -101.0, 5200034.25}, 1e-6);
}

TEST(PlacedModel, DigitsAreKeptBesideVerticesThatCannotBeUnderstoodOrHaveAWeight) {
    for (const std::string last : {"v one 2 3\n", "v 9000000 0 0 2\n"}) {
        const TemporaryFolder folder;
        const ImportedModel model = readOrFail(folder.write(
            "a.obj", "v 4500000.125 0 0\nv 4500001 0 0\nv 4500000.25 1 0\nf 1 2 3\n" + last));
        ASSERT_EQ(model.meshes.size(), 1U);
        EXPECT_NEAR(boundsOf(model).m_min.x, 4500000.125, 1e-6);
    }
}

TEST(PlacedModel, CoordinatesThatTheReadingRoundsAreTold) {
    const TemporaryFolder folder;
    const ImportedModel model = readOrFail(folder.write(
        "site.amf",
        "<?xml version=\"1.0\" encoding=\"UTF-8\"?><amf unit=\"millimeter\"><object id=\"1\">"
        "<mesh><vertices>"
        "<vertex><coordinates><x>4500000</x><y>5200000</y><z>0</z></coordinates></vertex>"
        "<vertex><coordinates><x>4500010</x><y>5200000</y><z>0</z></coordinates></vertex>"
        "<vertex><coordinates><x>4500000</x><y>5200010</y><z>0</z></coordinates></vertex>"
        "</vertices><volume><triangle><v1>0</v1><v2>1</v2><v3>2</v3></triangle></volume></mesh>"
        "</object></amf>"));
    ASSERT_EQ(model.warnings.size(), 1U);
    EXPECT_THAT(model.warnings[0], HasSubstr("far from the origin"));
    EXPECT_THAT(model.warnings[0], HasSubstr("0.5"));
}

TEST(PlacedModel, ScaleOfANodeRoundsNothing) {
    // A triangle of three corners of the unit square, scaled to a micrometre.
    const TemporaryFolder folder;
    const ImportedModel model = readOrFail(folder.write(
        "tiny.gltf",
        R"({"asset":{"version":"2.0"},"scene":0,"scenes":[{"nodes":[0]}],"nodes":[{"mesh":0,)"
        R"("scale":[1e-6,1e-6,1e-6]}],"meshes":[{"primitives":[{"attributes":{"POSITION":0}}]}],)"
        R"("accessors":[{"bufferView":0,"componentType":5126,"count":3,"type":"VEC3"}],)"
        R"("bufferViews":[{"buffer":0,"byteLength":36}],"buffers":[{"byteLength":36,"uri":)"
        R"("data:application/octet-stream;base64,AAAAAAAAAAAAAAAAAACAPwAAAAAAAAAAAAAAAAAAgD8AAAAA"}]})"));
    EXPECT_THAT(model.warnings, IsEmpty());
    EXPECT_NEAR(boundsOf(model).m_max.x, 1e-6, 1e-12);
}

} // namespace
} // namespace quarn::test
