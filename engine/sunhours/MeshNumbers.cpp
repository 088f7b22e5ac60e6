#include "engine/sunhours/MeshNumbers.h"

#include "engine/display/DisplayScene.h"

namespace quarn {

/// The members of the ray scene are the mesh objects that can be drawn, in their order.
std::vector<std::uint32_t> meshesOfSurfaces(const DisplayScene& scene) {
    std::vector<std::uint32_t> mesh_of_member;
    for (std::size_t i = 0; i < scene.meshes().size(); ++i)
        if (scene.meshes()[i].mesh)
            mesh_of_member.push_back(static_cast<std::uint32_t>(i));
    std::vector<std::uint32_t> meshes;
    for (const std::uint32_t member : scene.rays().surfaceMembers())
        meshes.push_back(mesh_of_member[member]);
    return meshes;
}

std::vector<bool> oneSidedMeshes(const DisplayScene& scene) {
    const std::vector<std::uint32_t> meshes = meshesOfSurfaces(scene);
    std::vector<bool> one_sided(scene.meshes().size());
    for (std::size_t i = 0; i < meshes.size(); ++i)
        one_sided[meshes[i]] = scene.rays().surfaces()[i].one_sided;
    return one_sided;
}

} // namespace quarn
