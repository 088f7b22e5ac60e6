#pragma once

#include <cstdint>
#include <vector>

namespace quarn {

class DisplayScene;

/// Of each surface of the ray scene the index of its mesh object in DisplayScene::meshes.
std::vector<std::uint32_t> meshesOfSurfaces(const DisplayScene& scene);

/// Of each mesh object whether it is seen from its front alone.
std::vector<bool> oneSidedMeshes(const DisplayScene& scene);

} // namespace quarn
