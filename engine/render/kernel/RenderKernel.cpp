#include "engine/render/kernel/RenderSetup.h"

namespace quarn {

const RenderKernel& bestRenderKernel() {
    // What one set of loops can run on, the other can.
    const RayKernel* const best = &bestRayKernel();
    if (best == &avx512_ray_kernel)
        return avx512_render_kernel;
    return best == &avx2_ray_kernel ? avx2_render_kernel : baseline_render_kernel;
}

} // namespace quarn
