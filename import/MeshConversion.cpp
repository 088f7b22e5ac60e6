#include "import/MeshConversion.h"

#include "import/IndexTable.h"
#include "import/StoredColor.h"
#include "import/VertexNormals.h"

#include <assimp/mesh.h>

#include <algorithm>
#include <array>
#include <cmath>
#include <cstdint>
#include <limits>
#include <span>
#include <utility>
#include <vector>

namespace quarn {
namespace {

constexpr double crease_angle_deg = 40.0;

/// In a closed mesh six triangles meet at a vertex.
constexpr std::size_t usual_sharing = 6;

struct Vertex {
    KM_3fPoint place;
    KM_3fVector normal;
    KM_2fPoint texture;
    KM_Color color;
};

/// The part of an affine transform that turns normals: its cofactors, which unlike its inverse
/// exist for a flattening one as well.
class NormalTransform {
public:
    explicit NormalTransform(const KM_Xform& x) {
        for (int i = 0; i < 3; ++i) {
            for (int j = 0; j < 3; ++j) {
                const int a = (i + 1) % 3;
                const int b = (i + 2) % 3;
                const int c = (j + 1) % 3;
                const int d = (j + 2) % 3;
                m_cofactors[i][j] =
                    x.m_xform[a][c] * x.m_xform[b][d] - x.m_xform[a][d] * x.m_xform[b][c];
            }
        }
        for (int j = 0; j < 3; ++j) {
            m_determinant += x.m_xform[0][j] * m_cofactors[0][j];
        }
    }

    bool mirrors() const { return m_determinant < 0.0; }

    /// A unit vector, or zero where `n` or its image has no direction.
    KM_3fVector operator*(const aiVector3D& n) const {
        std::array<double, 3> turned{};
        for (int i = 0; i < 3; ++i) {
            turned[i] = m_cofactors[i][0] * static_cast<double>(n.x) +
                        m_cofactors[i][1] * static_cast<double>(n.y) +
                        m_cofactors[i][2] * static_cast<double>(n.z);
        }
        const double length = std::hypot(turned[0], turned[1], turned[2]);
        if (!(length > 0.0) || !std::isfinite(length)) {
            return {};
        }
        const double factor = (mirrors() ? -1.0 : 1.0) / length;
        return {static_cast<float>(turned[0] * factor + 0.0),
                static_cast<float>(turned[1] * factor + 0.0),
                static_cast<float>(turned[2] * factor + 0.0)};
    }

private:
    double m_cofactors[3][3] = {};
    double m_determinant = 0.0;
};

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
        : m_source(source), m_reading(reading), m_normals(reading.world_from_mesh),
          m_has_normals(reading.keep_normals && source.mNormals != nullptr),
          m_has_texture(reading.texture_coordinates < AI_MAX_NUMBER_OF_TEXTURECOORDS &&
                        source.mTextureCoords[reading.texture_coordinates] != nullptr),
          m_has_colors(source.mColors[0] != nullptr),
          m_in_place(reading.world_from_mesh.IsIdentity()), m_weld(mayShareNothing(source)),
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
        std::array<KM_3dPoint, 3> places;
        for (int k = 0; k < 3; ++k) {
            if (face.mIndices[k] >= m_source.mNumVertices ||
                !readPlace(face.mIndices[k], places[k])) {
                return false;
            }
        }
        KM_MeshTriangle triangle{};
        for (int k = 0; k < 3; ++k) {
            triangle.vi[k] = vertexFor(face.mIndices[k], places[k]);
        }
        if (m_normals.mirrors()) {
            std::swap(triangle.vi[1], triangle.vi[2]);
        }
        m_mesh->m_F.push_back(triangle);
        return true;
    }

    /// Where a vertex stands in the world, unless it is known already; false when it cannot be
    /// drawn there.
    bool readPlace(unsigned v, KM_3dPoint& place) const {
        if (m_index[v] != IndexTable::none) {
            return true;
        }
        const aiVector3D& p = m_source.mVertices[v];
        place = KM_3dPoint(p.x, p.y, p.z);
        if (!m_in_place) {
            place = m_reading.world_from_mesh * place;
        }
        return isUsableCoordinate(place.x) && isUsableCoordinate(place.y) &&
               isUsableCoordinate(place.z);
    }

    std::uint32_t vertexFor(unsigned v, const KM_3dPoint& place) {
        if (m_index[v] == IndexTable::none) {
            m_index[v] = add(readVertex(v, place));
        }
        return m_index[v];
    }

    Vertex readVertex(unsigned v, const KM_3dPoint& p) const {
        Vertex vertex;
        vertex.place = KM_3fPoint(static_cast<float>(p.x) + 0.0F, static_cast<float>(p.y) + 0.0F,
                                  static_cast<float>(p.z) + 0.0F);
        if (m_has_normals) {
            vertex.normal = m_normals * m_source.mNormals[v];
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
    NormalTransform m_normals;
    bool m_has_normals;
    bool m_has_texture;
    bool m_has_colors;
    bool m_in_place; ///< the mesh stands in world coordinates
    bool m_weld;
    std::vector<std::uint32_t> m_index; ///< of the source's vertices in ours
    IndexTable m_table;
    std::shared_ptr<KM_Mesh> m_mesh = std::make_shared<KM_Mesh>();
};

} // namespace

ConvertedMesh convertTriangles(const aiMesh& mesh, const MeshReading& reading) {
    return TriangleReader(mesh, reading).read();
}

void completeMesh(KM_Mesh& mesh) {
    if (mesh.m_N.empty()) {
        smoothVertexNormals(mesh, crease_angle_deg);
    } else {
        fillMissingNormals(mesh);
    }
    mesh.m_V.shrink_to_fit();
    mesh.m_N.shrink_to_fit();
    mesh.m_T.shrink_to_fit();
    mesh.m_C.shrink_to_fit();
    mesh.m_F.shrink_to_fit();
    mesh.PadForRayTracing();
}

bool hasArea(const KM_Mesh& mesh) {
    constexpr double least_sine = 1e-7; // of a corner; coordinates have seven digits
    return std::any_of(mesh.m_F.begin(), mesh.m_F.end(), [&](const KM_MeshTriangle& triangle) {
        const KM_3dPoint a = mesh.m_V[triangle.vi[0]].ToDouble();
        const KM_3dVector b = mesh.m_V[triangle.vi[1]].ToDouble() - a;
        const KM_3dVector c = mesh.m_V[triangle.vi[2]].ToDouble() - a;
        return KM_CrossProduct(b, c).Length() > least_sine * b.Length() * c.Length();
    });
}

bool isUsableCoordinate(double coordinate) {
    return std::abs(coordinate) <= double{std::numeric_limits<float>::max()};
}

} // namespace quarn
