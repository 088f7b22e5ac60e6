#include "host/session/SunPath.h"

#include "host/sunpath/SunPathFile.h"
#include "sdk/zel/QnZone.h"

#include <array>
#include <charconv>

namespace quarn {
namespace {

using namespace std::chrono;

/// The clock of the year's winter, which the diagram keeps all year.
StandardClock clockOf(const SunPathRequest& request) {
    return {request.year, request.zone.standardOffset(request.year)};
}

/// What clocks show in the middle of the year's winter and of its summer.
std::array<WallTime, 2> wallTimes(const SunPathRequest& request) {
    const StandardClock clock = clockOf(request);
    return {request.zone.at(clock.at(January / 15, hours(12))),
            request.zone.at(clock.at(July / 15, hours(12)))};
}

/// "CET, UTC+1"
std::string clockName(const SunPathRequest& request) {
    const StandardClock clock = clockOf(request);
    const auto ahead = floor<minutes>(clock.ahead).count();
    const std::string distance = QnZoneText(static_cast<int>(ahead)).ToUtf8();
    for (const WallTime& wall : wallTimes(request))
        if (wall.offset == clock.ahead)
            return wall.abbreviation == distance ? distance : wall.abbreviation + ", " + distance;
    return distance;
}

/// What clocks show in the year besides: empty where they show nothing else.
std::string clockNote(const SunPathRequest& request) {
    for (const WallTime& wall : wallTimes(request)) {
        const auto ahead = floor<minutes>(wall.offset - clockOf(request).ahead).count();
        if (ahead > 0)
            return "While summer time is kept (" + wall.abbreviation + ") clocks show " +
                   (ahead == 60 ? "one hour" : std::to_string(ahead) + " minutes") + " more.";
    }
    return "";
}

std::string coordinateText(double coordinate) {
    std::array<char, 32> text;
    const char* const end = std::to_chars(text.data(), text.data() + text.size(), coordinate).ptr;
    return {static_cast<const char*>(text.data()), end};
}

std::string pointName(const SkyPoint& place, const std::string& model) {
    if (const auto* const name = std::get_if<std::string>(&place))
        return "\"" + *name + "\" of " + model;
    const auto& point = std::get<KM_3dPoint>(place);
    return "the point " + coordinateText(point.x) + "," + coordinateText(point.y) + "," +
           coordinateText(point.z) + " of " + model;
}

SunPathWish wishOf(const SunPathRequest& request) {
    SunPathWish wish{.place = request.place,
                     .site = request.site,
                     .clock = clockOf(request),
                     .clock_name = clockName(request),
                     .clock_note = clockNote(request),
                     .projections = {},
                     .north_deg = request.north_deg,
                     .point = {}};
    if (request.is_stereographic)
        wish.projections.push_back(SkyProjection::stereographic);
    if (request.is_orthographic)
        wish.projections.push_back(SkyProjection::orthographic);
    return wish;
}

} // namespace

Result<SunPathDrawn> makeSunPath(CQuarnDoc& document, const SunPathRequest& request) {
    SunPathWish wish = wishOf(request);
    if (request.point) {
        auto obstruction =
            obstructionAround(document, *request.point, request.north_deg.value_or(0.0));
        if (!obstruction)
            return Error{request.model + ": " + obstruction.message()};
        wish.point =
            DiagramPoint{pointName(*request.point, request.model), std::move(obstruction.value())};
    }
    if (const auto written = writeSunPathDiagram(wish, request.file); !written)
        return written.error();
    return SunPathDrawn{wish.clock_name};
}

} // namespace quarn
