#include "import/assembly/MeshCleaning.h"

#include "import/assembly/EqualItems.h"
#include "import/assembly/IndexTable.h"

#include <tbb/blocked_range.h>
#include <tbb/parallel_for.h>
#include <tbb/parallel_reduce.h>

#include <algorithm>
#include <array>
#include <atomic>
#include <cmath>
#include <cstdint>
#include <vector>

namespace quarn {

namespace {

bool isUsable(const KM_3fPoint& p) {
    return std::isfinite(p.x) && std::isfinite(p.y) && std::isfinite(p.z);
}

bool allUsable(const std::vector<KM_3fPoint>& points) {
    using Range = tbb::blocked_range<std::size_t>;
    return tbb::parallel_reduce(
        Range(0, points.size(), 16384), true,
        [&](const Range& range, bool all) {
            for (std::size_t i = range.begin(); i != range.end(); ++i)
                all = all && isUsable(points[i]);
            return all;
        },
        [](bool a, bool b) { return a && b; });
}

/// Which vertices triangles name, as ones.
std::vector<std::uint8_t> usedVertices(const KM_Mesh& mesh) {
    std::vector<std::uint8_t> used(mesh.m_V.size());
    tbb::parallel_for(tbb::blocked_range<std::size_t>(0, mesh.m_F.size(), 16384),
                      [&](const auto& range) {
                          for (std::size_t f = range.begin(); f != range.end(); ++f)
                              for (const std::uint32_t v : mesh.m_F[f].vi)
                                  std::atomic_ref(used[v]).store(1, std::memory_order_relaxed);
                      });
    return used;
}

void renumber(KM_Mesh& mesh, const std::vector<std::uint32_t>& numbers) {
    tbb::parallel_for(tbb::blocked_range<std::size_t>(0, mesh.m_F.size(), 16384),
                      [&](const auto& range) {
                          for (std::size_t f = range.begin(); f != range.end(); ++f)
                              for (std::uint32_t& v : mesh.m_F[f].vi)
                                  v = numbers[v];
                      });
}

/// Of all that a vertex has: of those at one place, many may differ in the rest.
std::uint32_t hashOf(const KM_Mesh& mesh, std::uint32_t v) {
    const KM_3fPoint& p = mesh.m_V[v];
    const std::array<float, 3> place{p.x + 0.0F, p.y + 0.0F, p.z + 0.0F};
    std::uint32_t hash = hashOfBits(place);
    const auto add = [&hash](auto... numbers) {
        const std::array parts{(static_cast<float>(numbers) + 0.0F)...};
        hash = 31U * hash + hashOfBits(parts);
    };
    if (!mesh.m_N.empty())
        add(mesh.m_N[v].x, mesh.m_N[v].y, mesh.m_N[v].z);
    if (!mesh.m_T.empty())
        add(mesh.m_T[v].x, mesh.m_T[v].y);
    if (!mesh.m_C.empty())
        add(mesh.m_C[v].r, mesh.m_C[v].g, mesh.m_C[v].b, mesh.m_C[v].a);
    return hash;
}

bool areEqual(const KM_Mesh& mesh, std::uint32_t a, std::uint32_t b) {
    const auto same = [a, b](const auto& items) { return items.empty() || items[a] == items[b]; };
    return same(mesh.m_V) && same(mesh.m_N) && same(mesh.m_T) && same(mesh.m_C);
}

/// Keeps what belongs to the vertices that are marked.
template <class Item>
void keepMarked(std::vector<Item>& items, const std::vector<std::uint8_t>& marks) {
    if (items.empty())
        return;
    std::size_t kept = 0;
    for (std::size_t i = 0; i < marks.size(); ++i)
        if (marks[i] != 0)
            items[kept++] = items[i];
    items.resize(kept);
}

void keepMarkedVertices(KM_Mesh& mesh, const std::vector<std::uint8_t>& marks) {
    keepMarked(mesh.m_V, marks);
    keepMarked(mesh.m_N, marks);
    keepMarked(mesh.m_T, marks);
    keepMarked(mesh.m_C, marks);
}

} // namespace

std::size_t dropUnusableTriangles(KM_Mesh& mesh) {
    if (allUsable(mesh.m_V))
        return 0;
    const std::size_t dropped = std::erase_if(mesh.m_F, [&](const KM_MeshTriangle& triangle) {
        return !std::ranges::all_of(triangle.vi,
                                    [&](std::uint32_t v) { return isUsable(mesh.m_V[v]); });
    });
    for (KM_3fPoint& vertex : mesh.m_V)
        if (!isUsable(vertex))
            vertex = {}; // of no triangle any more
    return dropped;
}

void dropUnusedVertices(KM_Mesh& mesh) {
    const std::vector<std::uint8_t> used = usedVertices(mesh);
    if (std::ranges::find(used, 0) == used.end())
        return;
    std::vector<std::uint32_t> numbers(used.size());
    std::uint32_t next = 0;
    for (std::size_t v = 0; v < used.size(); ++v)
        numbers[v] = used[v] != 0 ? next++ : 0;
    renumber(mesh, numbers);
    keepMarkedVertices(mesh, used);
}

void weldVertices(KM_Mesh& mesh) {
    std::vector<std::uint32_t> numbers(mesh.m_V.size());
    const auto hash = [&mesh](std::uint32_t v) { return hashOf(mesh, v); };
    const auto equals = [&mesh](std::uint32_t a, std::uint32_t b) { return areEqual(mesh, a, b); };
    EqualItems(hash, equals).find(numbers);
    std::vector<std::uint8_t> is_first(numbers.size());
    std::uint32_t next = 0;
    for (std::uint32_t v = 0; v < numbers.size(); ++v) {
        is_first[v] = numbers[v] == v ? 1 : 0;
        numbers[v] = is_first[v] != 0 ? next++ : numbers[numbers[v]]; // the first one stands before
    }
    if (next == numbers.size())
        return;
    renumber(mesh, numbers);
    keepMarkedVertices(mesh, is_first);
}

void weldSparseMesh(KM_Mesh& mesh) {
    if (mesh.m_V.size() > mesh.m_F.size())
        weldVertices(mesh);
}

} // namespace quarn
