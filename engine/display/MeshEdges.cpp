#include "engine/display/MeshEdges.h"

#include "engine/display/PackedNormal.h"
#include "kelmar/KM_Mesh.h"

#include <algorithm>
#include <bit>
#include <cmath>
#include <numeric>

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

HalfEdgeTable halfEdges(const KM_Mesh& mesh, const std::vector<std::uint32_t>& welded,
                        const std::vector<FaceNormal>& normals) {
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

std::uint32_t packed(const FaceNormal& n) {
    return packNormal(n.x, n.y, n.z);
}

std::uint32_t triangleOf(const HalfEdge& edge) {
    return edge.triangle & ~backward;
}

/// Vertices that hang together by edges: each points to another of its set, the root to itself (R.
/// E. Tarjan, "Efficiency of a Good But Not Linear Set Union Algorithm", 1975).
class VertexSets {
public:
    explicit VertexSets(std::size_t count) : m_parent(count) {
        std::iota(m_parent.begin(), m_parent.end(), 0U);
    }
    std::uint32_t root(std::uint32_t v) {
        while (m_parent[v] != v)
            v = m_parent[v] = m_parent[m_parent[v]];
        return v;
    }
    /// @return false when both were in one set already: the edge closes a loop
    bool join(std::uint32_t a, std::uint32_t b) {
        a = root(a);
        b = root(b);
        m_parent[std::max(a, b)] = std::min(a, b);
        return a != b;
    }

private:
    std::vector<std::uint32_t> m_parent;
};

} // namespace

/// What the triangles at an edge are like.
class EdgeFinder {
public:
    explicit EdgeFinder(const KM_Mesh& mesh)
        : m_mesh(mesh), m_welded(weldedVertices(mesh.m_V)), m_normals(faceNormals(mesh)) {}

    HalfEdgeTable table() const { return halfEdges(m_mesh, m_welded, m_normals); }
    const FaceNormal& normal(const HalfEdge& edge) const { return m_normals[triangleOf(edge)]; }

    /// @param cosine_between  of the normals of the two triangles
    bool isCrease(const HalfEdge& a, const HalfEdge& b, std::uint32_t from,
                  float cosine_between) const {
        static const float unknown = cosine(MeshEdges::crease_angle_deg);
        static const float broken = cosine(MeshEdges::broken_crease_deg);
        static const float smooth = cosine(MeshEdges::smooth_crease_deg);
        if (cosine_between >= broken)
            return false;
        if (m_mesh.m_N.size() != m_mesh.m_V.size())
            return cosine_between < unknown;
        if (cosine_between < smooth)
            return true;
        return !normalsRunOn(a, b, from) || !normalsRunOn(a, b, a.other);
    }

private:
    std::uint32_t cornerAt(const HalfEdge& edge, std::uint32_t vertex) const {
        const std::uint32_t* const corners = m_mesh.m_F[triangleOf(edge)].vi;
        return *std::find_if(corners, corners + 2,
                             [&](std::uint32_t v) { return m_welded[v] == vertex; });
    }

    /// True when both triangles have the same vertex normal here, give or take 8 degrees.
    bool normalsRunOn(const HalfEdge& a, const HalfEdge& b, std::uint32_t vertex) const {
        const auto& p = m_mesh.m_N[cornerAt(a, vertex)];
        const auto& q = m_mesh.m_N[cornerAt(b, vertex)];
        const float product = p.x * q.x + p.y * q.y + p.z * q.z;
        const float squares =
            (p.x * p.x + p.y * p.y + p.z * p.z) * (q.x * q.x + q.y * q.y + q.z * q.z);
        return product > 0.99F * std::sqrt(squares);
    }

    const KM_Mesh& m_mesh;
    std::vector<std::uint32_t> m_welded;
    std::vector<FaceNormal> m_normals;
};

MeshEdges::MeshEdges(const KM_Mesh& mesh) {
    const EdgeFinder finder(mesh);
    HalfEdgeTable table = finder.table();
    for (std::uint32_t v = 0; v + 1 < table.starts.size(); ++v) {
        const auto begin = table.edges.begin() + table.starts[v];
        const auto end = table.edges.begin() + table.starts[v + 1];
        std::stable_sort(begin, end,
                         [](const HalfEdge& a, const HalfEdge& b) { return a.other < b.other; });
        for (auto first = begin; first != end;) {
            const auto last = std::find_if(
                first, end, [first](const HalfEdge& e) { return e.other != first->other; });
            classify(finder, {first, last}, v);
            first = last;
        }
    }
    dropAccidentalCreases(mesh);
    measureInner(mesh);
}

void MeshEdges::classify(const EdgeFinder& finder, std::span<const HalfEdge> alike,
                         std::uint32_t from) {
    static const float flat_cosine = cosine(flat_angle_deg);
    const std::uint32_t to = alike.front().other;
    const FaceNormal& a = finder.normal(alike[0]);
    if (alike.size() != 2) {
        m_features.push_back({from, to, packed(a), packed({-a.x, -a.y, -a.z})});
        return;
    }
    FaceNormal b = finder.normal(alike[1]);
    if ((alike[0].triangle & backward) == (alike[1].triangle & backward))
        b = {-b.x, -b.y, -b.z}; // wound the other way round
    const float c = dot(a, b);
    if (c > flat_cosine)
        m_flat.push_back({from, to});
    else if (finder.isCrease(alike[0], alike[1], from, c))
        m_features.push_back({from, to, packed(a), packed(b)});
    else
        m_smooth.push_back({from, to, packed(a), packed(b)});
}

void MeshEdges::dropAccidentalCreases(const KM_Mesh& mesh) {
    if (m_features.empty() || m_smooth.empty())
        return;
    const auto isBorderOrBlade = [](const Edge& edge) {
        float a[3];
        float b[3];
        unpackNormal(edge.normal_a, a);
        unpackNormal(edge.normal_b, b);
        return a[0] * b[0] + a[1] * b[1] + a[2] * b[2] < 0.0F;
    };
    VertexSets sets(mesh.m_V.size());
    std::vector<std::uint32_t> looped;
    for (const Edge& edge : m_features)
        if (!sets.join(edge.from, edge.to) || isBorderOrBlade(edge))
            looped.push_back(edge.from);
    std::vector<float> worth(mesh.m_V.size(), 0.0F); // by root
    for (const Edge& edge : m_features)
        worth[sets.root(edge.from)] +=
            static_cast<float>(length(mesh.m_V[edge.from], mesh.m_V[edge.to]));
    const double size = mesh.BoundingBox().Diagonal().Length();
    const auto enough = static_cast<float>(shortest_crease * size);
    for (const std::uint32_t vertex : looped)
        worth[sets.root(vertex)] = enough;
    const auto accidental = [&](const Edge& edge) { return worth[sets.root(edge.from)] < enough; };
    std::copy_if(m_features.begin(), m_features.end(), std::back_inserter(m_smooth), accidental);
    std::erase_if(m_features, accidental);
}

void MeshEdges::measureInner(const KM_Mesh& mesh) {
    const std::size_t count = m_smooth.size() + m_flat.size();
    if (count == 0)
        return;
    double sum = 0.0;
    const auto add = [&](const auto& edge) {
        sum += length(mesh.m_V[edge.from], mesh.m_V[edge.to]);
    };
    std::for_each(m_smooth.begin(), m_smooth.end(), add);
    std::for_each(m_flat.begin(), m_flat.end(), add);
    m_mean_inner_length = sum / static_cast<double>(count);
}

} // namespace quarn
