#include "host/document/file/SharedPlaces.h"

#include "engine/scene/MaterialFields.h"

namespace quarn {

SharedThings SharedPlaces::add(const DocumentContent& content) {
    SharedThings added;
    for (const ObjectContent& object : content.objects) {
        m_meshes.add(object.placed.mesh.get(), added.meshes);
        m_materials.add(object.placed.material.get(), added.materials);
    }
    const auto add = [&](const auto& texture) { m_textures.add(texture.get(), added.textures); };
    for (const Material* material : added.materials) {
        if (content.version >= FIRST_VERSION_WITH_SURFACES)
            forEachTexture(*material, add);
        else
            add(material->base_color_texture);
    }
    return added;
}

void SharedPlaces::forget(const void* gone) {
    m_textures.forget(gone);
    m_materials.forget(gone);
    m_meshes.forget(gone);
}

} // namespace quarn
