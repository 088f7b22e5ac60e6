// The commands that tell and draw where the sun stands.
#include "host/session/StatedSite.h"
#include "quarn/arguments/Readings.h"
#include "quarn/arguments/RecordingArguments.h"
#include "quarn/arguments/SiteArguments.h"
#include "quarn/arguments/Subcommands.h"
#include "quarn/reports/SunReport.h"
#include "quarn/runs/SunPathRun.h"

namespace quarn::program {

namespace {

using std::chrono::days;
using std::chrono::local_days;
using std::chrono::local_seconds;
using std::chrono::minutes;
using std::chrono::seconds;
using std::chrono::sys_seconds;

constexpr int FIRST_YEAR = 1800; // as the host's sun takes them
constexpr int LAST_YEAR = 2199;
constexpr int MINUTES_OF_DAY = 1440;

/// A moment by the clock on the wall; one without a date is of the day that is asked for.
struct TypedMoment {
    std::optional<COleDateTime> date;
    ClockTime time{};
};

Reading<TypedMoment> moment() {
    return [](const std::string& option,
              const std::string& word) -> std::variant<TypedMoment, Refusal> {
        const std::size_t gap = word.find_first_of(" T");
        TypedMoment typed;
        if (gap != std::string::npos) {
            auto date = dateUntil(LAST_YEAR)(option, word.substr(0, gap));
            if (const Refusal* const refusal = std::get_if<Refusal>(&date))
                return *refusal;
            typed.date = std::get<COleDateTime>(date);
        }
        const auto time = clockTime(gap == std::string::npos ? word : word.substr(gap + 1));
        if (!time)
            return mustBe(option, "a time such as 14:30, or \"2026-06-21 14:30\"", word);
        typed.time = *time;
        return typed;
    };
}

struct TypedSun {
    TypedSite site;
    std::optional<COleDateTime> date;
    std::optional<TypedMoment> time;
    std::optional<TypedMoment> to;
    int step = 60;
    std::string form;
};

local_days daysOf(const COleDateTime& date) {
    return local_days(std::chrono::year(date.GetYear()) /
                      std::chrono::month(static_cast<unsigned>(date.GetMonth())) /
                      std::chrono::day(static_cast<unsigned>(date.GetDay())));
}

/// "02:30"
std::string timeText(seconds time_of_day) {
    const auto digits = [](std::int64_t number) {
        return (number < 10 ? "0" : "") + std::to_string(number);
    };
    const auto whole = std::chrono::floor<minutes>(time_of_day).count();
    return digits(whole / 60) + ":" + digits(whole % 60);
}

/// Finds the instant at which the clocks show a time.
/// @param instant  is given it
/// @return what is wrong with the time, or nothing
std::optional<std::string> settleInstant(const std::string& option, local_seconds wanted,
                                         const Zone& zone, std::vector<std::string>& notes,
                                         sys_seconds& instant) {
    const WallReading reading = zone.read(wanted);
    const seconds time_of_day = wanted - std::chrono::floor<days>(wanted);
    instant = reading.first;
    if (reading.kind == WallReading::Kind::skipped) {
        const local_seconds after = zone.at(reading.first).local;
        return option + ": the clocks of " + zone.name() + " never show " + timeText(time_of_day) +
               " on that day; they go forward to " +
               timeText(after - std::chrono::floor<days>(after)) + ".";
    }
    if (reading.kind == WallReading::Kind::twice)
        notes.push_back(option + ": " + timeText(time_of_day) + " comes twice on that day; " +
                        zone.at(reading.first).abbreviation + " is taken. --zone " +
                        "with the distance from UTC takes the other one.");
    return std::nullopt;
}

/// The moments of a span, or of a whole day where no time is typed.
std::optional<std::string> settleSpan(const TypedSun& typed, SunRequest& request) {
    const Zone& zone = request.site.zone;
    const auto now = std::chrono::floor<seconds>(std::chrono::system_clock::now());
    if (typed.to && !typed.time)
        return "--to goes with --time.";
    if (typed.date && typed.time && typed.time->date)
        return "give the date with --date or with --time, not twice.";
    if (!typed.date && !typed.time) {
        request.from = request.to = std::chrono::floor<minutes>(now);
        return std::nullopt;
    }
    const local_days today = std::chrono::floor<days>(zone.at(now).local);
    const local_days date = typed.time && typed.time->date ? daysOf(*typed.time->date)
                            : typed.date                   ? daysOf(*typed.date)
                                                           : today;
    if (!typed.time) {
        request.from = zone.read(date).first;
        request.to = zone.read(date + days(1)).first - seconds(1);
        return std::nullopt;
    }
    const auto on = [](local_days day, const ClockTime& time) {
        return local_seconds(day) + std::chrono::hours(time.hour) + minutes(time.minute);
    };
    if (auto mistake =
            settleInstant("--time", on(date, typed.time->time), zone, request.notes, request.from))
        return mistake;
    request.to = request.from;
    if (!typed.to)
        return std::nullopt;
    const local_days last = typed.to->date ? daysOf(*typed.to->date) : date;
    return settleInstant("--to", on(last, typed.to->time), zone, request.notes, request.to);
}

std::optional<std::string> settleSun(const TypedSun& typed, SunRequest& request) {
    constexpr std::int64_t MOST_POSITIONS = 600000;
    if (auto mistake = settleSite(typed.site, request.site))
        return mistake;
    if (auto mistake = settleSpan(typed, request))
        return mistake;
    if (request.to < request.from)
        return "--to is before --time.";
    request.step = minutes(typed.step);
    request.form = typed.form == "json"  ? SunRequest::Form::json
                   : typed.form == "csv" ? SunRequest::Form::csv
                                         : SunRequest::Form::text;
    if ((request.to - request.from) / request.step >= MOST_POSITIONS)
        return "these are more than " + std::to_string(MOST_POSITIONS) +
               " positions: give a larger --every.";
    return std::nullopt;
}

Outcome tellSun(const TypedSun& typed) {
    SunRequest request;
    if (const auto mistake = settleSun(typed, request))
        return Outcome::misuse(*mistake);
    return reportSun(request);
}

struct TypedSunPath {
    SunPathOrder order;
    TypedSite site;
    std::optional<int> year;
    std::string projection;
    std::optional<Triple> point;
    std::string object;
};

/// The place that is typed; else the one that the model's file states, with its north.
std::optional<std::string> settlePlace(const TypedSunPath& typed, SunPathOrder& order) {
    CivilSite site;
    const auto stated =
        isTyped(typed.site) || order.model.empty() ? std::nullopt : statedSite(order.model);
    if (stated) {
        site.place = order.model.filename().native();
        site.latitude_deg = stated->latitude_deg;
        site.longitude_deg = stated->longitude_deg;
        if (!order.diagram.north_deg)
            order.diagram.north_deg = stated->north_angle_deg;
    }
    if (auto mistake = stated ? settleZone(typed.site.zone, site) : settleSite(typed.site, site))
        return mistake;
    order.diagram.place = site.place;
    order.diagram.site = {site.latitude_deg, site.longitude_deg};
    order.diagram.zone = site.zone;
    order.zone_origin = site.zone_origin;
    return std::nullopt;
}

std::optional<std::string> settlePoint(const TypedSunPath& typed, SunPathOrder& order) {
    const bool has_place = typed.point || !typed.object.empty();
    if (order.model.empty() && has_place)
        return "--point and --object are for a model: give its file too.";
    if (!order.model.empty() && !has_place)
        return "say from where the model is to be seen, with --point X,Y,Z or --object NAME.";
    if (typed.point && !typed.object.empty())
        return "give either --point or --object.";
    if (typed.point)
        order.diagram.point = KM_3dPoint((*typed.point)[0], (*typed.point)[1], (*typed.point)[2]);
    else if (has_place)
        order.diagram.point = typed.object;
    order.diagram.model = order.model.filename().native();
    return std::nullopt;
}

std::optional<std::string> settleSunPath(const TypedSunPath& typed, SunPathOrder& order) {
    if (auto mistake = settlePoint(typed, order))
        return mistake;
    if (auto mistake = settlePlace(typed, order))
        return mistake;
    const auto now = std::chrono::floor<seconds>(std::chrono::system_clock::now());
    const std::chrono::year_month_day today(
        std::chrono::floor<days>(order.diagram.zone.at(now).local));
    order.diagram.year = typed.year.value_or(static_cast<int>(today.year()));
    order.diagram.is_stereographic = typed.projection != "orthographic";
    order.diagram.is_orthographic = typed.projection != "stereographic";
    return std::nullopt;
}

} // namespace

Action addSun(CLI::App& command) {
    const auto typed = std::make_shared<TypedSun>();
    const OptionAdder add(command);
    addSite(add, typed->site);
    add("--date", typed->date, "DATE", dateUntil(LAST_YEAR),
        "The whole of a day, such as 2026-06-21");
    add("--time", typed->time, "TIME", moment(),
        "Or a time by the clock on the wall: 14:30, or \"2026-06-21 14:30\"");
    add("--to", typed->to, "TIME", moment(), "and the time that no position is later than");
    add("--every", typed->step, "MINUTES", wholeNumberFrom(1, MINUTES_OF_DAY, "minutes"),
        "Minutes between positions, 1 to 1440", "60");
    add("--format", typed->form, "NAME", oneOf({"text", "csv", "json"}), "text, csv or json",
        "text");
    return [typed] { return tellSun(*typed); };
}

Action addSunPath(CLI::App& command) {
    const auto typed = std::make_shared<TypedSunPath>();
    SunPathOrder& order = typed->order;
    const OptionAdder add(command);
    add("MODEL", order.model, "", scriptWord("the model's path"),
        "A model file or document, to see what it hides of the sky");
    addSite(add, typed->site);
    add("--year", typed->year, "YEAR", wholeNumberFrom(FIRST_YEAR, LAST_YEAR, "a year"),
        "1800 to 2199 (default: this year)");
    add("--projection", typed->projection, "NAME", oneOf({"stereographic", "orthographic", "both"}),
        "stereographic, orthographic or both", "stereographic");
    add("--north", order.diagram.north_deg, "DEG", numberFrom(-360, 360, "degrees"),
        "Where north is in the model, in degrees clockwise from its Y axis (default: 0)");
    add("--point", typed->point, "X,Y,Z", point(), "Point of the model to look at the sky from");
    add("--object", typed->object, "NAME", scriptWord("the name of --object"),
        "Or: the object to look from, by its name or id");
    add("--out", order.diagram.file, "FILE", scriptWord("the path of --out"),
        "The drawing: .svg or .png")
        ->required();
    command.add_flag("--overwrite", order.common.overwrites, "Replace a file that is there");
    addCommonOptions(command, order.common);
    return [typed] {
        SunPathOrder settled = typed->order;
        if (const auto mistake = settleSunPath(*typed, settled))
            return Outcome::misuse(*mistake);
        return drawSunPath(settled);
    };
}

} // namespace quarn::program
