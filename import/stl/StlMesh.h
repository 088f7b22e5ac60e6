#pragma once

#include "import/assembly/EqualItems.h"
#include "import/assembly/IndexTable.h"
#include "kelmar/KM_Mesh.h"

#include <tbb/parallel_for.h>

#include <algorithm>
#include <array>
#include <memory>
#include <span>
#include <vector>

namespace quarn {

/// Makes a mesh of triangles that state their corners each for itself: corners at one place, of one
/// colour, become one vertex. Works in the memory that the triangles will take.
/// @tparam Facets  has, safe for several threads: `KM_3fPoint corner(std::uint32_t)`, without
///   negative zeros, by three times the triangle's number and the corner's; `bool hasColors()`; and
///   `KM_Color color(std::uint32_t)` of a triangle
template <class Facets> class StlMesh {
public:
    StlMesh(const Facets& facets, std::size_t count) : m_facets(facets), m_count(count) {}

    std::shared_ptr<KM_Mesh> make() {
        m_mesh->m_F.resize(m_count);
        m_corners = {m_count == 0 ? nullptr : &m_mesh->m_F[0].vi[0], 3 * m_count};
        const auto hash = [this](std::uint32_t corner) { return hashOf(corner); };
        const auto equals = [this](std::uint32_t a, std::uint32_t b) { return areEqual(a, b); };
        EqualItems(hash, equals).find(m_corners);
        makeVertices();
        forBlocks([this](std::size_t begin, std::size_t end) {
            for (std::size_t i = begin; i < end; ++i)
                if ((m_corners[i] & IS_FIRST) == 0)
                    m_corners[i] = m_corners[m_corners[i]] & ~IS_FIRST;
        });
        forBlocks([this](std::size_t begin, std::size_t end) {
            for (std::size_t i = begin; i < end; ++i)
                m_corners[i] &= ~IS_FIRST;
        });
        return m_mesh;
    }

private:
    static constexpr std::size_t BLOCK = std::size_t{64} << 10;
    /// Marks the number of a vertex at the first of its corners; the others' hold the number of
    /// that corner until they, too, get the vertex.
    static constexpr std::uint32_t IS_FIRST = 0x80000000U;

    std::uint32_t hashOf(std::uint32_t corner) const {
        const KM_3fPoint p = m_facets.corner(corner);
        return hashOfBits(std::array{p.x, p.y, p.z});
    }

    bool areEqual(std::uint32_t a, std::uint32_t b) const {
        return m_facets.corner(a) == m_facets.corner(b) &&
               (!m_facets.hasColors() || m_facets.color(a / 3) == m_facets.color(b / 3));
    }

    template <class Work> void forBlocks(const Work& work) const {
        const std::size_t blocks = (m_corners.size() + BLOCK - 1) / BLOCK;
        tbb::parallel_for(std::size_t{0}, blocks, [&](std::size_t block) {
            work(block * BLOCK, std::min((block + 1) * BLOCK, m_corners.size()));
        });
    }

    /// Vertices come in the order of their first corners.
    void makeVertices() {
        std::vector<std::uint32_t> next(m_corners.size() / BLOCK + 1);
        forBlocks([&](std::size_t begin, std::size_t end) {
            for (std::size_t i = begin; i < end; ++i)
                next[begin / BLOCK] += m_corners[i] == i ? 1 : 0;
        });
        std::uint32_t count = 0;
        for (std::uint32_t& of_block : next)
            count += std::exchange(of_block, count);
        m_mesh->m_V.reserve(count + std::size_t{1}); // see PadForRayTracing
        m_mesh->m_V.resize(count);
        m_mesh->m_C.resize(m_facets.hasColors() ? count : 0);
        forBlocks([&](std::size_t begin, std::size_t end) {
            std::uint32_t vertex = next[begin / BLOCK];
            for (std::size_t i = begin; i < end; ++i)
                if (m_corners[i] == i)
                    makeVertex(static_cast<std::uint32_t>(i), vertex++);
        });
    }

    void makeVertex(std::uint32_t corner, std::uint32_t vertex) {
        m_mesh->m_V[vertex] = m_facets.corner(corner);
        if (m_facets.hasColors())
            m_mesh->m_C[vertex] = m_facets.color(corner / 3);
        m_corners[corner] = vertex | IS_FIRST;
    }

    const Facets& m_facets;
    std::size_t m_count;
    std::shared_ptr<KM_Mesh> m_mesh = std::make_shared<KM_Mesh>();
    std::span<std::uint32_t> m_corners;
};

} // namespace quarn
