#include "import/obj/ObjReader.h"

#include "import/assembly/MeshPlacing.h"
#include "import/assembly/PolylineChains.h"
#include "import/assembly/WritingProgram.h"
#include "import/files/ModelFileCheck.h"
#include "import/obj/ObjContent.h"
#include "import/obj/ObjMaterials.h"
#include "import/text/FileText.h"

#include <utility>

namespace quarn {

namespace {

/// A triangle's indices, its share of the vertices with all that they have, and what finding them
/// takes.
constexpr std::uint64_t BYTES_OF_A_TRIANGLE = 64;
constexpr std::uint64_t BYTES_OF_A_SEGMENT = 128;

bool isUsablePoint(const KM_3dPoint& p) {
    return isUsableCoordinate(p.x) && isUsableCoordinate(p.y) && isUsableCoordinate(p.z);
}

class SceneMaking {
public:
    SceneMaking(const ObjContent& content, const ModelReading& reading)
        : m_content(content), m_reading(reading), m_materials(reading, m_scene.warnings),
          m_meshes({content.places, content.textures, content.normals, content.colors}) {}

    Result<SourceScene> make() {
        m_materials.readLibraries(m_content.libraries);
        for (const ObjPiece& piece : m_content.pieces)
            if (const Result<void> made = makePiece(piece); !made)
                return made.error();
        if (m_content.pieces.empty())
            takeAllAsPoints();
        m_materials.tellMissing();
        for (const std::string& sentence :
             {leftOutText(m_dropped, m_triangles, "triangles"),
              leftOutText(m_segments_dropped, m_segments, "line segments"),
              leftOutText(m_points_dropped, m_points, "points")})
            if (!sentence.empty())
                m_scene.warnings.push_back(sentence);
        m_scene.warnings.insert(m_scene.warnings.end(), m_content.faults.begin(),
                                m_content.faults.end());
        return std::move(m_scene);
    }

private:
    Result<void> makePiece(const ObjPiece& piece) {
        if (const Result<void> taken = takeMemory(piece); !taken)
            return taken;
        SourceMesh mesh;
        mesh.name = KM_wString::FromUtf8(piece.name);
        const ObjMaterial& material = m_materials.at(piece.material);
        mesh.material = material.material;
        if (!piece.faces.empty()) {
            CornerMesh made = m_meshes.make(piece.faces, material.texture_place);
            m_dropped += made.dropped;
            mesh.mesh = std::move(made.mesh);
            mesh.origin = made.origin;
        }
        mesh.lines = linesOf(piece);
        for (const std::span<const std::uint32_t> points : piece.points)
            takePoints(points, mesh);
        addPiece(std::move(mesh));
        return {};
    }

    Result<void> takeMemory(const ObjPiece& piece) {
        std::uint64_t triangles = 0;
        std::uint64_t segments = 0;
        for (const FaceCorners& faces : piece.faces)
            for (const FaceRun& run : faces.runs)
                triangles += std::uint64_t{run.faces} * (run.corners - 2);
        for (const FaceCorners& lines : piece.lines)
            for (const FaceRun& run : lines.runs)
                segments += std::uint64_t{run.faces} * (run.corners - 1);
        m_triangles += triangles;
        m_segments += segments;
        const Result<void> taken =
            m_reading.budget.take(triangles * BYTES_OF_A_TRIANGLE, "triangles");
        return taken ? m_reading.budget.take(segments * BYTES_OF_A_SEGMENT, "lines") : taken;
    }

    std::vector<KM_3dPointArray> linesOf(const ObjPiece& piece) {
        std::vector<LineSegment> segments;
        for (const FaceCorners& lines : piece.lines) {
            const std::uint32_t* corner = lines.places;
            for (const FaceRun& run : lines.runs)
                for (std::uint32_t line = 0; line < run.faces; ++line, corner += run.corners)
                    takeSegments({corner, run.corners}, segments);
        }
        return joinSegments(segments);
    }

    void takeSegments(std::span<const std::uint32_t> line, std::vector<LineSegment>& segments) {
        for (std::size_t i = 1; i < line.size(); ++i)
            if (isUsable(line[i - 1]) && isUsable(line[i]))
                segments.emplace_back(m_content.places[line[i - 1]], m_content.places[line[i]]);
            else
                ++m_segments_dropped;
    }

    void takePoints(std::span<const std::uint32_t> points, SourceMesh& mesh) {
        m_points += points.size();
        for (const std::uint32_t point : points)
            if (isUsable(point))
                mesh.points.Append(m_content.places[point]);
            else
                ++m_points_dropped;
    }

    /// Vertices of a file that has nothing else are a point cloud.
    void takeAllAsPoints() {
        SourceMesh mesh;
        for (std::uint32_t place = 0; place < m_content.places.size(); ++place)
            takePoints({&place, 1}, mesh);
        addPiece(std::move(mesh));
    }

    void addPiece(SourceMesh&& mesh) {
        m_scene.places.push_back({{}, m_scene.meshes.size(), {}});
        m_scene.meshes.push_back(std::move(mesh));
    }

    bool isUsable(std::uint32_t place) const {
        return place < m_content.places.size() && isUsablePoint(m_content.places[place]);
    }

    const ObjContent& m_content;
    const ModelReading& m_reading;
    SourceScene m_scene;
    ObjMaterials m_materials;
    CornerMeshes m_meshes;
    std::uint64_t m_triangles = 0;
    std::uint64_t m_dropped = 0;
    std::uint64_t m_segments = 0;
    std::uint64_t m_segments_dropped = 0;
    std::uint64_t m_points = 0;
    std::uint64_t m_points_dropped = 0;
};

} // namespace

Result<SourceScene> readObj(const ModelReading& reading) {
    const auto failed = [&reading](const std::string& why) {
        return cannotReadModel(reading.path, why, "Use a smaller model.");
    };
    const Result<FileText> file = FileText::of(reading.bytes, reading.budget);
    if (!file)
        return failed(file.message());
    const std::string_view text = file.value().text();
    const Result<ObjContent> content = readObjContent(text, reading);
    if (!content)
        return failed(content.message());
    Result<SourceScene> scene = SceneMaking(content.value(), reading).make();
    if (!scene)
        return failed(scene.message());
    scene.value().up = upAxisOfOpenFormat("obj", text, reading.up);
    return scene;
}

} // namespace quarn
