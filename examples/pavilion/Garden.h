#pragma once

#include "examples/pavilion/Shapes.h"
#include "examples/pavilion/Temple.h"

/// The ground with its paving and lawns, and what stands there: basin, trees, benches, lamps,
/// walls.
namespace garden {

constexpr double half_size = 16.0;
constexpr Vec basin{0.0, -8.2, 0.0};
constexpr double basin_radius = 2.8;

struct Area {
    double x0, x1, y0, y1;
    bool contains(double x, double y) const { return x > x0 && x < x1 && y > y0 && y < y1; }
};

inline std::vector<Area> lawns() {
    return {{8.6, 15.2, -3.8, 15.2},
            {5.2, 15.2, -15.2, -4.6},
            {-15.2, -5.2, -15.2, -5.2},
            {3.2, 8.6, 11.6, 15.2}};
}

inline void addGround(ModelWriter& model) {
    model.beginObject("Plinth", "stone_dark");
    addBox(model, {-half_size, -half_size, -0.55}, {half_size, half_size, -0.03}, 0.04);
    model.beginObject("Lawns", "grass");
    for (const Area& lawn : lawns()) {
        addBox(model, {lawn.x0, lawn.y0, -0.03}, {lawn.x1, lawn.y1, 0.07}, 0.02);
    }
    model.beginObject("Kerbs", "stone_light");
    constexpr double w = 0.16;
    for (const Area& lawn : lawns()) {
        addBox(model, {lawn.x0 - w, lawn.y0 - w, -0.03}, {lawn.x1 + w, lawn.y0, 0.12}, 0.015);
        addBox(model, {lawn.x0 - w, lawn.y1, -0.03}, {lawn.x1 + w, lawn.y1 + w, 0.12}, 0.015);
        addBox(model, {lawn.x0 - w, lawn.y0, -0.03}, {lawn.x0, lawn.y1, 0.12}, 0.015);
        addBox(model, {lawn.x1, lawn.y0, -0.03}, {lawn.x1 + w, lawn.y1, 0.12}, 0.015);
    }
}

inline bool isPaved(double x, double y, double half_tile) {
    for (const Area& lawn : lawns()) {
        if (lawn.contains(x, y)) {
            return false;
        }
    }
    const Vec& c = temple::centre;
    const bool under_pavilion = std::abs(x - c.x) < temple::half_width + 1.4 - half_tile &&
                                std::abs(y - c.y) < temple::half_depth + 1.4 - half_tile;
    const bool under_basin = std::hypot(x - basin.x, y - basin.y) < basin_radius - half_tile;
    return !under_pavilion && !under_basin;
}

/// What fills the joints of the paving.
inline void addPavingBed(ModelWriter& model) {
    model.beginObject("Paving bed", "mortar");
    addBox(model, {-15.6, -15.6, -0.035}, {15.6, 15.6, -0.009});
}

/// Tiles of three tones: rings around the basin, a grid with darker bands elsewhere.
inline void addPaving(ModelWriter& model) {
    constexpr int count = 40;
    constexpr double tile = 2.0 * 15.6 / count;
    const char* const tones[] = {"paving_light", "paving_warm", "paving_dark"};
    for (int tone = 0; tone < 3; ++tone) {
        model.beginObject(std::string("Paving ") + std::to_string(tone + 1), tones[tone]);
        for (int i = 0; i < count; ++i) {
            for (int j = 0; j < count; ++j) {
                const double x = -15.6 + (i + 0.5) * tile;
                const double y = -15.6 + (j + 0.5) * tile;
                const double ring = std::hypot(x - basin.x, y - basin.y);
                const bool band = i % 5 == 0 || j % 5 == 0;
                const int plain = scattered(static_cast<unsigned>(97 * i + j)) < 0.3 ? 1 : 0;
                const int own = ring < 5.2 ? (ring > 4.3 ? 2 : 1) : band ? 2 : plain;
                if (own != tone || !isPaved(x, y, 0.5 * tile)) {
                    continue;
                }
                const double h = 0.5 * tile - 0.012;
                addBox(model, {x - h, y - h, -0.04}, {x + h, y + h, 0.0}, 0.008);
            }
        }
    }
}

inline void addBasin(ModelWriter& model) {
    model.beginObject("Basin", "stone_light");
    std::vector<ProfilePoint> rim{{basin_radius, 0.0, true}, {basin_radius, 0.34, true}};
    appendArc(rim, basin_radius - 0.02, 0.42, 0.08, -90.0, 90.0, 8);
    rim.push_back({basin_radius - 0.34, 0.50, true});
    rim.push_back({basin_radius - 0.36, 0.0, true});
    addTurned(model, basin, rim, 72);
    std::vector<ProfilePoint> bowl{{0.55, 0.0, true},   {0.55, 0.36, true},  {0.30, 0.42, true},
                                   {0.20, 0.60, false}, {0.17, 0.95, false}, {0.24, 1.15, true},
                                   {0.95, 1.38, false}, {1.02, 1.45, true},  {0.98, 1.48, true},
                                   {0.60, 1.40, true}};
    addTurned(model, basin, bowl, 48);
    std::vector<ProfilePoint> jet{{0.16, 1.36, true}, {0.11, 1.6, false}, {0.08, 1.8, true}};
    appendArc(jet, 0.0, 1.9, 0.12, -50.0, 90.0, 8);
    addTurned(model, basin, jet, 24);
    model.beginObject("Water", "water");
    const ProfilePoint low_water[] = {{basin_radius - 0.36, 0.36, true}, {0.55, 0.36, true}};
    addTurned(model, basin, low_water, 72);
    const ProfilePoint high_water[] = {{0.96, 1.44, true}, {0.0, 1.44, true}};
    addTurned(model, basin, high_water, 48);
}

inline void addTree(ModelWriter& model, const std::string& name, const Vec& foot, double height,
                    unsigned seed) {
    model.beginObject(name + " trunk", "bark");
    const double fork = 0.42 * height;
    const ProfilePoint trunk[] = {
        {0.30, 0.0, true}, {0.20, 0.12 * height, false}, {0.16, fork, true}};
    addTurned(model, foot, trunk, 18);
    struct Branch {
        Vec tip;
        double size;
    };
    std::vector<Branch> branches{{{0.0, 0.0, 0.78 * height}, 0.25 * height}};
    constexpr int around = 5;
    for (unsigned i = 0; i < around; ++i) {
        const double a = 2.0 * std::numbers::pi * (i + 0.4 * scattered(seed + i)) / around;
        const double out = height * (0.17 + 0.05 * scattered(seed + 10 + i));
        const double up = height * (0.53 + 0.12 * scattered(seed + 20 + i));
        branches.push_back({{out * std::cos(a), out * std::sin(a), up},
                            height * (0.19 + 0.04 * scattered(seed + 30 + i))});
    }
    constexpr int above = 4;
    for (unsigned i = 0; i < above; ++i) {
        const double a =
            2.0 * std::numbers::pi * (i + 0.5 + 0.3 * scattered(seed + 50 + i)) / above;
        const double out = height * (0.13 + 0.03 * scattered(seed + 60 + i));
        const double up = height * (0.71 + 0.06 * scattered(seed + 70 + i));
        branches.push_back({{out * std::cos(a), out * std::sin(a), up},
                            height * (0.13 + 0.03 * scattered(seed + 80 + i))});
    }
    for (const Branch& branch : branches) {
        addBar(model, foot + Vec{0, 0, fork - 0.05}, foot + branch.tip, 0.07);
    }
    const char* const greens[] = {"leaves_deep", "leaves", "leaves_light"};
    for (std::size_t tone = 0; tone < 3; ++tone) {
        model.beginObject(name + " crown " + std::to_string(tone + 1), greens[tone]);
        for (std::size_t i = tone; i < branches.size(); i += 3) {
            const double s = branches[i].size;
            addBlob(model, foot + branches[i].tip, {s, s, 0.82 * s},
                    seed + 40 + static_cast<unsigned>(i), 0.08);
        }
    }
}

inline void addCypress(ModelWriter& model, const std::string& name, const Vec& foot, double height,
                       unsigned seed) {
    model.beginObject(name, "cypress");
    addBar(model, foot, foot + Vec{0, 0, 0.6}, 0.12);
    addBlob(model, foot + Vec{0, 0, 0.36 * height}, {0.62, 0.62, 0.32 * height}, seed, 0.07);
    addBlob(model, foot + Vec{0, 0, 0.64 * height}, {0.50, 0.50, 0.30 * height}, seed + 1, 0.07);
    addBlob(model, foot + Vec{0, 0, 0.84 * height}, {0.28, 0.28, 0.20 * height}, seed + 2, 0.07);
}

/// A bench whose seat runs along x or along y.
inline void addBench(ModelWriter& model, const std::string& name, const Vec& at, bool along_x) {
    const auto box = [&](const Vec& a, const Vec& b) {
        along_x ? addBox(model, at + a, at + b, 0.01)
                : addBox(model, at + Vec{a.y, a.x, a.z}, at + Vec{b.y, b.x, b.z}, 0.01);
    };
    model.beginObject(name + " feet", "stone_light");
    for (const double x : {-0.75, 0.75}) {
        box({x - 0.11, -0.24, 0.0}, {x + 0.11, 0.24, 0.40});
    }
    model.beginObject(name + " seat", "wood");
    for (int i = 0; i < 4; ++i) {
        const double y = -0.26 + 0.135 * i;
        box({-1.05, y, 0.40}, {1.05, y + 0.115, 0.46});
    }
}

inline void addLamp(ModelWriter& model, const std::string& name, const Vec& foot) {
    model.beginObject(name + " post", "iron");
    std::vector<ProfilePoint> post{
        {0.20, 0.0, true}, {0.20, 0.12, true}, {0.12, 0.22, true}, {0.09, 0.80, true}};
    appendArc(post, 0.075, 0.85, 0.05, -90.0, 90.0, 6);
    post.insert(post.end(), {{0.055, 0.95, true},
                             {0.04, 3.0, true},
                             {0.09, 3.08, true},
                             {0.15, 3.14, true},
                             {0.15, 3.17, true},
                             {0.0, 3.17, true}});
    addTurned(model, foot, post, 20);
    const ProfilePoint hat[] = {{0.0, 3.60, true},   {0.25, 3.60, true}, {0.25, 3.64, true},
                                {0.12, 3.78, false}, {0.05, 3.86, true}, {0.0, 3.95, true}};
    addTurned(model, foot, hat, 20);
    for (int i = 0; i < 4; ++i) {
        const double a = 0.5 * std::numbers::pi * (i + 0.5);
        const Vec out{std::cos(a), std::sin(a), 0.0};
        addBar(model, foot + out * 0.13 + Vec{0, 0, 3.17}, foot + out * 0.22 + Vec{0, 0, 3.61},
               0.015, 6);
    }
    model.beginObject(name + " glass", "lamp");
    const ProfilePoint glass[] = {{0.115, 3.17, true}, {0.20, 3.60, true}};
    addTurned(model, foot, glass, 20);
}

/// A low wall with a coping between two places, and its end piers with balls.
inline void addGardenWall(ModelWriter& model, const std::string& name, const Vec& from,
                          const Vec& to) {
    const Vec low{std::min(from.x, to.x), std::min(from.y, to.y), -0.03};
    const Vec high{std::max(from.x, to.x), std::max(from.y, to.y), 0.0};
    model.beginObject(name, "stone_warm");
    addBox(model, low + Vec{-0.14, -0.14, 0}, high + Vec{0.14, 0.14, 0.72});
    for (const Vec& pier : {from, to}) {
        addBox(model, pier + Vec{-0.26, -0.26, -0.03}, pier + Vec{0.26, 0.26, 1.0});
    }
    model.beginObject(name + " coping", "stone_light");
    addBox(model, {low.x - 0.2, low.y - 0.2, 0.72}, high + Vec{0.2, 0.2, 0.82}, 0.02);
    for (const Vec& pier : {from, to}) {
        addBox(model, pier + Vec{-0.32, -0.32, 1.0}, pier + Vec{0.32, 0.32, 1.1}, 0.02);
        std::vector<ProfilePoint> ball{{0.12, 1.1, true}, {0.10, 1.16, true}};
        appendArc(ball, 0.0, 1.37, 0.22, -70.0, 90.0, 14);
        addTurned(model, pier, ball, 28);
    }
}

inline void addHedge(ModelWriter& model, const Vec& low, const Vec& high) {
    addBox(model, low, high, 0.10);
}

inline void add(ModelWriter& model) {
    addGround(model);
    addPavingBed(model);
    addPaving(model);
    addBasin(model);
    addGardenWall(model, "South wall west", {-15.5, -15.5, 0}, {-2.2, -15.5, 0});
    addGardenWall(model, "South wall east", {2.2, -15.5, 0}, {15.5, -15.5, 0});
    addGardenWall(model, "East wall", {15.5, -15.5, 0}, {15.5, 15.5, 0});
    addTree(model, "Plane tree", {11.8, 10.2, 0.05}, 7.6, 11);
    addTree(model, "Lime tree", {12.2, 1.4, 0.05}, 6.4, 23);
    addTree(model, "Maple", {10.6, -10.4, 0.05}, 7.0, 37);
    addTree(model, "Elm", {-10.8, -10.6, 0.05}, 6.8, 53);
    const Vec cypresses[] = {{6.3, -6.0, 0.05},
                             {6.3, -13.6, 0.05},
                             {-6.3, -6.6, 0.05},
                             {-6.3, -13.6, 0.05},
                             {6.4, 13.4, 0.05}};
    unsigned seed = 70;
    for (const Vec& foot : cypresses) {
        addCypress(model, "Cypress", foot, 5.4 + 0.7 * scattered(seed), seed);
        seed += 3;
    }
    addBench(model, "West bench", {-4.7, -8.2, 0}, false);
    addBench(model, "East bench", {4.7, -8.2, 0}, false);
    addBench(model, "Street bench", {-9.6, 5.2, 0}, false);
    for (const Vec& foot : {Vec{-3.7, -4.0, 0}, Vec{3.7, -4.0, 0}, Vec{-8.3, 9.6, 0},
                            Vec{-8.6, -4.4, 0}, Vec{8.2, 9.9, 0}}) {
        addLamp(model, "Street lamp", foot);
    }
    model.beginObject("Hedges", "hedge");
    addHedge(model, {8.9, -3.4, 0.07}, {9.5, 10.8, 0.95});
    addHedge(model, {5.6, -5.4, 0.07}, {14.8, -4.9, 0.85});
    addHedge(model, {-14.8, -6.0, 0.07}, {-7.4, -5.5, 0.85});
}

} // namespace garden
