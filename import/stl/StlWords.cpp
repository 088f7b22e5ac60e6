#include "import/stl/StlWords.h"

#include "import/assembly/MeshPlacing.h"
#include "import/text/Words.h"

#include <algorithm>
#include <limits>

namespace quarn {

namespace {

constexpr std::size_t PART_BYTES = std::size_t{512} << 10;
constexpr std::string_view FACET_END = "endfacet";
constexpr const char* CUT_SHORT = "ends within a triangle: the file is cut short";

char lower(char c) {
    return c >= 'A' && c <= 'Z' ? static_cast<char>(c + 32) : c;
}

bool isWord(std::string_view word, std::string_view wanted) {
    return word.size() == wanted.size() && std::equal(word.begin(), word.end(), wanted.begin(),
                                                      [](char a, char b) { return lower(a) == b; });
}

bool isSpace(char c) {
    return isBlank(c) || c == '\n';
}

class PartReading {
public:
    PartReading(std::string_view text, const KM_3dPoint& origin) : m_rest(text), m_origin(origin) {}

    StlPart read() {
        for (std::string_view word = next(); !word.empty(); word = next())
            if (!readWord(word))
                return std::move(m_part);
        if (m_in_facet)
            fail(CUT_SHORT);
        return std::move(m_part);
    }

private:
    /// The next word; empty at the end.
    std::string_view next() {
        const auto* const begin = std::find_if_not(m_rest.begin(), m_rest.end(), isSpace);
        const auto* const end = std::find_if(begin, m_rest.end(), isSpace);
        const std::string_view word(begin, end);
        m_rest = {end, m_rest.end()};
        m_place = begin;
        return word;
    }

    std::string_view restOfLine() {
        std::string_view line = m_rest.substr(0, m_rest.find('\n'));
        m_rest.remove_prefix(line.size());
        skipBlanks(line);
        while (!line.empty() && isBlank(line.back()))
            line.remove_suffix(1);
        return line;
    }

    bool readWord(std::string_view word) {
        if (isWord(word, "vertex"))
            return readVertex();
        if (isWord(word, "facet"))
            return beginFacet();
        if (isWord(word, FACET_END))
            return endFacet();
        if (isWord(word, "outer") || isWord(word, "loop") || isWord(word, "endloop"))
            return m_in_facet || misplaced(word);
        if (m_in_facet)
            return misplaced(word);
        if (isWord(word, "solid")) {
            m_part.solids.push_back({restOfLine(), m_part.corners.size()});
            m_part.ends_solid = false;
            return true;
        }
        if (isWord(word, "endsolid")) {
            restOfLine();
            m_part.ends_solid = true;
            return true;
        }
        return misplaced(word);
    }

    bool misplaced(std::string_view word) {
        if (m_in_facet && m_rest.empty()) // a word that the file's end cuts off
            return fail(CUT_SHORT);
        return fail("holds " + quotedWord(word) + ", which does not belong there");
    }

    bool fail(std::string why) {
        m_part.fault = m_place;
        m_part.why = std::move(why);
        return false;
    }

    /// The normal is no matter, whatever words give it.
    bool beginFacet() {
        if (m_in_facet)
            return misplaced("facet");
        m_in_facet = true;
        m_facet.clear();
        for (int words = 0; words < 4; ++words) {
            const std::string_view rest = m_rest;
            if (isWord(next(), "outer")) {
                m_rest = rest;
                break;
            }
        }
        return true;
    }

    bool readVertex() {
        if (!m_in_facet)
            return misplaced("vertex");
        double numbers[3] = {};
        for (double& number : numbers) {
            std::string_view word = next();
            const std::string_view whole = word;
            if (word.empty())
                return fail(CUT_SHORT);
            const auto taken = takeNumber<double>(word);
            const bool is_none = whole.find(".#") != std::string_view::npos; // as some wrote it
            if (!taken && !is_none)
                return fail("holds " + quotedWord(whole) + " where a coordinate belongs");
            number = taken.value_or(std::numeric_limits<double>::quiet_NaN());
        }
        m_facet.push_back(placed({numbers[0], numbers[1], numbers[2]}));
        return true;
    }

    KM_3fPoint placed(const KM_3dPoint& point) {
        const KM_3dVector p = point - m_origin;
        if (!isUsableCoordinate(p.x) || !isUsableCoordinate(p.y) || !isUsableCoordinate(p.z)) {
            constexpr float NO_NUMBER = std::numeric_limits<float>::quiet_NaN();
            return {NO_NUMBER, NO_NUMBER, NO_NUMBER};
        }
        m_part.extent.add(point);
        return {static_cast<float>(p.x) + 0.0F, static_cast<float>(p.y) + 0.0F,
                static_cast<float>(p.z) + 0.0F};
    }

    bool endFacet() {
        if (!m_in_facet)
            return misplaced(FACET_END);
        if (m_facet.size() < 3)
            return fail("ends a triangle of " + std::to_string(m_facet.size()) + " corners");
        m_in_facet = false;
        for (std::size_t i = 2; i < m_facet.size(); ++i)
            m_part.corners.insert(m_part.corners.end(), {m_facet[0], m_facet[i - 1], m_facet[i]});
        return true;
    }

    std::string_view m_rest;
    KM_3dPoint m_origin;
    StlPart m_part;
    const char* m_place = nullptr; ///< of the word in hand
    bool m_in_facet = false;
    std::vector<KM_3fPoint> m_facet; ///< the corners of the one in hand
};

} // namespace

std::vector<std::string_view> partsOfStl(std::string_view text) {
    std::vector<std::string_view> parts;
    while (!text.empty()) {
        const std::size_t end = text.find(FACET_END, std::min(PART_BYTES, text.size()));
        parts.push_back(
            text.substr(0, end == std::string_view::npos ? end : end + FACET_END.size()));
        text.remove_prefix(parts.back().size());
    }
    return parts;
}

StlPart readStlPart(std::string_view text, const KM_3dPoint& origin) {
    return PartReading(text, origin).read();
}

} // namespace quarn
