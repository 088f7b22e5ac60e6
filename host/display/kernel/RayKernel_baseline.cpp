#define QUARN_RAY_KERNEL baseline_ray_kernel
#define QUARN_RAY_KERNEL_NAME "baseline"
#include "host/display/kernel/RayLoops.h"
