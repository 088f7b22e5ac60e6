#include "host/sunhours/SunHoursMap.h"

#include <limits>

namespace quarn {

float SunHoursMap::hours(int x, int y) const {
    const std::size_t index = tiles.indexOf(x, y);
    return seen.object[index] == 0 ? std::numeric_limits<float>::quiet_NaN() : light.hours[index];
}

std::vector<SunStep> stepsOf(const SunMoments& moments) {
    std::vector<SunStep> steps;
    for (const SunMoment& moment : moments.moments)
        steps.push_back(moment.step);
    return steps;
}

std::optional<SunHoursMap> mapOf(const DisplayScene& scene, const KM_Viewport& viewport,
                                 const SunHoursRequest& request, const SunMoments& moments,
                                 const SunWatch& watch) {
    const PixelTiles tiles(request.width_px, request.height_px);
    SunHoursMap map{
        request.width_px,
        request.height_px,
        tiles,
        pointsSeen(scene, viewport, request.width_px, request.height_px, tiles.places()),
        {}};
    if (!findSun(scene, map.seen.points, stepsOf(moments), moments.areShown(), watch, map.light))
        return std::nullopt;
    return map;
}

} // namespace quarn
