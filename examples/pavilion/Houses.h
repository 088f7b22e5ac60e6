#pragma once

#include "examples/pavilion/Roofs.h"
#include "examples/pavilion/Walls.h"

#include <string>

/// The row of neighbouring houses in the corner behind the pavilion.
namespace houses {

struct House {
    std::string name;
    std::string plaster;
    std::string shutters;
    Vec low; ///< the corner with the smallest x and y, on the ground
    double size_x;
    double size_y;
    double eaves; ///< height of the walls
    double rise;  ///< of the ridge above them
    bool ridge_along_x;
    int door_side;            ///< 0 south, 1 east, 2 north, 3 west
    bool closed_side[4] = {}; ///< sides that stand against a neighbour
};

/// A side of a house: where its wall begins, seen from outside, and its length.
inline std::pair<WallFrame, double> sideOf(const House& h, int side) {
    const Vec corners[4] = {h.low, h.low + Vec{h.size_x, 0, 0}, h.low + Vec{h.size_x, h.size_y, 0},
                            h.low + Vec{0, h.size_y, 0}};
    const Vec along[4] = {{1, 0, 0}, {0, 1, 0}, {-1, 0, 0}, {0, -1, 0}};
    return {{corners[side], along[side]}, side % 2 == 0 ? h.size_x : h.size_y};
}

inline bool isGable(const House& h, int side) {
    return h.ridge_along_x == (side % 2 == 1);
}

inline void addShutters(ModelWriter& model, const WallFrame& wall, const Opening& o) {
    const double leaf = 0.5 * (o.right - o.left);
    for (const double left : {o.left - leaf - 0.02, o.right + 0.02}) {
        addWallBlock(model, wall, {left, left + leaf, o.bottom, o.top}, -0.05, 0.0);
        constexpr int slats = 9;
        for (int i = 0; i < slats; ++i) {
            const double z = o.bottom + 0.08 + (o.top - o.bottom - 0.16) * i / slats;
            addWallBlock(model, wall, {left + 0.06, left + leaf - 0.06, z, z + 0.07}, -0.075,
                         -0.05);
        }
    }
}

inline void addWindow(ModelWriter& model, const House& h, const WallFrame& wall, const Opening& o,
                      bool shutters) {
    model.beginObject(h.name + " window panes", "glass");
    addWallBlock(model, wall, o, 0.19, 0.22);
    model.beginObject(h.name + " window frames", "white");
    addWindowBars(model, wall, o, 0.15);
    model.beginObject(h.name + " sills", "stone_light");
    addWallBlock(model, wall, {o.left - 0.1, o.right + 0.1, o.bottom - 0.1, o.bottom}, -0.09, 0.15);
    if (shutters) {
        model.beginObject(h.name + " shutters", h.shutters);
        addShutters(model, wall, o);
    }
}

inline void addDoor(ModelWriter& model, const House& h, const WallFrame& wall, const Opening& o) {
    model.beginObject(h.name + " door", "wood_dark");
    addWallBlock(model, wall, o, 0.16, 0.22);
    const double middle = 0.5 * (o.left + o.right);
    for (const double left : {o.left + 0.08, middle + 0.04}) {
        for (const double bottom : {o.bottom + 0.15, o.bottom + 1.15}) {
            addWallBlock(model, wall, {left, left + 0.40, bottom, bottom + 0.8}, 0.13, 0.16);
        }
    }
    model.beginObject(h.name + " doorstep", "stone_light");
    addWallBlock(model, wall, {o.left - 0.25, o.right + 0.25, 0.0, 0.14}, -0.45, 0.2);
    for (const double left : {o.left - 0.16, o.right}) {
        addWallBlock(model, wall, {left, left + 0.16, 0.14, o.top}, -0.05, 0.0);
    }
    addWallBlock(model, wall, {o.left - 0.22, o.right + 0.22, o.top, o.top + 0.2}, -0.08, 0.0);
}

inline void addSide(ModelWriter& model, const House& h, int side) {
    const auto [wall, width] = sideOf(h, side);
    std::vector<Opening> windows;
    std::vector<Opening> doors;
    const int columns = std::max(1, static_cast<int>(width / 1.9));
    if (!h.closed_side[side]) {
        for (int i = 0; i < columns; ++i) {
            const double middle = width * (i + 0.5) / columns;
            const bool door = side == h.door_side && i == columns / 2;
            if (door) {
                doors.push_back({middle - 0.52, middle + 0.52, 0.14, 2.35});
            } else {
                windows.push_back({middle - 0.42, middle + 0.42, 0.95, 2.25});
            }
            windows.push_back({middle - 0.42, middle + 0.42, 3.35, 4.65});
        }
    }
    std::vector<Opening> openings = windows;
    openings.insert(openings.end(), doors.begin(), doors.end());
    model.beginObject(h.name + " walls", h.plaster);
    addFacade(model, wall, width, h.eaves, openings, 0.19);
    if (isGable(h, side)) {
        model.face({wall.at(0.0, h.eaves), wall.at(width, h.eaves),
                    wall.at(0.5 * width, h.eaves + h.rise)});
    }
    for (const Opening& o : windows) {
        addWindow(model, h, wall, o, 0.84 * 2.0 * columns < width);
    }
    for (const Opening& o : doors) {
        addDoor(model, h, wall, o);
    }
    model.beginObject(h.name + " plinth", "stone_dark");
    const double door_left = doors.empty() ? width : doors[0].left - 0.16;
    const double door_right = doors.empty() ? width : doors[0].right + 0.16;
    addWallBlock(model, wall, {0.0, door_left, 0.0, 0.45}, -0.05, 0.0);
    if (door_right < width) {
        addWallBlock(model, wall, {door_right, width, 0.0, 0.45}, -0.05, 0.0);
    }
}

inline void addRoof(ModelWriter& model, const House& h) {
    constexpr double overhang = 0.45;
    const double span = h.ridge_along_x ? h.size_y : h.size_x;
    const double length_along = h.ridge_along_x ? h.size_x : h.size_y;
    const Vec run = h.ridge_along_x ? Vec{1, 0, 0} : Vec{0, 1, 0};
    const Vec middle = h.low + Vec{0.5 * h.size_x, 0.5 * h.size_y, h.eaves};
    const double drop = overhang * h.rise / (0.5 * span);
    const double half_run = 0.5 * length_along + 0.18;
    std::vector<RoofSlope> slopes;
    for (const Vec& along : {run, run * -1.0}) {
        const Vec inward = cross({0, 0, 1}, along);
        const Vec eave =
            middle - along * half_run - inward * (0.5 * span + overhang) - Vec{0, 0, drop - 0.1};
        const Vec up = inward * (0.5 * span + overhang) + Vec{0, 0, h.rise + drop};
        slopes.push_back({eave, along, unit(up), 2.0 * half_run, length(up)});
    }
    model.beginObject(h.name + " roof", "terracotta");
    for (const RoofSlope& slope : slopes) {
        addTiles(model, slope);
    }
    model.beginObject(h.name + " roof boards", "wood_dark");
    for (const RoofSlope& slope : slopes) {
        addSoffit(model, slope, 0.12);
    }
    model.beginObject(h.name + " ridge", "terracotta_dark");
    const Vec top = middle + Vec{0, 0, h.rise + 0.17};
    addBar(model, top - run * half_run, top + run * half_run, 0.12, 14);
    for (const RoofSlope& slope : slopes) {
        for (const double end : {0.02, slope.eave_width - 0.02}) {
            addBar(model, slope.at(end, 0.0, 0.04), slope.at(end, slope.slope_length, 0.04), 0.085);
        }
    }
    model.beginObject(h.name + " chimney", h.plaster);
    const Vec stack = middle + run * (0.28 * length_along) + cross({0, 0, 1}, run) * (0.2 * span);
    addBox(model, stack + Vec{-0.35, -0.28, 0.2}, stack + Vec{0.35, 0.28, h.rise + 0.75});
    model.beginObject(h.name + " chimney cap", "terracotta_dark");
    addBox(model, stack + Vec{-0.43, -0.36, h.rise + 0.75}, stack + Vec{0.43, 0.36, h.rise + 0.87},
           0.02);
    for (const double x : {-0.17, 0.17}) {
        const ProfilePoint pot[] = {
            {0.13, 0.0, true}, {0.10, 0.35, true}, {0.12, 0.4, true}, {0.0, 0.4, true}};
        addTurned(model, stack + Vec{x, 0.0, h.rise + 0.87}, pot, 16);
    }
}

inline std::vector<House> row() {
    return {{"House by the gate",
             "plaster_ochre",
             "shutter_green",
             {-15.5, -3.6, 0},
             4.9,
             6.0,
             5.2,
             1.9,
             false,
             1,
             {false, false, true, false}},
            {"Rose house",
             "plaster_rose",
             "shutter_blue",
             {-15.5, 2.4, 0},
             5.1,
             5.4,
             6.0,
             2.3,
             true,
             1,
             {true, false, true, false}},
            {"Corner house",
             "plaster_cream",
             "shutter_green",
             {-15.5, 7.8, 0},
             6.6,
             7.7,
             5.5,
             2.6,
             false,
             1,
             {true, false, false, false}},
            {"Blue house",
             "plaster_blue",
             "white",
             {-8.9, 11.1, 0},
             4.9,
             4.4,
             6.2,
             2.1,
             false,
             0,
             {false, true, false, true}},
            {"Garden house",
             "plaster_ochre",
             "shutter_blue",
             {-4.0, 11.3, 0},
             6.4,
             4.2,
             5.0,
             1.9,
             true,
             0,
             {false, false, false, true}}};
}

inline void add(ModelWriter& model) {
    for (const House& house : row()) {
        for (int side = 0; side < 4; ++side) {
            addSide(model, house, side);
        }
        addRoof(model, house);
    }
}

} // namespace houses
