#pragma once

#include <optional>
#include <string>
#include <variant>
#include <vector>

namespace quarn {

/// A place on a drawing, from its upper left corner; y runs down.
struct DrawnPoint {
    double x_px;
    double y_px;
};

/// A grey of ink: 0 black, 1 white.
using Grey = double;

struct DrawnStroke {
    double width_px = 1;
    Grey grey = 0;
    double dash_px = 0; ///< of each dash and each gap; 0: a line without gaps
};

/// Lines through points, or areas inside of them.
struct DrawnPath {
    std::string id{}; ///< names the shape in the file, for whoever edits it; empty: no name
    std::vector<std::vector<DrawnPoint>> lines{};
    bool is_closed = false;
    std::optional<Grey> fill{};
    std::optional<DrawnStroke> stroke{};
};

struct DrawnCircle {
    DrawnPoint middle;
    double radius_px;
    std::optional<Grey> fill{};
    std::optional<DrawnStroke> stroke{};
};

enum class TextAnchor { start, middle, end };

/// A line of text.
struct DrawnText {
    DrawnPoint place; ///< on its base line
    std::string text; ///< UTF-8
    double size_px;
    TextAnchor anchor = TextAnchor::start;
    bool is_bold = false;
    Grey grey = 0;
    bool has_halo = false; ///< white around the letters, where lines run behind them
};

using DrawnShape = std::variant<DrawnPath, DrawnCircle, DrawnText>;

/// A drawing on white, to be printed; later shapes cover earlier ones.
struct Drawing {
    double width_px = 0;
    double height_px = 0;
    std::string title; ///< UTF-8, told to who cannot see the drawing
    std::vector<DrawnShape> shapes;
};

} // namespace quarn
