#include "import/gltf/GltfTriangles.h"

#include "import/assembly/MeshCleaning.h"
#include "import/assembly/StoredColor.h"

#include <tbb/parallel_for.h>

#include <algorithm>
#include <array>
#include <atomic>
#include <cmath>
#include <utility>

namespace quarn::gltf {

namespace {

/// The corners of a triangle. Khronos Group, glTF 2.0, section 3.7.2.1.
std::array<std::uint64_t, 3> cornersOf(PrimitiveMode mode, std::uint64_t triangle) {
    const std::uint64_t i = triangle;
    switch (mode) {
    case PrimitiveMode::strip:
        return {i, i + 1 + i % 2, i + 2 - i % 2};
    case PrimitiveMode::fan:
        return {i + 1, i + 2, 0};
    default:
        return {3 * i, 3 * i + 1, 3 * i + 2};
    }
}

float finiteOrZero(double number) {
    const auto single = static_cast<float>(number);
    return std::isfinite(single) ? single + 0.0F : 0.0F;
}

class TriangleReader {
public:
    TriangleReader(const Primitive& primitive, const Deformation& deformation,
                   const TexturePlace& place)
        : m_primitive(primitive), m_deformation(deformation), m_place(place) {}

    ReadTriangles read() {
        readFaces();
        const std::uint64_t in_range = m_mesh->m_F.size();
        selectVertices();
        readVertices();
        dropUnusableTriangles(*m_mesh);
        dropUnusedVertices(*m_mesh);
        weldSparseMesh(*m_mesh);
        return {std::move(m_mesh), in_range};
    }

private:
    std::uint32_t vertexAt(std::uint64_t corner) const {
        return m_primitive.indices ? m_primitive.indices->index(corner)
                                   : static_cast<std::uint32_t>(corner);
    }

    void readFaces() {
        const std::uint64_t corners =
            m_primitive.indices ? m_primitive.indices->count : m_primitive.positions.count;
        const std::uint64_t vertices = m_primitive.positions.count;
        std::vector<KM_MeshTriangle>& faces = m_mesh->m_F;
        faces.resize(trianglesOf(m_primitive.mode, corners));
        std::atomic<bool> has_bad = false;
        tbb::parallel_for(std::size_t{0}, faces.size(), [&](std::size_t f) {
            const std::array<std::uint64_t, 3> corner = cornersOf(m_primitive.mode, f);
            for (std::size_t k = 0; k < 3; ++k) {
                faces[f].vi[k] = vertexAt(corner[k]);
                if (faces[f].vi[k] >= vertices)
                    has_bad.store(true, std::memory_order_relaxed);
            }
        });
        if (has_bad)
            std::erase_if(faces, [vertices](const KM_MeshTriangle& face) {
                return std::ranges::any_of(face.vi,
                                           [vertices](std::uint32_t v) { return v >= vertices; });
            });
    }

    /// Files let many meshes share long lists of vertices: where a mesh can use only a part of its
    /// list, it reads that part alone.
    void selectVertices() {
        const std::uint64_t vertices = m_primitive.positions.count;
        std::vector<KM_MeshTriangle>& faces = m_mesh->m_F;
        m_count = vertices;
        if (3 * faces.size() >= vertices)
            return;
        for (const KM_MeshTriangle& face : faces)
            m_selected.insert(m_selected.end(), std::begin(face.vi), std::end(face.vi));
        std::ranges::sort(m_selected);
        m_selected.erase(std::unique(m_selected.begin(), m_selected.end()), m_selected.end());
        m_count = m_selected.size();
        for (KM_MeshTriangle& face : faces)
            for (std::uint32_t& v : face.vi)
                v = static_cast<std::uint32_t>(std::ranges::lower_bound(m_selected, v) -
                                               m_selected.begin());
    }

    template <class Element, class Read>
    void readInto(std::vector<Element>& list, const Read& read) const {
        list.resize(m_count);
        tbb::parallel_for(std::size_t{0}, list.size(), [&](std::size_t i) {
            list[i] = read(m_selected.empty() ? i : m_selected[i]);
        });
    }

    void readVertices() {
        readInto(m_mesh->m_V, [this](std::uint64_t v) { return m_deformation.place(v); });
        if (m_primitive.normals)
            readInto(m_mesh->m_N, [this](std::uint64_t v) { return m_deformation.normal(v); });
        if (m_primitive.texture_coordinates)
            readInto(m_mesh->m_T, [this](std::uint64_t v) { return textureAt(v); });
        if (m_primitive.colors)
            readInto(m_mesh->m_C, [this](std::uint64_t v) { return colorAt(v); });
    }

    KM_2fPoint textureAt(std::uint64_t vertex) const {
        std::array<float, 2> t{};
        m_primitive.texture_coordinates->read(vertex, t);
        const auto u = static_cast<double>(t[0]);
        const auto v = static_cast<double>(t[1]);
        return {finiteOrZero(m_place.u[0] * u + m_place.u[1] * v + m_place.u[2]),
                finiteOrZero(m_place.v[0] * u + m_place.v[1] * v + m_place.v[2])};
    }

    KM_Color colorAt(std::uint64_t vertex) const {
        std::array<float, 4> c{1.0F, 1.0F, 1.0F, 1.0F};
        const std::size_t given = m_primitive.colors->components >= 4 ? 4 : 3;
        m_primitive.colors->read(vertex, std::span(c).first(given));
        return colorFromLinear(c[0], c[1], c[2], c[3]);
    }

    const Primitive& m_primitive;
    const Deformation& m_deformation;
    const TexturePlace& m_place;
    std::shared_ptr<KM_Mesh> m_mesh = std::make_shared<KM_Mesh>();
    std::vector<std::uint32_t> m_selected; ///< the vertices that are read; none: all
    std::uint64_t m_count = 0;             ///< of vertices that are read
};

} // namespace

std::uint64_t trianglesOf(PrimitiveMode mode, std::uint64_t corners) {
    if (mode == PrimitiveMode::triangles)
        return corners / 3;
    return corners > 2 ? corners - 2 : 0;
}

ReadTriangles readTrianglesOf(const Primitive& primitive, const Deformation& deformation,
                              const TexturePlace& texture_place) {
    return TriangleReader(primitive, deformation, texture_place).read();
}

} // namespace quarn::gltf
