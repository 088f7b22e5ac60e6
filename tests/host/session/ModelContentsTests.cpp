#include "host/session/ModelContents.h"

#include "tests/host/app/TestCommand.h"
#include "tests/host/document/DocumentFixtures.h"
#include "tests/host/document/QualityChanges.h"

#include <cmath>

namespace quarn::test {
namespace {

class ModelContentsTest : public HostTest {
protected:
    ModelContents tell(const Material& material) {
        Document::of(session.document())
            .objects()
            .addMesh(L"Box", {boxMesh({0, 0, 0}, {1, 1, 1}), std::make_shared<Material>(material)});
        return contentsOf(session.document());
    }
    static const MaterialQuality& quality(const MaterialContents& material,
                                          const std::string& name) {
        for (const auto& [known, value] : material.qualities)
            if (known == name)
                return value;
        static const MaterialQuality NONE;
        ADD_FAILURE() << name;
        return NONE;
    }
};

TEST_F(ModelContentsTest, EveryQualityOfAMaterialIsTold) {
    const ModelContents contents = tell(changedMaterial());
    ASSERT_EQ(contents.materials.size(), 1U);
    const MaterialContents& told = contents.materials[0];
    EXPECT_EQ(told.qualities.size(), qualityChanges().size());
    for (const QualityChange& change : qualityChanges())
        EXPECT_FALSE(std::holds_alternative<std::monostate>(quality(told, change.name)));
    EXPECT_EQ(contents.textures.size(), 11U);
}

TEST_F(ModelContentsTest, QualitiesAreToldAsTheyAre) {
    const ModelContents contents = tell(changedMaterial());
    const MaterialContents& told = contents.materials[0];
    EXPECT_EQ(std::get<double>(quality(told, "roughness")), 0.3) << "not 0.300000012";
    EXPECT_EQ(std::get<double>(quality(told, "index_of_refraction")), 1.33);
    EXPECT_TRUE(std::get<bool>(quality(told, "one_sided")));
    EXPECT_EQ((std::get<std::array<double, 3>>(quality(told, "emission"))),
              (std::array{1.0, 20.0, 0.5}));
    const auto normals = std::get<UsedTexture>(quality(told, "normals"));
    EXPECT_EQ(normals.texture, 1U);
    EXPECT_EQ(normals.u, (std::array{2.0, 0.5, 3.0}));
    EXPECT_EQ(normals.v, (std::array{-0.25, 1.5, -3.0}));
}

TEST_F(ModelContentsTest, APlainMaterialHasNoneOfWhatIsWorthAWord) {
    Material material;
    material.alpha_cutout = true;
    material.alpha_cutoff = 0.2F;
    const MaterialContents told = tell(material).materials[0];
    EXPECT_EQ(told.alpha_cutoff, 0.2);
    EXPECT_FALSE(told.is_metal || told.has_normal_map || told.has_clearcoat || told.shines ||
                 told.lets_light_through || told.is_unlit || told.has_sheen);
    EXPECT_TRUE(std::isinf(std::get<double>(quality(told, "attenuation_distance"))));
}

TEST_F(ModelContentsTest, WhatIsWorthAWordFollowsFromTheQualities) {
    const MaterialContents all = tell(changedMaterial()).materials[0];
    EXPECT_TRUE(all.is_metal && all.has_normal_map && all.has_clearcoat && all.shines &&
                all.lets_light_through && all.is_unlit && all.has_sheen);
    Material pane;
    pane.see_through = true;
    EXPECT_TRUE(tell(pane).materials[1].lets_light_through);
    Material metal;
    metal.metalness = 0.4F;
    EXPECT_FALSE(tell(metal).materials[2].is_metal);
}

} // namespace
} // namespace quarn::test
