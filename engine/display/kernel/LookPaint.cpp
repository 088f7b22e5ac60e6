#include "engine/display/kernel/LookPaint.h"

#include "engine/display/SurfacePlace.h"
#include "engine/display/kernel/TexturePlace.h"
#include "kelmar/KM_Mesh.h"

#include <algorithm>
#include <cmath>

namespace quarn {

namespace {

/// Below it a texel says nothing about a direction.
constexpr float LEAST_LENGTH = 0.01F;

struct Vector {
    float x = 0.0F;
    float y = 0.0F;
    float z = 0.0F;
};

Vector sum(const Vector& a, float s, const Vector& b, float t) {
    return {a.x * s + b.x * t, a.y * s + b.y * t, a.z * s + b.z * t};
}

float dot(const Vector& a, const Vector& b) {
    return a.x * b.x + a.y * b.y + a.z * b.z;
}

Vector cross(const Vector& a, const Vector& b) {
    return {a.y * b.z - a.z * b.y, a.z * b.x - a.x * b.z, a.x * b.y - a.y * b.x};
}

/// @return false for a vector without a direction
bool unitize(Vector& v) {
    const float longest = std::max({std::fabs(v.x), std::fabs(v.y), std::fabs(v.z)});
    if (!(longest > 0.0F) || !std::isfinite(longest))
        return false;
    v = sum(v, 1.0F / longest, v, 0.0F);
    v = sum(v, 1.0F / std::sqrt(dot(v, v)), v, 0.0F);
    return true;
}

/// Where the first coordinate of a triangle's texture grows on it, and where the second does.
struct Tangents {
    Vector u;
    Vector v;
};

/// @return false where the texture is a line or a point on the triangle
bool findTangents(const RaySurface& surface, const LookTexture& texture, std::size_t triangle,
                  Tangents& tangents) {
    const std::uint32_t* const vertex = surface.triangles[triangle].vi;
    const auto edge = [&](int corner) {
        const KM_3fPoint& from = surface.vertices[vertex[0]];
        const KM_3fPoint& to = surface.vertices[vertex[corner]];
        float v[3] = {to.x - from.x, to.y - from.y, to.z - from.z};
        if (surface.place)
            turn(surface.place->linear, {v[0], v[1], v[2]}, v);
        return Vector{v[0], v[1], v[2]};
    };
    const auto step = [&](int corner, const float(&row)[3]) {
        const KM_2fPoint& from = surface.texture_coordinates[vertex[0]];
        const KM_2fPoint& to = surface.texture_coordinates[vertex[corner]];
        return row[0] * (to.x - from.x) + row[1] * (to.y - from.y);
    };
    const float u[2] = {step(1, texture.u), step(2, texture.u)};
    const float v[2] = {step(1, texture.v), step(2, texture.v)};
    const float side = u[0] * v[1] - u[1] * v[0] < 0.0F ? -1.0F : 1.0F;
    tangents.u = sum(edge(1), side * v[1], edge(2), -side * v[0]);
    tangents.v = sum(edge(2), side * u[0], edge(1), -side * u[1]);
    return unitize(tangents.u) && unitize(tangents.v);
}

/// Turns the normal as the map says, in the frame of normal and tangents. A bump seen from behind
/// is a dent.
void bendNormal(const RaySurface& surface, const RTCRayHit16& rays, int lane,
                const LookTexture& map, const TextureSample& sample, float scale,
                float (&normal)[3]) {
    const Vector bend{scale * (2.0F * sample.color.r - 1.0F),
                      scale * (2.0F * sample.color.g - 1.0F), 2.0F * sample.color.b - 1.0F};
    Tangents tangents;
    if (dot(bend, bend) < LEAST_LENGTH ||
        !findTangents(surface, map, rays.hit.primID[lane], tangents))
        return;
    const Vector n{normal[0], normal[1], normal[2]};
    Vector across = sum(tangents.u, 1.0F, n, -dot(tangents.u, n));
    if (!unitize(across))
        return;
    Vector along = cross(n, across);
    if (dot(along, tangents.v) < 0.0F)
        along = sum(along, -1.0F, along, 0.0F);
    float face[3] = {rays.hit.Ng_x[lane], rays.hit.Ng_y[lane], rays.hit.Ng_z[lane]};
    float front = 1.0F;
    if (surface.place) {
        turn(surface.place->cofactors, {face[0], face[1], face[2]}, face);
        front = surface.place->hand;
    }
    const Vector direction{rays.ray.dir_x[lane], rays.ray.dir_y[lane], rays.ray.dir_z[lane]};
    if (dot({face[0], face[1], face[2]}, direction) > 0.0F)
        front = -front;
    Vector bent = sum(sum(across, front * bend.x, along, front * bend.y), 1.0F, n, bend.z);
    if (!unitize(bent))
        return;
    normal[0] = bent.x;
    normal[1] = bent.y;
    normal[2] = bent.z;
}

void multiply(const LinearColor& by, float (&color)[3]) {
    color[0] *= by.r;
    color[1] *= by.g;
    color[2] *= by.b;
}

void paintMirrors(const TexturePlace& place, const SurfaceLook& look, LookNumbers<float>& numbers) {
    if (look.metal_rough.mips) {
        const TextureSample sample = place.sample(look.metal_rough);
        numbers.roughness *= sample.color.g;
        numbers.metalness *= sample.color.b;
    }
    if (look.specular.mips) {
        const float strength = place.sample(look.specular).alpha;
        numbers.f90 *= strength;
        for (float& number : numbers.f0)
            number *= strength;
    }
    if (look.specular_color.mips)
        multiply(place.sample(look.specular_color).color, numbers.f0);
    if (look.clearcoat.mips)
        numbers.clearcoat *= place.sample(look.clearcoat).color.r;
    if (look.clearcoat_roughness.mips)
        numbers.clearcoat_roughness *= place.sample(look.clearcoat_roughness).color.g;
}

void paintGlass(const TexturePlace& place, const SurfaceLook& look, LookNumbers<float>& numbers) {
    if (look.transmission.mips) {
        const float part = place.sample(look.transmission).color.r;
        numbers.transmission *= part;
        for (float& number : numbers.passing)
            number *= part;
    }
    if (look.thickness.mips) {
        const float part = place.sample(look.thickness).color.g;
        for (int c = 0; c < 3; ++c)
            numbers.passing[c] *= std::exp(-part * look.density[c]);
    }
}

} // namespace

void paintLookAt(const FrameSetup& frame, const RaySurface& surface, const RTCRayHit16& rays,
                 int lane, const float (&place)[3], PaintedLook& painted) {
    const TexturePlace on_texture(frame, surface, rays, lane, place);
    const SurfaceLook& look = *surface.look;
    const auto bend = [&](const LookTexture& map, float scale, float(&normal)[3]) {
        if (map.mips)
            bendNormal(surface, rays, lane, map, on_texture.sample(map), scale, normal);
    };
    bend(look.normals, look.normal_scale, painted.normal);
    bend(look.coat_normals, 1.0F, painted.coat_normal);
    if (look.occlusion.mips) {
        const float open = on_texture.sample(look.occlusion).color.r;
        painted.numbers.occlusion = 1.0F + look.occlusion_strength * (open - 1.0F);
    }
    if (look.emission.mips)
        multiply(on_texture.sample(look.emission).color, painted.numbers.emission);
    paintMirrors(on_texture, look, painted.numbers);
    paintGlass(on_texture, look, painted.numbers);
}

} // namespace quarn
