#pragma once

#include "ground/Result.h"

#include <filesystem>
#include <functional>
#include <memory>
#include <string_view>
#include <vector>

namespace quarn {

/// The font that came with the program: what texts in pictures and films are written with.
std::filesystem::path programFont();

/// A place on the border of a letter, from where its line of text begins; y runs down.
struct LetterPoint {
    double x_px;
    double y_px;
};

/// The letters of a font, for lines of text. A size is that of the em square, as in files of
/// drawings. Letters that the font lacks are boxes. Cheap to copy.
class Letters {
public:
    /// @param font  a TrueType file; must be one that came with the program
    /// @return an error, sentences that name the file, when it cannot be read or is no font
    static Result<Letters> read(const std::filesystem::path& font);

    /// Whether the font lacks none of a text's letters.
    bool have(std::string_view utf8) const;

    /// How far a text reaches to the right.
    /// @param spread_px  put between its letters
    double width(std::string_view utf8, double size_px, double spread_px = 0) const;

    /// The borders of its letters, to be filled by the rule of the winding number.
    std::vector<std::vector<LetterPoint>> outlines(std::string_view utf8, double size_px,
                                                   double spread_px = 0) const;

    /// Hands over the pixels that a text covers, and how much of each.
    /// @param x_px, y_px  where it begins, on the line that letters stand on
    void shade(std::string_view utf8, double size_px, double x_px, double y_px,
               const std::function<void(int x, int y, double share)>& cover) const;

private:
    struct Font;
    explicit Letters(std::shared_ptr<const Font> font) : m_font(std::move(font)) {}
    template <class Place>
    double place(std::string_view utf8, double scale, double spread_px, const Place& place) const;
    double scaleOf(double size_px) const;

    std::shared_ptr<const Font> m_font;
};

} // namespace quarn
