#include "import/ply/PlyFaces.h"

#include "import/ply/PlyFacePart.h"

#include <algorithm>
#include <span>
#include <utility>

namespace quarn {

namespace {

using Role = PlyFaceRole;

template <class Item> void append(std::vector<Item>& to, std::vector<Item>& from) {
    to.insert(to.end(), from.begin(), from.end());
    from = {};
}

std::uint64_t bytesOf(const PlyFaces& faces) {
    return faces.triangles.size() * sizeof(KM_MeshTriangle) +
           faces.texture.size() * sizeof(KM_2fPoint) + faces.lines.size() * sizeof(faces.lines[0]) +
           faces.points.size() * sizeof(faces.points[0]);
}

/// Reads all parts of an element. Nearly all files have triangles alone, which are read right where
/// they belong; where there are more than elements, they are joined behind them.
class ElementReading {
public:
    ElementReading(PlyContents& contents, std::size_t kind, const std::vector<KM_3fPoint>& vertices,
                   PlyFaces& faces)
        : m_contents(contents), m_kind(kind), m_element(contents.header().elements[kind]),
          m_vertices(vertices), m_faces(faces), m_before(faces.triangles.size()),
          m_parts(contents.countParts(kind)) {}

    void read() {
        if (!makeRoom())
            return;
        m_contents.readParts(m_kind,
                             [this](const PlyPart& part, std::size_t i) { readPart(part, i); });
        if (m_contents.why().empty())
            join();
    }

private:
    struct Part {
        std::size_t begin = 0;  ///< of its triangles among those of the file
        std::size_t filled = 0; ///< how many stand there
        PlyFaces rest;
    };

    bool makeRoom() {
        if (!hasPlyFaceRole(m_element, Role::indices))
            return true;
        const Result<void> taken =
            m_contents.budget().take(m_element.count * sizeof(KM_MeshTriangle), "triangles");
        if (taken)
            m_faces.triangles.resize(m_before + static_cast<std::size_t>(m_element.count));
        else
            m_contents.fail(taken.message());
        return taken.ok();
    }

    void readPart(const PlyPart& part, std::size_t i) {
        Part& to = m_parts[i];
        to.begin = m_before + static_cast<std::size_t>(part.first);
        std::span<KM_MeshTriangle> room;
        if (hasPlyFaceRole(m_element, Role::indices))
            room = std::span(m_faces.triangles)
                       .subspan(to.begin, static_cast<std::size_t>(part.count));
        if (m_contents.header().format == PlyFormat::text)
            to.filled =
                PlyFacePart<PlyTextNumbers>(m_contents, part, m_vertices, room, to.rest).read();
        else
            to.filled =
                PlyFacePart<PlyBinaryNumbers>(m_contents, part, m_vertices, room, to.rest).read();
        const Result<void> taken = m_contents.budget().take(bytesOf(to.rest), "triangles");
        if (!taken)
            m_contents.fail(part.bytes.data(), taken.message());
        m_contents.finish(part);
    }

    void join() {
        std::size_t count = m_before;
        std::size_t rest = 0;
        for (const Part& part : m_parts) {
            count += part.filled + part.rest.triangles.size();
            rest += part.rest.triangles.size();
        }
        if (rest > 0 || count != m_faces.triangles.size())
            joinTriangles(count);
        for (Part& part : m_parts) {
            append(m_faces.texture, part.rest.texture);
            append(m_faces.lines, part.rest.lines);
            append(m_faces.points, part.rest.points);
            m_faces.without_corners += part.rest.without_corners;
        }
    }

    void joinTriangles(std::size_t count) {
        const auto from = m_faces.triangles.begin();
        std::vector<KM_MeshTriangle> joined;
        joined.reserve(count);
        joined.insert(joined.end(), from, from + static_cast<std::ptrdiff_t>(m_before));
        for (Part& part : m_parts) {
            const auto begin = from + static_cast<std::ptrdiff_t>(part.begin);
            joined.insert(joined.end(), begin, begin + static_cast<std::ptrdiff_t>(part.filled));
            append(joined, part.rest.triangles);
        }
        m_faces.triangles = std::move(joined);
    }

    PlyContents& m_contents;
    std::size_t m_kind;
    const PlyElement& m_element;
    const std::vector<KM_3fPoint>& m_vertices;
    PlyFaces& m_faces;
    std::size_t m_before; ///< triangles of elements that were read before
    std::vector<Part> m_parts;
};

} // namespace

bool connectsVertices(const PlyElement& element) {
    if (element.name == "face" || element.name == "tristrips")
        return hasPlyFaceRole(element, Role::indices);
    return element.name == "edge" && hasPlyFaceRole(element, Role::first_end) &&
           hasPlyFaceRole(element, Role::second_end);
}

void readPlyFaces(PlyContents& contents, std::size_t kind, const std::vector<KM_3fPoint>& vertices,
                  PlyFaces& faces) {
    ElementReading(contents, kind, vertices, faces).read();
}

} // namespace quarn
