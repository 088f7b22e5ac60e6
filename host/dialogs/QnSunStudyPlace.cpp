#include "sdk/zel/QnSunStudyPlace.h"

#include "host/almanac/DayTimes.h"
#include "host/almanac/WantedDay.h"
#include "host/app/Application.h"
#include "host/cities/LocationChoice.h"
#include "host/clock/WallText.h"
#include "host/document/Document.h"
#include "host/sun/Seasons.h"
#include "host/sun/SunYears.h"
#include "sdk/qncore/QnLocalize.h"
#include "sdk/zel/QnZone.h"

#include <algorithm>
#include <cmath>

namespace {

using namespace std::chrono;
using quarn::Zone;

quarn::Document* activeDocument() {
    quarn::Application* const application = quarn::Application::current();
    return application ? application->documents().active() : nullptr;
}

/// -180 to 180.
double nearLongitude(double longitude_deg) {
    return std::abs(longitude_deg) <= 180.0 ? longitude_deg : std::remainder(longitude_deg, 360.0);
}

bool isOnEarth(const QnSunStudyPlace& place) {
    return std::abs(place.latitude) <= 90.0 && std::abs(place.longitude) <= 360.0;
}

std::optional<Zone> clocksOf(const QnSunStudyPlace& place) {
    if (!isOnEarth(place))
        return std::nullopt;
    const double longitude_deg = nearLongitude(place.longitude);
    const std::string written = place.clocks.ToUtf8();
    const auto zone = Zone::written(
        written.empty() ? std::string(quarn::nearestCity(place.latitude, longitude_deg).zone)
                        : written,
        longitude_deg);
    return zone ? std::optional(zone.value()) : std::nullopt;
}

/// What the clock of the study is ahead of universal time.
hours aheadOf(const QnSunStudyPlace& place) {
    return hours(QnZoneOfLongitude(place.longitude));
}

local_seconds onStudyClock(const QnSunStudyPlace& place, sys_seconds moment) {
    return local_seconds(moment.time_since_epoch() + aheadOf(place));
}

sys_seconds momentOf(const QnSunStudyPlace& place, local_seconds shown) {
    return sys_seconds(shown.time_since_epoch() - aheadOf(place));
}

local_seconds startOf(const KM_3dmAnimationProperties& record) {
    const year_month_day date = year(record.StartYear()) / record.StartMonth() / record.StartDay();
    return local_days(date) + hours(record.StartHour()) + minutes(record.StartMinutes());
}

local_seconds endOf(const KM_3dmAnimationProperties& record, bool is_one_day) {
    if (is_one_day)
        return floor<days>(startOf(record)) + hours(record.EndHour()) +
               minutes(record.EndMinutes());
    const year_month_day date = year(record.EndYear()) / record.EndMonth() / record.EndDay();
    return local_days(date) + (startOf(record) - floor<days>(startOf(record)));
}

void setStart(local_seconds start, KM_3dmAnimationProperties& record) {
    const auto day = floor<days>(start);
    const year_month_day date{day};
    const hh_mm_ss time{start - day};
    record.SetStartYear(int(date.year()));
    record.SetStartMonth(static_cast<std::int32_t>(unsigned(date.month())));
    record.SetStartDay(static_cast<std::int32_t>(unsigned(date.day())));
    record.SetStartHour(static_cast<std::int32_t>(time.hours().count()));
    record.SetStartMinutes(static_cast<std::int32_t>(time.minutes().count()));
    record.SetStartSeconds(0);
}

void setEnd(local_seconds end, KM_3dmAnimationProperties& record) {
    const auto day = floor<days>(end);
    const year_month_day date{day};
    const hh_mm_ss time{end - day};
    record.SetEndYear(int(date.year()));
    record.SetEndMonth(static_cast<std::int32_t>(unsigned(date.month())));
    record.SetEndDay(static_cast<std::int32_t>(unsigned(date.day())));
    record.SetEndHour(static_cast<std::int32_t>(time.hours().count()));
    record.SetEndMinutes(static_cast<std::int32_t>(time.minutes().count()));
    record.SetEndSeconds(0);
}

/// A study of one day has one date of its own clock: of a span over its midnight the longer part.
void setSpan(local_seconds first, local_seconds last, KM_3dmAnimationProperties& record) {
    const local_seconds midnight = floor<days>(last);
    if (first < midnight && midnight - first > last - midnight)
        last = midnight - minutes(1);
    else
        first = std::max(first, midnight);
    setStart(first, record);
    setEnd(last, record);
}

std::string told(const quarn::WallTime& wall, bool has_date) {
    return has_date ? quarn::dateAndTime(wall) : quarn::timeWithZone(wall);
}

KM_wString localTimesOfDay(const Zone& zone, const QnSunStudyPlace& place, local_seconds first,
                           local_seconds last) {
    const quarn::WallTime begin = zone.at(momentOf(place, first));
    const quarn::WallTime end = zone.at(momentOf(place, last));
    const bool is_other_date = floor<days>(begin.local) != floor<days>(first) ||
                               floor<days>(end.local) != floor<days>(last);
    const bool is_one_zone = begin.abbreviation == end.abbreviation && !is_other_date;
    const quarn::WallTime of_study{first, aheadOf(place), {}, false};
    const std::string local = (is_one_zone ? quarn::timeText(begin) : told(begin, is_other_date)) +
                              " - " + told(end, is_other_date);
    const std::string own = quarn::timeText(of_study) + " - " +
                            quarn::timeText(quarn::WallTime{last, aheadOf(place), {}, false}) +
                            " " + quarn::offsetText(of_study);
    return KM_wString::FormatToString(QnLocalizeString(L"%s is %s by the clocks there.", 43430),
                                      KM_wString::FromUtf8(own).Array(),
                                      KM_wString::FromUtf8(local).Array());
}

/// A season keeps its own clock's time; what people call it changes with daylight saving.
KM_wString localTimesOfSeason(const Zone& zone, const QnSunStudyPlace& place, local_seconds first,
                              local_seconds last) {
    const quarn::WallTime begin = zone.at(momentOf(place, first));
    std::string local = quarn::timeWithZone(begin);
    constexpr auto MANY_DAYS = days(400);
    const local_seconds until = std::min(last, first + MANY_DAYS);
    for (local_seconds shown = first; shown <= until; shown += days(1)) {
        const quarn::WallTime wall = zone.at(momentOf(place, shown));
        if (wall.offset == begin.offset)
            continue;
        local += ", " + quarn::timeWithZone(wall);
        break;
    }
    const quarn::WallTime of_study{first, aheadOf(place), {}, false};
    const std::string own = quarn::timeText(of_study) + " " + quarn::offsetText(of_study);
    return KM_wString::FormatToString(QnLocalizeString(L"%s is %s by the clocks there.", 43430),
                                      KM_wString::FromUtf8(own).Array(),
                                      KM_wString::FromUtf8(local).Array());
}

QnSunStudyDay namedDay(const wchar_t* name, year_month_day date) {
    return {name, int(date.year()), static_cast<int>(unsigned(date.month())),
            static_cast<int>(unsigned(date.day()))};
}

} // namespace

QnSunStudyPlace QnPlaceOfSunStudy(const KM_3dmAnimationProperties& record) {
    QnSunStudyPlace place{record.Latitude(), record.Longitude(), {}};
    const quarn::Document* const document = activeDocument();
    if (!document)
        return place;
    const std::optional<quarn::StudiedPlace> kept = document->studiedPlace();
    if (kept && kept->isAt(place.latitude, place.longitude))
        place.clocks = kept->zone;
    return place;
}

void QnKeepPlaceOfSunStudy(const QnSunStudyPlace& place) {
    quarn::Document* const document = activeDocument();
    const auto zone = clocksOf(place);
    if (document && zone)
        document->setStudiedPlace({QnCityOfSunStudy(place), KM_wString::FromUtf8(zone->name()),
                                   place.latitude, place.longitude});
}

KM_wString QnCityOfSunStudy(const QnSunStudyPlace& place) {
    if (!isOnEarth(place))
        return {};
    const quarn::LocationChoice choice({place.latitude, nearLongitude(place.longitude)});
    return choice.cityHere() ? KM_wString::FromUtf8(quarn::nameWithCountry(*choice.cityHere()))
                             : KM_wString();
}

KM_wString QnClocksOfSunStudy(const QnSunStudyPlace& place) {
    const auto zone = clocksOf(place);
    return zone ? KM_wString::FromUtf8(zone->name()) : KM_wString();
}

KM_ClassArray<QnSunStudyDay> QnDaysOfSunStudy(const QnSunStudyPlace& place, int year) {
    const Zone zone = clocksOf(place).value_or(Zone::fixed({}));
    KM_ClassArray<QnSunStudyDay> named;
    named.Append(namedDay(QnLocalizeString(L"Today", 43431), quarn::today(zone)));
    if (!quarn::isSunYear(year))
        return named;
    const quarn::Seasons seasons = quarn::seasonsOf(year);
    const bool is_north = place.latitude >= 0.0;
    const auto add = [&](const wchar_t* name, sys_seconds moment) {
        named.Append(namedDay(name, quarn::dateAt(zone, moment)));
    };
    add(QnLocalizeString(L"Equinox in March", 43432), seasons.march_equinox);
    add(QnLocalizeString(L"Longest day", 43433),
        is_north ? seasons.june_solstice : seasons.december_solstice);
    add(QnLocalizeString(L"Equinox in September", 43434), seasons.september_equinox);
    add(QnLocalizeString(L"Shortest day", 43435),
        is_north ? seasons.december_solstice : seasons.june_solstice);
    return named;
}

void QnOfferSunTimes(const QnSunStudyPlace& place, KM_3dmAnimationProperties& record) {
    const auto zone = clocksOf(place);
    const year_month_day date = year(record.StartYear()) / record.StartMonth() / record.StartDay();
    if (!zone || !date.ok() || !quarn::isSunYear(record.StartYear()))
        return;
    const int step = std::clamp(std::abs(record.MinutesBetweenFrames()), 1, 1440);
    const quarn::Daylight light = quarn::daylightOf(
        {{}, place.latitude, nearLongitude(place.longitude), 0.0, *zone}, date, minutes(step));
    const bool has_light = light.mistake.empty();
    const local_days midnight(date);
    const sys_seconds first = has_light ? light.first : zone->read(midnight + hours(9)).first;
    const sys_seconds last = has_light ? light.last : zone->read(midnight + hours(15)).first;
    setSpan(onStudyClock(place, first), onStudyClock(place, last), record);
}

void QnOfferSunYear(const QnSunStudyPlace& place, KM_3dmAnimationProperties& record) {
    const auto zone = clocksOf(place);
    if (!zone)
        return;
    const year present = quarn::today(*zone).year();
    const seconds standard = zone->standardOffset(int(present));
    const auto noonOf = [&](year_month_day date) {
        return onStudyClock(
            place, sys_seconds((local_days(date) + hours(12)).time_since_epoch() - standard));
    };
    setStart(noonOf(present / January / 1), record);
    setEnd(noonOf(present / December / 31), record);
}

KM_wString QnLocalTimesOfSunStudy(const QnSunStudyPlace& place,
                                  const KM_3dmAnimationProperties& record, bool is_one_day) {
    const auto zone = clocksOf(place);
    const year_month_day date = year(record.StartYear()) / record.StartMonth() / record.StartDay();
    if (!zone || !date.ok())
        return {};
    const local_seconds first = startOf(record);
    const local_seconds last = endOf(record, is_one_day);
    if (last < first)
        return {};
    return is_one_day ? localTimesOfDay(*zone, place, first, last)
                      : localTimesOfSeason(*zone, place, first, last);
}
