#pragma once

#include "engine/scene/Material.h"
#include "engine/scene/UnitSystem.h"
#include "import/ImportedModel.h"
#include "kelmar/KM_3dPointArray.h"
#include "kelmar/KM_Mesh.h"
#include "kelmar/KM_Xform.h"

#include <cstddef>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace quarn {

/// What a file holds in one piece, of one material: a mesh, lines, points, or some of each.
struct SourceMesh {
    KM_wString name; ///< empty: it has none
    /// Null: no triangles. Every index names a vertex and every vertex is finite; there are no
    /// normals, or one a vertex, of which zero ones are made by the assembly. Colours are sRGB.
    std::shared_ptr<KM_Mesh> mesh;
    /// Where the mesh's coordinates begin in those of the file, for files whose numbers have more
    /// digits than single precision keeps.
    KM_3dPoint origin;
    /// Null: the default material. Its thickness is in units of the mesh, but its distance of
    /// attenuation in those of the file's world. Its numbers may be any.
    std::shared_ptr<const Material> material;
    std::vector<KM_3dPointArray> lines; ///< polylines of two points and more
    KM_3dPointArray points;
};

/// One piece where it stands. Pieces may stand in many places, or nowhere.
struct SourcePlace {
    KM_wString name;      ///< empty: that of the piece
    std::size_t mesh = 0; ///< which of the scene's pieces
    KM_Xform world_from_mesh;
};

/// A camera as its file has it, in the file's world.
struct SourceCamera {
    KM_wString name;
    KM_3dPoint location;
    KM_3dVector direction; ///< of any length
    KM_3dVector up;        ///< likewise
    bool is_parallel = false;
    /// The tangent of half the horizontal angle of view, or half the width where it is parallel;
    /// none where the file does not say.
    std::optional<double> half_width;
    double aspect = 4.0 / 3.0; ///< width over height
};

/// What a reader has understood of a model file, in the file's own coordinates.
struct SourceScene {
    std::vector<SourceMesh> meshes;
    std::vector<SourcePlace> places;
    std::vector<SourceCamera> cameras;
    std::vector<KM_Light> lights;
    UnitSystem units = UnitSystem::none;
    TakenUpAxis up;
    std::optional<ImportedPlace> place;
    std::vector<std::string> warnings; ///< sentences: what was left out and why
};

/// The sentence for what cannot be shown: "3 of 12 triangles were left out: an index is out of
/// range or a coordinate is no usable number."; empty where nothing was left out.
/// @param what  the things in the plural
std::string leftOutText(std::uint64_t dropped, std::uint64_t all, std::string_view what);

} // namespace quarn
