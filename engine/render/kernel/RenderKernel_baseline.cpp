#define QUARN_RENDER_KERNEL baseline_render_kernel
#define QUARN_RENDER_KERNEL_NAME "baseline"
#include "engine/render/kernel/RenderLoops.h"
