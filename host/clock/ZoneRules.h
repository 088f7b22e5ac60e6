#pragma once

#include <chrono>
#include <string>

namespace quarn {

/// A time through which the clocks of a zone keep one distance from UTC.
struct ClockPeriod {
    std::chrono::sys_seconds begin = std::chrono::sys_seconds::min();
    std::chrono::sys_seconds end = std::chrono::sys_seconds::max(); ///< not in it any more
    std::chrono::seconds offset{0};                                 ///< ahead of UTC
    std::string abbreviation;
    bool is_daylight_saving = false; ///< by the database, which has Ireland's in winter
};

/// When the clocks of a zone are put forward and back.
class ZoneRules {
public:
    virtual ~ZoneRules() = default;
    virtual ClockPeriod periodAt(std::chrono::sys_seconds utc) const = 0;
};

} // namespace quarn
