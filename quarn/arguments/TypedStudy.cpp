#include "quarn/arguments/TypedStudy.h"

#include "host/clock/WallText.h"
#include "host/session/StatedSite.h"
#include "quarn/scripts/StudyClock.h"

#include <cstdint>

namespace quarn::program {

namespace {

constexpr int MINUTES_OF_DAY = 1440;

/// Takes the place that the model's file states.
std::optional<std::string> settleByModel(const std::filesystem::path& model, StudySite& site) {
    const std::optional<StatedSite> stated = statedSite(model);
    if (!stated)
        return "say where the model stands with --place, or with --latitude and --longitude; "
               "quarn places lists the places.";
    site = {"As " + model.filename().native() + " states", stated->latitude_deg,
            stated->longitude_deg, stated->north_angle_deg, site.zone};
    return std::nullopt;
}

/// The clocks of the place, or those that were asked for.
std::optional<std::string> settleZone(const TypedStudy& typed, SunStudyRequest& request) {
    StudySite& site = request.site;
    const City& near =
        typed.city ? *typed.city : nearestCity(site.latitude_deg, site.longitude_deg);
    const bool is_asked_for = !typed.zone.empty();
    const auto zone =
        is_asked_for ? Zone::written(typed.zone, site.longitude_deg) : Zone::named(near.zone);
    if (!zone)
        return (is_asked_for ? "--zone: " : "") + zone.message();
    site.zone = zone.value();
    if (!is_asked_for && !typed.city)
        request.notes.push_back("The clock is that of " + nameWithCountry(near) +
                                ", the nearest city known; --zone takes another");
    return std::nullopt;
}

/// An end of a day: where it was not asked for, the first or last light.
std::optional<std::string> settleEnd(SunStudyRequest& request, std::chrono::year_month_day day,
                                     const std::optional<WantedTime>& wanted, bool is_end) {
    FoundMoment found;
    if (wanted) {
        found = findTime(request.site, day, *wanted, is_end ? "--to" : "--from", is_end);
    } else {
        const Daylight light = daylightOf(request.site, day, std::chrono::minutes(request.step));
        found = {is_end ? light.last : light.first, light.mistake, is_end ? "" : light.note};
    }
    if (!found.mistake.empty())
        return found.mistake;
    if (!found.note.empty())
        request.notes.push_back(found.note);
    (is_end ? request.end : request.start) = found.time;
    return std::nullopt;
}

std::optional<std::string> settleDay(const TypedStudy& typed, SunStudyRequest& request) {
    const std::chrono::year_month_day day = dayOf(typed.day, request.site.zone);
    if (auto mistake = settleEnd(request, day, typed.first_time, false))
        return mistake;
    if (auto mistake = settleEnd(request, day, typed.last_time, true))
        return mistake;
    if (request.end < request.start)
        return "--to " + timeWithZone(request.site.zone.at(request.end)) + " is before --from " +
               timeWithZone(request.site.zone.at(request.start)) + ".";
    return std::nullopt;
}

std::string textOf(std::chrono::year_month_day day) {
    return dateText(WallTime{std::chrono::local_days(day), {}, {}, false});
}

/// The same date of another year; the day before it where that has no 29 February.
std::chrono::year_month_day yearsLater(std::chrono::year_month_day day, int years) {
    const auto later = day + std::chrono::years(years);
    return later.ok() ? later : later.year() / later.month() / std::chrono::last;
}

/// Without dates it is this year; with one of them the year that begins or ends with it.
std::optional<std::string> settleSeason(const TypedStudy& typed, SunStudyRequest& request) {
    using namespace std::chrono;
    const Zone& zone = request.site.zone;
    year_month_day first;
    year_month_day last;
    if (typed.first_date || typed.last_date) {
        const year_month_day known = typed.first_date ? *typed.first_date : *typed.last_date;
        first = typed.first_date.value_or(sys_days(yearsLater(known, -1)) + days(1));
        last = typed.last_date.value_or(sys_days(yearsLater(known, 1)) - days(1));
    } else {
        const year this_year = dayOf({}, zone).year();
        first = this_year / January / 1;
        last = this_year / December / 31;
    }
    if (last < first)
        return "--to " + textOf(last) + " is before --from " + textOf(first) + ".";
    const seconds standard = zone.standardOffset(int(first.year()));
    const auto momentOf = [&](year_month_day day) {
        return ceil<minutes>(sys_days(day) + typed.noon.later - standard - 30s);
    };
    request.start = momentOf(first);
    request.end = momentOf(last);
    return std::nullopt;
}

/// The clock of the set-up commands may be a day before or behind at the ends of their years.
std::optional<std::string> checkYears(const SunStudyRequest& request) {
    const bool is_one_day = request.kind == SunStudyRequest::Kind::one_day;
    const int last_year = is_one_day ? LAST_YEAR_OF_DAY : LAST_YEAR_OF_SEASON;
    for (const StudySpan& span : studySpans(request))
        for (const std::chrono::local_seconds end : {span.first, span.last}) {
            const std::chrono::year_month_day day{std::chrono::floor<std::chrono::days>(end)};
            if (int(day.year()) < FIRST_YEAR_OF_STUDY || int(day.year()) > last_year)
                return "the study reaches beyond the years " + std::to_string(FIRST_YEAR_OF_STUDY) +
                       " to " + std::to_string(last_year) +
                       " by the sun's own clock; leave out its first or last day.";
        }
    return std::nullopt;
}

/// A span is counted in frames; both of its ends have one where the steps meet them.
void countFrames(SunStudyRequest& request) {
    const bool is_one_day = request.kind == SunStudyRequest::Kind::one_day;
    const std::chrono::seconds step =
        std::chrono::minutes(std::int64_t{request.step} * (is_one_day ? 1 : MINUTES_OF_DAY));
    request.recording.frames = static_cast<int>((request.end - request.start) / step) + 1;
}

} // namespace

std::optional<std::string> settleSite(TypedStudy& typed) {
    StudySite& site = typed.request.site;
    const bool has_coordinate = typed.latitude_deg || typed.longitude_deg;
    if (typed.city && has_coordinate)
        return "give either --place, or --latitude and --longitude.";
    if (!typed.city && has_coordinate && !(typed.latitude_deg && typed.longitude_deg))
        return "--latitude and --longitude go together.";
    std::optional<std::string> mistake;
    if (typed.city)
        site = {nameWithCountry(*typed.city), typed.city->latitude_deg, typed.city->longitude_deg,
                0.0, site.zone};
    else if (has_coordinate)
        site = {"", *typed.latitude_deg, *typed.longitude_deg, 0.0, site.zone};
    else
        mistake = settleByModel(typed.request.recording.model, site);
    site.north_deg = typed.north_deg.value_or(site.north_deg);
    return mistake;
}

std::optional<std::string> settleTimes(TypedStudy& typed) {
    SunStudyRequest& request = typed.request;
    if (auto mistake = settleZone(typed, request))
        return mistake;
    const bool is_one_day = request.kind == SunStudyRequest::Kind::one_day;
    if (auto mistake = is_one_day ? settleDay(typed, request) : settleSeason(typed, request))
        return mistake;
    countFrames(request);
    return checkYears(request);
}

} // namespace quarn::program
