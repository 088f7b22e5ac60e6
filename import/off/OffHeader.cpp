#include "import/off/OffHeader.h"

#include "import/text/LineCursor.h"
#include "import/text/Words.h"

#include <optional>
#include <string>

namespace quarn {

namespace {

constexpr std::uint64_t LEAST_BYTES_OF_A_VERTEX = 6; // three numbers
constexpr std::uint64_t LEAST_BYTES_OF_A_FACE = 2;   // a number of corners

/// The words of the head, across lines and without comments.
class HeadWords {
public:
    HeadWords(std::string_view text, char line_break) : m_lines(text, line_break) {}

    /// @return empty at the end of the text
    std::string_view next() {
        std::string_view word = takeWord(m_line);
        while (word.empty() || word.front() == '#') {
            if (!m_lines.next(m_line))
                return {};
            word = takeWord(m_line);
        }
        return word;
    }

    std::uint64_t line() const { return m_lines.number(); }
    std::string_view below() const { return m_lines.rest(); }

private:
    LineCursor m_lines;
    std::string_view m_line;
};

bool take(std::string_view& keyword, std::string_view prefix) {
    if (!keyword.starts_with(prefix))
        return false;
    keyword.remove_prefix(prefix.size());
    return true;
}

std::string inLine(std::uint64_t line) {
    return "line " + std::to_string(line) + " ";
}

/// Reads "STCN4nOFF", of which everything before OFF may be missing.
/// @return the word behind it, or an error
Result<std::string_view> readKeyword(HeadWords& words, OffHeader& header) {
    std::string_view word = words.next();
    if (!word.ends_with("OFF"))
        return word;
    const std::string_view whole = word;
    header.has_textures = take(word, "ST");
    header.has_colors = take(word, "C");
    header.has_normals = take(word, "N");
    header.has_weights = take(word, "4");
    const bool has_dimension = take(word, "n");
    if (word != "OFF")
        return Error{inLine(words.line()) + "begins with " + quotedWord(whole) +
                     ", which is no kind of OFF file that is known"};
    word = words.next();
    if (has_dimension) {
        if (word != "3")
            return Error{"its vertices have " + quotedWord(word) +
                         " coordinates, and only those with 3 are read"};
        word = words.next();
    }
    if (word == "BINARY")
        return Error{"it is a binary OFF file, which is not read"};
    return word;
}

Result<OffHeader> checked(const OffHeader& header, std::uint64_t bytes) {
    // Divided, for their products may be too large; the last line may have no line break.
    const bool fits = header.vertices <= (bytes + 1) / LEAST_BYTES_OF_A_VERTEX &&
                      header.faces <= (bytes + 1 - header.vertices * LEAST_BYTES_OF_A_VERTEX) /
                                          LEAST_BYTES_OF_A_FACE;
    if (!fits)
        return Error{
            "it claims more vertices or faces than it holds: " + std::to_string(header.vertices) +
            " vertices and " + std::to_string(header.faces) + " faces"};
    return header;
}

} // namespace

bool isFilledOffLine(std::string_view line) {
    skipBlanks(line);
    return !line.empty() && line.front() != '#';
}

Result<OffHeader> readOffHeader(std::string_view text, char line_break) {
    OffHeader header;
    HeadWords words(text, line_break);
    const Result<std::string_view> first = readKeyword(words, header);
    if (!first)
        return first.error();
    std::string_view word = first.value();
    std::uint64_t edges = 0;
    for (std::uint64_t* const count : {&header.vertices, &header.faces, &edges}) {
        std::string_view rest = word;
        const std::optional<std::uint64_t> number = takeNumber<std::uint64_t>(rest);
        if (!number)
            return Error{inLine(words.line()) + "holds " + quotedWord(word) +
                         " where the numbers of vertices, faces and edges belong"};
        *count = *number;
        if (count != &edges)
            word = words.next();
    }
    header.body = words.below();
    return checked(header, header.body.size());
}

} // namespace quarn
