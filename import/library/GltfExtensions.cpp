#include "import/library/GltfExtensions.h"

#include <algorithm>
#include <array>
#include <string_view>

namespace quarn {
namespace {

constexpr std::array<std::string_view, 3> of_vertices{
    "KHR_mesh_quantization", "EXT_meshopt_compression", "KHR_meshopt_compression"};

/// Read, or without a say in what is shown.
constexpr std::array<std::string_view, 3> known{"KHR_draco_mesh_compression",
                                                "KHR_texture_transform", "KHR_lights_punctual"};

template <typename List> bool contains(const List& list, std::string_view name) {
    return std::find(list.begin(), list.end(), name) != list.end();
}

} // namespace

std::string unreadableExtension(const GltfDescription& description) {
    for (const std::string& name : description.required_extensions) {
        if (contains(of_vertices, name)) {
            return name;
        }
    }
    return {};
}

std::vector<std::string> tellUnknownExtensions(const GltfDescription& description) {
    std::vector<std::string> sentences;
    for (const std::string& name : description.required_extensions) {
        if (!contains(known, name) && !name.starts_with("KHR_materials_")) {
            sentences.push_back("It needs the glTF extension '" + name +
                                "', which is not known here: something may be missing or look "
                                "wrong. Export the model without it.");
        }
    }
    return sentences;
}

} // namespace quarn
