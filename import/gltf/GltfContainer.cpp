#include "import/gltf/GltfContainer.h"

#include "import/files/ModelFileCheck.h"
#include "kelmar/KM_LittleEndian.h"

#include <cstring>
#include <limits>

namespace quarn::gltf {

namespace {

// Khronos Group, glTF 2.0, section 4.4: a head of 12 bytes, then chunks with heads of 8.
constexpr std::size_t GLB_HEADER = 12;
constexpr std::size_t CHUNK_HEAD = 8;
constexpr std::uint32_t JSON_CHUNK = 0x4E4F534A;
constexpr std::uint32_t BINARY_CHUNK = 0x004E4942;

std::uint32_t numberAt(Bytes bytes, std::size_t at) {
    return kelmar::fromLittleEndian<std::uint32_t>(bytes.data() + at);
}

std::string_view textOf(Bytes bytes) {
    return {reinterpret_cast<const char*>(bytes.data()), bytes.size()};
}

struct Chunk {
    std::uint32_t kind = 0;
    Bytes bytes;
};

Result<Chunk> chunkAt(Bytes file, std::size_t at) {
    if (file.size() - at < CHUNK_HEAD)
        return Error{"the file is cut short"};
    const std::uint64_t length = numberAt(file, at);
    if (length > file.size() - at - CHUNK_HEAD)
        return Error{"the lengths in its header do not fit the file's length: the part at byte " +
                     std::to_string(at) + " claims " + std::to_string(length) + " bytes and has " +
                     std::to_string(file.size() - at - CHUNK_HEAD)};
    return Chunk{numberAt(file, at + 4), file.subspan(at + CHUNK_HEAD, length)};
}

Result<Container> takeGlbApart(Bytes file) {
    if (file.size() < GLB_HEADER)
        return Error{"the file is cut short"};
    Container parts;
    parts.is_old_glb = numberAt(file, 4) < 2;
    if (parts.is_old_glb)
        return parts;
    const std::uint64_t length = numberAt(file, 8);
    if (length > file.size())
        return Error{"the lengths in its header do not fit the file's length: it claims " +
                     std::to_string(length) + " bytes and has " + std::to_string(file.size())};
    const Result<Chunk> first = chunkAt(file, GLB_HEADER);
    if (!first)
        return first.error();
    if (first.value().kind != JSON_CHUNK)
        return Error{"its first part is not the description of a model"};
    parts.text = textOf(first.value().bytes);
    std::size_t at = GLB_HEADER + CHUNK_HEAD + first.value().bytes.size();
    while (at + CHUNK_HEAD <= file.size()) {
        const Result<Chunk> chunk = chunkAt(file, at);
        if (!chunk)
            return chunk.error();
        if (chunk.value().kind == BINARY_CHUNK) {
            parts.binary = chunk.value().bytes;
            break;
        }
        at += CHUNK_HEAD + chunk.value().bytes.size();
    }
    return parts;
}

} // namespace

Result<Container> takeApart(const ModelReading& reading) {
    const Bytes file = reading.bytes;
    if (textOf(file).starts_with("glTF"))
        return takeGlbApart(file);
    const std::size_t first = textOf(file).find_first_not_of(" \t\r\n\xEF\xBB\xBF");
    const bool is_text = first != std::string_view::npos && file[first] == '{';
    if (modelFormat(reading.path) == "glb" && !is_text)
        return Error{"it is not a GLB file, whatever its name says"};
    return Container{textOf(file), {}, false};
}

Error damaged(const ModelReading& reading, std::string_view why) {
    return cannotReadModel(reading.path, why,
                           "The file may be damaged; get it or export it again.");
}

Error tooLarge(const ModelReading& reading, std::string_view why) {
    return cannotReadModel(reading.path, why, "Use a smaller model.");
}

Result<void> takeMemory(const ModelReading& reading, std::uint64_t count, std::uint64_t bytes_each,
                        std::string_view what) {
    constexpr std::uint64_t MOST = std::numeric_limits<std::uint64_t>::max();
    const bool is_beyond = bytes_each > 0 && count > MOST / bytes_each;
    const Result<void> taken = reading.budget.take(is_beyond ? MOST : count * bytes_each, what);
    return taken ? taken : tooLarge(reading, taken.message());
}

} // namespace quarn::gltf
