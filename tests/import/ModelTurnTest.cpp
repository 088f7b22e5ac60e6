#include "import/ModelTurn.h"
#include "tests/import/ModelFixtures.h"

#include <gmock/gmock.h>

#include <cmath>

namespace quarn::test {
namespace {

/// A roof, a line and a point, none of them alike along two axes.
constexpr const char* ROOF = "o Roof\nv 1 2 3\nv 4 2 3\nv 1 7 3\nv 1 2 9\nv 5 6 8\n"
                             "f 1 2 3\nf 1 3 4\nl 1 5\np 5\n";

std::vector<KM_3fPoint> verticesOf(const ImportedModel& model) {
    std::vector<KM_3fPoint> vertices;
    for (const ImportedMesh& mesh : model.meshes)
        for (const KM_3fPoint& vertex : mesh.placed.mesh->m_V)
            vertices.push_back(KM_3fPoint(mesh.placed.world_from_mesh * vertex.ToDouble()));
    return vertices;
}

void expectSame(const ImportedModel& actual, const ImportedModel& expected) {
    EXPECT_EQ(verticesOf(actual), verticesOf(expected));
    ASSERT_EQ(actual.meshes.size(), expected.meshes.size());
    for (std::size_t i = 0; i < actual.meshes.size(); ++i) {
        const KM_Mesh& mesh = *actual.meshes[i].placed.mesh;
        const KM_Mesh& other = *expected.meshes[i].placed.mesh;
        ASSERT_EQ(mesh.m_N.size(), other.m_N.size());
        for (std::size_t n = 0; n < mesh.m_N.size(); ++n) {
            EXPECT_NEAR(mesh.m_N[n].y, other.m_N[n].y, 1e-6);
            EXPECT_NEAR(mesh.m_N[n].z, other.m_N[n].z, 1e-6);
        }
        EXPECT_EQ(actual.meshes[i].name, expected.meshes[i].name);
    }
    ASSERT_EQ(actual.curves.size(), 1U);
    EXPECT_EQ(actual.curves[0].points, expected.curves[0].points);
    EXPECT_EQ(actual.points, expected.points);
}

class ModelTurnTest : public testing::Test {
protected:
    ImportedModel readRoof(UpAxis up) {
        auto model = readModelFile(folder.write("roof.obj", ROOF), {.up = up});
        EXPECT_TRUE(model) << model.message();
        return std::move(model.value());
    }

    TemporaryFolder folder;
};

TEST_F(ModelTurnTest, ATurnedModelIsTheOneThatIsReadWithTheOtherAxisUp) {
    const ImportedModel turned = turnedUp(readRoof(UpAxis::by_format), UpAxis::y);
    expectSame(turned, readRoof(UpAxis::y));
    EXPECT_EQ(turned.up.axis, UpAxis::y);
    EXPECT_EQ(turned.up.reason, TakenUpAxis::Reason::asked);
    expectSame(turnedUp(readRoof(UpAxis::y), UpAxis::z), readRoof(UpAxis::z));
}

TEST_F(ModelTurnTest, TheModelThatIsTurnedStaysAsItWas) {
    const ImportedModel model = readRoof(UpAxis::z);
    turnedUp(model, UpAxis::y);
    expectSame(model, readRoof(UpAxis::z));
}

TEST_F(ModelTurnTest, AModelFarFromTheOriginKeepsItsDigits) {
    const std::filesystem::path file = folder.write(
        "far.obj", "v 4000000.125 20 3\nv 4000001.25 20 3\nv 4000000.125 21.5 3\nf 1 2 3\n");
    const auto model = readModelFile(file);
    ASSERT_TRUE(model) << model.message();
    const KM_BoundingBox box = boundsOf(turnedUp(model.value(), UpAxis::y));
    EXPECT_EQ(box.m_min, KM_3dPoint(4000000.125, -3, 20));
    EXPECT_EQ(box.m_max, KM_3dPoint(4000001.25, -3, 21.5));
}

TEST_F(ModelTurnTest, LargeMeshesStaySharedAndSmallOnesNeedNoTransform) {
    ImportedModel model = readRoof(UpAxis::z);
    EXPECT_TRUE(turnedUp(model, UpAxis::y).meshes[0].placed.world_from_mesh.IsIdentity());
    auto large = std::make_shared<KM_Mesh>(*model.meshes[0].placed.mesh);
    large->m_F.resize(600'000, large->m_F[0]);
    model.meshes[0].placed.mesh = large;
    const ImportedModel turned = turnedUp(model, UpAxis::y);
    EXPECT_EQ(turned.meshes[0].placed.mesh, large);
    EXPECT_EQ(verticesOf(turned), verticesOf(readRoof(UpAxis::y)));
}

} // namespace
} // namespace quarn::test
