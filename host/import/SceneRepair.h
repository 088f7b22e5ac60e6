#pragma once

struct aiScene;

namespace quarn {

/// Makes a scene of the reading library pass its own validation where the file is sound but the
/// library's loader is not: vertices without faces, as in a point cloud, become points; meshes
/// without vertices are taken out of the scene and of its nodes.
void repairScene(aiScene& scene);

} // namespace quarn
