#include "import/ply/PlyContents.h"

#include "import/text/LineCursor.h"

#include <algorithm>
#include <utility>

namespace quarn {

namespace {

std::uint64_t bytesOf(const std::vector<PlyPart>& parts) {
    std::uint64_t bytes = 0;
    for (const PlyPart& part : parts)
        bytes += part.bytes.size();
    return bytes;
}

} // namespace

PlyContents::PlyContents(const ModelReading& reading, std::string_view file, PlyHeader header,
                         std::vector<PlyPart> parts)
    : m_reading(reading), m_file(file), m_header(std::move(header)), m_parts(std::move(parts)),
      m_progress(reading.watch, ReadingStep::read, bytesOf(m_parts)) {}

std::span<const PlyPart> PlyContents::partsOf(std::size_t kind) const {
    const auto is_before = [](const PlyPart& part, std::size_t wanted) {
        return part.kind < wanted;
    };
    const auto begin = std::lower_bound(m_parts.begin(), m_parts.end(), kind, is_before);
    const auto end = std::lower_bound(begin, m_parts.end(), kind + 1, is_before);
    return {begin, end};
}

bool PlyContents::isWanted(const char* place) {
    const std::lock_guard lock(m_failing);
    return m_fault == nullptr || place < m_fault;
}

void PlyContents::finish(const PlyPart& part) {
    if (!m_progress.goesOn(part.bytes.size()))
        fail("it was given up");
}

void PlyContents::fail(const PlyPart& part, std::uint64_t element, const char* place,
                       std::string_view why) {
    if (!isWanted(place))
        return;
    std::string subject;
    if (m_header.format == PlyFormat::text)
        subject = "line " + std::to_string(lineNumberAt(m_file, place, m_header.line_break));
    else
        subject = m_header.elements[part.kind].name + " " + std::to_string(element + 1) +
                  " at byte " + std::to_string(place - m_file.data());
    fail(place, subject + " " + std::string(why));
}

void PlyContents::fail(const char* place, std::string why) {
    const std::lock_guard lock(m_failing);
    if (m_fault != nullptr && m_fault <= place)
        return;
    m_fault = place;
    m_why = std::move(why);
}

} // namespace quarn
