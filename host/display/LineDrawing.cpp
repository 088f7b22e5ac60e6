#include "host/display/LineDrawing.h"

#include "host/display/CameraRays.h"
#include "host/display/DisplayMode.h"
#include "host/display/DisplayScene.h"
#include "host/display/MeshLines.h"
#include "host/display/VisibleParts.h"

#include <tbb/parallel_for.h>

#include <algorithm>
#include <cmath>
#include <limits>

namespace quarn {

namespace {

constexpr std::size_t lines_per_job = 8192;

constexpr float inner_edge_strength = 0.45F;
constexpr float weakest_drawn = 0.03F;
/// Of the tone that stands for edges that cannot be told apart.
constexpr float tone_strength = 0.13F;

bool wantsEdges(const DisplayModeAttributes& mode) {
    return mode.draws_edges || mode.draws_all_edges || mode.draws_outlines;
}

double depthOf(const CameraRays& rays, const KM_3dPoint& p) {
    return (rays.eye[0] - p.x) * rays.camera_z[0] + (rays.eye[1] - p.y) * rays.camera_z[1] +
           (rays.eye[2] - p.z) * rays.camera_z[2];
}

/// How near the nearest and the farthest part of a mesh are, in the measure of DepthImage.
struct NearnessRange {
    float nearest;
    float farthest;
};

NearnessRange nearnessOf(const DisplayScene::MeshObject& object, const KM_3dPoint& origin,
                         const CameraRays& rays) {
    const double least_depth = 1e-3 * object.box.Diagonal().Length();
    NearnessRange range{0.0F, std::numeric_limits<float>::max()};
    for (int i = 0; i < 8; ++i) {
        const KM_3dPoint corner = object.box.Corner(i) + (KM_3dPoint::Origin - origin);
        const double depth = std::max(depthOf(rays, corner), least_depth);
        const auto nearness =
            static_cast<float>(rays.parallel ? rays.far_depth - depth : 1.0 / depth);
        range.nearest = std::max(range.nearest, nearness);
        range.farthest = std::min(range.farthest, nearness);
    }
    return range;
}

/// How strong the inner edges of a mesh are where they can be told apart; 0 if they nowhere can.
float innerStrength(const DisplayScene::MeshObject& object, const KM_3dPoint& origin,
                    const CameraRays& rays) {
    const float nearest = nearnessOf(object, origin, rays).nearest;
    const bool is_clear =
        inner_edge_strength * EdgeSpacing(object, rays).clearness(nearest) > weakest_drawn;
    return is_clear ? inner_edge_strength : 0.0F;
}

struct Point3 {
    double at[3];
    explicit Point3(const KM_3dPoint& p) : at{p.x, p.y, p.z} {}
};

void addLine(const ScreenProjection& projection, const Point3& from, const Point3& to,
             LineBatch& batch) {
    ScreenSegment segment;
    if (projection.project(from.at, to.at, segment))
        batch.add(segment);
}

/// The styles of a mode's mesh lines.
struct MeshLineStyles {
    LineStyle inner;
    LineStyle creases;
    LineStyle outlines;

    explicit MeshLineStyles(const DisplayModeAttributes& mode)
        : inner{mode.edge_color, 1.0F, std::min(1.0F, mode.edge_width_px)},
          creases{mode.edge_color, mode.edge_strength, mode.edge_width_px},
          outlines{mode.edge_color, 1.0F, mode.edge_width_px, mode.outline_width_px} {
        inner.crowded = mode.crowded_strength;
        creases.crowded = mode.crowded_strength;
        outlines.crowded = 0.55F * mode.crowded_strength;
        for (LineStyle* const style : {&inner, &creases, &outlines})
            style->covered_strength = mode.covered_strength;
        creases.hidden_by_pixel = false;
        outlines.hidden_by_pixel = false;
    }
};

void keepVisibleParts(const LineTarget& target, LineBatch& batch) {
    const std::vector<ScreenSegment> all = batch.takeSegments();
    VisibleParts parts(target);
    for (const ScreenSegment& segment : all)
        parts.add(segment, batch);
}

} // namespace

bool LineDrawing::hasLines(const DisplayScene& scene, const DisplayModeAttributes& mode) {
    const auto shown = [](const auto& object) { return object.visible; };
    if (wantsEdges(mode) && std::any_of(scene.meshes().begin(), scene.meshes().end(), shown))
        return true;
    return std::any_of(scene.curves().begin(), scene.curves().end(), shown) ||
           std::any_of(scene.points().begin(), scene.points().end(), shown);
}

void LineDrawing::list(Source source, std::size_t object, std::size_t count, const LineStyle& style,
                       float strength) {
    for (std::size_t begin = 0; begin < count; begin += lines_per_job)
        m_jobs.push_back(
            {source, object, begin, std::min(count, begin + lines_per_job), style, strength});
}

/// Style by style, so that lines of one style cover a pixel once, whichever objects they are of.
void LineDrawing::listMeshes(const DisplayScene& scene, const CameraRays& rays,
                             const DisplayModeAttributes& mode) {
    if (!wantsEdges(mode))
        return;
    const MeshLineStyles styles(mode);
    const auto forEachMesh = [&](const auto& function) {
        for (std::size_t i = 0; i < scene.meshes().size(); ++i)
            if (scene.meshes()[i].visible && scene.meshes()[i].mesh)
                function(i, scene.meshes()[i]);
    };
    if (mode.draws_all_edges)
        forEachMesh([&](std::size_t i, const DisplayScene::MeshObject& object) {
            const float strength = innerStrength(object, scene.origin(), rays);
            if (strength <= weakest_drawn)
                return;
            const MeshEdges& edges = object.mesh->edges();
            list(Source::flat, i, edges.flat().size(), styles.inner, strength);
            list(Source::smooth, i, edges.smooth().size(), styles.inner, strength);
        });
    if (mode.draws_edges)
        forEachMesh([&](std::size_t i, const DisplayScene::MeshObject& object) {
            list(Source::creases, i, object.mesh->edges().features().size(), styles.creases);
        });
    if (mode.draws_edges || mode.draws_outlines)
        forEachMesh([&](std::size_t i, const DisplayScene::MeshObject& object) {
            list(Source::feature_outlines, i, object.mesh->edges().features().size(),
                 styles.outlines);
            if (mode.draws_outlines)
                list(Source::smooth_outlines, i, object.mesh->edges().smooth().size(),
                     styles.outlines);
        });
}

/// Where the inner edges of meshes cannot be told apart, a tone says that they are there.
void LineDrawing::layTone(const DisplayScene& scene, const CameraRays& rays,
                          const DisplayModeAttributes& mode, const ScreenProjection& projection,
                          const LineTarget& target) {
    m_tone.reset(target.width, target.height);
    for (const DisplayScene::MeshObject& object : scene.meshes()) {
        if (!object.visible || !object.mesh)
            continue;
        const float farthest = nearnessOf(object, scene.origin(), rays).farthest;
        if (EdgeSpacing(object, rays).clearness(farthest) < 1.0F)
            m_tone.add(object, rays, projection, target);
    }
    m_tone.blend(target, mode.edge_color, tone_strength);
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

void LineDrawing::addMeshLines(const Job& job, const MeshLines& lines, const MeshEdges& edges,
                               LineBatch& batch) {
    const std::size_t count = job.end - job.begin;
    switch (job.source) {
    case Source::flat:
        lines.addAll(edges.flat().subspan(job.begin, count), batch);
        break;
    case Source::smooth:
        lines.addAll(edges.smooth().subspan(job.begin, count), batch);
        break;
    case Source::creases:
        lines.addInner(edges.features().subspan(job.begin, count), batch);
        break;
    case Source::feature_outlines:
        lines.addOutlines(edges.features().subspan(job.begin, count), batch);
        break;
    default:
        lines.addOutlines(edges.smooth().subspan(job.begin, count), batch);
    }
}

void LineDrawing::draw(const DisplayScene& scene, const CameraRays& rays,
                       const DisplayModeAttributes& mode, const LineTarget& target) {
    m_jobs.clear();
    listMeshes(scene, rays, mode);
    listCurvesAndPoints(scene, mode);
    if (m_batches.size() < m_jobs.size())
        m_batches.resize(m_jobs.size());
    const float margin = std::max({mode.edge_width_px, mode.outline_width_px, mode.curve_width_px,
                                   mode.point_size_px}) +
                         1.0F;
    const KM_3dVector from_world = KM_3dPoint::Origin - scene.origin();
    KM_BoundingBox box = scene.boundingBox();
    if (box.IsValid())
        box = {box.m_min + from_world, box.m_max + from_world};
    const ScreenProjection projection(rays, target.width, target.height, margin);
    tbb::parallel_for(std::size_t{0}, m_jobs.size(), [&](std::size_t index) {
        const Job& job = m_jobs[index];
        LineBatch& batch = m_batches[index];
        batch.reset(job.style);
        if (job.source == Source::curve) {
            const KM_3dPoint* const points = scene.curves()[job.object].polyline.Array();
            for (std::size_t i = job.begin; i < job.end; ++i)
                addLine(projection, Point3(points[i] + from_world),
                        Point3(points[i + 1] + from_world), batch);
        } else if (job.source == Source::point) {
            const Point3 place(scene.points()[job.object].location + from_world);
            addLine(projection, place, place, batch);
        } else {
            const DisplayScene::MeshObject& object = scene.meshes()[job.object];
            const DepthFade fade(job.strength, mode.far_strength, rays, box);
            const MeshLines lines(object, rays, projection, fade);
            addMeshLines(job, lines, object.mesh->edges(), batch);
            if (target.depth && !job.style.hidden_by_pixel)
                keepVisibleParts(target, batch);
        }
        batch.sortIntoBands(target.height);
    });
    if (mode.draws_all_edges)
        layTone(scene, rays, mode, projection, target);
    drawLines({m_batches.data(), m_jobs.size()}, target);
}

} // namespace quarn
