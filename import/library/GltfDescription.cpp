#include "import/library/GltfDescription.h"

#include "import/files/ModelFileCheck.h"
#include "kelmar/KM_LittleEndian.h"

#include <nlohmann/json.hpp>

#include <algorithm>
#include <array>
#include <cstring>
#include <fstream>

namespace quarn {
namespace {

using nlohmann::json;

/// Leaves out the bytes and pictures that may stand in the text.
bool isWanted(int depth, json::parse_event_t event, json& key) {
    const bool is_member = depth == 1 && event == json::parse_event_t::key;
    return !is_member || (key != "buffers" && key != "images");
}

/// The text part of a GLB, whose header states its length; empty for another version.
std::string textOfGlb(std::istream& file) {
    std::array<std::uint8_t, 20> head{};
    file.read(reinterpret_cast<char*>(head.data()), head.size());
    const bool is_known = file.gcount() == static_cast<std::streamsize>(head.size()) &&
                          kelmar::fromLittleEndian<std::uint32_t>(&head[4]) == 2 &&
                          std::memcmp(&head[16], "JSON", 4) == 0;
    std::string text(is_known ? kelmar::fromLittleEndian<std::uint32_t>(&head[12]) : 0, ' ');
    file.read(text.data(), static_cast<std::streamsize>(text.size()));
    return text;
}

json readJson(const std::filesystem::path& path) {
    std::ifstream file(path, std::ios::binary);
    return modelFormat(path) == "glb" ? json::parse(textOfGlb(file), isWanted, false)
                                      : json::parse(file, isWanted, false);
}

/// The member of an object, or null for anything else.
const json& member(const json& value, const char* name) {
    static const json nothing;
    const auto found = value.is_object() ? value.find(name) : value.end();
    return found == value.end() ? nothing : *found;
}

std::string textOf(const json& value) {
    return value.is_string() ? value.get<std::string>() : std::string();
}

std::uint64_t numberOf(const json& value, std::uint64_t otherwise) {
    return value.is_number_unsigned() ? value.get<std::uint64_t>() : otherwise;
}

/// Khronos Group, glTF 2.0, section 3.7.2.1 (the modes of a primitive).
std::uint64_t facesOf(std::uint64_t mode, std::uint64_t indices) {
    const auto chained = [indices](std::uint64_t first) {
        return indices > first ? indices - first : 0;
    };
    switch (mode) {
    case 0: // points
        return indices;
    case 1: // separate segments
        return indices / 2;
    case 2: // a closed line
        return indices;
    case 3: // an open line
        return chained(1);
    case 4: // separate triangles
        return indices / 3;
    default: // a strip or a fan
        return chained(2);
    }
}

std::uint64_t facesOfPart(const json& part, const json& accessors) {
    const json& indices = member(part, "indices");
    const json& counted =
        indices.is_null() ? member(member(part, "attributes"), "POSITION") : indices;
    const std::uint64_t accessor = numberOf(counted, SIZE_MAX);
    if (!accessors.is_array() || accessor >= accessors.size()) {
        return 0;
    }
    const std::uint64_t count = numberOf(member(accessors[accessor], "count"), 0);
    return facesOf(numberOf(member(part, "mode"), 4), count);
}

void addPart(std::uint64_t count, GltfFaces& faces) {
    faces.fewest = faces.meshes == 0 ? count : std::min(faces.fewest, count);
    faces.all += count;
    ++faces.meshes;
}

std::map<std::string, GltfFaces> facesOfMeshes(const json& description) {
    std::map<std::string, GltfFaces> faces;
    const json& accessors = member(description, "accessors");
    const json& meshes = member(description, "meshes");
    for (std::size_t i = 0; meshes.is_array() && i < meshes.size(); ++i) {
        const std::string given = textOf(member(meshes[i], "name"));
        const std::string name = given.empty() ? "meshes[" + std::to_string(i) + "]" : given;
        const json& parts = member(meshes[i], "primitives");
        for (std::size_t part = 0; parts.is_array() && part < parts.size(); ++part) {
            const std::string suffix = parts.size() > 1 ? "-" + std::to_string(part) : "";
            addPart(facesOfPart(parts[part], accessors), faces[name + suffix]);
        }
    }
    return faces;
}

} // namespace

std::optional<GltfDescription> readGltfDescription(const std::filesystem::path& path) {
    const json description = readJson(path);
    if (!textOf(member(member(description, "asset"), "version")).starts_with("2")) {
        return std::nullopt;
    }
    GltfDescription result;
    result.faces = facesOfMeshes(description);
    const json& extensions = member(description, "extensionsRequired");
    for (const json& extension : extensions.is_array() ? extensions : json::array()) {
        result.required_extensions.push_back(textOf(extension));
    }
    return result;
}

} // namespace quarn
