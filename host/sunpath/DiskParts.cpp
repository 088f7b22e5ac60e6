#include "host/sunpath/DiskParts.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <numbers>
#include <optional>

namespace quarn {
namespace {

constexpr Grey GRID_GREY = 0.72;
constexpr Grey HIDDEN_GREY = 0.8;
constexpr Grey LOOP_GREY = 0.35;
constexpr double DASH_PX = 5;
constexpr std::size_t JUNE = 5;
constexpr std::size_t DECEMBER = 11;

/// How far outside the horizon things stand: degrees, dates, the letters of the compass.
constexpr double DEGREES_PX = 15;
constexpr double DATES_PX = 33;
constexpr double LETTERS_BESIDE_DATES_PX = 112;
constexpr double LETTERS_PX = 42;

std::string twoDigits(std::size_t number) {
    return (number < 10 ? "0" : "") + std::to_string(number);
}

/// The years' two halves look different: they are not in the same place.
double dashOfMonth(std::size_t month) {
    return month > JUNE && month < DECEMBER ? DASH_PX : 0;
}

/// How texts outside the disk stand so that they grow away from it.
TextAnchor anchorOutside(double azimuth_deg) {
    constexpr double UPRIGHT = 0.35;
    const double east = std::sin(azimuth_deg * std::numbers::pi / 180);
    return east > UPRIGHT    ? TextAnchor::start
           : east < -UPRIGHT ? TextAnchor::end
                             : TextAnchor::middle;
}

bool isOnHorizon(const SunPosition& sun) {
    return sun.altitude_deg == 0;
}

/// Where the sun sets on its way, or rises.
std::optional<SunPosition> endOnHorizon(const SunPath& path, bool is_set) {
    for (const auto& piece : path) {
        const SunPosition& end = is_set ? piece.back() : piece.front();
        if (isOnHorizon(end))
            return end;
    }
    return std::nullopt;
}

/// Where the sun is at a time of day, on a day without night.
SunPosition atHour(const SunPath& path, double hour) {
    const auto& piece = path.front();
    const auto index = static_cast<std::size_t>(hour / 24 * static_cast<double>(piece.size()));
    return piece[std::min(index, piece.size() - 1)];
}

DrawnPoint between(const DrawnPoint& from, const DrawnPoint& to, double distance_px) {
    const double x = to.x_px - from.x_px;
    const double y = to.y_px - from.y_px;
    const double length = std::max(std::hypot(x, y), 1e-9);
    return {from.x_px + x / length * distance_px, from.y_px + y / length * distance_px};
}

/// The ends of a loop at the solstices, June first; nothing where the sun is below the horizon.
struct LoopEnds {
    std::optional<SunPosition> june;
    std::optional<SunPosition> december;

    explicit LoopEnds(const SunLoop& loop) {
        if (!loop.winter_to_summer.empty()) {
            const SunPosition& last = loop.winter_to_summer.back().back();
            const SunPosition& first = loop.winter_to_summer.front().front();
            if (!isOnHorizon(last))
                june = last;
            if (!isOnHorizon(first))
                december = first;
        }
    }
};

} // namespace

YearOfPaths pathsOfYear(const SunSite& site, const StandardClock& clock) {
    YearOfPaths year;
    for (std::size_t month = 0; month < year.days.size(); ++month)
        year.days[month] = pathOfDay(site, clock, monthAt(month) / std::chrono::day(21));
    for (std::size_t hour = 0; hour < year.hours.size(); ++hour)
        year.hours[hour] = loopOfHour(site, clock, static_cast<int>(hour));
    return year;
}

void DiskParts::addSky() {
    m_drawing.shapes.push_back(
        DrawnCircle{.middle = m_disk.middle, .radius_px = m_disk.radius_px, .fill = 1});
}

void DiskParts::addHidden(const Obstruction& obstruction) {
    m_drawing.shapes.push_back(DrawnPath{.id = m_name + "-hidden",
                                         .lines = hiddenAreas(obstruction, m_disk),
                                         .is_closed = true,
                                         .fill = HIDDEN_GREY});
}

void DiskParts::addRings() {
    const DrawnStroke grid{.width_px = 0.6, .grey = GRID_GREY};
    for (int altitude = 10; altitude < 90; altitude += 10)
        m_drawing.shapes.push_back(DrawnCircle{.middle = m_disk.middle,
                                               .radius_px = m_disk.radiusOf(altitude),

                                               .stroke = grid});
    DrawnPath rays{.stroke = grid};
    for (int azimuth = 0; azimuth < 360; azimuth += 10) {
        const double inner_deg = azimuth % 30 == 0 ? 90 : 80;
        rays.lines.push_back({m_disk.at({double(azimuth), inner_deg}), m_disk.onRim(azimuth)});
    }
    m_drawing.shapes.push_back(std::move(rays));
    m_drawing.shapes.push_back(DrawnCircle{.middle = m_disk.middle,
                                           .radius_px = m_disk.radius_px,

                                           .stroke = DrawnStroke{.width_px = 1.6}});
}

void DiskParts::addPath(const std::string& id, const SunPath& path, const DrawnStroke& stroke) {
    if (path.empty())
        return;
    DrawnPath drawn{.id = m_name + "-" + id, .stroke = stroke};
    for (const auto& piece : path) {
        auto& line = drawn.lines.emplace_back();
        for (const SunPosition& sun : piece)
            line.push_back(m_disk.at(sun));
    }
    m_drawing.shapes.push_back(std::move(drawn));
}

void DiskParts::addLoops(const YearOfPaths& year) {
    const DrawnStroke full{.width_px = 0.9, .grey = LOOP_GREY};
    const DrawnStroke dashed{.width_px = 0.9, .grey = LOOP_GREY, .dash_px = DASH_PX};
    for (std::size_t hour = 0; hour < year.hours.size(); ++hour) {
        const std::string id = "hour-" + twoDigits(hour);
        addPath(id, year.hours[hour].winter_to_summer, full);
        addPath(id + "-back", year.hours[hour].summer_to_winter, dashed);
    }
}

void DiskParts::addDays(const YearOfPaths& year) {
    for (std::size_t month = 0; month < year.days.size(); ++month) {
        const bool is_solstice = month == JUNE || month == DECEMBER;
        addPath(twoDigits(month + 1) + "-21", year.days[month],
                {.width_px = is_solstice ? 2.2 : 1.4, .dash_px = dashOfMonth(month)});
    }
    for (std::size_t month = 0; month < year.days.size(); ++month)
        addDate(month, year.days[month]);
}

void DiskParts::addTextAt(const DrawnPoint& middle, DrawnText text) {
    constexpr double LETTER_MIDDLE = 0.35; // above the base line, of the size
    text.place = {middle.x_px, middle.y_px + LETTER_MIDDLE * text.size_px};
    m_drawing.shapes.push_back(std::move(text));
}

/// The first half of the year has its dates where the sun sets, the other where it rises: else two
/// would stand in one place.
void DiskParts::addDate(std::size_t month, const SunPath& path) {
    if (path.empty())
        return;
    const bool is_first_half = month <= JUNE;
    DrawnText text{.place = {}, .text = m_words.date(monthAt(month) / 21), .size_px = 13};
    if (const auto end = endOnHorizon(path, is_first_half)) {
        text.anchor = anchorOutside(end->azimuth_deg);
        addTextAt(m_disk.onRim(end->azimuth_deg, DATES_PX), std::move(text));
        return;
    }
    text.anchor = TextAnchor::middle;
    text.has_halo = true;
    // A day without night has a ring: each ring has its date between other hours.
    const double hour = is_first_half ? 16.5 + static_cast<double>(month)
                                      : 7.5 - static_cast<double>(month - JUNE - 1);
    addTextAt(m_disk.at(atHour(path, hour)), std::move(text));
}

void DiskParts::addAltitudes(const SunSite& site) {
    constexpr double LEAST_GAP_PX = 15;
    const double azimuth_deg = site.latitude_deg < 0 ? 180 : 0; // where the sun comes least
    double last_px = m_disk.radius_px;
    for (int altitude = 10; altitude < 90; altitude += 10) {
        const double radius_px = m_disk.radiusOf(altitude);
        if (last_px - radius_px < LEAST_GAP_PX)
            continue;
        last_px = radius_px;
        addTextAt(m_disk.at({azimuth_deg, double(altitude)}),
                  {.place = {},
                   .text = std::to_string(altitude) + "°",
                   .size_px = 11,
                   .anchor = TextAnchor::middle,
                   .grey = LOOP_GREY,
                   .has_halo = true});
    }
}

void DiskParts::addHours(const YearOfPaths& year, const SunSite& site) {
    constexpr double BESIDE_PX = 13;
    constexpr double LEAST_GAP_PX = 19;
    std::optional<DrawnPoint> last;
    for (std::size_t hour = 0; hour < year.hours.size(); ++hour) {
        const LoopEnds ends(year.hours[hour]);
        const bool is_june = site.latitude_deg < 0 ? !ends.december : ends.june.has_value();
        const auto& end = is_june ? ends.june : ends.december;
        if (!end)
            continue;
        // Away from the rest of the loop.
        const SunPath& half = year.hours[hour].winter_to_summer;
        const auto& piece = is_june ? half.back() : half.front();
        const SunPosition& inner = piece[piece.size() / 2];
        const DrawnPoint place = m_disk.at(*end);
        const DrawnPoint middle = between(place, m_disk.at(inner), -BESIDE_PX);
        if (last && std::hypot(middle.x_px - last->x_px, middle.y_px - last->y_px) < LEAST_GAP_PX)
            continue;
        last = middle;
        addTextAt(middle, {.place = {},
                           .text = std::to_string(hour),
                           .size_px = 14,
                           .anchor = TextAnchor::middle,
                           .is_bold = true,
                           .has_halo = true});
    }
}

void DiskParts::addCompass() {
    for (int azimuth = 0; azimuth < 360; azimuth += 10)
        addTextAt(m_disk.onRim(azimuth, DEGREES_PX), {.place = {},
                                                      .text = std::to_string(azimuth),
                                                      .size_px = 11,
                                                      .anchor = TextAnchor::middle,
                                                      .grey = LOOP_GREY});
    for (const Quarter quarter : {NORTH, EAST, SOUTH, WEST})
        addTextAt(
            m_disk.onRim(90.0 * quarter, quarter % 2 == 0 ? LETTERS_PX : LETTERS_BESIDE_DATES_PX),
            {.place = {},
             .text = m_words.quarter(quarter),
             .size_px = 22,
             .anchor = TextAnchor::middle,
             .is_bold = true});
}

} // namespace quarn
