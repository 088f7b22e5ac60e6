#pragma once

#include "engine/images/Image.h"
#include "ground/Result.h"
#include "kelmar/KM_Color.h"

#include <filesystem>
#include <memory>
#include <string_view>

namespace quarn {

/// Draws text into pictures with the letters of a font file.
class TextPainter {
public:
    /// @param font  a TrueType file; must be one that came with the program
    /// @return an error where it cannot be read
    static Result<TextPainter> open(const std::filesystem::path& font);
    TextPainter(TextPainter&&) noexcept;
    ~TextPainter();

    /// How far a text reaches to the right.
    /// @param size_px  from the lowest descender to the highest ascender
    double width(std::string_view utf8, double size_px) const;
    /// Draws one line of text; what lies outside the picture is left out.
    /// @param x, y  where it begins, on the line that letters stand on
    void draw(Image& image, double x, double y, std::string_view utf8, double size_px,
              KM_Color color) const;

private:
    struct Font;
    explicit TextPainter(std::unique_ptr<Font> font);
    std::unique_ptr<Font> m_font;
};

/// Lays a colour over a pixel; one outside the picture is left out.
void cover(Image& image, int x, int y, KM_Color color, double share);

} // namespace quarn
