#pragma once

#include "import/assembly/SourceScene.h"
#include "import/gltf/GltfDeformation.h"
#include "import/gltf/GltfMaterials.h"

#include <cstdint>
#include <map>
#include <string>

namespace quarn::gltf {

/// Makes pieces of a scene of the primitives of a file, and counts what is left out of them.
class Meshes {
public:
    /// All that it refers to outlives this object.
    Meshes(const PrimitiveSource& source, Materials& materials)
        : m_source(source), m_materials(materials) {}

    /// @param primitive  JSON
    /// @param name       of the primitive, for what is told of it
    /// @return a piece without a name, with nothing in it where the primitive says not where its
    ///   vertices are; or an error that names the file
    Result<SourceMesh> read(const Json& primitive, const std::string& name, const Pose& pose);

    /// Tells what was left out.
    void tellLosses();

private:
    struct Losses {
        std::uint64_t lost = 0;
        std::uint64_t all = 0;
        const char* what = "";
    };

    Result<void> readTriangles(const Primitive& primitive, const ReadMaterial& material,
                               const Deformation& deformation, Losses& losses, SourceMesh& piece);
    Result<void> readLines(const Primitive& primitive, const Deformation& deformation,
                           Losses& losses, SourceMesh& piece);
    Result<void> readPoints(const Primitive& primitive, const Deformation& deformation,
                            Losses& losses, SourceMesh& piece);

    const PrimitiveSource& m_source;
    Materials& m_materials;
    std::map<std::string, Losses> m_losses; ///< by name, of indices out of range
    std::uint64_t m_without_positions = 0;
    std::uint64_t m_triangles = 0;
    std::uint64_t m_triangles_dropped = 0; ///< for their coordinates
    std::uint64_t m_segments_dropped = 0;
    std::uint64_t m_points_dropped = 0;
};

} // namespace quarn::gltf
