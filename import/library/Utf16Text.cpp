#include "import/library/Utf16Text.h"

#include "import/text/WideText.h"

#include <algorithm>

namespace quarn {

namespace {

constexpr std::string_view TEXT_FORMATS[] = {"dae", "xml", "irr", "irrmesh", "ase",
                                             "ac",  "amf", "x3d", "xgl",     "nff"};

/// An XML file states its encoding once more; what is handed on is no longer true to it.
void correctDeclaration(std::string& text) {
    const std::size_t end = text.starts_with("<?xml") ? text.find("?>") : std::string::npos;
    const std::size_t at = text.find("encoding");
    const std::size_t quote = at < end ? text.find_first_of("\"'", at) : std::string::npos;
    if (end == std::string::npos || quote >= end)
        return;
    const std::size_t closing = text.find(text[quote], quote + 1);
    if (closing < end)
        text.replace(quote + 1, closing - quote - 1, "UTF-8");
}

} // namespace

std::optional<std::string> utf8OfWideFile(std::string_view format,
                                          std::span<const std::uint8_t> bytes) {
    if (std::ranges::find(TEXT_FORMATS, format) == std::ranges::end(TEXT_FORMATS))
        return std::nullopt;
    std::optional<std::string> text = utf8OfWideText(bytes);
    if (text)
        correctDeclaration(*text);
    return text;
}

} // namespace quarn
