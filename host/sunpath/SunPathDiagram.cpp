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

/// At most two digits behind the point.
std::string degreesText(double degrees) {
    std::array<char, 32> text;
    const double rounded = std::round(degrees * 100) / 100;
    const char* const end = std::to_chars(text.data(), text.data() + text.size(), rounded).ptr;
    return std::string(static_cast<const char*>(text.data()), end) + "°";
}

std::string siteText(const SunSite& site) {
    return degreesText(std::abs(site.latitude_deg)) + (site.latitude_deg < 0 ? " S, " : " N, ") +
           degreesText(std::abs(site.longitude_deg)) + (site.longitude_deg < 0 ? " W" : " E");
}

void addHeading(const SunPathWish& wish, Drawing& drawing) {
    const std::string place = wish.place.empty() ? siteText(wish.site) : wish.place;
    drawing.title = "Sun path of " + place + ", " + std::to_string(wish.clock.year);
    drawing.shapes.push_back(
        DrawnText{{LEFT_PX, 58}, "Sun path: " + place, 28, TextAnchor::start, true});
    drawing.shapes.push_back(DrawnText{{LEFT_PX, 86},
                                       (wish.place.empty() ? "" : siteText(wish.site) + " · ") +
                                           std::to_string(wish.clock.year) +
                                           " · hours of standard time, " + wish.clock_name,
                                       16});
}

/// Where north is in the model: its Y axis beside north.
void addNorthArrow(double north_deg, Drawing& drawing) {
    const SkyDisk compass{SkyProjection::orthographic, {drawing.width_px - 90, 78}, 34};
    const auto arrow = [&](double azimuth_deg, double width_px, const char* name) {
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
    if (std::remainder(north_deg, 360) != 0)
        arrow(-north_deg, 1, "Y");
    arrow(0, 2, std::remainder(north_deg, 360) != 0 ? "N" : "N, Y");
}

/// "Nov, Dec": the months on whose 21st the sun stays below the horizon.
std::string darkMonths(const YearOfPaths& year) {
    std::string names;
    for (std::size_t month = 0; month < year.days.size(); ++month)
        if (year.days[month].empty())
            names += (names.empty() ? "" : ", ") + std::string(MONTH_NAMES[month]);
    return names;
}

std::vector<std::string> notesOf(const SunPathWish& wish, const YearOfPaths& year) {
    std::vector<std::string> notes = {
        "The sun's centre, without refraction, on the 21st of each month and at each whole hour of "
        "standard time (loops).",
        "Full lines: December to June. Dashed lines: July to November."};
    if (const std::string dark = darkMonths(year); !dark.empty())
        notes[1] += " The sun does not rise on the 21st of: " + dark + ".";
    if (!wish.clock_note.empty())
        notes.push_back(wish.clock_note);
    if (wish.point)
        notes.push_back("Grey: what hides the sky from " + wish.point->name +
                        ". Glass hides nothing.");
    if (wish.north_deg && *wish.north_deg != 0)
        notes.push_back("North lies " + degreesText(std::abs(*wish.north_deg)) +
                        (*wish.north_deg < 0 ? " anticlockwise" : " clockwise") +
                        " from the model's Y axis, as seen from above.");
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

const char* nameOf(SkyProjection projection) {
    return projection == SkyProjection::stereographic ? "stereographic" : "orthographic";
}

void addPanel(const SunPathWish& wish, const YearOfPaths& year, const SkyDisk& disk,
              Drawing& drawing) {
    const std::string name = nameOf(disk.projection);
    DiskParts parts(disk, name, drawing);
    parts.addSky();
    if (wish.point)
        parts.addHidden(wish.point->obstruction);
    parts.addRings();
    parts.addLoops(year);
    parts.addDays(year);
    parts.addAltitudes(wish.site);
    parts.addHours(year, wish.site);
    parts.addCompass();
    drawing.shapes.push_back(DrawnText{.place = {disk.middle.x_px, NAME_Y_PX},
                                       .text = name + " projection",
                                       .size_px = 15,
                                       .anchor = TextAnchor::middle});
}

} // namespace

Drawing sunPathDiagram(const SunPathWish& wish) {
    const YearOfPaths year = pathsOfYear(wish.site, wish.clock);
    const std::vector<std::string> notes = notesOf(wish, year);
    Drawing drawing;
    drawing.width_px = PANEL_PX * static_cast<double>(wish.projections.size());
    drawing.height_px =
        std::max(HEIGHT_PX, NOTES_Y_PX + NOTE_STEP_PX * static_cast<double>(notes.size()) + 12);
    addHeading(wish, drawing);
    if (wish.north_deg)
        addNorthArrow(*wish.north_deg, drawing);
    double middle_px = PANEL_PX / 2;
    for (const SkyProjection projection : wish.projections) {
        addPanel(wish, year, {projection, {middle_px, MIDDLE_Y_PX}, RADIUS_PX}, drawing);
        middle_px += PANEL_PX;
    }
    addNotes(notes, drawing);
    return drawing;
}

} // namespace quarn
