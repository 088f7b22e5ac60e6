#include "import/gltf/GltfAccessor.h"

#include "import/gltf/GltfContainer.h"
#include "kelmar/KM_LittleEndian.h"

#include <algorithm>
#include <array>
#include <bit>
#include <cstring>
#include <limits>
#include <type_traits>
#include <utility>

namespace quarn::gltf {

namespace {

unsigned componentsOf(const std::string& type) {
    constexpr std::array<std::pair<std::string_view, unsigned>, 5> KINDS{
        {{"SCALAR", 1}, {"VEC2", 2}, {"VEC3", 3}, {"VEC4", 4}, {"MAT4", 16}}};
    for (const auto& [name, components] : KINDS)
        if (name == type)
            return components;
    return 0;
}

template <class Integer> Integer integerAt(const std::uint8_t* at) {
    return static_cast<Integer>(kelmar::fromLittleEndian<std::make_unsigned_t<Integer>>(at));
}

/// Khronos Group, glTF 2.0, section 3.6.2.2: the least of the signed integers is a little less
/// than -1, and counts as -1.
template <class Integer> float numberAt(const std::uint8_t* at, bool is_normalized) {
    const auto value = static_cast<float>(integerAt<Integer>(at));
    constexpr auto LARGEST = static_cast<float>(std::numeric_limits<Integer>::max());
    return is_normalized ? std::max(value / LARGEST, -1.0F) : value;
}

float numberAt(const std::uint8_t* at, ComponentType type, bool is_normalized) {
    switch (type) {
    case ComponentType::int8:
        return numberAt<std::int8_t>(at, is_normalized);
    case ComponentType::uint8:
        return numberAt<std::uint8_t>(at, is_normalized);
    case ComponentType::int16:
        return numberAt<std::int16_t>(at, is_normalized);
    case ComponentType::uint16:
        return numberAt<std::uint16_t>(at, is_normalized);
    case ComponentType::uint32:
        return numberAt<std::uint32_t>(at, is_normalized);
    case ComponentType::float32:
        break;
    }
    return std::bit_cast<float>(integerAt<std::uint32_t>(at));
}

std::uint64_t elementSize(const Accessor& accessor) {
    return sizeOf(accessor.type) * accessor.components;
}

} // namespace

std::size_t sizeOf(ComponentType type) {
    switch (type) {
    case ComponentType::int8:
    case ComponentType::uint8:
        return 1;
    case ComponentType::int16:
    case ComponentType::uint16:
        return 2;
    case ComponentType::uint32:
    case ComponentType::float32:
        return 4;
    }
    return 0;
}

void Accessor::read(std::uint64_t element, std::span<float> numbers) const {
    if (bytes.empty()) {
        std::ranges::fill(numbers, 0.0F);
        return;
    }
    const std::uint8_t* at = bytes.data() + element * stride;
    for (float& number : numbers) {
        number = numberAt(at, type, is_normalized);
        at += sizeOf(type);
    }
}

std::uint32_t Accessor::integer(std::uint64_t element, unsigned component) const {
    if (bytes.empty())
        return 0;
    const std::uint8_t* const at = bytes.data() + element * stride + component * sizeOf(type);
    switch (type) {
    case ComponentType::uint8:
        return *at;
    case ComponentType::uint16:
        return integerAt<std::uint16_t>(at);
    case ComponentType::uint32:
        return integerAt<std::uint32_t>(at);
    default:
        return 0;
    }
}

Result<Accessor> Accessors::described(const Json& which) const {
    const auto index = wholeNumber(which);
    const Json& json = element(member(m_json, "accessors"), index.value_or(UINT64_MAX));
    Accessor accessor;
    accessor.name = "accessor " + (index ? std::to_string(*index) : which.dump());
    if (json.is_null())
        return damaged(m_reading, "there is no " + accessor.name);
    const auto type = wholeNumber(member(json, "componentType"));
    accessor.type = static_cast<ComponentType>(type && *type < 6000 ? *type : 0);
    accessor.components = componentsOf(text(member(json, "type")));
    const auto count = wholeNumber(member(json, "count"));
    if (elementSize(accessor) == 0 || !count)
        return damaged(m_reading, accessor.name + " does not say what it holds");
    accessor.count = *count;
    accessor.stride = elementSize(accessor);
    accessor.is_normalized = flag(member(json, "normalized"));
    return accessor;
}

Result<Accessor> Accessors::at(const Json& which, unsigned needed) {
    Result<Accessor> described = this->described(which);
    if (!described)
        return described;
    Accessor& accessor = described.value();
    if (accessor.components < needed)
        return damaged(m_reading, accessor.name + " has too few numbers in each element");
    const std::uint64_t index = *wholeNumber(which);
    const auto found = m_sparse.find(index);
    if (found != m_sparse.end())
        return found->second;
    const Json& json = element(member(m_json, "accessors"), index);
    if (const Result<void> located = locate(json, accessor); !located)
        return located.error();
    const Json& sparse = member(json, "sparse");
    if (sparse.is_null())
        return described;
    if (const Result<void> put = overlay(sparse, accessor); !put)
        return put.error();
    m_sparse.emplace(index, accessor);
    return described;
}

Result<Bytes> Accessors::elementBytes(std::uint64_t view, std::uint64_t offset, std::uint64_t count,
                                      std::uint64_t stride, std::uint64_t size,
                                      const std::string& what) {
    const Result<Bytes> bytes = m_buffers.view(view);
    if (!bytes)
        return bytes;
    if (!fits(offset, count, stride, size, bytes.value().size()))
        return damaged(m_reading, what + " is out of range: its " + std::to_string(count) +
                                      " elements begin at byte " + std::to_string(offset) + " of " +
                                      std::to_string(bytes.value().size()) + " in buffer view " +
                                      std::to_string(view));
    return count == 0 ? Bytes() : bytes.value().subspan(offset);
}

Result<void> Accessors::locate(const Json& json, Accessor& accessor) {
    const auto view = wholeNumber(member(json, "bufferView"));
    if (!view)
        return {};
    const std::uint64_t stated = m_buffers.stride(*view);
    accessor.stride = stated > 0 ? stated : accessor.stride;
    const std::uint64_t offset = wholeNumber(member(json, "byteOffset")).value_or(0);
    const Result<Bytes> bytes = elementBytes(*view, offset, accessor.count, accessor.stride,
                                             elementSize(accessor), accessor.name);
    if (!bytes)
        return bytes.error();
    accessor.bytes = bytes.value();
    return {};
}

Result<Accessor> Accessors::sparseIndices(const Json& sparse, const Accessor& accessor) {
    const Json& place = member(sparse, "indices");
    Accessor indices;
    indices.name = "the sparse part of " + accessor.name;
    const auto type = wholeNumber(member(place, "componentType"));
    indices.type = static_cast<ComponentType>(type && *type < 6000 ? *type : 0);
    indices.components = 1;
    indices.stride = sizeOf(indices.type);
    indices.count = wholeNumber(member(sparse, "count")).value_or(0);
    const auto view = wholeNumber(member(place, "bufferView"));
    if (indices.stride == 0 || !view)
        return damaged(m_reading, indices.name + " does not say what it holds");
    const Result<Bytes> bytes =
        elementBytes(*view, wholeNumber(member(place, "byteOffset")).value_or(0), indices.count,
                     indices.stride, indices.stride, indices.name);
    if (!bytes)
        return bytes.error();
    indices.bytes = bytes.value();
    return indices;
}

/// Puts a copy of the elements in place of the accessor's bytes, and over it those that are stated
/// one by one.
Result<void> Accessors::overlay(const Json& sparse, Accessor& accessor) {
    const Result<Accessor> indices = sparseIndices(sparse, accessor);
    if (!indices)
        return indices.error();
    const std::uint64_t size = elementSize(accessor);
    const Json& place = member(sparse, "values");
    const Result<Bytes> values =
        elementBytes(wholeNumber(member(place, "bufferView")).value_or(UINT64_MAX),
                     wholeNumber(member(place, "byteOffset")).value_or(0), indices.value().count,
                     size, size, indices.value().name);
    if (!values)
        return values.error();
    if (const Result<void> taken = takeMemory(m_reading, accessor.count, size, "vertices"); !taken)
        return taken;
    auto dense = std::make_shared<std::vector<std::uint8_t>>(accessor.count * size);
    for (std::uint64_t i = 0; i < accessor.count && !accessor.bytes.empty(); ++i)
        std::memcpy(dense->data() + i * size, accessor.bytes.data() + i * accessor.stride, size);
    for (std::uint64_t i = 0; i < indices.value().count; ++i) {
        const std::uint64_t target = indices.value().index(i);
        if (target >= accessor.count)
            return damaged(m_reading, indices.value().name + " names element " +
                                          std::to_string(target) + ", which is out of range: " +
                                          "there are " + std::to_string(accessor.count));
        std::memcpy(dense->data() + target * size, values.value().data() + i * size, size);
    }
    accessor.stride = size;
    accessor.bytes = *dense;
    accessor.owned = std::move(dense);
    return {};
}

} // namespace quarn::gltf
