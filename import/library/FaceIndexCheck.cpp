#include "import/library/FaceIndexCheck.h"

#include "import/files/ModelFileCheck.h"
#include "import/library/LineReader.h"
#include "import/library/PlyHeader.h"

#include <charconv>
#include <fstream>

namespace quarn {
namespace {

std::string inLine(std::uint64_t line) {
    return "line " + std::to_string(line) + " ";
}

std::string quoted(std::string_view word) {
    constexpr std::size_t longest = 40;
    std::string text = "'";
    for (const char c : word.substr(0, longest)) {
        text += static_cast<unsigned char>(c) < 32 ? '?' : c;
    }
    return text + (word.size() > longest ? "...'" : "'");
}

/// Reads a whole word as a number that is not negative.
/// @return false for anything else; true, with the largest number, for one that is larger
bool readNumber(std::string_view word, std::uint64_t& number) {
    const char* const end = word.data() + word.size();
    const char* const begin = word.data() + (word.starts_with('+') ? 1 : 0);
    const auto [rest, failure] = std::from_chars(begin, end, number);
    if (failure == std::errc::result_out_of_range) {
        number = UINT64_MAX;
    }
    return failure != std::errc::invalid_argument && rest == end;
}

/// Whether so many words stand on a line; faster than taking them one by one.
bool hasWords(std::string_view line, std::size_t wanted) {
    std::size_t count = 0;
    bool was_blank = true;
    for (const char c : line) {
        const bool is_blank = c == ' ' || c == '\t' || c == '\r';
        count += was_blank && !is_blank ? 1 : 0;
        was_blank = is_blank;
    }
    return count >= wanted;
}

/// Takes a number of at most ten digits and the blanks before it.
/// @return the number, or one that is larger than any index
std::uint64_t takeShortNumber(const char*& at, const char* end) {
    while (at != end && *at == ' ') {
        ++at;
    }
    const char* const begin = at;
    std::uint64_t number = 0;
    while (at != end && *at >= '0' && *at <= '9' && at - begin < 10) {
        number = 10 * number + static_cast<std::uint64_t>(*at++ - '0');
    }
    return at == begin || (at != end && *at != ' ' && *at != '\r') ? UINT64_MAX : number;
}

/// Checks the lines of faces: a count, and so many indices.
class FaceCheck {
public:
    explicit FaceCheck(std::uint64_t vertices) : m_vertices(vertices) {}

    /// Whether a line is one of the usual ones, which are in order. Of any other one nothing is
    /// said.
    bool isUsual(std::string_view line) const {
        const char* at = line.data();
        const char* const end = at + line.size();
        const std::uint64_t count = takeShortNumber(at, end);
        bool is_usual = count <= line.size();
        for (std::uint64_t i = 0; is_usual && i < count; ++i) {
            is_usual = takeShortNumber(at, end) < m_vertices;
        }
        return is_usual;
    }

    /// @return what is wrong with the list that begins with the next word; empty when nothing is
    std::string check(LineWords& words, bool holds_indices) const {
        const std::string_view stated = words.next();
        std::uint64_t count = 0;
        if (stated.empty()) {
            return "ends where the number of corners belongs";
        }
        if (!readNumber(stated, count)) {
            return "holds " + quoted(stated) + " where the number of corners belongs";
        }
        for (std::uint64_t i = 0; i < count; ++i) {
            const std::string_view word = words.next();
            if (word.empty()) {
                return "ends after " + std::to_string(i) + " of " + std::to_string(count) +
                       " corners";
            }
            if (holds_indices && !isVertex(word)) {
                return whyNoVertex(word);
            }
        }
        return {};
    }

private:
    bool isVertex(std::string_view word) const {
        std::uint64_t index = 0;
        return readNumber(word, index) && index < m_vertices;
    }

    std::string whyNoVertex(std::string_view word) const {
        std::uint64_t index = 0;
        const bool is_negative =
            word.size() > 1 && word.front() == '-' && readNumber(word.substr(1), index);
        if (!is_negative && !readNumber(word, index)) {
            return "holds " + quoted(word) + ", which is no index of a vertex";
        }
        return "holds the index " + std::string(word.substr(0, 40)) +
               ", which is out of range: there are " + std::to_string(m_vertices) + " vertices";
    }

    std::uint64_t m_vertices;
};

class PlyCheck {
public:
    PlyCheck(LineReader& lines, const PlyHeader& header)
        : m_lines(lines), m_header(header), m_faces(vertexCount(header)) {}

    std::string why() {
        for (const PlyElement& element : m_header.elements) {
            const Kind kind = kindOf(element);
            for (std::uint64_t i = 0; i < element.count; ++i) {
                std::string_view line;
                if (!m_lines.next(line)) {
                    return "it ends after " + std::to_string(i) + " of " +
                           std::to_string(element.count) + " elements of kind '" + element.name +
                           "'";
                }
                const std::string why =
                    isUsual(line, element, kind) ? std::string() : whyBadLine(line, element);
                if (!why.empty()) {
                    return inLine(m_lines.number()) + why;
                }
            }
        }
        return {};
    }

private:
    enum class Kind { indices, numbers, mixed };

    static Kind kindOf(const PlyElement& element) {
        if (!element.hasList()) {
            return Kind::numbers;
        }
        const bool is_face = element.name == "face" && element.properties.size() == 1 &&
                             namesVertices(element.properties.front());
        return is_face ? Kind::indices : Kind::mixed;
    }

    /// A quick look at the lines that nearly all files are made of.
    bool isUsual(std::string_view line, const PlyElement& element, Kind kind) const {
        return kind == Kind::indices
                   ? m_faces.isUsual(line)
                   : kind == Kind::numbers && hasWords(line, element.properties.size());
    }

    static std::uint64_t vertexCount(const PlyHeader& header) {
        for (const PlyElement& element : header.elements) {
            if (element.name == "vertex") {
                return element.count;
            }
        }
        return 0;
    }

    /// Lists of other elements than faces are left alone: exporters that leave out a face element
    /// of no faces state its list behind the vertices' numbers, and write none there.
    std::string whyBadLine(std::string_view line, const PlyElement& element) const {
        LineWords words(line);
        std::size_t read = 0;
        for (const PlyProperty& property : element.properties) {
            const bool is_list = property.count_bytes > 0;
            if (is_list && element.name != "face") {
                return {};
            }
            const std::string why = is_list ? m_faces.check(words, namesVertices(property))
                                            : whyNoNumber(words.next(), read, element);
            if (!why.empty()) {
                return why;
            }
            ++read;
        }
        return {};
    }

    static bool namesVertices(const PlyProperty& property) {
        return property.name == "vertex_indices" || property.name == "vertex_index";
    }

    static std::string whyNoNumber(std::string_view word, std::size_t read,
                                   const PlyElement& element) {
        return word.empty() ? "holds " + std::to_string(read) + " of the " +
                                  std::to_string(element.properties.size()) + " numbers of a '" +
                                  element.name + "'; all must stand on one line"
                            : std::string();
    }

    LineReader& m_lines;
    const PlyHeader& m_header;
    FaceCheck m_faces;
};

std::string whyBadPlyIndices(const std::filesystem::path& path) {
    std::ifstream file(path, std::ios::binary);
    std::string magic;
    std::getline(file, magic);
    const auto header = readPlyHeader(file);
    if (!header || !header->text) {
        return {};
    }
    LineReader lines(path);
    for (std::string_view line; lines.next(line) && !line.starts_with("end_header");) {
    }
    return PlyCheck(lines, *header).why();
}

} // namespace

std::string whyBadIndices(const std::filesystem::path& path) {
    const std::string format = modelFormat(path);
    return format == "ply" ? whyBadPlyIndices(path) : std::string();
}

} // namespace quarn
