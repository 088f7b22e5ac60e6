#include "import/library/PlyHeader.h"

#include <algorithm>
#include <array>
#include <sstream>
#include <string_view>
#include <utility>

namespace quarn {
namespace {

int bytesOf(std::string_view type) {
    static constexpr std::array<std::pair<std::string_view, int>, 16> sizes{{{"char", 1},
                                                                             {"uchar", 1},
                                                                             {"int8", 1},
                                                                             {"uint8", 1},
                                                                             {"short", 2},
                                                                             {"ushort", 2},
                                                                             {"int16", 2},
                                                                             {"uint16", 2},
                                                                             {"int", 4},
                                                                             {"uint", 4},
                                                                             {"int32", 4},
                                                                             {"uint32", 4},
                                                                             {"float", 4},
                                                                             {"float32", 4},
                                                                             {"double", 8},
                                                                             {"float64", 8}}};
    const auto found = std::find_if(sizes.begin(), sizes.end(),
                                    [type](const auto& entry) { return entry.first == type; });
    return found == sizes.end() ? 0 : found->second;
}

bool readProperty(std::istream& words, PlyHeader& header) {
    std::string type;
    words >> type;
    PlyProperty property;
    if (type == "list") {
        std::string count_type;
        words >> count_type >> type;
        property.count_bytes = bytesOf(count_type);
        if (property.count_bytes == 0) {
            return false;
        }
    }
    property.value_bytes = bytesOf(type);
    words >> property.name;
    if (property.value_bytes == 0 || header.elements.empty()) {
        return false;
    }
    header.elements.back().properties.push_back(property);
    return true;
}

bool readElement(std::istream& words, PlyHeader& header) {
    PlyElement element;
    std::string count;
    words >> element.name >> count;
    if (count.empty() || count.size() > 18 ||
        count.find_first_not_of("0123456789") != std::string::npos) {
        return false;
    }
    element.count = std::stoull(count);
    header.elements.push_back(std::move(element));
    return true;
}

bool readHeaderLine(const std::string& line, PlyHeader& header) {
    std::istringstream words(line);
    std::string first;
    words >> first;
    if (first == "format") {
        std::string format;
        words >> format;
        header.text = format == "ascii";
        header.big_endian = format == "binary_big_endian";
        return header.text || header.big_endian || format == "binary_little_endian";
    }
    if (first == "element") {
        return readElement(words, header);
    }
    return first == "property" ? readProperty(words, header) : true;
}

} // namespace

bool PlyElement::hasList() const {
    return std::any_of(properties.begin(), properties.end(),
                       [](const PlyProperty& p) { return p.count_bytes > 0; });
}

std::uint64_t PlyElement::leastBytes(bool text) const {
    std::uint64_t bytes = 0;
    for (const PlyProperty& p : properties) {
        const int of_text = p.count_bytes > 0 ? 0 : 2;
        const int of_binary = p.count_bytes > 0 ? p.count_bytes : p.value_bytes;
        bytes += static_cast<std::uint64_t>(text ? of_text : of_binary);
    }
    return bytes;
}

std::optional<PlyHeader> readPlyHeader(std::istream& file) {
    constexpr int most_lines = 10000;
    PlyHeader header;
    std::string line;
    for (int i = 0; i < most_lines && std::getline(file, line); ++i) {
        if (!line.empty() && line.back() == '\r') {
            line.pop_back();
        }
        if (line == "end_header") {
            return header;
        }
        if (!readHeaderLine(line, header)) {
            return std::nullopt;
        }
    }
    return std::nullopt;
}

} // namespace quarn
