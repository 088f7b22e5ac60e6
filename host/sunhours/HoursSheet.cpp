#include "host/sunhours/HoursSheet.h"

#include "host/clock/WallText.h"
#include "host/sunhours/HourColors.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace quarn {

namespace {

constexpr SheetText TITLE{L"Hours of sun", 42985};
constexpr SheetText SPAN{L"%1 to %2", 42986};
constexpr SheetText EVERY_DAYS{L"%1, every %2 days", 42987};
constexpr SheetText AT_MOST{L"at most %1 of sun", 42988};
constexpr SheetText HOURS_MINUTES{L"%1 h %2 min", 42990};
constexpr SheetText LEGEND{L"Hours of direct sun", 42991};
constexpr SheetText LEGEND_OF_DAYS{L"Hours of direct sun a day, mean of the days", 42992};
constexpr SheetText STEPS{L"steps of %1 minutes, each begin and end of sun is known to %2 min",
                          42993};
constexpr SheetText COLORS{L"Colours: %1.", 42994};

constexpr const char* SEPARATOR = " · ";
constexpr KM_Color QUIET{92, 96, 102, 255};

/// All lengths follow from the picture's, so that sheets of any size look alike.
struct SheetSizes {
    explicit SheetSizes(const Image& map)
        : unit(std::max(8.0, 0.022 * std::sqrt(double(map.width) * map.height) * 0.8)),
          margin(static_cast<int>(std::lround(1.5 * unit))),
          head(static_cast<int>(std::lround(4.6 * unit))),
          foot(static_cast<int>(std::lround(5.4 * unit))) {}
    double unit; ///< height of the small text
    int margin;
    int head;
    int foot;
};

Image whiteSheet(int width, int height) {
    Image sheet;
    sheet.resize(width, height);
    std::ranges::fill(sheet.rgba, std::uint8_t{255});
    return sheet;
}

void fillBox(Image& sheet, int left, int top, int right, int bottom, KM_Color color) {
    for (int y = top; y < bottom; ++y)
        for (int x = left; x < right; ++x)
            cover(sheet, x, y, color, 1.0);
}

void layMap(Image& sheet, const Image& map, int left, int top) {
    for (int y = 0; y < map.height; ++y)
        for (int x = 0; x < map.width; ++x) {
            const auto pixel = map.pixel(x, y);
            cover(sheet, left + x, top + y, {pixel[0], pixel[1], pixel[2], 255}, 1.0);
        }
}

/// The size that lets a text fit, at most the one that is wished.
double fittingSize(const TextPainter& text, const std::string& words, double size, double room) {
    const double width = text.width(words, size);
    return width > room ? size * room / width : size;
}

/// A bar of the colours with its hours below.
void drawLegend(Image& sheet, const SheetSizes& sizes, int top, const SunHoursRequest& request,
                const SunMoments& moments, const TextPainter& text) {
    const SheetWords words(text.letters());
    const int left = sizes.margin;
    const int width = sheet.width - 2 * sizes.margin;
    const int height = static_cast<int>(std::lround(0.9 * sizes.unit));
    const double end = endOfScale(moments.hours);
    for (int x = 0; x < width; ++x)
        fillBox(sheet, left + x, top, left + x + 1, top + height, viridis((x + 0.5) / width));
    const double room = text.width(hoursText(24, words), sizes.unit) * 1.6;
    int step = 1;
    while (width / end * step < room)
        ++step;
    for (int hour = 0; hour <= static_cast<int>(end); hour += step) {
        const int x = left + static_cast<int>(std::lround(width * hour / end));
        const int tick = std::min(x, left + width - 1);
        fillBox(sheet, tick, top + height, tick + 1, top + height + height / 3, SHEET_INK);
        const std::string label = hour == 0 ? "0" : hoursText(hour, words);
        const double across = text.width(label, sizes.unit);
        text.draw(sheet, std::clamp(x - 0.5 * across, double(left), left + width - across),
                  top + height + 1.35 * sizes.unit, label, sizes.unit, SHEET_INK);
    }
    const std::string legend = legendOf(request, moments, words);
    text.draw(sheet, left, top + height + 2.9 * sizes.unit, legend,
              fittingSize(text, legend, 0.85 * sizes.unit, width), QUIET);
}

/// A needle in a ring, whose filled half points north.
void drawNorth(Image& sheet, double x, double y, double radius, double north_deg,
               const TextPainter& text) {
    const double angle = north_deg * std::numbers::pi / 180.0;
    const double nx = std::sin(angle);
    const double ny = -std::cos(angle);
    const int reach = static_cast<int>(std::ceil(radius)) + 2;
    for (int j = -reach; j <= reach; ++j)
        for (int i = -reach; i <= reach; ++i) {
            constexpr int FINE = 4;
            int ring = 0;
            int needle = 0;
            for (int s = 0; s < FINE * FINE; ++s) {
                const double px = i + (s % FINE + 0.5) / FINE - 0.5;
                const double py = j + (s / FINE + 0.5) / FINE - 0.5;
                const double along = (px * nx + py * ny) / radius;
                const double across = std::abs(px * ny - py * nx) / radius;
                const double far = std::hypot(px, py) / radius;
                ring += far > 0.95 && far < 1.03;
                needle += along > -0.55 && along < 0.85 && across < 0.30 * (0.85 - along) / 1.4 &&
                          across > 0.5 * (-0.25 - along);
            }
            const int px = static_cast<int>(std::lround(x)) + i;
            const int py = static_cast<int>(std::lround(y)) + j;
            cover(sheet, px, py, SHEET_INK, double(std::max(ring, needle)) / (FINE * FINE));
        }
    const double size = 0.75 * radius;
    const std::string north = SheetWords(text.letters()).quarter(NORTH);
    text.draw(sheet, x + 1.45 * radius * nx - 0.5 * text.width(north, size),
              y + 1.45 * radius * ny + 0.36 * size, north, size, SHEET_INK);
}

std::string daysText(const SunHoursRequest& request, const SheetWords& words) {
    if (request.last_day == request.first_day)
        return words.date(request.first_day);
    const std::string span =
        words(SPAN, {words.date(request.first_day), words.date(request.last_day)});
    return request.every_days > 1 ? words(EVERY_DAYS, {span, std::to_string(request.every_days)})
                                  : span;
}

/// An end of the time of day. Sunrise and sunset are told by the clock where there is one day.
std::string endText(const SunHoursRequest& request, const SunMoments& moments,
                    const std::optional<WantedTime>& wanted, bool is_last) {
    if (!wanted)
        return is_last ? "24:00" : "00:00";
    const bool is_by_sun = wanted->since != WantedTime::Since::midnight;
    if (!is_by_sun || moments.days > 1 || moments.moments.empty())
        return wantedTimeText(*wanted);
    const SunMoment& moment = is_last ? moments.moments.back() : moments.moments.front();
    return timeText(request.site.zone.at(moment.time));
}

} // namespace

std::string hoursText(double hours, const SheetWords& words) {
    const int minutes = static_cast<int>(std::lround(60.0 * hours));
    const std::string whole = std::to_string(minutes / 60);
    return minutes % 60 == 0 ? words(WHOLE_HOURS, {whole})
                             : words(HOURS_MINUTES, {whole, std::to_string(minutes % 60)});
}

std::string titleOf(const SunHoursRequest& request, const SheetWords& words) {
    return words(TITLE) + SEPARATOR + request.title;
}

std::string subtitleOf(const SunHoursRequest& request, const SunMoments& moments,
                       const SheetWords& words) {
    std::string text = request.site.place.empty() ? "" : request.site.place + SEPARATOR;
    text += daysText(request, words);
    if (request.from || request.to)
        text += SEPARATOR + words(SPAN, {endText(request, moments, request.from, false),
                                         endText(request, moments, request.to, true)});
    if (!moments.moments.empty())
        text += " (" + request.site.zone.at(moments.moments.front().time).abbreviation + ")";
    return text + SEPARATOR + words(AT_MOST, {hoursText(moments.hours, words)});
}

std::string legendOf(const SunHoursRequest& request, const SunMoments& moments,
                     const SheetWords& words) {
    const int half = (request.every_minutes + 1) / 2;
    return words(moments.days > 1 ? LEGEND_OF_DAYS : LEGEND) + "; " +
           words(STEPS, {std::to_string(request.every_minutes), std::to_string(half)}) + ". " +
           words(COLORS, {"viridis"});
}

Image sheetOf(const Image& map, const SunHoursRequest& request, const SunMoments& moments,
              const TextPainter& text) {
    const SheetSizes sizes(map);
    const SheetWords words(text.letters());
    Image sheet = whiteSheet(map.width + 2 * sizes.margin, map.height + sizes.head + sizes.foot);
    layMap(sheet, map, sizes.margin, sizes.head);
    const double room = map.width - 4.5 * sizes.unit; // the arrow stands beside them
    const std::string title = titleOf(request, words);
    text.draw(sheet, sizes.margin, 2.2 * sizes.unit, title,
              fittingSize(text, title, 1.55 * sizes.unit, room), SHEET_INK);
    const std::string subtitle = subtitleOf(request, moments, words);
    text.draw(sheet, sizes.margin, 3.8 * sizes.unit, subtitle,
              fittingSize(text, subtitle, sizes.unit, room), QUIET);
    drawLegend(sheet, sizes, sizes.head + map.height + static_cast<int>(sizes.unit), request,
               moments, text);
    if (request.is_plan) {
        const double radius = 1.1 * sizes.unit;
        drawNorth(sheet, sizes.margin + map.width - 1.8 * radius, 2.6 * sizes.unit, radius,
                  request.site.north_deg, text);
    }
    return sheet;
}

} // namespace quarn
