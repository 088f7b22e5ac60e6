#pragma once

#include "examples/pavilion/Roofs.h"
#include "examples/pavilion/Walls.h"

/// The pavilion: a stepped base, sixteen columns around a walled room, a tiled hip roof and a dome.
namespace temple {

constexpr Vec centre{0.0, 3.0, 0.0};
constexpr double floor_height = 0.54;
constexpr double column_height = 4.2;
constexpr double beam_foot = floor_height + column_height;
constexpr double half_width = 5.7; ///< of the rectangle of column axes, along x
constexpr double half_depth = 3.7; ///< along y
constexpr double shaft_radius = 0.32;

/// Where the columns stand.
inline std::vector<Vec> columnFeet() {
    std::vector<Vec> feet;
    constexpr int along_front = 6;
    constexpr int along_side = 4;
    for (int i = 0; i < along_front; ++i) {
        for (int j = 0; j < along_side; ++j) {
            if (i == 0 || i == along_front - 1 || j == 0 || j == along_side - 1) {
                feet.push_back(centre + Vec{-half_width + 2.0 * half_width * i / (along_front - 1),
                                            -half_depth + 2.0 * half_depth * j / (along_side - 1),
                                            floor_height});
            }
        }
    }
    return feet;
}

inline void addCentredBox(ModelWriter& model, double half_x, double half_y, double low, double high,
                          double chamfer) {
    addBox(model, centre + Vec{-half_x, -half_y, low}, centre + Vec{half_x, half_y, high}, chamfer);
}

inline void addBase(ModelWriter& model) {
    model.beginObject("Steps", "stone_light");
    for (int step = 0; step < 3; ++step) {
        const double out = 0.75 + 0.38 * (2 - step);
        addCentredBox(model, half_width + out, half_depth + out, step == 0 ? 0.0 : 0.18 * step,
                      0.18 * (step + 1), 0.015);
    }
    model.beginObject("Pavilion floor", "paving_warm");
    for (int i = -7; i < 7; ++i) {
        for (int j = -5; j < 5; ++j) {
            const double x = i * 0.86;
            const double y = j * 0.82;
            addBox(model, centre + Vec{x + 0.015, y + 0.015, floor_height - 0.05},
                   centre + Vec{x + 0.845, y + 0.805, floor_height + 0.012}, 0.008);
        }
    }
}

inline void addColumn(ModelWriter& model, const Vec& foot) {
    addBox(model, foot + Vec{-0.46, -0.46, 0.0}, foot + Vec{0.46, 0.46, 0.14}, 0.012);
    std::vector<ProfilePoint> profile{{0.44, 0.14, true}};
    appendArc(profile, 0.36, 0.22, 0.08, -90.0, 90.0, 8); // the lower torus
    profile.push_back({0.355, 0.33, true});
    appendArc(profile, 0.345, 0.375, 0.045, -90.0, 90.0, 6); // the upper torus
    profile.push_back({shaft_radius + 0.015, 0.45, true});
    constexpr int shaft_steps = 14;
    const double shaft_top = column_height - 0.52;
    for (int i = 0; i <= shaft_steps; ++i) {
        const double t = static_cast<double>(i) / shaft_steps;
        const double entasis = 0.045 * std::pow(std::max(0.0, t - 0.25) / 0.75, 1.6);
        profile.push_back(
            {shaft_radius - entasis, 0.48 + (shaft_top - 0.48) * t, i == 0 || i == shaft_steps});
    }
    appendArc(profile, shaft_radius - 0.03, shaft_top + 0.04, 0.035, -90.0, 90.0, 6); // a ring
    profile.push_back({shaft_radius - 0.05, shaft_top + 0.16, true});
    constexpr int echinus_steps = 7;
    for (int i = 1; i <= echinus_steps; ++i) {
        const double a = 0.5 * std::numbers::pi * i / echinus_steps;
        profile.push_back({shaft_radius - 0.05 + 0.18 * std::sin(a),
                           shaft_top + 0.16 + 0.18 * (1.0 - std::cos(a)), i == echinus_steps});
    }
    addTurned(model, foot, profile, 40);
    addBox(model, foot + Vec{-0.48, -0.48, shaft_top + 0.34}, foot + Vec{0.48, 0.48, column_height},
           0.015);
}

inline void addEntablature(ModelWriter& model) {
    model.beginObject("Beams", "stone_light");
    const auto ring = [&](double half, double low, double high) {
        const double x = half_width + half;
        const double y = half_depth + half;
        addCentredBox(model, x, y, low, high, 0.012);
    };
    ring(0.36, beam_foot, beam_foot + 0.26);
    ring(0.40, beam_foot + 0.26, beam_foot + 0.50);
    ring(0.52, beam_foot + 0.50, beam_foot + 0.58);
    ring(0.30, beam_foot + 0.58, beam_foot + 0.95); // closes the roof behind the rafters
    model.beginObject("Rafters", "wood_dark");
    const double z = beam_foot + 0.58;
    for (int i = -12; i <= 12; ++i) {
        for (const double side : {-1.0, 1.0}) {
            const Vec at = centre + Vec{i * 0.5, side * (half_depth + 0.65), z};
            addBox(model, at + Vec{-0.06, -0.25, 0.0}, at + Vec{0.06, 0.25, 0.12});
        }
    }
    for (int j = -8; j <= 8; ++j) {
        for (const double side : {-1.0, 1.0}) {
            const Vec at = centre + Vec{side * (half_width + 0.65), j * 0.5, z};
            addBox(model, at + Vec{-0.25, -0.06, 0.0}, at + Vec{0.25, 0.06, 0.12});
        }
    }
}

constexpr double eave_height = beam_foot + 0.70;
constexpr double eave_x = half_width + 1.05;
constexpr double eave_y = half_depth + 1.05;
constexpr double roof_rise = 2.2;

inline void addRoof(ModelWriter& model) {
    const double slope = std::hypot(eave_y, roof_rise);
    const Vec origin = centre + Vec{0.0, 0.0, eave_height};
    struct Side {
        Vec along;
        double half_length;
        double half_depth;
    };
    const Side sides[] = {{{1, 0, 0}, eave_x, eave_y},
                          {{0, 1, 0}, eave_y, eave_x},
                          {{-1, 0, 0}, eave_x, eave_y},
                          {{0, -1, 0}, eave_y, eave_x}};
    const double ridge_x = eave_x - eave_y; // all slopes are equally steep
    std::vector<RoofSlope> slopes;
    for (const Side& side : sides) {
        const Vec inward = cross({0, 0, 1}, side.along);
        const Vec up = unit(inward * eave_y + Vec{0, 0, roof_rise});
        slopes.push_back({origin - side.along * side.half_length - inward * side.half_depth,
                          side.along, up, 2.0 * side.half_length, slope, eave_y, eave_y});
    }
    model.beginObject("Pavilion roof", "terracotta");
    for (const RoofSlope& s : slopes) {
        addTiles(model, s);
    }
    model.beginObject("Pavilion eaves", "wood_dark");
    for (const RoofSlope& s : slopes) {
        addSoffit(model, s, 0.10);
    }
    model.beginObject("Pavilion ridges", "terracotta_dark");
    const Vec lift{0.0, 0.0, 0.06};
    const Vec top = origin + Vec{0.0, 0.0, roof_rise} + lift;
    for (const double x : {-1.0, 1.0}) {
        for (const double y : {-1.0, 1.0}) {
            addBar(model, origin + lift + Vec{x * eave_x, y * eave_y, 0.0},
                   top + Vec{x * ridge_x, 0.0, 0.0}, 0.11, 14);
        }
    }
    addBar(model, top - Vec{ridge_x, 0.0, 0.0}, top + Vec{ridge_x, 0.0, 0.0}, 0.12, 14);
}

inline void addDome(ModelWriter& model) {
    const Vec foot = centre + Vec{0.0, 0.0, eave_height + 1.0};
    model.beginObject("Drum", "stone_light");
    const ProfilePoint drum[] = {{1.85, 0.0, true},  {1.85, 0.75, true}, {1.72, 0.80, true},
                                 {1.72, 1.95, true}, {1.90, 2.05, true}, {1.96, 2.12, true},
                                 {1.96, 2.24, true}, {1.70, 2.30, true}};
    addTurned(model, foot, drum, 64);
    model.beginObject("Drum windows", "glass");
    constexpr int windows = 12;
    for (int i = 0; i < windows; ++i) {
        const double a = 2.0 * std::numbers::pi * (i + 0.5) / windows;
        const Vec out{std::cos(a), std::sin(a), 0.0};
        const Vec along = cross({0, 0, 1}, out);
        const WallFrame wall{foot + out * 1.735 - along * 0.22 + Vec{0, 0, 0.98}, along};
        addWallBlock(model, wall, {0.0, 0.44, 0.0, 0.80}, 0.0, 0.10);
    }
    model.beginObject("Dome", "copper");
    std::vector<ProfilePoint> dome;
    constexpr int steps = 18;
    for (int i = 0; i <= steps; ++i) {
        const double a = 0.5 * std::numbers::pi * i / steps;
        dome.push_back({i == steps ? 0.0 : 1.76 * std::cos(a), 2.28 + 1.76 * std::sin(a), i == 0});
    }
    addTurned(model, foot, dome, 64);
    for (int i = 0; i < windows; ++i) { // the ribs
        const double a = 2.0 * std::numbers::pi * i / windows;
        const Vec out{std::cos(a), std::sin(a), 0.0};
        for (int k = 0; k + 1 < steps; ++k) {
            addBar(model, foot + out * dome[k].radius + Vec{0, 0, dome[k].height},
                   foot + out * dome[k + 1].radius + Vec{0, 0, dome[k + 1].height}, 0.035, 8);
        }
    }
    model.beginObject("Finial", "brass");
    std::vector<ProfilePoint> finial{{0.22, 3.98, true}, {0.10, 4.14, true}};
    appendArc(finial, 0.0, 4.32, 0.19, -60.0, 90.0, 12);
    addTurned(model, foot, finial, 24);
    addBar(model, foot + Vec{0, 0, 4.45}, foot + Vec{0, 0, 5.0}, 0.025, 8);
}

constexpr double room_x = 3.4;      ///< half the room's width outside
constexpr double room_front = -1.6; ///< from the centre
constexpr double room_back = 2.0;
constexpr double wall_thickness = 0.35;

/// A wall of the room from both sides, with bars and glass in its openings but the first, which is
/// the doorway where `has_door`.
inline void addRoomWall(ModelWriter& model, const WallFrame& wall, double width,
                        std::span<const Opening> openings, bool has_door) {
    constexpr double height = column_height;
    model.beginObject("Room walls", "plaster_cream");
    addFacade(model, wall, width, height, openings, wall_thickness);
    std::vector<Opening> seen_from_inside;
    for (const Opening& o : openings) {
        seen_from_inside.push_back({width - o.right, width - o.left, o.bottom, o.top});
    }
    const WallFrame inside{wall.at(width, 0.0, wall_thickness), wall.along * -1.0};
    addFacade(model, inside, width, height, seen_from_inside, 0.0);
    for (std::size_t i = has_door ? 1 : 0; i < openings.size(); ++i) {
        const Opening& o = openings[i];
        model.beginObject("Room window bars", "wood_dark");
        addWindowBars(model, wall, o, 0.18);
        model.beginObject("Room sills", "stone_light");
        addWallBlock(model, wall, {o.left - 0.12, o.right + 0.12, o.bottom - 0.12, o.bottom}, -0.10,
                     0.30);
    }
    for (const Opening& o : openings) {
        model.beginObject("Room surrounds", "stone_light");
        const double w = 0.16;
        addWallBlock(model, wall, {o.left - w, o.left, o.bottom, o.top + w}, -0.05, 0.05);
        addWallBlock(model, wall, {o.right, o.right + w, o.bottom, o.top + w}, -0.05, 0.05);
        addWallBlock(model, wall, {o.left, o.right, o.top, o.top + w}, -0.05, 0.05);
    }
}

inline void addRoom(ModelWriter& model) {
    const double depth = room_back - room_front;
    const Vec foot = centre + Vec{0.0, 0.0, floor_height};
    const Opening front[] = {
        {2.55, 4.25, 0.0, 3.0}, {0.75, 1.75, 0.95, 2.75}, {5.05, 6.05, 0.95, 2.75}};
    const Opening back[] = {
        {0.75, 1.75, 0.95, 2.75}, {2.9, 3.9, 0.95, 2.75}, {5.05, 6.05, 0.95, 2.75}};
    const Opening side[] = {{0.65, 1.55, 0.95, 2.75}, {depth - 1.55, depth - 0.65, 0.95, 2.75}};
    addRoomWall(model, {foot + Vec{-room_x, room_front, 0}, {1, 0, 0}}, 2 * room_x, front, true);
    addRoomWall(model, {foot + Vec{room_x, room_back, 0}, {-1, 0, 0}}, 2 * room_x, back, false);
    addRoomWall(model, {foot + Vec{room_x, room_front, 0}, {0, 1, 0}}, depth, side, false);
    addRoomWall(model, {foot + Vec{-room_x, room_back, 0}, {0, -1, 0}}, depth, side, false);
}

inline void add(ModelWriter& model) {
    addBase(model);
    model.beginObject("Columns", "stone_warm");
    for (const Vec& foot : columnFeet()) {
        addColumn(model, foot);
    }
    addRoom(model);
    addEntablature(model);
    addRoof(model);
    addDome(model);
}

} // namespace temple
