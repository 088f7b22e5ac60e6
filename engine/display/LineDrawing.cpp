#include "engine/display/LineDrawing.h"

#include "engine/display/CameraRays.h"
#include "engine/display/DisplayMode.h"
#include "engine/display/DisplayScene.h"
#include "engine/display/MeshLines.h"
#include "engine/display/VisibleParts.h"

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
        listPart({source, object, begin, std::min(count, begin + lines_per_job), strength}, style);
}

/// Many small objects share a task.
void LineDrawing::listPart(const Part& part, const LineStyle& style) {
    const std::size_t count = part.end - part.begin;
    const bool joins = !m_jobs.empty() && m_jobs.back().style == style &&
                       m_jobs.back().line_count + count <= lines_per_job;
    if (!joins)
        m_jobs.push_back({style, m_parts.size(), m_parts.size(), 0});
    m_parts.push_back(part);
    ++m_jobs.back().end_part;
    m_jobs.back().line_count += count;
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

struct LineDrawing::Shared {
    const DisplayScene& scene;
    const CameraRays& rays;
    const DisplayModeAttributes& mode;
    const LineTarget& target;
    const ScreenProjection projection;
    const KM_3dVector frame_from_world;
    const KM_BoundingBox box; ///< of what is shown, in the coordinates of the frame
};

void LineDrawing::addCurve(const Part& part, const Shared& shared, LineBatch& batch) {
    const KM_3dPoint* const points = shared.scene.curves()[part.object].polyline.Array();
    for (std::size_t i = part.begin; i < part.end; ++i)
        addLine(shared.projection, Point3(points[i] + shared.frame_from_world),
                Point3(points[i + 1] + shared.frame_from_world), batch);
}

void LineDrawing::addPoint(const Part& part, const Shared& shared, LineBatch& batch) {
    const Point3 place(shared.scene.points()[part.object].location + shared.frame_from_world);
    addLine(shared.projection, place, place, batch);
}

void LineDrawing::addMeshLines(const Part& part, const Shared& shared, VisibleParts* visible_parts,
                               LineBatch& batch) {
    const DisplayScene::MeshObject& object = shared.scene.meshes()[part.object];
    const MeshEdges& edges = object.mesh->edges();
    const DepthFade fade(part.strength, shared.mode.far_strength, shared.rays, shared.box);
    const MeshLines lines(object, shared.rays, shared.projection, fade, visible_parts);
    const std::size_t count = part.end - part.begin;
    switch (part.source) {
    case Source::flat:
        lines.addAll(edges.flat().subspan(part.begin, count), batch);
        break;
    case Source::smooth:
        lines.addAll(edges.smooth().subspan(part.begin, count), batch);
        break;
    case Source::creases:
        lines.addInner(edges.features().subspan(part.begin, count), batch);
        break;
    case Source::feature_outlines:
        lines.addOutlines(edges.features().subspan(part.begin, count), batch);
        break;
    default:
        lines.addOutlines(edges.smooth().subspan(part.begin, count), batch);
    }
}

void LineDrawing::run(const Job& job, const Shared& shared, LineBatch& batch) {
    batch.reset(job.style);
    VisibleParts visible_parts(shared.target);
    const bool keeps_visible = shared.target.depth && !job.style.hidden_by_pixel;
    for (std::size_t i = job.first_part; i < job.end_part; ++i) {
        const Part& part = m_parts[i];
        if (part.source == Source::curve)
            addCurve(part, shared, batch);
        else if (part.source == Source::point)
            addPoint(part, shared, batch);
        else if (part.strength > weakest_drawn)
            addMeshLines(part, shared, keeps_visible ? &visible_parts : nullptr, batch);
    }
    batch.sortIntoBands(shared.target.height);
}

void LineDrawing::draw(const DisplayScene& scene, const CameraRays& rays,
                       const DisplayModeAttributes& mode, const LineTarget& target) {
    m_parts.clear();
    m_jobs.clear();
    listMeshes(scene, rays, mode);
    listCurvesAndPoints(scene, mode);
    m_batches.resize(m_jobs.size());
    const float margin = std::max({mode.edge_width_px, mode.outline_width_px, mode.curve_width_px,
                                   mode.point_size_px}) +
                         1.0F;
    const KM_3dVector frame_from_world = KM_3dPoint::Origin - scene.origin();
    KM_BoundingBox box = scene.boundingBox();
    if (box.IsValid())
        box = {box.m_min + frame_from_world, box.m_max + frame_from_world};
    const Shared shared{scene,
                        rays,
                        mode,
                        target,
                        ScreenProjection(rays, target.width, target.height, margin),
                        frame_from_world,
                        box};
    tbb::parallel_for(std::size_t{0}, m_jobs.size(),
                      [&](std::size_t index) { run(m_jobs[index], shared, m_batches[index]); });
    if (mode.draws_all_edges)
        layTone(scene, rays, mode, shared.projection, target);
    drawLines(m_batches, target);
}

} // namespace quarn
