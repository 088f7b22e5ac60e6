#include "engine/display/RayMesh.h"

#include "engine/display/MeshEdges.h"
#include "engine/display/PackedNormal.h"
#include "engine/scene/DrawableRange.h"
#include "ground/LargePages.h"

#include <tbb/blocked_range.h>
#include <tbb/parallel_for.h>

#include <algorithm>

namespace quarn {

namespace {

bool fits(std::size_t optional_count, std::size_t vertex_count) {
    return optional_count == 0 || optional_count == vertex_count;
}

bool canBeDrawn(const KM_Mesh& mesh) {
    const std::size_t count = mesh.m_V.size();
    if (mesh.m_F.empty() || !fits(mesh.m_N.size(), count) || !fits(mesh.m_T.size(), count) ||
        !fits(mesh.m_C.size(), count))
        return false;
    return std::all_of(mesh.m_F.begin(), mesh.m_F.end(), [count](const KM_MeshTriangle& t) {
        return t.vi[0] < count && t.vi[1] < count && t.vi[2] < count;
    });
}

template <class Function> void forAll(std::size_t count, const Function& function) {
    tbb::parallel_for(tbb::blocked_range<std::size_t>(0, count, 8192), [&](const auto& range) {
        for (std::size_t i = range.begin(); i != range.end(); ++i)
            function(i);
    });
}

} // namespace

RayMesh::RayMesh(std::shared_ptr<const KM_Mesh> mesh) : m_mesh(std::move(mesh)) {
    m_in_range = !m_mesh || isInDrawableRange(*m_mesh);
    m_drawable = m_mesh && m_in_range && canBeDrawn(*m_mesh);
    if (!m_drawable)
        return;
    m_box = m_mesh->BoundingBox();
    padVertices();
    packNormals();
}

RayMesh::~RayMesh() = default;

void RayMesh::padVertices() {
    const auto& vertices = m_mesh->m_V;
    if (vertices.capacity() > vertices.size())
        return;
    m_padded_copy.reserve(vertices.size() + 1);
    m_padded_copy = vertices;
    m_padded_copy.emplace_back();
}

void RayMesh::packNormals() {
    if (m_mesh->m_N.empty())
        return;
    std::vector<std::uint32_t> packed(m_mesh->m_N.size());
    forAll(packed.size(), [&](std::size_t i) {
        const KM_3fVector& n = m_mesh->m_N[i];
        packed[i] = packNormal(n.x, n.y, n.z);
    });
    // Not set to zeros first: that would take longer than the rest.
    const std::size_t corners = 3 * m_mesh->m_F.size();
    m_corner_normals = std::make_unique_for_overwrite<std::uint32_t[]>(corners);
    askForLargePages(m_corner_normals.get(), corners * sizeof(std::uint32_t));
    forAll(m_mesh->m_F.size(), [&](std::size_t i) {
        for (std::size_t corner = 0; corner < 3; ++corner)
            m_corner_normals[3 * i + corner] = packed[m_mesh->m_F[i].vi[corner]];
    });
}

const std::uint32_t* RayMesh::cornerNormals() const {
    return m_corner_normals.get();
}

const KM_3fPoint* RayMesh::paddedVertices() const {
    return m_padded_copy.empty() ? m_mesh->m_V.data() : m_padded_copy.data();
}

const MeshEdges& RayMesh::edges() const {
    if (!m_edges)
        m_edges = std::make_unique<MeshEdges>(*m_mesh);
    return *m_edges;
}

} // namespace quarn
