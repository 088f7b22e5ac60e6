#include "quarn/reports/FileFacts.h"
#include "quarn/reports/ModelTelling.h"

#include <nlohmann/json.hpp>

#include <cstdio>

namespace quarn::program {

namespace {

using Json = nlohmann::ordered_json;

Json indexOrNull(const std::optional<std::size_t>& index) {
    return index ? Json(*index) : Json(nullptr);
}

Json pointOf(const KM_3dPoint& point) {
    return {point.x, point.y, point.z};
}

std::string hexOf(const KM_Color& color) {
    char text[16];
    std::snprintf(text, sizeof text, "#%02x%02x%02x", color.r, color.g, color.b);
    return text;
}

Json objectsOf(const ModelContents& contents) {
    Json objects = Json::array();
    for (const ObjectContents& object : contents.objects)
        objects.push_back({{"name", object.name},
                           {"kind", object.kind},
                           {"triangles", object.triangles},
                           {"vertices", object.vertices},
                           {"material", indexOrNull(object.material)},
                           {"repeats", object.repeats},
                           {"visible", object.is_visible}});
    return objects;
}

/// A number that is infinite becomes null.
struct QualityJson {
    Json operator()(std::monostate) const { return nullptr; }
    Json operator()(double number) const { return number; }
    Json operator()(bool flag) const { return flag; }
    Json operator()(const std::array<double, 3>& color) const { return color; }
    Json operator()(const UsedTexture& use) const {
        return {{"texture", use.texture}, {"u", use.u}, {"v", use.v}};
    }
};

Json materialOf(const MaterialContents& material) {
    Json json = {{"name", material.name},
                 {"base_color", hexOf(material.base_color)},
                 {"opacity", material.base_color.a / 255.0},
                 {"see_through", material.is_see_through},
                 {"alpha_cutoff", material.alpha_cutoff ? Json(*material.alpha_cutoff) : Json()},
                 {"texture", indexOrNull(material.texture)}};
    for (const auto& [name, quality] : material.qualities)
        json[name] = std::visit(QualityJson(), quality);
    return json;
}

Json materialsOf(const ModelContents& contents) {
    Json materials = Json::array();
    for (const MaterialContents& material : contents.materials)
        materials.push_back(materialOf(material));
    return materials;
}

Json texturesOf(const ModelContents& contents) {
    Json textures = Json::array();
    for (const TextureContents& texture : contents.textures)
        textures.push_back({{"width_px", texture.width_px},
                            {"height_px", texture.height_px},
                            {"bytes", texture.bytes}});
    return textures;
}

Json upOf(const ModelContents& contents) {
    if (contents.up_axis == 0)
        return nullptr;
    return {{"axis", std::string(1, contents.up_axis)},
            {"why", contents.up_reason},
            {"guessed", contents.up_is_guessed}};
}

Json boxOf(const ModelContents& contents) {
    if (!contents.box)
        return nullptr;
    return {{"low", pointOf(contents.box->first)}, {"high", pointOf(contents.box->second)}};
}

} // namespace

std::string jsonOf(const ReadFile& file) {
    const ModelContents& contents = file.contents;
    const Json json = {
        {"name", file.path.filename().native()},
        {"format", formatName(file.path)},
        {"file_bytes", file.bytes},
        {"read_ms", millisecondsOf(file.read_time)},
        {"units", contents.units.empty() ? Json(nullptr) : Json(contents.units)},
        {"up", upOf(contents)},
        {"box", boxOf(contents)},
        {"objects", objectsOf(contents)},
        {"materials", materialsOf(contents)},
        {"textures", texturesOf(contents)},
        {"cameras", contents.cameras},
        {"lights", contents.lights},
        {"animation", contents.animation.empty() ? Json(nullptr) : Json(contents.animation)},
        {"left_out", contents.left_out}};
    return json.dump(2, ' ', false, Json::error_handler_t::replace) + "\n";
}

} // namespace quarn::program
