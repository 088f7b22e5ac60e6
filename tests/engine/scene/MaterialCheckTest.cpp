#include "engine/scene/MaterialCheck.h"

#include "engine/scene/MaterialTextures.h"

#include <gmock/gmock.h>

#include <cmath>
#include <limits>

namespace quarn::test {
namespace {

using testing::ElementsAre;

constexpr float NOT_A_NUMBER = std::numeric_limits<float>::quiet_NaN();
constexpr float INFINITE = std::numeric_limits<float>::infinity();

std::shared_ptr<const Texture> texture(int width, int height, std::size_t bytes) {
    Texture made;
    made.width = width;
    made.height = height;
    made.rgba.resize(bytes);
    return std::make_shared<const Texture>(std::move(made));
}

TEST(DrawableMaterial, ThatIsSoundStaysAsItIs) {
    Material material;
    material.emission = {3.0F, 2.0F, 1000.0F};
    material.specular_color = {2.0F, 0.0F, 1.0F};
    material.index_of_refraction = 1.0F;
    material.normals = {texture(2, 1, 8), {2, 0, 0.5F}, {0, -1, 1}};
    EXPECT_EQ(makeDrawable(material), "");
    EXPECT_THAT(material.emission, ElementsAre(3.0F, 2.0F, 1000.0F));
    EXPECT_NE(material.normals.texture, nullptr);
    EXPECT_EQ(material.normals.u[0], 2.0F);
    EXPECT_TRUE(std::isinf(material.attenuation_distance));
}

TEST(DrawableMaterial, HasTheUsualNumberWhereThereWasNone) {
    Material material;
    material.metalness = material.roughness = material.index_of_refraction = NOT_A_NUMBER;
    material.attenuation_distance = material.emission[1] = NOT_A_NUMBER;
    EXPECT_EQ(makeDrawable(material), "metalness, roughness, emission, index of refraction, "
                                      "attenuation distance");
    EXPECT_EQ(material.metalness, 0.0F);
    EXPECT_EQ(material.roughness, 1.0F);
    EXPECT_EQ(material.index_of_refraction, 1.5F);
    EXPECT_EQ(material.emission[1], 0.0F);
    EXPECT_TRUE(std::isinf(material.attenuation_distance));
}

TEST(DrawableMaterial, HasNumbersWithinTheirLimits) {
    Material material;
    material.metalness = 1.5F;
    material.roughness = -0.5F;
    material.transmission = INFINITE;
    material.thickness = -1.0F;
    material.attenuation_color = {2.0F, -1.0F, 0.5F};
    material.clearcoat = -INFINITE;
    EXPECT_EQ(makeDrawable(material),
              "metalness, roughness, transmission, thickness, attenuation colour, clearcoat");
    EXPECT_EQ(material.metalness, 1.0F);
    EXPECT_EQ(material.roughness, 0.0F);
    EXPECT_EQ(material.transmission, 1.0F);
    EXPECT_EQ(material.thickness, 0.0F);
    EXPECT_THAT(material.attenuation_color, ElementsAre(1.0F, 0.0F, 0.5F));
    EXPECT_EQ(material.clearcoat, 0.0F);
}

TEST(DrawableMaterial, RefractsAsUsualWhereItsIndexIsBelowThatOfNothing) {
    for (const float index : {0.0F, -1.0F, 0.99F}) {
        Material material;
        material.index_of_refraction = index;
        EXPECT_EQ(makeDrawable(material), "index of refraction");
        EXPECT_EQ(material.index_of_refraction, 1.5F);
    }
    Material much;
    much.index_of_refraction = 1e30F;
    EXPECT_EQ(makeDrawable(much), "index of refraction");
    EXPECT_EQ(much.index_of_refraction, MOST_INDEX_OF_REFRACTION);
}

TEST(DrawableMaterial, KeepsTheHueOfLightThatIsTooBright) {
    Material material;
    material.emission = {1e30F, 5e29F, 0.0F};
    EXPECT_EQ(makeDrawable(material), "emission");
    EXPECT_THAT(material.emission, ElementsAre(MOST_EMISSION, MOST_EMISSION / 2, 0.0F));
    material.emission = {INFINITE, 1.0F, -1.0F};
    EXPECT_EQ(makeDrawable(material), "emission");
    EXPECT_EQ(material.emission[0], MOST_EMISSION);
    EXPECT_EQ(material.emission[2], 0.0F);
}

TEST(DrawableMaterial, HasNoTextureOfAnotherSizeThanItSays) {
    Material material;
    for (TextureUse* const use : textureUses(material))
        use->texture = texture(2, 2, 12); // three channels
    material.base_color_texture = texture(0, 0, 0);
    makeDrawable(material);
    EXPECT_EQ(material.base_color_texture, nullptr);
    for (const TextureUse* const use : textureUses(material))
        EXPECT_EQ(use->texture, nullptr);
}

TEST(DrawableMaterial, HasTexturesAtPlacesThatAreSome) {
    Material material;
    material.occlusion = {texture(1, 1, 4), {NOT_A_NUMBER, 0, 0}, {0, 1, 0}};
    EXPECT_EQ(makeDrawable(material), "occlusion texture");
    EXPECT_NE(material.occlusion.texture, nullptr);
    EXPECT_THAT(material.occlusion.u, ElementsAre(1.0F, 0.0F, 0.0F));
}

TEST(DrawableMaterial, IsNotChangedAgain) {
    Material material;
    for (float* const number :
         {&material.metalness, &material.normal_scale, &material.index_of_refraction,
          &material.attenuation_distance, &material.specular_color[0], &material.emission[0]})
        for (const float bad : {NOT_A_NUMBER, INFINITE, -INFINITE, 1e30F, 1e-40F, -1.0F}) {
            *number = bad;
            makeDrawable(material);
            EXPECT_EQ(makeDrawable(material), "") << bad;
        }
}

} // namespace
} // namespace quarn::test
