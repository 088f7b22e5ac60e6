#pragma once

#include "ground/Result.h"
#include "sdk/qncore/QnExport.h"

#include <chrono>
#include <memory>
#include <string>
#include <string_view>

namespace quarn {

class ZoneRules;

/// What the clocks of a place show at one moment.
struct WallTime {
    std::chrono::local_seconds local; ///< date and time of day, Gregorian calendar
    std::chrono::seconds offset{0};   ///< what the clocks are ahead of UTC
    std::string abbreviation;         ///< "CEST"; "UTC+5:30" where the zone has no letters; "LMT"
    bool is_summer_time = false;      ///< ahead of what the same clocks show in winter
};

/// Which moments clocks show a date and time of day at.
struct WallReading {
    enum class Kind {
        unique,  ///< at one moment, `first`
        skipped, ///< never: clocks were put forward over it at the moment `first`
        twice,   ///< at `first` and, after clocks were put back, at `second`
    };
    Kind kind = Kind::unique;
    std::chrono::sys_seconds first;
    std::chrono::sys_seconds second; ///< `first`, where it is not shown twice
};

/// The clocks of a place: what they show at any moment, with daylight saving as it was, is or, by
/// the last rule that is known, will be there. Cheap to copy; may be used from several threads.
class QNCORE_API Zone {
public:
    /// A zone of the time zone database ("Europe/Berlin"; case makes no difference), or one that is
    /// always so much ahead of UTC: "+05:30", "-3", "UTC", "UTC+5:30", at most 24 hours either way.
    ///
    /// @param text  UTF-8
    /// @return an error when there is no such zone (it proposes names that are like it), when the
    ///         database is missing, or a file of it cannot be read
    static Result<Zone> named(std::string_view text);

    /// As named; besides it takes "solar": the mean solar time of a longitude.
    /// @param longitude_deg  east positive
    static Result<Zone> written(std::string_view text, double longitude_deg);

    /// A zone that is always so much ahead of UTC.
    static Zone fixed(std::chrono::minutes east);

    /// The mean solar time of a longitude: four minutes a degree, to the second.
    /// @param longitude_deg  east positive, -360 to 360
    static Zone solar(double longitude_deg);

    /// As `written` takes it: "Europe/Berlin", "UTC+5:30", "solar".
    const std::string& name() const { return m_name; }

    /// What the clocks show at a moment; before zones were made, the mean solar time there (LMT).
    WallTime at(std::chrono::sys_seconds utc) const;

    /// When the clocks show a date and time of day.
    WallReading read(std::chrono::local_seconds local) const;

    /// What the clocks are ahead of UTC in winter: the lesser of what they are ahead in the middle
    /// of January and of July of a year.
    std::chrono::seconds standardOffset(int year) const;

private:
    Zone(std::string name, std::shared_ptr<const ZoneRules> rules);

    std::string m_name;
    std::shared_ptr<const ZoneRules> m_rules;
};

} // namespace quarn
