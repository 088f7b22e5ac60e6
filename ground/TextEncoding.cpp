#include "ground/TextEncoding.h"

#include "kelmar/KM_wString.h"

namespace quarn {
namespace {

std::string latin1From(std::wstring_view text) {
    std::string bytes;
    bytes.reserve(text.size());
    for (const wchar_t character : text) {
        const auto code = static_cast<unsigned long>(character);
        bytes += code <= 0xFF ? static_cast<char>(code) : '?';
    }
    return bytes;
}

} // namespace

std::string encodeTextFile(std::wstring_view text, TextEncoding encoding) {
    if (encoding == TextEncoding::latin1) {
        return latin1From(text);
    }
    const std::string mark = encoding == TextEncoding::utf8_bom ? "\xEF\xBB\xBF" : "";
    return mark + KM_wString(text).ToUtf8();
}

} // namespace quarn
