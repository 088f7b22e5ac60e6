// Metalness, roughness, light and the rest of what makes a surface, as glTF states it.
#include "engine/scene/MaterialCheck.h"
#include "engine/scene/MaterialTextures.h"
#include "tests/import/gltf/GltfWriter.h"

#include <gmock/gmock.h>
#include <webp/encode.h>

#include <array>
#include <cmath>

namespace quarn::test {
namespace {

using ::testing::AllOf;
using ::testing::ElementsAre;
using ::testing::HasSubstr;
using ::testing::IsEmpty;

using Json = GltfWriter::Json;

std::string webp(const std::array<std::uint8_t, 4>& rgba) {
    std::uint8_t* bytes = nullptr;
    const std::size_t size = WebPEncodeLosslessRGBA(rgba.data(), 1, 1, 4, &bytes);
    std::string picture(reinterpret_cast<const char*>(bytes), size);
    WebPFree(bytes);
    return picture;
}

/// A triangle with two sets of texture coordinates and three textures.
GltfWriter surface(Json material) {
    GltfWriter gltf;
    gltf.triangle();
    Json& attributes = gltf.primitive()["attributes"];
    attributes["TEXCOORD_0"] = gltf.floats({0.125F, 0.25F, 1, 0, 0, 1}, "VEC2");
    attributes["TEXCOORD_1"] = gltf.floats({0.5F, 0.75F, 1, 0, 0, 0.25F}, "VEC2");
    gltf.primitive()["material"] = 0;
    material["name"] = "paint";
    gltf.json["materials"] = Json::array({std::move(material)});
    for (std::uint8_t i = 0; i < 3; ++i) {
        gltf.json["images"].push_back(
            {{"bufferView", gltf.view(webp({10, 20, static_cast<std::uint8_t>(30 + i), 64}))}});
        gltf.json["textures"].push_back({{"source", i}});
    }
    return gltf;
}

Material materialOf(const ImportedModel& model) {
    return model.meshes.empty() ? Material() : *model.meshes[0].placed.material;
}

/// The first corner's place on a texture.
std::array<float, 2> placeOf(const ImportedModel& model, const TextureUse& use) {
    const KM_Mesh& mesh = *model.meshes.at(0).placed.mesh;
    const KM_2fPoint& t = mesh.m_T.at(mesh.m_F.at(0).vi[0]);
    return {use.u[0] * t.x + use.u[1] * t.y + use.u[2], use.v[0] * t.x + use.v[1] * t.y + use.v[2]};
}

TEST(GltfSurface, IsRoughMetalOfOneSideWhereTheFileStatesNothing) {
    const Material material = materialOf(surface(Json::object()).read());
    EXPECT_EQ(material.metalness, 1.0F);
    EXPECT_EQ(material.roughness, 1.0F);
    EXPECT_TRUE(material.is_one_sided);
    EXPECT_FALSE(material.is_unlit);
    EXPECT_EQ(material.index_of_refraction, 1.5F);
    EXPECT_EQ(material.specular, 1.0F);
    EXPECT_EQ(material.transmission, 0.0F);
    EXPECT_THAT(material.emission, ElementsAre(0.0F, 0.0F, 0.0F));
    EXPECT_TRUE(std::isinf(material.attenuation_distance));
}

TEST(GltfSurface, HasTheNumbersOfTheFile) {
    const ImportedModel model =
        surface({{"pbrMetallicRoughness", {{"metallicFactor", 0.25}, {"roughnessFactor", 0.5}}},
                 {"doubleSided", true},
                 {"emissiveFactor", {1.0, 0.5, 0.25}},
                 {"normalTexture", {{"index", 0}, {"scale", 0.75}}},
                 {"occlusionTexture", {{"index", 0}, {"strength", 0.375}}}})
            .read();
    const Material material = materialOf(model);
    EXPECT_EQ(material.metalness, 0.25F);
    EXPECT_EQ(material.roughness, 0.5F);
    EXPECT_FALSE(material.is_one_sided);
    EXPECT_THAT(material.emission, ElementsAre(1.0F, 0.5F, 0.25F));
    EXPECT_EQ(material.normal_scale, 0.75F);
    EXPECT_EQ(material.occlusion_strength, 0.375F);
    EXPECT_THAT(model.warnings, IsEmpty());
}

TEST(GltfSurface, HasTheNumbersOfExtensions) {
    GltfWriter gltf =
        surface({{"emissiveFactor", {1.0, 0.5, 0.0}},
                 {"extensions",
                  {{"KHR_materials_emissive_strength", {{"emissiveStrength", 8.0}}},
                   {"KHR_materials_clearcoat",
                    {{"clearcoatFactor", 0.5}, {"clearcoatRoughnessFactor", 0.25}}},
                   {"KHR_materials_transmission", {{"transmissionFactor", 0.75}}},
                   {"KHR_materials_ior", {{"ior", 1.25}}},
                   {"KHR_materials_volume",
                    {{"thicknessFactor", 0.5},
                     {"attenuationDistance", 2.0},
                     {"attenuationColor", {0.25, 0.5, 0.75}}}},
                   {"KHR_materials_specular",
                    {{"specularFactor", 0.125}, {"specularColorFactor", {1.0, 0.5, 2.0}}}}}}});
    gltf.json["extensionsRequired"] = {"KHR_materials_emissive_strength",
                                       "KHR_materials_clearcoat",
                                       "KHR_materials_transmission",
                                       "KHR_materials_ior",
                                       "KHR_materials_volume",
                                       "KHR_materials_specular"};
    const ImportedModel model = gltf.read();
    const Material material = materialOf(model);
    EXPECT_THAT(material.emission, ElementsAre(8.0F, 4.0F, 0.0F));
    EXPECT_EQ(material.clearcoat, 0.5F);
    EXPECT_EQ(material.clearcoat_roughness, 0.25F);
    EXPECT_EQ(material.transmission, 0.75F);
    EXPECT_EQ(material.index_of_refraction, 1.25F);
    EXPECT_EQ(material.thickness, 0.5F);
    EXPECT_EQ(material.attenuation_distance, 2.0F);
    EXPECT_THAT(material.attenuation_color, ElementsAre(0.25F, 0.5F, 0.75F));
    EXPECT_EQ(material.specular, 0.125F);
    EXPECT_THAT(material.specular_color, ElementsAre(1.0F, 0.5F, 2.0F));
    EXPECT_THAT(model.warnings, IsEmpty());
}

TEST(GltfSurface, KeepsItsSheenAndTellsThatItIsNotDrawn) {
    GltfWriter gltf =
        surface({{"extensions",
                  {{"KHR_materials_sheen",
                    {{"sheenColorFactor", {0.5, 0.25, 1.0}}, {"sheenRoughnessFactor", 0.5}}}}}});
    gltf.json["extensionsRequired"] = {"KHR_materials_sheen"};
    const ImportedModel model = gltf.read();
    EXPECT_THAT(materialOf(model).sheen_color, ElementsAre(0.5F, 0.25F, 1.0F));
    EXPECT_EQ(materialOf(model).sheen_roughness, 0.5F);
    EXPECT_THAT(model.warnings, ElementsAre("The sheen of 1 material is kept, but not drawn."));
}

TEST(GltfSurface, HasATextureForEachOfItsQualities) {
    const Json use = {{"index", 0}};
    const ImportedModel model =
        surface({{"pbrMetallicRoughness", {{"metallicRoughnessTexture", use}}},
                 {"normalTexture", use},
                 {"occlusionTexture", use},
                 {"emissiveTexture", use},
                 {"emissiveFactor", {1, 1, 1}},
                 {"extensions",
                  {{"KHR_materials_clearcoat",
                    {{"clearcoatFactor", 1},
                     {"clearcoatTexture", use},
                     {"clearcoatRoughnessTexture", use},
                     {"clearcoatNormalTexture", use}}},
                   {"KHR_materials_transmission",
                    {{"transmissionFactor", 1}, {"transmissionTexture", use}}},
                   {"KHR_materials_volume", {{"thicknessFactor", 1}, {"thicknessTexture", use}}},
                   {"KHR_materials_specular",
                    {{"specularTexture", use}, {"specularColorTexture", use}}}}}})
            .read();
    const Material material = materialOf(model);
    ASSERT_NE(material.normals.texture, nullptr);
    EXPECT_THAT(material.normals.texture->rgba, ElementsAre(10, 20, 30, 64)); // as they are
    for (const TextureUse* const each : textureUses(material))
        EXPECT_EQ(each->texture, material.normals.texture); // read once
    EXPECT_THAT(model.warnings, IsEmpty());
}

TEST(GltfSurface, LaysEachTextureWhereItsOwnTransformPutsIt) {
    const auto moved = [](int index, double offset, double scale) {
        return Json{
            {"index", index},
            {"extensions",
             {{"KHR_texture_transform", {{"offset", {offset, 0.25}}, {"scale", {scale, 2.0}}}}}}};
    };
    const ImportedModel model =
        surface({{"pbrMetallicRoughness", {{"baseColorTexture", moved(0, 0.5, 4.0)}}},
                 {"normalTexture", moved(1, 0.125, 0.5)},
                 {"occlusionTexture", {{"index", 2}}}})
            .read();
    const Material material = materialOf(model);
    // The corner (0.125, 0.25), scaled and moved, and turned upward.
    EXPECT_THAT(placeOf(model, {}), ElementsAre(1.0F, 0.25F));
    EXPECT_THAT(placeOf(model, material.normals), ElementsAre(0.1875F, 0.25F));
    EXPECT_THAT(placeOf(model, material.occlusion), ElementsAre(0.125F, 0.75F));
}

TEST(GltfSurface, LeavesOutTexturesThatLieByOtherCoordinatesAndTellsThemOnce) {
    const ImportedModel model =
        surface({{"pbrMetallicRoughness", {{"baseColorTexture", {{"index", 0}}}}},
                 {"normalTexture", {{"index", 1}, {"texCoord", 1}}},
                 {"occlusionTexture", {{"index", 2}, {"texCoord", 1}}}})
            .read();
    EXPECT_NE(materialOf(model).base_color_texture, nullptr);
    EXPECT_EQ(materialOf(model).normals.texture, nullptr);
    EXPECT_EQ(materialOf(model).occlusion.texture, nullptr);
    EXPECT_THAT(model.warnings,
                ElementsAre("Textures of materials were left out, as they lie by other texture "
                            "coordinates than the base colour: 'paint' (normal map), 'paint' "
                            "(occlusion)."));
}

TEST(GltfSurface, TakesTheOtherCoordinatesWhereAllTexturesLieByThem) {
    const ImportedModel model = surface({{"normalTexture", {{"index", 1}, {"texCoord", 1}}},
                                         {"occlusionTexture", {{"index", 2}, {"texCoord", 1}}}})
                                    .read();
    EXPECT_NE(materialOf(model).occlusion.texture, nullptr);
    EXPECT_THAT(placeOf(model, materialOf(model).normals), ElementsAre(0.5F, 0.25F));
    EXPECT_THAT(model.warnings, IsEmpty());
}

TEST(GltfSurface, WithEveryTextureMissingIsShownAndEachPictureToldOnce) {
    GltfWriter gltf = surface(
        {{"pbrMetallicRoughness",
          {{"baseColorTexture", {{"index", 0}}}, {"metallicRoughnessTexture", {{"index", 1}}}}},
         {"normalTexture", {{"index", 2}}},
         {"occlusionTexture", {{"index", 1}}},
         {"emissiveTexture", {{"index", 7}}},
         {"emissiveFactor", {1, 1, 1}}});
    for (int i = 0; i < 3; ++i)
        gltf.json["images"][i] = {{"uri", "gone" + std::to_string(i) + ".png"}};
    const ImportedModel model = gltf.read();
    const Material material = materialOf(model);
    EXPECT_EQ(material.base_color_texture, nullptr);
    for (const TextureUse* const use : textureUses(material))
        EXPECT_EQ(use->texture, nullptr);
    EXPECT_THAT(model.warnings,
                ElementsAre(HasSubstr("'gone0.png' was left out"), HasSubstr("'gone1.png'"),
                            HasSubstr("'gone2.png'"), HasSubstr("'texture 7' was left out")));
}

TEST(GltfSurface, ThatIsUnlitReadsNothingButItsColour) {
    GltfWriter gltf = surface({{"pbrMetallicRoughness", {{"baseColorTexture", {{"index", 0}}}}},
                               {"normalTexture", {{"index", 1}}},
                               {"extensions", {{"KHR_materials_unlit", Json::object()}}}});
    gltf.json["images"][1] = {{"uri", "gone.png"}};
    const ImportedModel model = gltf.read();
    EXPECT_TRUE(materialOf(model).is_unlit);
    EXPECT_NE(materialOf(model).base_color_texture, nullptr);
    EXPECT_THAT(model.warnings, IsEmpty());
}

TEST(GltfSurface, WithNumbersThatCannotBeIsMadeDrawableAndToldOnce) {
    const Json bad = {
        {"pbrMetallicRoughness", {{"metallicFactor", -3.0}, {"roughnessFactor", 1e300}}},
        {"emissiveFactor", {1e30, 0, 0}},
        {"extensions",
         {{"KHR_materials_ior", {{"ior", 0.0}}},
          {"KHR_materials_volume", {{"attenuationDistance", 0.0}}}}}};
    GltfWriter gltf = surface(bad);
    gltf.json["materials"].push_back(bad);
    gltf.mesh({{"attributes", gltf.primitive()["attributes"]}, {"material", 1}});
    const ImportedModel model = gltf.read();
    Material material = materialOf(model);
    EXPECT_EQ(makeDrawable(material), "");
    EXPECT_EQ(material.metalness, 0.0F);
    EXPECT_EQ(material.roughness, 1.0F);
    EXPECT_EQ(material.index_of_refraction, 1.5F);
    EXPECT_EQ(material.emission[0], MOST_EMISSION);
    EXPECT_THAT(model.warnings,
                ElementsAre("2 materials have numbers or textures that cannot be; what is usual "
                            "stands for them: 'paint' (metalness, roughness, emission, index of "
                            "refraction, attenuation distance) and others."));
}

TEST(GltfSurface, MirrorsAllByAnIndexOfRefractionOfNothingWhereItsSpecularColourIsStated) {
    const ImportedModel model =
        surface({{"extensions",
                  {{"KHR_materials_ior", {{"ior", 0.0}}},
                   {"KHR_materials_specular", {{"specularColorFactor", {1.0, 0.5, 0.25}}}}}}})
            .read();
    EXPECT_EQ(materialOf(model).index_of_refraction, MOST_INDEX_OF_REFRACTION);
    EXPECT_THAT(model.warnings, IsEmpty());
}

TEST(GltfSurface, OfTheOlderModelMirrorsItsSpecularColourByItsGlossiness) {
    const ImportedModel model = surface({{"extensions",
                                          {{"KHR_materials_pbrSpecularGlossiness",
                                            {{"glossinessFactor", 0.5},
                                             {"specularFactor", {0.25, 0.5, 0.75}},
                                             {"specularGlossinessTexture", {{"index", 0}}}}}}}})
                                    .read();
    const Material material = materialOf(model);
    EXPECT_EQ(material.metalness, 0.0F);
    EXPECT_EQ(material.index_of_refraction, MOST_INDEX_OF_REFRACTION);
    EXPECT_THAT(material.specular_color, ElementsAre(0.25F, 0.5F, 0.75F));
    ASSERT_NE(material.specular_color_texture.texture, nullptr);
    ASSERT_NE(material.metal_rough.texture, nullptr);
    EXPECT_EQ(material.roughness, 1.0F);
    EXPECT_EQ(material.metal_rough.texture->rgba[1], 255 - 64 / 2);
    const Material plain = materialOf(
        surface({{"extensions",
                  {{"KHR_materials_pbrSpecularGlossiness", {{"glossinessFactor", 0.75}}}}}})
            .read());
    EXPECT_EQ(plain.roughness, 0.25F);
}

TEST(GltfSurface, IsAsThickAsItsMeshIsLarge) {
    const Json glass = {
        {"extensions",
         {{"KHR_materials_transmission", {{"transmissionFactor", 1.0}}},
          {"KHR_materials_volume", {{"thicknessFactor", 0.5}, {"attenuationDistance", 4.0}}}}}};
    GltfWriter gltf = surface(glass);
    gltf.node()["scale"] = {2.0, 2.0, 2.0};
    const Material alone = materialOf(gltf.read()); // its coordinates become those of the world
    EXPECT_FLOAT_EQ(alone.thickness, 1.0F);
    EXPECT_FLOAT_EQ(alone.attenuation_distance, 4.0F);
    gltf.json["nodes"].push_back({{"mesh", 0}});
    const ImportedModel twice = gltf.read();
    ASSERT_EQ(twice.meshes.size(), 2U);
    EXPECT_EQ(twice.meshes[0].placed.material->thickness, 0.5F);
    EXPECT_FLOAT_EQ(twice.meshes[0].placed.material->attenuation_distance, 2.0F);
    EXPECT_EQ(twice.meshes[1].placed.material->attenuation_distance, 4.0F);
}

} // namespace
} // namespace quarn::test
