#include "import/assembly/CornerPieces.h"

#include "import/assembly/MeshPlacing.h"
#include "import/assembly/PolylineChains.h"

#include <array>
#include <string>
#include <utility>

namespace quarn {

namespace {

/// A triangle's indices, its share of the vertices with all that they have, and what finding them
/// takes.
constexpr std::uint64_t BYTES_OF_A_TRIANGLE = 64;
constexpr std::uint64_t BYTES_OF_A_SEGMENT = 96;
constexpr std::uint64_t BYTES_OF_A_LINE = 1024; // which is joined to others piece by piece
constexpr std::uint64_t BYTES_OF_A_POINT = 48;
constexpr std::uint64_t BYTES_OF_A_PIECE = 1024;

} // namespace

CornerPieces::CornerPieces(const CornerTables& tables, const ModelReading& reading,
                           SourceScene& scene)
    : m_tables(tables), m_reading(reading), m_scene(scene), m_meshes(tables) {}

Result<void> CornerPieces::add(const CornerElements& elements, SourceMesh piece,
                               const TexturePlace& texture_place) {
    if (const Result<void> taken = takeMemory(elements); !taken)
        return taken;
    if (!elements.faces.empty()) {
        CornerMesh made = m_meshes.make(elements.faces, texture_place);
        m_triangles.dropped += made.dropped;
        piece.mesh = std::move(made.mesh);
        piece.origin = made.origin;
    }
    piece.lines = linesOf(elements, piece.origin);
    for (const std::span<const std::uint32_t> points : elements.points)
        for (const std::uint32_t point : points)
            takePoint(point, piece);
    place(std::move(piece));
    return {};
}

void CornerPieces::addAllAsPoints() {
    SourceMesh piece;
    for (std::uint32_t place = 0; place < m_tables.places.size(); ++place)
        takePoint(place, piece);
    place(std::move(piece));
}

void CornerPieces::tellDropped() {
    for (const std::string& sentence :
         std::array{leftOutText(m_triangles.dropped, m_triangles.all, "triangles"),
                    leftOutText(m_segments.dropped, m_segments.all, "line segments"),
                    leftOutText(m_points.dropped, m_points.all, "points")})
        if (!sentence.empty())
            m_scene.warnings.push_back(sentence);
}

Result<void> CornerPieces::takeMemory(const CornerElements& elements) {
    std::uint64_t triangles = 0;
    std::uint64_t lines = 0;
    std::uint64_t segments = 0;
    std::uint64_t points = 0;
    for (const FaceCorners& faces : elements.faces)
        for (const FaceRun& run : faces.runs)
            triangles += std::uint64_t{run.faces} * (run.corners - 2);
    for (const FaceCorners& some : elements.lines)
        for (const FaceRun& run : some.runs) {
            lines += run.faces;
            segments += std::uint64_t{run.faces} * (run.corners - 1);
        }
    for (const std::span<const std::uint32_t> some : elements.points)
        points += some.size();
    m_triangles.all += triangles;
    m_segments.all += segments;
    const std::uint64_t bytes = BYTES_OF_A_PIECE + triangles * BYTES_OF_A_TRIANGLE +
                                lines * BYTES_OF_A_LINE + segments * BYTES_OF_A_SEGMENT +
                                points * BYTES_OF_A_POINT;
    return m_reading.budget.take(bytes, "triangles, lines and points");
}

std::vector<KM_3dPointArray> CornerPieces::linesOf(const CornerElements& elements,
                                                   const KM_3dPoint& origin) {
    const KM_3dVector to_piece = KM_3dPoint::Origin - origin;
    std::vector<LineSegment> segments;
    const auto take = [&](std::uint32_t from, std::uint32_t to) {
        if (isUsable(from) && isUsable(to))
            segments.emplace_back(m_tables.places[from] + to_piece, m_tables.places[to] + to_piece);
        else
            ++m_segments.dropped;
    };
    for (const FaceCorners& lines : elements.lines) {
        const std::uint32_t* corner = lines.places;
        for (const FaceRun& run : lines.runs)
            for (std::uint32_t line = 0; line < run.faces; ++line, corner += run.corners)
                for (std::uint32_t i = 1; i < run.corners; ++i)
                    take(corner[i - 1], corner[i]);
    }
    return joinSegments(segments);
}

void CornerPieces::takePoint(std::uint32_t place, SourceMesh& piece) {
    ++m_points.all;
    if (isUsable(place))
        piece.points.Append(m_tables.places[place] + (KM_3dPoint::Origin - piece.origin));
    else
        ++m_points.dropped;
}

void CornerPieces::place(SourceMesh&& piece) {
    m_scene.places.push_back({{}, m_scene.meshes.size(), {}});
    m_scene.meshes.push_back(std::move(piece));
}

bool CornerPieces::isUsable(std::uint32_t place) const {
    if (place >= m_tables.places.size())
        return false;
    const KM_3dPoint& p = m_tables.places[place];
    return isUsableCoordinate(p.x) && isUsableCoordinate(p.y) && isUsableCoordinate(p.z);
}

} // namespace quarn
