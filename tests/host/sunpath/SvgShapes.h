#pragma once

#include <algorithm>
#include <cmath>
#include <cstdlib>
#include <limits>
#include <optional>
#include <regex>
#include <string>
#include <vector>

namespace quarn {

/// A place in a picture, as its file has it.
struct SvgPoint {
    double x;
    double y;
};
using SvgLines = std::vector<std::vector<SvgPoint>>;

/// The lines of a path that has this name; nothing where there is none.
inline std::optional<SvgLines> svgLines(const std::string& svg, const std::string& id) {
    const std::string start = "<path id=\"" + id + "\" d=\"";
    const std::size_t found = svg.find(start);
    if (found == std::string::npos)
        return std::nullopt;
    const std::size_t begin = found + start.size();
    const std::string steps = svg.substr(begin, svg.find('"', begin) - begin);
    SvgLines lines;
    const char* at = steps.c_str();
    while (*at) {
        const char step = *at++;
        if (step == 'Z')
            continue;
        if (step == 'M')
            lines.emplace_back();
        char* end = nullptr;
        const double x = std::strtod(at, &end);
        const double y = std::strtod(end, &end);
        lines.back().push_back({x, y});
        at = end;
    }
    return lines;
}

/// The largest circles of a picture, from the left: the horizons of its disks.
struct SvgDisk {
    SvgPoint middle;
    double radius;
};
inline std::vector<SvgDisk> svgDisks(const std::string& svg) {
    static const std::regex circle("<circle cx=\"([^\"]+)\" cy=\"([^\"]+)\" r=\"([^\"]+)\" "
                                   "fill=\"none\"");
    std::vector<SvgDisk> disks;
    for (std::sregex_iterator found(svg.begin(), svg.end(), circle), end; found != end; ++found)
        disks.push_back({{std::stod((*found)[1]), std::stod((*found)[2])}, std::stod((*found)[3])});
    double largest = 0;
    for (const SvgDisk& disk : disks)
        largest = std::max(largest, disk.radius);
    std::erase_if(disks, [&](const SvgDisk& disk) { return disk.radius < largest; });
    return disks;
}

/// How far a place is from the nearest of some lines.
inline double distanceTo(const SvgLines& lines, const SvgPoint& place) {
    double least = std::numeric_limits<double>::infinity();
    for (const auto& line : lines)
        for (std::size_t i = 0; i + 1 < line.size(); ++i) {
            const double x = line[i + 1].x - line[i].x;
            const double y = line[i + 1].y - line[i].y;
            const double square = std::max(x * x + y * y, 1e-12);
            const double along = ((place.x - line[i].x) * x + (place.y - line[i].y) * y) / square;
            const double share = std::clamp(along, 0.0, 1.0);
            least = std::min(least, std::hypot(line[i].x + share * x - place.x,
                                               line[i].y + share * y - place.y));
        }
    return least;
}

/// Whether a place is in an area, by the rule of the winding number.
inline bool isInside(const SvgLines& areas, const SvgPoint& place) {
    int winding = 0;
    for (const auto& area : areas)
        for (std::size_t i = 0; i < area.size(); ++i) {
            const SvgPoint& a = area[i];
            const SvgPoint& b = area[(i + 1) % area.size()];
            const double side = (b.x - a.x) * (place.y - a.y) - (place.x - a.x) * (b.y - a.y);
            if (a.y <= place.y && b.y > place.y && side > 0)
                ++winding;
            if (a.y > place.y && b.y <= place.y && side < 0)
                --winding;
        }
    return winding != 0;
}

} // namespace quarn
