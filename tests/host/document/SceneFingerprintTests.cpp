#include "host/document/SceneFingerprint.h"

#include "ground/Checksum.h"
#include "tests/engine/display/DisplayFixture.h"
#include "tests/host/document/QualityChanges.h"

#include <functional>
#include <gtest/gtest.h>
#include <set>

namespace quarn::test {
namespace {

std::uint64_t fingerprintOf(const SceneContent& content) {
    Checksum sum;
    addScene(content, sum);
    return sum.value();
}

SceneContent sampleScene() {
    SceneContent content;
    addMesh(content, boxMesh({0.0, 0.0, 0.0}, {1.0, 2.0, 3.0}));
    auto texture = std::make_shared<Texture>();
    texture->width = texture->height = 1;
    texture->rgba = {1, 2, 3, 255};
    auto material = std::make_shared<Material>();
    material->base_color_texture = texture;
    content.meshes[0].placed.material = material;
    content.curves.push_back({});
    content.curves[0].polyline.Append({1.0, 2.0, 3.0});
    content.points.push_back({});
    content.lights.push_back(sunLight({0.0, 0.0, -1.0}));
    return content;
}

/// Whether this change of the scene changes its fingerprint.
bool isNoticed(const std::function<void(SceneContent&)>& change) {
    SceneContent content = sampleScene();
    change(content);
    return fingerprintOf(content) != fingerprintOf(sampleScene());
}

TEST(SceneFingerprintTest, OfAModelReadAgainIsTheSame) {
    EXPECT_FALSE(isNoticed([](SceneContent& content) {
        content.revision = 17;
        content.meshes[0].id = KM_UUID{1, 2, 3, {4, 5, 6, 7, 8, 9, 10, 11}};
    }));
}

TEST(SceneFingerprintTest, ChangesWithEverythingThatIsSeen) {
    EXPECT_TRUE(isNoticed([](SceneContent& content) {
        KM_Mesh mesh = *content.meshes[0].placed.mesh;
        mesh.m_V[5].z += 1e-6F;
        content.meshes[0].placed.mesh = shared(std::move(mesh));
    }));
    EXPECT_TRUE(isNoticed([](SceneContent& content) { content.meshes[0].visible = false; }));
    EXPECT_TRUE(isNoticed([](SceneContent& content) {
        content.meshes[0].placed.world_from_mesh = KM_Xform::Translation(0.0, 0.0, 1e-9);
    }));
    EXPECT_TRUE(isNoticed([](SceneContent& content) {
        Material material = *content.meshes[0].placed.material;
        material.base_color = {1, 2, 3, 4};
        content.meshes[0].placed.material = std::make_shared<Material>(material);
    }));
    EXPECT_TRUE(isNoticed([](SceneContent& content) {
        Material material = *content.meshes[0].placed.material;
        Texture texture = *material.base_color_texture;
        texture.rgba[2] = 4;
        material.base_color_texture = std::make_shared<Texture>(texture);
        content.meshes[0].placed.material = std::make_shared<Material>(material);
    }));
    EXPECT_TRUE(isNoticed([](SceneContent& content) {
        content.curves[0].polyline.Append({1.0, 2.0, 4.0});
    }));
    EXPECT_TRUE(isNoticed([](SceneContent& content) { content.points[0].location.x = 1.0; }));
    EXPECT_TRUE(isNoticed([](SceneContent& content) {
        content.lights[0] = sunLight({0.0, 1.0, -1.0});
    }));
    EXPECT_TRUE(isNoticed([](SceneContent& content) { content.lights.clear(); }));
}

/// The sample with this change of its material.
SceneContent sceneWith(const std::function<void(Material&)>& change) {
    SceneContent content = sampleScene();
    auto material = std::make_shared<Material>(*content.meshes[0].placed.material);
    change(*material);
    content.meshes[0].placed.material = std::move(material);
    return content;
}

TEST(SceneFingerprintTest, ChangesWithEveryQualityOfAMaterialToAnotherEachTime) {
    std::set<std::uint64_t> fingerprints{fingerprintOf(sampleScene())};
    for (const QualityChange& change : qualityChanges())
        EXPECT_TRUE(fingerprints.insert(fingerprintOf(sceneWith(change.make))).second)
            << change.name;
}

TEST(SceneFingerprintTest, ChangesWithTheWayThatATextureLies) {
    const auto fingerprint = [](float shift_u, float shift_v) {
        return fingerprintOf(sceneWith([&](Material& material) {
            material.normals.texture = material.base_color_texture;
            material.normals.u[2] = shift_u;
            material.normals.v[2] = shift_v;
        }));
    };
    EXPECT_EQ(fingerprint(0.5F, 0.0F), fingerprint(0.5F, 0.0F));
    EXPECT_NE(fingerprint(0.0F, 0.0F), fingerprint(0.5F, 0.0F));
    EXPECT_NE(fingerprint(0.0F, 0.5F), fingerprint(0.5F, 0.0F));
}

TEST(SceneFingerprintTest, TellsATextureOfOneQualityFromThatOfAnother) {
    const auto use = [](TextureUse Material::*quality) {
        return fingerprintOf(sceneWith([=](Material& material) {
            (material.*quality).texture = material.base_color_texture;
        }));
    };
    EXPECT_NE(use(&Material::occlusion), use(&Material::metal_rough));
    EXPECT_NE(use(&Material::clearcoat_texture), use(&Material::specular_texture));
}

std::uint64_t fingerprintOf(const LightSettings& light) {
    Checksum sum;
    addLight(light, sum);
    return sum.value();
}

LightSettings withPicture(float light) {
    LightSettings settings;
    settings.picture =
        std::make_shared<const EnvironmentPicture>(EnvironmentPicture{1, 1, {light, 0.0F, 0.0F}});
    return settings;
}

TEST(SceneFingerprintTest, OfTheLightChangesWithAllThatIsChosen) {
    const std::function<void(LightSettings&)> changes[] = {
        [](LightSettings& light) { light.surroundings = Surroundings::sky; },
        [](LightSettings& light) { light.exposure = 0.0; },
        [](LightSettings& light) { light.exposure = 1.0; },
        [](LightSettings& light) { light.background = BackgroundKind::transparent; },
        [](LightSettings& light) { light.background_color.b = 0; },
        [](LightSettings& light) { light.has_ground = false; },
        [](LightSettings& light) { light.metres_per_unit = 0.001; },
        [](LightSettings& light) { light = withPicture(1.0F); },
        [](LightSettings& light) { light = withPicture(2.0F); }};
    std::set<std::uint64_t> fingerprints{fingerprintOf(LightSettings())};
    for (const auto& change : changes) {
        LightSettings light;
        change(light);
        EXPECT_TRUE(fingerprints.insert(fingerprintOf(light)).second);
    }
    EXPECT_EQ(fingerprintOf(withPicture(1.0F)), fingerprintOf(withPicture(1.0F)))
        << "the same picture read again";
}

} // namespace
} // namespace quarn::test
