// The document file. Every input is read twice: as a whole file, and, after its first byte, as the
// payload of a chunk of the kind that this byte chooses, in a file that is sound besides, so that
// the check sequences do not keep the fuzzer from the fields.
#include "host/document/file/ChunkIds.h"
#include "host/document/file/ContentLayouts.h"
#include "host/document/file/DocumentCoding.h"
#include "host/document/file/DocumentHeader.h"
#include "kelmar/KM_BinaryArchive.h"

#include <array>
#include <cstdint>
#include <cstdlib>
#include <functional>
#include <span>
#include <vector>

namespace {

using namespace quarn;
using Bytes = std::vector<std::uint8_t>;
using Span = std::span<const std::uint8_t>;

constexpr std::array KINDS = {chunk::SETTINGS, chunk::TEXTURE, chunk::MATERIAL, chunk::MESH,
                              chunk::OBJECT,   chunk::VIEW,    chunk::CAMERA,   chunk::LIGHT,
                              chunk::PLUG_IN,  chunk::END,     chunk::SURFACE};

// A broken promise ends the program, which is how a fuzzer learns of it.
void require(bool promise) {
    if (!promise)
        std::abort();
}

void addChunk(KM_BinaryArchive& archive, std::uint32_t id, Span payload) {
    require(archive.BeginWriteChunk(id) && archive.WriteBytes(payload) && archive.EndWriteChunk());
}

Bytes payloadOf(const std::function<void(KM_BinaryArchive&)>& write) {
    KM_BinaryArchive archive = KM_BinaryArchive::ForWriting();
    write(archive);
    return archive.TakeBytes();
}

Bytes soundSettings() {
    return payloadOf([](KM_BinaryArchive& archive) {
        archive.WriteInt(0);
        archive.WriteDouble(0.001);
        archive.WriteBool(true);
        archive.WriteVector(KM_3dVector::ZAxis);
        archive.WriteInt(10);
    });
}

// One that materials can name.
Bytes soundTexture() {
    return payloadOf([](KM_BinaryArchive& archive) {
        for (const std::int32_t number : {1, 1, 0, 0, 0})
            archive.WriteInt(number);
        archive.WriteCount(4);
        archive.WriteBytes(std::array<std::uint8_t, 4>{1, 2, 3, 255});
    });
}

// One that objects can name.
Bytes soundMesh() {
    const std::array<KM_3fPoint, 3> vertices = {{{0, 0, 0}, {1, 0, 0}, {0, 1, 0}}};
    const std::array<KM_MeshTriangle, 1> triangles = {{{{0, 1, 2}}}};
    return payloadOf([&](KM_BinaryArchive& archive) {
        archive.WriteArray(std::span<const KM_3fPoint>(vertices));
        for (int absent = 0; absent < 3; ++absent)
            archive.WriteCount(0);
        archive.WriteArray(std::span<const KM_MeshTriangle>(triangles));
    });
}

// One that objects can name and that a surface belongs to.
Bytes soundMaterial() {
    return payloadOf([](KM_BinaryArchive& archive) { writeMaterial(archive, Material(), 0); });
}

Bytes fileAround(std::uint32_t kind, Span payload) {
    KM_BinaryArchive archive = KM_BinaryArchive::ForWriting();
    archive.WriteBytes(DOCUMENT_MAGIC);
    archive.WriteInt(KM_CURRENT_ARCHIVE_VERSION);
    if (kind != chunk::SETTINGS)
        addChunk(archive, chunk::SETTINGS, soundSettings());
    addChunk(archive, chunk::TEXTURE, soundTexture());
    addChunk(archive, chunk::MESH, soundMesh());
    addChunk(archive, chunk::MATERIAL, soundMaterial());
    addChunk(archive, kind, payload);
    if (kind != chunk::END)
        addChunk(archive, chunk::END, payloadOf([](KM_BinaryArchive& end) {
                     end.WriteInt(KM_CURRENT_ARCHIVE_VERSION);
                 }));
    return archive.TakeBytes();
}

// What is taken can be written, and is then read as the same.
void readFile(Span bytes) {
    const auto content = decodeDocument(bytes);
    if (!content) {
        require(!content.message().empty());
        return;
    }
    const auto written = encodeDocument(content.value());
    require(written.ok());
    const auto again = decodeDocument(written.value());
    require(again.ok());
    const auto written_again = encodeDocument(again.value());
    require(written_again.ok() && written_again.value() == written.value());
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size) {
    const Span input(bytes, size);
    readFile(input);
    if (size > 0)
        readFile(fileAround(KINDS[input[0] % KINDS.size()], input.subspan(1)));
    return 0;
}
