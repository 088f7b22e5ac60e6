#pragma once

#include "engine/display/CameraRays.h"
#include "engine/display/EnvironmentMap.h"
#include "engine/display/RaySurface.h"

#include <embree3/rtcore.h>

#include <cstddef>
#include <cstdint>

namespace quarn {

/// How many rays travel together: a tile of 4 by 4 pixels.
inline constexpr int lane_count = 16;
inline constexpr int tile_size = 4;

/// A directional light as the ray loops use it.
struct FrameLight {
    float toward[3];
    float color[3];
    float shadow; ///< 0: none are looked for
};

inline constexpr int max_fixed_lights = 4;
inline constexpr int max_suns = 8;

/// A soft rectangle of light, far away.
struct FrameSoftBox {
    float toward[3]; ///< its middle
    float across[3];
    float along[3];
    float half_width; ///< tangents of angles
    float half_height;
    float border; ///< over which it fades
    float color[3];
};

inline constexpr int max_soft_boxes = 4;

/// A lamp: it shines from a place, less the farther away.
struct FrameLamp {
    float place[3]; ///< in the scene's coordinates
    float color[3]; ///< scene light on a white surface that faces it from one unit away
    float axis[3];  ///< where a spot shines to; of unit length
    /// A spot's light is multiplied by the square of what this gives, moved into 0 to 1:
    /// cone_slope * cosine of the angle to the axis + cone_base. Other lamps: 0 and 1.
    float cone_slope;
    float cone_base;
    float least_square; ///< of the distance: nearer by, the light grows no more
    float shadow;       ///< as FrameLight::shadow
};

inline constexpr int max_lamps = 32;

/// A picture of what lies around, see PictureLight.
struct FramePicture {
    const float* sharp = nullptr; ///< PictureMap::floats numbers; null: there is no picture
    const float* broad = nullptr; ///< its mean over larger parts, BroadMap::floats numbers
    float scale = 1.0F;           ///< from its numbers to scene light
};

/// How layers of see-through surfaces cover what lies behind them.
struct FrameLayers {
    int count = 1;             ///< how many surfaces a ray passes at most; 1: they are opaque
    float facing_opacity = 1;  ///< of a surface that faces the observer
    float edge_on_opacity = 1; ///< of one that is seen along its face
    float stain = 0;           ///< 1: what comes through takes the surface's colour; 0: none of it
};

/// How many see-through surfaces of a pixel are kept, to tell what lies before a line.
inline constexpr int layers_kept = 4;

/// The free sky is found on a grid that is coarser than the picture: place (i, j) lies at the
/// continuous pixel (sky_spacing * i + sky_spacing / 2, sky_spacing * j + sky_spacing / 2).
inline constexpr int sky_spacing = 2;
/// How many rays each place sends toward the sky to find how much of it is free.
inline constexpr int sky_rays = 2;

/// Two places show one surface if each lies near the other's plane, by parts of the reach and of
/// how far they are apart, and if the cosine of the angle between their normals is not too small.
inline constexpr float sky_step_of_reach = 0.06F;
inline constexpr float sky_step_of_slope = 0.25F;
inline constexpr float sky_least_facing = 0.7F;

/// Sixteen directions about (0, 0, 1), the density of all being as the cosine of their angle to it;
/// and how far each looks, as a part of `FrameSetup::sky_reach`.
struct SkyDirections {
    alignas(64) float x[lane_count];
    alignas(64) float y[lane_count];
    alignas(64) float z[lane_count];
    alignas(64) float reach[lane_count];
};

/// The directions of the free sky.
struct SkyTable {
    SkyDirections shared[sky_rays]; ///< each place of a 4 by 4 tile of the grid takes one of each
    SkyDirections alone;            ///< all for one pixel that no place of the grid speaks for
};

/// What a place of the grid shows, to compare neighbours.
struct SkyPlace {
    float normal[3]; ///< all 0: nothing
    float point[3];
};

/// How much of the light from all around arrives at the ground, on a grid of places.
inline constexpr int ground_map_side = 192;
struct FrameGroundMap {
    float corner[2] = {0, 0}; ///< where the first texel begins
    float texels_a_unit[2] = {1, 1};
    float near_scale = 1.0F;     ///< 1 / the height up to which surfaces are taken to be near it
    float step_before = 0.0F;    ///< how far before upright faces they look at the ground
    const float* open = nullptr; ///< row by row along x, 0 to 1; null: not known
};

/// Unit vectors toward the light from all around, each for an equal part of it.
inline constexpr int ground_directions = 256;
struct GroundDirections {
    float toward[ground_directions][3];
    int count; ///< of those that are used
};

/// Everything that the ray loops need for one picture; plain numbers and pointers, because the
/// loops are compiled several times, for several processors.
struct FrameSetup {
    int width = 0;
    int height = 0;
    CameraRays rays;

    RTCScene scene = nullptr; ///< null: no surfaces
    /// By instance; null when the scene has none. Then the first surface is the sole one.
    const std::uint32_t* first_surfaces = nullptr;
    std::int32_t sole_first_surface = 0;
    const RaySurface* surfaces = nullptr;
    float scene_min[3] = {0, 0, 0};
    float scene_max[3] = {0, 0, 0};
    float scene_size = 0.0F; ///< diagonal of that box

    /// Whether the triangles' own normals must have unit length: shadows and the free sky go by
    /// them, while shading alone asks for their side.
    bool needs_unit_faces = true;
    bool base_colors = true; ///< else every surface has plain_albedo
    bool textures = false;   ///< textures and vertex colours
    float plain_albedo[3] = {1, 1, 1};
    FrameLayers layers;
    bool has_see_through = false; ///< surfaces of see-through materials are drawn so
    bool has_one_sided = false;   ///< the backs of some surfaces are not seen
    bool has_looks = false;       ///< some surfaces look like more than their base colours
    bool has_mirrors = false;     ///< some of these mirror
    bool mirrors_scene = false;   ///< smooth ones show the scene itself, not only what lies around

    /// The light that surfaces give off is to be multiplied by it; that of all lights here is.
    float exposure = 1.0F;
    float ambient_base[3] = {0, 0, 0};
    float ambient_slope[3][3] = {};
    bool has_ambient_square = false;
    float ambient_square[3][5] = {}; ///< see AmbientLight
    int fixed_count = 0;
    FrameLight fixed[max_fixed_lights] = {};
    int sun_count = 0;
    FrameLight suns[max_suns] = {};
    int lamp_count = 0;
    FrameLamp lamps[max_lamps] = {};

    bool has_ground = false;
    bool catches_shadows = false; ///< the ground looks as what is behind it, which shadows darken
    float ground_height = 0.0F;
    float ground_center[2] = {0, 0};
    float ground_fade_start = 0.0F; ///< distance from the centre
    float ground_fade_end = 1.0F;
    float ground_albedo[3] = {0.5F, 0.5F, 0.5F};
    float ground_light[3] = {0, 0, 0}; ///< that it sends where nothing shadows it
    FrameGroundMap ground_map;
    float ground_eye = 0.0F; ///< how high the middle of the scene is taken to lie over it

    bool has_sky = false;              ///< what lies around is seen, else a background
    bool has_clear_background = false; ///< pixels have an opacity; the background is black
    float background_top[3] = {1, 1, 1};
    float background_bottom[3] = {1, 1, 1};
    float shown_top[3] = {1, 1, 1}; ///< the background as it is shown, in linear light
    float shown_bottom[3] = {1, 1, 1};
    float sky_horizon[3] = {1, 1, 1};
    float sky_side[3] = {0, 0, 0}; ///< see Sky
    float sky_zenith[3] = {1, 1, 1};
    float sky_nadir[3] = {1, 1, 1};
    float sky_glow[3] = {0, 0, 0};
    float sky_disc[3] = {0, 0, 0};
    float toward_sun[3] = {0, 0, 1};
    int soft_box_count = 0;
    FrameSoftBox soft_boxes[max_soft_boxes] = {}; ///< not seen behind the scene
    FramePicture picture;                         ///< instead of sky and soft boxes
    /// What surfaces mirror of what lies around, see EnvironmentMap.h; null when none does.
    float* environment = nullptr;
    const std::uint32_t* environment_pairs = nullptr; ///< the same, in pairs
    const float* split_sum = nullptr;                 ///< SplitSum::entries()

    float sky_reach = 0.0F; ///< how far surfaces hide the sky from others; 0: not at all
    const SkyTable* sky_table = nullptr;
    int sky_width = 0;              ///< places of the grid in a row
    int sky_height = 0;             ///< rows of the grid
    SkyPlace* sky_places = nullptr; ///< by place, row by row
    float* free_sky = nullptr;      ///< by place, 0 to 1

    const std::uint32_t* display_table = nullptr; ///< DisplayTable::entries()
    const std::uint32_t* shown_light = nullptr;   ///< ShownLight::entries()

    std::uint32_t* pixels = nullptr; ///< width * height, bytes r, g, b, a in memory
    float* nearness = nullptr;       ///< see DepthImage; null when nobody asks
    /// For each pixel how near its first layers are, `layers_kept` of them, 0 where there are
    /// fewer; null when nobody asks.
    float* layer_nearness = nullptr;
    std::uint32_t* objects = nullptr; ///< surface index + 1, or 0; null when nobody asks
};

/// How visible a change of colour from pixel to pixel must be for an edge, in steps of a channel's
/// 255.
inline constexpr int visible_step = 14;
inline constexpr int visible_step_in_mirror = 24;

/// A part of the picture, in pixels; the upper left corner lies on a tile's corner.
struct PixelBlock {
    int x_begin = 0;
    int y_begin = 0;
    int x_end = 0;
    int y_end = 0;
};

/// Up to 16 places of the picture to look at, and what is seen there.
struct SamplePacket {
    alignas(64) float x[lane_count] = {}; ///< continuous pixels
    alignas(64) float y[lane_count] = {};
    alignas(64) std::uint32_t pixels[lane_count] = {};
    alignas(64) std::uint32_t objects[lane_count] = {};
    int count = 0;
};

/// The ray loops, compiled for one kind of processor. All give the same pixels.
struct RayKernel {
    const char* name;
    void (*trace_block)(const FrameSetup& frame, const PixelBlock& block);
    void (*trace_samples)(const FrameSetup& frame, SamplePacket& samples);
    /// A bit for each of up to 64 pixels from offset `row` on, the lowest for the first: whether it
    /// differs visibly, in colour or object, from its match in those from `other` on.
    std::uint64_t (*find_steps)(const FrameSetup& frame, std::size_t row, std::size_t other,
                                int count);
    /// Fills `sky_places` and `free_sky` of a block, which is given in places of the grid. What a
    /// place finds is rough; the places of a tile together are right.
    void (*find_free_sky)(const FrameSetup& frame, const PixelBlock& block);
    /// Fills a row of picture `level` of `environment`, from 1 on; the one before must be whole.
    void (*find_environment)(const FrameSetup& frame, const EnvironmentSamples& samples, int level,
                             int row);
    /// What rough surfaces see of all that lies around and of the ground in sixteen directions of
    /// unit length; rows are x, y, z and r, g, b.
    void (*find_light_around)(const FrameSetup& frame, const float (&directions)[3][lane_count],
                              float (&colors)[3][lane_count]);
    /// Fills a row of a ground map, whose place is in `frame`.
    void (*find_open_ground)(const FrameSetup& frame, const GroundDirections& directions, int row,
                             float* open);
};

/// The loops for the instruction set in force (InstructionSet.h).
const RayKernel& rayKernelInForce();

extern const RayKernel baseline_ray_kernel; ///< any x86-64
extern const RayKernel avx2_ray_kernel;     ///< x86-64-v3
extern const RayKernel avx512_ray_kernel;   ///< x86-64-v4

} // namespace quarn
