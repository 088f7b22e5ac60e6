#include "engine/render/TintedLight.h"

#include "engine/display/MipTexture.h"
#include "engine/display/OpacityFilter.h"
#include "kelmar/KM_Mesh.h"
#include "kelmar/KM_Point.h"

#include <algorithm>

namespace quarn {

namespace {

/// What is darker than this no eye sees on the ground.
constexpr float least_passed = 1.0F / 512.0F;

struct HitPlace {
    unsigned triangle;
    float u;
    float v;
};

/// The base colour of a surface at a place of one of its triangles, by full size textures.
void colorAt(const RaySurface& surface, const HitPlace& place, float (&color)[3]) {
    std::copy_n(surface.albedo, 3, color);
    if (!surface.colors && !surface.texture)
        return;
    const std::uint32_t* const vertex = surface.triangles[place.triangle].vi;
    const float weight[3] = {1.0F - place.u - place.v, place.u, place.v};
    LinearColor mean{0.0F, 0.0F, 0.0F};
    float s = 0.0F;
    float t = 0.0F;
    for (int corner = 0; corner < 3; ++corner) {
        if (surface.colors) {
            const LinearColor c = linearFromColor(surface.colors[vertex[corner]]);
            mean.r += weight[corner] * c.r;
            mean.g += weight[corner] * c.g;
            mean.b += weight[corner] * c.b;
        }
        if (surface.texture && surface.texture_coordinates) {
            s += weight[corner] * surface.texture_coordinates[vertex[corner]].x;
            t += weight[corner] * surface.texture_coordinates[vertex[corner]].y;
        }
    }
    const auto multiply = [&](const LinearColor& by) {
        color[0] *= by.r;
        color[1] *= by.g;
        color[2] *= by.b;
    };
    if (surface.colors)
        multiply(mean);
    if (surface.texture && surface.texture_coordinates)
        multiply(surface.texture->sample(s, t, 0.0F).color);
}

const RaySurface& surfaceMet(const FrameSetup& frame, const RTCFilterFunctionNArguments& arguments,
                             unsigned index) {
    const unsigned geometry = RTCHitN_geomID(arguments.hit, arguments.N, index);
    if (!frame.first_surfaces)
        return frame.surfaces[static_cast<unsigned>(frame.sole_first_surface) + geometry];
    const unsigned instance = RTCHitN_instID(arguments.hit, arguments.N, index, 0);
    return frame.surfaces[frame.first_surfaces[instance] + geometry];
}

/// @return false when next to nothing is left
bool dim(TintedLight& light, unsigned lane, const RaySurface& surface, const HitPlace& place) {
    const float opacity = opacityAt(surface, place.triangle, place.u, place.v);
    float color[3];
    colorAt(surface, place, color);
    const float brightest = std::max({color[0], color[1], color[2]});
    float most = 0.0F;
    for (int c = 0; c < 3; ++c) {
        const float hue = brightest > 0.0F ? color[c] / brightest : 1.0F;
        float& passed = light.passed[c][lane];
        passed *= passedByPane(opacity, hue);
        most = std::max(most, passed);
    }
    return most > least_passed;
}

/// Called for every surface that did not let the ray pass by itself.
void tint(const RTCFilterFunctionNArguments* arguments) {
    TintedLight& light = *reinterpret_cast<TintedLight*>(arguments->context);
    for (unsigned i = 0; i < arguments->N; ++i) {
        if (arguments->valid[i] == 0)
            continue;
        const RaySurface& surface = surfaceMet(*light.frame, *arguments, i);
        if (!surface.see_through)
            continue;
        const HitPlace place{RTCHitN_primID(arguments->hit, arguments->N, i),
                             RTCHitN_u(arguments->hit, arguments->N, i),
                             RTCHitN_v(arguments->hit, arguments->N, i)};
        const unsigned lane = RTCRayN_id(arguments->ray, arguments->N, i) - first_tinted_id;
        if (dim(light, lane, surface, place))
            arguments->valid[i] = 0;
    }
}

} // namespace

float passedByPane(float opacity, float hue) {
    return (1.0F - opacity) * (1.0F - opacity * (1.0F - hue));
}

void startTintedLight(const FrameSetup& frame, TintedLight& light, RTCRay16& rays) {
    rtcInitIntersectContext(&light.context);
    light.context.filter = tint;
    light.frame = &frame;
    for (auto& channel : light.passed)
        std::fill_n(channel, lane_count, 1.0F);
    for (unsigned i = 0; i < lane_count; ++i)
        rays.id[i] = first_tinted_id + i;
}

} // namespace quarn
