#include "host/sunpath/SunPathDiagram.h"

#include "host/sunpath/DiskParts.h"

#include <array>
#include <charconv>
#include <cmath>

namespace quarn {
namespace {

constexpr double PANEL_PX = 1000;
constexpr double HEIGHT_PX = 1180;
constexpr double RADIUS_PX = 360;
constexpr double MIDDLE_Y_PX = 590;
constexpr double LEFT_PX = 60;
constexpr double NAME_Y_PX = 1085;
constexpr double NOTES_Y_PX = 1110;
constexpr double NOTE_STEP_PX = 19;
constexpr double NOTE_SIZE_PX = 13.5;

constexpr SheetText TITLE{L"Sun path: %1", 43414};
constexpr SheetText HOURS{L"hours of standard time, %1", 43415};
constexpr SheetText SUN_NOTE{
    L"The sun's centre, without refraction, on the 21st of each month and at "
    L"each whole hour of standard time (loops).",
    43416};
constexpr SheetText LINES_NOTE{L"Full lines: December to June. Dashed lines: July to November.",
                               43417};
constexpr SheetText DARK_NOTE{L"The sun does not rise on the 21st of: %1.", 43418};
constexpr SheetText HOUR_MORE{L"While summer time is kept (%1) clocks show one hour more.", 43419};
constexpr SheetText MINUTES_MORE{L"While summer time is kept (%1) clocks show %2 minutes more.",
                                 43420};
constexpr SheetText POINT_NOTE{
    L"Grey: what hides the sky from the point %1 of %2. Glass hides nothing.", 43421};
constexpr SheetText OBJECT_NOTE{L"Grey: what hides the sky from \"%1\" of %2. Glass hides nothing.",
                                43422};
constexpr SheetText NORTH_CLOCKWISE{
    L"North lies %1 clockwise from the model's Y axis, as seen from above.", 43423};
constexpr SheetText NORTH_ANTICLOCKWISE{
    L"North lies %1 anticlockwise from the model's Y axis, as seen from above.", 43424};
constexpr SheetText STEREOGRAPHIC{L"stereographic projection", 43425};
constexpr SheetText ORTHOGRAPHIC{L"orthographic projection", 43426};

/// At most two digits behind the point.
std::string degreesText(double degrees) {
    std::array<char, 32> text;
    const double rounded = std::round(degrees * 100) / 100;
    const char* const end = std::to_chars(text.data(), text.data() + text.size(), rounded).ptr;
    return std::string(static_cast<const char*>(text.data()), end) + "°";
}

std::string siteText(const SunSite& site, const SheetWords& words) {
    return degreesText(std::abs(site.latitude_deg)) + " " +
           words.quarter(site.latitude_deg < 0 ? SOUTH : NORTH) + ", " +
           degreesText(std::abs(site.longitude_deg)) + " " +
           words.quarter(site.longitude_deg < 0 ? WEST : EAST);
}

void addHeading(const SunPathWish& wish, const SheetWords& words, Drawing& drawing) {
    const std::string site = siteText(wish.site, words);
    const std::string year = std::to_string(wish.clock.year);
    const std::string title = words(TITLE, {wish.place.empty() ? site : wish.place});
    drawing.title = title + ", " + year;
    drawing.shapes.push_back(DrawnText{{LEFT_PX, 58}, title, 28, TextAnchor::start, true});
    drawing.shapes.push_back(DrawnText{{LEFT_PX, 86},
                                       (wish.place.empty() ? "" : site + " · ") + year + " · " +
                                           words(HOURS, {wish.clock_name}),
                                       16});
}

/// Where north is in the model: its Y axis beside north.
void addNorthArrow(double north_deg, const SheetWords& words, Drawing& drawing) {
    const SkyDisk compass{SkyProjection::orthographic, {drawing.width_px - 90, 78}, 34};
    const auto arrow = [&](double azimuth_deg, double width_px, const std::string& name) {
        const DrawnPoint tip = compass.onRim(azimuth_deg);
        drawing.shapes.push_back(DrawnPath{.lines = {{compass.middle, tip},
                                                     {compass.onRim(azimuth_deg - 14, -10), tip,
                                                      compass.onRim(azimuth_deg + 14, -10)}},
                                           .stroke = DrawnStroke{.width_px = width_px}});
        const DrawnPoint place = compass.onRim(azimuth_deg, 11);
        drawing.shapes.push_back(DrawnText{.place = {place.x_px, place.y_px + 5},
                                           .text = name,
                                           .size_px = 14,
                                           .anchor = TextAnchor::middle,
                                           .is_bold = width_px > 1,
                                           .has_halo = true});
    };
    const bool is_turned = std::remainder(north_deg, 360) != 0;
    if (is_turned)
        arrow(-north_deg, 1, "Y");
    arrow(0, 2, words.quarter(NORTH) + (is_turned ? "" : ", Y"));
}

/// "Nov, Dec": the months on whose 21st the sun stays below the horizon.
std::string darkMonths(const YearOfPaths& year, const SheetWords& words) {
    std::string names;
    for (std::size_t month = 0; month < year.days.size(); ++month)
        if (year.days[month].empty())
            names += (names.empty() ? "" : ", ") + words.month(monthAt(month));
    return names;
}

std::string clockNote(const SummerTime& summer, const SheetWords& words) {
    if (summer.ahead == std::chrono::hours(1))
        return words(HOUR_MORE, {summer.name});
    return words(MINUTES_MORE, {summer.name, std::to_string(summer.ahead.count())});
}

std::vector<std::string> notesOf(const SunPathWish& wish, const YearOfPaths& year,
                                 const SheetWords& words) {
    std::vector<std::string> notes = {words(SUN_NOTE), words(LINES_NOTE)};
    if (const std::string dark = darkMonths(year, words); !dark.empty())
        notes.push_back(words(DARK_NOTE, {dark}));
    if (wish.summer_time)
        notes.push_back(clockNote(*wish.summer_time, words));
    if (wish.point)
        notes.push_back(words(wish.point->is_object ? OBJECT_NOTE : POINT_NOTE,
                              {wish.point->name, wish.point->model}));
    if (wish.north_deg && *wish.north_deg != 0)
        notes.push_back(words(*wish.north_deg < 0 ? NORTH_ANTICLOCKWISE : NORTH_CLOCKWISE,
                              {degreesText(std::abs(*wish.north_deg))}));
    return notes;
}

void addNotes(const std::vector<std::string>& notes, Drawing& drawing) {
    double y_px = NOTES_Y_PX;
    for (const std::string& note : notes) {
        drawing.shapes.push_back(
            DrawnText{.place = {LEFT_PX, y_px}, .text = note, .size_px = NOTE_SIZE_PX});
        y_px += NOTE_STEP_PX;
    }
}

void addPanel(const SunPathWish& wish, const YearOfPaths& year, const SkyDisk& disk,
              const SheetWords& words, Drawing& drawing) {
    const bool is_stereographic = disk.projection == SkyProjection::stereographic;
    DiskParts parts(disk, is_stereographic ? "stereographic" : "orthographic", words, drawing);
    parts.addSky();
    if (wish.point)
        parts.addHidden(wish.point->obstruction);
    parts.addRings();
    parts.addLoops(year);
    parts.addDays(year);
    parts.addAltitudes(wish.site);
    parts.addHours(year, wish.site);
    parts.addCompass();
    drawing.shapes.push_back(
        DrawnText{.place = {disk.middle.x_px, NAME_Y_PX},
                  .text = words(is_stereographic ? STEREOGRAPHIC : ORTHOGRAPHIC),
                  .size_px = 15,
                  .anchor = TextAnchor::middle});
}

} // namespace

Drawing sunPathDiagram(const SunPathWish& wish, const SheetWords& words) {
    const YearOfPaths year = pathsOfYear(wish.site, wish.clock);
    const std::vector<std::string> notes = notesOf(wish, year, words);
    Drawing drawing;
    drawing.width_px = PANEL_PX * static_cast<double>(wish.projections.size());
    drawing.height_px =
        std::max(HEIGHT_PX, NOTES_Y_PX + NOTE_STEP_PX * static_cast<double>(notes.size()) + 12);
    addHeading(wish, words, drawing);
    if (wish.north_deg)
        addNorthArrow(*wish.north_deg, words, drawing);
    double middle_px = PANEL_PX / 2;
    for (const SkyProjection projection : wish.projections) {
        addPanel(wish, year, {projection, {middle_px, MIDDLE_Y_PX}, RADIUS_PX}, words, drawing);
        middle_px += PANEL_PX;
    }
    addNotes(notes, drawing);
    return drawing;
}

} // namespace quarn
