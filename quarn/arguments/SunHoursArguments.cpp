// The command that tells how much sun each place gets.
#include "host/clock/WallText.h"
#include "quarn/arguments/Readings.h"
#include "quarn/arguments/RecordingArguments.h"
#include "quarn/arguments/SiteArguments.h"
#include "quarn/arguments/StudyViewArguments.h"
#include "quarn/arguments/Subcommands.h"
#include "quarn/runs/SunHoursRun.h"
#include "quarn/words/AnimationName.h"

namespace quarn::program {

namespace {

constexpr int DAYS_OF_YEAR = 366;
constexpr const char* PLAN = "plan";

/// What is typed; what it means together is found out when all words are read.
struct TypedHours {
    SunHoursWish wish{};
    TypedSite site;
    WantedDay day;
    std::optional<WantedDay> last_day;
    PixelSize size{};
};

std::optional<std::string> settlePlace(TypedHours& typed) {
    auto settled = settleSite(typed.site, typed.wish.model);
    if (!settled)
        return settled.message();
    typed.wish.hours.site = std::move(settled.value().site);
    if (const std::string& note = settled.value().zone_note; !note.empty())
        typed.wish.notes.push_back(note);
    return std::nullopt;
}

/// Looks at the times of the first day, before a model is read; those of the days behind it that
/// are not there count as SunMoments has it.
std::optional<std::string> settleTimes(TypedHours& typed) {
    const SunHoursRequest& hours = typed.wish.hours;
    std::optional<std::chrono::sys_seconds> ends[2];
    for (const bool is_end : {false, true}) {
        const auto& wanted = is_end ? hours.to : hours.from;
        const FoundMoment found =
            findTime(hours.site, hours.first_day, wanted.value_or(WantedTime()),
                     is_end ? "--to" : "--from", is_end);
        if (!found.mistake.empty() && (wanted || found.kind == FoundMoment::Kind::no_day))
            return found.mistake;
        if (!wanted)
            continue;
        if (!found.note.empty())
            typed.wish.notes.push_back(found.note);
        ends[is_end] = found.time;
    }
    if (ends[1] &&
        *ends[1] <=
            ends[0].value_or(hours.site.zone.read(std::chrono::local_days(hours.first_day)).first))
        return "--to is not after --from: no time is between them.";
    return std::nullopt;
}

std::optional<std::string> settleDays(TypedHours& typed) {
    SunHoursRequest& hours = typed.wish.hours;
    hours.first_day = dayOf(typed.day, hours.site.zone);
    hours.last_day = typed.last_day ? dayOf(*typed.last_day, hours.site.zone) : hours.first_day;
    if (hours.last_day < hours.first_day)
        return "--to-date " + dateText(hours.last_day) + " is before --date " +
               dateText(hours.first_day) + ".";
    return settleTimes(typed);
}

std::optional<std::string> settleView(TypedHours& typed) {
    SunHoursRequest& hours = typed.wish.hours;
    StudyView& view = typed.wish.view;
    hours.width_px = typed.size.width_px;
    hours.height_px = typed.size.height_px;
    hours.is_plan = view.name && lowerCase(*view.name) == PLAN;
    if (auto mistake = whyViewIsRefused(view, view.isParallel() || hours.is_plan))
        return mistake;
    if (hours.is_plan && view.distance_factor)
        return "--distance does not go with --view plan, which fits the model.";
    if (!typed.wish.up_axis.empty() && isDocument(typed.wish.model))
        return "--up is for model files; a document knows its axes.";
    return std::nullopt;
}

Outcome tellHours(TypedHours& typed) {
    for (const auto settle : {settlePlace, settleDays, settleView})
        if (const auto mistake = settle(typed))
            return Outcome::misuse(*mistake);
    SunHoursRequest& hours = typed.wish.hours;
    hours.name = animationNameFor(typed.wish.model);
    hours.title = hours.name;
    return writeSunHours(typed.wish);
}

void addTimes(const OptionAdder& add, TypedHours& typed) {
    SunHoursRequest& hours = typed.wish.hours;
    add("--date", typed.day, "DATE", dayOfTheSun(), DAY_HELP);
    add("--to-date", typed.last_day, "DATE", dayOfTheSun(),
        "The last of several days: hours are the mean of a day then");
    add("--every-days", hours.every_days, "N", wholeNumberFrom(1, DAYS_OF_YEAR, "days"),
        "Days between those that are looked at, 1 to 366", "1");
    add("--from", hours.from, "TIME", timeOfTheSun(),
        "Time that hours count from, by the clock of the place, such as 09:00, or each day's own "
        "sunrise+1h (default: midnight)");
    add("--to", hours.to, "TIME", timeOfTheSun(),
        "Time that they count to, such as 15:00 or sunset-1h (default: midnight)");
    add("--every", hours.every_minutes, "MINUTES", minutesOfADay(),
        "Minutes between the places of the sun, 1 to 1440", "10");
}

void addView(const OptionAdder& add, TypedHours& typed) {
    addStudyView(
        add, typed.wish.view,
        "plan (straight from above, with a north arrow), Top, Front, Right, Perspective or "
        "a camera of the model");
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
    addSiteOfModel(add, typed->site);
    addTimes(add, *typed);
    addView(add, *typed);
    addResults(add, wish.hours);
    command.add_flag("--overwrite", wish.common.overwrites, "Replace files that are there");
    addCommonOptions(command, wish.common);
    return [typed] { return tellHours(*typed); };
}

} // namespace quarn::program
