#pragma once

#include <cstdint>

struct aiScene;

namespace quarn {

/// Mends what the reading library hands out and then refuses itself when it checks its scene: empty
/// meshes, faces without corners and nodes that are missing go, a mesh of vertices alone becomes
/// points. Lights and animations go as well, for nobody here reads them. So do vertex colours that
/// are nothing at all, which stand for missing ones.
///
/// @return how many faces without corners there were
std::uint64_t repairScene(aiScene& scene);

} // namespace quarn
