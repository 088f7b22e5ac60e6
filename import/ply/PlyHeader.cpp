#include "import/ply/PlyHeader.h"

#include "import/text/LineCursor.h"
#include "import/text/Words.h"

#include <algorithm>
#include <utility>

namespace quarn {

namespace {

constexpr std::uint64_t MOST_LINES = 10'000;
constexpr std::uint64_t MOST_ELEMENTS = 1'000'000'000'000; // of a kind

constexpr std::pair<std::string_view, PlyType> TYPES[] = {
    {"char", PlyType::int8},       {"int8", PlyType::int8},       {"uchar", PlyType::uint8},
    {"uint8", PlyType::uint8},     {"short", PlyType::int16},     {"int16", PlyType::int16},
    {"ushort", PlyType::uint16},   {"uint16", PlyType::uint16},   {"int", PlyType::int32},
    {"int32", PlyType::int32},     {"uint", PlyType::uint32},     {"uint32", PlyType::uint32},
    {"float", PlyType::float32},   {"float32", PlyType::float32}, {"double", PlyType::float64},
    {"float64", PlyType::float64},
};

std::optional<PlyType> typeOf(std::string_view name) {
    const auto* const found =
        std::ranges::find(TYPES, name, &std::pair<std::string_view, PlyType>::first);
    return found == std::end(TYPES) ? std::nullopt : std::optional(found->second);
}

std::string_view withoutBlanksAround(std::string_view text) {
    skipBlanks(text);
    while (!text.empty() && isBlank(text.back()))
        text.remove_suffix(1);
    return text;
}

bool readFormat(std::string_view words, PlyHeader& header) {
    const std::string_view format = takeWord(words);
    if (format == "binary_little_endian")
        header.format = PlyFormat::little_endian;
    else if (format == "binary_big_endian")
        header.format = PlyFormat::big_endian;
    return header.format != PlyFormat::text || format == "ascii";
}

bool readElement(std::string_view words, PlyHeader& header) {
    PlyElement element;
    element.name = takeWord(words);
    const auto count = takeNumber<std::uint64_t>(words);
    element.count = count.value_or(0);
    header.elements.push_back(std::move(element));
    return count && *count <= MOST_ELEMENTS;
}

bool readProperty(std::string_view words, PlyHeader& header) {
    std::string_view type = takeWord(words);
    PlyProperty property;
    if (type == "list") {
        property.count_type = typeOf(takeWord(words));
        type = takeWord(words);
        if (!property.count_type || *property.count_type >= PlyType::float32)
            return false;
    }
    const std::optional<PlyType> known = typeOf(type);
    property.name = takeWord(words);
    if (!known || header.elements.empty())
        return false;
    property.type = *known;
    header.elements.back().properties.push_back(std::move(property));
    return true;
}

/// Lines that begin with other words are passed over.
bool readLine(std::string_view line, PlyHeader& header) {
    const std::string_view first = takeWord(line);
    if (first == "format")
        return readFormat(line, header);
    if (first == "element")
        return readElement(line, header);
    if (first == "property")
        return readProperty(line, header);
    if (first == "comment" || first == "obj_info")
        header.comments.emplace_back(withoutBlanksAround(line));
    return true;
}

/// That the file ends before the contents would, however they are.
Result<void> checkCounts(const PlyHeader& header, std::uint64_t left) {
    for (const PlyElement& element : header.elements) {
        const std::uint64_t least = std::max<std::uint64_t>(1, element.leastBytes(header.format));
        if (!element.properties.empty() &&
            element.count > (left + 1) / least) // the last line may lack its line break
            return endsBefore(element);
    }
    return {};
}

} // namespace

bool PlyElement::hasList() const {
    return std::ranges::any_of(properties, &PlyProperty::isList);
}

std::uint64_t PlyElement::leastBytes(PlyFormat format) const {
    std::uint64_t bytes = 0;
    for (const PlyProperty& property : properties)
        if (format == PlyFormat::text)
            bytes += property.isList() ? 0 : 2;
        else
            bytes += bytesOf(property.count_type.value_or(property.type));
    return bytes;
}

Result<PlyHeader> readPlyHeader(std::string_view file) {
    if (!file.starts_with("ply"))
        return Error{"it is not a PLY file, whatever its name says"};
    PlyHeader header;
    header.line_break = lineBreakOf(file.substr(0, 4096));
    LineCursor lines(file, header.line_break);
    std::string_view line;
    lines.next(line);
    while (lines.number() < MOST_LINES && lines.next(line)) {
        std::string_view words = line;
        if (takeWord(words) == "end_header") {
            header.bytes = file.size() - lines.rest().size();
            const Result<void> checked = checkCounts(header, lines.rest().size());
            return checked ? Result<PlyHeader>(std::move(header)) : checked.error();
        }
        if (!readLine(line, header))
            return Error{"its PLY header is damaged: line " + std::to_string(lines.number()) +
                         " holds " + quotedWord(withoutBlanksAround(line))};
    }
    return Error{"its PLY header is damaged: it has no end"};
}

Error endsBefore(const PlyElement& element) {
    return {"it claims " + std::to_string(element.count) + " elements of kind '" + element.name +
            "' but ends before them"};
}

} // namespace quarn
