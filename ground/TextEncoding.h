#pragma once

#include <string>
#include <string_view>

namespace quarn {

/// How a text file stores its characters; the numbers are those of CQnTextFile's file types.
enum class TextEncoding : int {
    latin1 = 0,   ///< one byte a character; characters above U+00FF become '?'
    utf8 = 1,     ///< UTF-8
    utf8_bom = 2, ///< UTF-8 after a byte-order mark, which tells a browser what the file is
};

/// The bytes of a text file. Line breaks stay as they are. An empty text is an empty file, but for
/// its byte-order mark.
std::string encodeTextFile(std::wstring_view text, TextEncoding encoding);

} // namespace quarn
