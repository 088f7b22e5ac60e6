#include "import/assembly/CornerMeshes.h"

#include "engine/scene/PlacedMesh.h"
#include "import/assembly/MeshCleaning.h"
#include "import/assembly/MeshPlacing.h"

#include <tbb/blocked_range.h>
#include <tbb/parallel_for.h>
#include <tbb/parallel_reduce.h>

#include <algorithm>
#include <cmath>
#include <utility>

namespace quarn {

namespace {

constexpr std::uint32_t NONE = IndexTable::none;
constexpr std::uint32_t UNUSABLE = NONE - 1;

/// Vertices of one place are looked through one after the other up to so many.
constexpr int MOST_COMPARED = 12;

bool isUsablePlace(const KM_3dPoint& p) {
    return isUsableCoordinate(p.x) && isUsableCoordinate(p.y) && isUsableCoordinate(p.z);
}

std::size_t cornersOf(const FaceCorners& faces) {
    std::size_t count = 0;
    for (const FaceRun& run : faces.runs)
        count += std::size_t{run.corners} * run.faces;
    return count;
}

std::size_t trianglesOf(std::span<const FaceCorners> faces) {
    std::size_t count = 0;
    for (const FaceCorners& part : faces)
        for (const FaceRun& run : part.runs)
            count += std::size_t{run.corners - 2} * run.faces;
    return count;
}

KM_BoundingBox united(KM_BoundingBox a, const KM_BoundingBox& b) {
    a.Union(b);
    return a;
}

/// A unit vector, or zero where `n` has no direction.
KM_3fVector unitNormal(const KM_3fVector& n) {
    const double length = std::hypot(double{n.x}, double{n.y}, double{n.z});
    if (!(length > 0.0) || !std::isfinite(length))
        return {};
    const double factor = 1.0 / length;
    return {static_cast<float>(n.x * factor + 0.0), static_cast<float>(n.y * factor + 0.0),
            static_cast<float>(n.z * factor + 0.0)};
}

KM_2fPoint placedTexture(const KM_2fPoint& t, const TexturePlace& place) {
    const auto number = [&t](const double* row) {
        const auto sum = static_cast<float>(row[0] * double{t.x} + row[1] * double{t.y} + row[2]);
        return std::isfinite(sum) ? sum + 0.0F : 0.0F;
    };
    return {number(place.u), number(place.v)};
}

std::uint32_t numberAt(const std::uint32_t* numbers, std::size_t corner) {
    return numbers != nullptr ? numbers[corner] : NONE;
}

} // namespace

CornerMeshes::CornerMeshes(const CornerTables& tables)
    : m_tables(tables), m_vertex_of_place(tables.places.size(), NONE) {}

CornerMesh CornerMeshes::make(std::span<const FaceCorners> faces,
                              const TexturePlace& texture_place) {
    m_textures = namingOf(faces, &FaceCorners::textures);
    m_normals = namingOf(faces, &FaceCorners::normals);
    m_colors = namingOf(faces, &FaceCorners::colors);
    m_has_own = m_textures == Naming::own || m_normals == Naming::own || m_colors == Naming::own;
    m_triangles.reserve(trianglesOf(faces));
    for (const FaceCorners& part : faces)
        addFaces(part);
    CornerMesh made;
    made.mesh = std::make_shared<KM_Mesh>();
    takePlaces(made);
    takeTextures(*made.mesh, texture_place);
    takeNormals(*made.mesh);
    takeColors(*made.mesh);
    made.dropped = m_dropped;
    made.mesh->m_F = std::move(m_triangles);
    forget();
    weldSparseMesh(*made.mesh);
    return made;
}

/// Most files number the parts of a corner alike, or have one part alone.
CornerMeshes::Naming CornerMeshes::namingOf(std::span<const FaceCorners> faces,
                                            const std::uint32_t* FaceCorners::*part) const {
    bool is_by_place = true;
    bool is_none = true;
    for (const FaceCorners& some : faces) {
        const std::uint32_t* const numbers = some.*part;
        const std::size_t count = cornersOf(some);
        is_none = is_none && (numbers == nullptr || count == 0);
        is_by_place = is_by_place &&
                      (numbers == some.places ||
                       (numbers != nullptr && std::equal(numbers, numbers + count, some.places)));
    }
    return is_none ? Naming::none : is_by_place ? Naming::by_place : Naming::own;
}

void CornerMeshes::addFaces(const FaceCorners& faces) {
    std::size_t corner = 0;
    for (const FaceRun& run : faces.runs)
        for (std::uint32_t face = 0; face < run.faces; ++face, corner += run.corners)
            addFace(faces, corner, run.corners);
}

void CornerMeshes::addFace(const FaceCorners& faces, std::size_t begin, std::uint32_t corners) {
    const std::uint32_t* const places = faces.places + begin;
    if (!std::all_of(places, places + corners, [this](std::uint32_t p) { return isUsable(p); })) {
        m_dropped += corners - 2;
        return;
    }
    if (corners == 3) {
        m_triangles.push_back(
            {vertexAt(faces, begin), vertexAt(faces, begin + 1), vertexAt(faces, begin + 2)});
        return;
    }
    m_outline.clear();
    for (std::uint32_t k = 0; k < corners; ++k)
        m_outline.push_back(m_tables.places[places[k]]);
    for (const PolygonTriangles::Triangle& cut : m_cutter.cut(m_outline))
        m_triangles.push_back({vertexAt(faces, begin + cut[0]), vertexAt(faces, begin + cut[1]),
                               vertexAt(faces, begin + cut[2])});
}

bool CornerMeshes::isUsable(std::uint32_t place) {
    if (place >= m_vertex_of_place.size())
        return false;
    const std::uint32_t vertex = m_vertex_of_place[place];
    if (vertex < UNUSABLE)
        return true;
    if (vertex == NONE && isUsablePlace(m_tables.places[place]))
        return true;
    if (vertex == NONE) {
        m_vertex_of_place[place] = UNUSABLE;
        m_unusable.push_back(place);
    }
    return false;
}

std::uint32_t CornerMeshes::vertexAt(const FaceCorners& faces, std::size_t corner) {
    const std::uint32_t place = faces.places[corner];
    if (!m_has_own)
        return placeVertex(place);
    return ownVertex({place, numberAt(faces.textures, corner), numberAt(faces.normals, corner),
                      numberAt(faces.colors, corner)});
}

std::uint32_t CornerMeshes::placeVertex(std::uint32_t place) {
    std::uint32_t& vertex = m_vertex_of_place[place];
    if (vertex == NONE) {
        vertex = static_cast<std::uint32_t>(m_places.size());
        m_places.push_back(place);
    }
    return vertex;
}

std::uint32_t CornerMeshes::ownVertex(const Vertex& vertex) {
    std::uint32_t* at = &m_vertex_of_place[vertex.place];
    for (int compared = 0; compared < MOST_COMPARED; ++compared) {
        if (*at == NONE) {
            const auto added = static_cast<std::uint32_t>(m_places.size());
            *at = added; // before a new element moves what it points into
            return addVertex(vertex);
        }
        if (m_vertices[*at] == vertex)
            return *at;
        at = &m_next[*at];
    }
    if (!m_crowded)
        m_crowded = std::make_unique<IndexTable>();
    const auto next = static_cast<std::uint32_t>(m_places.size());
    const std::uint32_t hash = (vertex.place * 0x9E3779B1U) ^ (vertex.texture * 0x85EBCA77U) ^
                               (vertex.normal * 0xC2B2AE3DU) ^ (vertex.color * 0x27D4EB2FU);
    const std::uint32_t found = m_crowded->findOrAdd(
        hash ^ (hash >> 15), next, [&](std::uint32_t i) { return m_vertices[i] == vertex; });
    return found == next ? addVertex(vertex) : found;
}

std::uint32_t CornerMeshes::addVertex(const Vertex& vertex) {
    m_places.push_back(vertex.place);
    m_vertices.push_back(vertex);
    m_next.push_back(NONE);
    return static_cast<std::uint32_t>(m_places.size() - 1);
}

void CornerMeshes::takePlaces(CornerMesh& made) const {
    const auto place = [this](std::size_t v) { return m_tables.places[m_places[v]]; };
    const KM_BoundingBox box = tbb::parallel_reduce(
        tbb::blocked_range<std::size_t>(0, m_places.size(), 4096), KM_BoundingBox(),
        [&](const tbb::blocked_range<std::size_t>& range, KM_BoundingBox sum) {
            for (std::size_t v = range.begin(); v != range.end(); ++v)
                sum.Set(place(v));
            return sum;
        },
        united);
    made.origin = nearbyOrigin(box);
    const KM_3dVector origin = made.origin - KM_3dPoint::Origin;
    made.mesh->m_V.resize(m_places.size());
    tbb::parallel_for(std::size_t{0}, m_places.size(), [&](std::size_t v) {
        const KM_3dPoint near = place(v) + -origin;
        made.mesh->m_V[v] = {static_cast<float>(near.x) + 0.0F, static_cast<float>(near.y) + 0.0F,
                             static_cast<float>(near.z) + 0.0F};
    });
}

std::uint32_t CornerMeshes::textureOf(std::size_t vertex) const {
    return m_has_own ? m_vertices[vertex].texture : m_places[vertex];
}

std::uint32_t CornerMeshes::normalOf(std::size_t vertex) const {
    return m_has_own ? m_vertices[vertex].normal : m_places[vertex];
}

std::uint32_t CornerMeshes::colorOf(std::size_t vertex) const {
    return m_has_own ? m_vertices[vertex].color : m_places[vertex];
}

void CornerMeshes::takeTextures(KM_Mesh& mesh, const TexturePlace& texture_place) const {
    if (m_textures == Naming::none)
        return;
    mesh.m_T.resize(m_places.size());
    tbb::parallel_for(std::size_t{0}, m_places.size(), [&](std::size_t v) {
        const std::uint32_t number = textureOf(v);
        if (number < m_tables.textures.size())
            mesh.m_T[v] = placedTexture(m_tables.textures[number], texture_place);
    });
}

void CornerMeshes::takeNormals(KM_Mesh& mesh) const {
    if (m_normals == Naming::none)
        return;
    mesh.m_N.resize(m_places.size());
    tbb::parallel_for(std::size_t{0}, m_places.size(), [&](std::size_t v) {
        const std::uint32_t number = normalOf(v);
        if (number < m_tables.normals.size())
            mesh.m_N[v] = unitNormal(m_tables.normals[number]);
    });
}

void CornerMeshes::takeColors(KM_Mesh& mesh) const {
    if (m_colors == Naming::none)
        return;
    mesh.m_C.assign(m_places.size(), KM_Color{255, 255, 255, 255});
    tbb::parallel_for(std::size_t{0}, m_places.size(), [&](std::size_t v) {
        const std::uint32_t number = colorOf(v);
        if (number < m_tables.colors.size())
            mesh.m_C[v] = m_tables.colors[number];
    });
}

/// Only what the mesh touched, so that a file of a thousand meshes is no slower than one of one.
void CornerMeshes::forget() {
    for (const std::uint32_t place : m_places)
        m_vertex_of_place[place] = NONE;
    for (const std::uint32_t place : m_unusable)
        m_vertex_of_place[place] = NONE;
    m_places.clear();
    m_vertices.clear();
    m_next.clear();
    m_unusable.clear();
    m_crowded.reset();
    m_triangles = {};
    m_dropped = 0;
}

} // namespace quarn
