#include "engine/scene/MaterialCheck.h"
#include "ground/LargePages.h"
#include "ground/LightFields.h"
#include "ground/ViewportLayout.h"
#include "import/transfer/ModelTransfer.h"
#include "import/transfer/TransferLayout.h"
#include "kelmar/KM_LittleEndian.h"

#include <algorithm>
#include <new>
#include <stdexcept>
#include <string>

namespace quarn {

namespace {

/// Beyond the last vertex the ray tracer reads on; the room for it is asked for at once.
constexpr std::size_t SPARE_ELEMENTS = 2;

constexpr const char* NOT_WHOLE = "what its reader handed over is no whole model";

class ModelTaking {
public:
    ModelTaking(SharedBlock& block, std::span<const std::uint8_t> description,
                std::uint64_t arrays_end)
        : m_block(block), m_arrays_end(arrays_end),
          m_description(KM_BinaryArchive::ForReading(description)) {}

    /// @return false when it is no whole model
    bool take(ImportedModel& model) {
        return takeTextures() && takeMaterials() && takeMeshes() && takeObjects(model.meshes) &&
               takeCurves(model.curves) && takePoints(model.points, 0) &&
               takeCameras(model.cameras) && takeLights(model.lights) &&
               m_step(model.units, UnitSystem::none, LAST_UNIT_SYSTEM) &&
               upFields(m_step, model.up) && takeText(model.up.writer) && takePlace(model.place) &&
               takeWarnings(model.warnings) && m_description.BytesLeft() == 0 &&
               m_taken == m_arrays_end && !isEmpty(model);
    }

private:
    static bool isEmpty(const ImportedModel& model) {
        return model.meshes.empty() && model.curves.empty() && model.points.Count() == 0;
    }

    /// A list of the description.
    /// @param one  takes one more element; false when there is none
    template <class One> bool takeList(One one) {
        int count = 0;
        bool is_whole = m_description.ReadCount(1, count);
        for (int i = 0; is_whole && i < count; ++i)
            is_whole = one();
        return is_whole;
    }

    /// Asks for memory only where the block has as much.
    template <class Array>
    bool takeArray(std::uint64_t count, std::size_t element_bytes, Array& array) {
        if (count > (m_arrays_end - m_taken) / element_bytes)
            return false;
        array.reserve(count + SPARE_ELEMENTS);
        askForLargePages(array.data(), count * element_bytes);
        const std::size_t step = TRANSFER_STEP_BYTES / element_bytes;
        for (std::size_t done = 0; done < count; done = array.size()) {
            array.resize(std::min<std::size_t>(count, done + step));
            if (!takeBytes({reinterpret_cast<std::uint8_t*>(array.data() + done),
                            (array.size() - done) * element_bytes}))
                return false;
        }
        return true;
    }

    template <class Element> bool takeArray(std::int32_t count, std::vector<Element>& array) {
        return takeArray(static_cast<std::uint64_t>(count), sizeof(Element), array);
    }

    bool takeBytes(std::span<std::uint8_t> bytes) {
        if (!m_block.read(m_taken, bytes))
            return false;
        const std::uint64_t from = m_taken;
        m_taken += bytes.size();
        m_block.giveBack(from, m_taken);
        return true;
    }

    bool takeTextures() {
        return takeList([&] {
            auto texture = std::make_shared<Texture>();
            if (!textureFields(m_step, *texture))
                return false;
            const auto pixels = static_cast<std::uint64_t>(texture->width) *
                                static_cast<std::uint64_t>(texture->height);
            m_textures.push_back(texture);
            return takeArray(4 * pixels, 1, texture->rgba);
        });
    }

    bool takeMaterials() {
        return takeList([&] {
            auto material = std::make_shared<Material>();
            m_materials.push_back(material);
            return materialFields(m_step, *material) && takeTexturesOf(*material);
        });
    }

    bool takeTexturesOf(Material& material) {
        bool are_there = takeShared(m_textures, true, material.base_color_texture);
        for (TextureUse* const use : textureUses(material))
            are_there = are_there && takeShared(m_textures, true, use->texture);
        if (are_there && !makeDrawable(material).empty())
            ++m_materials_changed;
        return are_there;
    }

    bool takeMeshes() {
        return takeList([&] {
            auto mesh = std::make_shared<KM_Mesh>();
            MeshLengths lengths{};
            if (!lengthFields(m_step, lengths) || !takeArray(lengths[0], mesh->m_V) ||
                !takeArray(lengths[1], mesh->m_N) || !takeArray(lengths[2], mesh->m_T) ||
                !takeArray(lengths[3], mesh->m_C) || !takeArray(lengths[4], mesh->m_F))
                return false;
            mesh->PadForRayTracing();
            m_meshes.push_back(mesh);
            return !mesh->m_N.empty() && mesh->IsValid();
        });
    }

    bool takeObjects(std::vector<ImportedMesh>& objects) {
        return takeList([&] {
            ImportedMesh& object = objects.emplace_back();
            return m_step(object.name) && takeShared(m_meshes, false, object.placed.mesh) &&
                   takeShared(m_materials, true, object.placed.material) &&
                   placeFields(m_step, object.placed.world_from_mesh);
        });
    }

    template <class T>
    bool takeShared(const std::vector<std::shared_ptr<const T>>& things, bool may_be_none,
                    std::shared_ptr<const T>& thing) {
        std::int32_t place = NO_SHARED_PLACE;
        if (!m_step(place))
            return false;
        if (place == NO_SHARED_PLACE)
            return may_be_none;
        if (place < 0 || static_cast<std::size_t>(place) >= things.size())
            return false;
        thing = things[static_cast<std::size_t>(place)];
        return true;
    }

    bool takeCurves(std::vector<ImportedCurve>& curves) {
        return takeList([&] {
            ImportedCurve& curve = curves.emplace_back();
            return m_step(curve.name) && takePoints(curve.points, 2);
        });
    }

    bool takePoints(KM_3dPointArray& points, std::int32_t least) {
        std::int32_t count = 0;
        std::vector<KM_3dPoint> taken;
        if (!m_step(count) || count < least || !takeArray(count, taken) ||
            !std::all_of(taken.begin(), taken.end(), [](const auto& p) { return p.IsValid(); }))
            return false;
        points.Append(count, taken.data());
        return true;
    }

    bool takeCameras(std::vector<ImportedCamera>& cameras) {
        return takeList([&] {
            ImportedCamera& camera = cameras.emplace_back();
            return m_step(camera.name) && readViewport(m_description, camera.viewport);
        });
    }

    bool takeLights(std::vector<KM_Light>& lights) {
        return takeList([&] {
            LightFields fields;
            if (!lightFields(m_step, fields))
                return false;
            lights.push_back(fields.light());
            return fields.location.IsValid() && fields.direction.IsValid();
        });
    }

    bool takePlace(std::optional<ImportedPlace>& place) {
        bool is_there = false;
        if (!m_step(is_there))
            return false;
        return !is_there || earthFields(m_step, place.emplace());
    }

    bool takeWarnings(std::vector<std::string>& warnings) {
        if (!takeList([&] { return takeText(warnings.emplace_back()); }))
            return false;
        if (m_materials_changed > 0)
            warnings.push_back("Its reader handed over materials with numbers that cannot be (" +
                               std::to_string(m_materials_changed) +
                               "); what is usual stands for them.");
        return true;
    }

    bool takeText(std::string& text) {
        KM_wString wide;
        if (!m_step(wide))
            return false;
        text = wide.ToUtf8();
        return true;
    }

    SharedBlock& m_block;
    std::uint64_t m_taken = 0; ///< bytes of the arrays
    std::uint64_t m_arrays_end;
    KM_BinaryArchive m_description;
    FieldReader m_step{m_description};
    std::vector<std::shared_ptr<const Texture>> m_textures;
    std::vector<std::shared_ptr<const Material>> m_materials;
    std::size_t m_materials_changed = 0; ///< since their numbers could not be drawn
    std::vector<std::shared_ptr<const KM_Mesh>> m_meshes;
};

Result<ImportedModel> takeChecked(SharedBlock& block) {
    const std::uint64_t size = block.size();
    std::array<std::uint8_t, TRANSFER_END_BYTES> end{};
    if (size < end.size() || !block.read(size - end.size(), end))
        return Error{NOT_WHOLE};
    const auto length = kelmar::fromLittleEndian<std::uint64_t>(end.data());
    if (length > size - end.size())
        return Error{NOT_WHOLE};
    std::vector<std::uint8_t> description(length);
    const std::uint64_t arrays_end = size - end.size() - length;
    if (!block.read(arrays_end, description))
        return Error{NOT_WHOLE};
    block.giveBack(arrays_end, size);
    ImportedModel model;
    if (!ModelTaking(block, description, arrays_end).take(model))
        return Error{NOT_WHOLE};
    return model;
}

} // namespace

Result<ImportedModel> takeModel(SharedBlock& block) {
    try {
        return takeChecked(block);
    } catch (const std::bad_alloc&) {
        return Error{"there is too little memory for it"};
    } catch (const std::length_error&) {
        return Error{NOT_WHOLE};
    }
}

} // namespace quarn
