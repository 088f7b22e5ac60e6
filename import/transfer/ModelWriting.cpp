#include "ground/LightFields.h"
#include "ground/ViewportLayout.h"
#include "import/transfer/ModelTransfer.h"
#include "import/transfer/TransferLayout.h"

#include <algorithm>
#include <sys/mman.h>
#include <unistd.h>
#include <unordered_map>
#include <utility>

namespace quarn {

namespace {

/// Things of one kind that others share, each once, in the order in which they are first met.
template <class T> class SharedThings {
public:
    std::int32_t place(const std::shared_ptr<const T>& thing) {
        if (!thing)
            return NO_SHARED_PLACE;
        const auto next = static_cast<std::int32_t>(m_things.size());
        const auto [found, is_new] = m_places.try_emplace(thing.get(), next);
        if (is_new)
            m_things.push_back(thing);
        return found->second;
    }
    std::vector<std::shared_ptr<const T>>& things() { return m_things; }

private:
    std::unordered_map<const T*, std::int32_t> m_places;
    std::vector<std::shared_ptr<const T>> m_things;
};

/// Gives back the memory of a piece of an array that nobody reads any more, of its whole pages.
void forget(std::span<const std::uint8_t> piece) {
    static const auto PAGE = static_cast<std::uintptr_t>(sysconf(_SC_PAGESIZE));
    const auto begin = (reinterpret_cast<std::uintptr_t>(piece.data()) + PAGE - 1) / PAGE * PAGE;
    const auto end = (reinterpret_cast<std::uintptr_t>(piece.data()) + piece.size()) / PAGE * PAGE;
    if (begin < end)
        madvise(reinterpret_cast<void*>(begin), end - begin, MADV_DONTNEED);
}

template <class Element>
std::span<const std::uint8_t> bytesOf(const Element* elements, std::size_t count) {
    return {reinterpret_cast<const std::uint8_t*>(elements), count * sizeof(Element)};
}

template <class Element> std::span<const std::uint8_t> bytesOf(const std::vector<Element>& array) {
    return bytesOf(array.data(), array.size());
}

MeshLengths lengthsOf(const KM_Mesh& mesh) {
    const auto length = [](const auto& array) { return static_cast<std::int32_t>(array.size()); };
    return {length(mesh.m_V), length(mesh.m_N), length(mesh.m_T), length(mesh.m_C),
            length(mesh.m_F)};
}

class ModelWriting {
public:
    explicit ModelWriting(SharedBlock& block) : m_block(block) {}

    Result<void> write(ImportedModel& model) {
        // A member that is added has to be carried: this line says so.
        auto& [meshes, curves, points, cameras, lights, units, up, place, warnings] = model;
        noteObjects(meshes);
        noteMaterials();
        writeTextures();
        writeMaterials();
        writeMeshes();
        m_description.WriteCount(m_objects.size());
        for (const Object& object : m_objects)
            writeObject(object);
        writeCurves(curves);
        writePoints(points);
        writeCameras(cameras);
        m_description.WriteCount(lights.size());
        for (const KM_Light& light : lights) {
            const LightFields fields(light);
            lightFields(m_step, fields);
        }
        m_step(units, UnitSystem::none, LAST_UNIT_SYSTEM);
        upFields(m_step, up);
        writeText(up.writer);
        m_step(place.has_value()) && place&& earthFields(m_step, *place);
        m_description.WriteCount(warnings.size());
        for (const std::string& warning : warnings)
            writeText(warning);
        return finish();
    }

private:
    struct Object {
        KM_wString name;
        std::int32_t mesh;
        std::int32_t material;
        KM_Xform place;
    };
    struct Look {
        Material material;                  ///< without its textures
        std::vector<std::int32_t> textures; ///< that of the base colour, then the others
    };

    /// Takes the meshes over, so that a mesh that was written is not held any more.
    void noteObjects(std::vector<ImportedMesh>& meshes) {
        for (ImportedMesh& mesh : meshes)
            m_objects.push_back({std::move(mesh.name), m_meshes.place(mesh.placed.mesh),
                                 m_materials.place(mesh.placed.material),
                                 mesh.placed.world_from_mesh});
        meshes.clear();
    }

    /// Copies the materials, so that they do not hold their textures any more.
    void noteMaterials() {
        for (auto& material : m_materials.things()) {
            Look& look = m_looks.emplace_back(Look{*material, {}});
            look.textures.push_back(placeOf(look.material.base_color_texture));
            for (TextureUse* const use : textureUses(look.material))
                look.textures.push_back(placeOf(use->texture));
            material.reset();
        }
    }

    std::int32_t placeOf(std::shared_ptr<const Texture>& texture) {
        return m_textures.place(std::exchange(texture, nullptr));
    }

    void writeTextures() {
        m_description.WriteCount(m_textures.things().size());
        for (auto& texture : m_textures.things()) {
            textureFields(m_step, *texture);
            writeArray(bytesOf(texture->rgba), texture.use_count() == 1);
            texture.reset();
        }
    }

    void writeMaterials() {
        m_description.WriteCount(m_looks.size());
        for (const Look& look : m_looks)
            materialFields(m_step, look.material) && numberFields(m_step, look.textures);
    }

    void writeMeshes() {
        m_description.WriteCount(m_meshes.things().size());
        for (auto& mesh : m_meshes.things()) {
            const bool is_last = mesh.use_count() == 1;
            const MeshLengths lengths = lengthsOf(*mesh);
            lengthFields(m_step, lengths);
            writeArray(bytesOf(mesh->m_V), is_last);
            writeArray(bytesOf(mesh->m_N), is_last);
            writeArray(bytesOf(mesh->m_T), is_last);
            writeArray(bytesOf(mesh->m_C), is_last);
            writeArray(bytesOf(mesh->m_F), is_last);
            mesh.reset();
        }
    }

    void writeObject(const Object& object) {
        m_step(object.name) && m_step(object.mesh) && m_step(object.material) &&
            placeFields(m_step, object.place);
    }

    void writeCurves(const std::vector<ImportedCurve>& curves) {
        m_description.WriteCount(curves.size());
        for (const auto& [name, points] : curves) {
            m_step(name);
            writePoints(points);
        }
    }

    void writePoints(const KM_3dPointArray& points) {
        m_step(static_cast<std::int32_t>(points.Count()));
        writeArray(bytesOf(points.Array(), static_cast<std::size_t>(points.Count())), false);
    }

    void writeCameras(const std::vector<ImportedCamera>& cameras) {
        m_description.WriteCount(cameras.size());
        for (const auto& [name, viewport] : cameras)
            m_step(name) && writeViewport(m_description, viewport);
    }

    void writeText(const std::string& text) { m_step(KM_wString::FromUtf8(text)); }

    /// @param is_last  nobody looks at the array after this
    void writeArray(std::span<const std::uint8_t> bytes, bool is_last) {
        while (m_written && !bytes.empty()) {
            const auto piece = bytes.first(std::min(bytes.size(), TRANSFER_STEP_BYTES));
            m_written = m_block.append(piece);
            if (is_last)
                forget(piece);
            bytes = bytes.subspan(piece.size());
        }
    }

    Result<void> finish() {
        const std::uint64_t length = m_description.Bytes().size();
        m_description.WriteInt64(static_cast<std::int64_t>(length));
        if (m_description.HasFailed())
            return Error{"it cannot be handed over"};
        writeArray(m_description.Bytes(), false);
        return m_written;
    }

    SharedBlock& m_block;
    KM_BinaryArchive m_description = KM_BinaryArchive::ForWriting();
    FieldWriter m_step{m_description}; ///< what it fails at, the archive knows at the end
    Result<void> m_written;
    SharedThings<Texture> m_textures;
    SharedThings<Material> m_materials;
    SharedThings<KM_Mesh> m_meshes;
    std::vector<Look> m_looks;
    std::vector<Object> m_objects;
};

} // namespace

Result<void> writeModel(ImportedModel model, SharedBlock& block) {
    try {
        return ModelWriting(block).write(model);
    } catch (const std::bad_alloc&) {
        return Error{"there is too little memory to hand it over"};
    }
}

} // namespace quarn
