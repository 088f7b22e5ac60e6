#include "engine/display/FrontsAlone.h"

#include "engine/display/RaySurface.h"

namespace quarn {

namespace {

const RaySurface& surfaceMet(const RTCFilterFunctionNArguments& arguments, unsigned i) {
    const auto& rays = *reinterpret_cast<const FrontsAlone*>(arguments.context);
    const unsigned first =
        rays.first_surfaces ? rays.first_surfaces[RTCHitN_instID(arguments.hit, arguments.N, i, 0)]
                            : rays.sole_first_surface;
    return rays.surfaces[first + RTCHitN_geomID(arguments.hit, arguments.N, i)];
}

/// Ray and normal are in the coordinates of the mesh, where no transform has turned fronts into
/// backs.
bool isBack(const RTCFilterFunctionNArguments& arguments, unsigned i) {
    const unsigned count = arguments.N;
    RTCHitN* const hit = arguments.hit;
    RTCRayN* const ray = arguments.ray;
    return RTCHitN_Ng_x(hit, count, i) * RTCRayN_dir_x(ray, count, i) +
               RTCHitN_Ng_y(hit, count, i) * RTCRayN_dir_y(ray, count, i) +
               RTCHitN_Ng_z(hit, count, i) * RTCRayN_dir_z(ray, count, i) >
           0.0F;
}

void dropBacks(const RTCFilterFunctionNArguments* arguments) {
    for (unsigned i = 0; i < arguments->N; ++i)
        if (arguments->valid[i] != 0 && surfaceMet(*arguments, i).one_sided &&
            isBack(*arguments, i))
            arguments->valid[i] = 0;
}

} // namespace

void passBacks(FrontsAlone& fronts) {
    rtcInitIntersectContext(&fronts.context);
    fronts.context.filter = dropBacks;
}

} // namespace quarn
