#include "import/assembly/VertexWelding.h"

#include "import/assembly/IndexTable.h"

#include <array>
#include <utility>

namespace quarn {

namespace {

/// In a closed mesh six triangles meet at a vertex.
constexpr std::size_t USUAL_SHARING = 6;

/// Builds the arrays of vertices anew, in the order in which the triangles name them.
class VertexRebuilding {
public:
    VertexRebuilding(KM_Mesh& mesh, bool welds)
        : m_mesh(mesh), m_welds(welds), m_table(welds ? mesh.m_V.size() / USUAL_SHARING : 0),
          m_index(mesh.m_V.size(), IndexTable::none) {}

    void run() {
        for (KM_MeshTriangle& triangle : m_mesh.m_F)
            for (std::uint32_t& v : triangle.vi)
                v = newIndexOf(v);
        m_mesh.m_V = std::move(m_new.m_V);
        m_mesh.m_N = std::move(m_new.m_N);
        m_mesh.m_T = std::move(m_new.m_T);
        m_mesh.m_C = std::move(m_new.m_C);
    }

private:
    std::uint32_t newIndexOf(std::uint32_t v) {
        if (m_index[v] == IndexTable::none)
            m_index[v] = add(v);
        return m_index[v];
    }

    std::uint32_t add(std::uint32_t v) {
        const auto next = static_cast<std::uint32_t>(m_new.m_V.size());
        if (m_welds) {
            const std::uint32_t found =
                m_table.findOrAdd(hashOf(v), next, [&](std::uint32_t i) { return equals(i, v); });
            if (found != next)
                return found;
        }
        append(v);
        return next;
    }

    std::uint32_t hashOf(std::uint32_t v) const {
        const KM_3fPoint& p = m_mesh.m_V[v];
        const KM_3fVector n = m_mesh.m_N.empty() ? KM_3fVector() : m_mesh.m_N[v];
        const KM_2fPoint t = m_mesh.m_T.empty() ? KM_2fPoint() : m_mesh.m_T[v];
        const std::array<float, 8> numbers{p.x, p.y, p.z, n.x, n.y, n.z, t.x, t.y};
        return hashOfBits(numbers);
    }

    bool equals(std::uint32_t i, std::uint32_t v) const {
        return m_new.m_V[i] == m_mesh.m_V[v] &&
               (m_mesh.m_N.empty() || m_new.m_N[i] == m_mesh.m_N[v]) &&
               (m_mesh.m_T.empty() || m_new.m_T[i] == m_mesh.m_T[v]) &&
               (m_mesh.m_C.empty() || m_new.m_C[i] == m_mesh.m_C[v]);
    }

    void append(std::uint32_t v) {
        m_new.m_V.push_back(m_mesh.m_V[v]);
        if (!m_mesh.m_N.empty())
            m_new.m_N.push_back(m_mesh.m_N[v]);
        if (!m_mesh.m_T.empty())
            m_new.m_T.push_back(m_mesh.m_T[v]);
        if (!m_mesh.m_C.empty())
            m_new.m_C.push_back(m_mesh.m_C[v]);
    }

    KM_Mesh& m_mesh;
    bool m_welds;
    IndexTable m_table;
    std::vector<std::uint32_t> m_index; ///< of the old vertices among the new ones
    KM_Mesh m_new;
};

} // namespace

void dropUnusedVertices(KM_Mesh& mesh) {
    VertexRebuilding(mesh, false).run();
}

void weldVertices(KM_Mesh& mesh) {
    VertexRebuilding(mesh, true).run();
}

} // namespace quarn
