#include "import/library/FaceIndexCheck.h"

#include "import/files/ModelFileCheck.h"
#include "import/library/LineReader.h"

#include <charconv>

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

/// Checks the lines of faces: a count, and so many indices.
class FaceCheck {
public:
    explicit FaceCheck(std::uint64_t vertices) : m_vertices(vertices) {}

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

class OffCheck {
public:
    explicit OffCheck(const std::filesystem::path& path) : m_lines(path) {}

    std::string why() {
        std::uint64_t counts[3] = {}; // of vertices, faces and edges
        std::string_view word = nextWord();
        if (word.ends_with("OFF")) {
            if (word.starts_with("n") || word.starts_with("4")) {
                return {}; // more coordinates than three
            }
            word = nextWord();
        }
        if (word == "BINARY") {
            return {};
        }
        for (std::uint64_t& count : counts) {
            if (!readNumber(word, count)) {
                return inLine(m_lines.number()) + "holds " + quoted(word) +
                       " where the numbers of vertices, faces and edges belong";
            }
            word = &count == &counts[2] ? word : nextWord();
        }
        return whyBadLines(counts[0], counts[1]);
    }

private:
    /// Across lines, without comments.
    std::string_view nextWord() {
        std::string_view word = m_words.next();
        while (word.empty() || word.front() == '#') {
            std::string_view line;
            if (!m_lines.next(line)) {
                return {};
            }
            m_words = LineWords(line);
            word = m_words.next();
        }
        return word;
    }

    bool nextFilledLine() {
        std::string_view line;
        while (m_lines.next(line)) {
            m_words = LineWords(line);
            if (!LineWords(line).next().empty()) {
                return true;
            }
        }
        return false;
    }

    std::string whyBadLines(std::uint64_t vertices, std::uint64_t faces) {
        for (std::uint64_t i = 0; i < vertices + faces; ++i) {
            if (!nextFilledLine()) {
                return "it claims " + std::to_string(vertices) + " vertices and " +
                       std::to_string(faces) + " faces but ends before them";
            }
            const std::string why =
                i < vertices ? whyBadVertex() : FaceCheck(vertices).check(m_words, true);
            if (!why.empty()) {
                return inLine(m_lines.number()) + why;
            }
        }
        return {};
    }

    std::string whyBadVertex() {
        for (int i = 0; i < 3; ++i) {
            if (m_words.next().empty()) {
                return "holds " + std::to_string(i) + " of the 3 coordinates of a vertex";
            }
        }
        return {};
    }

    LineReader m_lines;
    LineWords m_words{std::string_view()};
};

} // namespace

std::string whyBadIndices(const std::filesystem::path& path) {
    return modelFormat(path) == "off" ? OffCheck(path).why() : std::string();
}

} // namespace quarn
