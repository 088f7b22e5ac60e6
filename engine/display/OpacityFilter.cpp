#include "engine/display/OpacityFilter.h"

#include "engine/display/MipTexture.h"
#include "engine/display/RaySurface.h"
#include "kelmar/KM_Mesh.h"

namespace quarn {

float opacityAt(const RaySurface& surface, unsigned triangle, float u, float v) {
    float opacity = surface.opacity;
    const std::uint32_t* vertex = surface.triangles[triangle].vi;
    const float w = 1.0F - u - v;
    if (surface.colors) {
        const KM_Color* c = surface.colors;
        opacity *=
            (w * static_cast<float>(c[vertex[0]].a) + u * static_cast<float>(c[vertex[1]].a) +
             v * static_cast<float>(c[vertex[2]].a)) /
            255.0F;
    }
    if (surface.texture && surface.texture_coordinates) {
        const KM_2fPoint* t = surface.texture_coordinates;
        const float s = w * t[vertex[0]].x + u * t[vertex[1]].x + v * t[vertex[2]].x;
        const float r = w * t[vertex[0]].y + u * t[vertex[1]].y + v * t[vertex[2]].y;
        opacity *= surface.texture->sample(s, r, 0.0F).alpha;
    }
    return opacity;
}

namespace {

void rejectCutouts(const RTCFilterFunctionNArguments* arguments) {
    const auto& surface = *static_cast<const RaySurface*>(arguments->geometryUserPtr);
    for (unsigned i = 0; i < arguments->N; ++i) {
        if (arguments->valid[i] == 0)
            continue;
        const float opacity = opacityAt(surface, RTCHitN_primID(arguments->hit, arguments->N, i),
                                        RTCHitN_u(arguments->hit, arguments->N, i),
                                        RTCHitN_v(arguments->hit, arguments->N, i));
        if (opacity < surface.alpha_cutoff)
            arguments->valid[i] = 0;
    }
}

/// What comes through a surface of what arrives at it.
float passedBy(const RaySurface& surface, unsigned triangle, float u, float v) {
    const float opacity = surface.see_through ? opacityAt(surface, triangle, u, v) : 1.0F;
    return 1.0F - opacity * (1.0F - surface.passing);
}

/// Rays that ask for it go on behind a see-through surface with less light.
void dimPassingLight(const RTCFilterFunctionNArguments* arguments) {
    const auto& surface = *static_cast<const RaySurface*>(arguments->geometryUserPtr);
    for (unsigned i = 0; i < arguments->N; ++i) {
        const unsigned id = RTCRayN_id(arguments->ray, arguments->N, i);
        if (arguments->valid[i] == 0 || id == 0 || id > PassingLight::count)
            continue;
        const float passed = passedBy(surface, RTCHitN_primID(arguments->hit, arguments->N, i),
                                      RTCHitN_u(arguments->hit, arguments->N, i),
                                      RTCHitN_v(arguments->hit, arguments->N, i));
        reinterpret_cast<PassingLight*>(arguments->context)->passed[id - 1] *= passed;
        arguments->valid[i] = 0;
    }
}

} // namespace

bool setOpacityFilter(RTCGeometry geometry, const RaySurface& surface) {
    if (!surface.has_cutout && !surface.see_through && surface.passing == 0.0F)
        return false;
    // Embree hands the data back to the filters, which only read it.
    rtcSetGeometryUserData(geometry, const_cast<RaySurface*>(&surface));
    if (surface.has_cutout)
        rtcSetGeometryIntersectFilterFunction(geometry, rejectCutouts);
    rtcSetGeometryOccludedFilterFunction(geometry,
                                         surface.has_cutout ? rejectCutouts : dimPassingLight);
    return true;
}

} // namespace quarn
