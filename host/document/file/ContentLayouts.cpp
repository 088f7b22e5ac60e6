#include "host/document/file/ContentLayouts.h"

#include "engine/render/RenderRequest.h"
#include "ground/Fields.h"
#include "ground/LightFields.h"
#include "ground/ViewportLayout.h"
#include "host/document/LightStore.h"
#include "host/document/ViewState.h"
#include "host/document/file/CurveLayout.h"

#include <cmath>

namespace quarn {

namespace {

/// What an object consists of.
enum class ObjectKind : std::int32_t { mesh = 1, curve = 2, point = 3, placed_mesh = 4 };

/// How the pixels of a texture stand in the file.
enum class PixelEncoding : std::int32_t { raw = 0 };

constexpr double UNIT_LENGTH_TOLERANCE = 1e-6;

ObjectKind kindOf(const ObjectContent& object) {
    if (object.placed.mesh)
        return object.placed.world_from_mesh.IsIdentity() ? ObjectKind::mesh
                                                          : ObjectKind::placed_mesh;
    return object.curve ? ObjectKind::curve : ObjectKind::point;
}

bool isUnitVector(const KM_3dVector& vector) {
    return vector.IsValid() && std::abs(vector.Length() - 1.0) < UNIT_LENGTH_TOLERANCE;
}

bool isPictureSide(std::int32_t side_px) {
    return side_px >= 1 && side_px <= ViewState::largest_side_px;
}

bool isWhole(const Texture& texture) {
    if (texture.width < 1 || texture.height < 1)
        return false;
    const auto pixels =
        static_cast<std::uint64_t>(texture.width) * static_cast<std::uint64_t>(texture.height);
    return texture.rgba.size() == 4 * pixels;
}

bool makeSense(const SettingsContent& settings) {
    return KM_IsValid(settings.absolute_tolerance) && settings.absolute_tolerance > 0.0 &&
           isUnitVector(settings.direction_to_sun) && settings.light_slots >= 0 &&
           settings.light_slots <= LightStore::most_slots;
}

bool makesSense(const ViewContent& view) {
    return !view.name.IsEmpty() && isPictureSide(view.width_px) && isPictureSide(view.height_px);
}

bool makesSense(const RenderSettings& settings) {
    const auto isNumberOfSamples = [](int samples) {
        return samples >= 1 && samples <= RenderRequest::most_samples;
    };
    return isPictureSide(settings.width_px) && isPictureSide(settings.height_px) &&
           isNumberOfSamples(settings.samples) && isNumberOfSamples(settings.preview_samples);
}

template <class Step, class AnySettings> bool renderFields(Step step, AnySettings& settings) {
    return step(settings.width_px) && step(settings.height_px) && step(settings.samples) &&
           step(settings.preview_samples) && step.check(makesSense(settings));
}

template <class Step, class AnySettings> bool settingsFields(Step step, AnySettings& settings) {
    return step(settings.units, UnitSystem::none, LAST_UNIT_SYSTEM) &&
           step(settings.absolute_tolerance) && step(settings.sun_enabled) &&
           step(settings.direction_to_sun) && step(settings.light_slots) &&
           step.check(makeSense(settings));
}

template <class Step, class AnyTexture> bool textureFields(Step step, AnyTexture& texture) {
    PixelEncoding encoding = PixelEncoding::raw;
    return step(texture.width) && step(texture.height) &&
           step(texture.wrap_u, TextureWrap::repeat, TextureWrap::clamp) &&
           step(texture.wrap_v, TextureWrap::repeat, TextureWrap::clamp) &&
           step(encoding, PixelEncoding::raw, PixelEncoding::raw) && step(texture.rgba) &&
           step.check(isWhole(texture));
}

template <class Step, class AnyMaterial> bool materialFields(Step step, AnyMaterial& material) {
    return step(material.name) && step(material.base_color) && step(material.alpha_cutout) &&
           step(material.alpha_cutoff) &&
           step.check(material.alpha_cutoff >= 0.0F && material.alpha_cutoff <= 1.0F);
}

template <class Step, class AnyMesh> bool meshFields(Step step, AnyMesh& mesh) {
    return step(mesh.m_V) && step(mesh.m_N) && step(mesh.m_T) && step(mesh.m_C) && step(mesh.m_F);
}

template <class Step, class AnyObject> bool attributeFields(Step step, AnyObject& object) {
    return step(object.id) && step(object.name) && step(object.visible) &&
           step.check(!KM_UuidIsNil(object.id));
}

/// The determinant of a very small scale is too small for a number.
bool isFlattening(const KM_Xform& place) {
    KM_Xform inverse = place;
    return place.Determinant() == 0.0 && !inverse.Invert();
}

/// An affine transform: three rows of four numbers.
template <class Step, class AnyXform> bool placeFields(Step step, AnyXform& place) {
    for (int i = 0; i < 3; ++i)
        for (int j = 0; j < 4; ++j)
            if (!step(place.m_xform[i][j]))
                return false;
    return step.check(place.IsValid() && !isFlattening(place));
}

template <class Step, class AnyView> bool viewFields(Step step, AnyView& view) {
    return step(view.name) && step(view.display_mode) && step(view.width_px) &&
           step(view.height_px) && step(view.active) && step.check(makesSense(view));
}

bool readPoint(KM_BinaryArchive& archive, std::optional<KM_3dPoint>& point) {
    KM_3dPoint location;
    if (!archive.ReadPoint(location))
        return false;
    if (!location.IsValid())
        return archive.Fail();
    point = location;
    return true;
}

bool beginsWithVersion(std::span<const std::uint8_t> bytes) {
    KM_BinaryArchive archive = KM_BinaryArchive::ForReading(bytes);
    int major = 0;
    int minor = 0;
    return archive.Read3dmChunkVersion(major, minor);
}

} // namespace

bool writeSettings(KM_BinaryArchive& archive, const SettingsContent& settings) {
    return settingsFields(FieldWriter(archive), settings);
}

bool readSettings(KM_BinaryArchive& archive, SettingsContent& settings) {
    return settingsFields(FieldReader(archive), settings);
}

bool writeTexture(KM_BinaryArchive& archive, const Texture& texture) {
    return textureFields(FieldWriter(archive), texture);
}

bool readTexture(KM_BinaryArchive& archive, SharedContent& shared) {
    auto texture = std::make_shared<Texture>();
    if (!textureFields(FieldReader(archive), *texture))
        return false;
    shared.textures.push_back(std::move(texture));
    return true;
}

bool writeMaterial(KM_BinaryArchive& archive, const Material& material, std::int32_t texture) {
    return materialFields(FieldWriter(archive), material) && archive.WriteInt(texture) &&
           (!material.see_through || archive.WriteBool(true));
}

bool readMaterial(KM_BinaryArchive& archive, SharedContent& shared) {
    auto material = std::make_shared<Material>();
    if (!materialFields(FieldReader(archive), *material) ||
        !readShared(archive, shared.textures, true, material->base_color_texture))
        return false;
    if (archive.BytesLeft() > 0 && !archive.ReadBool(material->see_through))
        return false;
    shared.materials.push_back(std::move(material));
    return true;
}

std::uint64_t meshSize(const KM_Mesh& mesh) {
    return mesh.m_V.size() * sizeof(KM_3fPoint) + mesh.m_N.size() * sizeof(KM_3fVector) +
           mesh.m_T.size() * sizeof(KM_2fPoint) + mesh.m_C.size() * sizeof(KM_Color) +
           mesh.m_F.size() * sizeof(KM_MeshTriangle);
}

bool writeMesh(KM_BinaryArchive& archive, const KM_Mesh& mesh) {
    return meshFields(FieldWriter(archive), mesh);
}

bool readMesh(KM_BinaryArchive& archive, SharedContent& shared) {
    auto mesh = std::make_shared<KM_Mesh>();
    if (!meshFields(FieldReader(archive), *mesh))
        return false;
    if (!mesh->IsValid())
        return archive.Fail();
    mesh->PadForRayTracing();
    shared.meshes.push_back(std::move(mesh));
    return true;
}

bool writeObject(KM_BinaryArchive& archive, const ObjectContent& object, std::int32_t mesh,
                 std::int32_t material) {
    const ObjectKind kind = kindOf(object);
    if (!attributeFields(FieldWriter(archive), object) ||
        !archive.WriteInt(static_cast<std::int32_t>(kind)))
        return false;
    switch (kind) {
    case ObjectKind::mesh:
        return archive.WriteInt(mesh) && archive.WriteInt(material);
    case ObjectKind::placed_mesh:
        return archive.WriteInt(mesh) && archive.WriteInt(material) &&
               placeFields(FieldWriter(archive), object.placed.world_from_mesh);
    case ObjectKind::curve:
        return writeCurve(archive, *object.curve);
    case ObjectKind::point:
        if (object.point && object.point->IsValid())
            return archive.WritePoint(*object.point);
    }
    return archive.Fail();
}

bool readObject(KM_BinaryArchive& archive, const SharedContent& shared, ObjectContent& object) {
    ObjectKind kind = ObjectKind::mesh;
    FieldReader step(archive);
    if (!attributeFields(step, object) || !step(kind, ObjectKind::mesh, ObjectKind::placed_mesh))
        return false;
    switch (kind) {
    case ObjectKind::mesh:
        return readShared(archive, shared.meshes, false, object.placed.mesh) &&
               readShared(archive, shared.materials, true, object.placed.material);
    case ObjectKind::placed_mesh:
        return readShared(archive, shared.meshes, false, object.placed.mesh) &&
               readShared(archive, shared.materials, true, object.placed.material) &&
               placeFields(FieldReader(archive), object.placed.world_from_mesh);
    case ObjectKind::curve:
        object.curve = readCurve(archive);
        return object.curve != nullptr;
    case ObjectKind::point:
        return readPoint(archive, object.point);
    }
    return archive.Fail();
}

bool writeView(KM_BinaryArchive& archive, const ViewContent& view) {
    return viewFields(FieldWriter(archive), view) && writeViewport(archive, view.viewport);
}

bool readView(KM_BinaryArchive& archive, ViewContent& view) {
    return viewFields(FieldReader(archive), view) && readViewport(archive, view.viewport);
}

bool writeCamera(KM_BinaryArchive& archive, const CameraContent& camera) {
    return archive.WriteString(camera.name) && writeViewport(archive, camera.viewport);
}

bool readCamera(KM_BinaryArchive& archive, CameraContent& camera) {
    return archive.ReadString(camera.name) && readViewport(archive, camera.viewport);
}

bool writeEdges(KM_BinaryArchive& archive, const EdgesContent& edges) {
    return archive.WriteUuid(edges.display_mode) &&
           FieldWriter(archive)(edges.choice, MeshEdgeChoice::none, MeshEdgeChoice::all);
}

bool readEdges(KM_BinaryArchive& archive, EdgesContent& edges) {
    return archive.ReadUuid(edges.display_mode) &&
           FieldReader(archive)(edges.choice, MeshEdgeChoice::none, MeshEdgeChoice::all);
}

bool writeRendering(KM_BinaryArchive& archive, const RenderSettings& settings) {
    return renderFields(FieldWriter(archive), settings);
}

bool readRendering(KM_BinaryArchive& archive, RenderSettings& settings) {
    return renderFields(FieldReader(archive), settings);
}

bool writeLight(KM_BinaryArchive& archive, const LightContent& light) {
    const LightFields fields(light.light);
    return archive.WriteInt(light.index) && lightFields(FieldWriter(archive), fields);
}

bool readLight(KM_BinaryArchive& archive, LightContent& light) {
    LightFields fields;
    if (!archive.ReadInt(light.index) || !lightFields(FieldReader(archive), fields))
        return false;
    light.light = fields.light();
    return LightStore::canShine(light.light) || archive.Fail();
}

bool writePlugIn(KM_BinaryArchive& archive, const PlugInContent& plug_in) {
    return archive.WriteUuid(plug_in.plug_in_id) && archive.WriteBytes(plug_in.bytes);
}

bool readPlugIn(KM_BinaryArchive& archive, PlugInContent& plug_in) {
    std::span<const std::uint8_t> bytes;
    if (!archive.ReadUuid(plug_in.plug_in_id) || !archive.ViewBytes(archive.BytesLeft(), bytes))
        return false;
    if (KM_UuidIsNil(plug_in.plug_in_id) || !beginsWithVersion(bytes))
        return archive.Fail();
    plug_in.bytes.assign(bytes.begin(), bytes.end());
    return true;
}

} // namespace quarn
