#pragma once

#include "import/gltf/GltfAccessor.h"
#include "import/gltf/GltfDeformation.h"
#include "import/gltf/GltfNodes.h"

namespace quarn::gltf {

/// What bends the meshes of a file: the weights of morph targets and the joints of skins.
struct PoseSource {
    const ModelReading& reading;
    const Json& json;
    const Nodes& nodes;
    Accessors& accessors;
};

/// How a mesh is bent at a node.
/// @return an error that names the file
Result<Pose> poseAt(const PoseSource& source, const Json& node, const Json& mesh);

/// Where the copies of a node's mesh stand that the extension EXT_mesh_gpu_instancing makes: one at
/// the node itself without it.
/// @param most_memory_each  what each copy may take of the budget
/// @return an error that names the file
Result<std::vector<KM_Xform>> instancesAt(const PoseSource& source, const Json& node,
                                          std::uint64_t most_memory_each);

} // namespace quarn::gltf
