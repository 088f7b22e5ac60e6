#pragma once

#include "engine/images/Image.h"
#include "host/letters/Letters.h"
#include "kelmar/KM_Color.h"

namespace quarn {

/// Draws text into pictures.
class TextPainter {
public:
    explicit TextPainter(Letters letters) : m_letters(std::move(letters)) {}

    const Letters& letters() const { return m_letters; }

    /// How far a text reaches to the right.
    /// @param size_px  from the lowest descender to the highest ascender
    double width(std::string_view utf8, double size_px) const;
    /// Draws one line of text; what lies outside the picture is left out.
    /// @param x, y  where it begins, on the line that letters stand on
    void draw(Image& image, double x, double y, std::string_view utf8, double size_px,
              KM_Color color) const;

private:
    Letters m_letters;
};

/// Lays a colour over a pixel; one outside the picture is left out.
void cover(Image& image, int x, int y, KM_Color color, double share);

} // namespace quarn
