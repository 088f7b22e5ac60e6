#pragma once

#include "import/textures/TexturePlace.h"
#include "import/textures/TextureStore.h"

#include <array>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace quarn {

/// A picture that a material names.
struct MaterialMap {
    std::string file; ///< empty: none
    TexturePlace place;
    TextureWraps wraps;
    float strength = 1.0F; ///< of a relief
};

/// A material of a material file, as far as it is of use here.
struct FileMaterial {
    std::string_view name; ///< may be empty
    std::optional<std::array<float, 3>> color{};
    std::optional<float> opacity{};                 ///< 0 to 1
    std::optional<float> transparency{};            ///< what other programs write in its place
    std::optional<std::array<float, 3>> specular{}; ///< colour of the highlight
    std::optional<std::array<float, 3>> emission{};
    std::optional<float> exponent{}; ///< of the highlight
    std::optional<float> roughness{};
    std::optional<float> metalness{};
    std::optional<float> clearcoat{};
    std::optional<float> clearcoat_roughness{};
    MaterialMap color_map{};
    MaterialMap opacity_map{};
    MaterialMap specular_map{};
    MaterialMap emission_map{};
    MaterialMap roughness_map{};
    MaterialMap metalness_map{};
    MaterialMap normal_map{};
    MaterialMap bump_map{}; ///< heights, or normals
};

/// What a material file (MTL) holds.
struct MaterialFile {
    std::vector<FileMaterial> materials;
    std::string fault; ///< what is wrong with the first line that is damaged: "line 5 holds ..."
};

/// Reads a material file.
/// @param text  of the file; outlives what is returned
MaterialFile readMaterialFile(std::string_view text);

} // namespace quarn
