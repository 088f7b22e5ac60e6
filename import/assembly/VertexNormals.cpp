#include "import/assembly/VertexNormals.h"

#include "import/assembly/EqualItems.h"
#include "import/assembly/FaceNormals.h"
#include "import/assembly/IndexTable.h"

#include <tbb/global_control.h>
#include <tbb/parallel_for.h>
#include <tbb/task_arena.h>

#include <algorithm>
#include <array>
#include <atomic>
#include <cmath>
#include <cstdint>
#include <numbers>
#include <span>
#include <utility>
#include <vector>

namespace quarn {
namespace {

using namespace face_normals;

/// Stars of more triangles than this are not compared pair by pair.
constexpr std::size_t largest_star = 512;

/// For each vertex the number of its place; vertices at one place have one number. Empty where each
/// vertex has a place of its own.
std::vector<std::uint32_t> placesOf(const KM_Mesh& mesh, std::size_t& place_count) {
    place_count = mesh.m_V.size();
    const bool may_have_seams = !mesh.m_T.empty() || !mesh.m_C.empty();
    if (!may_have_seams)
        return {};
    std::vector<std::uint32_t> places(mesh.m_V.size());
    const auto hash = [&mesh](std::uint32_t v) {
        const KM_3fPoint& p = mesh.m_V[v];
        return hashOfBits(std::array<float, 3>{p.x + 0.0F, p.y + 0.0F, p.z + 0.0F});
    };
    const auto equals = [&mesh](std::uint32_t a, std::uint32_t b) {
        return mesh.m_V[a] == mesh.m_V[b];
    };
    EqualItems(hash, equals).find(places);
    std::uint32_t next = 0;
    for (std::uint32_t v = 0; v < places.size(); ++v) // the first vertex of a place stands before
        places[v] = places[v] == v ? next++ : places[places[v]];
    place_count = next;
    return places;
}

/// Calls `work` with the borders of ranges that together are 0 to `count`, each from one thread.
template <class Work> void forRanges(std::size_t count, std::size_t ranges, const Work& work) {
    tbb::parallel_for(std::size_t{0}, ranges, [&](std::size_t range) {
        work(count * range / ranges, count * (range + 1) / ranges);
    });
}

class CreaseSmoothing {
public:
    CreaseSmoothing(KM_Mesh& mesh, double crease_angle_deg)
        : m_mesh(mesh), m_cos_crease(cosine(crease_angle_deg)),
          m_cos_half_crease(cosine(0.5 * crease_angle_deg)),
          m_places(placesOf(mesh, m_place_count)), m_ranges(rangesFor(mesh.m_F.size())) {}

    void run() {
        sumNormals();
        findCreases();
        takeMeans();
        if (m_crease_count > 0) {
            collectStars();
            splitStars();
        }
    }

private:
    struct SplitVertex {
        std::uint32_t original;
        std::uint32_t vertex;
        Vector normal;
    };

    /// One corner of a star.
    struct Ray {
        Vector normal;   ///< of its triangle
        Vector weighted; ///< the same, as long as its weight
    };

    /// Stars that one thread splits. The numbers of new vertices begin behind those of the mesh and
    /// are moved on when it is known how many those of the blocks before are.
    struct Block {
        std::size_t first_star = 0;
        std::size_t end_star = 0;
        std::vector<SplitVertex> created;
        std::size_t first_created = 0;   ///< among those of all blocks
        std::vector<Ray> rays;           ///< of the star in hand
        std::vector<SplitVertex> splits; ///< likewise
    };

    static constexpr std::size_t STARS_OF_BLOCK = 4096;
    static constexpr std::uint32_t SMOOTH = 0xFFFFFFFFU;

    static float cosine(double angle_deg) {
        return static_cast<float>(std::cos(angle_deg * std::numbers::pi / 180.0));
    }

    /// Each thread walks over all triangles and takes what belongs to its own places, so that sums
    /// come out the same however many threads there are.
    static std::size_t rangesFor(std::size_t triangles) {
        constexpr std::size_t WORTH_A_THREAD = 8192;
        constexpr std::size_t MOST_RANGES = 16;
        const auto threads = std::min(
            static_cast<std::size_t>(tbb::this_task_arena::max_concurrency()),
            tbb::global_control::active_value(tbb::global_control::max_allowed_parallelism));
        return std::clamp<std::size_t>(std::min(threads, triangles / WORTH_A_THREAD), 1,
                                       MOST_RANGES);
    }

    std::uint32_t placeOf(std::uint32_t vertex) const {
        return m_places.empty() ? vertex : m_places[vertex];
    }

    /// The sums of the places: they become the normals where each vertex is a place.
    std::vector<Vector>& sums() { return m_places.empty() ? m_mesh.m_N : m_sums; }

    void sumNormals() {
        std::vector<Vector>& sums = this->sums();
        sums.assign(m_place_count, Vector());
        forRanges(m_place_count, m_ranges, [&](std::size_t begin, std::size_t end) {
            for (const KM_MeshTriangle& face : m_mesh.m_F)
                for (int corner = 0; corner < 3; ++corner) {
                    const std::uint32_t place = placeOf(face.vi[corner]);
                    if (place >= begin && place < end)
                        sums[place] += weightedNormal(m_mesh, face, corner);
                }
            for (std::size_t place = begin; place < end; ++place)
                sums[place] = unit(sums[place]);
        });
    }

    /// A place has a crease where a triangle turns away too far from the mean.
    void findCreases() {
        const std::vector<Vector>& means = sums();
        m_has_crease.assign(m_place_count, 0);
        tbb::parallel_for(std::size_t{0}, m_mesh.m_F.size(), [&](std::size_t f) {
            const KM_MeshTriangle& face = m_mesh.m_F[f];
            const Vector n = faceNormal(m_mesh, face);
            if (isZero(n))
                return;
            for (const std::uint32_t v : face.vi)
                if (!(dot(n, means[placeOf(v)]) >= m_cos_half_crease))
                    std::atomic_ref(m_has_crease[placeOf(v)]).store(1, std::memory_order_relaxed);
        });
        m_crease_count = static_cast<std::size_t>(std::ranges::count(m_has_crease, 1));
    }

    void takeMeans() {
        m_mesh.m_N.resize(m_mesh.m_V.size());
        tbb::parallel_for(std::size_t{0}, m_mesh.m_N.size(), [&](std::size_t v) {
            const Vector mean = sums()[placeOf(static_cast<std::uint32_t>(v))];
            m_mesh.m_N[v] = isZero(mean) ? Vector(0.0F, 0.0F, 1.0F) : mean;
        });
    }

    /// Sorts the corners of the triangles that meet at a place with a crease. Corner 3 f + k is
    /// corner k of triangle f.
    void collectStars() {
        std::vector<std::uint32_t> stars(m_place_count, SMOOTH);
        std::uint32_t next = 0;
        for (std::size_t place = 0; place < m_place_count; ++place)
            if (m_has_crease[place] != 0)
                stars[place] = next++;
        m_star_begin.assign(m_crease_count + 1, 0);
        forCornersOfStars(stars,
                          [this](std::uint32_t star, std::uint32_t) { ++m_star_begin[star]; });
        std::uint32_t end = 0;
        for (std::uint32_t& begin : m_star_begin)
            end += std::exchange(begin, end);
        m_corners.resize(end);
        std::vector<std::uint32_t> free(m_star_begin.begin(), m_star_begin.end() - 1);
        forCornersOfStars(stars, [&](std::uint32_t star, std::uint32_t corner) {
            m_corners[free[star]++] = corner;
        });
    }

    /// Calls `take` with the corners of each star in their order, those of one star from one
    /// thread.
    template <class Take>
    void forCornersOfStars(const std::vector<std::uint32_t>& stars, const Take& take) {
        forRanges(m_crease_count, m_ranges, [&](std::size_t begin, std::size_t end) {
            for (std::size_t f = 0; f < m_mesh.m_F.size(); ++f)
                for (std::size_t k = 0; k < 3; ++k) {
                    const std::uint32_t star = stars[placeOf(m_mesh.m_F[f].vi[k])];
                    if (star >= begin && star < end)
                        take(star, static_cast<std::uint32_t>(3 * f + k));
                }
        });
    }

    /// A vertex belongs to one star, so the stars do not meet. New vertices come in the order of
    /// their stars.
    void splitStars() {
        m_new_vertices.resize(m_corners.size());
        std::vector<Block> blocks((m_crease_count + STARS_OF_BLOCK - 1) / STARS_OF_BLOCK);
        tbb::parallel_for(std::size_t{0}, blocks.size(), [&](std::size_t i) {
            blocks[i].first_star = i * STARS_OF_BLOCK;
            blocks[i].end_star = std::min((i + 1) * STARS_OF_BLOCK, m_crease_count);
            for (std::size_t star = blocks[i].first_star; star < blocks[i].end_star; ++star)
                splitStar(star, blocks[i]);
        });
        const std::size_t old_count = m_mesh.m_V.size();
        std::size_t created = 0;
        for (Block& block : blocks)
            block.first_created = std::exchange(created, created + block.created.size());
        makeRoom(old_count + created);
        tbb::parallel_for(std::size_t{0}, blocks.size(),
                          [&](std::size_t i) { takeBlock(blocks[i], old_count); });
    }

    std::uint32_t& vertexOf(std::uint32_t corner) { return m_mesh.m_F[corner / 3].vi[corner % 3]; }

    void splitStar(std::size_t star, Block& block) {
        const std::uint32_t begin = m_star_begin[star];
        const std::uint32_t end = m_star_begin[star + 1];
        block.rays.clear();
        block.splits.clear();
        Vector sum;
        for (std::uint32_t i = begin; i < end; ++i) {
            const KM_MeshTriangle& face = m_mesh.m_F[m_corners[i] / 3];
            const int corner = static_cast<int>(m_corners[i] % 3);
            block.rays.push_back({faceNormal(m_mesh, face), weightedNormal(m_mesh, face, corner)});
            sum += block.rays.back().weighted;
        }
        const Vector mean = unit(sum);
        for (std::uint32_t i = begin; i < end; ++i) {
            Vector normal = unit(sumWithinCrease(block.rays, block.rays[i - begin]));
            if (isZero(normal))
                normal = isZero(mean) ? Vector(0.0F, 0.0F, 1.0F) : mean;
            m_new_vertices[i] = vertexWith(vertexOf(m_corners[i]), normal, block);
        }
    }

    Vector sumWithinCrease(std::span<const Ray> star, const Ray& ray) const {
        if (star.size() > largest_star)
            return ray.normal;
        Vector sum;
        for (const Ray& other : star)
            if (dot(ray.normal, other.normal) >= m_cos_crease)
                sum += other.weighted;
        return sum;
    }

    /// The vertex for a corner of the star in hand: one that has this normal already, or a new one.
    std::uint32_t vertexWith(std::uint32_t original, const Vector& normal, Block& block) {
        constexpr float same_direction = 0.99999F;
        std::uint32_t vertex = original;
        std::size_t compared = 0;
        for (const SplitVertex& split : block.splits) {
            if (split.original != original || ++compared > largest_star)
                continue;
            if (dot(split.normal, normal) > same_direction)
                return split.vertex;
            vertex = IndexTable::none; // the original has another normal by now
        }
        if (vertex == original) {
            m_mesh.m_N[original] = normal;
        } else {
            vertex = static_cast<std::uint32_t>(m_mesh.m_V.size() + block.created.size());
            block.created.push_back({original, vertex, normal});
        }
        block.splits.push_back({original, vertex, normal});
        return vertex;
    }

    void makeRoom(std::size_t count) {
        m_mesh.m_V.reserve(count + 1); // see PadForRayTracing
        m_mesh.m_V.resize(count);
        m_mesh.m_N.resize(count);
        m_mesh.m_T.resize(m_mesh.m_T.empty() ? 0 : count);
        m_mesh.m_C.resize(m_mesh.m_C.empty() ? 0 : count);
    }

    void takeBlock(const Block& block, std::size_t old_count) {
        std::size_t vertex = old_count + block.first_created;
        for (const SplitVertex& created : block.created) {
            m_mesh.m_V[vertex] = m_mesh.m_V[created.original];
            m_mesh.m_N[vertex] = created.normal;
            if (!m_mesh.m_T.empty())
                m_mesh.m_T[vertex] = m_mesh.m_T[created.original];
            if (!m_mesh.m_C.empty())
                m_mesh.m_C[vertex] = m_mesh.m_C[created.original];
            ++vertex;
        }
        for (std::uint32_t i = m_star_begin[block.first_star]; i < m_star_begin[block.end_star];
             ++i) {
            const std::uint32_t taken = m_new_vertices[i];
            const bool is_new = taken >= old_count;
            vertexOf(m_corners[i]) =
                taken + static_cast<std::uint32_t>(is_new ? block.first_created : 0);
        }
    }

    KM_Mesh& m_mesh;
    float m_cos_crease;
    float m_cos_half_crease;
    std::size_t m_place_count = 0;
    std::vector<std::uint32_t> m_places; ///< of vertices; empty where each is a place
    std::size_t m_ranges;
    std::vector<Vector> m_sums;             ///< of places, where these are no vertices
    std::vector<std::uint8_t> m_has_crease; ///< of places
    std::size_t m_crease_count = 0;
    std::vector<std::uint32_t> m_star_begin;   ///< by place with a crease, and one past the last
    std::vector<std::uint32_t> m_corners;      ///< of the stars
    std::vector<std::uint32_t> m_new_vertices; ///< of those corners
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
