#include "engine/display/kernel/LookPaint.h"

#include "engine/display/kernel/TexturePlace.h"

namespace quarn {

void paintLookAt(const FrameSetup& frame, const RaySurface& surface, const RTCRayHit16& rays,
                 int lane, const float (&place)[3], PaintedLook& painted) {
    const TexturePlace on_texture(frame, surface, rays, lane, place);
    const SurfaceLook& look = *surface.look;
    if (look.emission_texture.mips) {
        const TextureSample sample = on_texture.sample(look.emission_texture);
        painted.emission[0] *= sample.color.r;
        painted.emission[1] *= sample.color.g;
        painted.emission[2] *= sample.color.b;
    }
    if (frame.has_mirrors && look.metal_rough.mips) {
        const TextureSample sample = on_texture.sample(look.metal_rough);
        painted.roughness *= sample.color.g;
        painted.metalness *= sample.color.b;
    }
}

} // namespace quarn
