#include "host/display/LineDrawing.h"

#include "host/display/CameraRays.h"
#include "host/display/DisplayMode.h"
#include "host/display/DisplayScene.h"
#include "host/display/MeshEdges.h"
#include "host/display/PackedNormal.h"

#include <tbb/parallel_for.h>

#include <algorithm>
#include <cmath>

namespace quarn {

namespace {

constexpr std::size_t lines_per_job = 8192;

/// The smooth edges of a mesh fade out where they stand closer than this, in pixels.
constexpr double sparse_px = 10.0;
constexpr double dense_px = 3.0;
constexpr float smooth_edge_opacity = 0.42F;

bool wantsEdges(const DisplayModeAttributes& mode) {
    return mode.draws_edges || mode.draws_smooth_edges || mode.draws_silhouettes;
}

double depthOf(const CameraRays& rays, const KM_3dPoint& p) {
    return (rays.eye[0] - p.x) * rays.camera_z[0] + (rays.eye[1] - p.y) * rays.camera_z[1] +
           (rays.eye[2] - p.z) * rays.camera_z[2];
}

/// How visible the smooth edges of a mesh are: a dense net would be a black spot.
float smoothOpacity(const RayMesh& mesh, const CameraRays& rays) {
    double pixel = rays.pixel_size;
    if (!rays.parallel)
        pixel *=
            std::max(depthOf(rays, mesh.box().Center()), 1e-3 * mesh.box().Diagonal().Length());
    const double spacing_px = mesh.edges().meanSmoothLength() / std::max(pixel, 1e-300);
    const double t = std::clamp((spacing_px - dense_px) / (sparse_px - dense_px), 0.0, 1.0);
    return smooth_edge_opacity * static_cast<float>(t);
}

struct Point3 {
    double at[3];
    explicit Point3(const KM_3fPoint& p) : at{p.x, p.y, p.z} {}
    explicit Point3(const KM_3dPoint& p) : at{p.x, p.y, p.z} {}
};

void addLine(const ScreenProjection& projection, const Point3& from, const Point3& to,
             LineBatch& batch) {
    ScreenSegment segment;
    if (projection.project(from.at, to.at, segment))
        batch.add(segment);
}

/// True when one of the two triangles faces the observer and the other does not.
bool isSilhouette(const MeshEdges::SmoothEdge& edge, const KM_3fPoint& place,
                  const CameraRays& rays) {
    const float view[3] = {
        rays.parallel ? rays.camera_z[0] : static_cast<float>(rays.eye[0]) - place.x,
        rays.parallel ? rays.camera_z[1] : static_cast<float>(rays.eye[1]) - place.y,
        rays.parallel ? rays.camera_z[2] : static_cast<float>(rays.eye[2]) - place.z};
    float a[3];
    float b[3];
    unpackNormal(edge.normal_a, a);
    unpackNormal(edge.normal_b, b);
    const float toward_a = a[0] * view[0] + a[1] * view[1] + a[2] * view[2];
    const float toward_b = b[0] * view[0] + b[1] * view[1] + b[2] * view[2];
    return (toward_a > 0.0F) != (toward_b > 0.0F);
}

template <class Edges>
void addEdges(const RayMesh& mesh, const Edges& edges, const ScreenProjection& projection,
              LineBatch& batch) {
    const auto& vertices = mesh.mesh().m_V;
    for (const auto& edge : edges)
        addLine(projection, Point3(vertices[edge.from]), Point3(vertices[edge.to]), batch);
}

void addSilhouettes(const RayMesh& mesh, std::span<const MeshEdges::SmoothEdge> edges,
                    const CameraRays& rays, const ScreenProjection& projection, LineBatch& batch) {
    const auto& vertices = mesh.mesh().m_V;
    for (const auto& edge : edges)
        if (isSilhouette(edge, vertices[edge.from], rays))
            addLine(projection, Point3(vertices[edge.from]), Point3(vertices[edge.to]), batch);
}

} // namespace

bool LineDrawing::hasLines(const DisplayScene& scene, const DisplayModeAttributes& mode) {
    const auto shown = [](const auto& object) { return object.visible; };
    if (wantsEdges(mode) && std::any_of(scene.meshes().begin(), scene.meshes().end(), shown))
        return true;
    return std::any_of(scene.curves().begin(), scene.curves().end(), shown) ||
           std::any_of(scene.points().begin(), scene.points().end(), shown);
}

void LineDrawing::list(Source source, std::size_t object, std::size_t count,
                       const LineStyle& style) {
    for (std::size_t begin = 0; begin < count; begin += lines_per_job)
        m_jobs.push_back({source, object, begin, std::min(count, begin + lines_per_job), style});
}

void LineDrawing::listMeshes(const DisplayScene& scene, const CameraRays& rays,
                             const DisplayModeAttributes& mode) {
    if (!wantsEdges(mode))
        return;
    const LineStyle clear{mode.edge_color, 1.0F, mode.edge_width_px};
    for (std::size_t i = 0; i < scene.meshes().size(); ++i) {
        const auto& object = scene.meshes()[i];
        if (!object.visible || !object.mesh)
            continue;
        const std::size_t smooth_count = object.mesh->edges().smooth().size();
        const LineStyle faint{mode.edge_color, smoothOpacity(*object.mesh, rays),
                              mode.edge_width_px};
        if (mode.draws_smooth_edges && faint.opacity > 0.03F)
            list(Source::smooth_edges, i, smooth_count, faint);
        if (mode.draws_edges)
            list(Source::features, i, object.mesh->edges().features().size(), clear);
        if (mode.draws_silhouettes)
            list(Source::silhouettes, i, smooth_count, clear);
    }
}

void LineDrawing::listCurvesAndPoints(const DisplayScene& scene,
                                      const DisplayModeAttributes& mode) {
    for (std::size_t i = 0; i < scene.curves().size(); ++i) {
        const SceneCurve& curve = scene.curves()[i];
        if (curve.visible && curve.polyline.Count() > 1)
            list(Source::curve, i, static_cast<std::size_t>(curve.polyline.Count() - 1),
                 {curve.color, 1.0F, mode.curve_width_px});
    }
    for (std::size_t i = 0; i < scene.points().size(); ++i)
        if (scene.points()[i].visible)
            list(Source::point, i, 1, {scene.points()[i].color, 1.0F, mode.point_size_px});
}

void LineDrawing::draw(const DisplayScene& scene, const CameraRays& rays,
                       const DisplayModeAttributes& mode, const LineTarget& target) {
    m_jobs.clear();
    listMeshes(scene, rays, mode);
    listCurvesAndPoints(scene, mode);
    if (m_batches.size() < m_jobs.size())
        m_batches.resize(m_jobs.size());
    const float margin =
        std::max({mode.edge_width_px, mode.curve_width_px, mode.point_size_px}) + 1.0F;
    const ScreenProjection projection(rays, target.width, target.height, margin);
    tbb::parallel_for(std::size_t{0}, m_jobs.size(), [&](std::size_t index) {
        const Job& job = m_jobs[index];
        LineBatch& batch = m_batches[index];
        batch.reset(job.style);
        const std::size_t count = job.end - job.begin;
        if (job.source == Source::curve) {
            const KM_3dPoint* const points = scene.curves()[job.object].polyline.Array();
            for (std::size_t i = job.begin; i < job.end; ++i)
                addLine(projection, Point3(points[i]), Point3(points[i + 1]), batch);
        } else if (job.source == Source::point) {
            const Point3 place(scene.points()[job.object].location);
            addLine(projection, place, place, batch);
        } else {
            const RayMesh& mesh = *scene.meshes()[job.object].mesh;
            const MeshEdges& edges = mesh.edges();
            if (job.source == Source::features)
                addEdges(mesh, edges.features().subspan(job.begin, count), projection, batch);
            else if (job.source == Source::smooth_edges)
                addEdges(mesh, edges.smooth().subspan(job.begin, count), projection, batch);
            else
                addSilhouettes(mesh, edges.smooth().subspan(job.begin, count), rays, projection,
                               batch);
        }
        batch.sortIntoBands(target.height);
    });
    drawLines({m_batches.data(), m_jobs.size()}, target);
}

} // namespace quarn
