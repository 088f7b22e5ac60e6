#include "import/ply/PlyBody.h"

#include "import/ply/PlyNumbers.h"
#include "import/text/LineCursor.h"
#include "import/text/Words.h"

#include <tbb/parallel_for.h>

#include <algorithm>

namespace quarn {

namespace {

constexpr std::size_t PART_BYTES = std::size_t{256} << 10;

/// Walks over the elements of a binary file.
class BinaryParting {
public:
    BinaryParting(const PlyHeader& header, std::string_view contents)
        : m_header(header), m_rest(contents) {}

    Result<std::vector<PlyPart>> part() {
        for (m_kind = 0; m_kind < m_header.elements.size(); ++m_kind) {
            const PlyElement& element = m_header.elements[m_kind];
            if (element.properties.empty() || element.count == 0)
                continue;
            if (!(element.hasList() ? walkLists(element) : stepOver(element)))
                return endsBefore(element);
        }
        return std::move(m_parts);
    }

private:
    void addPart(std::uint64_t first, std::uint64_t count, std::size_t bytes) {
        m_parts.push_back({m_kind, first, count, m_rest.substr(0, bytes)});
        m_rest.remove_prefix(bytes);
    }

    bool stepOver(const PlyElement& element) {
        const auto bytes = static_cast<std::size_t>(element.leastBytes(m_header.format));
        if (element.count > m_rest.size() / bytes)
            return false;
        const std::uint64_t most = std::max<std::uint64_t>(PART_BYTES / bytes, 1);
        for (std::uint64_t first = 0; first < element.count; first += most) {
            const std::uint64_t count = std::min(most, element.count - first);
            addPart(first, count, static_cast<std::size_t>(count) * bytes);
        }
        return true;
    }

    bool walkLists(const PlyElement& element) {
        std::size_t at = 0;
        std::uint64_t first = 0;
        for (std::uint64_t i = 0; i < element.count; ++i) {
            if (!stepOverOne(element, at))
                return false;
            if (at >= PART_BYTES || i + 1 == element.count) {
                addPart(first, i + 1 - first, at);
                first = i + 1;
                at = 0;
            }
        }
        return true;
    }

    bool stepOverOne(const PlyElement& element, std::size_t& at) const {
        for (const PlyProperty& property : element.properties) {
            std::uint64_t values = 1;
            if (property.isList()) {
                const std::size_t bytes = bytesOf(*property.count_type);
                if (bytes > m_rest.size() - at)
                    return false;
                const std::int64_t count =
                    plyWhole(m_rest.data() + at, *property.count_type, m_header.format);
                at += bytes;
                if (count < 0)
                    return false;
                values = static_cast<std::uint64_t>(count);
            }
            const std::size_t bytes = bytesOf(property.type);
            if (values > (m_rest.size() - at) / bytes)
                return false;
            at += static_cast<std::size_t>(values) * bytes;
        }
        return true;
    }

    const PlyHeader& m_header;
    std::string_view m_rest;
    std::size_t m_kind = 0;
    std::vector<PlyPart> m_parts;
};

bool isFilled(std::string_view line) {
    skipBlanks(line);
    return !line.empty();
}

/// Gives the lines of a text to the elements. Blank ones are passed over.
class TextParting {
public:
    TextParting(const PlyHeader& header, std::string_view contents)
        : m_header(header), m_pieces(partsOfLines(contents, PART_BYTES, header.line_break)) {}

    Result<std::vector<PlyPart>> part() {
        std::vector<std::uint64_t> counts(m_pieces.size());
        tbb::parallel_for(std::size_t{0}, m_pieces.size(),
                          [&](std::size_t i) { counts[i] = countFilled(m_pieces[i]); });
        for (std::size_t i = 0; i < m_pieces.size(); ++i)
            give(m_pieces[i], counts[i]);
        skipEmptyKinds();
        if (m_kind < m_header.elements.size())
            return Error{"it ends after " + std::to_string(m_first) + " of " +
                         std::to_string(m_header.elements[m_kind].count) + " elements of kind '" +
                         m_header.elements[m_kind].name + "'"};
        return std::move(m_parts);
    }

private:
    std::uint64_t countFilled(std::string_view piece) const {
        std::uint64_t count = 0;
        LineCursor lines(piece, m_header.line_break);
        for (std::string_view line; lines.next(line);)
            count += isFilled(line) ? 1 : 0;
        return count;
    }

    /// What has no properties has no lines.
    void skipEmptyKinds() {
        while (m_kind < m_header.elements.size() && (m_header.elements[m_kind].properties.empty() ||
                                                     m_first == m_header.elements[m_kind].count)) {
            ++m_kind;
            m_first = 0;
        }
    }

    void give(std::string_view piece, std::uint64_t filled) {
        while (filled > 0) {
            skipEmptyKinds();
            if (m_kind == m_header.elements.size())
                return; // lines that belong to nothing
            const std::uint64_t count = std::min(filled, m_header.elements[m_kind].count - m_first);
            m_parts.push_back({m_kind, m_first, count, piece});
            m_first += count;
            filled -= count;
            if (filled > 0)
                piece = withoutFilled(piece, count);
        }
    }

    std::string_view withoutFilled(std::string_view piece, std::uint64_t count) const {
        LineCursor lines(piece, m_header.line_break);
        for (std::string_view line; count > 0 && lines.next(line);)
            count -= isFilled(line) ? 1 : 0;
        return lines.rest();
    }

    const PlyHeader& m_header;
    std::vector<std::string_view> m_pieces;
    std::vector<PlyPart> m_parts;
    std::size_t m_kind = 0;
    std::uint64_t m_first = 0; ///< of the elements of that kind that have no line yet
};

} // namespace

Result<std::vector<PlyPart>> partsOfPly(const PlyHeader& header, std::string_view file) {
    const std::string_view contents = file.substr(header.bytes);
    return header.format == PlyFormat::text ? TextParting(header, contents).part()
                                            : BinaryParting(header, contents).part();
}

} // namespace quarn
