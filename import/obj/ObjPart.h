#pragma once

#include "import/assembly/CornerMeshes.h"
#include "kelmar/KM_Point.h"

#include <array>
#include <cstddef>
#include <cstdint>
#include <deque>
#include <functional>
#include <string>
#include <string_view>
#include <vector>

namespace quarn {

/// What in an OBJ file cannot be used.
enum class ObjFault {
    statement, ///< a number that is none, too few of them, or the file's end within it
    index,     ///< of a vertex that is not there
    keyword,   ///< that nobody knows
    free_form, ///< curves and surfaces, which are no meshes
};
constexpr std::size_t OBJ_FAULT_KINDS = 4;

/// Faults of one kind: the first one, and how many there are.
struct ObjFaults {
    std::uint64_t count = 0;
    const char* place = nullptr; ///< of the first one in the text
    std::string why;             ///< what its line does: "holds ..."
};

/// What changes how the statements behind it count.
struct ObjChange {
    enum class Kind { object, material, library };
    Kind kind;
    std::string_view name; ///< may be empty
};

/// Elements between two changes, as counts of what was read before them.
struct ObjSection {
    std::vector<ObjChange> changes; ///< before the elements
    std::size_t runs = 0;
    std::size_t corners = 0;
    std::size_t line_runs = 0;
    std::size_t line_corners = 0;
    std::size_t points = 0;
};

/// A number that counts backward from the vertices before its statement is kept as one from the
/// part's first vertex on, which may be negative, around this; others are smaller than
/// OBJ_RELATIVE.
constexpr std::uint32_t OBJ_RELATIVE = 0x80000000U;
constexpr std::uint32_t OBJ_RELATIVE_ZERO = 0xC0000000U;
/// Of a corner without one.
constexpr std::uint32_t OBJ_NO_INDEX = 0x7FFFFFFFU;
/// One that stands for none, whatever the file holds.
constexpr std::uint32_t OBJ_LARGEST_INDEX = 0x7FFFFFFEU;

/// Of a place without a colour.
constexpr std::array<float, 3> NO_OBJ_COLOR{-1.0F, -1.0F, -1.0F};

/// What stands in some lines of an OBJ file that follow each other.
struct ObjPart {
    std::string_view text;
    std::vector<KM_3dPoint> places;
    std::vector<std::array<float, 3>> colors; ///< by place, or of fewer ones
    float largest_color = 0.0F;
    std::vector<KM_2fPoint> textures;
    std::vector<KM_3fVector> normals;
    std::vector<FaceRun> runs;
    std::vector<std::uint32_t> corners;
    std::vector<std::uint32_t> corner_textures; ///< none, or by corner; so are the normals
    std::vector<std::uint32_t> corner_normals;
    std::vector<FaceRun> line_runs; ///< polylines by how many vertices they have, at least two
    std::vector<std::uint32_t> line_corners;
    std::vector<std::uint32_t> points;
    std::vector<ObjSection> sections; ///< at least one
    std::deque<std::string> joined;   ///< statements of several lines, to which names may refer
    std::array<ObjFaults, OBJ_FAULT_KINDS> faults;

    /// How much memory this takes.
    std::size_t bytes() const;
    void note(ObjFault kind, const char* place, std::string why);
};

/// Reads lines of an OBJ file.
/// @param text     whole lines, none of which a backslash joins to others; outlives the part
/// @param is_last  nothing follows in the file
/// @param goes_on  asked after each statement; false ends the reading
ObjPart
readObjPart(std::string_view text, char line_break, bool is_last,
            const std::function<bool(const ObjPart& part, const char* place)>& goes_on = nullptr);

} // namespace quarn
