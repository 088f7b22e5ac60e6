#include "import/stl/StlReader.h"

#include "import/stl/StlBinary.h"
#include "import/stl/StlText.h"
#include "import/text/LineCursor.h"
#include "import/text/Words.h"

#include <algorithm>

namespace quarn {

namespace {

/// The headers of binary files may begin as texts do; they are padded with zeros, or their counts
/// contain one.
bool isText(std::string_view file) {
    constexpr std::string_view FIRST_WORD = "solid";
    const std::string_view begin = file.substr(0, 84);
    if (begin.find('\0') != std::string_view::npos)
        return false;
    std::string_view rest = withoutByteOrderMark(begin);
    while (!rest.empty() && (isBlank(rest.front()) || rest.front() == '\n'))
        rest.remove_prefix(1);
    return std::ranges::equal(rest.substr(0, FIRST_WORD.size()), FIRST_WORD,
                              [](char a, char b) { return (a | 0x20) == b; });
}

} // namespace

Result<SourceScene> readStl(const ModelReading& reading) {
    const std::string_view file = textOf(reading.bytes);
    return !hasBinaryStlLength(file) && isText(file) ? readTextStl(reading)
                                                     : readBinaryStl(reading);
}

} // namespace quarn
