#pragma once

namespace quarn {

/// Light that comes from far away on all sides, for surfaces to mirror: pictures of it, each as a
/// surface of some roughness mirrors it. A picture is a square of texels, an octahedron folded open
/// (T. Engelhardt and C. Dachsbacher, "Octahedron Environment Maps", VMV 2008), with a border of
/// one texel that repeats what lies across the edge.
namespace environment_map {
inline constexpr int side = 48; ///< texels without the border
inline constexpr int stride = side + 2;
inline constexpr int texels = stride * stride; ///< of one channel; red comes first, blue last
/// Picture i, from 1 on, is for roughness i / levels. A perfect mirror needs none.
inline constexpr int levels = 6;
/// Channels of pictures follow each other.
inline constexpr int channels = 3;
inline constexpr int floats = levels * channels * texels;
/// How many directions a texel's light is summed up from.
inline constexpr int samples = 32;
} // namespace environment_map

/// A picture of all that lies around is kept the same way, once sharp and once for rough surfaces;
/// channels follow each other.
template <int texels_a_side> struct SquareMap {
    static constexpr int side = texels_a_side; ///< texels without the border
    static constexpr int stride = side + 2;
    static constexpr int texels = stride * stride; ///< of one channel
    static constexpr int floats = environment_map::channels * texels;
};
using PictureMap = SquareMap<1024>;
using BroadMap = SquareMap<64>;

/// The directions that a texel's light comes from, about (0, 0, 1), and how much each counts.
struct EnvironmentSamples {
    float x[environment_map::samples];
    float y[environment_map::samples];
    float z[environment_map::samples];
    float weight[environment_map::samples]; ///< together 1
};

} // namespace quarn
