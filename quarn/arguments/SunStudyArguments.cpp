// The recordings whose sun moves, and the places that they know.
#include "host/cities/Cities.h"
#include "quarn/arguments/Readings.h"
#include "quarn/arguments/RecordingArguments.h"
#include "quarn/arguments/SiteArguments.h"
#include "quarn/arguments/Subcommands.h"
#include "quarn/arguments/TypedStudy.h"
#include "quarn/reports/PlaceList.h"
#include "quarn/scripts/SunStudyScript.h"

namespace quarn::program {

namespace {

constexpr int MINUTES_OF_DAY = 1440;

Reading<std::chrono::year_month_day> dayUntil(int last_year) {
    return [=](const std::string& option,
               const std::string& word) -> std::variant<std::chrono::year_month_day, Refusal> {
        const auto read = dateUntil(last_year)(option, word);
        if (const Refusal* const refusal = std::get_if<Refusal>(&read))
            return *refusal;
        const COleDateTime& date = std::get<COleDateTime>(read);
        return std::chrono::year(date.GetYear()) / date.GetMonth() / date.GetDay();
    };
}

Reading<WantedDay> wantedDay() {
    return
        [](const std::string& option, const std::string& word) -> std::variant<WantedDay, Refusal> {
            constexpr std::pair<std::string_view, SeasonDay> NAMED[] = {
                {"equinox-march", SeasonDay::march_equinox},
                {"solstice-june", SeasonDay::june_solstice},
                {"equinox-september", SeasonDay::september_equinox},
                {"solstice-december", SeasonDay::december_solstice}};
            for (const auto& [name, day] : NAMED)
                if (word == name)
                    return WantedDay(day);
            if (word == "today")
                return WantedDay();
            const auto read = dayUntil(LAST_YEAR_OF_DAY)(option, word);
            if (const Refusal* const refusal = std::get_if<Refusal>(&read))
                return *refusal;
            return WantedDay(std::get<std::chrono::year_month_day>(read));
        };
}

/// @param sun  whether sunrise and sunset count
Reading<WantedTime> timeOfStudy(bool sun) {
    return [=](const std::string& option,
               const std::string& word) -> std::variant<WantedTime, Refusal> {
        const auto time = wantedTime(word);
        if (time && (sun || time->since == WantedTime::Since::midnight))
            return *time;
        return mustBe(option,
                      std::string("a time from 00:00 to 23:59") +
                          (sun ? ", or one such as sunrise+1h and sunset-30m" : ""),
                      word);
    };
}

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
    add("--zone", typed.zone, "ZONE", scriptWord("the name of --zone"),
        "Clocks that times are of: a time zone such as Europe/Berlin, hours from UTC such as "
        "+05:30, or solar for the mean time of the sun (default: those of the place)");
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

Outcome recordStudy(TypedStudy& typed) {
    SunStudyRequest& request = typed.request;
    std::optional<std::string> mistake = settle(request.recording);
    if (!mistake)
        mistake = settleSite(typed);
    if (!mistake && request.view.name && request.view.aims())
        mistake = "--view takes the place of --azimuth, --elevation and --target.";
    if (!mistake && request.view.lens_mm && request.view.isParallel())
        mistake = "--lens is for perspective views; --view " + *request.view.name + " has none.";
    if (!mistake)
        mistake = settleTimes(typed);
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
    add("--date", typed->day, "DATE", wantedDay(),
        "The day, such as 2026-06-21, or this year's solstice-june, solstice-december, "
        "equinox-march or equinox-september (default: today)");
    add("--from", typed->first_time, "TIME", timeOfStudy(true),
        "Time of the first picture, such as 06:30 or sunrise+1h (default: the first step of "
        "--every with the sun's centre above the horizon)");
    add("--to", typed->last_time, "TIME", timeOfStudy(true),
        "Time that no picture is later than, such as 18:00 or sunset-30m (default: the last such "
        "step)");
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
    add("--from", typed->first_date, "DATE", dayUntil(LAST_YEAR_OF_SEASON),
        "Date of the first picture, such as 2026-03-21 (default: 1 January of this year, or a year "
        "before --to)");
    add("--to", typed->last_date, "DATE", dayUntil(LAST_YEAR_OF_SEASON),
        "Date that no picture is later than (default: a year after --from)");
    add("--every", request.step, "DAYS", wholeNumberFrom(1, {}, "days"),
        "Days between pictures, from 1", "7");
    add("--at", typed->noon, "HH:MM", timeOfStudy(false),
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
