#pragma once

#include "ground/Result.h"
#include "host/sunpath/Drawing.h"

#include <filesystem>
#include <memory>

namespace quarn {

/// The letters of a font as areas to be filled.
class LetterShapes {
public:
    /// @param font  a TrueType file
    /// @return an error that names the file, when it cannot be read or is no font
    static Result<LetterShapes> read(const std::filesystem::path& font);

    /// The outlines of a line of text where it stands.
    std::vector<std::vector<DrawnPoint>> outlinesOf(const DrawnText& text) const;

private:
    struct Font;
    explicit LetterShapes(std::shared_ptr<const Font> font) : m_font(std::move(font)) {}
    double addLetter(char32_t letter, const DrawnText& text, double x_px,
                     std::vector<std::vector<DrawnPoint>>& outlines) const;

    std::shared_ptr<const Font> m_font;
};

} // namespace quarn
