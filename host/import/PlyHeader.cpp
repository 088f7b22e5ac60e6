#include "host/import/PlyHeader.h"

#include <algorithm>
#include <array>
#include <optional>
#include <sstream>
#include <string_view>
#include <utility>
#include <vector>

namespace quarn {
namespace {

struct PlyProperty {
    int count_bytes = 0; ///< of the number before a list, 0 when it is no list
    int value_bytes = 0;
};

struct PlyElement {
    std::string name;
    std::uint64_t count = 0;
    std::vector<PlyProperty> properties;

    bool hasList() const {
        return std::any_of(properties.begin(), properties.end(),
                           [](const PlyProperty& p) { return p.count_bytes > 0; });
    }

    /// The least bytes that one of these takes, as text or as binary.
    std::uint64_t leastBytes(bool text) const {
        std::uint64_t bytes = 0;
        for (const PlyProperty& p : properties) {
            bytes += static_cast<std::uint64_t>(
                text ? 2 : (p.count_bytes ? p.count_bytes : p.value_bytes));
        }
        return bytes;
    }
};

struct PlyHeader {
    bool text = false;
    bool big_endian = false;
    std::vector<PlyElement> elements;
};

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

std::optional<PlyHeader> readHeader(std::istream& file) {
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

/// Steps over `count` elements with lists; false when the file ends before them.
class ListWalk {
public:
    ListWalk(std::istream& file, bool big_endian, std::uint64_t left)
        : m_file(file), m_big_endian(big_endian), m_left(left) {}

    bool skip(const PlyElement& element) {
        if (!element.hasList()) {
            const std::uint64_t bytes = element.count * element.leastBytes(false);
            return skipBytes(bytes);
        }
        for (std::uint64_t i = 0; i < element.count; ++i) {
            if (!skipOne(element)) {
                return false;
            }
        }
        return true;
    }

private:
    bool skipOne(const PlyElement& element) {
        for (const PlyProperty& p : element.properties) {
            std::uint64_t values = 1;
            if (p.count_bytes > 0 && !readCount(p.count_bytes, values)) {
                return false;
            }
            if (!skipBytes(values * static_cast<std::uint64_t>(p.value_bytes))) {
                return false;
            }
        }
        return true;
    }

    bool readCount(int bytes, std::uint64_t& count) {
        if (bytes > 4 || m_left < static_cast<std::uint64_t>(bytes)) {
            return false;
        }
        count = 0;
        for (int i = 0; i < bytes; ++i) {
            const auto byte = static_cast<std::uint64_t>(m_file.rdbuf()->sbumpc() & 0xFF);
            count = m_big_endian ? count << 8 | byte : count | byte << (8 * i);
        }
        m_left -= static_cast<std::uint64_t>(bytes);
        return true;
    }

    bool skipBytes(std::uint64_t bytes) {
        if (bytes > m_left) {
            return false;
        }
        m_left -= bytes;
        if (bytes > 64) {
            m_file.seekg(static_cast<std::streamoff>(bytes), std::ios::cur);
            return m_file.good();
        }
        for (std::uint64_t i = 0; i < bytes; ++i) {
            m_file.rdbuf()->sbumpc();
        }
        return true;
    }

    std::istream& m_file;
    bool m_big_endian;
    std::uint64_t m_left;
};

std::string endsBefore(const PlyElement& element) {
    return "it claims " + std::to_string(element.count) + " elements of kind '" + element.name +
           "' but ends before them";
}

} // namespace

std::string whyBadPly(std::istream& file, std::uint64_t size) {
    std::string magic;
    std::getline(file, magic);
    if (!magic.starts_with("ply")) {
        return "it is not a PLY file, whatever its name says";
    }
    const std::optional<PlyHeader> header = readHeader(file);
    if (!header) {
        return "its PLY header is damaged";
    }
    std::uint64_t left = size - static_cast<std::uint64_t>(file.tellg());
    for (const PlyElement& element : header->elements) {
        const std::uint64_t least = std::max<std::uint64_t>(1, element.leastBytes(header->text));
        if (element.count > (left + 1) / least) { // the last line may lack its line break
            return endsBefore(element);
        }
    }
    if (header->text) {
        return {};
    }
    ListWalk walk(file, header->big_endian, left);
    for (const PlyElement& element : header->elements) {
        if (!walk.skip(element)) {
            return endsBefore(element);
        }
    }
    return {};
}

} // namespace quarn
