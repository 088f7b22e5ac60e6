// The recovery file. Every input is read twice: as a whole file, and, after its first byte, as the
// payload of a chunk of the kind that this byte chooses, in a file that is sound besides, so that
// the check sequences do not keep the fuzzer from the fields.
#include "host/document/file/ChunkIds.h"
#include "host/document/file/DocumentCoding.h"
#include "host/recovery/RecoveryChunks.h"
#include "host/recovery/RecoveryCoding.h"
#include "kelmar/KM_BinaryArchive.h"

#include <array>
#include <cstdint>
#include <cstdlib>
#include <span>
#include <vector>

namespace {

using namespace quarn;
using Bytes = std::vector<std::uint8_t>;
using Span = std::span<const std::uint8_t>;

constexpr std::array KINDS = {chunk::TEXTURE, chunk::MATERIAL, chunk::MESH,
                              chunk::PICTURE, chunk::STATE,    chunk::SURFACE};

// A broken promise ends the program, which is how a fuzzer learns of it.
void require(bool promise) {
    if (!promise)
        std::abort();
}

void append(Bytes& bytes, const Result<Bytes>& chunk) {
    require(chunk.ok());
    bytes.insert(bytes.end(), chunk.value().begin(), chunk.value().end());
}

Bytes soundState() {
    RecoveryState state;
    const auto chunk = stateChunk(state, SharedPlaces());
    require(chunk.ok());
    return chunk.value();
}

// The chunk stands, behind a material, between two states that need it not.
Bytes fileAround(std::uint32_t kind, Span payload) {
    KM_BinaryArchive archive = KM_BinaryArchive::ForWriting();
    require(archive.BeginWriteChunk(kind) && archive.WriteBytes(payload) &&
            archive.EndWriteChunk());
    Bytes bytes = recoveryBeginning();
    append(bytes, soundState());
    append(bytes, materialChunks(Material(), SharedPlaces()));
    append(bytes, archive.TakeBytes());
    if (kind != chunk::STATE)
        append(bytes, soundState());
    return bytes;
}

// What is taken is a document like any other.
void readFile(Span bytes) {
    const auto state = decodeRecovery(bytes);
    if (!state) {
        require(!state.message().empty());
        return;
    }
    const auto written = encodeDocument(state.value().content);
    require(written.ok() && decodeDocument(written.value()).ok());
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size) {
    const Span input(bytes, size);
    readFile(input);
    if (size > 0)
        readFile(fileAround(KINDS[input[0] % KINDS.size()], input.subspan(1)));
    return 0;
}
