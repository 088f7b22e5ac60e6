#include "host/document/file/ChunkIds.h"
#include "host/document/file/ContentLayouts.h"
#include "host/document/file/DocumentCoding.h"
#include "host/document/file/DocumentHeader.h"
#include "host/document/file/LightChoiceLayout.h"
#include "host/document/file/StudiedPlaceLayout.h"
#include "host/document/file/SurfaceLayout.h"

#include <algorithm>
#include <exception>

namespace quarn {

namespace {

constexpr const char* NO_MEMORY = "there is too little memory";

std::string nameOf(const ObjectContent& object) {
    return object.name.IsEmpty() ? "the object " + KM_UuidToString(object.id).ToUtf8()
                                 : "the object \"" + object.name.ToUtf8() + "\"";
}

/// Writes one document. Each step is true, or leaves the archive failed and the name of what could
/// not be written behind.
class DocumentWriter {
public:
    /// @param places  of all that objects share
    /// @param shared  what of it is written
    DocumentWriter(const DocumentContent& content, const SharedPlaces& places,
                   const SharedThings& shared)
        : m_content(content), m_places(places), m_shared(shared),
          m_archive(KM_BinaryArchive::ForWriting(content.version)) {}

    Result<std::vector<std::uint8_t>> write() {
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

    void reserve() {
        constexpr std::uint64_t for_a_small_chunk = 256;
        std::uint64_t size = for_a_small_chunk * (16 + m_content.objects.size());
        for (const KM_Mesh* mesh : m_shared.meshes)
            size += for_a_small_chunk + meshSize(*mesh);
        for (const Texture* texture : m_shared.textures)
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
        const auto mesh = [](KM_BinaryArchive& archive, const KM_Mesh* thing) {
            return writeMesh(archive, *thing);
        };
        return writeEach(chunk::TEXTURE, "a texture", m_shared.textures, texture) &&
               std::ranges::all_of(
                   m_shared.materials,
                   [this](const Material* material) { return writeMaterialChunks(*material); }) &&
               writeEach(chunk::MESH, "a mesh", m_shared.meshes, mesh);
    }

    bool writeMaterialChunks(const Material& material) {
        const auto itself = [&] {
            return writeMaterial(m_archive, material,
                                 m_places.of(material.base_color_texture.get()));
        };
        const auto surface = [&] { return writeSurface(m_archive, material, m_places); };
        const std::string what = "the material \"" + material.name.ToUtf8() + "\"";
        if (!writeChunk(chunk::MATERIAL, what, itself))
            return false;
        return m_content.version < FIRST_VERSION_WITH_SURFACES || !hasSurface(material) ||
               writeChunk(chunk::SURFACE, what, surface);
    }

    bool writeObjects() {
        for (const ObjectContent& object : m_content.objects) {
            const auto payload = [&] {
                return writeObject(m_archive, object, m_places.of(object.placed.mesh.get()),
                                   m_places.of(object.placed.material.get()));
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
            !writeRenderSettings() || !writeLightChoice() || !writePlaceOfStudy() ||
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

    bool writeLightChoice() {
        return !m_content.light ||
               writeChunk(chunk::SURROUNDINGS, "the settings of the light",
                          [&] { return quarn::writeLightChoice(m_archive, *m_content.light); });
    }

    bool writePlaceOfStudy() {
        return !m_content.studied_place ||
               writeChunk(chunk::STUDIED_PLACE, "the place of the sun study",
                          [&] { return writeStudiedPlace(m_archive, *m_content.studied_place); });
    }

    const DocumentContent& m_content;
    const SharedPlaces& m_places;
    const SharedThings& m_shared;
    KM_BinaryArchive m_archive;
    std::string m_failed_at;
};

} // namespace

Result<std::vector<std::uint8_t>> encodeDocument(const DocumentContent& content) {
    try {
        SharedPlaces places;
        const SharedThings shared = places.add(content);
        return DocumentWriter(content, places, shared).write();
    } catch (const std::exception&) {
        return Error{NO_MEMORY};
    }
}

Result<std::vector<std::uint8_t>> encodeDocument(const DocumentContent& content,
                                                 const SharedPlaces& places) {
    try {
        const SharedThings nothing;
        return DocumentWriter(content, places, nothing).write();
    } catch (const std::exception&) {
        return Error{NO_MEMORY};
    }
}

} // namespace quarn
