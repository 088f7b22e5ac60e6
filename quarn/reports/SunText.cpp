// The sun as text and as a table.
#include "host/clock/WallText.h"
#include "quarn/reports/SunTelling.h"

#include <array>
#include <charconv>
#include <cmath>

namespace quarn::program {

namespace {

using std::chrono::seconds;
using std::chrono::sys_seconds;

std::string padded(std::string text, std::size_t width, bool is_number = false) {
    const std::string blanks(text.size() < width ? width - text.size() : 0, ' ');
    return is_number ? blanks + text : text + blanks;
}

std::string lengthText(seconds length) {
    const auto minutes = std::chrono::floor<std::chrono::minutes>(length + seconds(30)).count();
    return std::to_string(minutes / 60) + (minutes % 60 < 10 ? " h 0" : " h ") +
           std::to_string(minutes % 60) + " min";
}

std::string dayText(const CivilSite& site, const SunDay& day) {
    std::string text = "\n" + dateText(std::chrono::year_month_day(day.date)) + "\n";
    for (const SunEvent& event : day.sun.events) {
        const SunPosition sun = sunPosition({site.latitude_deg, site.longitude_deg}, event.time);
        const bool is_transit = event.kind == SunEvent::Kind::transit;
        text += "  " + padded(nameOf(event.kind), 12) +
                padded(timeWithZone(site.zone.at(event.time)), 16) +
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
    return padded(dateAndTime(zone.at(sun.time)), 26) +
           padded(fixedText(sun.position.azimuth_deg, 2), 8, true) +
           padded(fixedText(sun.position.altitude_deg, 2), 10, true) + "\n";
}

std::string heading(const SunRequest& request) {
    const CivilSite& site = request.site;
    std::string text = (site.place.empty() ? "" : site.place + ": ") + coordinatesText(site) +
                       "\nClock: " + site.zone.name() + "\n";
    for (const std::string& note : request.notes)
        text += note + ".\n";
    return text;
}

std::string firstOf(const Zone& zone, const SunEvents& sun, SunEvent::Kind kind) {
    const auto time = sun.first(kind);
    return time ? isoTextWithOffset(zone.at(*time)) : "";
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
        text += isoTextWithOffset(zone.at(sun.time)) + "," +
                fixedText(sun.position.azimuth_deg, 4) + "," +
                fixedText(sun.position.altitude_deg, 4) + "," +
                firstOf(zone, day->sun, SunEvent::Kind::rise) + "," +
                firstOf(zone, day->sun, SunEvent::Kind::transit) + "," +
                firstOf(zone, day->sun, SunEvent::Kind::set) + "," +
                fixedText(static_cast<double>(day->sun.day_length.count()) / 3600, 4) + "\n";
    }
    return text;
}

} // namespace quarn::program
