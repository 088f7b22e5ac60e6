#pragma once

#include "engine/scene/PlacedMesh.h"
#include "engine/scene/UnitSystem.h"
#include "kelmar/KM_3dPointArray.h"
#include "kelmar/KM_Light.h"
#include "kelmar/KM_Viewport.h"
#include "kelmar/KM_wString.h"

#include <cstddef>
#include <optional>
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

/// Which axis of a model file points up.
enum class UpAxis {
    by_format, ///< what the file says of itself, else what its format means
    y,
    z,
};

/// The axis of a model file that was taken as the one that points up, and why.
struct TakenUpAxis {
    enum class Reason {
        format, ///< the format defines it
        file,   ///< the file says so, or its reader has turned it; the axis is what came of that
        habit,  ///< the format leaves it open; most files of the kind have it so
        writer, ///< the program that wrote the file has it so
        asked,  ///< whoever reads the file said so
    };
    UpAxis axis = UpAxis::z; ///< never by_format
    Reason reason = Reason::format;
    std::string writer; ///< the program that wrote the file, where that is the reason
};

/// The place on the earth that a model file states for its origin.
struct ImportedPlace {
    double latitude_deg = 0.0;    ///< north positive, -90 to 90
    double longitude_deg = 0.0;   ///< east positive, -180 to 180
    double north_angle_deg = 0.0; ///< from the Y axis to north, clockwise seen from above, 0 to 360
};

/// What a person may want to know of a reading afterwards.
struct ReadingNotes {
    TakenUpAxis up;
    std::vector<std::string> warnings; ///< sentences: what was left out and why
};

/// What a model file holds.
struct ImportedModel {
    std::vector<ImportedMesh> meshes;
    std::vector<ImportedCurve> curves;
    KM_3dPointArray points;
    std::vector<ImportedCamera> cameras;
    std::vector<KM_Light> lights;        ///< in world coordinates
    UnitSystem units = UnitSystem::none; ///< of the coordinates, where the format defines them
    TakenUpAxis up;
    std::optional<ImportedPlace> place;
    std::vector<std::string> warnings; ///< sentences for the person: what was left out and why

    /// All triangles of all meshes.
    std::size_t triangleCount() const;
};

} // namespace quarn
