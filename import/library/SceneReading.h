#pragma once

#include "import/ModelReading.h"

struct aiScene;

namespace quarn {

/// What the format of a model file implies.
struct ModelConventions {
    bool keep_normals = true; ///< false: those of the file are worth nothing
    /// The loader of glTF repeats a camera's place, which its node states already, and gives the
    /// vertical angle times the aspect for the horizontal one.
    bool gltf_cameras = false;
};

/// Takes a scene of the reading library apart. Each mesh's memory is freed as soon as it has been
/// converted, so that the scene and its copy never stand in memory together; the scene is useless
/// afterwards.
SourceScene takeScene(aiScene& scene, const ModelReading& reading,
                      const ModelConventions& conventions);

} // namespace quarn
