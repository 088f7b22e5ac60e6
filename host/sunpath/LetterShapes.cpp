#include "host/sunpath/LetterShapes.h"

#include "ground/FileBytes.h"
#include "kelmar/KM_wString.h"

#define STBTT_STATIC
#define STB_TRUETYPE_IMPLEMENTATION
#include <stb_truetype.h>

namespace quarn {
namespace {

/// A curve of a letter becomes so many lines; letters are small.
constexpr int LINES_OF_CURVE = 6;

struct FreeShape {
    const stbtt_fontinfo& font;
    void operator()(stbtt_vertex* shape) const { stbtt_FreeShape(&font, shape); }
};

void addCurve(std::vector<DrawnPoint>& outline, const DrawnPoint& bend, const DrawnPoint& end) {
    const DrawnPoint start = outline.back();
    for (int i = 1; i <= LINES_OF_CURVE; ++i) {
        const double t = static_cast<double>(i) / LINES_OF_CURVE;
        const double a = (1 - t) * (1 - t);
        const double b = 2 * t * (1 - t);
        outline.push_back({a * start.x_px + b * bend.x_px + t * t * end.x_px,
                           a * start.y_px + b * bend.y_px + t * t * end.y_px});
    }
}

} // namespace

struct LetterShapes::Font {
    std::vector<unsigned char> bytes;
    stbtt_fontinfo info{};
};

Result<LetterShapes> LetterShapes::read(const std::filesystem::path& font) {
    constexpr std::size_t MOST_BYTES = std::size_t{64} << 20;
    const auto file = readFileBytes(font, MOST_BYTES);
    if (!file)
        return Error{"Cannot read the font " + font.native() + ": " + file.message() +
                     ". Install the program with all its files."};
    auto read = std::make_shared<Font>();
    const auto found = file.value().bytes();
    read->bytes.assign(found.begin(), found.end());
    const unsigned char* const bytes = read->bytes.data();
    const int offset = read->bytes.size() < 12 ? -1 : stbtt_GetFontOffsetForIndex(bytes, 0);
    if (offset < 0 || !stbtt_InitFont(&read->info, bytes, offset))
        return Error{font.native() + " is no font that letters can be drawn with: install "
                                     "fonts-dejavu-core again."};
    return LetterShapes(std::move(read));
}

double LetterShapes::addLetter(char32_t letter, const DrawnText& text, double x_px,
                               std::vector<std::vector<DrawnPoint>>& outlines) const {
    const stbtt_fontinfo& font = m_font->info;
    // The size of a text is that of the em square, as in files of drawings.
    const double scale = stbtt_ScaleForMappingEmToPixels(&font, static_cast<float>(text.size_px));
    const auto place = [&](int x, int y) {
        return DrawnPoint{x_px + scale * x, text.place.y_px - scale * y};
    };
    const int glyph = stbtt_FindGlyphIndex(&font, static_cast<int>(letter));
    stbtt_vertex* found = nullptr;
    const int count = stbtt_GetGlyphShape(&font, glyph, &found);
    const std::unique_ptr<stbtt_vertex, FreeShape> shape(found, FreeShape{font});
    for (int i = 0; i < count; ++i) {
        const stbtt_vertex& vertex = found[i];
        if (vertex.type == STBTT_vmove)
            outlines.emplace_back();
        if (vertex.type == STBTT_vcurve)
            addCurve(outlines.back(), place(vertex.cx, vertex.cy), place(vertex.x, vertex.y));
        else
            outlines.back().push_back(place(vertex.x, vertex.y));
    }
    int advance = 0;
    int bearing = 0;
    stbtt_GetGlyphHMetrics(&font, glyph, &advance, &bearing);
    return scale * advance;
}

std::vector<std::vector<DrawnPoint>> LetterShapes::outlinesOf(const DrawnText& text) const {
    std::vector<std::vector<DrawnPoint>> outlines;
    double x_px = text.place.x_px;
    const double spread_px = text.is_bold ? 0.06 * text.size_px : 0;
    for (const wchar_t letter : std::wstring(KM_wString::FromUtf8(text.text).View()))
        x_px += addLetter(static_cast<char32_t>(letter), text, x_px, outlines) + spread_px;
    const double width_px = x_px - text.place.x_px;
    const double shift_px = text.anchor == TextAnchor::start    ? 0
                            : text.anchor == TextAnchor::middle ? width_px / 2
                                                                : width_px;
    for (auto& outline : outlines)
        for (DrawnPoint& point : outline)
            point.x_px -= shift_px;
    return outlines;
}

} // namespace quarn
