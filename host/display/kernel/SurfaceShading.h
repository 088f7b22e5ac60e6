#pragma once

#include "host/display/kernel/SunShadow.h"

namespace quarn {
namespace {

inline void cosines(const LaneVectors& normal, const float (&toward)[3], Lanes& cosine) {
    for (int i = 0; i < lane_count; ++i)
        cosine.v[i] = greatest(0.0F, normal.x.v[i] * toward[0] + normal.y.v[i] * toward[1] +
                                         normal.z.v[i] * toward[2]);
}

inline void addLight(const float (&color)[3], const Lanes& amount, LaneColors& light) {
    for (int i = 0; i < lane_count; ++i) {
        light.r.v[i] += color[0] * amount.v[i];
        light.g.v[i] += color[1] * amount.v[i];
        light.b.v[i] += color[2] * amount.v[i];
    }
}

inline void ambientLight(const FrameSetup& frame, const LaneVectors& normal, LaneColors& light) {
    const auto& base = frame.ambient_base;
    const auto& slope = frame.ambient_slope;
    for (int i = 0; i < lane_count; ++i) {
        const float x = normal.x.v[i];
        const float y = normal.y.v[i];
        const float z = normal.z.v[i];
        light.r.v[i] = base[0] + slope[0][0] * x + slope[0][1] * y + slope[0][2] * z;
        light.g.v[i] = base[1] + slope[1][0] * x + slope[1][1] * y + slope[1][2] * z;
        light.b.v[i] = base[2] + slope[2][0] * x + slope[2][1] * y + slope[2][2] * z;
    }
}

/// The light that diffuse surfaces send to the observer, in the lanes of `lit`.
inline void shadeSurfaces(const FrameSetup& frame, const RayPacket& packet,
                          const SurfaceLanes& surfaces, const LaneMask& lit, LaneColors& color) {
    LaneColors light;
    ambientLight(frame, surfaces.normal, light);
    Lanes cosine;
    for (int k = 0; k < frame.fixed_count; ++k) {
        cosines(surfaces.normal, frame.fixed[k].toward, cosine);
        addLight(frame.fixed[k].color, cosine, light);
    }
    Lanes arriving;
    for (int k = 0; k < frame.sun_count; ++k) {
        cosines(surfaces.normal, frame.suns[k].toward, cosine);
        sunShadow(frame, frame.suns[k], packet, surfaces, lit, cosine, arriving);
        for (int i = 0; i < lane_count; ++i)
            cosine.v[i] *= arriving.v[i];
        addLight(frame.suns[k].color, cosine, light);
    }
    for (int i = 0; i < lane_count; ++i) {
        color.r.v[i] = surfaces.albedo.r.v[i] * light.r.v[i];
        color.g.v[i] = surfaces.albedo.g.v[i] * light.g.v[i];
        color.b.v[i] = surfaces.albedo.b.v[i] * light.b.v[i];
    }
}

} // namespace
} // namespace quarn
