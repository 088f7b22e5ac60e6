#include "host/sun/ClockTime.h"

#include "host/sun/MissingSun.h"
#include "host/sun/SunYears.h"
#include "sdk/zel/QnZelSun.h"

#include <algorithm>
#include <array>
#include <cmath>

namespace quarn {
namespace {

Error errorFor(std::wstring_view text, const char* why) {
    return {"\"" + KM_wString(text).ToUtf8() + "\" " + why};
}

Error noDate(std::wstring_view text) {
    return errorFor(text, "is no date. Write year, month and day, like 2026-06-21.");
}

/// So many decimal digits and nothing else; -1 for another text.
int digits(std::wstring_view text, std::size_t fewest, std::size_t most) {
    if (text.size() < fewest || text.size() > most)
        return -1;
    int number = 0;
    for (const wchar_t letter : text) {
        if (letter < L'0' || letter > L'9')
            return -1;
        number = number * 10 + static_cast<int>(letter - L'0');
    }
    return number;
}

std::wstring_view withoutBlanks(std::wstring_view text) {
    const std::size_t first = text.find_first_not_of(L" \t");
    if (first == std::wstring_view::npos)
        return {};
    return text.substr(first, text.find_last_not_of(L" \t") - first + 1);
}

/// A year, a month and a day, whether or not the calendar has them; -1 where there is no number.
std::array<int, 3> dateNumbers(std::wstring_view text) {
    const std::size_t first = text.find(L'-');
    const std::size_t second =
        first == std::wstring_view::npos ? first : text.find(L'-', first + 1);
    if (second == std::wstring_view::npos)
        return {-1, -1, -1};
    return {digits(text.substr(0, first), 4, 4),
            digits(text.substr(first + 1, second - first - 1), 1, 2),
            digits(text.substr(second + 1), 1, 2)};
}

Result<COleDateTime> readDate(std::wstring_view text) {
    const auto [year, month, day] = dateNumbers(text);
    if (year < 0 || month < 0 || day < 0)
        return noDate(text);
    COleDateTime date;
    if (!date.SetDate(year, month, day))
        return errorFor(text, "is a date that the calendar does not have.");
    if (!isSunYear(year))
        return errorFor(text, "is too far away: the sun is known for the years 1800 to 2199.");
    return date;
}

} // namespace

COleDateTime universalTime(const ClockTime& clock) {
    COleDateTime time = clock.time;
    return time += COleDateTimeSpan(0, 0, -clock.zone_minutes, 0);
}

std::optional<SunPosition> sunPositionAt(const SunSite& site, const ClockTime& clock) {
    if (!clock.time.IsValid())
        return {};
    // The sun takes zones of whole hours. What is left of the zone goes into the time, to the side
    // where the time stays within its day.
    const double hours =
        clock.time.GetHour() + clock.time.GetMinute() / 60.0 + clock.time.GetSecond() / 3600.0;
    const double zone_hours = clock.zone_minutes / 60.0;
    const double below = std::floor(zone_hours);
    const double zone = hours >= zone_hours - below ? below : std::ceil(zone_hours);
    CQnZelSun sun;
    sun.SetLatitude(site.latitude_deg);
    sun.SetLongitude(site.longitude_deg);
    sun.SetTimeZone(static_cast<int>(zone));
    sun.SetLocalDateTime(clock.time.GetYear(), clock.time.GetMonth(), clock.time.GetDay(),
                         hours - (zone_hours - zone));
    const SunPosition position{sun.Azimuth(), sun.Altitude()};
    if (std::isfinite(position.altitude_deg))
        return position;
    (void)takeMissingSun(); // the caller knows what to tell, or only tries
    return std::nullopt;
}

Result<WrittenTime> readDateTime(std::wstring_view text) {
    const std::wstring_view written = withoutBlanks(text);
    const std::size_t gap = written.find_first_of(L" Tt");
    const auto date = readDate(written.substr(0, gap));
    if (!date)
        return date.error();
    if (gap == std::wstring_view::npos)
        return WrittenTime{date.value(), false};
    const auto time = readTimeOfDay(date.value(), written.substr(gap + 1));
    if (!time)
        return time.error();
    return WrittenTime{time.value(), true};
}

Result<COleDateTime> readTimeOfDay(const COleDateTime& date, std::wstring_view text) {
    const std::wstring_view written = withoutBlanks(text);
    const std::size_t first = std::min(written.find(L':'), written.size());
    const std::size_t second = std::min(written.find(L':', first + 1), written.size());
    const int hour = digits(written.substr(0, first), 1, 2);
    const int minute =
        first < written.size() ? digits(written.substr(first + 1, second - first - 1), 2, 2) : -1;
    const int seconds = second < written.size() ? digits(written.substr(second + 1), 2, 2) : 0;
    COleDateTime time;
    if (!time.SetDateTime(date.GetYear(), date.GetMonth(), date.GetDay(), hour, minute, seconds))
        return errorFor(written, "is no time of day. Write hours and minutes from 00:00 to 23:59, "
                                 "like 14:30.");
    return time;
}

} // namespace quarn
