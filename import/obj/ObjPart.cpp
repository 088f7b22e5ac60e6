#include "import/obj/ObjPart.h"

#include "import/obj/ObjStatements.h"
#include "import/text/LineCursor.h"
#include "import/text/Words.h"

#include <utility>

namespace quarn {

namespace {

/// With its changes and the piece that it may become.
constexpr std::size_t BYTES_OF_A_SECTION = 512;

template <class T> std::size_t bytesOf(const std::vector<T>& list) {
    return list.capacity() * sizeof(T);
}

bool goesOnBelow(std::string_view line) {
    while (!line.empty() && line.back() == '\r')
        line.remove_suffix(1);
    return !line.empty() && line.back() == '\\';
}

bool isComment(std::string_view line) {
    skipBlanks(line);
    return line.starts_with('#');
}

/// A line with those that a backslash at its end joins to it.
std::string_view joinedLines(std::string_view line, LineCursor& lines, ObjPart& part) {
    std::string& all = part.joined.emplace_back(line);
    while (goesOnBelow(line)) {
        all[all.rfind('\\')] = ' ';
        if (!lines.next(line))
            break;
        all += line;
    }
    return all;
}

} // namespace

ObjPart readObjPart(std::string_view text, char line_break, bool is_last,
                    const std::function<bool(const ObjPart& part, const char* place)>& goes_on) {
    ObjPart part;
    part.text = text;
    ObjStatements statements(part);
    LineCursor lines(text, line_break);
    for (std::string_view line; lines.next(line);) {
        const char* const place = line.data();
        if (goesOnBelow(line) && !isComment(line))
            line = joinedLines(line, lines, part);
        statements.read(line, place, is_last && !lines.wasEnded());
        if (goes_on && !goes_on(part, place))
            break;
    }
    return part;
}

std::size_t ObjPart::bytes() const {
    return bytesOf(places) + bytesOf(colors) + bytesOf(textures) + bytesOf(normals) +
           bytesOf(runs) + bytesOf(corners) + bytesOf(corner_textures) + bytesOf(corner_normals) +
           bytesOf(line_runs) + bytesOf(line_corners) + bytesOf(points) +
           sections.capacity() * BYTES_OF_A_SECTION;
}

void ObjPart::note(ObjFault kind, const char* place, std::string why) {
    ObjFaults& known = faults[static_cast<std::size_t>(kind)];
    if (known.count++ > 0)
        return;
    known.place = place;
    known.why = std::move(why);
}

} // namespace quarn
