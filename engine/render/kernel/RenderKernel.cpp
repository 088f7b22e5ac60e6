#include "engine/display/InstructionSet.h"
#include "engine/render/kernel/RenderSetup.h"

namespace quarn {

const RenderKernel& renderKernelInForce() {
    switch (instructionSetInForce()) {
    case InstructionSet::avx512:
        return avx512_render_kernel;
    case InstructionSet::avx2:
        return avx2_render_kernel;
    case InstructionSet::sse2:
        break;
    }
    return baseline_render_kernel;
}

} // namespace quarn
