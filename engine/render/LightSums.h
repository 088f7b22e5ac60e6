#pragma once

#include "engine/render/kernel/RenderSetup.h"

namespace quarn {

/// One kind of light among the sums of a picture, and how its noise is smoothed.
struct LightSums {
    int first;         ///< its red
    int square;        ///< the square of its brightness
    bool times_albedo; ///< the surfaces' own colours are in it
    /// It changes with the surfaces more than on them, see LightFit. Light with sharp borders
    /// across surfaces does not.
    bool follows_surfaces;
    float spread; ///< squared differences of up to so many variances are taken for noise
};

/// Few samples scatter less than their variance says, which knows nothing of how well spread they
/// are: the suns' least of all, most of which see the whole of a sun or nothing of it.
inline constexpr LightSums sky_sums{RenderPlane::sky_r, RenderPlane::sky_square, true, true, 9.0F};
inline constexpr LightSums sun_sums{RenderPlane::sun_r, RenderPlane::sun_square, true, false, 1.0F};
inline constexpr LightSums gloss_sums{RenderPlane::gloss_r, RenderPlane::gloss_square, false, false,
                                      9.0F};

/// Light of a pixel without albedo. A channel in which the surface is black takes the light of the
/// channel in which it is brightest.
inline void withoutAlbedo(const float (&sum)[3], const float (&albedo)[3], float (&light)[3]) {
    constexpr float least_albedo = 0.02F; // below it a channel tells nothing of the light
    int brightest = albedo[1] > albedo[0] ? 1 : 0;
    brightest = albedo[2] > albedo[brightest] ? 2 : brightest;
    const float sure = albedo[brightest] > 0.0F ? sum[brightest] / albedo[brightest] : 0.0F;
    for (int c = 0; c < 3; ++c)
        light[c] = albedo[c] > least_albedo * albedo[brightest] ? sum[c] / albedo[c] : sure;
}

} // namespace quarn
