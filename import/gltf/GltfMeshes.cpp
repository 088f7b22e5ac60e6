#include "import/gltf/GltfMeshes.h"

#include "import/assembly/MeshPlacing.h"
#include "import/assembly/PolylineChains.h"
#include "import/gltf/GltfContainer.h"
#include "import/gltf/GltfTriangles.h"

#include <algorithm>
#include <utility>

namespace quarn::gltf {

namespace {

constexpr std::uint64_t MOST_TRIANGLES = 1'000'000'000; // their corners are counted in 32 bits
constexpr std::uint64_t MEMORY_OF_TRIANGLE = 2 * sizeof(KM_MeshTriangle);
constexpr std::uint64_t MEMORY_OF_SEGMENT = 256; // with the table that joins them
constexpr std::uint64_t MEMORY_OF_POINT = 2 * sizeof(KM_3dPoint);

bool isUsable(const KM_3fPoint& p) {
    return isUsableCoordinate(static_cast<double>(p.x)) &&
           isUsableCoordinate(static_cast<double>(p.y)) &&
           isUsableCoordinate(static_cast<double>(p.z));
}

std::uint64_t cornersOf(const Primitive& primitive) {
    return primitive.indices ? primitive.indices->count : primitive.positions.count;
}

/// The vertex at a corner, which may be beyond the last.
std::uint64_t vertexAt(const Primitive& primitive, std::uint64_t corner) {
    return primitive.indices ? primitive.indices->index(corner) : corner;
}

std::uint64_t segmentsOf(PrimitiveMode mode, std::uint64_t corners) {
    if (mode == PrimitiveMode::lines)
        return corners / 2;
    if (corners < 2)
        return 0;
    return mode == PrimitiveMode::line_loop ? corners : corners - 1;
}

/// The corner where a segment begins; it ends at the next.
std::uint64_t beginOfSegment(PrimitiveMode mode, std::uint64_t segment) {
    return mode == PrimitiveMode::lines ? 2 * segment : segment;
}

std::uint64_t memoryOfVertex(const Primitive& primitive) {
    return sizeof(KM_3fPoint) + sizeof(KM_3fVector) +
           (primitive.texture_coordinates ? sizeof(KM_2fPoint) : 0) +
           (primitive.colors ? sizeof(KM_Color) : 0);
}

} // namespace

Result<SourceMesh> Meshes::read(const Json& json, const std::string& name, const Pose& pose) {
    SourceMesh piece;
    if (!hasPositions(json)) {
        ++m_without_positions;
        return piece;
    }
    const ReadMaterial& material = m_materials.at(member(json, "material"));
    piece.material = material.material;
    const Result<Primitive> found = findPrimitive(m_source, json, material.coordinate_set);
    if (!found)
        return found.error();
    const Primitive& primitive = found.value();
    const Deformation deformation(primitive, pose);
    const std::string wrong = deformation.whyBad();
    if (!wrong.empty())
        return damaged(m_source.reading, wrong);
    Losses losses;
    const Result<void> done = primitive.mode == PrimitiveMode::points
                                  ? readPoints(primitive, deformation, losses, piece)
                              : primitive.mode < PrimitiveMode::triangles
                                  ? readLines(primitive, deformation, losses, piece)
                                  : readTriangles(primitive, material, deformation, losses, piece);
    if (!done)
        return done.error();
    Losses& of_name = m_losses[name];
    of_name.what = losses.lost > 0 || of_name.lost == 0 ? losses.what : of_name.what;
    of_name.lost += losses.lost;
    of_name.all += losses.all;
    return piece;
}

Result<void> Meshes::readTriangles(const Primitive& primitive, const ReadMaterial& material,
                                   const Deformation& deformation, Losses& losses,
                                   SourceMesh& piece) {
    const std::uint64_t all = trianglesOf(primitive.mode, cornersOf(primitive));
    if (all > MOST_TRIANGLES)
        return tooLarge(m_source.reading,
                        "one of its meshes has " + std::to_string(all) + " triangles");
    const std::uint64_t used = std::min(primitive.positions.count, 3 * all);
    for (const Result<void>& taken :
         {takeMemory(m_source.reading, all, MEMORY_OF_TRIANGLE, "triangles"),
          takeMemory(m_source.reading, used, memoryOfVertex(primitive), "vertices")})
        if (!taken)
            return taken;
    ReadTriangles read = readTrianglesOf(primitive, deformation, material.texture_place);
    losses = {all - read.in_range, all, "triangles"};
    m_triangles += all;
    m_triangles_dropped += read.in_range - read.mesh->m_F.size();
    if (material.blends &&
        std::ranges::any_of(read.mesh->m_C, [](const KM_Color& color) { return color.a < 255; })) {
        material.material->see_through = true;
        material.material->alpha_cutout = false;
    }
    piece.mesh = std::move(read.mesh);
    return {};
}

Result<void> Meshes::readLines(const Primitive& primitive, const Deformation& deformation,
                               Losses& losses, SourceMesh& piece) {
    const std::uint64_t corners = cornersOf(primitive);
    const std::uint64_t all = segmentsOf(primitive.mode, corners);
    if (const Result<void> taken = takeMemory(m_source.reading, all, MEMORY_OF_SEGMENT, "lines");
        !taken)
        return taken;
    losses = {0, all, "lines"};
    std::vector<LineSegment> segments;
    segments.reserve(all);
    for (std::uint64_t i = 0; i < all; ++i) {
        const std::uint64_t begin = beginOfSegment(primitive.mode, i);
        const std::uint64_t a = vertexAt(primitive, begin);
        const std::uint64_t b = vertexAt(primitive, (begin + 1) % corners);
        if (std::max(a, b) >= primitive.positions.count) {
            ++losses.lost;
            continue;
        }
        const KM_3fPoint from = deformation.place(a);
        const KM_3fPoint to = deformation.place(b);
        if (isUsable(from) && isUsable(to))
            segments.emplace_back(from.ToDouble(), to.ToDouble());
        else
            ++m_segments_dropped;
    }
    piece.lines = joinSegments(segments);
    return {};
}

Result<void> Meshes::readPoints(const Primitive& primitive, const Deformation& deformation,
                                Losses& losses, SourceMesh& piece) {
    const std::uint64_t all = cornersOf(primitive);
    if (const Result<void> taken = takeMemory(m_source.reading, all, MEMORY_OF_POINT, "points");
        !taken)
        return taken;
    losses = {0, all, "points"};
    for (std::uint64_t i = 0; i < all; ++i) {
        const std::uint64_t vertex = vertexAt(primitive, i);
        if (vertex >= primitive.positions.count) {
            ++losses.lost;
            continue;
        }
        const KM_3fPoint point = deformation.place(vertex);
        if (isUsable(point))
            piece.points.Append(point.ToDouble());
        else
            ++m_points_dropped;
    }
    return {};
}

void Meshes::tellLosses() {
    constexpr std::size_t MOST_SENTENCES = 8;
    std::vector<std::string>& warnings = m_source.warnings;
    std::size_t told = 0;
    std::uint64_t lost_by_others = 0;
    for (const auto& [name, losses] : m_losses) {
        if (losses.lost == 0)
            continue;
        if (++told > MOST_SENTENCES) {
            lost_by_others += losses.lost;
            continue;
        }
        warnings.push_back(std::to_string(losses.lost) + " of " + std::to_string(losses.all) + " " +
                           losses.what + " of the mesh '" + name +
                           "' were left out: their indices lie beyond its vertices. The file may "
                           "be damaged; get or export it again.");
    }
    if (lost_by_others > 0)
        warnings.push_back("Other meshes lost " + std::to_string(lost_by_others) +
                           " faces in the same way.");
    for (const std::string& sentence :
         {leftOutText(m_triangles_dropped, m_triangles, "triangles"),
          leftOutText(m_segments_dropped, m_segments_dropped, "line segments"),
          leftOutText(m_points_dropped, m_points_dropped, "points")})
        if (!sentence.empty())
            warnings.push_back(sentence);
    if (m_without_positions > 0)
        warnings.push_back(std::to_string(m_without_positions) +
                           " parts of its meshes were left out: the file does not say where their "
                           "vertices are.");
}

} // namespace quarn::gltf
