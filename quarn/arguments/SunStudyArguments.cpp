// The recordings whose sun moves, and the places that they know.
#include "host/almanac/CourseChoice.h"
#include "quarn/arguments/Readings.h"
#include "quarn/arguments/RecordingArguments.h"
#include "quarn/arguments/SiteArguments.h"
#include "quarn/arguments/StudyViewArguments.h"
#include "quarn/arguments/Subcommands.h"
#include "quarn/reports/PlaceList.h"
#include "quarn/scripts/SunStudyScript.h"

namespace quarn::program {

namespace {

/// A study as it is typed: what it is made of is put together when all words are read.
struct TypedStudy {
    SunStudyRequest request{};
    TypedSite site;
    int step = 1;
    WantedCourse day;                   ///< of a day's study
    std::optional<WantedDay> first_day; ///< of a season
    std::optional<WantedDay> last_day;
    std::chrono::minutes time{}; ///< of a season: since midnight
    ScriptUse use;
};

std::optional<std::chrono::year_month_day> dateOf(const std::optional<WantedDay>& day,
                                                  const Zone& zone) {
    return day ? std::optional(dayOf(*day, zone)) : std::nullopt;
}

/// Settles the place and the moments; the request's recording must be settled.
std::optional<std::string> settleCourse(TypedStudy& typed) {
    SunStudyRequest& request = typed.request;
    const auto settled = settleSite(typed.site, request.recording.model);
    if (!settled)
        return settled.message();
    const CivilSite& site = settled.value().site;
    auto course = request.course.kind == StudyCourse::Kind::one_day
                      ? courseOfDay(site, typed.day, typed.step)
                      : courseOfSeason(site, dateOf(typed.first_day, site.zone),
                                       dateOf(typed.last_day, site.zone), typed.time, typed.step);
    if (!course)
        return course.message();
    request.course = std::move(course.value());
    if (const std::string& note = settled.value().zone_note; !note.empty())
        request.course.notes.insert(request.course.notes.begin(), note);
    request.recording.frames = frameCount(request.course);
    return std::nullopt;
}

Outcome recordStudy(TypedStudy& typed) {
    SunStudyRequest& request = typed.request;
    std::optional<std::string> mistake = settle(request.recording);
    if (!mistake)
        mistake = whyViewIsRefused(request.view, request.view.isParallel());
    if (!mistake)
        mistake = settleCourse(typed);
    if (mistake)
        return Outcome::misuse(*mistake);
    return recordOrShow(request.recording, sunStudyLines(request), typed.use);
}

Action finish(CLI::App& command, const std::shared_ptr<TypedStudy>& typed) {
    addStudyView(OptionAdder(command), typed->request.view,
                 "Top, Front, Right, Perspective or a camera of the model");
    addRecordingOptions(command, typed->request.recording, typed->use, CaptureSubject::moving_sun);
    return [typed] { return recordStudy(*typed); };
}

} // namespace

Action addDay(CLI::App& command) {
    const auto typed = std::make_shared<TypedStudy>();
    SunStudyRequest& request = typed->request;
    request.course.kind = StudyCourse::Kind::one_day;
    const OptionAdder add(command);
    addModelAndFolder(add, request.recording);
    addSiteOfModel(add, typed->site);
    add("--date", typed->day.day, "DATE", dayOfTheSun(), DAY_HELP);
    add("--from", typed->day.first, "TIME", timeOfTheSun(),
        "Time of the first picture, such as 06:30 or sunrise+1h (default: the first step of "
        "--every with the sun's centre above the horizon)");
    add("--to", typed->day.last, "TIME", timeOfTheSun(),
        "Time that no picture is later than, such as 18:00 or sunset-30m (default: the last such "
        "step)");
    add("--every", typed->step, "MINUTES", minutesOfADay(), "Minutes between pictures, 1 to 1440",
        "15");
    return finish(command, typed);
}

Action addSeason(CLI::App& command) {
    const auto typed = std::make_shared<TypedStudy>();
    SunStudyRequest& request = typed->request;
    request.course.kind = StudyCourse::Kind::seasonal;
    const OptionAdder add(command);
    addModelAndFolder(add, request.recording);
    addSiteOfModel(add, typed->site);
    add("--from", typed->first_day, "DATE", dayOfTheSun(LAST_SEASON_YEAR),
        "Date of the first picture, such as 2026-03-21 or solstice-june (default: 1 January of "
        "this year, or a year before --to)");
    add("--to", typed->last_day, "DATE", dayOfTheSun(LAST_SEASON_YEAR),
        "Date that no picture is later than (default: a year after --from)");
    add("--every", typed->step, "DAYS", wholeNumberFrom(1, {}, "days"),
        "Days between pictures, from 1", "7");
    add("--at", typed->time, "HH:MM", timeByTheClock(),
        "Time of day of every picture, in the place's standard time", "12:00");
    return finish(command, typed);
}

Action addPlaces(CLI::App& command) {
    const auto text = std::make_shared<std::string>();
    command.add_option("TEXT", *text, "Only those with this in their name or country")
        ->type_name("");
    return [text] { return listPlaces(*text); };
}

} // namespace quarn::program
