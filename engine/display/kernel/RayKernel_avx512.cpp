#define QUARN_RAY_KERNEL avx512_ray_kernel
#define QUARN_RAY_KERNEL_NAME "avx512"
#include "engine/display/kernel/RayLoops.h"
