#include "host/document/DocumentScene.h"
#include "host/document/LightStore.h"
#include "host/document/ObjectTable.h"
#include "tests/engine/display/DisplayFixture.h"

#include <gtest/gtest.h>

#include <cmath>

namespace quarn {
namespace {

/// The sun of one frame: from east to west in `count` frames.
KM_Light sunOfFrame(int frame, int count) {
    const double angle = KM_PI * (frame + 0.5) / count;
    return sunLight({-std::cos(angle), -0.3, -std::sin(angle)});
}

/// Puts the frame's light into the table in place of the one before, as a study does.
void replaceLight(LightStore& lights, int& index, const KM_Light& light) {
    if (index >= 0) {
        EXPECT_TRUE(lights.remove(index));
    }
    index = lights.add(light);
}

TEST(SunStudy, ThousandFramesBuildTheSceneOnce) {
    ObjectTable objects;
    objects.addMesh(L"Hills", {shared(hillMesh(80))}); // large: a scene of its own
    objects.addMesh(L"Box", {shared(boxMesh({0, 0, 0}, {3, 3, 9}))});
    LightStore lights;
    int index = LightStore::no_index;
    DocumentScene scene;
    replaceLight(lights, index, sunOfFrame(0, 1000));
    ASSERT_TRUE(scene.update(objects, lights.shiningLights()).ok());
    const std::size_t built = scene.display().rays().buildCount();
    EXPECT_EQ(built, 3U); // the hills, the small meshes, and both together
    RTCScene const root = scene.display().rays().root();
    for (int frame = 1; frame < 1000; ++frame) {
        replaceLight(lights, index, sunOfFrame(frame, 1000));
        ASSERT_TRUE(scene.update(objects, lights.shiningLights()).ok());
        ASSERT_EQ(scene.display().lights().size(), 1U); // deleted slots are not walked through
    }
    EXPECT_EQ(lights.count(), 1000);
    EXPECT_EQ(scene.display().rays().buildCount(), built);
    EXPECT_EQ(scene.display().rays().root(), root);
}

TEST(SunStudy, FramesOfAKeptSceneEqualThoseOfAFreshOne) {
    ObjectTable objects;
    objects.addMesh(L"Box", {shared(boxMesh({-1, -1, 0}, {1, 1, 4}))});
    LightStore lights;
    int index = LightStore::no_index;
    DocumentScene kept;
    const KM_Viewport viewport = perspectiveView({-10.0, -14.0, 8.0}, {0.0, 0.0, 1.0});
    for (int frame = 0; frame < 5; ++frame) {
        replaceLight(lights, index, sunOfFrame(frame, 5));
        DocumentScene fresh;
        Image images[2];
        DocumentScene* const scenes[2] = {&kept, &fresh};
        for (int i = 0; i < 2; ++i) {
            ASSERT_TRUE(scenes[i]->update(objects, lights.shiningLights()).ok());
            ASSERT_TRUE(
                scenes[i]->draw(viewport, modeNamed(L"Rendered", 2), 160, 120, images[i]).ok());
        }
        EXPECT_EQ(images[0].rgba, images[1].rgba) << frame;
    }
}

TEST(SunStudy, HidingAnObjectBuildsOnlyWhatItIsIn) {
    SceneContent content;
    addMesh(content, hillMesh(80));
    addMesh(content, boxMesh({0, 0, 0}, {3, 3, 90}));
    content.curves.push_back({KM_CreateUuid(), {}, {}, true});
    content.curves[0].polyline.Append({0, 0, 500});
    DisplayScene scene;
    ASSERT_TRUE(scene.update(content).ok());
    const std::size_t built = scene.rays().buildCount();
    EXPECT_EQ(scene.boundingBox().m_max.z, 500.0);
    content.curves[0].visible = false;
    ASSERT_TRUE(scene.update(content).ok());
    EXPECT_EQ(scene.rays().buildCount(), built);
    EXPECT_EQ(scene.boundingBox().m_max.z, 90.0);
    content.meshes[1].visible = false;
    ASSERT_TRUE(scene.update(content).ok());
    EXPECT_LE(scene.rays().buildCount(), built + 1);
    EXPECT_LT(scene.boundingBox().m_max.z, 10.0);
}

} // namespace
} // namespace quarn
