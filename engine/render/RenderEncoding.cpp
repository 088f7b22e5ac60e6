#include "engine/render/RenderEncoding.h"

#include "engine/display/DisplayTable.h"
#include "engine/display/ShownLight.h"
#include "engine/render/LightFilter.h"
#include "engine/render/RenderLayers.h"
#include "engine/scene/SrgbCurve.h"

#include <tbb/parallel_for.h>

#include <algorithm>
#include <bit>
#include <vector>

namespace quarn {

namespace {

using Colors = std::vector<float>; ///< three numbers a pixel

template <class Work> void forRows(const RenderLayers& layers, const Work& work) {
    tbb::parallel_for(0, layers.height(), [&](int y) {
        const std::size_t start =
            static_cast<std::size_t>(y) * static_cast<std::size_t>(layers.width());
        for (int x = 0; x < layers.width(); ++x)
            work(start + static_cast<std::size_t>(x), x, y);
    });
}

/// From the sums of a pixel to their means; 0 where there are none.
float meanScale(const RenderLayers& layers, int x, int y) {
    const int samples = layers.samplesAt(x, y);
    return samples > 0 ? 1.0F / static_cast<float>(samples) : 0.0F;
}

void addDirect(const RenderLayers& layers, Colors& colors) {
    forRows(layers, [&](std::size_t pixel, int x, int y) {
        const float scale = meanScale(layers, x, y);
        for (int c = 0; c < 3; ++c)
            colors[3 * pixel + static_cast<std::size_t>(c)] =
                scale * layers.at(RenderPlane::direct_r + c, x, y);
    });
}

/// Ground that shows shadows alone is kept apart.
/// @param caught  takes its light, of 1 where nothing shadows it
void addLight(const RenderLayers& layers, const LightImage& light, Colors& colors, Colors& caught) {
    forRows(layers, [&](std::size_t pixel, int x, int y) {
        const float scale = meanScale(layers, x, y);
        for (int c = 0; c < 3; ++c) {
            const float arriving = scale * light.color[c].row(y)[x];
            const float catcher = layers.at(RenderPlane::catcher_r + c, x, y);
            const std::size_t at = 3 * pixel + static_cast<std::size_t>(c);
            colors[at] += arriving * (layers.at(RenderPlane::albedo_r + c, x, y) - catcher);
            caught[at] += arriving * catcher;
        }
    });
}

void addGloss(const RenderLayers& layers, const LightImage& light, Colors& colors) {
    forRows(layers, [&](std::size_t pixel, int x, int y) {
        const float cover = meanScale(layers, x, y) * layers.at(RenderPlane::cover, x, y);
        for (int c = 0; c < 3; ++c)
            colors[3 * pixel + static_cast<std::size_t>(c)] += cover * light.color[c].row(y)[x];
    });
}

bool hasGloss(const RenderLayers& layers) {
    for (int y = 0; y < layers.height(); ++y)
        for (int x = 0; x < layers.width(); ++x)
            if (layers.at(RenderPlane::gloss_square, x, y) > 0.0F)
                return true;
    return false;
}

std::uint8_t shown(float light, const std::uint32_t* table) {
    const auto place = static_cast<int>(std::bit_cast<std::uint32_t>(std::max(light, 0.0F)) >>
                                        DisplayTable::shift) -
                       DisplayTable::first;
    return static_cast<std::uint8_t>(table[std::clamp(place, 0, DisplayTable::count - 1)]);
}

/// The part of the light that is left on ground that shows shadows alone.
/// @param caught  see addLight
float leftOf(float ground, float caught) {
    return std::clamp(caught / ground, 0.0F, 1.0F);
}

float lightShownAs(float color) {
    const auto step =
        static_cast<std::size_t>(color * static_cast<float>(ShownLight::steps) + 0.5F);
    return std::bit_cast<float>(shownLight().entries()[step]);
}

/// The background at a height of the picture as it is shown, see Background.h.
float backgroundAt(const FrameSetup& frame, int y, std::size_t channel) {
    const float s = (static_cast<float>(y) + 0.5F) / static_cast<float>(frame.height);
    const float t = s * s * (3.0F - 2.0F * s);
    const float top = frame.shown_top[channel];
    return top + t * (frame.shown_bottom[channel] - top);
}

/// Lays ground that shows shadows alone under the rest: it looks like the background, of which
/// shadows take.
void addCatcher(const RenderLayers& layers, const FrameSetup& frame, int x, int y,
                const float* caught, float* color) {
    const float ground = meanScale(layers, x, y) * layers.at(RenderPlane::catcher, x, y);
    for (std::size_t c = 0; c < 3 && ground > 0.0F; ++c)
        color[c] += ground * lightShownAs(backgroundAt(frame, y, c) * leftOf(ground, caught[c]));
}

/// How opaque a pixel is before nothing. A shadow is black, and as dark as on white when pictures
/// are laid over each other by the numbers of their pixels.
float opacityOf(const RenderLayers& layers, int x, int y, const float* caught) {
    const float scale = meanScale(layers, x, y);
    const float ground = scale * layers.at(RenderPlane::catcher, x, y);
    const float nothing = scale * layers.at(RenderPlane::nothing, x, y);
    float shadow = 0.0F;
    if (ground > 0.0F) {
        const float bright = 0.2126F * caught[0] + 0.7152F * caught[1] + 0.0722F * caught[2];
        shadow = ground * (1.0F - srgbFromLinear(leftOf(ground, bright)));
    }
    return std::clamp(1.0F - nothing - ground + shadow, 0.0F, 1.0F);
}

/// Colours are not multiplied by the opacity.
void showBeforeNothing(const RenderLayers& layers, int x, int y, const float* color,
                       const float* caught, std::uint8_t* pixel) {
    const float opacity = opacityOf(layers, x, y, caught);
    const auto alpha = static_cast<std::uint8_t>(opacity * 255.0F + 0.5F);
    for (int c = 0; c < 3; ++c)
        pixel[c] =
            alpha > 0 ? shown(color[c] / opacity, displayTable().entries()) : std::uint8_t{0};
    pixel[3] = alpha;
}

/// @param color   the light of a pixel, without ground that shows shadows alone
/// @param caught  see addLight
void showPixel(const RenderLayers& layers, const FrameSetup& frame, int x, int y, float* color,
               const float* caught, std::uint8_t* pixel) {
    if (frame.has_clear_background) {
        showBeforeNothing(layers, x, y, color, caught, pixel);
        return;
    }
    if (frame.catches_shadows && !frame.has_sky)
        addCatcher(layers, frame, x, y, caught, color);
    for (int c = 0; c < 3; ++c)
        pixel[c] = shown(color[c], displayTable().entries());
    pixel[3] = 255;
}

/// The light that the samples of a pixel found, as it is.
/// @param caught  see addLight
void readUnfiltered(const RenderLayers& layers, int x, int y, float (&color)[3],
                    float (&caught)[3]) {
    const float scale = meanScale(layers, x, y);
    float sum[3];
    float albedo[3];
    float light[3];
    for (int c = 0; c < 3; ++c) {
        sum[c] = layers.at(RenderPlane::sky_r + c, x, y) + layers.at(RenderPlane::sun_r + c, x, y);
        albedo[c] = layers.at(RenderPlane::albedo_r + c, x, y);
    }
    withoutAlbedo(sum, albedo, light);
    for (int c = 0; c < 3; ++c) {
        const float on_catcher = light[c] * layers.at(RenderPlane::catcher_r + c, x, y);
        caught[c] = scale * on_catcher;
        color[c] = scale * (layers.at(RenderPlane::direct_r + c, x, y) +
                            layers.at(RenderPlane::gloss_r + c, x, y) + sum[c] - on_catcher);
    }
}

/// Of pixels that nothing is known of, in sRGB.
constexpr std::uint8_t not_begun = 60;

} // namespace

void encodeRow(const RenderLayers& layers, const FrameSetup& frame, int y, Image& image) {
    std::uint8_t* pixel = image.rgba.data() + std::size_t{4} * static_cast<std::size_t>(y) *
                                                  static_cast<std::size_t>(image.width);
    for (int x = 0; x < image.width; ++x, pixel += 4) {
        if (layers.samplesAt(x, y) == 0) {
            std::fill_n(pixel, 3, not_begun);
            pixel[3] = 255;
            continue;
        }
        float color[3];
        float caught[3];
        readUnfiltered(layers, x, y, color, caught);
        showPixel(layers, frame, x, y, color, caught, pixel);
    }
}

void encodeRender(const RenderLayers& layers, const FrameSetup& frame, LightFilter& filter,
                  Image& image) {
    Colors colors(std::size_t{3} * static_cast<std::size_t>(layers.width()) *
                  static_cast<std::size_t>(layers.height()));
    Colors caught(colors.size());
    addDirect(layers, colors);
    constexpr LightSums diffuse[] = {sky_sums, sun_sums};
    for (const LightImage& light : filter.filtered(diffuse))
        addLight(layers, light, colors, caught);
    if (hasGloss(layers))
        addGloss(layers, filter.filtered({&gloss_sums, 1}).front(), colors);
    image.resize(layers.width(), layers.height());
    forRows(layers, [&](std::size_t pixel, int x, int y) {
        showPixel(layers, frame, x, y, colors.data() + 3 * pixel, caught.data() + 3 * pixel,
                  image.rgba.data() + 4 * pixel);
    });
}

} // namespace quarn
