#include "import/off/OffLines.h"

#include "import/text/LineCursor.h"
#include "import/text/Words.h"

#include <algorithm>
#include <cmath>
#include <optional>
#include <string>

namespace quarn {

namespace {

constexpr std::array<float, 4> NO_COLOR{-1.0F, -1.0F, -1.0F, -1.0F};

float finiteOrZero(double number) {
    const auto single = static_cast<float>(number);
    return std::isfinite(single) ? single : 0.0F;
}

class Lines {
public:
    Lines(OffPart& part, const OffTables& tables) : m_part(part), m_tables(tables) {}

    void read(char line_break) {
        LineCursor lines(m_part.text, line_break);
        std::uint64_t element = m_part.first;
        const OffHeader& header = m_tables.header;
        for (std::string_view line; m_part.bad_place == nullptr && lines.next(line);) {
            if (!isFilledOffLine(line))
                continue;
            m_line = line;
            if (element < header.vertices)
                readVertex(line, element);
            else if (element < header.vertices + header.faces)
                readFace(line);
            else
                return; // what stands there means nothing here
            ++element;
        }
    }

private:
    void readVertex(std::string_view rest, std::size_t vertex) {
        const OffHeader& header = m_tables.header;
        std::array<double, 4> place{0.0, 0.0, 0.0, 1.0};
        const std::size_t wanted = header.has_weights ? 4 : 3;
        for (std::size_t i = 0; i < wanted; ++i) {
            const std::optional<double> number = takeNumber<double>(rest);
            if (!number)
                return noCoordinate(rest, i, wanted);
            place[i] = *number;
        }
        m_tables.places[vertex] = {place[0] / place[3], place[1] / place[3], place[2] / place[3]};
        if (header.has_normals)
            m_tables.normals[vertex] = readNormal(rest);
        readColorAndTexture(rest, vertex);
    }

    void noCoordinate(std::string_view rest, std::size_t read, std::size_t wanted) {
        const std::string_view word = takeWord(rest);
        bad(word.empty() || word.front() == '#'
                ? "holds " + std::to_string(read) + " of the " + std::to_string(wanted) +
                      " coordinates of a vertex"
                : "holds " + quotedWord(word) + " where a coordinate belongs");
    }

    static KM_3fVector readNormal(std::string_view& rest) {
        const float x = finiteOrZero(takeNumber<double>(rest).value_or(0.0));
        const float y = finiteOrZero(takeNumber<double>(rest).value_or(0.0));
        const float z = finiteOrZero(takeNumber<double>(rest).value_or(0.0));
        return {x, y, z};
    }

    void readColorAndTexture(std::string_view rest, std::size_t vertex) {
        const OffHeader& header = m_tables.header;
        if (!header.has_colors && !header.has_textures)
            return;
        std::array<float, 6> numbers{};
        std::size_t count = takeRest(rest, numbers);
        if (header.has_textures && count >= 2) {
            m_tables.textures[vertex] = {numbers[count - 2], numbers[count - 1]};
            count -= 2;
        }
        if (header.has_colors)
            m_tables.colors[vertex] = colorOf(numbers, count);
    }

    static std::size_t takeRest(std::string_view rest, std::array<float, 6>& numbers) {
        std::size_t count = 0;
        while (count < numbers.size()) {
            const std::optional<double> number = takeNumber<double>(rest);
            if (!number)
                break;
            numbers[count++] = finiteOrZero(*number);
        }
        return count;
    }

    /// Three numbers, with or without an opacity. One alone counts in a list of colours that the
    /// file does not have.
    std::array<float, 4> colorOf(const std::array<float, 6>& numbers, std::size_t count) {
        if (count < 3)
            return NO_COLOR;
        std::array<float, 4> color{};
        for (std::size_t i = 0; i < 4; ++i) {
            color[i] = i < count ? std::max(numbers[i], 0.0F) : -1.0F;
            m_part.largest_color = std::max(m_part.largest_color, color[i]);
        }
        return color;
    }

    void readFace(std::string_view rest) {
        std::string_view word = takeWord(rest);
        const std::optional<std::uint64_t> count = indexOf(word);
        if (!count)
            return bad("holds " + quotedWord(word) + " where the number of corners belongs");
        m_corners.clear();
        while (m_corners.size() < *count) {
            word = takeWord(rest);
            const std::optional<std::uint64_t> index = indexOf(word);
            if (!index || *index >= m_tables.header.vertices)
                return badCorner(word, *count);
            m_corners.push_back(static_cast<std::uint32_t>(*index));
        }
        addFace(rest);
    }

    static std::optional<std::uint64_t> indexOf(std::string_view word) {
        return takeNumber<std::uint64_t>(word);
    }

    void badCorner(std::string_view word, std::uint64_t count) {
        if (word.empty() || word.front() == '#')
            return bad("ends after " + std::to_string(m_corners.size()) + " of " +
                       std::to_string(count) + " corners");
        const std::string_view digits = word.substr(word.front() == '-' ? 1 : 0);
        const bool is_number = !digits.empty() && std::ranges::all_of(digits, [](char c) {
            return c >= '0' && c <= '9';
        });
        bad(is_number ? "holds the index " + std::string(word.substr(0, 40)) +
                            ", which is out of range: there are " +
                            std::to_string(m_tables.header.vertices) + " vertices"
                      : "holds " + quotedWord(word) + ", which is no index of a vertex");
    }

    void addFace(std::string_view rest) {
        const std::size_t count = m_corners.size();
        if (count == 0)
            ++m_part.without_corners;
        else if (count == 1)
            m_part.points.push_back(m_corners.front());
        else if (count == 2)
            add(m_part.line_runs, m_part.line_corners);
        else {
            addColor(rest);
            add(m_part.runs, m_part.corners);
        }
    }

    void add(std::vector<FaceRun>& runs, std::vector<std::uint32_t>& corners) {
        const auto count = static_cast<std::uint32_t>(m_corners.size());
        if (runs.empty() || runs.back().corners != count)
            runs.push_back({count, 0});
        ++runs.back().faces;
        corners.insert(corners.end(), m_corners.begin(), m_corners.end());
    }

    void addColor(std::string_view rest) {
        std::array<float, 6> numbers{};
        const std::size_t count = takeRest(rest, numbers);
        const std::array<float, 4> color = colorOf(numbers, count);
        if (color != NO_COLOR || !m_part.face_colors.empty()) {
            m_part.face_colors.resize(m_faces, NO_COLOR);
            m_part.face_colors.push_back(color);
        }
        ++m_faces;
    }

    void bad(std::string why) {
        m_part.bad_place = m_line.data();
        m_part.why_bad = std::move(why);
    }

    OffPart& m_part;
    const OffTables& m_tables;
    std::string_view m_line;
    std::size_t m_faces = 0; ///< of three corners and more
    std::vector<std::uint32_t> m_corners;
};

} // namespace

void readOffLines(OffPart& part, const OffTables& tables, char line_break) {
    Lines(part, tables).read(line_break);
}

} // namespace quarn
