#include "import/gltf/DracoDecoding.h"

#include <draco/compression/decode.h>

#include <cstring>
#include <memory>
#include <optional>

namespace quarn::gltf {

namespace {

// "Draco 3D Data Compression", bitstream specification 2.2, sections 3 and 4: a head of 11 bytes,
// then the counts of the mesh.
constexpr std::size_t HEADER_BYTES = 11;
constexpr std::uint8_t EDGE_BREAKER = 1;
constexpr std::uint8_t HAS_METADATA = 0x80; // in the higher byte of the flags

std::optional<std::uint64_t> takeVarint(Bytes& bytes) {
    std::uint64_t number = 0;
    for (unsigned shift = 0; shift < 63 && !bytes.empty(); shift += 7) {
        const std::uint8_t byte = bytes.front();
        bytes = bytes.subspan(1);
        number |= static_cast<std::uint64_t>(byte & 0x7F) << shift;
        if (byte < 0x80)
            return number;
    }
    return std::nullopt;
}

/// The library asks for memory by these counts before it has seen what they count.
std::string whyBadCounts(Bytes bytes, const DracoLimits& limits) {
    if (bytes.size() < HEADER_BYTES + 1 || std::memcmp(bytes.data(), "DRACO", 5) != 0)
        return "they are of another kind";
    if (bytes[5] != 2 || bytes[6] < 2)
        return "they are of another version";
    if ((bytes[HEADER_BYTES - 1] & HAS_METADATA) != 0)
        return "they hold more than a mesh";
    const bool is_edge_breaker = bytes[8] == EDGE_BREAKER;
    bytes = bytes.subspan(HEADER_BYTES + (is_edge_breaker ? 1 : 0));
    const auto first = takeVarint(bytes);
    const auto second = takeVarint(bytes);
    if (!first || !second)
        return "they are cut short";
    const std::uint64_t faces = is_edge_breaker ? *second : *first;
    const std::uint64_t vertices = is_edge_breaker ? *first : *second;
    return faces <= limits.indices && vertices <= limits.vertices
               ? ""
               : "they hold more than their accessors say";
}

std::optional<ComponentType> typeOf(draco::DataType type) {
    switch (type) {
    case draco::DT_INT8:
        return ComponentType::int8;
    case draco::DT_UINT8:
        return ComponentType::uint8;
    case draco::DT_INT16:
        return ComponentType::int16;
    case draco::DT_UINT16:
        return ComponentType::uint16;
    case draco::DT_UINT32:
        return ComponentType::uint32;
    case draco::DT_FLOAT32:
        return ComponentType::float32;
    default:
        return std::nullopt;
    }
}

Accessor ownedAccessor(std::vector<std::uint8_t> bytes, std::uint64_t count, ComponentType type,
                       unsigned components) {
    Accessor accessor;
    accessor.name = "its compressed part";
    accessor.count = count;
    accessor.type = type;
    accessor.components = components;
    accessor.stride = sizeOf(type) * components;
    accessor.owned = std::make_shared<const std::vector<std::uint8_t>>(std::move(bytes));
    accessor.bytes = *accessor.owned;
    return accessor;
}

std::optional<Accessor> attributeOf(const draco::Mesh& mesh, std::uint32_t id) {
    const draco::PointAttribute* const source = mesh.GetAttributeByUniqueId(id);
    const auto type = source != nullptr ? typeOf(source->data_type()) : std::nullopt;
    if (!type || source->num_components() < 1)
        return std::nullopt;
    const auto components = static_cast<unsigned>(source->num_components());
    const std::size_t size = sizeOf(*type) * components;
    std::vector<std::uint8_t> bytes(mesh.num_points() * size);
    for (std::uint32_t i = 0; i < mesh.num_points(); ++i) {
        const draco::AttributeValueIndex value = source->mapped_index(draco::PointIndex(i));
        if (value.value() >= source->size())
            return std::nullopt;
        std::memcpy(bytes.data() + i * size, source->GetAddress(value), size);
    }
    Accessor accessor = ownedAccessor(std::move(bytes), mesh.num_points(), *type, components);
    accessor.is_normalized = source->normalized();
    return accessor;
}

Accessor indicesOf(const draco::Mesh& mesh) {
    std::vector<std::uint8_t> bytes(mesh.num_faces() * 3 * sizeof(std::uint32_t));
    std::uint8_t* at = bytes.data();
    for (std::uint32_t f = 0; f < mesh.num_faces(); ++f)
        for (const draco::PointIndex& corner : mesh.face(draco::FaceIndex(f))) {
            const std::uint32_t index = corner.value();
            for (int byte = 0; byte < 4; ++byte)
                *at++ = static_cast<std::uint8_t>(index >> (8 * byte));
        }
    return ownedAccessor(std::move(bytes), std::uint64_t{mesh.num_faces()} * 3,
                         ComponentType::uint32, 1);
}

} // namespace

Result<DracoMesh> decodeDraco(Bytes bytes, const std::map<std::string, std::uint32_t>& ids,
                              const DracoLimits& limits) {
    const std::string wrong = whyBadCounts(bytes, limits);
    if (!wrong.empty())
        return Error{wrong};
    draco::DecoderBuffer buffer;
    buffer.Init(reinterpret_cast<const char*>(bytes.data()), bytes.size());
    draco::StatusOr<std::unique_ptr<draco::Mesh>> decoded =
        draco::Decoder().DecodeMeshFromBuffer(&buffer);
    if (!decoded.ok() || decoded.value() == nullptr)
        return Error{"they are damaged"};
    const draco::Mesh& mesh = *decoded.value();
    DracoMesh result;
    for (const auto& [name, id] : ids) {
        std::optional<Accessor> attribute = attributeOf(mesh, id);
        if (!attribute)
            return Error{"they do not hold what belongs to " + name};
        result.attributes.emplace(name, std::move(*attribute));
    }
    result.indices = indicesOf(mesh);
    return result;
}

} // namespace quarn::gltf
