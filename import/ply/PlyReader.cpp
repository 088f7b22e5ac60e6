#include "import/ply/PlyReader.h"

#include "import/WritingProgram.h"
#include "import/assembly/MeshCleaning.h"
#include "import/assembly/PolylineChains.h"
#include "import/files/ModelFileCheck.h"
#include "import/ply/PlyFaces.h"
#include "import/ply/PlyVertices.h"
#include "import/text/LineCursor.h"
#include "import/textures/TextureStore.h"

#include <algorithm>
#include <optional>
#include <utility>

namespace quarn {

namespace {

constexpr std::string_view TEXTURE_MARK = "TextureFile ";

Error refusal(const ModelReading& reading, std::string_view why) {
    return cannotReadModel(reading.path, why, "Export the model again or restore the file.");
}

TakenUpAxis upOf(const ModelReading& reading, const PlyHeader& header) {
    std::string comments;
    for (const std::string& comment : header.comments)
        comments += comment + '\n';
    return upAxisOf(reading.up, comments,
                    {{"Created by Blender", "Blender", UpAxis::z},
                     {"Created in Blender", "Blender", UpAxis::z}});
}

/// Makes the pieces of a scene from vertices and what connects them.
class SceneMaking {
public:
    SceneMaking(const ModelReading& reading, const PlyHeader& header, PlyVertices vertices,
                PlyFaces faces)
        : m_reading(reading), m_header(header), m_vertices(std::move(vertices)),
          m_faces(std::move(faces)) {}

    SourceScene make() {
        m_scene.up = upOf(m_reading, m_header);
        m_piece.origin = m_vertices.origin;
        const bool is_cloud =
            std::ranges::none_of(m_header.elements, [](const PlyElement& element) {
                return connectsVertices(element) && element.count > 0;
            });
        if (is_cloud)
            takeCloud();
        takeLines();
        takePoints();
        takeTriangles();
        if (m_faces.without_corners > 0)
            m_scene.warnings.push_back(std::to_string(m_faces.without_corners) +
                                       " faces were left out: they have no corners.");
        m_scene.meshes.push_back(std::move(m_piece));
        m_scene.places.push_back({});
        return std::move(m_scene);
    }

private:
    const std::vector<KM_3fPoint>& places() const { return m_vertices.mesh.m_V; }

    void warnLeftOut(std::uint64_t dropped, std::uint64_t all, std::string_view what) {
        std::string sentence = leftOutText(dropped, all, what);
        if (!sentence.empty())
            m_scene.warnings.push_back(std::move(sentence));
    }

    void takeCloud() {
        for (const KM_3fPoint& place : places())
            if (place.IsValid())
                m_piece.points.Append(place.ToDouble());
        warnLeftOut(m_vertices.unusable, places().size(), "points");
    }

    void takePoints() {
        std::uint64_t dropped = 0;
        for (const std::uint32_t vertex : m_faces.points)
            if (places()[vertex].IsValid())
                m_piece.points.Append(places()[vertex].ToDouble());
            else
                ++dropped;
        warnLeftOut(dropped, m_faces.points.size(), "points");
    }

    void takeLines() {
        std::vector<LineSegment> segments;
        for (const auto& [from, to] : m_faces.lines)
            if (places()[from].IsValid() && places()[to].IsValid())
                segments.emplace_back(places()[from].ToDouble(), places()[to].ToDouble());
        warnLeftOut(m_faces.lines.size() - segments.size(), m_faces.lines.size(), "line segments");
        m_piece.lines = joinSegments(segments);
    }

    void takeTriangles() {
        const std::size_t all = m_faces.triangles.size();
        if (all == 0)
            return;
        if (m_faces.texture.size() == 3 * all)
            partCorners();
        KM_Mesh& mesh = m_vertices.mesh;
        mesh.m_F = std::move(m_faces.triangles);
        if (m_vertices.unusable > 0)
            warnLeftOut(dropUnusableTriangles(mesh), all, "triangles");
        dropUnusedVertices(mesh);
        weldSparseMesh(mesh);
        if (!mesh.m_T.empty())
            m_piece.material = readTexture();
        m_piece.mesh = std::make_shared<KM_Mesh>(std::move(mesh));
    }

    /// Gives each corner of each triangle a vertex of its own, for texture coordinates that stand
    /// with the faces. The vertices that turn out equal are joined later.
    void partCorners() {
        KM_Mesh parted;
        const auto copy = [this](const auto& from, auto& to) {
            if (from.empty())
                return;
            to.reserve(3 * m_faces.triangles.size());
            for (const KM_MeshTriangle& triangle : m_faces.triangles)
                for (const std::uint32_t v : triangle.vi)
                    to.push_back(from[v]);
        };
        copy(m_vertices.mesh.m_V, parted.m_V);
        copy(m_vertices.mesh.m_N, parted.m_N);
        copy(m_vertices.mesh.m_C, parted.m_C);
        parted.m_T = std::move(m_faces.texture);
        m_vertices.mesh = std::move(parted);
        std::uint32_t next = 0;
        for (KM_MeshTriangle& triangle : m_faces.triangles)
            for (std::uint32_t& v : triangle.vi)
                v = next++;
    }

    std::shared_ptr<const Material> readTexture() {
        std::vector<std::string> names;
        for (const std::string& comment : m_header.comments)
            if (comment.starts_with(TEXTURE_MARK))
                names.push_back(comment.substr(TEXTURE_MARK.size()));
        if (names.empty())
            return nullptr;
        if (names.size() > 1)
            m_scene.warnings.push_back("Of the " + std::to_string(names.size()) +
                                       " textures that it names only the first is shown.");
        Material material;
        material.base_color = {255, 255, 255, 255};
        TextureStore textures(m_reading, m_scene.warnings);
        material.base_color_texture = textures.fromFile(names.front(), {});
        return std::make_shared<const Material>(std::move(material));
    }

    const ModelReading& m_reading;
    const PlyHeader& m_header;
    PlyVertices m_vertices;
    PlyFaces m_faces;
    SourceScene m_scene;
    SourceMesh m_piece;
};

std::optional<std::size_t> kindOf(const PlyHeader& header, std::string_view name) {
    const auto found = std::ranges::find(header.elements, name, &PlyElement::name);
    return found == header.elements.end()
               ? std::nullopt
               : std::optional(static_cast<std::size_t>(found - header.elements.begin()));
}

} // namespace

Result<SourceScene> readPly(const ModelReading& reading) {
    const std::string_view file = textOf(reading.bytes);
    Result<PlyHeader> header = readPlyHeader(file);
    if (!header)
        return refusal(reading, header.message());
    const std::optional<std::size_t> vertex_kind = kindOf(header.value(), "vertex");
    if (!vertex_kind)
        return refusal(reading, "it has no vertices");
    Result<std::vector<PlyPart>> parts = partsOfPly(header.value(), file);
    if (!parts)
        return refusal(reading, parts.message());
    PlyContents contents(reading, file, std::move(header.value()), std::move(parts.value()));
    PlyVertices vertices = readPlyVertices(contents, *vertex_kind);
    PlyFaces faces;
    for (std::size_t kind = 0; kind < contents.header().elements.size(); ++kind)
        if (contents.why().empty() && connectsVertices(contents.header().elements[kind]))
            readPlyFaces(contents, kind, vertices.mesh.m_V, faces);
    if (!contents.why().empty())
        return refusal(reading, contents.why());
    return SceneMaking(reading, contents.header(), std::move(vertices), std::move(faces)).make();
}

} // namespace quarn
