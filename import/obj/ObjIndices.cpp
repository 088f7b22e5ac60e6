#include "import/obj/ObjIndices.h"

#include <tbb/parallel_for.h>

#include <cstdint>
#include <string>
#include <string_view>

namespace quarn {

namespace {

using Indices = std::vector<std::uint32_t>;

/// One of the tables of a part, in which indices count.
struct Table {
    std::string_view thing;
    std::string_view things;
    std::size_t (*size)(const ObjPart& part);
};

constexpr Table PLACES{"vertex", "vertices",
                       [](const ObjPart& part) { return part.places.size(); }};
constexpr Table TEXTURES{"texture coordinate", "texture coordinates",
                         [](const ObjPart& part) { return part.textures.size(); }};
constexpr Table NORMALS{"normal", "normals",
                        [](const ObjPart& part) { return part.normals.size(); }};

/// Indices of a part, and what they count in.
struct List {
    Indices ObjPart::*indices;
    const Table& table;
};

constexpr List LISTS[] = {{&ObjPart::corners, PLACES},
                          {&ObjPart::corner_textures, TEXTURES},
                          {&ObjPart::corner_normals, NORMALS},
                          {&ObjPart::line_corners, PLACES},
                          {&ObjPart::points, PLACES}};

/// How much of a table stands before a part, and how much there is in all.
struct Span {
    std::int64_t before = 0;
    std::int64_t all = 0;
};

bool isRelative(std::uint32_t index) {
    return index >= OBJ_RELATIVE;
}

/// Where a relative index leads in its part, which may be before its beginning.
std::int64_t inPart(std::uint32_t index) {
    return std::int64_t{index} - std::int64_t{OBJ_RELATIVE_ZERO};
}

/// The elements of a list that name nothing.
struct Missing {
    std::uint64_t count = 0;
    std::size_t first = 0;
    std::uint32_t index = 0; ///< of the first one, as it was read
};

Missing resolve(Indices& indices, const Span& span) {
    Missing missing;
    for (std::size_t i = 0; i < indices.size(); ++i) {
        const std::uint32_t read = indices[i];
        if (read < span.all || read == OBJ_NO_INDEX)
            continue;
        const std::int64_t from_first = isRelative(read) ? span.before + inPart(read) : -1;
        if (from_first >= 0 && from_first < span.all) {
            indices[i] = static_cast<std::uint32_t>(from_first);
            continue;
        }
        indices[i] = OBJ_LARGEST_INDEX;
        if (missing.count++ == 0)
            missing = {1, i, read};
    }
    return missing;
}

/// "names the vertex 9, but the file has 3 vertices".
std::string whyMissing(std::int64_t number, const Table& table, std::int64_t all) {
    return "names the " + std::string(table.thing) + " " + std::to_string(number) +
           ", but the file has " + std::to_string(all) + " " +
           std::string(all == 1 ? table.thing : table.things);
}

/// Reads the part once more up to the statement with the first index that is missing.
void note(ObjPart& part, const Missing& missing, const List& list, std::int64_t all,
          char line_break) {
    const char* place = nullptr;
    std::size_t known = 0;
    readObjPart(part.text, line_break, false, [&](const ObjPart& read, const char* at) {
        place = at;
        known = list.table.size(read);
        return (read.*list.indices).size() <= missing.first;
    });
    const std::int64_t number = isRelative(missing.index)
                                    ? inPart(missing.index) - static_cast<std::int64_t>(known)
                                    : std::int64_t{missing.index} + 1;
    part.note(ObjFault::index, place, whyMissing(number, list.table, all));
    part.faults[static_cast<std::size_t>(ObjFault::index)].count += missing.count - 1;
}

/// By part.
std::vector<Span> spansOf(const std::vector<ObjPart>& parts, const Table& table) {
    std::vector<Span> spans;
    std::int64_t all = 0;
    for (const ObjPart& part : parts) {
        spans.push_back({all, 0});
        all += static_cast<std::int64_t>(table.size(part));
    }
    for (Span& span : spans)
        span.all = all;
    return spans;
}

} // namespace

void resolveIndices(std::vector<ObjPart>& parts, char line_break) {
    for (const List& list : LISTS) {
        const std::vector<Span> spans = spansOf(parts, list.table);
        tbb::parallel_for(std::size_t{0}, parts.size(), [&](std::size_t i) {
            const Missing missing = resolve(parts[i].*list.indices, spans[i]);
            if (missing.count > 0)
                note(parts[i], missing, list, spans[i].all, line_break);
        });
    }
}

} // namespace quarn
