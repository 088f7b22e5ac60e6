#include "host/document/file/ChunkIds.h"
#include "host/document/file/ContentLayouts.h"
#include "host/document/file/DocumentCoding.h"
#include "host/document/file/DocumentHeader.h"
#include "host/document/file/LightChoiceLayout.h"
#include "host/document/file/StudiedPlaceLayout.h"
#include "host/document/file/SurfaceLayout.h"

#include <algorithm>
#include <exception>
#include <set>

namespace quarn {

namespace {

constexpr const char* DAMAGED = "it is damaged or was cut off; a copy made earlier may be whole";

/// Reads one document. Each step is true, or leaves the archive failed.
class DocumentReader {
public:
    DocumentReader(std::span<const std::uint8_t> bytes, SharedContent shared)
        : m_archive(KM_BinaryArchive::ForReading(bytes)), m_shared(std::move(shared)) {}

    Result<DocumentContent> read() {
        if (const auto begun = readHeader(); !begun)
            return begun.error();
        while (!m_has_ended) {
            if (!readChunk())
                return Error{DAMAGED};
        }
        if (m_archive.BytesLeft() > 0 || !m_has_settings || !lightsHaveSlots() || !namesAreUnique())
            return Error{DAMAGED};
        return std::move(m_content);
    }

private:
    Result<void> readHeader() {
        std::span<const std::uint8_t> magic;
        if (!m_archive.ViewBytes(DOCUMENT_MAGIC.size(), magic) ||
            !std::ranges::equal(magic, DOCUMENT_MAGIC))
            return Error{"it is no document"};
        std::int32_t version = 0;
        if (!m_archive.ReadInt(version))
            return Error{DAMAGED};
        if (version > KM_CURRENT_ARCHIVE_VERSION)
            return Error{"it is of version " + std::to_string(version) +
                         ", and this program reads documents up to version " +
                         std::to_string(KM_CURRENT_ARCHIVE_VERSION) + "; update the program"};
        if (version < OLDEST_DOCUMENT_VERSION)
            return Error{DAMAGED};
        m_content.version = version;
        return {};
    }

    bool readChunk() {
        std::uint32_t id = 0;
        std::uint64_t length = 0;
        if (!m_archive.BeginReadChunk(id, length) || !readPayload(id) ||
            m_archive.BytesLeft() > 0 || !m_archive.EndReadChunk())
            return false;
        m_last_chunk = id;
        return true;
    }

    bool readPayload(std::uint32_t id) {
        switch (id) {
        case chunk::SETTINGS:
            return readOnlySettings();
        case chunk::TEXTURE:
            return readTexture(m_archive, m_shared);
        case chunk::MATERIAL:
            return readMaterial(m_archive, m_shared);
        case chunk::SURFACE:
            return m_last_chunk == chunk::MATERIAL ? readSurface(m_archive, m_shared)
                                                   : passOverSurface();
        case chunk::MESH:
            return readMesh(m_archive, m_shared);
        case chunk::OBJECT:
            return readObject(m_archive, m_shared, m_content.objects.emplace_back());
        case chunk::VIEW:
            return readView(m_archive, m_content.views.emplace_back());
        case chunk::CAMERA:
            return readCamera(m_archive, m_content.cameras.emplace_back());
        case chunk::EDGES:
            return readEdges(m_archive, m_content.edges.emplace_back());
        case chunk::RENDERING:
            return !m_content.rendering ? readRendering(m_archive, m_content.rendering.emplace())
                                        : m_archive.Fail();
        case chunk::SURROUNDINGS:
            return !m_content.light ? readLightChoice(m_archive, m_content.light.emplace())
                                    : m_archive.Fail();
        case chunk::STUDIED_PLACE:
            return !m_content.studied_place
                       ? readStudiedPlace(m_archive, m_content.studied_place.emplace())
                       : m_archive.Fail();
        case chunk::LIGHT:
            return readLight(m_archive, m_content.lights.emplace_back());
        case chunk::PLUG_IN:
            return readPlugIn(m_archive, m_content.plug_ins.emplace_back());
        case chunk::END:
            m_has_ended = true;
            return confirmVersion();
        default:
            return keep(id);
        }
    }

    /// A program that does not know such chunks keeps them, but not where they stood, and the
    /// textures that they name are gone.
    bool passOverSurface() {
        std::span<const std::uint8_t> passed_over;
        m_content.lost_surfaces = true;
        return m_archive.ViewBytes(m_archive.BytesLeft(), passed_over);
    }

    bool readOnlySettings() {
        if (m_has_settings)
            return m_archive.Fail();
        m_has_settings = true;
        return readSettings(m_archive, m_content.settings);
    }

    /// The version at the beginning stands outside every chunk, so nothing else guards it.
    bool confirmVersion() {
        std::int32_t version = 0;
        return m_archive.ReadInt(version) && (version == m_content.version || m_archive.Fail());
    }

    bool keep(std::uint32_t id) {
        std::span<const std::uint8_t> payload;
        if (!m_archive.ViewBytes(m_archive.BytesLeft(), payload))
            return false;
        m_content.unknown.push_back({id, {payload.begin(), payload.end()}});
        return true;
    }

    bool lightsHaveSlots() const {
        int first_free = 0;
        for (const LightContent& light : m_content.lights) {
            if (light.index < first_free)
                return false;
            first_free = light.index + 1;
        }
        return first_free <= m_content.settings.light_slots;
    }

    /// Objects, plug-ins and display modes are found by their ids, views by their names, ignoring
    /// case.
    bool namesAreUnique() const {
        std::set<KM_UUID> ids;
        for (const ObjectContent& object : m_content.objects)
            if (!ids.insert(object.id).second)
                return false;
        std::set<KM_UUID> plug_in_ids;
        for (const PlugInContent& plug_in : m_content.plug_ins)
            if (!plug_in_ids.insert(plug_in.plug_in_id).second)
                return false;
        std::set<KM_UUID> modes;
        for (const EdgesContent& edges : m_content.edges)
            if (!modes.insert(edges.display_mode).second)
                return false;
        std::set<KM_wString> names;
        for (const ViewContent& view : m_content.views) {
            KM_wString name = view.name;
            name.MakeLower();
            if (!names.insert(name).second)
                return false;
        }
        return true;
    }

    KM_BinaryArchive m_archive;
    DocumentContent m_content;
    SharedContent m_shared;
    bool m_has_settings = false;
    bool m_has_ended = false;
    std::uint32_t m_last_chunk = 0;
};

} // namespace

Result<DocumentContent> decodeDocument(std::span<const std::uint8_t> bytes, SharedContent shared) {
    try {
        return DocumentReader(bytes, std::move(shared)).read();
    } catch (const std::exception&) {
        return Error{"there is too little memory for it"};
    }
}

} // namespace quarn
