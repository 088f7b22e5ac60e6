#include "import/transfer/ModelTransfer.h"
#include "engine/scene/MaterialCheck.h"
#include "engine/scene/MaterialTextures.h"
#include "tests/import/transfer/TransferFixtures.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <limits>

namespace quarn::test {
namespace {

using Bytes = std::vector<std::uint8_t>;

Bytes written(const ImportedModel& model) {
    SharedBlock block = emptyBlock();
    const Result<void> result = writeModel(model, block);
    EXPECT_TRUE(result) << result.message();
    return bytesOf(block);
}

Result<ImportedModel> taken(std::span<const std::uint8_t> bytes) {
    SharedBlock block = blockOf(bytes);
    return takeModel(block);
}

ImportedModel crossed(const ImportedModel& model) {
    Result<ImportedModel> arrived = taken(written(model));
    EXPECT_TRUE(arrived) << arrived.message();
    return arrived ? std::move(arrived.value()) : ImportedModel();
}

void expectSameMesh(const KM_Mesh& mesh, const KM_Mesh& other) {
    EXPECT_EQ(mesh.m_V, other.m_V);
    EXPECT_EQ(mesh.m_N, other.m_N);
    EXPECT_EQ(mesh.m_T, other.m_T);
    EXPECT_EQ(mesh.m_C, other.m_C);
    EXPECT_EQ(mesh.m_F, other.m_F);
}

bool areValid(const std::vector<ImportedMesh>& meshes) {
    return std::ranges::all_of(meshes,
                               [](const auto& mesh) { return mesh.placed.mesh->IsValid(); });
}

void expectSameTexture(const Texture& texture, const Texture& other) {
    EXPECT_EQ(texture.width, other.width);
    EXPECT_EQ(texture.height, other.height);
    EXPECT_EQ(texture.rgba, other.rgba);
    EXPECT_EQ(texture.wrap_u, other.wrap_u);
    EXPECT_EQ(texture.wrap_v, other.wrap_v);
}

void expectSameSurface(const Material& material, const Material& other) {
    for (const auto number :
         {&Material::metalness, &Material::roughness, &Material::normal_scale,
          &Material::occlusion_strength, &Material::clearcoat, &Material::clearcoat_roughness,
          &Material::transmission, &Material::index_of_refraction, &Material::thickness,
          &Material::attenuation_distance, &Material::specular, &Material::sheen_roughness})
        EXPECT_EQ(material.*number, other.*number);
    for (const auto color : {&Material::emission, &Material::attenuation_color,
                             &Material::specular_color, &Material::sheen_color})
        EXPECT_EQ(material.*color, other.*color);
    EXPECT_EQ(material.is_one_sided, other.is_one_sided);
    EXPECT_EQ(material.is_unlit, other.is_unlit);
    const auto uses = textureUses(material);
    const auto others = textureUses(other);
    for (std::size_t i = 0; i < uses.size(); ++i) {
        EXPECT_EQ(uses[i]->u, others[i]->u) << i;
        EXPECT_EQ(uses[i]->v, others[i]->v) << i;
        ASSERT_EQ(uses[i]->texture == nullptr, others[i]->texture == nullptr) << i;
        if (uses[i]->texture)
            expectSameTexture(*uses[i]->texture, *others[i]->texture);
    }
}

void expectSameMaterial(const Material& material, const Material& other) {
    EXPECT_EQ(material.name, other.name);
    EXPECT_EQ(material.base_color, other.base_color);
    EXPECT_EQ(material.alpha_cutout, other.alpha_cutout);
    EXPECT_EQ(material.alpha_cutoff, other.alpha_cutoff);
    EXPECT_EQ(material.see_through, other.see_through);
    expectSameTexture(*material.base_color_texture, *other.base_color_texture);
    expectSameSurface(material, other);
}

} // namespace

TEST(ModelTransfer, ObjectsArriveAsTheyWere) {
    const ImportedModel model = modelOfEverything();
    const ImportedModel arrived = crossed(model);
    ASSERT_EQ(arrived.meshes.size(), model.meshes.size());
    for (std::size_t i = 0; i < model.meshes.size(); ++i) {
        const PlacedMesh& before = model.meshes[i].placed;
        const PlacedMesh& after = arrived.meshes[i].placed;
        EXPECT_EQ(arrived.meshes[i].name, model.meshes[i].name);
        EXPECT_EQ(after.world_from_mesh, before.world_from_mesh);
        expectSameMesh(*after.mesh, *before.mesh);
        ASSERT_EQ(after.material == nullptr, before.material == nullptr);
        if (before.material)
            expectSameMaterial(*after.material, *before.material);
    }
}

TEST(ModelTransfer, WhatObjectsShareTheyShareAgain) {
    const ImportedModel arrived = crossed(modelOfEverything());
    ASSERT_EQ(arrived.meshes.size(), 4U);
    EXPECT_EQ(arrived.meshes[0].placed.mesh, arrived.meshes[1].placed.mesh);
    EXPECT_NE(arrived.meshes[2].placed.mesh, arrived.meshes[3].placed.mesh);
    EXPECT_EQ(arrived.meshes[0].placed.material, arrived.meshes[2].placed.material);
    EXPECT_NE(arrived.meshes[0].placed.material, arrived.meshes[1].placed.material);
    EXPECT_EQ(arrived.meshes[0].placed.material->base_color_texture,
              arrived.meshes[1].placed.material->base_color_texture);
    const Material& material = *arrived.meshes[0].placed.material;
    EXPECT_EQ(material.metal_rough.texture, material.occlusion.texture);
    EXPECT_EQ(material.normals.texture, material.base_color_texture);
}

TEST(ModelTransfer, CurvesPointsCamerasLightsAndTheRestArriveAsTheyWere) {
    const ImportedModel model = modelOfEverything();
    const ImportedModel arrived = crossed(model);
    ASSERT_EQ(arrived.curves.size(), 1U);
    EXPECT_EQ(arrived.curves[0].name, model.curves[0].name);
    ASSERT_EQ(arrived.curves[0].points.Count(), 3);
    EXPECT_EQ(arrived.curves[0].points[2], model.curves[0].points[2]);
    ASSERT_EQ(arrived.points.Count(), 1);
    EXPECT_EQ(arrived.points[0], model.points[0]);
    ASSERT_EQ(arrived.cameras.size(), 1U);
    EXPECT_EQ(arrived.cameras[0].name, model.cameras[0].name);
    EXPECT_EQ(arrived.cameras[0].viewport, model.cameras[0].viewport);
    EXPECT_EQ(arrived.lights, model.lights);
    EXPECT_EQ(arrived.units, model.units);
    EXPECT_EQ(arrived.up.axis, model.up.axis);
    EXPECT_EQ(arrived.up.reason, model.up.reason);
    EXPECT_EQ(arrived.up.writer, model.up.writer);
    ASSERT_TRUE(arrived.place);
    EXPECT_EQ(arrived.place->latitude_deg, model.place->latitude_deg);
    EXPECT_EQ(arrived.place->longitude_deg, model.place->longitude_deg);
    EXPECT_EQ(arrived.place->north_angle_deg, model.place->north_angle_deg);
    EXPECT_EQ(arrived.warnings, model.warnings);
}

TEST(ModelTransfer, AModelThatIsHeldElsewhereKeepsItsArrays) {
    ImportedModel model = modelOfEverything();
    auto large = std::make_shared<KM_Mesh>(*model.meshes[0].placed.mesh);
    large->m_V.resize(1'000'000, {1, 2, 3});
    large->m_N.resize(1'000'000, {0, 0, 1});
    large->m_T.clear();
    large->m_C.clear();
    model.meshes[0].placed.mesh = large;
    const ImportedModel arrived = crossed(model);
    EXPECT_EQ(large->m_V.back(), KM_3fPoint(1, 2, 3));
    expectSameMesh(*arrived.meshes[0].placed.mesh, *large);
}

TEST(ModelTransfer, TheBlockIsEmptyOnceItsModelIsTaken) {
    ImportedModel model = modelOfEverything();
    auto large = std::make_shared<KM_Mesh>(*model.meshes[3].placed.mesh);
    large->m_F.resize(500'000, {{0, 1, 2}});
    model.meshes[3].placed.mesh = std::move(large);
    SharedBlock block = emptyBlock();
    ASSERT_TRUE(writeModel(std::move(model), block));
    EXPECT_GT(block.memory(), 6'000'000U);
    ASSERT_TRUE(takeModel(block));
    EXPECT_LT(block.memory(), 100'000U);
}

TEST(ModelTransfer, ABlockThatIsCutAnywhereIsRefused) {
    const Bytes whole = written(modelOfEverything());
    for (std::size_t length = 0; length < whole.size(); ++length)
        EXPECT_FALSE(taken(std::span(whole).first(length))) << length;
}

TEST(ModelTransfer, ABlockWithAnyBitTurnedIsRefusedOrHoldsAModelThatCanBeShown) {
    Bytes bytes = written(modelOfEverything());
    int refused = 0;
    for (std::size_t bit = 0; bit < 8 * bytes.size(); ++bit) {
        bytes[bit / 8] ^= static_cast<std::uint8_t>(1U << bit % 8);
        const Result<ImportedModel> arrived = taken(bytes);
        refused += arrived ? 0 : 1;
        if (arrived && !areValid(arrived.value().meshes))
            ADD_FAILURE() << bit;
        bytes[bit / 8] ^= static_cast<std::uint8_t>(1U << bit % 8);
    }
    EXPECT_GT(refused, 1000);
}

TEST(ModelTransfer, AMeshThatNamesAVertexThatIsNotThereIsRefused) {
    ImportedModel model = modelOfEverything();
    auto bad = std::make_shared<KM_Mesh>(*model.meshes[0].placed.mesh);
    bad->m_F[1].vi[2] = 4;
    model.meshes[0].placed.mesh = bad;
    EXPECT_FALSE(taken(written(model)));
}

TEST(ModelTransfer, NumbersThatAreNoneAreRefused) {
    const double infinite = std::numeric_limits<double>::infinity();
    ImportedModel flat = modelOfEverything();
    flat.meshes[0].placed.world_from_mesh.m_xform[0][3] = infinite;
    SharedBlock block = emptyBlock();
    EXPECT_FALSE(writeModel(flat, block) && taken(bytesOf(block)));
    ImportedModel curved = modelOfEverything();
    curved.curves[0].points[1].y = infinite;
    EXPECT_FALSE(taken(written(curved)));
    ImportedModel lit = modelOfEverything();
    lit.lights[0].SetLocation({infinite, 0.0, 0.0});
    EXPECT_FALSE(taken(written(lit)));
}

TEST(ModelTransfer, MaterialsWithNumbersThatCannotBeArriveDrawableAndAreTold) {
    const float none = std::numeric_limits<float>::quiet_NaN();
    ImportedModel model = modelOfEverything();
    auto look = std::make_shared<Material>(*model.meshes[0].placed.material);
    look->metalness = none;
    look->index_of_refraction = 0.0F;
    look->emission = {1e30F, 0.0F, none};
    look->attenuation_distance = -1.0F;
    look->alpha_cutoff = none;
    look->normals.u[1] = none;
    model.meshes[0].placed.material = look;
    const ImportedModel arrived = crossed(model);
    ASSERT_EQ(arrived.meshes.size(), 4U);
    Material material = *arrived.meshes[0].placed.material;
    EXPECT_EQ(makeDrawable(material), "");
    EXPECT_EQ(material.metalness, 0.0F);
    EXPECT_EQ(material.index_of_refraction, 1.5F);
    ASSERT_EQ(arrived.warnings.size(), model.warnings.size() + 1);
    EXPECT_EQ(arrived.warnings.back(), "Its reader handed over materials with numbers that cannot "
                                       "be (1); what is usual stands for them.");
}

TEST(ModelTransfer, AMaterialWithATextureThatIsNotThereIsRefused) {
    Bytes bytes = written(modelOfEverything());
    const Bytes last_use{1, 0, 0, 0, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF, 0xFF};
    const auto found = std::ranges::search(bytes, last_use);
    ASSERT_FALSE(found.empty()); // the second texture, then none twice
    found.front() = 2;
    EXPECT_FALSE(taken(bytes));
}

TEST(ModelTransfer, ATextureWhosePixelsAreNotThereIsRefused) {
    ImportedModel model = modelOfEverything();
    auto look = std::make_shared<Material>(*model.meshes[0].placed.material);
    auto texture = std::make_shared<Texture>(*look->base_color_texture);
    texture->width = 30000;
    texture->height = 30000;
    look->base_color_texture = texture;
    model.meshes[0].placed.material = look;
    EXPECT_FALSE(taken(written(model)));
}

} // namespace quarn::test
