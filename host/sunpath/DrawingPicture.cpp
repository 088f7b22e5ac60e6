#include "host/sunpath/DrawingPicture.h"

#include "host/sunpath/StrokeShapes.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace quarn {
namespace {

using Areas = std::vector<std::vector<DrawnPoint>>;

/// Rows of a pixel that are looked at; along a row what is covered is exact.
constexpr int ROWS_OF_PIXEL = 8;

/// Where a line of a border crosses a row, and whether it runs down.
struct Crossing {
    double x_px;
    int turn;
};

/// Fills areas of a picture with grey ink.
class Filling {
public:
    Filling(Image& picture, double scale) : m_picture(picture), m_scale(scale) {}

    void fill(const Areas& areas, Grey grey) {
        const auto [first, last] = rowsOf(areas);
        std::vector<std::vector<Crossing>> rows(
            static_cast<std::size_t>(std::max(0, last - first)));
        for (const auto& area : areas)
            for (std::size_t i = 0; i < area.size(); ++i)
                addBorder(area[i], area[(i + 1) % area.size()], first, rows);
        std::vector<float> covered;
        for (int row = first; row < last; ++row) {
            if (row % ROWS_OF_PIXEL == 0 || row == first)
                covered.assign(static_cast<std::size_t>(m_picture.width), 0.0F);
            cover(rows[static_cast<std::size_t>(row - first)], covered);
            if (row % ROWS_OF_PIXEL == ROWS_OF_PIXEL - 1 || row == last - 1)
                blend(row / ROWS_OF_PIXEL, covered, grey);
        }
    }

private:
    double rowAt(const DrawnPoint& point) const { return point.y_px * m_scale * ROWS_OF_PIXEL; }

    /// The rows that the areas touch, within the picture.
    std::pair<int, int> rowsOf(const Areas& areas) const {
        double low = m_picture.height * ROWS_OF_PIXEL;
        double high = 0;
        for (const auto& area : areas)
            for (const DrawnPoint& point : area) {
                low = std::min(low, rowAt(point));
                high = std::max(high, rowAt(point));
            }
        const int rows = m_picture.height * ROWS_OF_PIXEL;
        return {std::clamp(static_cast<int>(std::floor(low)), 0, rows),
                std::clamp(static_cast<int>(std::ceil(high)), 0, rows)};
    }

    void addBorder(const DrawnPoint& from, const DrawnPoint& to, int first,
                   std::vector<std::vector<Crossing>>& rows) const {
        const bool runs_down = to.y_px > from.y_px;
        const DrawnPoint& top = runs_down ? from : to;
        const DrawnPoint& bottom = runs_down ? to : from;
        const int end = static_cast<int>(rows.size());
        const int begin_row = std::max(static_cast<int>(std::ceil(rowAt(top) - 0.5)) - first, 0);
        const int end_row = std::min(static_cast<int>(std::ceil(rowAt(bottom) - 0.5)) - first, end);
        for (int row = begin_row; row < end_row; ++row) {
            const double share = (row + first + 0.5 - rowAt(top)) / (rowAt(bottom) - rowAt(top));
            rows[static_cast<std::size_t>(row)].push_back(
                {m_scale * (top.x_px + share * (bottom.x_px - top.x_px)), runs_down ? 1 : -1});
        }
    }

    static void cover(std::vector<Crossing>& row, std::vector<float>& covered) {
        std::ranges::sort(row, {}, &Crossing::x_px);
        int winding = 0;
        for (std::size_t i = 0; i + 1 < row.size(); ++i) {
            winding += row[i].turn;
            if (winding != 0)
                coverSpan(row[i].x_px, row[i + 1].x_px, covered);
        }
    }

    static void coverSpan(double from_px, double to_px, std::vector<float>& covered) {
        const auto width = static_cast<double>(covered.size());
        from_px = std::clamp(from_px, 0.0, width);
        to_px = std::clamp(to_px, 0.0, width);
        for (auto x = static_cast<std::size_t>(from_px); x < covered.size(); ++x) {
            const auto left = static_cast<double>(x);
            if (left >= to_px)
                return;
            covered[x] += static_cast<float>(std::min(to_px, left + 1) - std::max(from_px, left)) /
                          ROWS_OF_PIXEL;
        }
    }

    void blend(int y, const std::vector<float>& covered, Grey grey) {
        std::uint8_t* pixel =
            m_picture.rgba.data() + std::size_t{4} * covered.size() * static_cast<std::size_t>(y);
        for (const float share : covered) {
            if (share > 0) {
                const double level = pixel[0] + std::min(1.0F, share) * (255 * grey - pixel[0]);
                std::fill_n(pixel, 3, static_cast<std::uint8_t>(std::lround(level)));
            }
            pixel += 4;
        }
    }

    Image& m_picture;
    double m_scale;
};

/// The outlines of a line of text where it stands.
Areas outlinesOf(const DrawnText& text, const Letters& letters) {
    const double spread_px = text.is_bold ? 0.06 * text.size_px : 0;
    const double width_px = letters.width(text.text, text.size_px, spread_px);
    const double shift_px = text.anchor == TextAnchor::start    ? 0
                            : text.anchor == TextAnchor::middle ? width_px / 2
                                                                : width_px;
    Areas areas;
    for (const auto& outline : letters.outlines(text.text, text.size_px, spread_px)) {
        auto& area = areas.emplace_back();
        for (const LetterPoint& point : outline)
            area.push_back({text.place.x_px - shift_px + point.x_px, text.place.y_px + point.y_px});
    }
    return areas;
}

class Painter {
public:
    Painter(Image& picture, double scale, const Letters& letters)
        : m_filling(picture, scale), m_letters(letters) {}

    void operator()(const DrawnPath& path) {
        if (path.fill)
            m_filling.fill(path.lines, *path.fill);
        if (path.stroke)
            stroke(path.lines, path.is_closed, *path.stroke);
    }

    void operator()(const DrawnCircle& circle) {
        constexpr int SIDES = 720;
        DrawnPath path{
            .lines = {{}}, .is_closed = true, .fill = circle.fill, .stroke = circle.stroke};
        for (int side = 0; side < SIDES; ++side) {
            const double turn = 2 * std::numbers::pi * side / SIDES;
            path.lines[0].push_back({circle.middle.x_px + circle.radius_px * std::cos(turn),
                                     circle.middle.y_px + circle.radius_px * std::sin(turn)});
        }
        (*this)(path);
    }

    void operator()(const DrawnText& text) {
        const Areas letters = outlinesOf(text, m_letters);
        if (text.has_halo)
            stroke(letters, true, {.width_px = text.size_px / 3, .grey = 1});
        m_filling.fill(letters, text.grey);
        if (text.is_bold)
            stroke(letters, true, {.width_px = 0.07 * text.size_px, .grey = text.grey});
    }

private:
    void stroke(const Areas& lines, bool is_closed, const DrawnStroke& stroke) {
        m_filling.fill(strokeAreas(lines, is_closed, stroke), stroke.grey);
    }

    Filling m_filling;
    const Letters& m_letters;
};

} // namespace

Image pictureOf(const Drawing& drawing, double scale, const Letters& letters) {
    Image picture;
    picture.resize(static_cast<int>(std::lround(scale * drawing.width_px)),
                   static_cast<int>(std::lround(scale * drawing.height_px)));
    std::ranges::fill(picture.rgba, std::uint8_t{255});
    Painter painter(picture, scale, letters);
    for (const DrawnShape& shape : drawing.shapes)
        std::visit(painter, shape);
    return picture;
}

} // namespace quarn
