#include "host/clock/Zone.h"

#include "host/clock/ZoneDatabase.h"
#include "host/clock/ZoneOffset.h"
#include "host/clock/ZoneRules.h"

#include <algorithm>
#include <cmath>

namespace quarn {
namespace {

using namespace std::chrono;

constexpr std::string_view SOLAR = "solar";

/// Clocks that nobody puts forward or back.
class SteadyRules final : public ZoneRules {
public:
    SteadyRules(seconds offset, std::string abbreviation) {
        m_period.offset = offset;
        m_period.abbreviation = std::move(abbreviation);
    }

    ClockPeriod periodAt(sys_seconds) const override { return m_period; }

private:
    ClockPeriod m_period;
};

bool isBounded(const ClockPeriod& period) {
    constexpr days CENTURY{36525};
    return period.begin > sys_days(1800y / 1 / 1) - CENTURY &&
           period.end < sys_days(2199y / 12 / 31) + CENTURY;
}

/// Ireland's law has winter time as the exception, and Morocco sets its clocks back in Ramadan: the
/// database calls both daylight saving. A person calls summer time what is ahead of the rest of the
/// year.
bool isSummerTime(const ZoneRules& rules, const ClockPeriod& period) {
    if (!isBounded(period))
        return period.is_daylight_saving;
    const ClockPeriod before = rules.periodAt(period.begin - 1s);
    const ClockPeriod after = rules.periodAt(period.end);
    const auto isExceptionTo = [](const ClockPeriod& one, const ClockPeriod& other) {
        return one.is_daylight_saving && !other.is_daylight_saving && one.offset < other.offset;
    };
    if (period.is_daylight_saving)
        return !isExceptionTo(period, before) && !isExceptionTo(period, after);
    constexpr days LONGEST_SUMMER{300};
    return isExceptionTo(before, period) && isExceptionTo(after, period) &&
           period.end - period.begin < LONGEST_SUMMER;
}

sys_seconds momentOf(local_seconds local, seconds offset) {
    return sys_seconds(local.time_since_epoch() - offset);
}

} // namespace

Zone::Zone(std::string name, std::shared_ptr<const ZoneRules> rules)
    : m_name(std::move(name)), m_rules(std::move(rules)) {}

Result<Zone> Zone::named(std::string_view text) {
    if (const auto offset = writtenOffset(text))
        return fixed(*offset);
    const auto zone = databaseZone(text);
    if (!zone)
        return zone.error();
    return Zone(zone.value().name, zone.value().rules);
}

Result<Zone> Zone::written(std::string_view text, double longitude_deg) {
    if (text == SOLAR)
        return solar(longitude_deg);
    return named(text);
}

Zone Zone::fixed(minutes east) {
    const std::string name = offsetText(east);
    return Zone(name, std::make_shared<SteadyRules>(east, name));
}

Zone Zone::solar(double longitude_deg) {
    constexpr double SECONDS_PER_DEGREE = 240.0;
    const auto offset = static_cast<int>(std::lround(longitude_deg * SECONDS_PER_DEGREE));
    return Zone(std::string(SOLAR), std::make_shared<SteadyRules>(seconds(offset), "LMT"));
}

WallTime Zone::at(sys_seconds utc) const {
    const ClockPeriod period = m_rules->periodAt(utc);
    return {local_seconds(utc.time_since_epoch() + period.offset), period.offset,
            letteredName(period.abbreviation, period.offset), isSummerTime(*m_rules, period)};
}

WallReading Zone::read(local_seconds local) const {
    // No change of the clocks is as long as a day, but for places that crossed the date line: the
    // periods a day and a half before and after are those of any moment that can be meant.
    constexpr hours FAR{36};
    const sys_seconds as_utc(local.time_since_epoch());
    const seconds one = m_rules->periodAt(as_utc - FAR).offset;
    const seconds other = m_rules->periodAt(as_utc + FAR).offset;
    const sys_seconds early = momentOf(local, std::max(one, other));
    const sys_seconds late = momentOf(local, std::min(one, other));
    const bool is_early = at(early).local == local;
    const bool is_late = at(late).local == local;
    if (is_early && is_late && early != late)
        return {WallReading::Kind::twice, early, late};
    if (is_early || is_late) {
        const sys_seconds moment = is_early ? early : late;
        return {WallReading::Kind::unique, moment, moment};
    }
    const sys_seconds change = m_rules->periodAt(early).end;
    return {WallReading::Kind::skipped, change, change};
}

seconds Zone::standardOffset(int year) const {
    const auto offsetIn = [&](month of_year) {
        return m_rules->periodAt(sys_days(std::chrono::year(year) / of_year / 15)).offset;
    };
    return std::min(offsetIn(January), offsetIn(July));
}

} // namespace quarn
