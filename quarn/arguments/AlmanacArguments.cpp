// The commands that tell and draw where the sun stands.
#include "host/sun/SunYears.h"
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
using std::chrono::minutes;
using std::chrono::seconds;
using std::chrono::year_month_day;

/// A time of a day; one without a day is of the day that is asked for.
struct TypedMoment {
    std::optional<WantedDay> day;
    WantedTime time;
};

Reading<TypedMoment> moment() {
    return [](const std::string& option,
              const std::string& word) -> std::variant<TypedMoment, Refusal> {
        const std::size_t gap = word.find_first_of(" T");
        TypedMoment typed;
        if (gap != std::string::npos) {
            auto day = dayOfTheSun()(option, word.substr(0, gap));
            if (Refusal* const refusal = std::get_if<Refusal>(&day))
                return std::move(*refusal);
            typed.day = std::get<WantedDay>(day);
        }
        const auto time = wantedTime(gap == std::string::npos ? word : word.substr(gap + 1));
        if (!time)
            return mustBe(option, "a time such as 14:30, sunrise+1h, or \"2026-06-21 14:30\"",
                          word);
        typed.time = *time;
        return typed;
    };
}

struct TypedSun {
    TypedSite site;
    std::optional<WantedDay> day;
    std::optional<TypedMoment> time;
    std::optional<TypedMoment> to;
    int step = 60;
    std::string form;
};

/// Finds an end of the span.
/// @return what is wrong with the time, or nothing
std::optional<std::string> settleEnd(const TypedMoment& typed, year_month_day day, bool is_end,
                                     SunRequest& request) {
    const FoundMoment found =
        findTime(request.site, day, typed.time, is_end ? "--to" : "--time", is_end);
    if (!found.mistake.empty())
        return found.mistake;
    if (!found.note.empty())
        request.notes.push_back(found.note);
    (is_end ? request.to : request.from) = found.time;
    return std::nullopt;
}

/// The moments of a span, or of a whole day where no time is typed.
std::optional<std::string> settleSpan(const TypedSun& typed, SunRequest& request) {
    const Zone& zone = request.site.zone;
    if (typed.to && !typed.time)
        return "--to goes with --time.";
    if (typed.day && typed.time && typed.time->day)
        return "give the date with --date or with --time, not twice.";
    if (!typed.day && !typed.time) {
        request.from = request.to = std::chrono::floor<minutes>(std::chrono::system_clock::now());
        return std::nullopt;
    }
    const WantedDay wanted = typed.day ? *typed.day : typed.time->day.value_or(WantedDay());
    const year_month_day day = dayOf(wanted, zone);
    if (!typed.time) {
        request.from = zone.read(local_days(day)).first;
        request.to = zone.read(local_days(day) + days(1)).first - seconds(1);
        return std::nullopt;
    }
    if (auto mistake = settleEnd(*typed.time, day, false, request))
        return mistake;
    request.to = request.from;
    if (!typed.to)
        return std::nullopt;
    return settleEnd(*typed.to, typed.to->day ? dayOf(*typed.to->day, zone) : day, true, request);
}

std::optional<std::string> settleSun(const TypedSun& typed, SunRequest& request) {
    constexpr std::int64_t MOST_POSITIONS = 600000;
    const auto settled = settleSite(typed.site, {});
    if (!settled)
        return settled.message();
    request.site = settled.value().site;
    if (const std::string& note = settled.value().zone_note; !note.empty())
        request.notes.push_back(note);
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

std::optional<std::string> settlePlace(const TypedSunPath& typed, SunPathOrder& order) {
    const auto settled = settleSite(typed.site, order.model);
    if (!settled)
        return settled.message();
    const CivilSite& site = settled.value().site;
    order.diagram.place = settled.value().is_stated ? order.model.filename().native() : site.place;
    order.diagram.site = {site.latitude_deg, site.longitude_deg};
    order.diagram.zone = site.zone;
    if (settled.value().has_north)
        order.diagram.north_deg = site.north_deg;
    order.zone_note = settled.value().zone_note;
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
    order.diagram.year = typed.year.value_or(int(today(order.diagram.zone).year()));
    order.diagram.is_stereographic = typed.projection != "orthographic";
    order.diagram.is_orthographic = typed.projection != "stereographic";
    return std::nullopt;
}

} // namespace

Action addSun(CLI::App& command) {
    const auto typed = std::make_shared<TypedSun>();
    const OptionAdder add(command);
    addSite(add, typed->site);
    add("--date", typed->day, "DATE", dayOfTheSun(),
        std::string("The whole of a day. ") + DAY_HELP);
    add("--time", typed->time, "TIME", moment(),
        "Or a time by the clock on the wall: 14:30, sunrise+1h, or \"2026-06-21 14:30\" (default: "
        "now)");
    add("--to", typed->to, "TIME", moment(), "and the time that no position is later than");
    add("--every", typed->step, "MINUTES", minutesOfADay(), "Minutes between positions, 1 to 1440",
        "60");
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
    addSiteOfModel(add, typed->site);
    add("--year", typed->year, "YEAR", wholeNumberFrom(FIRST_SUN_YEAR, LAST_SUN_YEAR, "a year"),
        "1800 to 2199 (default: this year)");
    add("--projection", typed->projection, "NAME", oneOf({"stereographic", "orthographic", "both"}),
        "stereographic, orthographic or both", "stereographic");
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
