#pragma once

#include "ground/Result.h"
#include "import/ModelReading.h"
#include "import/assembly/CornerMeshes.h"
#include "import/assembly/SourceScene.h"

#include <cstdint>
#include <span>
#include <vector>

namespace quarn {

/// Faces, polylines and points of one piece, all by numbers of the same tables.
struct CornerElements {
    std::vector<FaceCorners> faces;
    std::vector<FaceCorners> lines; ///< polylines, by as many places as a run has corners
    std::vector<std::span<const std::uint32_t>> points;
};

/// Makes pieces of a scene from elements whose corners name what they have by number. What has no
/// usable place is left out and told.
class CornerPieces {
public:
    /// @param tables, reading, scene  outlive this object
    CornerPieces(const CornerTables& tables, const ModelReading& reading, SourceScene& scene);

    /// Adds a piece to the scene, where it stands once.
    /// @param piece  with a name and a material, where there are any
    /// @return an error, a part of a sentence, where the budget does not hold it
    Result<void> add(const CornerElements& elements, SourceMesh piece,
                     const TexturePlace& texture_place = {});

    /// Adds all places as a cloud of points, for files that have nothing else.
    void addAllAsPoints();

    /// Adds the sentences for what was left out to the scene's.
    void tellDropped();

private:
    struct Count {
        std::uint64_t all = 0;
        std::uint64_t dropped = 0;
    };

    Result<void> takeMemory(const CornerElements& elements);
    std::vector<KM_3dPointArray> linesOf(const CornerElements& elements, const KM_3dPoint& origin);
    void takePoint(std::uint32_t place, SourceMesh& piece);
    void place(SourceMesh&& piece);
    bool isUsable(std::uint32_t place) const;

    const CornerTables& m_tables;
    const ModelReading& m_reading;
    SourceScene& m_scene;
    CornerMeshes m_meshes;
    Count m_triangles;
    Count m_segments;
    Count m_points;
};

} // namespace quarn
