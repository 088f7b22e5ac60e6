#include "import/assembly/WritingProgram.h"

#include <string>

namespace quarn {

namespace {

/// Beyond this nobody signs a file.
constexpr std::size_t BYTES_OF_HEAD = 1024;

struct Program {
    std::string_view format;
    std::string_view signature; ///< what it writes at the head of its files
    std::string_view name;
    UpAxis axis;
};

constexpr Program PROGRAMS[] = {
    {"obj", "# Blender", "Blender", UpAxis::y},
    {"obj", "# Exported from Wings 3D", "Wings 3D", UpAxis::y},
    {"obj", "# This file uses centimeters as units for non-parametric coordinates", "Maya",
     UpAxis::y},
    {"ply", "comment Created by Blender", "Blender", UpAxis::z},
    {"ply", "comment Created in Blender", "Blender", UpAxis::z},
    {"stl", "Exported from Blender", "Blender", UpAxis::z},
    {"stl", "solid OpenSCAD_Model", "OpenSCAD", UpAxis::z},
};

} // namespace

TakenUpAxis upAxisOfOpenFormat(std::string_view format, std::string_view file, UpAxis asked) {
    if (asked != UpAxis::by_format)
        return {asked, TakenUpAxis::Reason::asked, {}};
    const std::string_view head = file.substr(0, BYTES_OF_HEAD);
    for (const Program& program : PROGRAMS)
        if (program.format == format && head.find(program.signature) != std::string_view::npos)
            return {program.axis, TakenUpAxis::Reason::writer, std::string(program.name)};
    return {UpAxis::z, TakenUpAxis::Reason::habit, {}};
}

} // namespace quarn
