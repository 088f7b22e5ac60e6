#pragma once

#include "kelmar/KM_Color.h"
#include "kelmar/KM_Uuid.h"

#include <span>
#include <string_view>

namespace quarn {

/// What a display mode is at heart.
enum class DisplayKind : int {
    wireframe = 1, ///< lines alone
    shaded = 2,    ///< surfaces
};

/// How surfaces are painted.
enum class SurfaceStyle : int {
    none,   ///< not at all: one sees through everything
    studio, ///< colours and textures under a neutral light that follows the camera
    lit,    ///< colours and textures under the document's lights and the sky, on a ground plane
    translucent, ///< one sees through, layer behind layer
    x_ray,       ///< see-through faces, dense where they are seen edge-on
    paper,       ///< the colour of the paper: surfaces only hide what lies behind them
    clay,        ///< one matt material, the document's lights and the sky
};

/// How often a pixel is looked at where colour, normal, depth or object changes.
enum class AntialiasingLevel : int {
    off = 0,     ///< one ray a pixel
    screen = 1,  ///< 4 more rays at edges
    capture = 2, ///< 8 more rays at edges
};

/// Everything that tells the display pipeline how to draw. A plain value: views keep a copy of
/// their mode's attributes and may change it.
struct DisplayModeAttributes {
    KM_UUID id;
    std::wstring_view english_name; ///< of a standard mode; lives as long as the program
    DisplayKind kind = DisplayKind::shaded;
    SurfaceStyle surface_style = SurfaceStyle::studio;
    bool uses_document_lights = false;
    bool casts_shadows = false;
    bool has_ground_plane = false;
    bool has_sky = false; ///< else the background runs from background_top to background_bottom
    KM_Color background_top{226, 232, 240, 255};
    KM_Color background_bottom{248, 248, 247, 255};

    bool draws_edges = false;        ///< borders and creases of meshes
    bool draws_all_edges = false;    ///< the other edges too, lighter
    bool draws_outlines = false;     ///< where a surface turns away from the camera
    bool shows_hidden_lines = false; ///< lines behind surfaces are drawn too
    KM_Color edge_color{40, 44, 52, 255};
    float edge_width_px = 1.0F;
    float outline_width_px = 1.4F;
    float edge_strength = 1.0F;     ///< of creases and borders, 0 to 1; outlines have 1
    float far_strength = 1.0F;      ///< of the farthest edges beside the nearest
    float covered_strength = 1.0F;  ///< what each surface before an edge leaves of it, where the
                                    ///< surfaces are see-through
    float crowded_strength = 0.75F; ///< 1: edges fade fully where they crowd; 0: not at all
    float curve_width_px = 1.6F;
    float point_size_px = 5.0F;

    int antialiasing_level =
        1; ///< see AntialiasingLevel; a value beyond its range is moved into it
};

/// Whether surfaces look as their materials say, and the backs of one-sided ones are not seen.
bool showsMaterials(SurfaceStyle style);

/// Which edges of meshes are drawn.
enum class MeshEdgeChoice : int {
    standard = 0, ///< as the display mode has it
    none = 1,     ///< outlines alone, where the mode has them
    features = 2, ///< borders and creases, and outlines
    all = 3,      ///< every edge of every triangle
};

/// The mode with other edges than its own.
DisplayModeAttributes withEdges(DisplayModeAttributes mode, MeshEdgeChoice choice);

/// The display modes in the host's order, with English local names:
/// Wireframe, Shaded, Rendered, Translucent, X-Ray, Drawing, Clay.
std::span<const DisplayModeAttributes> standardDisplayModes();

/// Ids of the modes that other code refers to.
extern const KM_UUID wireframe_mode_id;
extern const KM_UUID shaded_mode_id;
extern const KM_UUID rendered_mode_id;

/// @return the mode with this id, or null
const DisplayModeAttributes* findDisplayMode(const KM_UUID& id);

} // namespace quarn
