#define QUARN_RENDER_KERNEL avx512_render_kernel
#define QUARN_RENDER_KERNEL_NAME "avx512"
#include "engine/render/kernel/RenderLoops.h"
