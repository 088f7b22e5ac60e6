#pragma once

#include <cstdint>
#include <filesystem>
#include <fstream>
#include <string_view>
#include <vector>

namespace quarn {

/// Hands out the lines of a text file one after the other, fast, with little memory.
class LineReader {
public:
    explicit LineReader(const std::filesystem::path& path);

    /// @param line  receives the next line without its line break; valid until the next call
    /// @return false at the end of the file
    bool next(std::string_view& line);

    /// Of the line handed out last, from 1.
    std::uint64_t number() const { return m_number; }

private:
    void readMore();

    std::ifstream m_file;
    std::vector<char> m_bytes;
    std::size_t m_at = 0;
    std::size_t m_end = 0;
    std::uint64_t m_number = 0;
};

/// The words of a line, which blanks part.
class LineWords {
public:
    explicit LineWords(std::string_view line) : m_rest(line) {}

    /// The next word; empty at the end of the line.
    std::string_view next() {
        std::size_t begin = 0;
        while (begin < m_rest.size() && isBlank(m_rest[begin])) {
            ++begin;
        }
        std::size_t end = begin;
        while (end < m_rest.size() && !isBlank(m_rest[end])) {
            ++end;
        }
        const std::string_view word = m_rest.substr(begin, end - begin);
        m_rest.remove_prefix(end);
        return word;
    }

private:
    static bool isBlank(char c) { return c == ' ' || c == '\t' || c == '\r'; }

    std::string_view m_rest;
};

} // namespace quarn
