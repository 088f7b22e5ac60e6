#include "import/ModelFormats.h"

#include "import/cad/CadReader.h"
#include "import/gltf/GltfReader.h"
#include "import/library/LibraryExtensions.h"
#include "import/library/LibraryReader.h"
#include "import/obj/ObjReader.h"
#include "import/off/OffReader.h"
#include "import/ply/PlyReader.h"
#include "import/stl/StlReader.h"

#include <algorithm>

namespace quarn {

namespace {

struct Format {
    std::string_view extension;
    ModelReader read;
    bool is_own; ///< not a library's
};

/// The formats that have a reader of their own.
constexpr Format FORMATS[] = {
    {"brep", readBrep, false}, {"glb", readGltf, true},  {"gltf", readGltf, true},
    {"iges", readIges, false}, {"igs", readIges, false}, {"obj", readObj, true},
    {"off", readOff, true},    {"ply", readPly, true},   {"step", readStep, false},
    {"stl", readStl, true},    {"stp", readStep, false},
};

constexpr const char* USUAL[] = {"glb", "gltf", "obj", "fbx", "dae",  "stl",
                                 "ply", "3mf",  "3ds", "off", "step", "ifc"};

const Format* formatOf(std::string_view extension) {
    const auto* const found = std::ranges::find(FORMATS, extension, &Format::extension);
    return found == std::end(FORMATS) ? nullptr : found;
}

} // namespace

ModelReader readerOf(std::string_view extension) {
    const Format* const format = formatOf(extension);
    return format ? format->read : readWithLibrary;
}

bool hasOwnReader(std::string_view extension) {
    const Format* const format = formatOf(extension);
    return format && format->is_own;
}

std::vector<std::string> modelFileExtensions() {
    std::vector<std::string> known = libraryExtensions();
    for (const Format& format : FORMATS)
        known.emplace_back(format.extension);
    std::ranges::sort(known);
    known.erase(std::unique(known.begin(), known.end()), known.end());
    auto next = known.begin();
    for (const char* usual : USUAL) {
        const auto found = std::find(next, known.end(), usual);
        if (found != known.end())
            std::rotate(next++, found, found + 1);
    }
    return known;
}

} // namespace quarn
