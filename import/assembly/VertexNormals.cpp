#include "import/assembly/VertexNormals.h"

#include "import/assembly/IndexTable.h"

#include <tbb/parallel_for.h>

#include <array>
#include <cmath>
#include <cstdint>
#include <numbers>
#include <span>
#include <vector>

namespace quarn {
namespace {

/// Stars of more triangles than this are not compared pair by pair.
constexpr std::size_t largest_star = 512;

struct Vector {
    float x = 0.0F;
    float y = 0.0F;
    float z = 0.0F;
};

Vector operator-(const KM_3fPoint& a, const KM_3fPoint& b) {
    return {a.x - b.x, a.y - b.y, a.z - b.z};
}

Vector& operator+=(Vector& a, const Vector& b) {
    a = {a.x + b.x, a.y + b.y, a.z + b.z};
    return a;
}

float dot(const Vector& a, const Vector& b) {
    return a.x * b.x + a.y * b.y + a.z * b.z;
}

Vector scaled(const Vector& v, float factor) {
    return {v.x * factor, v.y * factor, v.z * factor};
}

/// Zero for a vector too short to have a direction, and for one that overflowed.
Vector unit(const Vector& v) {
    const float square = dot(v, v);
    return square > 0.0F && std::isfinite(square) ? scaled(v, 1.0F / std::sqrt(square)) : Vector{};
}

bool isZero(const Vector& v) {
    return v.x == 0.0F && v.y == 0.0F && v.z == 0.0F;
}

Vector cross(const Vector& a, const Vector& b) {
    return {a.y * b.z - a.z * b.y, a.z * b.x - a.x * b.z, a.x * b.y - a.y * b.x};
}

/// True where products of four lengths, whose square this is, stay well inside the range of a
/// float.
bool isModest(float square) {
    return square > 1e-9F && square < 1e9F;
}

/// The edges of tiny and huge triangles are made unit vectors first.
Vector faceNormal(const KM_Mesh& mesh, const KM_MeshTriangle& face) {
    const KM_3fPoint& origin = mesh.m_V[face.vi[0]];
    const Vector a = mesh.m_V[face.vi[1]] - origin;
    const Vector b = mesh.m_V[face.vi[2]] - origin;
    const bool modest = isModest(dot(a, a)) && isModest(dot(b, b));
    return unit(modest ? cross(a, b) : cross(unit(a), unit(b)));
}

/// The normal of a triangle at one of its corners, as long as its weight.
Vector weightedNormal(const KM_Mesh& mesh, const KM_MeshTriangle& face, int corner) {
    const KM_3fPoint& here = mesh.m_V[face.vi[corner]];
    const Vector a = mesh.m_V[face.vi[(corner + 1) % 3]] - here;
    const Vector b = mesh.m_V[face.vi[(corner + 2) % 3]] - here;
    const float aa = dot(a, a);
    const float bb = dot(b, b);
    if (isModest(aa) && isModest(bb)) {
        return scaled(cross(a, b), 1.0F / (aa * bb));
    }
    const float weight = std::sqrt(aa * bb);
    const Vector turned = cross(unit(a), unit(b));
    return weight > 0.0F && std::isfinite(1.0F / weight) ? scaled(turned, 1.0F / weight) : turned;
}

/// For each vertex the number of its place; vertices at one place have one number.
std::vector<std::uint32_t> placesOf(const KM_Mesh& mesh, std::size_t& place_count) {
    std::vector<std::uint32_t> places(mesh.m_V.size());
    const bool may_have_seams = !mesh.m_T.empty() || !mesh.m_C.empty();
    IndexTable table;
    std::vector<std::uint32_t> first_vertex;
    for (std::uint32_t v = 0; v < places.size(); ++v) {
        places[v] = v;
        if (!may_have_seams) {
            continue;
        }
        const KM_3fPoint& p = mesh.m_V[v];
        const std::array<float, 3> numbers{p.x + 0.0F, p.y + 0.0F, p.z + 0.0F};
        const auto next = static_cast<std::uint32_t>(first_vertex.size());
        places[v] = table.findOrAdd(hashOfBits(numbers), next, [&](std::uint32_t place) {
            return mesh.m_V[first_vertex[place]] == p;
        });
        if (places[v] == next) {
            first_vertex.push_back(v);
        }
    }
    place_count = may_have_seams ? first_vertex.size() : places.size();
    return places;
}

class CreaseSmoothing {
public:
    CreaseSmoothing(KM_Mesh& mesh, double crease_angle_deg)
        : m_mesh(mesh), m_cos_crease(cosine(crease_angle_deg)),
          m_cos_half_crease(cosine(0.5 * crease_angle_deg)) {}

    void run() {
        collectStars();
        m_mesh.m_N.assign(m_mesh.m_V.size(), KM_3fVector(0.0F, 0.0F, 1.0F));
        const std::size_t place_count = m_star_begin.size() - 1;
        std::vector<std::uint8_t> has_crease(place_count);
        // A vertex belongs to one star, so the stars do not meet. New vertices come afterwards, in
        // the order of their places.
        tbb::parallel_for(std::size_t{0}, place_count, [&](std::size_t place) {
            has_crease[place] = smoothStar(starAt(place)) ? 0 : 1;
        });
        for (std::size_t place = 0; place < place_count; ++place) {
            if (has_crease[place] != 0) {
                splitStar(starAt(place));
            }
        }
    }

private:
    struct SplitVertex {
        std::uint32_t original;
        std::uint32_t vertex;
        Vector normal;
    };

    static float cosine(double angle_deg) {
        return static_cast<float>(std::cos(angle_deg * std::numbers::pi / 180.0));
    }

    std::span<const std::uint32_t> starAt(std::size_t place) const {
        return {m_corners.data() + m_star_begin[place], m_corners.data() + m_star_begin[place + 1]};
    }

    /// Sorts the corners of all triangles by place. Corner 3 f + k is corner k of triangle f.
    void collectStars() {
        std::size_t place_count = 0;
        const std::vector<std::uint32_t> places = placesOf(m_mesh, place_count);
        m_star_begin.assign(place_count + 1, 0);
        m_face_normals.resize(m_mesh.m_F.size());
        tbb::parallel_for(std::size_t{0}, m_mesh.m_F.size(), [this](std::size_t f) {
            m_face_normals[f] = faceNormal(m_mesh, m_mesh.m_F[f]);
        });
        for (const KM_MeshTriangle& face : m_mesh.m_F) {
            for (const std::uint32_t v : face.vi) {
                ++m_star_begin[places[v]];
            }
        }
        std::uint32_t end = 0;
        for (std::uint32_t& begin : m_star_begin) {
            end += begin;
            begin = end;
        }
        m_corners.resize(end);
        for (std::size_t corner = end; corner-- > 0;) {
            const std::uint32_t place = places[m_mesh.m_F[corner / 3].vi[corner % 3]];
            m_corners[--m_star_begin[place]] = static_cast<std::uint32_t>(corner);
        }
    }

    Vector weighted(std::uint32_t corner) const {
        return weightedNormal(m_mesh, m_mesh.m_F[corner / 3], static_cast<int>(corner % 3));
    }

    std::uint32_t& vertexOf(std::uint32_t corner) { return m_mesh.m_F[corner / 3].vi[corner % 3]; }

    void setNormal(std::uint32_t vertex, const Vector& n) {
        m_mesh.m_N[vertex] = KM_3fVector(n.x, n.y, n.z);
    }

    Vector meanOf(std::span<const std::uint32_t> star) const {
        Vector sum;
        for (const std::uint32_t corner : star) {
            sum += weighted(corner);
        }
        return unit(sum);
    }

    /// @return false, with nothing done, where the star has a crease
    bool smoothStar(std::span<const std::uint32_t> star) {
        const Vector mean = meanOf(star);
        for (const std::uint32_t corner : star) {
            const Vector& n = m_face_normals[corner / 3];
            if (!isZero(n) && !(dot(n, mean) >= m_cos_half_crease)) {
                return false;
            }
        }
        for (const std::uint32_t corner : star) {
            if (!isZero(mean)) {
                setNormal(vertexOf(corner), mean);
            }
        }
        return true;
    }

    void splitStar(std::span<const std::uint32_t> star) {
        const Vector mean = meanOf(star);
        m_splits.clear();
        for (const std::uint32_t corner : star) {
            Vector normal = unit(sumWithinCrease(star, corner));
            if (isZero(normal)) {
                normal = isZero(mean) ? Vector{0.0F, 0.0F, 1.0F} : mean;
            }
            vertexOf(corner) = vertexWith(vertexOf(corner), normal);
        }
    }

    Vector sumWithinCrease(std::span<const std::uint32_t> star, std::uint32_t corner) const {
        const Vector& n = m_face_normals[corner / 3];
        if (star.size() > largest_star) {
            return n;
        }
        Vector sum;
        for (const std::uint32_t other : star) {
            if (dot(n, m_face_normals[other / 3]) >= m_cos_crease) {
                sum += weighted(other);
            }
        }
        return sum;
    }

    /// The vertex for a corner of the star in hand: one that has this normal already, or a new one.
    std::uint32_t vertexWith(std::uint32_t original, const Vector& normal) {
        constexpr float same_direction = 0.99999F;
        std::uint32_t vertex = original;
        std::size_t compared = 0;
        for (const SplitVertex& split : m_splits) {
            if (split.original != original || ++compared > largest_star) {
                continue;
            }
            if (dot(split.normal, normal) > same_direction) {
                return split.vertex;
            }
            vertex = IndexTable::none; // the original has another normal by now
        }
        if (vertex == IndexTable::none) {
            vertex = copyOf(original);
        }
        setNormal(vertex, normal);
        m_splits.push_back({original, vertex, normal});
        return vertex;
    }

    std::uint32_t copyOf(std::uint32_t original) {
        const auto vertex = static_cast<std::uint32_t>(m_mesh.m_V.size());
        const KM_3fPoint place = m_mesh.m_V[original];
        m_mesh.m_V.push_back(place);
        m_mesh.m_N.emplace_back();
        if (!m_mesh.m_T.empty()) {
            const KM_2fPoint t = m_mesh.m_T[original];
            m_mesh.m_T.push_back(t);
        }
        if (!m_mesh.m_C.empty()) {
            const KM_Color c = m_mesh.m_C[original];
            m_mesh.m_C.push_back(c);
        }
        return vertex;
    }

    KM_Mesh& m_mesh;
    float m_cos_crease;
    float m_cos_half_crease;
    std::vector<Vector> m_face_normals;
    std::vector<std::uint32_t> m_star_begin; ///< by place, and one past the last
    std::vector<std::uint32_t> m_corners;
    std::vector<SplitVertex> m_splits;
};

} // namespace

void smoothVertexNormals(KM_Mesh& mesh, double crease_angle_deg) {
    CreaseSmoothing(mesh, crease_angle_deg).run();
}

void fillMissingNormals(KM_Mesh& mesh) {
    const auto missing = [&mesh](std::uint32_t v) { return mesh.m_N[v] == KM_3fVector(); };
    std::vector<Vector> sums;
    for (const KM_MeshTriangle& face : mesh.m_F) {
        for (int corner = 0; corner < 3; ++corner) {
            if (missing(face.vi[corner])) {
                sums.resize(mesh.m_V.size());
                sums[face.vi[corner]] += weightedNormal(mesh, face, corner);
            }
        }
    }
    for (std::uint32_t v = 0; v < sums.size(); ++v) {
        if (missing(v)) {
            const Vector n = unit(sums[v]);
            mesh.m_N[v] = isZero(n) ? KM_3fVector(0.0F, 0.0F, 1.0F) : KM_3fVector(n.x, n.y, n.z);
        }
    }
}

} // namespace quarn
