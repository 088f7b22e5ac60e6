// The command that tells how much sun each place gets.
#include "host/cities/Cities.h"
#include "host/session/StatedSite.h"
#include "quarn/arguments/Readings.h"
#include "quarn/arguments/RecordingArguments.h"
#include "quarn/arguments/Subcommands.h"
#include "quarn/runs/SunHoursRun.h"
#include "quarn/words/AnimationName.h"

namespace quarn::program {

namespace {

constexpr int LAST_YEAR = 2199;
constexpr int MINUTES_OF_DAY = 1440;
constexpr int DAYS_OF_YEAR = 366;
constexpr const char* PLAN = "plan";

/// What is typed; what it means together is found out when all words are read.
struct TypedHours {
    SunHoursWish wish{};
    const City* city = nullptr;
    std::optional<double> latitude_deg;
    std::optional<double> longitude_deg;
    std::optional<double> north_deg;
    std::optional<std::string> zone;
    COleDateTime date;
    std::optional<COleDateTime> last_date;
    std::optional<ClockTime> from;
    std::optional<ClockTime> to;
    PixelSize size{};
};

Reading<const City*> knownCity() {
    return [](const std::string& option,
              const std::string& word) -> std::variant<const City*, Refusal> {
        if (const City* const city = findCity(word))
            return city;
        return Refusal{option + ": " + whyNoCity(word) +
                       " quarn places lists those that are known."};
    };
}

std::chrono::year_month_day dayOf(const COleDateTime& date) {
    return std::chrono::year_month_day(std::chrono::year(date.GetYear()),
                                       std::chrono::month(static_cast<unsigned>(date.GetMonth())),
                                       std::chrono::day(static_cast<unsigned>(date.GetDay())));
}

std::optional<std::chrono::minutes> minutesOf(const std::optional<ClockTime>& time) {
    if (!time)
        return std::nullopt;
    return std::chrono::minutes(60 * time->hour + time->minute);
}

/// The place, without its clock.
std::optional<std::string> settlePlace(TypedHours& typed) {
    SunHoursRequest& hours = typed.wish.hours;
    const bool has_coordinate = typed.latitude_deg || typed.longitude_deg;
    if (typed.city && has_coordinate)
        return "give either --place, or --latitude and --longitude.";
    if (has_coordinate && !(typed.latitude_deg && typed.longitude_deg))
        return "--latitude and --longitude go together.";
    if (typed.city) {
        hours.place = nameWithCountry(*typed.city);
        hours.latitude_deg = typed.city->latitude_deg;
        hours.longitude_deg = typed.city->longitude_deg;
    } else if (has_coordinate) {
        hours.latitude_deg = *typed.latitude_deg;
        hours.longitude_deg = *typed.longitude_deg;
    } else {
        const std::optional<StatedSite> stated = statedSite(typed.wish.model);
        if (!stated)
            return "say where the model stands with --place, or with --latitude and --longitude; "
                   "quarn places lists the places.";
        hours.latitude_deg = stated->latitude_deg;
        hours.longitude_deg = stated->longitude_deg;
        hours.north_deg = stated->north_angle_deg;
    }
    hours.north_deg = typed.north_deg.value_or(hours.north_deg);
    return std::nullopt;
}

/// The zone that was named, that of the city, or that of the city that is nearest.
std::optional<std::string> settleClock(TypedHours& typed) {
    SunHoursRequest& hours = typed.wish.hours;
    const City& nearest = nearestCity(hours.latitude_deg, hours.longitude_deg);
    const std::string name =
        typed.zone ? *typed.zone : std::string(typed.city ? typed.city->zone : nearest.zone);
    const auto zone = Zone::written(name, hours.longitude_deg);
    if (!zone)
        return (typed.zone ? "--zone: " : "") + zone.message();
    hours.zone = zone.value();
    if (!typed.zone && !typed.city)
        typed.wish.zone_note = "Times are those of " + hours.zone.name() + ", the zone of " +
                               nameWithCountry(nearest) + "; --zone names another one.\n";
    return std::nullopt;
}

std::optional<std::string> settleTimes(TypedHours& typed) {
    SunHoursRequest& hours = typed.wish.hours;
    hours.first_day = dayOf(typed.date);
    hours.last_day = dayOf(typed.last_date.value_or(typed.date));
    hours.from = minutesOf(typed.from);
    hours.to = minutesOf(typed.to);
    if (std::chrono::sys_days(hours.last_day) < std::chrono::sys_days(hours.first_day))
        return "--to-date " + dateText(*typed.last_date) + " is before --date " +
               dateText(typed.date) + ".";
    if (typed.to && minutesOf(typed.to) <= hours.from.value_or(std::chrono::minutes(0)))
        return "--to is not after --from: no time is between them.";
    return std::nullopt;
}

std::optional<std::string> settleView(TypedHours& typed) {
    SunHoursRequest& hours = typed.wish.hours;
    StudyView& view = typed.wish.view;
    hours.width_px = typed.size.width_px;
    hours.height_px = typed.size.height_px;
    hours.is_plan = view.name && lowerCase(*view.name) == PLAN;
    if (view.name && view.aims())
        return "--view takes the place of --azimuth, --elevation and --target.";
    if (view.lens_mm && (view.isParallel() || hours.is_plan))
        return "--lens is for perspective views; --view " + *view.name + " has none.";
    if (hours.is_plan && view.distance_factor)
        return "--distance does not go with --view plan, which fits the model.";
    if (!typed.wish.up_axis.empty() && isDocument(typed.wish.model))
        return "--up is for model files; a document knows its axes.";
    return std::nullopt;
}

Outcome tellHours(TypedHours& typed) {
    for (const auto settle : {settlePlace, settleClock, settleTimes, settleView})
        if (const auto mistake = settle(typed))
            return Outcome::misuse(*mistake);
    SunHoursRequest& hours = typed.wish.hours;
    hours.name = animationNameFor(typed.wish.model);
    hours.title = hours.name;
    return writeSunHours(typed.wish);
}

void addSite(const OptionAdder& add, TypedHours& typed) {
    add("--place", typed.city, "NAME", knownCity(),
        "City where the model stands; quarn places lists them. An IFC file may state its own place "
        "and north, which count where these options are left out");
    add("--latitude", typed.latitude_deg, "DEG", numberFrom(-90, 90, "degrees"),
        "Or: degrees north, -90 to 90");
    add("--longitude", typed.longitude_deg, "DEG", numberFrom(-180, 180, "degrees"),
        "and degrees east, -180 to 180; west is negative");
    add("--north", typed.north_deg, "DEG", numberFrom(-360, 360, "degrees"),
        "Where north is in the model, in degrees clockwise from its Y axis (default: 0)");
    add("--zone", typed.zone, "NAME", scriptWord("the name of --zone"),
        "The clock: a time zone such as Europe/Berlin, +05:30 or solar (default: the place's)");
}

void addTimes(const OptionAdder& add, TypedHours& typed) {
    SunHoursRequest& hours = typed.wish.hours;
    add("--date", typed.date, "DATE", dateUntil(LAST_YEAR), "The day, such as 2026-03-21")
        ->required();
    add("--to-date", typed.last_date, "DATE", dateUntil(LAST_YEAR),
        "The last of several days: hours are the mean of a day then");
    add("--every-days", hours.every_days, "N", wholeNumberFrom(1, DAYS_OF_YEAR, "days"),
        "Days between those that are looked at, 1 to 366", "1");
    add("--from", typed.from, "HH:MM", timeOfDay(),
        "Time that hours count from, by the clock of the place (default: midnight)");
    add("--to", typed.to, "HH:MM", timeOfDay(), "Time that they count to (default: midnight)");
    add("--every", hours.every_minutes, "MINUTES", wholeNumberFrom(1, MINUTES_OF_DAY, "minutes"),
        "Minutes between the places of the sun, 1 to 1440", "10");
}

void addView(const OptionAdder& add, TypedHours& typed) {
    StudyView& view = typed.wish.view;
    add("--view", view.name, "NAME", scriptWord("the name of --view"),
        "plan (straight from above, with a north arrow), Top, Front, Right, Perspective or a "
        "camera of the model, in place of the next options");
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
    add("--size", typed.size, "WxH", sizeOfPicture(),
        "Size of the picture in pixels, without its title and legend", "1280x720");
}

void addResults(const OptionAdder& add, SunHoursRequest& hours) {
    add("--isolines", hours.isoline_hours, "HOURS", numberFrom(0.1, 24, "hours"),
        "Draw lines of equal hours, so many hours apart");
    add("--threshold", hours.threshold_hours, "HOURS", numberFrom(0, 24, "hours"),
        "Of the share of each object's area that the table tells", "2");
    add("--grid", hours.grid_size, "SIZE", numberFrom(1e-9, 1e9),
        "Also write all surfaces in triangles with edges of at most this size, in the model's "
        "units");
}

} // namespace

Action addSunHours(CLI::App& command) {
    const auto typed = std::make_shared<TypedHours>();
    SunHoursWish& wish = typed->wish;
    const OptionAdder add(command);
    add("MODEL", wish.model, "", scriptWord("the model's path"), "The model file or document")
        ->required();
    add("--out", wish.hours.folder, "DIR", scriptWord("the path of --out"),
        "Folder for picture, page, numbers and table")
        ->required();
    add("--up", wish.up_axis, "AXIS", oneOf({"y", "z"}),
        "Axis that points up in the file, y or z (default: y for glTF and such, z for OBJ, PLY, "
        "STL)");
    addSite(add, *typed);
    addTimes(add, *typed);
    addView(add, *typed);
    addResults(add, wish.hours);
    addCommonOptions(command, wish.common);
    return [typed] { return tellHours(*typed); };
}

} // namespace quarn::program
