#include "import/off/OffBody.h"

#include "import/ReadingProgress.h"
#include "import/assembly/StoredColor.h"
#include "import/off/OffLines.h"
#include "import/text/LineCursor.h"

#include <tbb/parallel_for.h>

#include <algorithm>
#include <atomic>
#include <unordered_map>
#include <utility>

namespace quarn {

namespace {

constexpr std::size_t BYTES_OF_A_PART = std::size_t{1} << 19;

/// What reading takes for a byte of the file: a corner has two at least, and a number of four
/// bytes; a face without any has a colour.
constexpr std::uint64_t BYTES_FOR_A_BYTE = 10;

std::uint64_t filledLines(std::string_view text, char line_break) {
    std::uint64_t count = 0;
    LineCursor lines(text, line_break);
    for (std::string_view line; lines.next(line);)
        count += isFilledOffLine(line) ? 1 : 0;
    return count;
}

class BodyReading {
public:
    BodyReading(const OffHeader& header, char line_break, const ModelReading& reading)
        : m_header(header), m_line_break(line_break), m_reading(reading),
          m_progress(reading.watch, ReadingStep::read, header.body.size()) {}

    Result<OffBody> read(std::string_view text) {
        const std::uint64_t bytes = BYTES_FOR_A_BYTE * m_header.body.size();
        if (const Result<void> taken = m_reading.budget.take(bytes, "lines"); !taken)
            return taken.error();
        if (const Result<void> parted = makeParts(); !parted)
            return parted.error();
        if (!readParts())
            return Error{"it was given up"};
        for (const OffPart& part : m_body.parts)
            if (part.bad_place != nullptr)
                return Error{"line " +
                             std::to_string(lineNumberAt(text, part.bad_place, m_line_break)) +
                             " " + part.why_bad};
        takeColors();
        return std::move(m_body);
    }

private:
    Result<void> makeParts() {
        for (const std::string_view text :
             partsOfLines(m_header.body, BYTES_OF_A_PART, m_line_break))
            m_body.parts.push_back({.text = text});
        tbb::parallel_for(std::size_t{0}, m_body.parts.size(), [this](std::size_t i) {
            m_body.parts[i].first = filledLines(m_body.parts[i].text, m_line_break);
        });
        std::uint64_t all = 0;
        for (OffPart& part : m_body.parts)
            all += std::exchange(part.first, all);
        return all >= m_header.vertices + m_header.faces
                   ? Result<void>()
                   : Error{"it claims " + std::to_string(m_header.vertices) + " vertices and " +
                           std::to_string(m_header.faces) + " faces but ends before them"};
    }

    bool readParts() {
        const auto count = static_cast<std::size_t>(m_header.vertices);
        m_body.places.resize(count);
        m_body.textures.resize(m_header.has_textures ? count : 0);
        m_body.normals.resize(m_header.has_normals ? count : 0);
        m_colors.resize(m_header.has_colors ? count : 0);
        const OffTables tables{m_header, m_body.places, m_body.textures, m_body.normals, m_colors};
        std::atomic<bool> goes_on = true;
        tbb::parallel_for(std::size_t{0}, m_body.parts.size(), [&](std::size_t i) {
            if (!goes_on)
                return;
            readOffLines(m_body.parts[i], tables, m_line_break);
            if (!m_progress.goesOn(m_body.parts[i].text.size()))
                goes_on = false;
        });
        return goes_on;
    }

    /// Colours of files that count to 255 come down to 1.
    void takeColors() {
        float largest = 0.0F;
        for (const OffPart& part : m_body.parts)
            largest = std::max(largest, part.largest_color);
        m_factor = largest > 1.0F ? 1.0F / 255.0F : 1.0F;
        for (const std::array<float, 4>& color : std::exchange(m_colors, {}))
            m_body.colors.push_back(stored(color));
        for (OffPart& part : m_body.parts)
            takeFaceColors(part);
    }

    KM_Color stored(const std::array<float, 4>& color) const {
        const auto [r, g, b, a] = color;
        if (r < 0.0F)
            return {255, 255, 255, 255};
        return colorFromSrgb(m_factor * r, m_factor * g, m_factor * b,
                             a < 0.0F ? 1.0F : m_factor * a);
    }

    /// The corners of a face with a colour have that one, others that of their vertex.
    void takeFaceColors(OffPart& part) {
        if (part.face_colors.empty())
            return;
        m_body.has_face_colors = true;
        part.corner_colors = part.corners;
        std::size_t face = 0;
        std::uint32_t* corner = part.corner_colors.data();
        for (const FaceRun& run : part.runs)
            for (std::uint32_t i = 0; i < run.faces; ++i, ++face, corner += run.corners)
                if (part.face_colors[face][0] >= 0.0F)
                    std::fill_n(corner, run.corners, numberOf(stored(part.face_colors[face])));
                else if (!m_header.has_colors)
                    std::fill_n(corner, run.corners, ~0U);
    }

    std::uint32_t numberOf(const KM_Color& color) {
        const std::uint32_t key = static_cast<std::uint32_t>(color.r) << 24 |
                                  static_cast<std::uint32_t>(color.g) << 16 |
                                  static_cast<std::uint32_t>(color.b) << 8 | color.a;
        const auto [known, is_new] =
            m_numbers.try_emplace(key, static_cast<std::uint32_t>(m_body.colors.size()));
        if (is_new)
            m_body.colors.push_back(color);
        return known->second;
    }

    const OffHeader& m_header;
    char m_line_break;
    const ModelReading& m_reading;
    ReadingProgress m_progress;
    OffBody m_body;
    std::vector<std::array<float, 4>> m_colors; ///< of the vertices, as the file counts them
    float m_factor = 1.0F;
    std::unordered_map<std::uint32_t, std::uint32_t> m_numbers; ///< of colours of faces
};

} // namespace

Result<OffBody> readOffBody(const OffHeader& header, std::string_view text, char line_break,
                            const ModelReading& reading) {
    return BodyReading(header, line_break, reading).read(text);
}

} // namespace quarn
