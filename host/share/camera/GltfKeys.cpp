#include "host/share/camera/GltfKeys.h"

#include <algorithm>
#include <bit>
#include <cstdint>

namespace quarn {

namespace {

using Json = nlohmann::ordered_json;

constexpr int FLOAT = 5126;

const char* typeOf(int components) {
    return components == 1 ? "SCALAR" : components == 3 ? "VEC3" : "VEC4";
}

/// The format asks for the range of the times.
Json accessorOf(std::span<const float> floats, int components, int view) {
    Json accessor = {{"bufferView", view},
                     {"componentType", FLOAT},
                     {"count", floats.size() / static_cast<std::size_t>(components)},
                     {"type", typeOf(components)}};
    if (components == 1) {
        accessor["min"] = Json::array({*std::min_element(floats.begin(), floats.end())});
        accessor["max"] = Json::array({*std::max_element(floats.begin(), floats.end())});
    }
    return accessor;
}

} // namespace

int GltfKeys::add(std::span<const float> floats, int components) {
    const int index = static_cast<int>(m_accessors.size());
    m_views.push_back(
        {{"buffer", 0}, {"byteOffset", m_bytes.size()}, {"byteLength", 4 * floats.size()}});
    m_accessors.push_back(accessorOf(floats, components, index));
    for (const float number : floats)
        for (int shift = 0; shift < 32; shift += 8)
            m_bytes.push_back(
                static_cast<std::byte>(std::bit_cast<std::uint32_t>(number) >> shift & 0xFF));
    return index;
}

} // namespace quarn
