#include "host/sunpath/StrokeShapes.h"

#include <algorithm>
#include <cmath>

namespace quarn {
namespace {

using Line = std::vector<DrawnPoint>;

double distance(const DrawnPoint& one, const DrawnPoint& other) {
    return std::hypot(other.x_px - one.x_px, other.y_px - one.y_px);
}

Line withoutRepeats(const Line& line) {
    constexpr double LEAST_PX = 1e-3;
    Line left;
    for (const DrawnPoint& point : line)
        if (left.empty() || distance(left.back(), point) > LEAST_PX)
            left.push_back(point);
    return left;
}

/// A unit vector to the left of the way from one point to another.
DrawnPoint leftOf(const DrawnPoint& from, const DrawnPoint& to) {
    const double length = distance(from, to);
    return {(to.y_px - from.y_px) / length, (from.x_px - to.x_px) / length};
}

/// How far the border of a stroke of half width one lies from a corner.
DrawnPoint miter(const DrawnPoint& before, const DrawnPoint& after) {
    constexpr double SHARPEST = 0.25; // longer points than four half widths are cut
    const double x = (before.x_px + after.x_px) / 2;
    const double y = (before.y_px + after.y_px) / 2;
    const double square = std::max(x * x + y * y, SHARPEST * SHARPEST);
    return {x / square, y / square};
}

/// The border of a line at its left, and with a negative distance at its right.
Line border(const Line& line, bool is_closed, double away_px) {
    const std::size_t count = line.size();
    Line moved;
    for (std::size_t i = 0; i < count; ++i) {
        const bool has_before = is_closed || i > 0;
        const bool has_after = is_closed || i + 1 < count;
        const DrawnPoint before =
            has_before ? leftOf(line[(i + count - 1) % count], line[i]) : leftOf(line[0], line[1]);
        const DrawnPoint after = has_after ? leftOf(line[i], line[(i + 1) % count]) : before;
        const DrawnPoint corner = miter(has_before ? before : after, after);
        moved.push_back(
            {line[i].x_px + away_px * corner.x_px, line[i].y_px + away_px * corner.y_px});
    }
    return moved;
}

/// The dashes of a line.
std::vector<Line> dashesOf(const Line& line, double dash_px) {
    std::vector<Line> dashes;
    double left_px = dash_px;
    bool is_dash = true;
    dashes.push_back({line.front()});
    for (std::size_t i = 0; i + 1 < line.size(); ++i) {
        DrawnPoint at = line[i];
        double rest_px = distance(at, line[i + 1]);
        while (rest_px > left_px) {
            const double share = left_px / rest_px;
            at = {at.x_px + share * (line[i + 1].x_px - at.x_px),
                  at.y_px + share * (line[i + 1].y_px - at.y_px)};
            if (is_dash)
                dashes.back().push_back(at);
            else
                dashes.push_back({at});
            is_dash = !is_dash;
            rest_px -= left_px;
            left_px = dash_px;
        }
        left_px -= rest_px;
        if (is_dash)
            dashes.back().push_back(line[i + 1]);
    }
    return dashes;
}

void addStroke(const Line& points, bool is_closed, double width_px, std::vector<Line>& areas) {
    Line line = withoutRepeats(points);
    if (is_closed && line.size() > 2 && distance(line.front(), line.back()) < 1e-3)
        line.pop_back();
    if (line.size() < 2)
        return;
    Line left = border(line, is_closed, width_px / 2);
    Line right = border(line, is_closed, -width_px / 2);
    std::ranges::reverse(right);
    if (is_closed) {
        areas.push_back(std::move(left));
        areas.push_back(std::move(right));
        return;
    }
    left.insert(left.end(), right.begin(), right.end());
    areas.push_back(std::move(left));
}

} // namespace

std::vector<Line> strokeAreas(const std::vector<Line>& lines, bool is_closed,
                              const DrawnStroke& stroke) {
    std::vector<Line> areas;
    for (const Line& line : lines) {
        if (line.empty())
            continue;
        if (stroke.dash_px <= 0) {
            addStroke(line, is_closed, stroke.width_px, areas);
            continue;
        }
        for (const Line& dash : dashesOf(line, stroke.dash_px))
            addStroke(dash, false, stroke.width_px, areas);
    }
    return areas;
}

} // namespace quarn
