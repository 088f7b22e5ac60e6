#include "host/clock/WallText.h"

#include "host/clock/ZoneOffset.h"

#include <array>
#include <cstdio>

namespace quarn {
namespace {

using namespace std::chrono;

std::string formatted(const char* form, int first, int second, int third = 0) {
    std::array<char, 48> text{};
    std::snprintf(text.data(), text.size(), form, first, second, third);
    return text.data();
}

local_seconds toTheMinute(const WallTime& wall) {
    return floor<minutes>(wall.local + 30s);
}

std::string timeOfDay(local_seconds local, const char* form) {
    const hh_mm_ss time{local - floor<days>(local)};
    return formatted(form, int(time.hours().count()), int(time.minutes().count()),
                     int(time.seconds().count()));
}

constexpr const char* TO_THE_SECOND = "%02d:%02d:%02d";

std::string dateText(local_seconds local) {
    return quarn::dateText(year_month_day{floor<days>(local)});
}

} // namespace

std::string dateText(year_month_day day) {
    return formatted("%04d-%02d-%02d", int(day.year()), static_cast<int>(unsigned(day.month())),
                     static_cast<int>(unsigned(day.day())));
}

std::string dateText(const WallTime& wall) {
    return dateText(toTheMinute(wall));
}

std::string timeText(const WallTime& wall) {
    return timeOfDay(toTheMinute(wall), "%02d:%02d");
}

std::string timeWithZone(const WallTime& wall) {
    return timeText(wall) + " " + wall.abbreviation;
}

std::string dateAndTime(const WallTime& wall) {
    return dateText(wall) + " " + timeWithZone(wall);
}

std::string isoText(const WallTime& wall) {
    return dateText(wall) + "T" + timeOfDay(toTheMinute(wall), TO_THE_SECOND);
}

std::string isoTextWithOffset(const WallTime& wall) {
    const hh_mm_ss offset{wall.offset};
    const char* const form = offset.seconds() == 0s ? "%02d:%02d" : TO_THE_SECOND;
    return dateText(wall.local) + "T" + timeOfDay(wall.local, TO_THE_SECOND) +
           (offset.is_negative() ? "-" : "+") +
           formatted(form, int(offset.hours().count()), int(offset.minutes().count()),
                     int(offset.seconds().count()));
}

std::string offsetText(const WallTime& wall) {
    return offsetText(round<minutes>(wall.offset));
}

} // namespace quarn
