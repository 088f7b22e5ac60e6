#include "host/sunpath/SvgText.h"

#include "kelmar/KM_wString.h"

#include <array>
#include <charconv>
#include <cmath>

namespace quarn {
namespace {

/// Two digits behind the point: a hundredth of a pixel.
std::string number(double value) {
    std::array<char, 32> text;
    const double rounded = std::round(value * 100) / 100;
    const char* const end =
        std::to_chars(text.data(), text.data() + text.size(), rounded == 0 ? 0 : rounded).ptr;
    return {static_cast<const char*>(text.data()), end};
}

std::string color(Grey grey) {
    constexpr char DIGITS[] = "0123456789abcdef";
    const auto level = static_cast<unsigned>(std::lround(255 * grey));
    const std::string byte = {DIGITS[level / 16 % 16], DIGITS[level % 16]};
    return "#" + byte + byte + byte;
}

std::string escaped(const std::string& text) {
    // A round trip leaves nothing but UTF-8.
    const std::string clean = KM_wString::FromUtf8(text).ToUtf8();
    std::string result;
    for (const char letter : clean) {
        if (letter == '&')
            result += "&amp;";
        else if (letter == '<')
            result += "&lt;";
        else if (letter == '>')
            result += "&gt;";
        else if (letter == '"')
            result += "&quot;";
        else
            result += static_cast<unsigned char>(letter) < ' ' || letter == '\x7f' ? '?' : letter;
    }
    return result;
}

std::string attribute(const char* name, const std::string& value) {
    return std::string(" ") + name + "=\"" + value + "\"";
}

std::string inkOf(const std::optional<Grey>& fill, const std::optional<DrawnStroke>& stroke) {
    std::string ink = attribute("fill", fill ? color(*fill) : "none");
    if (!stroke)
        return ink;
    ink += attribute("stroke", color(stroke->grey)) +
           attribute("stroke-width", number(stroke->width_px));
    if (stroke->dash_px > 0)
        ink += attribute("stroke-dasharray", number(stroke->dash_px));
    return ink;
}

std::string pathSteps(const DrawnPath& path) {
    std::string steps;
    for (const auto& line : path.lines) {
        char step = 'M';
        for (const DrawnPoint& point : line) {
            steps += step + number(point.x_px) + " " + number(point.y_px);
            step = 'L';
        }
        if (path.is_closed && !line.empty())
            steps += 'Z';
    }
    return steps;
}

std::string elementOf(const DrawnPath& path) {
    return "<path" + (path.id.empty() ? "" : attribute("id", escaped(path.id))) +
           attribute("d", pathSteps(path)) + inkOf(path.fill, path.stroke) +
           " stroke-linejoin=\"round\"/>\n";
}

std::string elementOf(const DrawnCircle& circle) {
    return "<circle" + attribute("cx", number(circle.middle.x_px)) +
           attribute("cy", number(circle.middle.y_px)) + attribute("r", number(circle.radius_px)) +
           inkOf(circle.fill, circle.stroke) + "/>\n";
}

std::string textElement(const DrawnText& text, const std::string& ink) {
    constexpr const char* ANCHORS[] = {"start", "middle", "end"};
    return "<text" + attribute("x", number(text.place.x_px)) +
           attribute("y", number(text.place.y_px)) + attribute("font-size", number(text.size_px)) +
           attribute("text-anchor", ANCHORS[static_cast<int>(text.anchor)]) +
           (text.is_bold ? attribute("font-weight", "bold") : "") + ink + ">" + escaped(text.text) +
           "</text>\n";
}

/// Programs disagree about a stroke that lies behind its own fill: the halo is a text of its own.
std::string elementOf(const DrawnText& text) {
    const std::string letters = textElement(text, attribute("fill", color(text.grey)));
    if (!text.has_halo)
        return letters;
    return textElement(text, inkOf(1, DrawnStroke{.width_px = text.size_px / 3, .grey = 1}) +
                                 " stroke-linejoin=\"round\"") +
           letters;
}

} // namespace

std::string svgText(const Drawing& drawing) {
    const std::string width = number(drawing.width_px);
    const std::string height = number(drawing.height_px);
    std::string text = "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n"
                       "<svg xmlns=\"http://www.w3.org/2000/svg\" version=\"1.1\"" +
                       attribute("width", width) + attribute("height", height) +
                       attribute("viewBox", "0 0 " + width + " " + height) +
                       " font-family=\"sans-serif\">\n<title>" + escaped(drawing.title) +
                       "</title>\n<rect" + attribute("width", width) + attribute("height", height) +
                       " fill=\"#ffffff\"/>\n";
    for (const DrawnShape& shape : drawing.shapes)
        text += std::visit([](const auto& drawn) { return elementOf(drawn); }, shape);
    return text + "</svg>\n";
}

} // namespace quarn
