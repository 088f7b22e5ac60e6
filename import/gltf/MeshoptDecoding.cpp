#include "import/gltf/MeshoptDecoding.h"

#include <meshoptimizer.h>

namespace quarn::gltf {

namespace {

constexpr std::uint64_t MOST_ELEMENTS = 0xFFFFFFFF;
/// A byte of vertices takes a quarter of a bit at least, an index a third of a byte.
constexpr std::uint64_t MOST_EXPANSION = 64;

using Bytes = std::span<const std::uint8_t>;

bool isOfAttributes(const MeshoptLayout& layout) {
    return layout.mode == "ATTRIBUTES";
}

bool hasFilter(const MeshoptLayout& layout) {
    return !layout.filter.empty() && layout.filter != "NONE";
}

bool fitsFilter(const MeshoptLayout& layout) {
    if (!hasFilter(layout))
        return true;
    if (!isOfAttributes(layout))
        return false;
    if (layout.filter == "OCTAHEDRAL")
        return layout.stride == 4 || layout.stride == 8;
    return layout.filter == "QUATERNION" ? layout.stride == 8 : layout.filter == "EXPONENTIAL";
}

int decode(std::vector<std::uint8_t>& decoded, Bytes bytes, const MeshoptLayout& layout) {
    if (isOfAttributes(layout))
        return meshopt_decodeVertexBuffer(decoded.data(), layout.count, layout.stride, bytes.data(),
                                          bytes.size());
    if (layout.mode == "TRIANGLES")
        return meshopt_decodeIndexBuffer(decoded.data(), layout.count, layout.stride, bytes.data(),
                                         bytes.size());
    return meshopt_decodeIndexSequence(decoded.data(), layout.count, layout.stride, bytes.data(),
                                       bytes.size());
}

void filter(std::vector<std::uint8_t>& decoded, const MeshoptLayout& layout) {
    if (layout.filter == "OCTAHEDRAL")
        meshopt_decodeFilterOct(decoded.data(), layout.count, layout.stride);
    else if (layout.filter == "QUATERNION")
        meshopt_decodeFilterQuat(decoded.data(), layout.count, layout.stride);
    else
        meshopt_decodeFilterExp(decoded.data(), layout.count, layout.stride);
}

} // namespace

// The decoders end the program where these sizes are wrong.
std::string whyBad(const MeshoptLayout& layout) {
    const std::uint64_t stride = layout.stride;
    const bool is_index = layout.mode == "TRIANGLES" || layout.mode == "INDICES";
    if (!isOfAttributes(layout) && !is_index)
        return "its mode '" + layout.mode + "' is not known";
    if (is_index ? stride != 2 && stride != 4 : stride == 0 || stride > 256 || stride % 4 != 0)
        return "elements of " + std::to_string(stride) + " bytes do not go with its mode";
    if (layout.mode == "TRIANGLES" && layout.count % 3 != 0)
        return "its count is no multiple of three";
    if (!fitsFilter(layout))
        return "its filter '" + layout.filter + "' is not known or does not fit it";
    return layout.count > MOST_ELEMENTS ? "it claims too many elements" : "";
}

Result<std::vector<std::uint8_t>> decodeMeshopt(Bytes bytes, const MeshoptLayout& layout) {
    if (layout.count * layout.stride > MOST_EXPANSION * bytes.size())
        return Error{"it claims " + std::to_string(layout.count) + " elements and has only " +
                     std::to_string(bytes.size()) + " bytes"};
    std::vector<std::uint8_t> decoded(layout.count * layout.stride);
    if (layout.count == 0)
        return decoded;
    if (decode(decoded, bytes, layout) != 0)
        return Error{"its bytes are damaged, or of a newer kind"};
    if (hasFilter(layout))
        filter(decoded, layout);
    return decoded;
}

} // namespace quarn::gltf
