#include "host/recovery/RecoveryCoding.h"

#include "host/document/file/ContentLayouts.h"
#include "host/document/file/DocumentCoding.h"
#include "host/document/file/SurfaceLayout.h"
#include "host/recovery/RecoveryChunks.h"

#include <algorithm>
#include <exception>

namespace quarn {

namespace {

using Bytes = std::vector<std::uint8_t>;

constexpr const char* NO_MEMORY = "there is too little memory";
constexpr const char* DAMAGED = "it is damaged before any of its states is whole";

/// @param write  writes the payload; false when it cannot be written
template <class Write>
Result<Bytes> chunkOf(std::uint32_t id, std::size_t size, const char* what, Write write) {
    constexpr std::size_t for_its_head = 64;
    KM_BinaryArchive archive = KM_BinaryArchive::ForWriting();
    archive.Reserve(size + for_its_head);
    if (archive.BeginWriteChunk(id) && write(archive) && archive.EndWriteChunk())
        return archive.TakeBytes();
    return Error{std::string(what) + " cannot be written"};
}

/// Reads one recovery file. Each step is true, or leaves the archive failed.
class RecoveryReader {
public:
    explicit RecoveryReader(std::span<const std::uint8_t> bytes)
        : m_archive(KM_BinaryArchive::ForReading(bytes)) {}

    Result<RecoveredState> read() {
        if (const auto begun = readBeginning(); !begun)
            return begun.error();
        bool is_whole = true;
        while (is_whole && m_archive.BytesLeft() > 0)
            is_whole = readChunk();
        if (m_state.empty())
            return Error{DAMAGED};
        auto content = decodeDocument(m_state, std::move(m_shared));
        if (!content)
            return content.error();
        const bool ends_with_state = is_whole && m_last_chunk == chunk::STATE;
        return RecoveredState{m_kept_at, std::move(content.value()), !ends_with_state};
    }

private:
    Result<void> readBeginning() {
        std::span<const std::uint8_t> magic;
        if (!m_archive.ViewBytes(RECOVERY_MAGIC.size(), magic) ||
            !std::ranges::equal(magic, RECOVERY_MAGIC))
            return Error{"it is no recovery file"};
        std::int32_t version = 0;
        if (!m_archive.ReadInt(version) || version < 1)
            return Error{DAMAGED};
        if (version > RECOVERY_VERSION)
            return Error{"a newer program wrote it; recover it with that one"};
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
        std::span<const std::uint8_t> skipped;
        switch (id) {
        case chunk::TEXTURE:
            return readTexture(m_archive, m_shared);
        case chunk::MATERIAL:
            return readMaterial(m_archive, m_shared);
        case chunk::SURFACE:
            return m_last_chunk == chunk::MATERIAL ? readSurface(m_archive, m_shared)
                                                   : m_archive.Fail();
        case chunk::MESH:
            return readMesh(m_archive, m_shared);
        case chunk::PICTURE:
            return m_archive.ViewBytes(m_archive.BytesLeft(), skipped);
        case chunk::STATE:
            return readState();
        default:
            return m_archive.Fail();
        }
    }

    bool readState() {
        std::int64_t milliseconds = 0;
        std::span<const std::uint8_t> document;
        if (!m_archive.ReadInt64(milliseconds) ||
            !m_archive.ViewBytes(m_archive.BytesLeft(), document))
            return false;
        const auto kept_at = timeOf(milliseconds);
        if (!kept_at || document.empty())
            return m_archive.Fail();
        m_kept_at = *kept_at;
        m_state = document;
        return true;
    }

    KM_BinaryArchive m_archive;
    SharedContent m_shared;
    std::span<const std::uint8_t> m_state; ///< the last one; empty: none is whole yet
    std::chrono::system_clock::time_point m_kept_at;
    std::uint32_t m_last_chunk = 0;
};

} // namespace

Bytes recoveryBeginning() {
    KM_BinaryArchive archive = KM_BinaryArchive::ForWriting();
    archive.WriteBytes(RECOVERY_MAGIC);
    archive.WriteInt(RECOVERY_VERSION);
    return archive.TakeBytes();
}

Result<Bytes> textureChunk(const Texture& texture) {
    return chunkOf(chunk::TEXTURE, texture.rgba.size(), "a texture",
                   [&](KM_BinaryArchive& archive) { return writeTexture(archive, texture); });
}

Result<Bytes> materialChunks(const Material& material, const SharedPlaces& places) {
    const auto itself = [&](KM_BinaryArchive& archive) {
        return writeMaterial(archive, material, places.of(material.base_color_texture.get()));
    };
    const auto surface = [&](KM_BinaryArchive& archive) {
        return writeSurface(archive, material, places);
    };
    auto chunks = chunkOf(chunk::MATERIAL, 0, "a material", itself);
    if (!chunks || !hasSurface(material))
        return chunks;
    const auto second = chunkOf(chunk::SURFACE, 0, "a material", surface);
    if (!second)
        return second;
    chunks.value().insert(chunks.value().end(), second.value().begin(), second.value().end());
    return chunks;
}

Result<Bytes> meshChunk(const KM_Mesh& mesh) {
    return chunkOf(chunk::MESH, meshSize(mesh), "a mesh",
                   [&](KM_BinaryArchive& archive) { return writeMesh(archive, mesh); });
}

Result<Bytes> pictureChunk(std::span<const std::byte> png) {
    const std::span bytes(reinterpret_cast<const std::uint8_t*>(png.data()), png.size());
    return chunkOf(chunk::PICTURE, bytes.size(), "a picture",
                   [&](KM_BinaryArchive& archive) { return archive.WriteBytes(bytes); });
}

Result<Bytes> stateChunk(const RecoveryState& state, const SharedPlaces& places) {
    const auto document = encodeDocument(state.content, places);
    if (!document)
        return document.error();
    return chunkOf(chunk::STATE, document.value().size(), "the document",
                   [&](KM_BinaryArchive& archive) {
                       return archive.WriteInt64(millisecondsOf(state.kept_at)) &&
                              archive.WriteBytes(document.value());
                   });
}

Result<RecoveredState> decodeRecovery(std::span<const std::uint8_t> bytes) {
    try {
        return RecoveryReader(bytes).read();
    } catch (const std::exception&) {
        return Error{NO_MEMORY};
    }
}

} // namespace quarn
