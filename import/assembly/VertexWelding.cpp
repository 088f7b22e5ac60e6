#include "import/assembly/VertexWelding.h"

#include "import/assembly/IndexTable.h"

#include <array>
#include <cstddef>
#include <cstdint>
#include <vector>

namespace quarn {

namespace {

/// In a closed mesh six triangles meet at a vertex.
constexpr std::size_t USUAL_SHARING = 6;

template <class Part> Part partAt(const std::vector<Part>& parts, std::uint32_t vertex) {
    return parts.empty() ? Part{} : parts[vertex];
}

bool areEqual(const KM_Mesh& mesh, std::uint32_t a, std::uint32_t b) {
    return mesh.m_V[a] == mesh.m_V[b] && partAt(mesh.m_N, a) == partAt(mesh.m_N, b) &&
           partAt(mesh.m_T, a) == partAt(mesh.m_T, b) && partAt(mesh.m_C, a) == partAt(mesh.m_C, b);
}

std::uint32_t hashOf(const KM_Mesh& mesh, std::uint32_t vertex) {
    const KM_3fPoint& place = mesh.m_V[vertex];
    const KM_3fVector normal = partAt(mesh.m_N, vertex);
    const KM_2fPoint texture = partAt(mesh.m_T, vertex);
    const std::array<float, 8> numbers{place.x,  place.y,  place.z,   normal.x,
                                       normal.y, normal.z, texture.x, texture.y};
    return hashOfBits(numbers);
}

template <class Part> void keep(std::vector<Part>& parts, const std::vector<std::uint32_t>& kept) {
    if (parts.empty())
        return;
    for (std::size_t i = 0; i < kept.size(); ++i)
        parts[i] = parts[kept[i]];
    parts.resize(kept.size());
}

} // namespace

void weldVertices(KM_Mesh& mesh) {
    IndexTable table(mesh.m_V.size() / USUAL_SHARING);
    std::vector<std::uint32_t> kept; // vertices, by their new numbers, which grow with the old ones
    std::vector<std::uint32_t> number(mesh.m_V.size());
    for (std::uint32_t v = 0; v < number.size(); ++v) {
        const auto next = static_cast<std::uint32_t>(kept.size());
        number[v] = table.findOrAdd(hashOf(mesh, v), next,
                                    [&](std::uint32_t i) { return areEqual(mesh, kept[i], v); });
        if (number[v] == next)
            kept.push_back(v);
    }
    if (kept.size() == number.size())
        return;
    for (KM_MeshTriangle& triangle : mesh.m_F)
        for (std::uint32_t& vertex : triangle.vi)
            vertex = number[vertex];
    keep(mesh.m_V, kept);
    keep(mesh.m_N, kept);
    keep(mesh.m_T, kept);
    keep(mesh.m_C, kept);
}

} // namespace quarn
