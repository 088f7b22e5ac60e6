#pragma once

#include <cstddef>
#include <nlohmann/json.hpp>
#include <span>
#include <vector>

namespace quarn {

/// The numbers that a glTF file keeps outside its JSON, each a little-endian 32-bit float.
class GltfKeys {
public:
    /// Adds one value for each frame.
    /// @param components  floats a value: 1, 3 or 4
    /// @return the index of its accessor
    int add(std::span<const float> floats, int components);

    std::span<const std::byte> bytes() const { return m_bytes; }
    const nlohmann::ordered_json& accessors() const { return m_accessors; }
    const nlohmann::ordered_json& bufferViews() const { return m_views; }

private:
    std::vector<std::byte> m_bytes;
    nlohmann::ordered_json m_accessors = nlohmann::ordered_json::array();
    nlohmann::ordered_json m_views = nlohmann::ordered_json::array();
};

} // namespace quarn
