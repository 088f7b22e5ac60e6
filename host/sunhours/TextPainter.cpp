#include "host/sunhours/TextPainter.h"

#include "ground/FileBytes.h"
#include "ground/PathText.h"
#include "kelmar/KM_wString.h"

#include <cmath>

#pragma GCC diagnostic push
#pragma GCC diagnostic ignored "-Wunused-function"
#define STB_TRUETYPE_IMPLEMENTATION
#define STBTT_STATIC
#include <stb_truetype.h>
#pragma GCC diagnostic pop

namespace quarn {

struct TextPainter::Font {
    FileBytes bytes;
    stbtt_fontinfo info{};
};

namespace {

/// Calls `place` with each letter and where its origin stands; gives back where the text ends.
template <class Place>
double eachLetter(const stbtt_fontinfo& font, std::string_view utf8, double scale,
                  const Place& place) {
    const KM_wString text = KM_wString::FromUtf8(utf8);
    double x = 0.0;
    int before = 0;
    for (const wchar_t letter : text.View()) {
        const int glyph = stbtt_FindGlyphIndex(&font, static_cast<int>(letter));
        if (before != 0)
            x += scale * stbtt_GetGlyphKernAdvance(&font, before, glyph);
        place(glyph, x);
        int advance = 0;
        int bearing = 0;
        stbtt_GetGlyphHMetrics(&font, glyph, &advance, &bearing);
        x += scale * advance;
        before = glyph;
    }
    return x;
}

} // namespace

TextPainter::TextPainter(std::unique_ptr<Font> font) : m_font(std::move(font)) {}
TextPainter::TextPainter(TextPainter&&) noexcept = default;
TextPainter::~TextPainter() = default;

Result<TextPainter> TextPainter::open(const std::filesystem::path& file) {
    auto bytes = readFileBytes(file);
    const std::string name = textFromPath(file).ToUtf8();
    if (!bytes)
        return Error{"Cannot read the font " + name + ": " + bytes.message() +
                     ". Install the program with all its files."};
    auto font = std::make_unique<Font>(Font{std::move(bytes.value()), {}});
    const auto* const data = reinterpret_cast<const unsigned char*>(font->bytes.bytes().data());
    if (font->bytes.bytes().empty() ||
        !stbtt_InitFont(&font->info, data, stbtt_GetFontOffsetForIndex(data, 0)))
        return Error{name + " is no font. Install the program with all its files."};
    return TextPainter(std::move(font));
}

double TextPainter::width(std::string_view utf8, double size_px) const {
    const double scale =
        double{stbtt_ScaleForPixelHeight(&m_font->info, static_cast<float>(size_px))};
    return eachLetter(m_font->info, utf8, scale, [](int, double) {});
}

void TextPainter::draw(Image& image, double x, double y, std::string_view utf8, double size_px,
                       KM_Color color) const {
    const float scale = stbtt_ScaleForPixelHeight(&m_font->info, static_cast<float>(size_px));
    eachLetter(m_font->info, utf8, double{scale}, [&](int glyph, double along) {
        const double left = x + along;
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
                cover(image, static_cast<int>(whole) + right + i,
                      static_cast<int>(std::lround(y)) + down + j, color,
                      shades[j * width + i] / 255.0);
        stbtt_FreeBitmap(shades, nullptr);
    });
}

void cover(Image& image, int x, int y, KM_Color color, double share) {
    if (x < 0 || y < 0 || x >= image.width || y >= image.height)
        return;
    std::uint8_t* const pixel =
        &image.rgba[4 * (static_cast<std::size_t>(y) * static_cast<std::size_t>(image.width) +
                         static_cast<std::size_t>(x))];
    const std::uint8_t over[3] = {color.r, color.g, color.b};
    for (int c = 0; c < 3; ++c)
        pixel[c] = static_cast<std::uint8_t>(std::lround(pixel[c] + share * (over[c] - pixel[c])));
}

} // namespace quarn
