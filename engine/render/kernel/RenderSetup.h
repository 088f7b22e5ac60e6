#pragma once

#include "engine/display/SplitSum.h"
#include "engine/display/kernel/FrameSetup.h"

#include <cstddef>
#include <cstdint>

namespace quarn {

/// The beginning of a sequence of well-spread places in the unit square, by SampleSequence.
struct SampleTable {
    const std::uint32_t* first = nullptr;  ///< 2^log2_length numbers, in the order of reversed bits
    const std::uint32_t* second = nullptr; ///< the same number of them
    int log2_length = 1;
};

/// What a sample of a pixel needs places in a square for: the first for its own place, and then
/// three for each surface that it comes to. What surfaces farther on need is less well spread.
enum class SampleUse : int { pixel_area, direction, light, choice };
inline constexpr int uses_of_surface = 3;
inline constexpr int surfaces_well_spread = 2;
inline constexpr int sample_use_count = 1 + uses_of_surface * surfaces_well_spread;

/// Where the sixteen pixels of a tile stand in the sequence: each has a stretch of its own.
struct TileSamples {
    alignas(64) std::uint32_t order[sample_use_count][lane_count];
    alignas(64) std::uint32_t first[sample_use_count][lane_count];
    alignas(64) std::uint32_t second[sample_use_count][lane_count];
};

/// Finds the stretches of the tile whose upper left pixel is (x, y). Neighbouring pixels get
/// stretches that complete each other, so that what is left of the noise is fine-grained (A. Ahmed
/// and P. Wonka, "Screen-Space Blue-Noise Diffusion of Monte Carlo Sampling Error via Hierarchical
/// Ordering of Pixels", ACM Transactions on Graphics 39(6), 2020).
void startTile(int x, int y, int log2_length, TileSamples& samples);

/// A sun's disc: any point of it lies at toward + x * across + y * along, with x * x + y * y <= 1.
struct SunDisc {
    float across[3];
    float along[3];
};

/// How the light from infinitely far away is spread, see EnvironmentLight.h.
struct EnvironmentTable {
    static constexpr int side = 128;
    const float* rows = nullptr;    ///< side + 1 numbers from 0 to 1; null: it is even enough
    const float* cells = nullptr;   ///< of each row the same
    const float* density = nullptr; ///< of each cell, by area of the square from -1 to 1
};

/// A triangle that shines, in the frame's coordinates.
struct Emitter {
    float corner[3];
    float edges[2][3]; ///< to the other corners
    float normal[3];   ///< of unit length
    float density;     ///< of the places that are chosen, by area
};

struct EmitterTable {
    int count = 0;
    const Emitter* emitters = nullptr;
    const float* ends = nullptr; ///< of each the chance of all up to it; the last is 1
    /// From a surface's brightness to the density of places on it.
    float density_of_brightness = 0.0F;
};

/// Everything that the render loops need for one picture.
struct RenderSetup {
    FrameSetup frame; ///< what is seen directly
    /// How surfaces look that light comes from: without the light that follows the camera.
    FrameSetup bounce;
    float sky_scale[3] = {1, 1, 1}; ///< from the colour of the sky to the light it sheds
    EnvironmentTable environment;
    EmitterTable emitters;
    /// The means of SplitSum's rows over all directions, by their cosine.
    float mean_a[SplitSum::side] = {};
    float mean_b[SplitSum::side] = {};
    SunDisc discs[max_suns] = {}; ///< of frame.suns
    SampleTable samples;
};

/// What is summed up over the samples of a pixel.
struct RenderPlane {
    enum : int {
        direct_r,
        direct_g,
        direct_b, ///< what needs no sampling, and the background
        albedo_r,
        albedo_g,
        albedo_b,
        sky_r,
        sky_g,
        sky_b, ///< light of the sky and of other surfaces, times albedo
        sun_r,
        sun_g,
        sun_b,      ///< light of the suns, times albedo
        sky_square, ///< square of the sky light's brightness, without albedo
        sun_square,
        normal_x,
        normal_y,
        normal_z,
        nearness, ///< see DepthImage
        cover,    ///< how much of the pixel surfaces and the ground fill
        gloss_r,
        gloss_g,
        gloss_b,      ///< light that surfaces mirror or let through; no albedo is taken out of it
        gloss_square, ///< square of its brightness
        // Brightness of what the samples with even numbers add alone: by how much it differs from
        // that of the others tells how far the mean of all may be from the truth.
        even_direct,
        even_albedo,
        even_sky,
        even_sun,
        even_gloss,
        nothing, ///< how much of the pixel shows a clear background
        catcher, ///< how much of it ground that shows shadows alone
        catcher_r,
        catcher_g,
        catcher_b, ///< albedo of that ground, whose light is 1 where nothing shadows it
        samples,   ///< how many there are, the same for all pixels of a tile
        count
    };
};

/// The sums, tile by tile in rows of tiles, and in each tile the sixteen pixels row by row.
struct RenderSums {
    int tile_columns = 0;
    const std::uint8_t* done = nullptr; ///< not 0 for tiles that need no more; null: none is done
    float* planes[RenderPlane::count] = {}; ///< aligned to 64 bytes
};

/// What a light filter's pass knows of the surfaces that pixels show.
struct FilterGuides {
    const float* normal[3] = {};     ///< unit vectors; zero where nothing is
    const float* nearness = nullptr; ///< linear on flat surfaces
    const float* slope_x = nullptr;  ///< its change from pixel to pixel
    const float* slope_y = nullptr;
    const float* tolerance = nullptr; ///< 1 / how far nearness may be off a plane
    const float* cover = nullptr;     ///< how much of a pixel surfaces fill; 0 beside rows
};

/// Light that a pass smooths.
struct FilterLight {
    const float* color[3] = {};
    const float* variance = nullptr; ///< of its brightness
    float* out[3] = {};
    float* out_variance = nullptr;
    bool across_surfaces = false; ///< it is averaged over edges too
    float spread = 1.0F; ///< squared difference of brightness over variance where weights end
};

inline constexpr int most_filter_lights = 2;

/// One row of a light filter's pass. Pointers are to the row's first pixel, in planes that have
/// some numbers more on both sides of each row (PixelPlane).
struct FilterRow {
    int width = 0;
    int height = 0;
    int y = 0;
    int step = 1;              ///< distance between the pixels that are looked at
    std::ptrdiff_t stride = 0; ///< of all planes
    FilterGuides guides;
    FilterLight lights[most_filter_lights];
    int light_count = 1;
};

/// The render loops, compiled for one kind of processor. All give the same pixels.
struct RenderKernel {
    const char* name;
    /// Adds the samples [first, end) of the pixels of a block to the sums, but of tiles that are
    /// done.
    void (*render_block)(const RenderSetup& setup, const PixelBlock& block, int first, int end,
                         const RenderSums& sums);
    /// Averages one row of pixels with those around that show the same surface.
    void (*filter_row)(const FilterRow& row);
    /// The light from far away in sixteen directions of unit length, see lightAround; rows are x,
    /// y, z and r, g, b.
    void (*light_around)(const FrameSetup& frame, const float (&directions)[3][lane_count],
                         float (&colors)[3][lane_count]);
};

/// The loops for the instruction set in force (InstructionSet.h).
const RenderKernel& renderKernelInForce();

extern const RenderKernel baseline_render_kernel; ///< any x86-64
extern const RenderKernel avx2_render_kernel;     ///< x86-64-v3
extern const RenderKernel avx512_render_kernel;   ///< x86-64-v4

} // namespace quarn
