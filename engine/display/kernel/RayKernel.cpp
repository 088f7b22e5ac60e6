#include "engine/display/kernel/FrameSetup.h"

namespace quarn {

const RayKernel& bestRayKernel() {
    const bool v3 = __builtin_cpu_supports("avx2") && __builtin_cpu_supports("fma") &&
                    __builtin_cpu_supports("bmi") && __builtin_cpu_supports("bmi2");
    const bool v4 = v3 && __builtin_cpu_supports("avx512f") && __builtin_cpu_supports("avx512bw") &&
                    __builtin_cpu_supports("avx512cd") && __builtin_cpu_supports("avx512dq") &&
                    __builtin_cpu_supports("avx512vl");
    if (v4)
        return avx512_ray_kernel;
    return v3 ? avx2_ray_kernel : baseline_ray_kernel;
}

} // namespace quarn
