#include "host/sun/SunEvents.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace quarn {
namespace {

using std::chrono::seconds;
using std::chrono::sys_seconds;

constexpr double RADIANS_OF_DEGREE = std::numbers::pi / 180;
constexpr double SECONDS_OF_HOUR_ANGLE = 240; // of the hour angle

/// The altitude has one highest and one lowest point a day: looks at this distance see each of them
/// as a look that lies above or below both of its neighbours.
constexpr seconds STEP = std::chrono::minutes(30);

struct Look {
    sys_seconds time;
    double altitude_deg;   ///< above the horizon of the rule
    double hour_angle_deg; ///< from the meridian, west positive, -180 to 180
};

double hourAngle(const SunSite& site, const SunPosition& sun) {
    const double latitude = site.latitude_deg * RADIANS_OF_DEGREE;
    const double azimuth = sun.azimuth_deg * RADIANS_OF_DEGREE;
    const double altitude = sun.altitude_deg * RADIANS_OF_DEGREE;
    return std::atan2(-std::cos(altitude) * std::sin(azimuth),
                      std::sin(altitude) * std::cos(latitude) -
                          std::cos(altitude) * std::sin(latitude) * std::cos(azimuth)) /
           RADIANS_OF_DEGREE;
}

/// The sky of one place, looked at in the course of time.
class Sky {
public:
    Sky(const SunSite& site, double horizon_deg) : m_site(site), m_horizon_deg(horizon_deg) {}

    Look at(sys_seconds time) const {
        const SunPosition sun = sunPosition(m_site, time);
        return {time, sun.altitude_deg - m_horizon_deg, hourAngle(m_site, sun)};
    }

    /// Where the sun crosses the horizon between two looks on either side of it.
    sys_seconds crossing(Look before, Look after) const {
        const bool rises = after.altitude_deg >= 0;
        while (after.time - before.time > seconds(1)) {
            const Look middle = at(before.time + (after.time - before.time) / 2);
            ((middle.altitude_deg >= 0) == rises ? after : before) = middle;
        }
        return std::abs(before.altitude_deg) < std::abs(after.altitude_deg) ? before.time
                                                                            : after.time;
    }

    /// The highest look between two, or with a sign of -1 the lowest.
    Look extreme(sys_seconds from, sys_seconds to, double sign) const {
        while (to - from > seconds(2)) {
            const seconds third = (to - from) / 3;
            const Look early = at(from + third);
            const Look late = at(to - third);
            if (sign * early.altitude_deg < sign * late.altitude_deg)
                from = early.time;
            else
                to = late.time;
        }
        return at(from + (to - from) / 2);
    }

    /// The transit near a look before it.
    sys_seconds transit(const Look& before) const {
        constexpr int ROUNDS = 3; // the sun's own motion changes the hour angle by a thousandth
        Look look = before;
        for (int round = 0; round < ROUNDS; ++round)
            look =
                at(look.time - seconds(std::llround(look.hour_angle_deg * SECONDS_OF_HOUR_ANGLE)));
        return look.time;
    }

private:
    SunSite m_site;
    double m_horizon_deg;
};

/// Looks from a step before the span to a step behind it, so that a short day at the border of the
/// span is seen.
std::vector<Look> looksThrough(const Sky& sky, sys_seconds from, sys_seconds to) {
    std::vector<Look> looks;
    for (sys_seconds time = from - STEP; time < to + 2 * STEP; time += STEP)
        looks.push_back(sky.at(time));
    return looks;
}

/// Adds the highest points that lie just above the horizon between two looks below it, and the
/// lowest ones likewise: no crossing lies unseen between two looks then.
std::vector<Look> withTurns(const Sky& sky, const std::vector<Look>& looks) {
    std::vector<Look> all;
    for (std::size_t i = 0; i < looks.size(); ++i) {
        const bool is_inner = i > 0 && i + 1 < looks.size();
        const double sign = looks[i].altitude_deg < 0 ? 1 : -1;
        const auto isBeyond = [&](const Look& other) {
            return sign * looks[i].altitude_deg >= sign * other.altitude_deg;
        };
        if (!is_inner || !isBeyond(looks[i - 1]) || !isBeyond(looks[i + 1])) {
            all.push_back(looks[i]);
            continue;
        }
        const Look turn = sky.extreme(looks[i - 1].time, looks[i + 1].time, sign);
        all.push_back(turn.time < looks[i].time ? turn : looks[i]);
        all.push_back(turn.time < looks[i].time ? looks[i] : turn);
    }
    return all;
}

void addEventsBetween(const Sky& sky, const Look& before, const Look& after,
                      std::vector<SunEvent>& events) {
    if ((before.altitude_deg >= 0) != (after.altitude_deg >= 0))
        events.push_back({after.altitude_deg >= 0 ? SunEvent::Kind::rise : SunEvent::Kind::set,
                          sky.crossing(before, after)});
    // At midnight the hour angle leaps backward.
    if (before.hour_angle_deg < 0 && after.hour_angle_deg >= 0)
        events.push_back({SunEvent::Kind::transit, sky.transit(before)});
}

/// Where the day length and the course of the span come from.
void sumUp(const Sky& sky, sys_seconds from, sys_seconds to, SunEvents& found) {
    bool is_up = sky.at(from).altitude_deg >= 0;
    found.course = is_up ? SunEvents::Course::polar_day : SunEvents::Course::polar_night;
    sys_seconds since = from;
    for (const SunEvent& event : found.events) {
        if (event.kind == SunEvent::Kind::transit)
            continue;
        found.course = SunEvents::Course::rises_or_sets;
        if (event.kind == SunEvent::Kind::set)
            found.day_length += event.time - since;
        is_up = event.kind == SunEvent::Kind::rise;
        since = event.time;
    }
    if (is_up)
        found.day_length += to - since;
}

} // namespace

std::optional<sys_seconds> SunEvents::first(SunEvent::Kind kind) const {
    const auto event = std::ranges::find(events, kind, &SunEvent::kind);
    return event == events.end() ? std::nullopt : std::optional(event->time);
}

SunEvents sunEvents(const SunSite& site, sys_seconds from, sys_seconds to, double horizon_deg) {
    SunEvents found;
    if (to <= from)
        return found;
    const Sky sky(site, horizon_deg);
    const std::vector<Look> looks = withTurns(sky, looksThrough(sky, from, to));
    for (std::size_t i = 1; i < looks.size(); ++i)
        addEventsBetween(sky, looks[i - 1], looks[i], found.events);
    std::erase_if(found.events,
                  [&](const SunEvent& event) { return event.time < from || event.time >= to; });
    std::ranges::stable_sort(found.events, {}, &SunEvent::time);
    sumUp(sky, from, to, found);
    return found;
}

} // namespace quarn
