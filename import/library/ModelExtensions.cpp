#include "import/library/ModelExtensions.h"

#include <assimp/Importer.hpp>

#include <algorithm>
#include <cctype>
#include <sstream>

namespace quarn {

namespace {

constexpr const char* USUAL[] = {"glb", "gltf", "obj", "fbx", "dae",
                                 "stl", "ply",  "3mf", "3ds", "off"};

/// From "*.3ds;*.obj".
std::vector<std::string> knownExtensions() {
    aiString list;
    const Assimp::Importer importer;
    importer.GetExtensionList(list);
    std::istringstream stream(list.C_Str());
    std::vector<std::string> extensions;
    for (std::string pattern; std::getline(stream, pattern, ';');) {
        std::string extension = pattern.substr(pattern.rfind('.') + 1);
        for (char& c : extension)
            c = static_cast<char>(std::tolower(static_cast<unsigned char>(c)));
        extensions.push_back(extension);
    }
    return extensions;
}

} // namespace

std::vector<std::string> modelFileExtensions() {
    std::vector<std::string> known = knownExtensions();
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
