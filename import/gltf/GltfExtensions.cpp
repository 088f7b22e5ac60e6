#include "import/gltf/GltfExtensions.h"

#include <algorithm>
#include <array>
#include <string_view>
#include <vector>

namespace quarn::gltf {

namespace {

/// A material's sheen tells itself.
constexpr std::array<std::string_view, 17> READ{"KHR_mesh_quantization",
                                                "EXT_meshopt_compression",
                                                "KHR_meshopt_compression",
                                                "KHR_draco_mesh_compression",
                                                "EXT_mesh_gpu_instancing",
                                                "KHR_texture_transform",
                                                "KHR_lights_punctual",
                                                "KHR_materials_clearcoat",
                                                "KHR_materials_emissive_strength",
                                                "KHR_materials_ior",
                                                "KHR_materials_pbrSpecularGlossiness",
                                                "KHR_materials_sheen",
                                                "KHR_materials_specular",
                                                "KHR_materials_transmission",
                                                "KHR_materials_unlit",
                                                "KHR_materials_volume",
                                                "CESIUM_RTC"};

/// Textures in other formats tell themselves when they cannot be read.
constexpr std::array<std::string_view, 3> TEXTURES{"EXT_texture_", "KHR_texture_", "MSFT_texture_"};

/// Of looks, movement, sound and remarks, none of which moves or adds a triangle.
constexpr std::array<std::string_view, 22> HARMLESS{"KHR_materials_",
                                                    "EXT_materials_",
                                                    "ADOBE_materials_",
                                                    "MSFT_packing_",
                                                    "NV_materials_",
                                                    "KHR_animation_",
                                                    "KHR_xmp",
                                                    "EXT_lights_",
                                                    "KHR_technique",
                                                    "EXT_mesh_features",
                                                    "EXT_instance_features",
                                                    "EXT_structural_metadata",
                                                    "EXT_feature_metadata",
                                                    "EXT_mesh_manifold",
                                                    "CESIUM_primitive_outline",
                                                    "KHR_audio",
                                                    "KHR_interactivity",
                                                    "KHR_physics_rigid_bodies",
                                                    "AGI_",
                                                    "VRM",
                                                    "GODOT_single_root",
                                                    "FB_geometry_metadata"};

/// The looks of all its materials are programs.
constexpr std::string_view ONLY_PROGRAMS = "KHR_techniques_webgl";

template <std::size_t Count>
bool beginsWithOneOf(std::string_view name, const std::array<std::string_view, Count>& begins) {
    return std::ranges::any_of(begins,
                               [name](std::string_view begin) { return name.starts_with(begin); });
}

bool isRead(std::string_view name) {
    return std::ranges::find(READ, name) != READ.end() || beginsWithOneOf(name, TEXTURES);
}

} // namespace

std::string unknownExtension(const Json& json) {
    for (const Json& entry : elements(member(json, "extensionsRequired")))
        if (const std::string name = text(entry);
            !name.empty() && !isRead(name) && !beginsWithOneOf(name, HARMLESS))
            return name;
    return {};
}

std::string passedOverText(const Json& json) {
    std::vector<std::string> names;
    const auto add = [&names](const std::string& name) {
        if (beginsWithOneOf(name, HARMLESS) && !isRead(name) &&
            std::ranges::find(names, name) == names.end())
            names.push_back(name);
    };
    for (const Json& entry : elements(member(json, "extensionsRequired")))
        add(text(entry));
    for (const Json& entry : elements(member(json, "extensionsUsed")))
        if (text(entry) == ONLY_PROGRAMS)
            add(text(entry));
    std::string list;
    for (const std::string& name : names)
        list += (list.empty() ? "" : ", ") + name;
    return list.empty() ? "" : "What these glTF extensions say was left out: " + list + ".";
}

} // namespace quarn::gltf
