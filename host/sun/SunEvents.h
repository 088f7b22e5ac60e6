#pragma once

#include "host/sun/SunPosition.h"

#include <chrono>
#include <optional>
#include <vector>

namespace quarn {

/// The altitude of the sun's centre, without refraction, at which published tables let it rise and
/// set: a zenith distance of 90 degrees 50 minutes, of which 34 minutes are refraction at the
/// horizon and 16 the sun's half diameter (Explanatory Supplement to the Astronomical Almanac, 3rd
/// edition, section 12.2).
inline constexpr double PUBLISHED_HORIZON_DEG = -50.0 / 60;

/// The altitude below which the light of the sun in a picture comes from under the ground: its
/// centre at the horizon, without refraction.
inline constexpr double BARE_HORIZON_DEG = 0;

/// Something that the sun does at an instant.
struct SunEvent {
    enum class Kind {
        rise,
        transit, ///< through the meridian, highest in the sky; by day or, near the poles, by night
        set,
    };
    Kind kind;
    std::chrono::sys_seconds time; ///< UTC, to the nearest second
};

/// What the sun does between two instants.
struct SunEvents {
    enum class Course {
        rises_or_sets, ///< at least once
        polar_day,     ///< above the horizon all the time
        polar_night,   ///< below it all the time
    };
    std::vector<SunEvent> events; ///< in the order of time
    Course course = Course::rises_or_sets;
    std::chrono::seconds day_length{}; ///< how long the sun is above the horizon, in all

    /// When something happens first; nothing where it never does. Near the poles a rise or set can
    /// come twice in one day, or stand alone.
    QNCORE_API std::optional<std::chrono::sys_seconds> first(SunEvent::Kind kind) const;
};

/// Finds the rises, transits and sets of the sun at a place at sea level with a free horizon.
///
/// @param from, to     the span, without `to` itself: a civil day by the clock of the place, from
///                     midnight to midnight. Of the years that SunYears.h names; empty where `to`
///                     is not after `from`: nothing happens then
/// @param horizon_deg  the altitude that the centre rises above and sets below
QNCORE_API SunEvents sunEvents(const SunSite& site, std::chrono::sys_seconds from,
                               std::chrono::sys_seconds to,
                               double horizon_deg = PUBLISHED_HORIZON_DEG);

} // namespace quarn
