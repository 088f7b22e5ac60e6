#include "import/gltf/GltfBuffers.h"

#include "import/files/ModelFileCheck.h"
#include "import/gltf/Base64.h"
#include "import/gltf/GltfContainer.h"
#include "import/gltf/MeshoptDecoding.h"

#include <utility>

namespace quarn::gltf {

namespace {

std::string called(const char* kind, std::uint64_t index) {
    return std::string(kind) + " " + std::to_string(index);
}

const Json& compressionOf(const Json& view) {
    const Json& ext = extension(view, "EXT_meshopt_compression");
    return ext.is_null() ? extension(view, "KHR_meshopt_compression") : ext;
}

} // namespace

bool fits(std::uint64_t offset, std::uint64_t count, std::uint64_t stride, std::uint64_t size,
          std::uint64_t length) {
    if (count == 0)
        return true;
    if (size > length || offset > length - size)
        return false;
    return stride == 0 || (count - 1) <= (length - size - offset) / stride;
}

Result<Bytes> Buffers::view(std::uint64_t index) {
    const Json& view = element(member(m_json, "bufferViews"), index);
    const std::string what = called("buffer view", index);
    if (view.is_null())
        return damaged(m_reading, "there is no " + what);
    const Json& compressed = compressionOf(view);
    if (compressed.is_null())
        return part(view, what);
    const auto found = m_views.find(index);
    if (found != m_views.end())
        return found->second;
    Result<Bytes> bytes = decompressed(compressed, what);
    if (bytes)
        m_views.emplace(index, bytes.value());
    return bytes;
}

std::uint64_t Buffers::stride(std::uint64_t view) const {
    return wholeNumber(member(element(member(m_json, "bufferViews"), view), "byteStride"))
        .value_or(0);
}

Result<Bytes> Buffers::part(const Json& place, const std::string& what) {
    const auto index = wholeNumber(member(place, "buffer"));
    const auto length = wholeNumber(member(place, "byteLength"));
    if (!index || !length)
        return damaged(m_reading, what + " does not say where its bytes are");
    const Result<Bytes> whole = buffer(*index);
    if (!whole)
        return whole;
    const std::uint64_t offset = wholeNumber(member(place, "byteOffset")).value_or(0);
    if (!fits(offset, 1, 0, *length, whole.value().size()))
        return damaged(m_reading, what + " is out of range: it takes " + std::to_string(*length) +
                                      " bytes from byte " + std::to_string(offset) + ", and " +
                                      called("buffer", *index) + " has " +
                                      std::to_string(whole.value().size()));
    return whole.value().subspan(offset, *length);
}

Result<Bytes> Buffers::decompressed(const Json& compressed, const std::string& what) {
    const Result<Bytes> bytes = part(compressed, what);
    if (!bytes)
        return bytes;
    MeshoptLayout layout;
    layout.count = wholeNumber(member(compressed, "count")).value_or(0);
    layout.stride = wholeNumber(member(compressed, "byteStride")).value_or(0);
    layout.mode = text(member(compressed, "mode"));
    layout.filter = text(member(compressed, "filter"));
    const std::string wrong = whyBad(layout);
    if (!wrong.empty())
        return damaged(m_reading, what + " cannot be decompressed: " + wrong);
    if (const Result<void> taken = takeMemory(m_reading, layout.count, layout.stride, "vertices");
        !taken)
        return taken.error();
    Result<std::vector<std::uint8_t>> decoded = decodeMeshopt(bytes.value(), layout);
    if (!decoded)
        return damaged(m_reading, what + " cannot be decompressed: " + decoded.message());
    return Bytes(m_decoded.emplace_back(std::move(decoded.value())));
}

Result<Bytes> Buffers::buffer(std::uint64_t index) {
    const auto found = m_buffers.find(index);
    if (found != m_buffers.end())
        return found->second;
    Result<Bytes> bytes = readBuffer(index);
    if (bytes)
        m_buffers.emplace(index, bytes.value());
    return bytes;
}

Result<Bytes> Buffers::readBuffer(std::uint64_t index) {
    const Json& buffer = element(member(m_json, "buffers"), index);
    const std::string what = called("buffer", index);
    if (buffer.is_null())
        return damaged(m_reading, "there is no " + what);
    const std::string uri = text(member(buffer, "uri"));
    if (uri.starts_with("data:"))
        return fromDataUri(what, uri);
    if (!uri.empty())
        return readFile(what, uri);
    if (index != 0 || m_binary.empty())
        return damaged(m_reading, what + " has no bytes");
    return m_binary;
}

Result<Bytes> Buffers::fromDataUri(const std::string& what, std::string_view uri) {
    constexpr std::string_view MARK = ";base64,";
    const std::size_t at = uri.find(MARK);
    if (at == std::string_view::npos)
        return damaged(m_reading, what + " is not given in Base64");
    if (const Result<void> taken = takeMemory(m_reading, uri.size(), 1, "buffers"); !taken)
        return taken.error();
    Result<std::vector<std::uint8_t>> bytes = fromBase64(uri.substr(at + MARK.size()));
    if (!bytes)
        return damaged(m_reading, what + " is damaged: " + bytes.message());
    return Bytes(m_decoded.emplace_back(std::move(bytes.value())));
}

Result<Bytes> Buffers::readFile(const std::string& what, const std::string& uri) {
    const std::optional<NamedFile> file = m_reading.folder.find(uri);
    if (!file && m_reading.folder.leadsOutside(uri))
        return cannotReadModel(m_reading.path,
                               "its " + what + " is the file '" + uri +
                                   "', which lies outside the model's folder",
                               "Copy that file beside the model.");
    if (!file)
        return cannotReadModel(
            m_reading.path, "the file '" + uri + "' that belongs to it is missing",
            "Put it beside the model; who passes on a model passes on all its files.");
    if (file->differs_in_case)
        m_warnings.push_back(otherCaseText(uri, *file));
    Result<MappedFile> mapped = mapFile(file->path);
    if (!mapped)
        return cannotReadModel(m_reading.path,
                               "its file '" + uri + "' cannot be read: " + mapped.message(),
                               "Check that file.");
    return m_files.emplace_back(std::move(mapped.value())).bytes();
}

} // namespace quarn::gltf
