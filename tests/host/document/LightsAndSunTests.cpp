#include "host/document/DocumentDrawing.h"
#include "import/ImportedModel.h"
#include "tests/host/document/DocumentFixtures.h"

#include <limits>

namespace quarn::test {
namespace {

KM_Light sunFrom(const KM_3dVector& direction) {
    KM_Light light;
    light.SetStyle(7);
    light.SetDirection(direction);
    return light;
}

using LightTableTest = DocumentTest;

TEST_F(LightTableTest, SlotsOfDeletedLightsAreNeverUsedAgain) {
    CQuarnLightTable& table = document.face().LightTable();
    EXPECT_EQ(table.AddLight(sunFrom({0, 0, -1}), nullptr), 0);
    EXPECT_EQ(table.AddLight(sunFrom({1, 0, -1}), nullptr), 1);
    EXPECT_TRUE(table.DeleteLight(0, true));
    EXPECT_EQ(table.AddLight(sunFrom({0, 1, -1}), nullptr), 2);
    EXPECT_EQ(table.LightCount(), 3);
    EXPECT_TRUE(table[0].IsDeleted());
    EXPECT_FALSE(table[1].IsDeleted());
    EXPECT_EQ(table[2].Light().Direction(), KM_3dVector(0, 1, -1));
}

TEST_F(LightTableTest, StaleAndForeignIndicesNameNoLiveLight) {
    CQuarnLightTable& table = document.face().LightTable();
    table.AddLight(sunFrom({0, 0, -1}), nullptr);
    table.AddLight(sunFrom({1, 0, -1}), nullptr);
    EXPECT_TRUE(table.DeleteLight(0, true));
    for (const int index :
         {0, -1, 2, 1000, std::numeric_limits<int>::max(), std::numeric_limits<int>::min()}) {
        EXPECT_TRUE(table[index].IsDeleted()) << index;
        EXPECT_FALSE(table.DeleteLight(index, true)) << index;
        EXPECT_FALSE(table[1].IsDeleted()) << index;
    }
    EXPECT_EQ(table.LightCount(), 2);
}

TEST_F(LightTableTest, LightsShineInTheOrderOfTheirIndices) {
    LightStore& lights = document.lights();
    for (int x = 0; x < 5; ++x)
        lights.add(sunFrom({static_cast<double>(x), 0, -1}));
    lights.remove(3);
    lights.remove(0);
    std::vector<int> xs;
    for (const KM_Light& light : lights.shiningLights())
        xs.push_back(static_cast<int>(light.Direction().x));
    EXPECT_EQ(xs, (std::vector{1, 2, 4}));
}

TEST_F(LightTableTest, RefusesLightsThatCannotShine) {
    CQuarnLightTable& table = document.face().LightTable();
    EXPECT_EQ(table.AddLight(KM_Light(), nullptr), -1);
    EXPECT_EQ(table.AddLight(sunFrom(KM_3dVector::ZeroVector), nullptr), -1);
    EXPECT_EQ(table.AddLight(sunFrom(KM_3dVector::UnsetVector), nullptr), -1);
    EXPECT_EQ(table.LightCount(), 0);
}

TEST_F(LightTableTest, ADirectionKeepsItsLength) {
    CQuarnLightTable& table = document.face().LightTable();
    const int index = table.AddLight(sunFrom({0, 0, -100}), nullptr);
    EXPECT_EQ(table[index].Light().Direction(), KM_3dVector(0, 0, -100));
}

TEST_F(LightTableTest, OnlyLiveLightsThatAreOnShineBesideTheSun) {
    document.sun().beginChange();
    document.sun().setDirectionToSun({0, 0, 1}); // else it would make way for another one
    document.lights().add(sunFrom({0, 0, -1}));
    KM_Light off = sunFrom({1, 0, -1});
    off.Enable(false);
    document.lights().add(off);
    document.lights().remove(document.lights().add(sunFrom({0, 1, -1})));

    const std::vector<KM_Light> lights = document.drawing().light().shiningLights();
    ASSERT_EQ(lights.size(), 2U);
    EXPECT_EQ(lights[0].Direction(), -document.sun().directionToSun());
    EXPECT_EQ(lights[1].Direction(), KM_3dVector(0, 0, -1));
}

KM_Light lampOfModel() {
    KM_Light lamp;
    lamp.SetStyle(KM_LightStyle::world_point);
    lamp.SetLocation({1, 2, 3});
    return lamp;
}

TEST_F(LightTableTest, LightsOfAModelShineBesideTheSun) {
    ImportedModel model;
    model.lights = {lampOfModel()};
    document.addModel(model);
    const std::vector<KM_Light> lights = document.drawing().light().shiningLights();
    ASSERT_EQ(lights.size(), 2U);
    EXPECT_EQ(lights[1].Style(), KM_LightStyle::world_point);
    EXPECT_EQ(document.face().LightTable().LightCount(), 1);
}

TEST_F(LightTableTest, LightsOfTheDocumentRestWhileAStudyMovesASun) {
    document.lights().add(lampOfModel());
    CQuarnLightTable& table = document.face().LightTable();
    const int sun = table.AddLight(sunFrom({0, 0, -1}), nullptr);
    EXPECT_EQ(document.drawing().light().shiningLights().size(), 3U) << "a light beside the sun";

    document.sun().beginChange();
    document.sun().setEnabled(false);
    const std::vector<KM_Light> lights = document.drawing().light().shiningLights();
    ASSERT_EQ(lights.size(), 1U);
    EXPECT_EQ(lights[0].Direction(), KM_3dVector(0, 0, -1));
    EXPECT_FALSE(table[0].IsDeleted());
    EXPECT_TRUE(table[0].Light().IsEnabled()) << "plug-ins see it as it is";

    table.DeleteLight(sun, true);
    ASSERT_EQ(document.drawing().light().shiningLights().size(), 1U);
    EXPECT_EQ(document.drawing().light().shiningLights()[0].Style(), KM_LightStyle::world_point);
}

TEST_F(LightTableTest, TheSunOfASingleFrameOfAStudyShinesAlone) {
    document.lights().add(lampOfModel());
    document.lights().add(sunFrom({1, 0, -1}));
    SceneChanges changes;
    changes.sun = sunFrom({0, 0, -1});
    const std::vector<KM_Light> lights = document.drawing().light().shiningLights(changes);
    ASSERT_EQ(lights.size(), 1U);
    EXPECT_EQ(lights[0].Direction(), KM_3dVector(0, 0, -1));
}

TEST_F(LightTableTest, AStudySunThatCannotShineLeavesTheStudyDark) {
    document.lights().add(lampOfModel());
    document.sun().beginChange();
    document.sun().setEnabled(false);
    CQuarnLightTable& table = document.face().LightTable();
    EXPECT_EQ(table.AddLight(sunFrom(KM_3dVector::ZeroVector), nullptr), LightStore::no_index);
    EXPECT_TRUE(document.drawing().light().shiningLights().empty());
    table.AddLight(sunFrom({0, 0, -1}), nullptr);
    EXPECT_EQ(document.drawing().light().shiningLights().size(), 1U);
}

TEST_F(LightTableTest, ALampOfAPlugInMakesNoStudy) {
    document.lights().add(sunFrom({1, 0, -1}));
    document.face().LightTable().AddLight(lampOfModel(), nullptr);
    document.sun().beginChange();
    document.sun().setEnabled(false);
    EXPECT_EQ(document.drawing().light().shiningLights().size(), 2U);
}

using DocumentSunTest = DocumentTest;

TEST_F(DocumentSunTest, StartsOnInTheSouthEastHalfwayUp) {
    CQuarnSun& sun = document.face().Sun();
    EXPECT_TRUE(sun.IsEnabled());
    const KM_3dVector direction = sun.DirectionToSun();
    EXPECT_NEAR(direction.Length(), 1.0, 1e-15);
    EXPECT_NEAR(direction.z, std::sin(45.0 * KM_PI / 180.0), 1e-15);
    EXPECT_NEAR(std::atan2(direction.x, direction.y), 135.0 * KM_PI / 180.0, 1e-15);
}

TEST_F(DocumentSunTest, NothingChangesWithoutAnOpenChange) {
    CQuarnSun& sun = document.face().Sun();
    sun.SetEnabled(false);
    EXPECT_TRUE(sun.IsEnabled());
    EXPECT_FALSE(sun.EndChange());
}

TEST_F(DocumentSunTest, ChangesNestAndEachTellsWhatChangedInIt) {
    CQuarnSun& sun = document.face().Sun();
    sun.BeginChange(CQuarnSun::change_by_program);
    sun.SetEnabled(false);
    sun.BeginChange(CQuarnSun::change_by_program);
    EXPECT_FALSE(sun.EndChange());
    sun.SetEnabled(false);
    EXPECT_TRUE(sun.EndChange());
    EXPECT_FALSE(sun.IsEnabled());
    sun.SetEnabled(true);
    EXPECT_FALSE(sun.IsEnabled()) << "every change is closed";
}

TEST_F(DocumentSunTest, AChangeThatIsTakenBackIsNone) {
    CQuarnSun& sun = document.face().Sun();
    sun.BeginChange(CQuarnSun::change_by_program);
    sun.SetEnabled(false);
    sun.SetEnabled(true);
    EXPECT_FALSE(sun.EndChange());
}

TEST_F(DocumentSunTest, ShinesOnlyWhileItIsOn) {
    ASSERT_EQ(document.drawing().light().shiningLights().size(), 1U);
    EXPECT_EQ(document.drawing().light().shiningLights()[0].Style(),
              KM_LightStyle::world_directional);
    document.sun().beginChange();
    document.sun().setEnabled(false);
    document.sun().endChange();
    EXPECT_TRUE(document.drawing().light().shiningLights().empty());
}

} // namespace
} // namespace quarn::test
