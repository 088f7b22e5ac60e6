#include "host/document/file/ChunkIds.h"
#include "host/document/file/ContentLayouts.h"
#include "host/document/file/DocumentCoding.h"
#include "host/document/file/DocumentHeader.h"

#include <exception>
#include <map>

namespace quarn {

namespace {

/// The things of one kind, each once, in the order in which they were first met.
template <class T> class Places {
public:
    /// @return the place of the thing; NO_PLACE for none
    std::int32_t of(const std::shared_ptr<const T>& thing) {
        if (!thing)
            return NO_PLACE;
        const auto [known, is_new] = m_places.try_emplace(thing.get(), count());
        if (is_new)
            m_things.push_back(thing.get());
        return known->second;
    }
    const std::vector<const T*>& things() const { return m_things; }

private:
    std::int32_t count() const { return static_cast<std::int32_t>(m_things.size()); }

    std::map<const T*, std::int32_t> m_places;
    std::vector<const T*> m_things;
};

std::string nameOf(const ObjectContent& object) {
    return object.name.IsEmpty() ? "the object " + KM_UuidToString(object.id).ToUtf8()
                                 : "the object \"" + object.name.ToUtf8() + "\"";
}

std::uint64_t sizeOf(const KM_Mesh& mesh) {
    return mesh.m_V.size() * sizeof(KM_3fPoint) + mesh.m_N.size() * sizeof(KM_3fVector) +
           mesh.m_T.size() * sizeof(KM_2fPoint) + mesh.m_C.size() * sizeof(KM_Color) +
           mesh.m_F.size() * sizeof(KM_MeshTriangle);
}

/// Writes one document. Each step is true, or leaves the archive failed and the name of what could
/// not be written behind.
class DocumentWriter {
public:
    explicit DocumentWriter(const DocumentContent& content)
        : m_content(content), m_archive(KM_BinaryArchive::ForWriting(content.version)) {}

    Result<std::vector<std::uint8_t>> write() {
        placeShared();
        reserve();
        if (writeHeader() && writeShared() && writeObjects() && writeSurroundings() &&
            writeChunk(chunk::END, "the end",
                       [&] { return m_archive.WriteInt(m_content.version); }))
            return m_archive.TakeBytes();
        return Error{m_failed_at + " cannot be written"};
    }

private:
    template <class Payload> bool writeChunk(std::uint32_t id, std::string what, Payload payload) {
        if (m_archive.BeginWriteChunk(id) && payload() && m_archive.EndWriteChunk())
            return true;
        m_failed_at = std::move(what);
        return false;
    }

    template <class T, class Write>
    bool writeEach(std::uint32_t id, const char* what, const std::vector<T>& things,
                   Write write_one) {
        for (const T& thing : things)
            if (!writeChunk(id, what, [&] { return write_one(m_archive, thing); }))
                return false;
        return true;
    }

    void placeShared() {
        for (const ObjectContent& object : m_content.objects) {
            m_meshes.of(object.placed.mesh);
            m_materials.of(object.placed.material);
        }
        for (const Material* material : m_materials.things())
            m_textures.of(material->base_color_texture);
    }

    void reserve() {
        constexpr std::uint64_t for_a_small_chunk = 256;
        std::uint64_t size = for_a_small_chunk * (16 + m_content.objects.size());
        for (const KM_Mesh* mesh : m_meshes.things())
            size += for_a_small_chunk + sizeOf(*mesh);
        for (const Texture* texture : m_textures.things())
            size += for_a_small_chunk + texture->rgba.size();
        for (const PlugInContent& plug_in : m_content.plug_ins)
            size += for_a_small_chunk + plug_in.bytes.size();
        m_archive.Reserve(size);
    }

    bool writeHeader() {
        return m_archive.WriteBytes(DOCUMENT_MAGIC) && m_archive.WriteInt(m_content.version) &&
               writeChunk(chunk::SETTINGS, "the document's settings",
                          [&] { return writeSettings(m_archive, m_content.settings); });
    }

    bool writeShared() {
        const auto texture = [](KM_BinaryArchive& archive, const Texture* thing) {
            return writeTexture(archive, *thing);
        };
        const auto material = [&](KM_BinaryArchive& archive, const Material* thing) {
            return writeMaterial(archive, *thing, m_textures.of(thing->base_color_texture));
        };
        const auto mesh = [](KM_BinaryArchive& archive, const KM_Mesh* thing) {
            return writeMesh(archive, *thing);
        };
        return writeEach(chunk::TEXTURE, "a texture", m_textures.things(), texture) &&
               writeEach(chunk::MATERIAL, "a material", m_materials.things(), material) &&
               writeEach(chunk::MESH, "a mesh", m_meshes.things(), mesh);
    }

    bool writeObjects() {
        for (const ObjectContent& object : m_content.objects) {
            const auto payload = [&] {
                return writeObject(m_archive, object, m_meshes.of(object.placed.mesh),
                                   m_materials.of(object.placed.material));
            };
            if (!writeChunk(chunk::OBJECT, nameOf(object), payload))
                return false;
        }
        return true;
    }

    bool writeSurroundings() {
        const auto unknown = [](KM_BinaryArchive& archive, const UnknownContent& content) {
            return archive.WriteBytes(content.payload);
        };
        if (!writeEach(chunk::VIEW, "a view", m_content.views, writeView) ||
            !writeEach(chunk::CAMERA, "a camera", m_content.cameras, writeCamera) ||
            !writeEach(chunk::EDGES, "the edges of a display mode", m_content.edges, writeEdges) ||
            !writeRenderSettings() ||
            !writeEach(chunk::LIGHT, "a light", m_content.lights, writeLight) ||
            !writeEach(chunk::PLUG_IN, "what a plug-in keeps", m_content.plug_ins, writePlugIn))
            return false;
        for (const UnknownContent& content : m_content.unknown)
            if (!writeChunk(content.id, "a part of an unknown kind",
                            [&] { return unknown(m_archive, content); }))
                return false;
        return true;
    }

    /// Those of a new document need no chunk.
    bool writeRenderSettings() {
        return !m_content.rendering ||
               writeChunk(chunk::RENDERING, "the settings of the renderer",
                          [&] { return writeRendering(m_archive, *m_content.rendering); });
    }

    const DocumentContent& m_content;
    KM_BinaryArchive m_archive;
    Places<Texture> m_textures;
    Places<Material> m_materials;
    Places<KM_Mesh> m_meshes;
    std::string m_failed_at;
};

} // namespace

Result<std::vector<std::uint8_t>> encodeDocument(const DocumentContent& content) {
    try {
        return DocumentWriter(content).write();
    } catch (const std::exception&) {
        return Error{"there is too little memory"};
    }
}

} // namespace quarn
