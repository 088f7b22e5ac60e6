#include "host/letters/Letters.h"

#include "ground/FileBytes.h"
#include "ground/ModuleFile.h"
#include "ground/PathText.h"
#include "kelmar/KM_wString.h"

#include <algorithm>
#include <cmath>

#pragma GCC diagnostic push
#pragma GCC diagnostic ignored "-Wunused-function"
#define STBTT_STATIC
#define STB_TRUETYPE_IMPLEMENTATION
#include <stb_truetype.h>
#pragma GCC diagnostic pop

namespace quarn {

struct Letters::Font {
    FileBytes bytes;
    stbtt_fontinfo info{};

    int glyphOf(wchar_t letter) const {
        return stbtt_FindGlyphIndex(&info, static_cast<int>(letter));
    }
};

namespace {

/// A curve of a letter becomes so many lines; letters are small.
constexpr int LINES_OF_CURVE = 6;

using Outline = std::vector<LetterPoint>;

struct FreeShape {
    const stbtt_fontinfo& font;
    void operator()(stbtt_vertex* shape) const { stbtt_FreeShape(&font, shape); }
};

void addCurve(Outline& outline, const LetterPoint& bend, const LetterPoint& end) {
    const LetterPoint start = outline.back();
    for (int i = 1; i <= LINES_OF_CURVE; ++i) {
        const double t = static_cast<double>(i) / LINES_OF_CURVE;
        const double a = (1 - t) * (1 - t);
        const double b = 2 * t * (1 - t);
        outline.push_back({a * start.x_px + b * bend.x_px + t * t * end.x_px,
                           a * start.y_px + b * bend.y_px + t * t * end.y_px});
    }
}

void addOutlines(const stbtt_fontinfo& font, int glyph, double x_px, double scale,
                 std::vector<Outline>& outlines) {
    const auto at = [&](int x, int y) { return LetterPoint{x_px + scale * x, -scale * y}; };
    stbtt_vertex* found = nullptr;
    const int count = stbtt_GetGlyphShape(&font, glyph, &found);
    const std::unique_ptr<stbtt_vertex, FreeShape> shape(found, FreeShape{font});
    for (int i = 0; i < count; ++i) {
        const stbtt_vertex& vertex = found[i];
        if (vertex.type == STBTT_vmove)
            outlines.emplace_back();
        if (vertex.type == STBTT_vcurve)
            addCurve(outlines.back(), at(vertex.cx, vertex.cy), at(vertex.x, vertex.y));
        else
            outlines.back().push_back(at(vertex.x, vertex.y));
    }
}

} // namespace

std::filesystem::path programFont() {
    return installedTree() / "share" / "quarn" / "fonts" / "DejaVuSans.ttf";
}

Result<Letters> Letters::read(const std::filesystem::path& file) {
    constexpr std::size_t MOST_BYTES = std::size_t{64} << 20;
    constexpr std::size_t LEAST_BYTES = 12; // of the table that a font begins with
    auto bytes = readFileBytes(file, MOST_BYTES);
    const std::string name = textFromPath(file).ToUtf8();
    const std::string remedy = " Install the program with all its files.";
    if (!bytes)
        return Error{"Cannot read the font " + name + ": " + bytes.message() + "." + remedy};
    auto font = std::make_shared<Font>(Font{std::move(bytes.value()), {}});
    const auto found = font->bytes.bytes();
    const auto* const data = reinterpret_cast<const unsigned char*>(found.data());
    const int offset = found.size() < LEAST_BYTES ? -1 : stbtt_GetFontOffsetForIndex(data, 0);
    if (offset < 0 || !stbtt_InitFont(&font->info, data, offset))
        return Error{name + " is no font that letters can be drawn with." + remedy};
    return Letters(std::move(font));
}

/// Calls `place` with each glyph and where its origin stands; gives back where the text ends.
template <class Place>
double Letters::place(std::string_view utf8, double scale, double spread_px,
                      const Place& place) const {
    const KM_wString text = KM_wString::FromUtf8(utf8);
    double x_px = 0.0;
    int before = 0;
    for (const wchar_t letter : text.View()) {
        const int glyph = m_font->glyphOf(letter);
        if (before != 0)
            x_px += scale * stbtt_GetGlyphKernAdvance(&m_font->info, before, glyph);
        place(glyph, x_px);
        int advance = 0;
        int bearing = 0;
        stbtt_GetGlyphHMetrics(&m_font->info, glyph, &advance, &bearing);
        x_px += scale * advance + spread_px;
        before = glyph;
    }
    return x_px;
}

double Letters::scaleOf(double size_px) const {
    return double{stbtt_ScaleForMappingEmToPixels(&m_font->info, static_cast<float>(size_px))};
}

bool Letters::have(std::string_view utf8) const {
    const KM_wString text = KM_wString::FromUtf8(utf8);
    return std::ranges::all_of(text.View(),
                               [&](wchar_t letter) { return m_font->glyphOf(letter) != 0; });
}

double Letters::width(std::string_view utf8, double size_px, double spread_px) const {
    return place(utf8, scaleOf(size_px), spread_px, [](int, double) {});
}

std::vector<Outline> Letters::outlines(std::string_view utf8, double size_px,
                                       double spread_px) const {
    const double scale = scaleOf(size_px);
    std::vector<Outline> outlines;
    place(utf8, scale, spread_px,
          [&](int glyph, double x_px) { addOutlines(m_font->info, glyph, x_px, scale, outlines); });
    return outlines;
}

void Letters::shade(std::string_view utf8, double size_px, double x_px, double y_px,
                    const std::function<void(int x, int y, double share)>& cover) const {
    const auto scale = static_cast<float>(scaleOf(size_px));
    const int line = static_cast<int>(std::lround(y_px));
    place(utf8, double{scale}, 0, [&](int glyph, double along_px) {
        const double left = x_px + along_px;
        const double whole = std::floor(left);
        int width = 0;
        int height = 0;
        int right = 0;
        int down = 0;
        unsigned char* const shades = stbtt_GetGlyphBitmapSubpixel(
            &m_font->info, scale, scale, static_cast<float>(left - whole), 0.0F, glyph, &width,
            &height, &right, &down);
        for (int j = 0; shades && j < height; ++j)
            for (int i = 0; i < width; ++i)
                cover(static_cast<int>(whole) + right + i, line + down + j,
                      shades[j * width + i] / 255.0);
        stbtt_FreeBitmap(shades, nullptr);
    });
}

} // namespace quarn
