#pragma once

#include "engine/display/MipTexture.h"
#include "engine/display/SurfaceLook.h"
#include "engine/display/kernel/FrameSetup.h"

namespace quarn {

/// Where ray `lane` met a surface that has texture coordinates, and how much of a texture a pixel
/// covers there.
class TexturePlace {
public:
    /// @param place  the hit's u and v and the distance along the ray
    TexturePlace(const FrameSetup& frame, const RaySurface& surface, const RTCRayHit16& rays,
                 int lane, const float (&place)[3]);

    /// A texture that goes by the coordinates of the mesh.
    TextureSample sample(const MipTexture& texture) const;
    TextureSample sample(const LookTexture& texture) const;

private:
    float levelOf(const MipTexture& texture, float area_scale) const;

    float m_u = 0.0F;
    float m_v = 0.0F;
    float m_texture_area; ///< twice the triangle's, where a whole texture is 1
    float m_world_area;   ///< of the triangle, by the scene's size
    float m_covered;      ///< of the world by a pixel
};

} // namespace quarn
