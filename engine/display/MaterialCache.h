#pragma once

#include "engine/display/MipTexture.h"
#include "engine/display/SurfaceLook.h"
#include "engine/scene/Material.h"

#include <map>
#include <memory>
#include <utility>

namespace quarn {

/// What the ray loops need of materials: made once for each, and kept from one revision of a scene
/// to the next where it is still in use.
class MaterialCache {
public:
    /// Between these two everything that is still needed is asked for; the rest goes.
    void beginRevision();
    void endRevision();

    /// The smaller copies of a texture that is there.
    const MipTexture* texture(const std::shared_ptr<const Texture>& texture, TexelMeaning meaning);

    /// What the material looks like beyond its base colour; null when there is no more to it.
    /// @param has_coordinates  whether the mesh can have textures
    const SurfaceLook* look(const std::shared_ptr<const Material>& material, bool has_coordinates);

private:
    struct CachedTexture {
        std::shared_ptr<const Texture> source; ///< keeps its address from being used again
        std::shared_ptr<const MipTexture> mips;
    };
    struct CachedLook {
        std::shared_ptr<const Material> source;
        std::shared_ptr<const SurfaceLook> look;
    };
    struct Contents {
        std::map<std::pair<const Texture*, TexelMeaning>, CachedTexture> textures;
        std::map<std::pair<const Material*, bool>, CachedLook> looks;
    };

    LookTexture use(const TextureUse& texture, TexelMeaning meaning);
    void addTextures(const Material& material, SurfaceLook& look);
    SurfaceLook makeLook(const Material& material, bool has_coordinates);

    Contents m_contents;
    Contents m_earlier;
};

} // namespace quarn
