// The recordings whose sun moves, and the places that they know.
#include "host/cities/Cities.h"
#include "host/session/StatedSite.h"
#include "quarn/arguments/Readings.h"
#include "quarn/arguments/RecordingArguments.h"
#include "quarn/arguments/SiteArguments.h"
#include "quarn/arguments/Subcommands.h"
#include "quarn/reports/PlaceList.h"
#include "quarn/scripts/SunStudyScript.h"

namespace quarn::program {

namespace {

constexpr int LAST_YEAR_OF_DAY = 2199;    // as the host's sun takes them
constexpr int LAST_YEAR_OF_SEASON = 2100; // as the command of a seasonal study takes them
constexpr int MINUTES_OF_DAY = 1440;

/// A study as it is typed: what it is made of is put together when all words are read.
struct TypedStudy {
    SunStudyRequest request{};
    const City* city = nullptr;
    std::optional<double> latitude_deg;
    std::optional<double> longitude_deg;
    std::optional<double> north_deg;
    COleDateTime first_date;
    COleDateTime last_date;
    ClockTime first_time{};
    ClockTime last_time{};
    ScriptUse use;
};

void addSiteOptions(const OptionAdder& add, TypedStudy& typed) {
    add("--place", typed.city, "NAME", cityName(),
        "City where the model stands; quarn places lists them. An IFC file may state its own place "
        "and north, which count where these options are left out");
    add("--latitude", typed.latitude_deg, "DEG", numberFrom(-90, 90, "degrees"),
        "Or: degrees north, -90 to 90");
    add("--longitude", typed.longitude_deg, "DEG", numberFrom(-180, 180, "degrees"),
        "and degrees east, -180 to 180; west is negative");
    add("--north", typed.north_deg, "DEG", numberFrom(-360, 360, "degrees"),
        "Where north is in the model, in degrees clockwise from its Y axis (default: 0)");
}

void addViewOptions(const OptionAdder& add, StudyView& view) {
    add("--view", view.name, "NAME", scriptWord("the name of --view"),
        "Top, Front, Right, Perspective or a camera of the model, in place of the next options");
    add("--azimuth", view.azimuth_deg, "DEG", numberFrom(-360, 360, "degrees"),
        "Where the camera stands, clockwise from the Y axis (default: 150, in front and to the "
        "right)");
    add("--elevation", view.elevation_deg, "DEG", numberFrom(0, 89, "degrees"),
        "Angle of the camera above the model, 0 to 89 (default: 30)");
    add("--target", view.target, "X,Y,Z", point(),
        "Point to look at (default: the model's middle)");
    add("--distance", view.distance_factor, "FACTOR", numberFrom(0.01, 1000),
        "Distance of the camera, 1 where the model just fits into the picture (default: 1.1)");
    addLens(add, view.lens_mm, "(default: 50; a document's own)");
}

/// Takes the place that the model's file states.
std::optional<std::string> settleByModel(const std::filesystem::path& model, StudySite& site) {
    const std::optional<StatedSite> stated = statedSite(model);
    if (!stated)
        return "say where the model stands with --place, or with --latitude and --longitude; "
               "quarn places lists the places.";
    site = {"As " + model.filename().native() + " states", stated->latitude_deg,
            stated->longitude_deg, stated->north_angle_deg};
    return std::nullopt;
}

std::optional<std::string> settleSite(const TypedStudy& typed, StudySite& site) {
    const bool has_coordinate = typed.latitude_deg || typed.longitude_deg;
    if (typed.city && has_coordinate)
        return "give either --place, or --latitude and --longitude.";
    if (!typed.city && has_coordinate && !(typed.latitude_deg && typed.longitude_deg))
        return "--latitude and --longitude go together.";
    std::optional<std::string> mistake;
    if (typed.city)
        site = {nameWithCountry(*typed.city), typed.city->latitude_deg, typed.city->longitude_deg};
    else if (has_coordinate)
        site = {"", *typed.latitude_deg, *typed.longitude_deg};
    else
        mistake = settleByModel(typed.request.recording.model, site);
    site.north_deg = typed.north_deg.value_or(site.north_deg);
    return mistake;
}

/// An end of the span, as its option has it.
std::string endText(const SunStudyRequest& request, const COleDateTime& end) {
    return request.kind == SunStudyRequest::Kind::one_day ? timeOfDayText(end) : dateText(end);
}

/// A span is counted in frames; both of its ends have one where the steps meet them.
std::optional<std::string> settleSpan(SunStudyRequest& request, std::int64_t minutes_of_step) {
    const std::int64_t minutes = minutesBetween(request.start, request.end);
    if (minutes < 0)
        return "--to " + endText(request, request.end) + " is before --from " +
               endText(request, request.start) + ".";
    request.recording.frames = static_cast<int>(minutes / minutes_of_step) + 1;
    return std::nullopt;
}

Outcome recordStudy(TypedStudy& typed) {
    SunStudyRequest& request = typed.request;
    const bool is_one_day = request.kind == SunStudyRequest::Kind::one_day;
    request.start = atTime(typed.first_date, typed.first_time);
    request.end = is_one_day ? atTime(typed.first_date, typed.last_time)
                             : atTime(typed.last_date, typed.first_time);
    std::optional<std::string> mistake = settle(request.recording);
    if (!mistake)
        mistake = settleSite(typed, request.site);
    if (!mistake && request.view.name && request.view.aims())
        mistake = "--view takes the place of --azimuth, --elevation and --target.";
    if (!mistake && request.view.lens_mm && request.view.isParallel())
        mistake = "--lens is for perspective views; --view " + *request.view.name + " has none.";
    if (!mistake)
        mistake =
            settleSpan(request, std::int64_t{request.step} * (is_one_day ? 1 : MINUTES_OF_DAY));
    if (mistake)
        return Outcome::misuse(*mistake);
    return recordOrShow(request.recording, sunStudyLines(request), typed.use);
}

Action finish(CLI::App& command, const std::shared_ptr<TypedStudy>& typed) {
    addViewOptions(OptionAdder(command), typed->request.view);
    addRecordingOptions(command, typed->request.recording, typed->use, CaptureSubject::moving_sun);
    return [typed] { return recordStudy(*typed); };
}

} // namespace

Action addDay(CLI::App& command) {
    const auto typed = std::make_shared<TypedStudy>();
    SunStudyRequest& request = typed->request;
    request.kind = SunStudyRequest::Kind::one_day;
    const OptionAdder add(command);
    addModelAndFolder(add, request.recording);
    addSiteOptions(add, *typed);
    add("--date", typed->first_date, "DATE", dateUntil(LAST_YEAR_OF_DAY),
        "The day, such as 2026-06-21")
        ->required();
    add("--from", typed->first_time, "HH:MM", timeOfDay(), "Time of the first picture", "06:00");
    add("--to", typed->last_time, "HH:MM", timeOfDay(), "Time that no picture is later than",
        "20:00");
    add("--every", request.step, "MINUTES", wholeNumberFrom(1, MINUTES_OF_DAY, "minutes"),
        "Minutes between pictures, 1 to 1440", "15");
    return finish(command, typed);
}

Action addSeason(CLI::App& command) {
    const auto typed = std::make_shared<TypedStudy>();
    SunStudyRequest& request = typed->request;
    request.kind = SunStudyRequest::Kind::seasonal;
    const OptionAdder add(command);
    addModelAndFolder(add, request.recording);
    addSiteOptions(add, *typed);
    add("--from", typed->first_date, "DATE", dateUntil(LAST_YEAR_OF_SEASON),
        "Date of the first picture, such as 2026-03-21")
        ->required();
    add("--to", typed->last_date, "DATE", dateUntil(LAST_YEAR_OF_SEASON),
        "Date that no picture is later than")
        ->required();
    add("--every", request.step, "DAYS", wholeNumberFrom(1, {}, "days"),
        "Days between pictures, from 1", "7");
    add("--at", typed->first_time, "HH:MM", timeOfDay(), "Time of day of every picture", "12:00");
    return finish(command, typed);
}

Action addPlaces(CLI::App& command) {
    const auto text = std::make_shared<std::string>();
    command.add_option("TEXT", *text, "Only those with this in their name or country")
        ->type_name("");
    return [text] { return listPlaces(*text); };
}

} // namespace quarn::program
