#define QUARN_RAY_KERNEL avx2_ray_kernel
#define QUARN_RAY_KERNEL_NAME "avx2"
#include "engine/display/kernel/RayLoops.h"
