#pragma once

#include <algorithm>
#include <cstddef>
#include <cstdint>
#include <cstring>
#include <span>
#include <string_view>
#include <vector>

namespace quarn {

/// The bytes of a file as characters.
inline std::string_view textOf(std::span<const std::uint8_t> bytes) {
    return {reinterpret_cast<const char*>(bytes.data()), bytes.size()};
}

/// A text without the three bytes by which some programs say that it is UTF-8.
inline std::string_view withoutByteOrderMark(std::string_view text) {
    return text.starts_with("\xEF\xBB\xBF") ? text.substr(3) : text;
}

/// What ends the lines of a text: a line feed, or a carriage return in files from old machines
/// where nothing follows it. A carriage return before a line feed counts as a blank of its line.
char lineBreakOf(std::string_view text);

/// Hands out the lines of a text in memory one after the other.
class LineCursor {
public:
    explicit LineCursor(std::string_view text, char line_break = '\n')
        : m_rest(text), m_line_break(line_break) {}

    /// @param line  receives the next line without its line break; it lies in the text, so that
    ///   its place there can be told
    /// @return false at the end of the text
    bool next(std::string_view& line) {
        if (m_rest.empty())
            return false;
        const void* const found = std::memchr(m_rest.data(), m_line_break, m_rest.size());
        m_was_ended = found != nullptr;
        const std::size_t length =
            m_was_ended ? static_cast<std::size_t>(static_cast<const char*>(found) - m_rest.data())
                        : m_rest.size();
        line = m_rest.substr(0, length);
        m_rest.remove_prefix(length + (m_was_ended ? 1 : 0));
        ++m_number;
        return true;
    }

    /// Of the line handed out last, from 1 in this text.
    std::uint64_t number() const { return m_number; }
    /// Whether a line break followed the line handed out last; only the last of all may have none.
    bool wasEnded() const { return m_was_ended; }
    /// What has not been handed out.
    std::string_view rest() const { return m_rest; }

private:
    std::string_view m_rest;
    char m_line_break;
    std::uint64_t m_number = 0;
    bool m_was_ended = true;
};

/// Parts a text between lines, for several threads.
/// @param bytes  about how many of them a part has; longer lines stay whole
/// @return the parts in their order, none empty; together they are the text
std::vector<std::string_view> partsOfLines(std::string_view text, std::size_t bytes,
                                           char line_break = '\n');

/// How many lines a text has; the last one counts with or without a line break.
std::uint64_t countLines(std::string_view text, char line_break = '\n');

/// The number, from 1, of the line in which a place of the text lies. Counts the lines before it:
/// for messages.
/// @param place  in the text or at its end
std::uint64_t lineNumberAt(std::string_view text, const char* place, char line_break = '\n');

} // namespace quarn
