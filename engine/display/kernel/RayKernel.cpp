#include "engine/display/InstructionSet.h"
#include "engine/display/kernel/FrameSetup.h"

namespace quarn {

const RayKernel& rayKernelInForce() {
    switch (instructionSetInForce()) {
    case InstructionSet::avx512:
        return avx512_ray_kernel;
    case InstructionSet::avx2:
        return avx2_ray_kernel;
    case InstructionSet::sse2:
        break;
    }
    return baseline_ray_kernel;
}

} // namespace quarn
