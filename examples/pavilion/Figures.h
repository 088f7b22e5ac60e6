#pragma once

#include "examples/pavilion/Shapes.h"

#include <string>

/// People, as plain as those of an architect's model: they show how large everything is.
namespace figures {

struct Figure {
    Vec foot;
    double facing_deg; ///< from x toward y
    double height;     ///< metres
    double stride;     ///< between the feet; 0: stands
    const char* coat;
};

inline void add(ModelWriter& model, const Figure& f, const std::string& name) {
    constexpr unsigned seed = 200;
    const double a = f.facing_deg * std::numbers::pi / 180.0;
    const Vec ahead{std::cos(a), std::sin(a), 0.0};
    const Vec left{-std::sin(a), std::cos(a), 0.0};
    const double h = f.height;
    const auto at = [&](double forward, double aside, double up) {
        return f.foot + ahead * (forward * h) + left * (aside * h) + Vec{0.0, 0.0, up * h};
    };
    const double step = 0.5 * f.stride / h;
    model.beginObject(name + " legs", "cloth_dark");
    for (const double side : {-1.0, 1.0}) {
        const Vec ankle = at(side * step, side * 0.045, 0.03);
        addBar(model, ankle, at(0.0, side * 0.048, 0.50), 0.042 * h, 12);
        addBlob(model, ankle + ahead * (0.03 * h), {0.055 * h, 0.055 * h, 0.03 * h}, seed, 0.0);
    }
    model.beginObject(name + " coat", f.coat);
    const ProfilePoint coat[] = {{0.088 * h, 0.38 * h, true},  {0.082 * h, 0.50 * h, false},
                                 {0.070 * h, 0.60 * h, false}, {0.092 * h, 0.74 * h, false},
                                 {0.088 * h, 0.79 * h, false}, {0.045 * h, 0.83 * h, false},
                                 {0.030 * h, 0.85 * h, true}};
    addTurned(model, f.foot, coat, 20);
    for (const double side : {-1.0, 1.0}) {
        addBar(model, at(0.0, side * 0.095, 0.79), at(-side * 0.6 * step, side * 0.125, 0.46),
               0.026 * h, 10);
        addBlob(model, at(0.0, side * 0.093, 0.78), {0.036 * h, 0.036 * h, 0.036 * h}, seed, 0.0);
    }
    model.beginObject(name + " head", "skin");
    addBar(model, at(0.0, 0.0, 0.83), at(0.01, 0.0, 0.89), 0.027 * h, 10);
    addBlob(model, at(0.01, 0.0, 0.93), {0.050 * h, 0.050 * h, 0.066 * h}, seed, 0.0);
    model.beginObject(name + " hair", "wood_dark");
    addBlob(model, at(-0.006, 0.0, 0.945), {0.053 * h, 0.053 * h, 0.055 * h}, seed, 0.0);
}

/// On the square, at the steps and in the street, off the way of the walk.
inline void add(ModelWriter& model) {
    const Figure figures[] = {{{2.25, -11.6, 0.0}, 62.0, 1.74, 0.0, "coat_red"},
                              {{2.75, -11.05, 0.0}, 225.0, 1.66, 0.0, "coat_blue"},
                              {{0.7, -14.0, 0.0}, 98.0, 1.78, 0.56, "coat_ochre"},
                              {{3.5, -2.35, 0.0}, 120.0, 1.70, 0.52, "coat_blue"},
                              {{-8.0, 7.0, 0.0}, 268.0, 1.72, 0.54, "coat_red"},
                              {{-7.5, 7.15, 0.0}, 268.0, 1.62, 0.50, "coat_ochre"}};
    int number = 1;
    for (const Figure& figure : figures) {
        add(model, figure, "Figure " + std::to_string(number++));
    }
}

} // namespace figures
