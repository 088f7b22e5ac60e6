#pragma once

#include <chrono>
#include <cstdio>
#include <string>

namespace quarn {

/// "2019-01-15" or "2019-01-15 13:12[:05]" of universal time.
inline std::chrono::sys_seconds utc(const std::string& text) {
    int year = 0;
    unsigned month = 0;
    unsigned day = 0;
    int hour = 0;
    int minute = 0;
    int second = 0;
    std::sscanf(text.c_str(), "%d-%u-%u %d:%d:%d", &year, &month, &day, &hour, &minute, &second);
    return std::chrono::sys_days(std::chrono::year(year) / month / day) + std::chrono::hours(hour) +
           std::chrono::minutes(minute) + std::chrono::seconds(second);
}

} // namespace quarn
