#pragma once

#include "import/ply/PlyHeader.h"
#include "import/text/LineCursor.h"
#include "import/text/Words.h"

#include <algorithm>
#include <array>
#include <bit>
#include <cstring>
#include <limits>

namespace quarn {

/// The number of a type at a place of a binary file.
template <class Number> Number plyNumber(const char* at, PlyFormat format) {
    std::array<char, sizeof(Number)> bytes;
    std::memcpy(bytes.data(), at, bytes.size());
    constexpr bool IS_LITTLE = std::endian::native == std::endian::little;
    if ((format == PlyFormat::little_endian) != IS_LITTLE)
        std::ranges::reverse(bytes);
    return std::bit_cast<Number>(bytes);
}

/// A whole number; for those that are none, one that is neither a count nor an index.
inline std::int64_t plyWhole(const char* at, PlyType type, PlyFormat format) {
    switch (type) {
    case PlyType::int8:
        return plyNumber<std::int8_t>(at, format);
    case PlyType::uint8:
        return plyNumber<std::uint8_t>(at, format);
    case PlyType::int16:
        return plyNumber<std::int16_t>(at, format);
    case PlyType::uint16:
        return plyNumber<std::uint16_t>(at, format);
    case PlyType::int32:
        return plyNumber<std::int32_t>(at, format);
    case PlyType::uint32:
        return plyNumber<std::uint32_t>(at, format);
    case PlyType::float32:
    case PlyType::float64:
        break;
    }
    return -1;
}

inline double plyDouble(const char* at, PlyType type, PlyFormat format) {
    if (type == PlyType::float32)
        return static_cast<double>(plyNumber<float>(at, format));
    if (type == PlyType::float64)
        return plyNumber<double>(at, format);
    return static_cast<double>(plyWhole(at, type, format));
}

/// What became of a number that was asked for.
enum class PlyTaken {
    yes,
    ended, ///< there is none
    bad,   ///< there is something else
};

/// Hands out the numbers of a part of a binary file. What would lie behind its end is told, though
/// the parting has looked at all lengths: a file may be changed while it is read.
class PlyBinaryNumbers {
public:
    static constexpr bool IS_TEXT = false;

    PlyBinaryNumbers(std::string_view part, const PlyHeader& header)
        : m_at(part.data()), m_end(part.data() + part.size()), m_format(header.format) {}

    bool begin() {
        m_place = m_at;
        return true;
    }
    /// Where the element in hand begins.
    const char* place() const { return m_place; }
    bool isAtEnd() const { return false; }
    /// What stands where a number was asked for.
    std::string_view badWord() const { return {}; }

    PlyTaken take(PlyType type, double& number) {
        const std::size_t bytes = bytesOf(type);
        if (!has(bytes))
            return PlyTaken::ended;
        number = plyDouble(m_at, type, m_format);
        m_at += bytes;
        return PlyTaken::yes;
    }

    PlyTaken takeWhole(PlyType type, std::int64_t& number) {
        const std::size_t bytes = bytesOf(type);
        if (!has(bytes))
            return PlyTaken::ended;
        number = plyWhole(m_at, type, m_format);
        m_at += bytes;
        return PlyTaken::yes;
    }

    PlyTaken skip(PlyType type) {
        const std::size_t bytes = bytesOf(type);
        if (!has(bytes))
            return PlyTaken::ended;
        m_at += bytes;
        return PlyTaken::yes;
    }

private:
    bool has(std::size_t bytes) const { return bytes <= static_cast<std::size_t>(m_end - m_at); }

    const char* m_at;
    const char* m_end;
    const char* m_place = nullptr;
    PlyFormat m_format;
};

/// Hands out the numbers of a part of a text, a line for each element.
class PlyTextNumbers {
public:
    static constexpr bool IS_TEXT = true;

    PlyTextNumbers(std::string_view part, const PlyHeader& header)
        : m_lines(part, header.line_break) {}

    /// Goes to the next line with something on it.
    /// @return false where there is none
    bool begin() {
        do {
            if (!m_lines.next(m_rest))
                return false;
            m_place = m_rest.data();
            skipBlanks(m_rest);
        } while (m_rest.empty());
        return true;
    }

    const char* place() const { return m_place; }
    bool isAtEnd() {
        skipBlanks(m_rest);
        return m_rest.empty();
    }
    std::string_view badWord() const { return m_bad_word; }

    /// Some programs wrote "1.#QNAN" and the like for what is no number.
    PlyTaken take(PlyType, double& number) {
        if (const std::optional<double> taken = takeNumber<double>(m_rest)) {
            number = *taken;
            return PlyTaken::yes;
        }
        number = std::numeric_limits<double>::quiet_NaN();
        const PlyTaken what = takeBadWord();
        return m_bad_word.find(".#") == std::string_view::npos ? what : PlyTaken::yes;
    }

    PlyTaken takeWhole(PlyType, std::int64_t& number) {
        if (const std::optional<std::int64_t> taken = takeNumber<std::int64_t>(m_rest)) {
            number = *taken;
            return PlyTaken::yes;
        }
        return takeBadWord();
    }

    PlyTaken skip(PlyType) { return takeWord(m_rest).empty() ? PlyTaken::ended : PlyTaken::yes; }

private:
    PlyTaken takeBadWord() {
        m_bad_word = takeWord(m_rest);
        return m_bad_word.empty() ? PlyTaken::ended : PlyTaken::bad;
    }

    LineCursor m_lines;
    std::string_view m_rest; ///< of the line in hand
    const char* m_place = nullptr;
    std::string_view m_bad_word;
};

} // namespace quarn
