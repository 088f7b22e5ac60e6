#include "import/stl/StlReader.h"

#include "import/WritingProgram.h"
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
    constexpr std::size_t HEADER_BYTES = 80;
    const std::string_view file = textOf(reading.bytes);
    const bool is_text = !hasBinaryStlLength(file) && isText(file);
    Result<SourceScene> scene = is_text ? readTextStl(reading) : readBinaryStl(reading);
    if (!scene)
        return scene;
    // The format states no unit. What is printed or milled from it, does in millimetres.
    scene.value().units = UnitSystem::millimeters;
    scene.value().up = upAxisOf(
        reading.up, file.substr(0, HEADER_BYTES),
        {{"Exported from Blender", "Blender", UpAxis::z}, {"OpenSCAD", "OpenSCAD", UpAxis::z}});
    return scene;
}

} // namespace quarn
