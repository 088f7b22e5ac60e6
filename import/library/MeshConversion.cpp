#include "import/library/MeshConversion.h"

#include "import/assembly/MeshCleaning.h"
#include "import/assembly/StoredColor.h"

#include <assimp/mesh.h>

#include <algorithm>
#include <cmath>
#include <span>

namespace quarn {
namespace {

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

template <class Element, class Source, class Convert>
void convertEach(const Source* source, unsigned count, std::vector<Element>& list,
                 const Convert& convert) {
    if (source == nullptr)
        return;
    list.reserve(count);
    for (const auto& element : std::span(source, count))
        list.push_back(convert(element));
}

void convertVertices(const aiMesh& source, const MeshReading& reading, KM_Mesh& mesh) {
    const unsigned count = source.mNumVertices;
    convertEach(source.mVertices, count, mesh.m_V,
                [](const aiVector3D& p) { return KM_3fPoint(p.x + 0.0F, p.y + 0.0F, p.z + 0.0F); });
    convertEach(reading.keep_normals ? source.mNormals : nullptr, count, mesh.m_N, unitNormal);
    const unsigned set = reading.texture_coordinates;
    convertEach(set < AI_MAX_NUMBER_OF_TEXTURECOORDS ? source.mTextureCoords[set] : nullptr, count,
                mesh.m_T, [](const aiVector3D& t) {
                    return KM_2fPoint(finiteOrZero(t.x), finiteOrZero(t.y));
                });
    convertEach(source.mColors[0], count, mesh.m_C,
                [](const aiColor4D& c) { return colorFromSrgb(c.r, c.g, c.b, c.a); });
}

bool isUsable(const aiMesh& mesh, const aiFace& face) {
    const std::span<const unsigned> corners(face.mIndices, face.mNumIndices);
    return corners.size() == 3 && std::ranges::all_of(corners, [&](unsigned v) {
               return v < mesh.mNumVertices && isUsable(mesh.mVertices[v]);
           });
}

} // namespace

ConvertedMesh convertTriangles(const aiMesh& source, const MeshReading& reading) {
    const auto mesh = std::make_shared<KM_Mesh>();
    convertVertices(source, reading, *mesh);
    mesh->m_F.reserve(source.mNumFaces);
    for (const aiFace& face : std::span(source.mFaces, source.mNumFaces))
        if (isUsable(source, face))
            mesh->m_F.push_back({{face.mIndices[0], face.mIndices[1], face.mIndices[2]}});
    dropUnusedVertices(*mesh);
    weldSparseMesh(*mesh);
    return {mesh, source.mNumFaces - mesh->m_F.size()};
}

} // namespace quarn
