#pragma once

#include <cstdint>

class KM_2fPoint;
class KM_3fPoint;
struct KM_Color;
struct KM_MeshTriangle;

namespace quarn {

class MipTexture;
struct SurfaceLook;
struct SurfacePlace;

/// What the ray loops need to know of one mesh object. Pointers live as long as the scene is not
/// updated.
struct RaySurface {
    const KM_MeshTriangle* triangles = nullptr;
    const KM_3fPoint* vertices = nullptr;
    const std::uint32_t* corner_normals = nullptr;   ///< three a triangle, packed; null: flat faces
    const KM_2fPoint* texture_coordinates = nullptr; ///< null when there are none
    const KM_Color* colors = nullptr;                ///< null when vertices have no colours
    const MipTexture* texture = nullptr;
    const SurfaceLook* look = nullptr;    ///< null: the base colour says all
    const SurfacePlace* place = nullptr;  ///< null: the vertices are in the frame's coordinates
    float albedo[3] = {0.6F, 0.6F, 0.6F}; ///< linear base colour
    float opacity = 1.0F;                 ///< of the base colour
    bool see_through = false;             ///< what lies behind shines through
    bool has_cutout = false;
    bool one_sided = false; ///< its back is not seen, but casts shadows
    float passing = 0.0F;   ///< of a sun's light, where it is glass
    float alpha_cutoff = 0.5F;

    friend bool operator==(const RaySurface&, const RaySurface&) = default;
};

} // namespace quarn
