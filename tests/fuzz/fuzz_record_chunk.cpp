// The chunk of an animation record. Every input is read twice: as a whole chunk, and as the payload
// of a sound one, so that the check sequence does not keep the fuzzer from the fields.
#include "kelmar/KM_AnimationProperties.h"
#include "kelmar/KM_BinaryArchive.h"

#include <cstdint>
#include <cstdlib>
#include <span>
#include <vector>

namespace {

using Bytes = std::vector<std::uint8_t>;
using Span = std::span<const std::uint8_t>;

// A broken promise ends the program, which is how a fuzzer learns of it.
void require(bool promise) {
    if (!promise)
        std::abort();
}

Bytes chunkOf(const KM_3dmAnimationProperties& record) {
    KM_BinaryArchive archive = KM_BinaryArchive::ForWriting();
    require(record.Write(archive));
    return archive.TakeBytes();
}

Bytes chunkAround(Span payload) {
    const Bytes any_record = chunkOf(KM_3dmAnimationProperties());
    std::uint32_t id = 0;
    std::uint64_t length = 0;
    require(KM_BinaryArchive::ForReading(any_record).BeginReadChunk(id, length));
    KM_BinaryArchive archive = KM_BinaryArchive::ForWriting();
    require(archive.BeginWriteChunk(id) && archive.WriteBytes(payload) && archive.EndWriteChunk());
    return archive.TakeBytes();
}

// A record unlike a new one, to see whether a refusal leaves it alone.
KM_3dmAnimationProperties markedRecord() {
    KM_3dmAnimationProperties record;
    record.SetHtmlFilename(L"kept");
    record.CameraPoints().Append(KM_3dPoint(1, 2, 3));
    return record;
}

void readChunk(Span chunk) {
    KM_3dmAnimationProperties record = markedRecord();
    KM_BinaryArchive archive = KM_BinaryArchive::ForReading(chunk);
    if (!record.Read(archive)) {
        require(archive.HasFailed());
        require(chunkOf(record) == chunkOf(markedRecord()));
        return;
    }
    const Bytes written = chunkOf(record);
    KM_3dmAnimationProperties again;
    KM_BinaryArchive second = KM_BinaryArchive::ForReading(written);
    require(again.Read(second) && second.BytesLeft() == 0);
    require(chunkOf(again) == written);
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* bytes, std::size_t size) {
    readChunk({bytes, size});
    readChunk(chunkAround({bytes, size}));
    return 0;
}
