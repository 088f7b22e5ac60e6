#pragma once

#include "import/assembly/SourceScene.h"
#include "import/gltf/GltfJson.h"
#include "kelmar/KM_Light.h"
#include "kelmar/KM_Xform.h"

#include <optional>
#include <vector>

namespace quarn::gltf {

/// The camera of a node, with the node's name or else its own.
/// @return nothing where the node has none
std::optional<SourceCamera> cameraOf(const Json& json, const Json& node,
                                     const KM_Xform& world_from_node);

/// The light that the extension KHR_lights_punctual gives a node, with the node's name
/// or else its own, and the intensity of the file; one below 0 counts as 0.
/// @return nothing where the node has none
std::optional<KM_Light> lightOf(const Json& json, const Json& node,
                                const KM_Xform& world_from_node);

/// Gives lights intensities up to 1. Those of files are candela, or lux of directional lights, for
/// which a document has no measure: the brightest light of a unit becomes 1, and the others keep
/// their relation to it.
void normalizeIntensities(std::vector<KM_Light>& lights);

} // namespace quarn::gltf
