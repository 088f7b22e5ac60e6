#pragma once

#include "engine/scene/PlacedMesh.h"
#include "engine/scene/UnitSystem.h"
#include "ground/Result.h"
#include "kelmar/KM_3dPointArray.h"
#include "kelmar/KM_Viewport.h"
#include "kelmar/KM_wString.h"

#include <filesystem>
#include <string>
#include <vector>

namespace quarn {

/// A mesh object of a model file.
struct ImportedMesh {
    KM_wString name; ///< as the file has it, or the file's own name; never empty
    /// The mesh is valid, with at least one triangle and vertex normals; objects that repeat a mesh
    /// share it, as those of one material share that. The transform is not the identity for
    /// repeated meshes and for models far from the origin.
    PlacedMesh placed;
};

/// Line primitives of a model file that hang together, as one polyline in world coordinates. The
/// last point of a closed one equals its first.
struct ImportedCurve {
    KM_wString name;
    KM_3dPointArray points; ///< at least two
};

/// A camera of a model file. Its target is where its line of sight comes closest to the middle of
/// the model.
struct ImportedCamera {
    KM_wString name;
    KM_Viewport viewport;
};

/// What a model file holds.
struct ImportedModel {
    std::vector<ImportedMesh> meshes;
    std::vector<ImportedCurve> curves;
    KM_3dPointArray points;
    std::vector<ImportedCamera> cameras;
    UnitSystem units = UnitSystem::none; ///< of the coordinates, where the format defines them
    std::vector<std::string> warnings;   ///< sentences for the person: what was left out and why

    /// All triangles of all meshes.
    std::size_t triangleCount() const;
};

/// Which axis of a model file points up.
enum class UpAxis {
    by_format, ///< Y where the format is Y-up, else Z
    y,
    z,
};

/// Reads a model file: OBJ, glTF, GLB, PLY, STL, and what else the Assimp library knows (FBX, DAE,
/// 3DS, 3MF, OFF, ...).
///
/// - Coordinates are in the file's own units. Z is up: formats that are Y-up by their definition
///   (glTF, GLB), or that Assimp hands out Y-up (FBX, DAE, 3DS, DXF and others), are turned, with Y
///   to Z and Z to -Y. OBJ, PLY, STL, OFF, 3MF, AMF, BLEND, COB, HMP, Q3O and SMD state no axis or
///   are Z-up: they stay as they are. Files of these that were made Y-up are read with UpAxis::y.
/// - Lengths of glTF and GLB are metres (Khronos Group, glTF 2.0, section 3.4); other
///   formats leave the units to whoever made the file.
/// - The transforms of the file's nodes are applied. A mesh that stands in a scene ten times
///   becomes ten objects that share it, each with its transform; where a mesh stands once, its
///   vertices are in world coordinates, and mirroring turns the triangles' winding, so that outside
///   stays outside.
/// - A model that lies far from the origin has its vertices near a place of its own, to which the
///   objects' transforms lead, because they have single precision.
/// - Vertex normals of the file are kept, except those of STL, which only repeat the facets, and of
/// BLEND, which smooth everything. Where
///   they are missing, vertices are smoothed over edges flatter than 40 degrees and sharp edges
///   stay sharp.
/// - Colours come out in sRGB: base colour factors and vertex colours of glTF are linear in the
///   file, those of other formats count as sRGB already.
/// - Other files that the model names (materials, buffers, textures) are read only from the model's
///   folder and below it; a name that leads elsewhere is left out with a warning.
/// - Triangles with an index out of range or a coordinate that is no usable number are left out
///   with a warning.
///
/// @param path  the model file; a relative path counts from the current folder
/// @param up    the axis that points up in the file
/// @return the model, with at least one triangle, curve or point; or an error that names the file:
///   missing, a folder, empty, not readable, larger than 4 GB, of an unknown kind, damaged, or with
///   nothing to show
Result<ImportedModel> readModelFile(const std::filesystem::path& path,
                                    UpAxis up = UpAxis::by_format);

} // namespace quarn
