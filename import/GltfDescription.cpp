#include "import/GltfDescription.h"

#include "import/ModelFileCheck.h"

#include <nlohmann/json.hpp>

#include <algorithm>
#include <array>
#include <cstring>
#include <fstream>
#include <limits>
#include <string_view>

namespace quarn {
namespace {

using nlohmann::json;

/// Copies JSON; texts that are longer than any name become empty ones. Takes it piece by piece.
class WithoutLongTexts {
public:
    void append(std::string_view piece) {
        while (!piece.empty()) {
            piece.remove_prefix(m_is_inside ? appendText(piece) : appendRest(piece));
        }
    }

    const std::string& json() const { return m_json; }

private:
    /// Up to and with the quotation mark that begins the next text.
    std::size_t appendRest(std::string_view piece) {
        const std::size_t quote = piece.find('"');
        m_is_inside = quote != std::string_view::npos;
        const std::size_t count = m_is_inside ? quote + 1 : piece.size();
        m_json.append(piece.substr(0, count));
        m_begin = m_json.size();
        return count;
    }

    /// Up to and with the quotation mark that ends the text.
    std::size_t appendText(std::string_view piece) {
        if (m_is_escaped) {
            m_is_escaped = false;
            keep(piece.substr(0, 1));
            return 1;
        }
        const std::size_t quote = piece.find('"');
        const std::size_t end = std::min(quote, piece.substr(0, quote).find('\\'));
        if (end == std::string_view::npos) {
            keep(piece);
            return piece.size();
        }
        m_is_escaped = piece[end] == '\\';
        m_is_inside = m_is_escaped;
        keep(piece.substr(0, end + (m_is_escaped ? 1 : 0)));
        if (!m_is_inside) {
            endText();
        }
        return end + 1;
    }

    void keep(std::string_view piece) {
        constexpr std::size_t longest = 4096;
        m_is_long = m_is_long || m_json.size() - m_begin + piece.size() > longest;
        if (!m_is_long) {
            m_json.append(piece);
        }
    }

    void endText() {
        if (m_is_long) {
            m_json.resize(m_begin);
        }
        m_is_long = false;
        m_json += '"';
    }

    std::string m_json;
    std::size_t m_begin = 0;  ///< of the text
    bool m_is_inside = false; ///< of a text
    bool m_is_escaped = false;
    bool m_is_long = false;
};

std::uint32_t littleEndian(const char* bytes) {
    std::uint32_t value = 0;
    for (int i = 3; i >= 0; --i) {
        value = value << 8 | static_cast<unsigned char>(bytes[i]);
    }
    return value;
}

/// How many bytes of JSON begin at the file's place now; a GLB states it in its header.
std::uint64_t textLength(std::istream& file, bool is_binary) {
    if (!is_binary) {
        return std::numeric_limits<std::uint64_t>::max();
    }
    std::array<char, 20> head{};
    file.read(head.data(), head.size());
    const bool is_known = file.gcount() == static_cast<std::streamsize>(head.size()) &&
                          littleEndian(&head[4]) == 2 && std::memcmp(&head[16], "JSON", 4) == 0;
    return is_known ? littleEndian(&head[12]) : 0;
}

json readJson(const std::filesystem::path& path) {
    std::ifstream file(path, std::ios::binary);
    std::uint64_t left = textLength(file, modelFormat(path) == "glb");
    std::vector<char> piece(std::size_t{1} << 18);
    WithoutLongTexts text;
    while (left > 0 && file) {
        const std::uint64_t wanted = std::min<std::uint64_t>(left, piece.size());
        file.read(piece.data(), static_cast<std::streamsize>(wanted));
        const auto count = static_cast<std::size_t>(file.gcount());
        text.append({piece.data(), count});
        left -= count;
    }
    return json::parse(text.json(), nullptr, false);
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
