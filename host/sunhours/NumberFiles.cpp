#include "host/sunhours/NumberFiles.h"

#include "host/sunhours/HourColors.h"

#include <cstdio>
#include <cstring>

namespace quarn {

namespace {

/// Sums of steps that should meet the threshold may miss it by their last digits.
constexpr double THRESHOLD_DIGITS = 1e-4;

constexpr float LOOKING_UP = 0.70710678F;

struct Sums {
    double hours = 0.0;
    double reaching = 0.0; ///< points that get at least the threshold
    double count = 0.0;

    void add(float of_point, double threshold_hours) {
        hours += double{of_point};
        reaching += double{of_point} >= threshold_hours - THRESHOLD_DIGITS ? 1.0 : 0.0;
        count += 1.0;
    }
    double mean(double sum) const { return count > 0.0 ? sum / count : 0.0; }
};

bool putText(const ByteSink& sink, const std::string& text) {
    return sink(std::as_bytes(std::span(text)));
}

/// The header's length makes the numbers begin at a multiple of 64 bytes.
std::string arrayHeader(int width, int height) {
    std::string text = "{'descr': '<f4', 'fortran_order': False, 'shape': (" +
                       std::to_string(height) + ", " + std::to_string(width) + "), }";
    constexpr std::size_t BEFORE = 10;
    constexpr std::size_t ALIGNED = 64;
    text.append(ALIGNED - 1 - (BEFORE + text.size()) % ALIGNED, ' ');
    text += '\n';
    std::string header("\x93NUMPY\x01\x00", 8);
    header += static_cast<char>(text.size() & 0xFF);
    header += static_cast<char>(text.size() >> 8);
    return header + text;
}

std::string quoted(const std::string& text) {
    std::string field = "\"";
    for (const char c : text) {
        field += c;
        if (c == '"')
            field += c;
    }
    return field + "\"";
}

template <class Number> void append(std::string& bytes, Number number) {
    char raw[sizeof number];
    std::memcpy(raw, &number, sizeof number);
    bytes.append(raw, sizeof number);
}

std::string gridHeader(std::size_t triangles) {
    return "ply\nformat binary_little_endian 1.0\ncomment hours of direct sun a day\n"
           "element vertex " +
           std::to_string(3 * triangles) +
           "\nproperty double x\nproperty double y\nproperty double z\n"
           "property uchar red\nproperty uchar green\nproperty uchar blue\n"
           "property float hours\nelement face " +
           std::to_string(triangles) + "\nproperty list uchar int vertex_indices\nend_header\n";
}

void appendCorner(std::string& bytes, const KM_3dPoint& origin, const KM_3fPoint& corner,
                  const KM_Color& color, float hours) {
    append(bytes, origin.x + double{corner.x});
    append(bytes, origin.y + double{corner.y});
    append(bytes, origin.z + double{corner.z});
    append(bytes, color.r);
    append(bytes, color.g);
    append(bytes, color.b);
    append(bytes, hours);
}

} // namespace

ObjectHours hoursOf(const ObjectSpan& object, const SurfacePoints& points, const SunLight& light,
                    double threshold_hours) {
    ObjectHours found;
    found.area = object.area;
    found.points = object.count;
    Sums all;
    Sums up;
    for (std::size_t i = object.first; i < object.first + object.count; ++i) {
        all.add(light.hours[i], threshold_hours);
        if (points.packets()[i / points_at_once].face[2][i % points_at_once] > LOOKING_UP)
            up.add(light.hours[i], threshold_hours);
    }
    found.mean_hours = all.mean(all.hours);
    found.share = all.mean(all.reaching);
    found.up_area = all.mean(up.count) * object.area;
    found.up_mean_hours = up.mean(up.hours);
    found.up_share = up.mean(up.reaching);
    return found;
}

Result<void> writeHoursArray(const std::filesystem::path& file, const SunHoursMap& map) {
    return writeFileInPieces(file, [&](const ByteSink& sink) -> Result<void> {
        putText(sink, arrayHeader(map.width_px, map.height_px));
        std::vector<float> row(static_cast<std::size_t>(map.width_px));
        for (int y = 0; y < map.height_px; ++y) {
            for (int x = 0; x < map.width_px; ++x)
                row[static_cast<std::size_t>(x)] = map.hours(x, y);
            if (!sink(std::as_bytes(std::span(row))))
                break;
        }
        return {};
    });
}

std::string objectsCsv(const std::vector<ObjectHours>& objects, double threshold_hours,
                       const std::string& area_unit) {
    char number[160];
    std::snprintf(number, sizeof number, "%g", threshold_hours);
    const std::string unit = area_unit.empty() ? "" : "_" + area_unit;
    const std::string reaching = std::string("share_from_") + number + "_hours";
    std::string csv = "object,area" + unit + ",mean_hours," + reaching + ",points,up_area" + unit +
                      ",up_mean_hours,up_" + reaching + "\r\n";
    for (const ObjectHours& object : objects) {
        std::snprintf(number, sizeof number, ",%.6g,%.3f,%.4f,%zu,%.6g,%.3f,%.4f\r\n", object.area,
                      object.mean_hours, object.share, object.points, object.up_area,
                      object.up_mean_hours, object.up_share);
        csv += quoted(object.name) + number;
    }
    return csv;
}

Result<void> writeGrid(const std::filesystem::path& file, const SurfaceGrid& grid,
                       const SunLight& light, const KM_3dPoint& origin, double end) {
    const std::size_t count = grid.points.size();
    return writeFileInPieces(file, [&](const ByteSink& sink) -> Result<void> {
        putText(sink, gridHeader(count));
        for (std::size_t i = 0; i < count; ++i) {
            std::string bytes;
            for (std::size_t corner = 3 * i; corner < 3 * i + 3; ++corner)
                appendCorner(bytes, origin, grid.corners[corner], viridis(light.hours[i] / end),
                             light.hours[i]);
            if (!putText(sink, bytes))
                return {};
        }
        for (std::size_t i = 0; i < count; ++i) {
            std::string bytes(1, '\3');
            for (std::size_t corner = 3 * i; corner < 3 * i + 3; ++corner)
                append(bytes, static_cast<std::int32_t>(corner));
            if (!putText(sink, bytes))
                return {};
        }
        return {};
    });
}

} // namespace quarn
