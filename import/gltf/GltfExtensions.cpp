#include "import/gltf/GltfExtensions.h"

#include <algorithm>
#include <array>
#include <string_view>

namespace quarn::gltf {

namespace {

constexpr std::array<std::string_view, 7> READ{
    "KHR_mesh_quantization",      "EXT_meshopt_compression", "KHR_meshopt_compression",
    "KHR_draco_mesh_compression", "EXT_mesh_gpu_instancing", "KHR_texture_transform",
    "KHR_lights_punctual"};

/// Of looks, movement and remarks, none of which moves or adds a triangle. Textures in other
/// formats tell themselves when they cannot be read.
constexpr std::array<std::string_view, 14> HARMLESS{"KHR_materials_",
                                                    "EXT_materials_",
                                                    "ADOBE_materials_",
                                                    "EXT_texture_",
                                                    "KHR_texture_",
                                                    "MSFT_texture_",
                                                    "KHR_animation_",
                                                    "KHR_xmp",
                                                    "EXT_lights_",
                                                    "KHR_technique",
                                                    "EXT_mesh_features",
                                                    "EXT_instance_features",
                                                    "EXT_structural_metadata",
                                                    "KHR_audio"};

bool isKnown(std::string_view name) {
    return std::ranges::find(READ, name) != READ.end() ||
           std::ranges::any_of(HARMLESS,
                               [name](std::string_view begin) { return name.starts_with(begin); });
}

} // namespace

std::string unknownExtension(const Json& json) {
    for (const Json& entry : elements(member(json, "extensionsRequired")))
        if (const std::string name = text(entry); !name.empty() && !isKnown(name))
            return name;
    return {};
}

} // namespace quarn::gltf
