#pragma once

#include "ground/Result.h"
#include "import/ModelFile.h"
#include "import/ModelFolder.h"

#include <string>

struct aiScene;

namespace quarn {

/// What the format of a model file implies.
struct ModelConventions {
    bool turn_y_up = false;     ///< the scene is Y-up and must be turned
    bool keep_normals = true;   ///< false: those of the file are worth nothing
    bool linear_colors = false; ///< colours are linear light
    /// The loader of glTF repeats a camera's place, which its node states already, and gives the
    /// vertical angle times the aspect for the horizontal one.
    bool gltf_cameras = false;
    KM_3dPoint origin;    ///< where the scene's coordinates begin, in those of the file
    KM_wString file_name; ///< names what has no name of its own
};

/// Takes a scene of the reading library apart. Each mesh's memory is freed as soon as the last node
/// that shows it has been converted, so that the scene and its copy never stand in memory together;
/// the scene is useless afterwards.
///
/// @return the model, which may be empty; or why it cannot be made, a part of a sentence
Result<ImportedModel> takeScene(aiScene& scene, const ModelFolder& folder,
                                const ModelConventions& conventions);

} // namespace quarn
