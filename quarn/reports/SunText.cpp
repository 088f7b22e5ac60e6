// The sun as text and as a table.
#include "quarn/reports/SunTelling.h"
#include "quarn/scripts/StudySite.h"

#include <array>
#include <charconv>
#include <cmath>

namespace quarn::program {

namespace {

using std::chrono::seconds;
using std::chrono::sys_seconds;

std::string twoDigits(std::int64_t number) {
    return (number < 10 ? "0" : "") + std::to_string(number);
}

/// "14:30", or "14:30:05" where there are seconds.
std::string timeOfDay(std::chrono::local_seconds local, bool has_seconds) {
    const std::chrono::hh_mm_ss time(local - std::chrono::floor<std::chrono::days>(local));
    const std::string text =
        twoDigits(time.hours().count()) + ":" + twoDigits(time.minutes().count());
    return has_seconds ? text + ":" + twoDigits(time.seconds().count()) : text;
}

/// What the clocks show, with their zone: "14:30 CEST".
std::string clockText(const Zone& zone, sys_seconds time) {
    const WallTime wall = zone.at(time);
    const bool has_seconds = wall.local.time_since_epoch() % 60 != seconds(0);
    return timeOfDay(wall.local, has_seconds) + " " + wall.abbreviation;
}

/// As tables print it, to the minute.
sys_seconds wholeMinute(sys_seconds time) {
    return std::chrono::floor<std::chrono::minutes>(time + seconds(30));
}

std::string padded(std::string text, std::size_t width, bool is_number = false) {
    const std::string blanks(text.size() < width ? width - text.size() : 0, ' ');
    return is_number ? blanks + text : text + blanks;
}

std::string lengthText(seconds length) {
    const auto minutes = std::chrono::floor<std::chrono::minutes>(length + seconds(30)).count();
    return std::to_string(minutes / 60) + " h " + twoDigits(minutes % 60) + " min";
}

std::string dayText(const CivilSite& site, const SunDay& day) {
    std::string text = "\n" + dateText(day.date) + "\n";
    for (const SunEvent& event : day.sun.events) {
        const SunPosition sun = sunPosition({site.latitude_deg, site.longitude_deg}, event.time);
        const bool is_transit = event.kind == SunEvent::Kind::transit;
        text += "  " + padded(nameOf(event.kind), 12) +
                padded(clockText(site.zone, wholeMinute(event.time)), 16) +
                (is_transit ? "altitude " + fixedText(sun.altitude_deg, 1)
                            : "azimuth " + fixedText(sun.azimuth_deg, 1)) +
                "\n";
    }
    text += "  " + padded("day length", 12) + lengthText(day.sun.day_length);
    if (const std::string course = nameOf(day.sun.course); !course.empty())
        text += ", " + course;
    return text + "\n";
}

std::string positionLine(const Zone& zone, const TimedSun& sun) {
    const auto date = std::chrono::floor<std::chrono::days>(zone.at(sun.time).local);
    return padded(dateText(date) + " " + clockText(zone, sun.time), 26) +
           padded(fixedText(sun.position.azimuth_deg, 2), 8, true) +
           padded(fixedText(sun.position.altitude_deg, 2), 10, true) + "\n";
}

std::string heading(const SunRequest& request) {
    const CivilSite& site = request.site;
    std::string text = (site.place.empty() ? "" : site.place + ": ") +
                       latitudeText(site.latitude_deg) + ", " + longitudeText(site.longitude_deg) +
                       "\nClock: " + site.zone.name();
    if (!site.zone_origin.empty())
        text += ", the zone of " + site.zone_origin + ", the nearest place that is known";
    text += "\n";
    for (const std::string& note : request.notes)
        text += note + "\n";
    return text;
}

std::string firstOf(const Zone& zone, const SunEvents& sun, SunEvent::Kind kind) {
    const auto time = sun.first(kind);
    return time ? isoText(zone, *time) : "";
}

} // namespace

std::string fixedText(double value, int digits) {
    std::array<char, 64> text;
    const double scale = std::pow(10, digits);
    const double rounded = std::round(value * scale) / scale;
    const char* const end =
        std::to_chars(text.data(), text.data() + text.size(), rounded == 0 ? 0 : rounded,
                      std::chars_format::fixed, digits)
            .ptr;
    return {static_cast<const char*>(text.data()), end};
}

std::string dateText(std::chrono::local_days date) {
    const std::chrono::year_month_day day(date);
    const std::string year = std::to_string(static_cast<int>(day.year()));
    return year + "-" + twoDigits(static_cast<unsigned>(day.month())) + "-" +
           twoDigits(static_cast<unsigned>(day.day()));
}

std::string isoText(const Zone& zone, sys_seconds time) {
    const WallTime wall = zone.at(time);
    const std::chrono::hh_mm_ss offset(wall.offset);
    std::string text = dateText(std::chrono::floor<std::chrono::days>(wall.local)) + "T" +
                       timeOfDay(wall.local, true) + (offset.is_negative() ? "-" : "+") +
                       twoDigits(offset.hours().count()) + ":" +
                       twoDigits(offset.minutes().count());
    if (offset.seconds() != seconds(0)) // mean time of a longitude
        text += ":" + twoDigits(offset.seconds().count());
    return text;
}

const char* nameOf(SunEvent::Kind kind) {
    constexpr const char* NAMES[] = {"rise", "transit", "set"};
    return NAMES[static_cast<int>(kind)];
}

const char* nameOf(SunEvents::Course course) {
    constexpr const char* NAMES[] = {"", "polar day", "polar night"};
    return NAMES[static_cast<int>(course)];
}

std::string textOf(const SunRequest& request, const SunTelling& telling) {
    std::string text = heading(request);
    for (const SunDay& day : telling.days)
        text += dayText(request.site, day);
    text += "\n" + padded("time", 26) + " azimuth  altitude\n";
    for (const TimedSun& sun : telling.positions)
        text += positionLine(request.site.zone, sun);
    return text;
}

std::string csvOf(const SunRequest& request, const SunTelling& telling) {
    const Zone& zone = request.site.zone;
    std::string text = "time,azimuth_deg,altitude_deg,rise,transit,set,day_length_h\n";
    auto day = telling.days.begin();
    for (const TimedSun& sun : telling.positions) {
        const auto date = std::chrono::floor<std::chrono::days>(zone.at(sun.time).local);
        while (day->date != date)
            ++day;
        text += isoText(zone, sun.time) + "," + fixedText(sun.position.azimuth_deg, 4) + "," +
                fixedText(sun.position.altitude_deg, 4) + "," +
                firstOf(zone, day->sun, SunEvent::Kind::rise) + "," +
                firstOf(zone, day->sun, SunEvent::Kind::transit) + "," +
                firstOf(zone, day->sun, SunEvent::Kind::set) + "," +
                fixedText(static_cast<double>(day->sun.day_length.count()) / 3600, 4) + "\n";
    }
    return text;
}

} // namespace quarn::program
