#pragma once

#include "import/ModelReading.h"
#include "import/gltf/GltfJson.h"
#include "kelmar/KM_Xform.h"

#include <cstdint>
#include <string>
#include <vector>

namespace quarn::gltf {

/// Where the nodes of a file stand.
struct Nodes {
    std::vector<KM_Xform> world_from_node; ///< of all nodes; those that nothing leads to stand at
                                           ///< the origin
    std::vector<std::uint64_t> shown; ///< those of the scene, each once, parents before children
};

/// Follows the nodes of the scene that the file shows: the one that it names, else its first, else
/// all nodes. A node that is reached a second time, also from below, stays where it was.
/// @param warnings  receives sentences
/// @return an error that names the file
Result<Nodes> followNodes(const ModelReading& reading, const Json& json,
                          std::vector<std::string>& warnings);

/// A rotation as files have it.
/// @param xyzw  a quaternion of any length; without a length it turns nothing
KM_Xform rotation(const double (&xyzw)[4]);

} // namespace quarn::gltf
