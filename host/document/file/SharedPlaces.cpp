#include "host/document/file/SharedPlaces.h"

namespace quarn {

SharedThings SharedPlaces::add(const DocumentContent& content) {
    SharedThings added;
    for (const ObjectContent& object : content.objects) {
        m_meshes.add(object.placed.mesh.get(), added.meshes);
        m_materials.add(object.placed.material.get(), added.materials);
    }
    for (const Material* material : added.materials)
        m_textures.add(material->base_color_texture.get(), added.textures);
    return added;
}

void SharedPlaces::forget(const void* gone) {
    m_textures.forget(gone);
    m_materials.forget(gone);
    m_meshes.forget(gone);
}

} // namespace quarn
