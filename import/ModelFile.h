#pragma once

#include "ground/Result.h"
#include "import/ImportedModel.h"
#include "import/ReadingBudget.h"
#include "import/ReadingWatch.h"

#include <cstdint>
#include <filesystem>
#include <limits>

namespace quarn {

/// How a model file is read.
struct ReadingOptions {
    UpAxis up = UpAxis::by_format;
    /// How far the meshes of curved surfaces (STEP, IGES, BREP) may lie beside them, in the file's
    /// units; 0: a share of the model's size.
    double tolerance = 0.0;
    /// How much memory the model may take, in bytes.
    std::uint64_t most_memory = std::numeric_limits<std::uint64_t>::max();
    ReadingWatch* watch = nullptr; ///< may be null; outlives the reading
};

/// Reads a model file; docs/model-files.md says what is kept of each format.
///
/// - Coordinates are in the file's own units, with Z up: files that are Y-up are turned, with Y to
/// Z
///   and Z to -Y.
/// - The transforms of the file's nodes are applied. A mesh that stands in a scene ten times
///   becomes ten objects that share it, each with its transform; where a mesh stands once, its
///   vertices are in world coordinates, and mirroring turns the triangles' winding, so that outside
///   stays outside.
/// - A model that lies far from the origin has its vertices near a place of its own, to which the
///   objects' transforms lead, because they have single precision.
/// - Vertex normals of the file are kept where its format's are worth it. Where they are missing,
///   vertices are smoothed over edges flatter than 40 degrees and sharp edges stay sharp.
/// - Colours come out in sRGB.
/// - Other files that the model names (materials, buffers, textures) are read only from the model's
///   folder and below it; a name that leads elsewhere is left out with a warning.
/// - Triangles with an index out of range or a coordinate that is no usable number are left out
///   with a warning.
///
/// @param path  the model file; a relative path counts from the current folder
/// @return the model, with at least one triangle, curve or point; or an error that names the file:
///   missing, a folder, empty, not readable, larger than 4 GB, of an unknown kind, damaged, given
///   up, in need of more memory than it may take, or with nothing to show
Result<ImportedModel> readModelFile(const std::filesystem::path& path,
                                    const ReadingOptions& options = {});

} // namespace quarn
