#include "quarn/runs/SunPathRun.h"

#include "host/session/SkyAround.h"
#include "host/sunpath/SunPathFile.h"
#include "quarn/session/Interruption.h"
#include "sdk/zel/QnZone.h"

#include <system_error>

namespace quarn::program {

namespace {

/// The clock of the year's winter, which the diagram keeps all year, and what to call it.
StandardClock clockOf(const SunPathRequest& request) {
    return {request.year, request.site.zone.standardOffset(request.year)};
}

/// "CET, UTC+1"
std::string clockName(const SunPathRequest& request) {
    const StandardClock clock = clockOf(request);
    const auto minutes = std::chrono::floor<std::chrono::minutes>(clock.ahead).count();
    const std::string distance = QnZoneText(static_cast<int>(minutes)).ToUtf8();
    using namespace std::chrono;
    for (const month_day day : {January / 15, July / 15}) {
        const WallTime wall = request.site.zone.at(clock.at(day, hours(12)));
        if (wall.offset != clock.ahead)
            continue;
        const std::string& letters = wall.abbreviation;
        return letters == distance ? distance : letters + ", " + distance;
    }
    return distance;
}

/// What clocks show in the year besides: empty where they show nothing else.
std::string clockNote(const SunPathRequest& request) {
    const StandardClock clock = clockOf(request);
    using namespace std::chrono;
    for (const month_day day : {January / 15, July / 15}) {
        const WallTime wall = request.site.zone.at(clock.at(day, hours(12)));
        const auto ahead = floor<minutes>(wall.offset - clock.ahead).count();
        if (ahead > 0)
            return "While summer time is kept (" + wall.abbreviation + ") clocks show " +
                   (ahead == 60 ? "one hour" : std::to_string(ahead) + " minutes") + " more.";
    }
    return "";
}

std::string pointName(const SunPathRequest& request) {
    const std::string model = " of " + request.model.filename().native();
    return request.point ? "the point " + tripleText(*request.point) + model
                         : "\"" + request.object + "\"" + model;
}

SunPathWish wishOf(const SunPathRequest& request) {
    SunPathWish wish{.place = request.site.place,
                     .site = {request.site.latitude_deg, request.site.longitude_deg},
                     .clock = clockOf(request),
                     .clock_name = clockName(request),
                     .clock_note = clockNote(request),
                     .projections = {},
                     .north_deg = {},
                     .point = {}};
    if (request.has_north)
        wish.north_deg = request.site.north_deg;
    if (request.is_stereographic)
        wish.projections.push_back(SkyProjection::stereographic);
    if (request.is_orthographic)
        wish.projections.push_back(SkyProjection::orthographic);
    return wish;
}

/// Looks at the sky from the point.
std::optional<Outcome> lookAround(const SunPathRequest& request, const CommonOptions& common,
                                  SunPathWish& wish) {
    watchForInterruption();
    ConsoleFrontEnd front_end(printsFor(common));
    HostSession host(front_end, common, HostSession::Use::numbers);
    if (const auto trouble = host.readModel(request.model))
        return *trouble;
    SkyPoint place = request.object;
    if (request.point)
        place = KM_3dPoint((*request.point)[0], (*request.point)[1], (*request.point)[2]);
    auto obstruction = obstructionAround(host.session().document(), place, request.site.north_deg);
    if (!obstruction)
        return Outcome::failure(request.model.native() + ": " + obstruction.message());
    wish.point = DiagramPoint{pointName(request), std::move(obstruction.value())};
    if (isInterruptionRequested())
        return stopped("Stopped before anything was written.");
    return std::nullopt;
}

std::string doneText(const SunPathRequest& request, const SunPathWish& wish) {
    std::string text = request.file.native() + ": sun path of " +
                       (request.site.place.empty() ? "the place" : request.site.place) + " in " +
                       std::to_string(request.year) + ", hours of " + wish.clock_name + ".\n";
    if (!request.zone_note.empty())
        text += request.zone_note + ".\n";
    return text;
}

} // namespace

Outcome drawSunPath(const SunPathRequest& request, const CommonOptions& common) {
    if (const auto refusal = whyDiagramIsRefused(request.file))
        return Outcome::misuse(*refusal);
    std::error_code unknown; // what cannot be looked at cannot be written either, and says why then
    if (!common.overwrites && std::filesystem::exists(request.file, unknown))
        return Outcome::failure(request.file.native() +
                                " is there already: give --overwrite to replace it, or another "
                                "file.");
    SunPathWish wish = wishOf(request);
    if (!request.model.empty())
        if (const auto trouble = lookAround(request, common, wish))
            return *trouble;
    if (const auto written = writeSunPathDiagram(wish, request.file); !written)
        return Outcome::failure(written.message());
    return Outcome::success(doneText(request, wish));
}

} // namespace quarn::program
