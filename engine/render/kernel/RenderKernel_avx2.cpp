#define QUARN_RENDER_KERNEL avx2_render_kernel
#define QUARN_RENDER_KERNEL_NAME "avx2"
#include "engine/render/kernel/RenderLoops.h"
