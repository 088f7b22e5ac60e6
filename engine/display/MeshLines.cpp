#include "engine/display/MeshLines.h"

#include "engine/display/CameraRays.h"
#include "engine/display/PackedNormal.h"
#include "engine/display/ScreenProjection.h"
#include "engine/display/VisibleParts.h"

#include <algorithm>
#include <limits>

namespace quarn {

DepthFade::DepthFade(float strength, float far_strength, const CameraRays& rays,
                     const KM_BoundingBox& box)
    : m_strength(strength), m_far_depth(rays.far_depth), m_parallel(rays.parallel) {
    if (!box.IsValid() || far_strength >= 1.0F)
        return;
    double nearest = std::numeric_limits<double>::max();
    double farthest = 0.0;
    for (int i = 0; i < 8; ++i) {
        const double depth = std::max(0.0, depthOf(rays, box.Corner(i)));
        nearest = std::min(nearest, depth);
        farthest = std::max(farthest, depth);
    }
    if (!(farthest > nearest))
        return;
    m_loss = 1.0F - far_strength;
    m_near = static_cast<float>(nearest);
    m_depth_range = static_cast<float>(farthest - nearest);
}

float DepthFade::at(float nearness) const {
    if (m_loss <= 0.0F)
        return m_strength;
    const float depth = m_parallel ? m_far_depth - nearness : 1.0F / std::max(nearness, 1e-30F);
    return m_strength * (1.0F - m_loss * std::clamp((depth - m_near) / m_depth_range, 0.0F, 1.0F));
}

MeshLines::MeshLines(const DisplayScene::MeshObject& object, const CameraRays& rays,
                     const ScreenProjection& projection, const DepthFade& fade,
                     VisibleParts* visible_parts)
    : m_vertices(object.mesh->mesh().m_V), m_frame_from_mesh(object.frame_from_mesh),
      m_stands(m_frame_from_mesh.IsIdentity()), m_parallel(rays.parallel),
      m_eye(rays.eye[0], rays.eye[1], rays.eye[2]),
      m_backward(rays.camera_z[0], rays.camera_z[1], rays.camera_z[2]), m_projection(projection),
      m_fade(fade), m_visible_parts(visible_parts), m_spacing(object, rays) {
    KM_Xform mesh_from_frame = m_frame_from_mesh;
    if (m_stands || !mesh_from_frame.Invert())
        return;
    m_eye = mesh_from_frame * m_eye;
    m_backward = mesh_from_frame * m_backward;
}

void MeshLines::addAll(std::span<const MeshEdges::Edge> edges, LineBatch& batch) const {
    for (const auto& edge : edges)
        addDense(edge.from, edge.to, batch);
}

void MeshLines::addAll(std::span<const MeshEdges::FlatEdge> edges, LineBatch& batch) const {
    for (const auto& edge : edges)
        addDense(edge.from, edge.to, batch);
}

void MeshLines::addOutlines(std::span<const MeshEdges::Edge> edges, LineBatch& batch) const {
    for (const auto& edge : edges)
        if (isOutline(edge))
            add(edge.from, edge.to, batch);
}

void MeshLines::addInner(std::span<const MeshEdges::Edge> edges, LineBatch& batch) const {
    for (const auto& edge : edges)
        if (!isOutline(edge))
            add(edge.from, edge.to, batch);
}

/// True when one of the two triangles faces the observer and the other does not.
bool MeshLines::isOutline(const MeshEdges::Edge& edge) const {
    const KM_3fVector view(m_parallel ? m_backward : m_eye - m_vertices[edge.from].ToDouble());
    float a[3];
    float b[3];
    unpackNormal(edge.normal_a, a);
    unpackNormal(edge.normal_b, b);
    const float toward_a = a[0] * view.x + a[1] * view.y + a[2] * view.z;
    const float toward_b = b[0] * view.x + b[1] * view.y + b[2] * view.z;
    return (toward_a > 0.0F) != (toward_b > 0.0F);
}

bool MeshLines::project(std::uint32_t from, std::uint32_t to, ScreenSegment& segment) const {
    KM_3dPoint a = m_vertices[from].ToDouble();
    KM_3dPoint b = m_vertices[to].ToDouble();
    if (!m_stands) {
        a = m_frame_from_mesh * a;
        b = m_frame_from_mesh * b;
    }
    if (!m_projection.project({a.x, a.y, a.z}, {b.x, b.y, b.z}, segment))
        return false;
    segment.from.strength = m_fade.at(segment.from.nearness);
    segment.to.strength = m_fade.at(segment.to.nearness);
    return true;
}

void MeshLines::add(std::uint32_t from, std::uint32_t to, LineBatch& batch) const {
    ScreenSegment segment;
    if (project(from, to, segment))
        addVisible(segment, batch);
}

void MeshLines::addVisible(const ScreenSegment& segment, LineBatch& batch) const {
    if (m_visible_parts)
        m_visible_parts->add(segment, batch);
    else
        batch.add(segment);
}

void MeshLines::addDense(std::uint32_t from, std::uint32_t to, LineBatch& batch) const {
    constexpr float least = 0.04F; // fainter lines cannot be seen
    const KM_3dPoint vertex = m_vertices[from].ToDouble();
    const KM_3dPoint start = m_stands ? vertex : m_frame_from_mesh * vertex;
    const float nearness = m_projection.nearness({start.x, start.y, start.z});
    if (nearness > 0.0F && m_spacing.clearness(nearness) < least)
        return;
    ScreenSegment segment;
    if (!project(from, to, segment))
        return;
    for (ScreenPoint* const end : {&segment.from, &segment.to})
        end->strength *= m_spacing.clearness(end->nearness);
    addVisible(segment, batch);
}

} // namespace quarn
