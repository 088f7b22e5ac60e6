#include "host/clock/WallText.h"

#include "host/clock/ZoneOffset.h"

#include <array>
#include <cstdio>

namespace quarn {
namespace {

using namespace std::chrono;

struct Shown {
    std::string date;
    std::string time;
};

Shown shown(const WallTime& wall) {
    const auto minute = floor<minutes>(wall.local + 30s);
    const auto day = floor<days>(minute);
    const year_month_day date{day};
    const hh_mm_ss time{minute - day};
    std::array<char, 32> text{};
    std::snprintf(text.data(), text.size(), "%04d-%02u-%02u", int(date.year()),
                  unsigned(date.month()), unsigned(date.day()));
    Shown both{text.data(), {}};
    std::snprintf(text.data(), text.size(), "%02d:%02d", int(time.hours().count()),
                  int(time.minutes().count()));
    both.time = text.data();
    return both;
}

} // namespace

std::string dateText(const WallTime& wall) {
    return shown(wall).date;
}

std::string timeText(const WallTime& wall) {
    return shown(wall).time;
}

std::string timeWithZone(const WallTime& wall) {
    return timeText(wall) + " " + wall.abbreviation;
}

std::string dateAndTime(const WallTime& wall) {
    return dateText(wall) + " " + timeWithZone(wall);
}

std::string isoText(const WallTime& wall) {
    const Shown both = shown(wall);
    return both.date + "T" + both.time + ":00";
}

std::string offsetText(const WallTime& wall) {
    return offsetText(round<minutes>(wall.offset));
}

} // namespace quarn
