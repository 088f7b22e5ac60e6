#include "import/library/MeshConversion.h"

#include "import/assembly/IndexTable.h"
#include "import/assembly/StoredColor.h"

#include <assimp/mesh.h>

#include <array>
#include <cmath>
#include <cstdint>
#include <span>
#include <vector>

namespace quarn {
namespace {

/// In a closed mesh six triangles meet at a vertex.
constexpr std::size_t usual_sharing = 6;

struct Vertex {
    KM_3fPoint place;
    KM_3fVector normal;
    KM_2fPoint texture;
    KM_Color color;
};

/// A unit vector, or zero where `n` has no direction.
KM_3fVector unitNormal(const aiVector3D& n) {
    const double length = std::hypot(double{n.x}, double{n.y}, double{n.z});
    if (!(length > 0.0) || !std::isfinite(length))
        return {};
    const double factor = 1.0 / length;
    return {static_cast<float>(n.x * factor + 0.0), static_cast<float>(n.y * factor + 0.0),
            static_cast<float>(n.z * factor + 0.0)};
}

bool isUsable(const aiVector3D& p) {
    return std::isfinite(p.x) && std::isfinite(p.y) && std::isfinite(p.z);
}

float finiteOrZero(float number) {
    return std::isfinite(number) ? number + 0.0F : 0.0F;
}

/// Polygons of n corners are n - 2 triangles by now, so where no two share a vertex there are more
/// vertices than triangles. In a mesh whose polygons share them there are half as many.
bool mayShareNothing(const aiMesh& mesh) {
    return mesh.mNumVertices > mesh.mNumFaces;
}

class TriangleReader {
public:
    TriangleReader(const aiMesh& source, const MeshReading& reading)
        : m_source(source), m_reading(reading),
          m_has_normals(reading.keep_normals && source.mNormals != nullptr),
          m_has_texture(reading.texture_coordinates < AI_MAX_NUMBER_OF_TEXTURECOORDS &&
                        source.mTextureCoords[reading.texture_coordinates] != nullptr),
          m_has_colors(source.mColors[0] != nullptr), m_weld(mayShareNothing(source)),
          m_table(m_weld ? source.mNumVertices / usual_sharing : 0) {}

    ConvertedMesh read() {
        m_index.assign(m_source.mNumVertices, IndexTable::none);
        m_mesh->m_F.reserve(m_source.mNumFaces);
        if (!m_weld) {
            reserveVertices(m_source.mNumVertices);
        }
        std::size_t dropped = 0;
        for (unsigned f = 0; f < m_source.mNumFaces; ++f) {
            dropped += readTriangle(m_source.mFaces[f]) ? 0 : 1;
        }
        return {m_mesh, dropped};
    }

private:
    void reserveVertices(std::size_t count) {
        m_mesh->m_V.reserve(count);
        m_mesh->m_N.reserve(m_has_normals ? count : 0);
        m_mesh->m_T.reserve(m_has_texture ? count : 0);
        m_mesh->m_C.reserve(m_has_colors ? count : 0);
    }

    bool readTriangle(const aiFace& face) {
        if (face.mNumIndices != 3) {
            return false;
        }
        for (int k = 0; k < 3; ++k) {
            if (face.mIndices[k] >= m_source.mNumVertices ||
                !isUsable(m_source.mVertices[face.mIndices[k]])) {
                return false;
            }
        }
        KM_MeshTriangle triangle{};
        for (int k = 0; k < 3; ++k) {
            triangle.vi[k] = vertexFor(face.mIndices[k]);
        }
        m_mesh->m_F.push_back(triangle);
        return true;
    }

    std::uint32_t vertexFor(unsigned v) {
        if (m_index[v] == IndexTable::none) {
            m_index[v] = add(readVertex(v));
        }
        return m_index[v];
    }

    Vertex readVertex(unsigned v) const {
        const aiVector3D& p = m_source.mVertices[v];
        Vertex vertex;
        vertex.place = KM_3fPoint(p.x + 0.0F, p.y + 0.0F, p.z + 0.0F);
        if (m_has_normals) {
            vertex.normal = unitNormal(m_source.mNormals[v]);
        }
        if (m_has_texture) {
            const aiVector3D& t = m_source.mTextureCoords[m_reading.texture_coordinates][v];
            vertex.texture = textureAt(static_cast<double>(t.x), static_cast<double>(t.y));
        }
        if (m_has_colors) {
            const aiColor4D& c = m_source.mColors[0][v];
            vertex.color = m_reading.linear_colors ? colorFromLinear(c.r, c.g, c.b, c.a)
                                                   : colorFromSrgb(c.r, c.g, c.b, c.a);
        }
        return vertex;
    }

    KM_2fPoint textureAt(double u, double v) const {
        const TexturePlace& place = m_reading.texture_place;
        return {finiteOrZero(static_cast<float>(place.u[0] * u + place.u[1] * v + place.u[2])),
                finiteOrZero(static_cast<float>(place.v[0] * u + place.v[1] * v + place.v[2]))};
    }

    std::uint32_t add(const Vertex& vertex) {
        const auto next = static_cast<std::uint32_t>(m_mesh->m_V.size());
        if (m_weld) {
            const std::array<float, 8> numbers{vertex.place.x,   vertex.place.y,  vertex.place.z,
                                               vertex.normal.x,  vertex.normal.y, vertex.normal.z,
                                               vertex.texture.x, vertex.texture.y};
            const std::uint32_t found = m_table.findOrAdd(
                hashOfBits(numbers), next, [&](std::uint32_t i) { return equals(i, vertex); });
            if (found != next) {
                return found;
            }
        }
        append(vertex);
        return next;
    }

    bool equals(std::uint32_t i, const Vertex& vertex) const {
        return m_mesh->m_V[i] == vertex.place &&
               (!m_has_normals || m_mesh->m_N[i] == vertex.normal) &&
               (!m_has_texture || m_mesh->m_T[i] == vertex.texture) &&
               (!m_has_colors || m_mesh->m_C[i] == vertex.color);
    }

    void append(const Vertex& vertex) {
        m_mesh->m_V.push_back(vertex.place);
        if (m_has_normals) {
            m_mesh->m_N.push_back(vertex.normal);
        }
        if (m_has_texture) {
            m_mesh->m_T.push_back(vertex.texture);
        }
        if (m_has_colors) {
            m_mesh->m_C.push_back(vertex.color);
        }
    }

    const aiMesh& m_source;
    const MeshReading& m_reading;
    bool m_has_normals;
    bool m_has_texture;
    bool m_has_colors;
    bool m_weld;
    std::vector<std::uint32_t> m_index; ///< of the source's vertices in ours
    IndexTable m_table;
    std::shared_ptr<KM_Mesh> m_mesh = std::make_shared<KM_Mesh>();
};

} // namespace

ConvertedMesh convertTriangles(const aiMesh& mesh, const MeshReading& reading) {
    return TriangleReader(mesh, reading).read();
}

} // namespace quarn
