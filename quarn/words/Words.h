#pragma once

#include <array>
#include <filesystem>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace quarn::program {

/// A point or a vector in model coordinates: x, y, z.
using Triple = std::array<double, 3>;

struct PixelSize {
    int width_px;
    int height_px;
};

/// Reads a whole word as a decimal number; the decimal mark is a point whatever the locale.
/// @return nothing for anything else, numbers out of range included
std::optional<int> wholeNumber(std::string_view word);
/// As wholeNumber, for any finite number.
std::optional<double> realNumber(std::string_view word);
/// Reads "x,y,z".
std::optional<Triple> triple(std::string_view word);
/// Reads "widthxheight".
std::optional<PixelSize> pixelSize(std::string_view word);

/// The shortest text that reads back as exactly this number; the decimal mark is a point.
std::string numberText(double value);
std::string tripleText(const Triple& point);

/// In ASCII letters alone.
std::string lowerCase(std::string_view ascii);

/// The longest name of a file, in bytes, that common file systems take.
inline constexpr std::size_t LONGEST_FILE_NAME = 255;

std::string utf8Text(std::wstring_view text);
/// The text that stands in UTF-8; the replacement character for what is no text.
std::wstring wideText(std::string_view utf8);

/// Whether the bytes are text in UTF-8.
bool isUtf8(std::string_view bytes);
/// Whether a line break or another control character is in there.
bool hasControlCharacter(std::string_view text);

/// Says why a path cannot stand in a script: a double quote or a control character would end or
/// change the command that it stands in.
/// @param subject  what the path is, for the message ("The model's path")
/// @return nothing when it can
std::optional<std::string> whyPathIsRefused(std::string_view subject,
                                            const std::filesystem::path& path);

/// Whether the file is a document of the host, by its extension.
bool isDocument(const std::filesystem::path& file);

/// The host command that opens a document, or reads a model file into the document that is there.
/// @param up         the axis that points up in a model file, "y" or "z"; empty: by its format
/// @param tolerance  how far meshes may lie beside its curved surfaces; 0: by its size
std::string readingLine(const std::filesystem::path& model, const std::string& up = "",
                        double tolerance = 0.0);

/// The text as one word of a command that a person types: in single quotes where a shell would read
/// more into it. It never ends a line: control characters stand as bash reads them in $'...'.
std::string shellWord(const std::string& text);

/// The words behind each other, as they can be pasted into a shell.
std::string shellCommand(const std::vector<std::string>& words);

/// The path as one word of a script, which no prompt takes for an option.
std::string quotedPath(const std::filesystem::path& path);

} // namespace quarn::program
