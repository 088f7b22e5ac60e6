#include "engine/sunhours/PicturePoints.h"

#include "engine/display/DisplayMode.h"
#include "engine/display/DisplayScene.h"
#include "engine/display/FlushDenormals.h"
#include "engine/display/FrameSetupBuilder.h"
#include "engine/display/SurfacePlace.h"
#include "engine/sunhours/GlassFilter.h"
#include "engine/sunhours/MeshNumbers.h"
#include "engine/sunhours/SunPackets.h"

#include <tbb/parallel_for.h>

#include <cmath>

namespace quarn {

namespace {

constexpr std::size_t TILE = 4;

void aim(const CameraRays& camera, std::span<const PicturePlace> places, RTCRay16& rays) {
    float* const origin[3] = {rays.org_x, rays.org_y, rays.org_z};
    float* const direction[3] = {rays.dir_x, rays.dir_y, rays.dir_z};
    for (std::size_t i = 0; i < points_at_once; ++i) {
        const PicturePlace& place = places[std::min(i, places.size() - 1)];
        for (int axis = 0; axis < 3; ++axis) {
            origin[axis][i] = camera.origin[axis] + place.x * camera.origin_dx[axis] +
                              place.y * camera.origin_dy[axis];
            direction[axis][i] = camera.direction[axis] + place.x * camera.direction_dx[axis] +
                                 place.y * camera.direction_dy[axis];
        }
        rays.tfar[i] = sun_distance;
    }
}

/// The unit normal of a hit, toward the eye.
void faceOf(const RTCRayHit16& rays, std::size_t i, const RaySurface& surface, float (&face)[3]) {
    const double normal[3] = {rays.hit.Ng_x[i], rays.hit.Ng_y[i], rays.hit.Ng_z[i]};
    double turned[3] = {normal[0], normal[1], normal[2]};
    for (int axis = 0; surface.place && axis < 3; ++axis) {
        const float(&row)[3] = surface.place->cofactors[axis];
        turned[axis] = row[0] * normal[0] + row[1] * normal[1] + row[2] * normal[2];
    }
    const double along = turned[0] * rays.ray.dir_x[i] + turned[1] * rays.ray.dir_y[i] +
                         turned[2] * rays.ray.dir_z[i];
    const double length = std::hypot(turned[0], turned[1], turned[2]);
    const double scale = length > 0.0 ? (along > 0.0 ? -1.0 : 1.0) / length : 0.0;
    for (int axis = 0; axis < 3; ++axis)
        face[axis] = static_cast<float>(turned[axis] * scale);
}

SurfacePoint pointOf(const RTCRayHit16& rays, std::size_t i, const RaySurface& surface) {
    const float distance = rays.ray.tfar[i];
    SurfacePoint point{{rays.ray.org_x[i] + distance * rays.ray.dir_x[i],
                        rays.ray.org_y[i] + distance * rays.ray.dir_y[i],
                        rays.ray.org_z[i] + distance * rays.ray.dir_z[i]},
                       {}};
    faceOf(rays, i, surface, point.face);
    return point;
}

std::size_t surfaceMet(const RayScene& scene, const RTCHit16& hit, std::size_t i) {
    const std::uint32_t first =
        scene.hasInstances() ? scene.firstSurfaces()[hit.instID[0][i]] : scene.soleFirstSurface();
    return first + hit.geomID[i];
}

/// Shoots the rays of up to sixteen places.
void intersect(const RayScene& scene, GlassFilter& filter, RTCRayHit16& rays) {
    alignas(64) int all[points_at_once];
    std::fill_n(all, points_at_once, -1);
    std::fill_n(rays.hit.geomID, points_at_once, RTC_INVALID_GEOMETRY_ID);
    std::fill_n(rays.hit.instID[0], points_at_once, RTC_INVALID_GEOMETRY_ID);
    filter.context.flags = RTC_INTERSECT_CONTEXT_FLAG_COHERENT;
    rtcIntersect16(all, scene.root(), &filter.context, &rays);
}

} // namespace

PicturePoints pointsSeen(const DisplayScene& scene, const KM_Viewport& viewport, int width_px,
                         int height_px, std::span<const PicturePlace> places) {
    PicturePoints seen{SurfacePoints(scene.surfaceBox().Diagonal().Length()), {}};
    seen.points.resize(places.size());
    seen.object.assign(places.size(), 0);
    const RayScene& rays_of_scene = scene.rays();
    if (!rays_of_scene.root() || !scene.canBeSeenBy(viewport, width_px, height_px))
        return seen;
    const CameraRays camera =
        makeFrameSetup(scene, viewport, *findDisplayMode(shaded_mode_id), width_px, height_px).rays;
    const std::vector<std::uint32_t> meshes = meshesOfSurfaces(scene);
    tbb::parallel_for(std::size_t{0}, seen.points.packets().size(), [&](std::size_t packet) {
        const FlushDenormals flush;
        GlassFilter filter(scene, true);
        const std::size_t first = packet * points_at_once;
        const auto asked =
            places.subspan(first, std::min<std::size_t>(points_at_once, places.size() - first));
        RTCRayHit16 rays;
        startRays(rays.ray);
        aim(camera, asked, rays.ray);
        intersect(rays_of_scene, filter, rays);
        for (std::size_t i = 0; i < asked.size(); ++i) {
            if (rays.hit.geomID[i] == RTC_INVALID_GEOMETRY_ID)
                continue;
            const std::size_t surface = surfaceMet(rays_of_scene, rays.hit, i);
            seen.points.set(first + i, pointOf(rays, i, rays_of_scene.surfaces()[surface]),
                            rays.ray.tfar[i]);
            seen.object[first + i] = meshes[surface] + 1;
        }
    });
    return seen;
}

PixelTiles::PixelTiles(int width_px, int height_px)
    : m_columns((static_cast<std::size_t>(width_px) + TILE - 1) / TILE),
      m_rows((static_cast<std::size_t>(height_px) + TILE - 1) / TILE) {}

std::vector<PicturePlace> PixelTiles::places() const {
    std::vector<PicturePlace> places;
    places.reserve(m_columns * m_rows * TILE * TILE);
    for (std::size_t row = 0; row < m_rows; ++row)
        for (std::size_t column = 0; column < m_columns; ++column)
            for (std::size_t i = 0; i < TILE * TILE; ++i)
                places.push_back({static_cast<float>(column * TILE + i % TILE) + 0.5F,
                                  static_cast<float>(row * TILE + i / TILE) + 0.5F});
    return places;
}

std::size_t PixelTiles::indexOf(int x, int y) const {
    const auto column = static_cast<std::size_t>(x);
    const auto row = static_cast<std::size_t>(y);
    return (row / TILE * m_columns + column / TILE) * TILE * TILE + row % TILE * TILE +
           column % TILE;
}

} // namespace quarn
