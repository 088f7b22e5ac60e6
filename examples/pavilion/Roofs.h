#pragma once

#include "examples/pavilion/Shapes.h"

/// One slope of a tiled roof, a plane that rises from its eave. The slope's outline is given along
/// the eave (from `eave_start`, to the right as seen from outside) and up the slope.
struct RoofSlope {
    Vec eave_start;
    Vec along;    ///< unit vector, level
    Vec up_slope; ///< unit vector
    double eave_width;
    double slope_length;
    double left_inset = 0.0;  ///< how far the upper end of the left side lies inward
    double right_inset = 0.0; ///< the same of the right side

    Vec normal() const { return cross(along, up_slope); }
    Vec at(double right, double up, double above = 0.0) const {
        return eave_start + along * right + up_slope * up + normal() * above;
    }
};

struct SlopePoint {
    double right;
    double up;
};

/// The part of a convex polygon where `distance` is not negative.
inline std::vector<SlopePoint> clipped(const std::vector<SlopePoint>& polygon,
                                       const std::function<double(const SlopePoint&)>& distance) {
    std::vector<SlopePoint> kept;
    for (std::size_t i = 0; i < polygon.size(); ++i) {
        const SlopePoint& a = polygon[i];
        const SlopePoint& b = polygon[(i + 1) % polygon.size()];
        const double da = distance(a);
        const double db = distance(b);
        if (da >= 0.0) {
            kept.push_back(a);
        }
        if ((da > 0.0 && db < 0.0) || (da < 0.0 && db > 0.0)) {
            const double t = da / (da - db);
            kept.push_back({a.right + t * (b.right - a.right), a.up + t * (b.up - a.up)});
        }
    }
    return kept;
}

/// Courses of rounded tiles, each of which overlaps the one below.
inline void addTiles(ModelWriter& model, const RoofSlope& slope) {
    constexpr double tile_width = 0.30;
    constexpr double wave = 0.035;
    constexpr double lip = 0.05;
    constexpr int steps = 6; // of a tile's width
    const int courses = std::max(1, static_cast<int>(std::lround(slope.slope_length / 0.42)));
    const int columns = static_cast<int>(std::ceil(slope.eave_width / tile_width)) * steps;
    const double column = tile_width / steps;
    const double course = slope.slope_length / courses;
    const auto insideLeft = [&](const SlopePoint& p) {
        return p.right - slope.left_inset * p.up / slope.slope_length;
    };
    const auto insideRight = [&](const SlopePoint& p) {
        return slope.eave_width - slope.right_inset * p.up / slope.slope_length - p.right;
    };
    const auto corner = [&](const SlopePoint& p, double lower_end) {
        const double phase = 2.0 * std::numbers::pi * p.right / tile_width;
        const double sink = lip * (1.0 - (p.up - lower_end) / course);
        const double tilt = 2.0 * std::numbers::pi / tile_width * wave * std::sin(phase);
        return Corner{slope.at(p.right, p.up, sink + wave * (1.0 - std::cos(phase))),
                      slope.normal() - slope.along * tilt + slope.up_slope * (lip / course)};
    };
    for (int j = 0; j < courses; ++j) {
        const double low = j * course;
        for (int i = 0; i < columns; ++i) {
            const double left = i * column;
            const double right = left + column;
            std::vector<SlopePoint> cell{
                {left, low}, {right, low}, {right, low + course}, {left, low + course}};
            cell = clipped(clipped(cell, insideLeft), insideRight);
            if (cell.size() < 3) {
                continue;
            }
            std::vector<Corner> corners;
            for (const SlopePoint& p : cell) {
                corners.push_back(corner(p, low));
            }
            model.face(std::span<const Corner>(corners));
            const Vec a = corner({left, low}, low).place;
            const Vec b = corner({right, low}, low).place;
            if (insideLeft({left, low}) >= 0.0 && insideRight({right, low}) >= 0.0) {
                model.face({slope.at(left, low), slope.at(right, low), b, a});
            }
        }
    }
}

/// The lower side of a roof slope and the board along its eave.
inline void addSoffit(ModelWriter& model, const RoofSlope& slope, double thickness) {
    const Vec down = Vec{0.0, 0.0, -thickness};
    const Vec a = slope.at(0.0, 0.0);
    const Vec b = slope.at(slope.eave_width, 0.0);
    const Vec c = slope.at(slope.eave_width - slope.right_inset, slope.slope_length);
    const Vec d = slope.at(slope.left_inset, slope.slope_length);
    model.face({d + down, c + down, b + down, a + down});
    model.face({a + down, b + down, b, a});
    model.face({b + down, c + down, c, b});
    model.face({d + down, a + down, a, d});
}
