#include "tests/import/transfer/TransferFixtures.h"

#include "engine/scene/MaterialTextures.h"

#include <stdexcept>

namespace quarn::test {

namespace {

std::shared_ptr<const KM_Mesh> quad(bool has_everything) {
    auto mesh = std::make_shared<KM_Mesh>();
    mesh->m_V = {{0, 0, 0}, {1, 0, 0}, {1, 1, 0}, {0, 1, 0.5F}};
    mesh->m_N.assign(4, {0, 0, 1});
    mesh->m_F = {{{0, 1, 2}}, {{0, 2, 3}}};
    if (has_everything) {
        mesh->m_T = {{0, 0}, {1, 0}, {1, 1}, {0, 1}};
        mesh->m_C = {{1, 2, 3, 4}, {5, 6, 7, 8}, {9, 10, 11, 12}, {13, 14, 15, 16}};
    }
    mesh->PadForRayTracing();
    return mesh;
}

/// Every number another one, and each texture at a place of its own.
void setSurface(Material& made) {
    float number = 0.0F;
    for (float* const share :
         {&made.metalness, &made.roughness, &made.occlusion_strength, &made.clearcoat,
          &made.clearcoat_roughness, &made.transmission, &made.specular, &made.sheen_roughness})
        *share = number += 0.0625F;
    made.normal_scale = -2.0F;
    made.emission = {7.0F, 8.0F, 9.0F};
    made.is_one_sided = true;
    made.is_unlit = true;
    made.index_of_refraction = 1.75F;
    made.thickness = 3.0F;
    made.attenuation_distance = 4.0F;
    made.attenuation_color = {0.1F, 0.2F, 0.3F};
    made.specular_color = {1.5F, 2.5F, 3.5F};
    made.sheen_color = {0.4F, 0.5F, 0.6F};
    for (TextureUse* const use : textureUses(made)) {
        number += 0.0625F;
        use->u = {number, 1.0F, 2.0F};
        use->v = {3.0F, number, 4.0F};
    }
}

std::shared_ptr<Material> material(const wchar_t* name, std::shared_ptr<const Texture> texture) {
    Material made;
    made.name = name;
    made.base_color = {10, 20, 30, 40};
    made.base_color_texture = std::move(texture);
    made.alpha_cutoff = 0.25F;
    made.see_through = true;
    setSurface(made);
    return std::make_shared<Material>(made);
}

void addObjects(ImportedModel& model) {
    const auto texture = std::make_shared<Texture>(
        Texture{2, 1, {1, 2, 3, 4, 5, 6, 7, 8}, TextureWrap::mirror, TextureWrap::clamp});
    const auto rough = std::make_shared<Texture>(
        Texture{1, 1, {9, 8, 7, 6}, TextureWrap::repeat, TextureWrap::repeat});
    const auto one = material(L"one", texture);
    one->metal_rough.texture = one->occlusion.texture = rough;
    one->normals.texture = texture;
    const auto other = material(L"other", texture);
    const auto shared = quad(true);
    model.meshes = {{L"left", {shared, one, KM_Xform::Translation(1, 2, 3)}},
                    {L"right", {shared, other, KM_Xform::Diagonal(2, 2, -2)}},
                    {L"単独", {quad(false), one, {}}},
                    {L"plain", {quad(false), nullptr, {}}}};
}

void addRest(ImportedModel& model) {
    ImportedCurve curve{L"path", {}};
    for (int i = 0; i < 3; ++i)
        curve.points.Append({1.0 * i, 2.0 * i, 0.1});
    model.curves.push_back(curve);
    model.points.Append({7.0, 8.0, 9.0});
    ImportedCamera camera{L"view", {}};
    camera.viewport.SetCameraLocation({3.0, 4.0, 5.0});
    model.cameras.push_back(camera);
    KM_Light light;
    light.SetStyle(KM_LightStyle::world_spot);
    light.SetLocation({1.0, 1.0, 9.0});
    light.Enable(false);
    light.SetLightName(L"lamp");
    model.lights.push_back(light);
    model.units = UnitSystem::feet;
    model.up = {UpAxis::y, TakenUpAxis::Reason::writer, "Sculptor 3"};
    model.place = ImportedPlace{48.5, -9.25, 12.0};
    model.warnings = {"Something was left out.", "Größe unbekannt."};
}

} // namespace

ImportedModel modelOfEverything() {
    ImportedModel model;
    addObjects(model);
    addRest(model);
    return model;
}

SharedBlock emptyBlock() {
    Result<SharedBlock> block = SharedBlock::make();
    if (!block)
        throw std::runtime_error(block.message());
    return std::move(block.value());
}

SharedBlock blockOf(std::span<const std::uint8_t> bytes) {
    SharedBlock block = emptyBlock();
    if (const Result<void> written = block.append(bytes); !written)
        throw std::runtime_error(written.message());
    return block;
}

std::vector<std::uint8_t> bytesOf(const SharedBlock& block) {
    std::vector<std::uint8_t> bytes(block.size());
    if (!block.read(0, bytes))
        throw std::runtime_error("the block cannot be read");
    return bytes;
}

} // namespace quarn::test
