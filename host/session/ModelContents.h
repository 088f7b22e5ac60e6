#pragma once

#include "kelmar/KM_Color.h"
#include "kelmar/KM_Point.h"
#include "sdk/qncore/QnExport.h"

#include <array>
#include <cstdint>
#include <optional>
#include <string>
#include <utility>
#include <variant>
#include <vector>

class CQuarnDoc;

namespace quarn {

/// A texture of a document.
struct TextureContents {
    int width_px = 0;
    int height_px = 0;
    std::uint64_t bytes = 0; ///< in memory
};

/// A texture as one quality of a material uses it. The mesh's coordinates (a, b) lie at
/// (u[0] a + u[1] b + u[2], v[0] a + v[1] b + v[2]) on it.
struct UsedTexture {
    std::size_t texture = 0; ///< index among the document's textures
    std::array<double, 3> u{};
    std::array<double, 3> v{};
};

/// A quality of a material: a number, which may be infinite, a flag, a colour in linear light, a
/// texture, or none where there could be one.
using MaterialQuality =
    std::variant<std::monostate, double, bool, std::array<double, 3>, UsedTexture>;

/// A material of a document.
struct MaterialContents {
    std::string name; ///< may be empty
    KM_Color base_color;
    bool is_see_through = false;
    std::optional<double> alpha_cutoff; ///< what is less opaque is left out; none: nothing is
    std::optional<std::size_t> texture; ///< index among the document's textures
    /// All other qualities, each with its name: "metalness".
    std::vector<std::pair<std::string, MaterialQuality>> qualities;
    // What is worth a word about them:
    bool is_metal = false; ///< for one half at least
    bool has_normal_map = false;
    bool has_clearcoat = false;
    bool shines = false; ///< by itself
    bool lets_light_through = false;
    bool is_unlit = false;
    bool has_sheen = false;
};

/// An object of a document.
struct ObjectContents {
    std::string name; ///< empty: it has none
    std::string kind; ///< "mesh", "curve", "point"
    std::size_t triangles = 0;
    std::size_t vertices = 0;
    std::optional<std::size_t> material; ///< index among the document's materials
    bool repeats = false;                ///< shows the mesh of an object before it once more
    bool is_visible = true;
};

/// What is in a document, to be told. Texts are UTF-8 and English.
struct ModelContents {
    std::vector<ObjectContents> objects;
    std::vector<MaterialContents> materials;
    std::vector<TextureContents> textures;
    std::vector<std::string> cameras; ///< names
    std::size_t lights = 0;
    std::string animation; ///< "turntable, 120 frames in Perspective"; empty where none is set up
    std::string units;     ///< "metres"; empty where nobody said
    /// The corners of the box of all objects; none without objects.
    std::optional<std::pair<KM_3dPoint, KM_3dPoint>> box;
    /// Of the model file that was read last, where one was:
    char up_axis = 0;                  ///< 'y' or 'z'; 0 where the file itself settled it
    std::string up_reason;             ///< "as its format has it"
    bool up_is_guessed = false;        ///< the format leaves it open
    std::vector<std::string> left_out; ///< sentences: what was left out and why
};

QNCORE_API ModelContents contentsOf(CQuarnDoc& document);

} // namespace quarn
