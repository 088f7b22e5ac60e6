#include "import/obj/ObjStatements.h"

#include "import/text/Words.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <span>
#include <utility>

namespace quarn {

namespace {

constexpr std::string_view WITHOUT_MEANING_HERE[] = {
    "s",        "mg",       "lod",        "usemap",    "maplib", "bevel",
    "c_interp", "d_interp", "shadow_obj", "trace_obj", "vp"};

constexpr std::string_view FREE_FORM[] = {
    "cstype", "deg", "bmat", "step",  "curv",  "curv2", "surf", "parm", "trim", "hole", "scrv",
    "sp",     "end", "con",  "ctech", "stech", "bzp",   "bsp",  "cdc",  "cdp",  "res"};

bool isOneOf(std::string_view word, std::span<const std::string_view> words) {
    return std::find(words.begin(), words.end(), word) != words.end();
}

bool isAtEnd(std::string_view rest) {
    return rest.empty() || rest.front() == '#';
}

/// @return how many numbers the line begins with, at most as many as `numbers` holds
template <std::size_t MOST>
int takeNumbers(std::string_view& rest, std::array<double, MOST>& numbers) {
    std::size_t count = 0;
    while (count < MOST) {
        const std::optional<double> number = takeNumber<double>(rest);
        if (!number)
            break;
        numbers[count++] = *number;
    }
    skipBlanks(rest);
    return static_cast<int>(count);
}

/// What a number whose rest the file's end cuts off may end with.
bool endsWithinNumber(std::string_view line) {
    return !line.empty() && std::string_view(".+-eE/").find(line.back()) != std::string_view::npos;
}

std::string tooFew(int count, std::string_view wanted) {
    return "holds " + std::to_string(count) + " of the " + std::string(wanted);
}

/// Parts that no corner before had are filled up.
void appendIndex(std::vector<std::uint32_t>& indices, std::size_t before, std::uint32_t index) {
    if (indices.empty() && index == OBJ_NO_INDEX)
        return;
    indices.resize(before, OBJ_NO_INDEX);
    indices.push_back(index);
}

void addToRuns(std::vector<FaceRun>& runs, std::size_t first_of_section, std::size_t corners) {
    const bool is_new = runs.size() == first_of_section || runs.back().corners != corners;
    if (is_new)
        runs.push_back({static_cast<std::uint32_t>(corners), 0});
    ++runs.back().faces;
}

} // namespace

ObjStatements::ObjStatements(ObjPart& part) : m_part(part) {
    m_part.sections.emplace_back();
}

void ObjStatements::read(std::string_view statement, const char* place, bool is_cut) {
    skipBlanks(statement);
    if (isAtEnd(statement))
        return;
    m_place = place;
    m_is_cut = is_cut;
    if (statement.front() == 'v')
        readVertexPart(statement);
    else if (statement.size() > 1 && statement.front() == 'f' && isBlank(statement[1]))
        readFace(statement.substr(2));
    else
        readOther(statement);
}

void ObjStatements::readVertexPart(std::string_view line) {
    if (line.size() > 1 && isBlank(line[1]))
        readPlace(line.substr(2));
    else if (line.size() > 2 && line[1] == 't' && isBlank(line[2]))
        readTexture(line.substr(3));
    else if (line.size() > 2 && line[1] == 'n' && isBlank(line[2]))
        readNormal(line.substr(3));
    else
        readOther(line);
}

void ObjStatements::readOther(std::string_view line) {
    const std::string_view keyword = takeWord(line);
    if (keyword == "g" || keyword == "o")
        change(ObjChange::Kind::object, trimmed(line));
    else if (keyword == "usemtl")
        change(ObjChange::Kind::material, trimmed(line));
    else if (keyword == "mtllib")
        change(ObjChange::Kind::library, trimmed(line));
    else if (keyword == "l")
        readLine(line);
    else if (keyword == "p")
        readPoints(line);
    else if (keyword == "fo" || keyword == "f")
        readFace(line);
    else if (keyword == "v" || keyword == "vt" || keyword == "vn")
        fault("ends behind '" + std::string(keyword) + "'");
    else if (isOneOf(keyword, FREE_FORM))
        m_part.note(ObjFault::free_form, m_place, {});
    else if (m_is_cut)
        fault("ends within a statement");
    else if (!isOneOf(keyword, WITHOUT_MEANING_HERE))
        m_part.note(ObjFault::keyword, m_place, "begins with " + quotedWord(keyword));
}

/// A vertex that cannot be understood keeps its number.
void ObjStatements::readPlace(std::string_view rest) {
    std::array<double, 7> numbers{};
    const std::string_view whole = rest;
    const int count = takeNumbers(rest, numbers);
    if (count < 3) {
        if (isAtEnd(rest))
            fault(tooFew(count, "3 coordinates of a vertex"));
        else
            tellUnread(rest);
        constexpr double NONE = std::numeric_limits<double>::quiet_NaN();
        m_part.places.emplace_back(NONE, NONE, NONE);
        return;
    }
    if (!isAtEnd(rest) && count < 7)
        tellUnread(rest);
    else if (m_is_cut && endsWithinNumber(whole))
        fault("ends within a number");
    const double divisor = count == 4 ? numbers[3] : 1.0;
    m_part.places.emplace_back(numbers[0] / divisor, numbers[1] / divisor, numbers[2] / divisor);
    readColor(numbers, count);
}

/// Some programs write the colour of a vertex behind its place, from 0 to 1 or to 255.
void ObjStatements::readColor(const std::array<double, 7>& numbers, int count) {
    if (count < 6 && m_part.colors.empty())
        return;
    m_part.colors.resize(m_part.places.size(), NO_OBJ_COLOR);
    if (count < 6)
        return;
    for (int i = 0; i < 3; ++i) {
        const auto channel = static_cast<float>(numbers[3 + i]);
        const float usable = std::isfinite(channel) ? std::max(channel, 0.0F) : 0.0F;
        m_part.colors.back()[i] = usable;
        m_part.largest_color = std::max(m_part.largest_color, usable);
    }
}

void ObjStatements::readTexture(std::string_view rest) {
    std::array<double, 3> numbers{};
    const int count = takeNumbers(rest, numbers);
    if (!isAtEnd(rest) && count < 3)
        tellUnread(rest);
    else if (count < (m_is_cut ? 2 : 1))
        fault("holds too few numbers of a texture coordinate");
    const auto usable = [](double number) {
        const auto single = static_cast<float>(number);
        return std::isfinite(single) ? single : 0.0F;
    };
    m_part.textures.emplace_back(usable(numbers[0]), usable(numbers[1]));
}

void ObjStatements::readNormal(std::string_view rest) {
    std::array<double, 3> numbers{};
    const int count = takeNumbers(rest, numbers);
    if (count < 3 && isAtEnd(rest))
        fault(tooFew(count, "3 numbers of a normal"));
    else if (!isAtEnd(rest))
        tellUnread(rest);
    if (count < 3)
        numbers = {};
    m_part.normals.emplace_back(static_cast<float>(numbers[0]), static_cast<float>(numbers[1]),
                                static_cast<float>(numbers[2]));
}

void ObjStatements::readFace(std::string_view rest) {
    if (!readCorners(rest, "face"))
        return;
    if (m_is_cut && m_corners.size() < 3)
        fault(tooFew(static_cast<int>(m_corners.size()), "3 corners that a face has at least"));
    else if (m_corners.size() == 1)
        m_part.points.push_back(m_corners.front().place);
    else if (m_corners.size() == 2)
        addPolyline();
    else
        addFace();
}

void ObjStatements::readLine(std::string_view rest) {
    if (!readCorners(rest, "line"))
        return;
    if (m_corners.size() < 2)
        fault(tooFew(1, "2 points that a line has at least"));
    else
        addPolyline();
}

void ObjStatements::readPoints(std::string_view rest) {
    if (readCorners(rest, "point"))
        for (const Corner& corner : m_corners)
            m_part.points.push_back(corner.place);
}

/// @return false where the element cannot be used, which is noted then
bool ObjStatements::readCorners(std::string_view rest, std::string_view element) {
    m_corners.clear();
    skipBlanks(rest);
    while (!isAtEnd(rest)) {
        Corner corner;
        std::string_view word = rest;
        if (!readCorner(rest, corner)) {
            fault("holds " + quotedWord(takeWord(word)) + " where the vertices of a " +
                  std::string(element) + " belong");
            return false;
        }
        m_corners.push_back(corner);
        skipBlanks(rest);
    }
    if (m_corners.empty()) {
        fault("names no vertex");
        return false;
    }
    const Corner& first = m_corners.front();
    const Corner& last = m_corners.back();
    const bool is_alike = last.slashes == first.slashes &&
                          (last.texture == OBJ_NO_INDEX) == (first.texture == OBJ_NO_INDEX) &&
                          (last.normal == OBJ_NO_INDEX) == (first.normal == OBJ_NO_INDEX);
    if (m_is_cut && !is_alike)
        fault("ends within a corner");
    return !m_is_cut || is_alike;
}

bool ObjStatements::readCorner(std::string_view& rest, Corner& corner) {
    if (!takeIndex(rest, m_part.places.size(), corner.place))
        return false;
    const auto takeSlash = [&] {
        if (rest.empty() || rest.front() != '/')
            return false;
        rest.remove_prefix(1);
        ++corner.slashes;
        return true;
    };
    const auto isIndexNext = [&] {
        return !rest.empty() && rest.front() != '/' && !isBlank(rest.front());
    };
    if (takeSlash() && isIndexNext() && !takeIndex(rest, m_part.textures.size(), corner.texture))
        return false;
    if (corner.slashes == 1 && takeSlash() && isIndexNext() &&
        !takeIndex(rest, m_part.normals.size(), corner.normal))
        return false;
    return rest.empty() || isBlank(rest.front());
}

/// Takes a number from 1 on, or a negative one that counts backward from the last of the `known`
/// ones of the part.
bool ObjStatements::takeIndex(std::string_view& rest, std::size_t known, std::uint32_t& index) {
    const bool is_negative = !rest.empty() && rest.front() == '-';
    const std::size_t sign = is_negative || rest.starts_with('+') ? 1 : 0;
    std::size_t at = sign;
    std::uint64_t number = 0;
    for (; at < rest.size() && rest[at] >= '0' && rest[at] <= '9'; ++at)
        number = std::min<std::uint64_t>(10 * number + static_cast<unsigned>(rest[at] - '0'),
                                         OBJ_LARGEST_INDEX + 1ULL);
    if (at == sign || number == 0)
        return false;
    rest.remove_prefix(at);
    index = static_cast<std::uint32_t>(number - 1);
    if (is_negative) {
        const std::int64_t from_zero =
            static_cast<std::int64_t>(known) - static_cast<std::int64_t>(number);
        constexpr std::int64_t LOWEST = -(std::int64_t{1} << 30);
        index = static_cast<std::uint32_t>(std::int64_t{OBJ_RELATIVE_ZERO} +
                                           std::max(from_zero, LOWEST));
    }
    return true;
}

void ObjStatements::addFace() {
    addToRuns(m_part.runs, sectionInHand().runs, m_corners.size());
    for (const Corner& corner : m_corners) {
        appendIndex(m_part.corner_textures, m_part.corners.size(), corner.texture);
        appendIndex(m_part.corner_normals, m_part.corners.size(), corner.normal);
        m_part.corners.push_back(corner.place);
    }
}

void ObjStatements::addPolyline() {
    addToRuns(m_part.line_runs, sectionInHand().line_runs, m_corners.size());
    for (const Corner& corner : m_corners)
        m_part.line_corners.push_back(corner.place);
}

void ObjStatements::change(ObjChange::Kind kind, std::string_view name) {
    const ObjSection& known = sectionInHand();
    const bool is_used = m_part.runs.size() > known.runs ||
                         m_part.line_runs.size() > known.line_runs ||
                         m_part.points.size() > known.points;
    if (is_used) {
        ObjSection next;
        next.runs = m_part.runs.size();
        next.corners = m_part.corners.size();
        next.line_runs = m_part.line_runs.size();
        next.line_corners = m_part.line_corners.size();
        next.points = m_part.points.size();
        m_part.sections.push_back(std::move(next));
    }
    sectionInHand().changes.push_back({kind, name});
}

void ObjStatements::fault(std::string why) {
    m_part.note(ObjFault::statement, m_place,
                m_is_cut ? std::move(why) + ", and the file ends there" : std::move(why));
}

void ObjStatements::tellUnread(std::string_view rest) {
    fault("holds " + quotedWord(takeWord(rest)) + " where a number belongs");
}

} // namespace quarn
