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

std::optional<SummerTime> summerTime(const SunPathRequest& request) {
    for (const WallTime& wall : wallTimes(request)) {
        const auto ahead = floor<minutes>(wall.offset - clockOf(request).ahead);
        if (ahead > minutes(0))
            return SummerTime{wall.abbreviation, ahead};
    }
    return std::nullopt;
}

std::string coordinateText(double coordinate) {
    std::array<char, 32> text;
    const char* const end = std::to_chars(text.data(), text.data() + text.size(), coordinate).ptr;
    return {static_cast<const char*>(text.data()), end};
}

std::string nameOf(const SkyPoint& place) {
    if (const auto* const name = std::get_if<std::string>(&place))
        return *name;
    const auto& point = std::get<KM_3dPoint>(place);
    return coordinateText(point.x) + "," + coordinateText(point.y) + "," + coordinateText(point.z);
}

SunPathWish wishOf(const SunPathRequest& request) {
    SunPathWish wish{.place = request.place,
                     .site = request.site,
                     .clock = clockOf(request),
                     .clock_name = clockName(request),
                     .summer_time = summerTime(request),
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
        wish.point = DiagramPoint{nameOf(*request.point),
                                  std::holds_alternative<std::string>(*request.point),
                                  request.model, std::move(obstruction.value())};
    }
    if (const auto written = writeSunPathDiagram(wish, request.file); !written)
        return written.error();
    return SunPathDrawn{wish.clock_name};
}

} // namespace quarn
