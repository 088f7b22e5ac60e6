#include "host/display/MeshEdges.h"

#include "host/display/PackedNormal.h"
#include "kelmar/KM_Mesh.h"

#include <algorithm>
#include <bit>
#include <cmath>

namespace quarn {

/// One side of a triangle, seen from its vertex of lower index.
struct HalfEdge {
    std::uint32_t other;    ///< the vertex of higher index
    std::uint32_t triangle; ///< the highest bit: the triangle runs from the higher to the lower
};

/// Unit normal; zero for a triangle without area.
struct FaceNormal {
    float x;
    float y;
    float z;
};

namespace {

constexpr std::uint32_t backward = 0x80000000U;
constexpr std::uint32_t no_vertex = 0xFFFFFFFFU;

float dot(const FaceNormal& a, const FaceNormal& b) {
    return a.x * b.x + a.y * b.y + a.z * b.z;
}

float cosine(float angle_deg) {
    return std::cos(angle_deg * 3.14159265F / 180.0F);
}

std::size_t placeHash(const KM_3fPoint& p) {
    const std::uint64_t x = std::bit_cast<std::uint32_t>(p.x);
    const std::uint64_t y = std::bit_cast<std::uint32_t>(p.y);
    const std::uint64_t z = std::bit_cast<std::uint32_t>(p.z);
    std::uint64_t h = (x * 0x9E3779B97F4A7C15ULL) ^ (y * 0xC2B2AE3D27D4EB4FULL + (x << 31)) ^
                      (z * 0x165667B19E3779F9ULL);
    h ^= h >> 29;
    h *= 0xBF58476D1CE4E5B9ULL;
    return static_cast<std::size_t>(h ^ (h >> 32));
}

/// Makes 0 of what rounding left of it, as at the poles of a computed sphere, and +0 of -0.
class PlaceRounding {
public:
    explicit PlaceRounding(const std::vector<KM_3fPoint>& vertices) {
        float largest = 0.0F;
        for (const KM_3fPoint& p : vertices)
            largest = std::max({largest, std::fabs(p.x), std::fabs(p.y), std::fabs(p.z)});
        m_zero = 1e-7F * largest;
    }
    KM_3fPoint operator()(const KM_3fPoint& p) const {
        const auto rounded = [this](float value) {
            return std::fabs(value) > m_zero ? value : 0.0F;
        };
        return {rounded(p.x), rounded(p.y), rounded(p.z)};
    }

private:
    float m_zero = 0.0F;
};

/// For each vertex the first one at the same place.
std::vector<std::uint32_t> weldedVertices(const std::vector<KM_3fPoint>& vertices) {
    const PlaceRounding place(vertices);
    const std::size_t size = std::bit_ceil(2 * vertices.size() + 1);
    std::vector<std::uint32_t> table(size, no_vertex);
    std::vector<std::uint32_t> first(vertices.size());
    for (std::size_t i = 0; i < vertices.size(); ++i) {
        const KM_3fPoint here = place(vertices[i]);
        std::size_t slot = placeHash(here) & (size - 1);
        while (table[slot] != no_vertex && !(place(vertices[table[slot]]) == here))
            slot = (slot + 1) & (size - 1);
        if (table[slot] == no_vertex)
            table[slot] = static_cast<std::uint32_t>(i);
        first[i] = table[slot];
    }
    return first;
}

FaceNormal faceNormal(const KM_3fPoint& a, const KM_3fPoint& b, const KM_3fPoint& c) {
    const double u[3] = {double{b.x} - a.x, double{b.y} - a.y, double{b.z} - a.z};
    const double v[3] = {double{c.x} - a.x, double{c.y} - a.y, double{c.z} - a.z};
    const double n[3] = {u[1] * v[2] - u[2] * v[1], u[2] * v[0] - u[0] * v[2],
                         u[0] * v[1] - u[1] * v[0]};
    const double length = std::sqrt(n[0] * n[0] + n[1] * n[1] + n[2] * n[2]);
    if (!(length > 0.0) || !std::isfinite(length))
        return {0.0F, 0.0F, 0.0F};
    return {static_cast<float>(n[0] / length), static_cast<float>(n[1] / length),
            static_cast<float>(n[2] / length)};
}

std::vector<FaceNormal> faceNormals(const KM_Mesh& mesh) {
    std::vector<FaceNormal> normals(mesh.m_F.size());
    std::transform(mesh.m_F.begin(), mesh.m_F.end(), normals.begin(), [&](const auto& t) {
        return faceNormal(mesh.m_V[t.vi[0]], mesh.m_V[t.vi[1]], mesh.m_V[t.vi[2]]);
    });
    return normals;
}

bool hasArea(const FaceNormal& n) {
    return n.x != 0.0F || n.y != 0.0F || n.z != 0.0F;
}

/// Calls function(lower, higher, triangle with direction bit) for the sides of all proper
/// triangles.
template <class Function>
void forEachSide(const KM_Mesh& mesh, const std::vector<std::uint32_t>& welded,
                 const std::vector<FaceNormal>& normals, const Function& function) {
    for (std::size_t t = 0; t < mesh.m_F.size(); ++t) {
        if (!hasArea(normals[t]))
            continue;
        for (int side = 0; side < 3; ++side) {
            const std::uint32_t a = welded[mesh.m_F[t].vi[side]];
            const std::uint32_t b = welded[mesh.m_F[t].vi[(side + 1) % 3]];
            if (a == b)
                continue;
            const auto triangle = static_cast<std::uint32_t>(t);
            if (a < b)
                function(a, b, triangle);
            else
                function(b, a, triangle | backward);
        }
    }
}

/// Half edges grouped by their lower vertex: those of vertex v lie from starts[v] to starts[v + 1].
struct HalfEdgeTable {
    std::vector<std::uint32_t> starts;
    std::vector<HalfEdge> edges;
};

HalfEdgeTable halfEdges(const KM_Mesh& mesh, const std::vector<FaceNormal>& normals) {
    const std::vector<std::uint32_t> welded = weldedVertices(mesh.m_V);
    HalfEdgeTable table;
    table.starts.assign(mesh.m_V.size() + 1, 0);
    forEachSide(mesh, welded, normals,
                [&](std::uint32_t a, std::uint32_t, std::uint32_t) { ++table.starts[a + 1]; });
    for (std::size_t i = 1; i < table.starts.size(); ++i)
        table.starts[i] += table.starts[i - 1];
    table.edges.resize(table.starts.back());
    std::vector<std::uint32_t> next(table.starts.begin(), table.starts.end() - 1);
    forEachSide(mesh, welded, normals, [&](std::uint32_t a, std::uint32_t b, std::uint32_t t) {
        table.edges[next[a]++] = {b, t};
    });
    return table;
}

double length(const KM_3fPoint& a, const KM_3fPoint& b) {
    return a.ToDouble().DistanceTo(b.ToDouble());
}

} // namespace

MeshEdges::MeshEdges(const KM_Mesh& mesh) {
    const std::vector<FaceNormal> normals = faceNormals(mesh);
    HalfEdgeTable table = halfEdges(mesh, normals);
    for (std::uint32_t v = 0; v + 1 < table.starts.size(); ++v) {
        const auto begin = table.edges.begin() + table.starts[v];
        const auto end = table.edges.begin() + table.starts[v + 1];
        std::stable_sort(begin, end,
                         [](const HalfEdge& a, const HalfEdge& b) { return a.other < b.other; });
        for (auto first = begin; first != end;) {
            const auto last = std::find_if(
                first, end, [first](const HalfEdge& e) { return e.other != first->other; });
            classify(mesh, {first, last}, v, normals);
            first = last;
        }
    }
    if (!m_smooth.empty())
        m_mean_smooth_length /= static_cast<double>(m_smooth.size());
}

void MeshEdges::classify(const KM_Mesh& mesh, std::span<const HalfEdge> alike, std::uint32_t from,
                         std::span<const FaceNormal> normals) {
    static const float crease_cosine = cosine(crease_angle_deg);
    static const float flat_cosine = cosine(flat_angle_deg);
    const std::uint32_t to = alike.front().other;
    if (alike.size() != 2) {
        m_features.push_back({from, to});
        return;
    }
    const FaceNormal& a = normals[alike[0].triangle & ~backward];
    FaceNormal b = normals[alike[1].triangle & ~backward];
    if ((alike[0].triangle & backward) == (alike[1].triangle & backward))
        b = {-b.x, -b.y, -b.z}; // wound the other way round
    const float c = dot(a, b);
    if (c < crease_cosine)
        m_features.push_back({from, to});
    if (c < crease_cosine || c > flat_cosine)
        return;
    m_smooth.push_back({from, to, packNormal(a.x, a.y, a.z), packNormal(b.x, b.y, b.z)});
    m_mean_smooth_length += length(mesh.m_V[from], mesh.m_V[to]);
}

} // namespace quarn
