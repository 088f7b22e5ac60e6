#include "engine/sunhours/GlassFilter.h"

#include "engine/display/DisplayScene.h"
#include "engine/display/OpacityFilter.h"
#include "engine/display/RaySurface.h"
#include "engine/display/SurfaceLook.h"

namespace quarn {

namespace {

constexpr float HALF = 0.5F;

std::uint32_t surfaceMet(const GlassFilter& filter, const RTCFilterFunctionNArguments& arguments,
                         unsigned i) {
    const unsigned first =
        filter.first_surfaces
            ? filter.first_surfaces[RTCHitN_instID(arguments.hit, arguments.N, i, 0)]
            : filter.sole_first_surface;
    return first + RTCHitN_geomID(arguments.hit, arguments.N, i);
}

bool isGlass(const RaySurface& surface, const RTCFilterFunctionNArguments& arguments, unsigned i) {
    if (surface.look &&
        surface.look->numbers.transmission * (1.0F - surface.look->numbers.metalness) > HALF)
        return true;
    return surface.see_through && opacityAt(surface, RTCHitN_primID(arguments.hit, arguments.N, i),
                                            RTCHitN_u(arguments.hit, arguments.N, i),
                                            RTCHitN_v(arguments.hit, arguments.N, i)) < HALF;
}

/// Ray and normal are in the coordinates of the mesh, where no transform has turned fronts into
/// backs.
bool isBack(const RTCFilterFunctionNArguments& arguments, unsigned i) {
    const unsigned count = arguments.N;
    return RTCHitN_Ng_x(arguments.hit, count, i) * RTCRayN_dir_x(arguments.ray, count, i) +
               RTCHitN_Ng_y(arguments.hit, count, i) * RTCRayN_dir_y(arguments.ray, count, i) +
               RTCHitN_Ng_z(arguments.hit, count, i) * RTCRayN_dir_z(arguments.ray, count, i) >
           0.0F;
}

void dropGlass(const RTCFilterFunctionNArguments* arguments) {
    const auto& filter = *reinterpret_cast<const GlassFilter*>(arguments->context);
    for (unsigned i = 0; i < arguments->N; ++i) {
        if (arguments->valid[i] == 0)
            continue;
        const std::uint32_t met = surfaceMet(filter, *arguments, i);
        const RaySurface& surface = filter.surfaces[met];
        const bool is_unseen_back =
            filter.passes_backs && surface.one_sided && isBack(*arguments, i);
        if (met == filter.absent_surface || is_unseen_back || isGlass(surface, *arguments, i))
            arguments->valid[i] = 0;
    }
}

} // namespace

GlassFilter::GlassFilter(const DisplayScene& scene, bool fronts_alone, std::uint32_t absent)
    : surfaces(scene.rays().surfaces().data()),
      first_surfaces(scene.rays().hasInstances() ? scene.rays().firstSurfaces().data() : nullptr),
      sole_first_surface(scene.rays().soleFirstSurface()), passes_backs(fronts_alone),
      absent_surface(absent) {
    rtcInitIntersectContext(&context);
    const RayScene& rays = scene.rays();
    if (rays.hasSeeThrough() || (fronts_alone && rays.hasOneSided()) || absent != NO_SURFACE)
        context.filter = dropGlass; // the library asks about every surface then
}

} // namespace quarn
