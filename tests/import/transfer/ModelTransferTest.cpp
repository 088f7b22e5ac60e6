#include "import/transfer/ModelTransfer.h"
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

void expectSameMaterial(const Material& material, const Material& other) {
    EXPECT_EQ(material.name, other.name);
    EXPECT_EQ(material.base_color, other.base_color);
    EXPECT_EQ(material.alpha_cutout, other.alpha_cutout);
    EXPECT_EQ(material.alpha_cutoff, other.alpha_cutoff);
    EXPECT_EQ(material.see_through, other.see_through);
    const Texture& texture = *material.base_color_texture;
    const Texture& other_texture = *other.base_color_texture;
    EXPECT_EQ(texture.width, other_texture.width);
    EXPECT_EQ(texture.height, other_texture.height);
    EXPECT_EQ(texture.rgba, other_texture.rgba);
    EXPECT_EQ(texture.wrap_u, other_texture.wrap_u);
    EXPECT_EQ(texture.wrap_v, other_texture.wrap_v);
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
