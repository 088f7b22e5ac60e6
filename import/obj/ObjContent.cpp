#include "import/obj/ObjContent.h"

#include "import/ReadingProgress.h"
#include "import/assembly/StoredColor.h"
#include "import/obj/ObjIndices.h"
#include "import/obj/ObjPieces.h"
#include "import/text/LineCursor.h"

#include <tbb/parallel_for.h>

#include <algorithm>
#include <atomic>
#include <mutex>
#include <utility>

namespace quarn {

namespace {

constexpr std::size_t BYTES_OF_A_PART = std::size_t{1} << 19;

bool endsWithBackslash(std::string_view part, char line_break) {
    while (!part.empty() && (part.back() == line_break || part.back() == '\r'))
        part.remove_suffix(1);
    return part.ends_with('\\');
}

/// Parts between statements, of which each may have several lines.
std::vector<std::string_view> partsOfStatements(std::string_view text, char line_break) {
    std::vector<std::string_view> parts;
    for (const std::string_view lines : partsOfLines(text, BYTES_OF_A_PART, line_break)) {
        if (!parts.empty() && endsWithBackslash(parts.back(), line_break))
            parts.back() = {parts.back().data(), parts.back().size() + lines.size()};
        else
            parts.push_back(lines);
    }
    return parts;
}

/// The parts of a file, read by several threads.
class PartsReading {
public:
    PartsReading(std::string_view text, char line_break, const ModelReading& reading)
        : m_texts(partsOfStatements(text, line_break)), m_line_break(line_break),
          m_budget(reading.budget), m_progress(reading.watch, ReadingStep::read, text.size()),
          m_parts(m_texts.size()) {}

    Result<std::vector<ObjPart>> read() {
        tbb::parallel_for(std::size_t{0}, m_texts.size(), [this](std::size_t i) { readPart(i); });
        if (m_is_ended)
            return m_failure;
        return std::move(m_parts);
    }

private:
    void readPart(std::size_t i) {
        if (m_is_ended)
            return;
        m_parts[i] = readObjPart(m_texts[i], m_line_break, i + 1 == m_texts.size());
        if (const Result<void> taken = m_budget.take(m_parts[i].bytes(), "lines"); !taken)
            end(taken.error());
        else if (!m_progress.goesOn(m_texts[i].size()))
            end({"it was given up"});
    }

    void end(Error failure) {
        const std::lock_guard lock(m_mutex);
        if (!m_is_ended)
            m_failure = std::move(failure);
        m_is_ended = true;
    }

    std::vector<std::string_view> m_texts;
    char m_line_break;
    ReadingBudget& m_budget;
    ReadingProgress m_progress;
    std::vector<ObjPart> m_parts;
    std::atomic<bool> m_is_ended = false;
    std::mutex m_mutex;
    Error m_failure;
};

/// Moves the tables of the parts into one.
template <class T>
std::vector<T> joined(std::vector<ObjPart>& parts, std::vector<T> ObjPart::*table) {
    std::vector<std::size_t> begins;
    std::size_t all = 0;
    for (const ObjPart& part : parts) {
        begins.push_back(all);
        all += (part.*table).size();
    }
    std::vector<T> whole(all);
    tbb::parallel_for(std::size_t{0}, parts.size(), [&](std::size_t i) {
        const std::vector<T> own = std::exchange(parts[i].*table, {});
        std::copy(own.begin(), own.end(), whole.begin() + static_cast<std::ptrdiff_t>(begins[i]));
    });
    return whole;
}

/// Colours of files that count to 255 come down to 1.
std::vector<KM_Color> takeColors(std::vector<ObjPart>& parts) {
    constexpr float LARGEST_OF_UNIT = 2.0F; // some go a little beyond 1
    float largest = 0.0F;
    bool has_colors = false;
    for (ObjPart& part : parts) {
        largest = std::max(largest, part.largest_color);
        has_colors = has_colors || !part.colors.empty();
    }
    if (!has_colors)
        return {};
    const float factor = largest > LARGEST_OF_UNIT ? 1.0F / 255.0F : 1.0F;
    std::vector<KM_Color> colors;
    for (ObjPart& part : parts) {
        part.colors.resize(part.places.size(), NO_OBJ_COLOR);
        for (const auto& [r, g, b] : std::exchange(part.colors, {}))
            colors.push_back(r < 0.0F ? KM_Color{255, 255, 255, 255}
                                      : colorFromSrgb(factor * r, factor * g, factor * b, 1.0F));
    }
    return colors;
}

/// "; so do 3 other lines", or nothing.
std::string othersToo(std::uint64_t others, std::string_view thing, std::string_view one_does,
                      std::string_view many_do) {
    if (others == 0)
        return {};
    return "; " + std::to_string(others) + " other " + std::string(thing) +
           std::string(others == 1 ? one_does : many_do);
}

std::string sentenceOf(ObjFault kind, const ObjFaults& faults, std::uint64_t line) {
    const std::string in_line = "ine " + std::to_string(line);
    const std::uint64_t others = faults.count - 1;
    switch (kind) {
    case ObjFault::free_form:
        return "Free-form curves and surfaces were left out: they begin in l" + in_line +
               ". Export them as meshes.";
    case ObjFault::keyword:
        return "L" + in_line + " " + faults.why + ", which is not known" +
               othersToo(others, "line", " is not known either", "s are not known either") + ".";
    case ObjFault::index:
        return "L" + in_line + " " + faults.why +
               othersToo(others, "ind", "ex names nothing either", "ices name nothing either") +
               ".";
    case ObjFault::statement:
        break;
    }
    return "L" + in_line + " " + faults.why +
           othersToo(others, "line", " is damaged too", "s are damaged too") + ".";
}

std::vector<std::string> tellFaults(const std::vector<ObjPart>& parts, std::string_view text,
                                    char line_break) {
    std::vector<std::string> sentences;
    for (const ObjFault kind :
         {ObjFault::free_form, ObjFault::keyword, ObjFault::index, ObjFault::statement}) {
        ObjFaults all;
        for (const ObjPart& part : parts) {
            const ObjFaults& some = part.faults[static_cast<std::size_t>(kind)];
            if (all.count == 0)
                all = some;
            else
                all.count += some.count;
        }
        if (all.count > 0)
            sentences.push_back(sentenceOf(kind, all, lineNumberAt(text, all.place, line_break)));
    }
    return sentences;
}

} // namespace

Result<ObjContent> readObjContent(std::string_view text, const ModelReading& reading) {
    const char line_break = lineBreakOf(text);
    Result<std::vector<ObjPart>> parts = PartsReading(text, line_break, reading).read();
    if (!parts)
        return parts.error();
    ObjContent content;
    content.parts = std::move(parts.value());
    resolveIndices(content.parts, line_break);
    content.colors = takeColors(content.parts);
    content.places = joined(content.parts, &ObjPart::places);
    content.textures = joined(content.parts, &ObjPart::textures);
    content.normals = joined(content.parts, &ObjPart::normals);
    takePieces(content);
    content.faults = tellFaults(content.parts, text, line_break);
    return content;
}

} // namespace quarn
