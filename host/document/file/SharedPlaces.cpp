#include "host/document/file/SharedPlaces.h"

namespace quarn {

SharedContent SharedPlaces::add(const DocumentContent& content) {
    SharedContent added;
    for (const ObjectContent& object : content.objects) {
        m_meshes.add(object.placed.mesh, added.meshes);
        m_materials.add(object.placed.material, added.materials);
    }
    for (const auto& material : added.materials)
        m_textures.add(material->base_color_texture, added.textures);
    return added;
}

} // namespace quarn
