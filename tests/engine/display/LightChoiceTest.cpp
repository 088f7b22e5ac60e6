#include "engine/display/LightChoice.h"
#include "tests/engine/display/DisplayFixture.h"

#include <gtest/gtest.h>

namespace quarn {
namespace {

const KM_BoundingBox CHAIR({0, 0, 0}, {0.6, 0.6, 0.9});
const KM_BoundingBox HOUSE({0, 0, 0}, {12, 8, 6});

Surroundings chosen(const LightSettings& settings, const KM_BoundingBox& box,
                    const std::vector<KM_Light>& lights = {}) {
    return surroundingsOf(settings, lights, box);
}

TEST(LightChoice, ProductsStandInAStudioAndBuildingsUnderTheSky) {
    EXPECT_EQ(chosen({}, CHAIR), Surroundings::studio);
    EXPECT_EQ(chosen({}, HOUSE), Surroundings::sky);
    EXPECT_EQ(chosen({}, {}), Surroundings::sky);
}

TEST(LightChoice, TheSizeCountsInMetres) {
    LightSettings millimetres;
    millimetres.metres_per_unit = 0.001;
    EXPECT_EQ(chosen(millimetres, {{0, 0, 0}, {4999, 10, 10}}), Surroundings::studio);
    EXPECT_EQ(chosen(millimetres, {{0, 0, 0}, {10, 10, 5001}}), Surroundings::sky);
}

TEST(LightChoice, WhereASunShinesThereIsASkyEvenByNight) {
    EXPECT_EQ(chosen({}, CHAIR, {sunLight({0, 0, -1})}), Surroundings::sky);
    EXPECT_EQ(chosen({}, CHAIR, {sunLight({0, 0.5, 1})}), Surroundings::sky);
    KM_Light off = sunLight({0, 0, -1});
    off.Enable(false);
    KM_Light lamp;
    lamp.SetStyle(KM_LightStyle::world_point);
    EXPECT_EQ(chosen({}, CHAIR, {off, lamp}), Surroundings::studio);
}

TEST(LightChoice, WhatTheSettingsSayHoldsForEveryScene) {
    LightSettings settings;
    settings.surroundings = Surroundings::studio;
    EXPECT_EQ(chosen(settings, HOUSE, {sunLight({0, 0, -1})}), Surroundings::studio);
    settings.surroundings = Surroundings::sky;
    EXPECT_EQ(chosen(settings, CHAIR), Surroundings::sky);
}

TEST(LightChoice, APictureThatIsNoneIsTakenForAutomatic) {
    LightSettings settings;
    settings.surroundings = Surroundings::picture;
    EXPECT_EQ(chosen(settings, CHAIR), Surroundings::studio);
    settings.picture = std::make_shared<EnvironmentPicture>(EnvironmentPicture{2, 2, {1, 1, 1}});
    EXPECT_EQ(chosen(settings, HOUSE), Surroundings::sky);
    settings.picture = std::make_shared<EnvironmentPicture>(EnvironmentPicture{1, 1, {1, 1, 1}});
    EXPECT_EQ(chosen(settings, CHAIR), Surroundings::picture);
}

TEST(LightChoice, HiddenSurfacesCountSoThatTheChoiceHoldsThroughoutAFilm) {
    SceneContent content;
    addMesh(content, boxMesh({0, 0, 0}, {1, 1, 1}));
    const std::size_t house = addMesh(content, boxMesh({2, 0, 0}, {14, 8, 6}));
    DisplayScene scene;
    ASSERT_TRUE(scene.update(content).ok());
    EXPECT_EQ(scene.surroundings(), Surroundings::sky);
    content.meshes[house].visible = false;
    ASSERT_TRUE(scene.update(content).ok());
    EXPECT_EQ(scene.surroundings(), Surroundings::sky);
}

} // namespace
} // namespace quarn
