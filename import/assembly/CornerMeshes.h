#pragma once

#include "import/assembly/IndexTable.h"
#include "import/assembly/PolygonTriangles.h"
#include "import/textures/TexturePlace.h"
#include "kelmar/KM_Mesh.h"

#include <cstddef>
#include <cstdint>
#include <memory>
#include <span>
#include <vector>

namespace quarn {

/// What the corners of faces name by number, where a format numbers places, texture coordinates,
/// normals and colours each for themselves.
struct CornerTables {
    std::span<const KM_3dPoint> places; ///< also such that are no usable numbers
    std::span<const KM_2fPoint> textures;
    std::span<const KM_3fVector> normals; ///< of any length
    std::span<const KM_Color> colors;
};

/// Faces that follow each other and have equally many corners.
struct FaceRun {
    std::uint32_t corners = 0; ///< of each, at least three
    std::uint32_t faces = 0;
};

/// Faces of a mesh, corner after corner. A number that names nothing stands for none: a face
/// without a place is left out, a corner without a texture coordinate has (0, 0), one without a
/// normal gets one from the assembly, one without a colour is white.
struct FaceCorners {
    std::span<const FaceRun> runs;
    const std::uint32_t* places = nullptr;
    const std::uint32_t* textures = nullptr; ///< null: these corners have none
    const std::uint32_t* normals = nullptr;
    const std::uint32_t* colors = nullptr; ///< may be `places`, as the other two may
};

/// A mesh made of corners.
struct CornerMesh {
    std::shared_ptr<KM_Mesh> mesh;
    KM_3dPoint origin;         ///< where its coordinates begin
    std::uint64_t dropped = 0; ///< triangles that had no usable place
};

/// Makes meshes of corners. A vertex of a mesh is what corners have in common: their place alone
/// where the other numbers are the same as the place's, else each combination that comes up. Where
/// no two triangles would share a vertex, as some programs write them, vertices with equal values
/// become one.
class CornerMeshes {
public:
    /// @param tables  outlive this object
    explicit CornerMeshes(const CornerTables& tables);

    /// @param faces          of one mesh
    /// @param texture_place  where its texture coordinates lie on the texture
    CornerMesh make(std::span<const FaceCorners> faces, const TexturePlace& texture_place = {});

private:
    /// What is one vertex of a mesh.
    struct Vertex {
        std::uint32_t place;
        std::uint32_t texture;
        std::uint32_t normal;
        std::uint32_t color;
        bool operator==(const Vertex&) const = default;
    };
    /// How the corners of a mesh name one of their parts.
    enum class Naming { none, by_place, own };

    Naming namingOf(std::span<const FaceCorners> faces,
                    const std::uint32_t* FaceCorners::*part) const;
    void addFaces(const FaceCorners& faces);
    void addFace(const FaceCorners& faces, std::size_t begin, std::uint32_t corners);
    bool isUsable(std::uint32_t place);
    std::uint32_t vertexAt(const FaceCorners& faces, std::size_t corner);
    std::uint32_t placeVertex(std::uint32_t place);
    std::uint32_t ownVertex(const Vertex& vertex);
    std::uint32_t addVertex(const Vertex& vertex);
    std::uint32_t textureOf(std::size_t vertex) const;
    std::uint32_t normalOf(std::size_t vertex) const;
    std::uint32_t colorOf(std::size_t vertex) const;
    void takePlaces(CornerMesh& made) const;
    void takeTextures(KM_Mesh& mesh, const TexturePlace& texture_place) const;
    void takeNormals(KM_Mesh& mesh) const;
    void takeColors(KM_Mesh& mesh) const;
    void forget();

    CornerTables m_tables;
    /// By place: its first vertex in the mesh in hand, or that it has none, or cannot have one.
    std::vector<std::uint32_t> m_vertex_of_place;
    Naming m_textures = Naming::none;
    Naming m_normals = Naming::none;
    Naming m_colors = Naming::none;
    bool m_has_own = false;                ///< one of the three is named by numbers of its own
    std::vector<std::uint32_t> m_places;   ///< by vertex
    std::vector<Vertex> m_vertices;        ///< by vertex, where m_has_own
    std::vector<std::uint32_t> m_next;     ///< by vertex, where m_has_own: another of its place
    std::vector<std::uint32_t> m_unusable; ///< places
    std::unique_ptr<IndexTable> m_crowded; ///< vertices of places that have many
    std::vector<KM_MeshTriangle> m_triangles;
    std::uint64_t m_dropped = 0;
    PolygonTriangles m_cutter;
    std::vector<KM_3dPoint> m_outline;
};

} // namespace quarn
