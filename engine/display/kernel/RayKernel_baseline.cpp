#define QUARN_RAY_KERNEL baseline_ray_kernel
#define QUARN_RAY_KERNEL_NAME "baseline"
#include "engine/display/kernel/RayLoops.h"
