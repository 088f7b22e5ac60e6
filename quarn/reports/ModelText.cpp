#include "quarn/reports/FileFacts.h"
#include "quarn/reports/ModelTelling.h"
#include "quarn/words/Words.h"

#include <algorithm>
#include <cmath>
#include <cstdio>

namespace quarn::program {

namespace {

/// A number of bytes in the unit that suits it: "812 bytes", "1.5 MB".
std::string byteCountText(std::uintmax_t bytes) {
    if (bytes < 1000)
        return std::to_string(bytes) + " bytes";
    constexpr const char* UNITS[] = {" kB", " MB", " GB", " TB"};
    double count = static_cast<double>(bytes) / 1000.0;
    int unit = 0;
    for (; count >= 999.95 && unit < 3; ++unit)
        count /= 1000.0;
    return numberText(std::round(count * 10.0) / 10.0) + UNITS[unit];
}

/// "121,496".
std::string groupedText(std::size_t count) {
    std::string text = std::to_string(count);
    for (auto at = static_cast<std::ptrdiff_t>(text.size()) - 3; at > 0; at -= 3)
        text.insert(static_cast<std::size_t>(at), 1, ',');
    return text;
}

std::string counted(std::size_t count, const char* one, const char* several) {
    return groupedText(count) + " " + (count == 1 ? one : several);
}

/// As many digits as say something of a length.
std::string lengthText(double length) {
    char text[40];
    std::snprintf(text, sizeof text, "%.6g", length + 0.0); // never "-0"
    return text;
}

/// @param size  of the model, beside which what rounding leaves is nothing
std::string pointText(const KM_3dPoint& point, double size) {
    const auto coordinate = [size](double value) {
        return lengthText(std::abs(value) < 1e-9 * size ? 0.0 : value);
    };
    return coordinate(point.x) + "," + coordinate(point.y) + "," + coordinate(point.z);
}

std::string sizeLine(const ModelContents& contents) {
    if (!contents.box)
        return "";
    const auto& [low, high] = *contents.box;
    const KM_3dVector size = high - low;
    return "size: " + lengthText(size.x) + " x " + lengthText(size.y) + " x " + lengthText(size.z) +
           ", from " + pointText(low, size.Length()) + " to " + pointText(high, size.Length()) +
           "\n";
}

std::string axisLine(const ModelContents& contents) {
    if (contents.up_axis == 0)
        return "";
    const bool is_y = contents.up_axis == 'y';
    const std::string hint =
        contents.up_is_guessed ? std::string("; --up ") + (is_y ? "z" : "y") + " turns it" : "";
    return std::string("up: ") + (is_y ? "Y" : "Z") + ", " + contents.up_reason + hint + "\n";
}

/// What the objects of one kind are, summed up.
std::string meshesText(const ModelContents& contents) {
    std::size_t meshes = 0;
    std::size_t repeats = 0;
    std::size_t triangles = 0;
    std::size_t vertices = 0;
    for (const ObjectContents& object : contents.objects) {
        meshes += object.kind == "mesh" ? 1 : 0;
        repeats += object.repeats ? 1 : 0;
        triangles += object.triangles;
        vertices += object.repeats ? 0 : object.vertices;
    }
    std::string text = counted(meshes, "mesh", "meshes") + " with " +
                       counted(triangles, "triangle", "triangles") + " and " +
                       counted(vertices, "vertex", "vertices");
    return repeats == 0 ? text : text + ", " + groupedText(repeats) + " of them repeated";
}

std::size_t countOf(const ModelContents& contents, const char* kind) {
    return static_cast<std::size_t>(
        std::ranges::count(contents.objects, kind, &ObjectContents::kind));
}

std::string objectsLine(const ModelContents& contents) {
    const auto hidden = static_cast<std::size_t>(
        std::ranges::count(contents.objects, false, &ObjectContents::is_visible));
    return "objects: " + meshesText(contents) + ", " +
           counted(countOf(contents, "curve"), "curve", "curves") + ", " +
           counted(countOf(contents, "point"), "point", "points") +
           (hidden > 0 ? "; " + groupedText(hidden) + " hidden" : "") + "\n";
}

struct QualityWords {
    bool MaterialContents::*quality;
    const char* one;
    const char* several;
};

constexpr QualityWords QUALITIES[] = {
    {&MaterialContents::is_metal, "is metal", "are metal"},
    {&MaterialContents::has_normal_map, "has a normal map", "have normal maps"},
    {&MaterialContents::has_clearcoat, "has a clear coat", "have clear coats"},
    {&MaterialContents::shines, "shines by itself", "shine by themselves"},
    {&MaterialContents::lets_light_through, "lets light through", "let light through"},
    {&MaterialContents::is_unlit, "is unlit", "are unlit"},
    {&MaterialContents::has_sheen, "has a sheen that is not drawn",
     "have sheens that are not drawn"},
};

/// "materials: 5, of which 3 are metal, 1 shines by itself".
std::string materialsLine(const ModelContents& contents) {
    std::string text = "materials: " + groupedText(contents.materials.size());
    const char* before = ", of which ";
    for (const QualityWords& words : QUALITIES) {
        const auto count =
            static_cast<std::size_t>(std::ranges::count(contents.materials, true, words.quality));
        if (count == 0)
            continue;
        text += before + counted(count, words.one, words.several);
        before = ", ";
    }
    return text + "\n";
}

std::string looksLines(const ModelContents& contents) {
    std::string text = materialsLine(contents);
    std::uint64_t bytes = 0;
    std::string sizes;
    for (const TextureContents& texture : contents.textures) {
        bytes += texture.bytes;
        sizes += (sizes.empty() ? "" : ", ") + std::to_string(texture.width_px) + " x " +
                 std::to_string(texture.height_px);
    }
    if (!contents.textures.empty())
        text += "textures: " + groupedText(contents.textures.size()) + ", " + sizes +
                " pixels, in all " + byteCountText(bytes) + " of memory\n";
    return text;
}

std::string restLines(const ModelContents& contents) {
    std::string text;
    for (const std::string& name : contents.cameras)
        text += (text.empty() ? "cameras: " : ", ") + (name.empty() ? "(without a name)" : name);
    text += text.empty() ? "" : "\n";
    if (contents.lights > 0)
        text += "lights: " + groupedText(contents.lights) + "\n";
    if (!contents.animation.empty())
        text += "animation: " + contents.animation + "\n";
    return text;
}

std::string materialText(const ModelContents& contents, const ObjectContents& object) {
    if (!object.material)
        return "";
    const std::string& name = contents.materials[*object.material].name;
    return name.empty() ? "" : ", " + name;
}

std::string objectLine(const ModelContents& contents, const ObjectContents& object) {
    std::string line =
        (object.name.empty() ? "(without a name)" : object.name) + "  " + object.kind;
    if (object.triangles > 0)
        line += ", " + counted(object.triangles, "triangle", "triangles");
    return line + materialText(contents, object) + (object.repeats ? ", repeated" : "") +
           (object.is_visible ? "" : ", hidden") + "\n";
}

} // namespace

std::string textOf(const ReadFile& file) {
    const ModelContents& contents = file.contents;
    std::string text = "name: " + file.path.filename().native() +
                       "\nformat: " + formatName(file.path) +
                       "\nfile size: " + byteCountText(file.bytes) +
                       "\nread in: " + numberText(millisecondsOf(file.read_time)) + " ms\n";
    text += axisLine(contents);
    text += "units: " + (contents.units.empty() ? "not stated" : contents.units) + "\n";
    text += sizeLine(contents) + objectsLine(contents) + looksLines(contents) + restLines(contents);
    for (const ObjectContents& object : contents.objects)
        text += objectLine(contents, object);
    return text;
}

} // namespace quarn::program
