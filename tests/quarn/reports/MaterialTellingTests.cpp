#include "quarn/reports/ModelTelling.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

#include <limits>

namespace quarn::program {
namespace {

using testing::HasSubstr;

ReadFile fileWith(std::vector<MaterialContents> materials) {
    ReadFile file;
    file.path = "thing.glb";
    file.contents.materials = std::move(materials);
    return file;
}

TEST(MaterialTelling, SumsUpWhatMaterialsAre) {
    std::vector<MaterialContents> materials(5);
    for (std::size_t i = 0; i < 3; ++i)
        materials[i].is_metal = true;
    materials[1].has_normal_map = materials[4].has_normal_map = true;
    materials[3].shines = true;
    materials[4].lets_light_through = true;
    EXPECT_THAT(textOf(fileWith(materials)),
                HasSubstr("\nmaterials: 5, of which 3 are metal, 2 have normal maps, 1 shines by "
                          "itself, 1 lets light through\n"));
    materials[0].has_clearcoat = materials[0].is_unlit = materials[0].has_sheen = true;
    EXPECT_THAT(textOf(fileWith({materials[0]})),
                HasSubstr("\nmaterials: 1, of which 1 is metal, 1 has a clear coat, 1 is unlit, 1 "
                          "has a sheen that is not drawn\n"));
}

TEST(MaterialTelling, SaysNothingOfPlainMaterials) {
    EXPECT_THAT(textOf(fileWith(std::vector<MaterialContents>(2))), HasSubstr("\nmaterials: 2\n"));
}

TEST(MaterialTelling, GivesProgramsEachQualityByItsName) {
    MaterialContents material;
    material.alpha_cutoff = 0.25;
    material.qualities = {{"metalness", 0.75},
                          {"attenuation_distance", std::numeric_limits<double>::infinity()},
                          {"unlit", true},
                          {"emission", std::array{1.0, 2.0, 3.0}},
                          {"occlusion", std::monostate()},
                          {"normals", UsedTexture{4, {1, 0, 0.5}, {0, 1, -0.5}}}};
    const auto json = nlohmann::json::parse(jsonOf(fileWith({material})))["materials"][0];
    EXPECT_EQ(json["alpha_cutoff"], 0.25);
    EXPECT_EQ(json["metalness"], 0.75);
    EXPECT_EQ(json["attenuation_distance"], nullptr);
    EXPECT_EQ(json["unlit"], true);
    EXPECT_EQ(json["emission"], (nlohmann::json{1.0, 2.0, 3.0}));
    EXPECT_TRUE(json.contains("occlusion"));
    EXPECT_EQ(json["occlusion"], nullptr);
    EXPECT_EQ(json["normals"]["texture"], 4);
    EXPECT_EQ(json["normals"]["u"], (nlohmann::json{1.0, 0.0, 0.5}));
    EXPECT_EQ(json["normals"]["v"], (nlohmann::json{0.0, 1.0, -0.5}));
}

} // namespace
} // namespace quarn::program
