#include "import/library/LibraryLosses.h"

#include <assimp/mesh.h>
#include <assimp/scene.h>

#include <algorithm>
#include <array>
#include <cstdint>
#include <span>

namespace quarn {

namespace {

constexpr std::string_view BLANKS = " \t\r\n";

constexpr std::array<std::string_view, 8> X3D_GROUPS{
    "Transform", "Group", "StaticGroup", "Switch", "LOD", "Anchor", "Collision", "Billboard"};

/// The tag of which `inside` is a place.
std::string_view tagName(std::string_view text, std::size_t inside) {
    const std::size_t begin = text.rfind('<', inside) + 1; // 0 where there is none
    return text.substr(begin, std::min(text.find_first_of(" \t\r\n/>", begin), inside) - begin);
}

/// What follows a group that stands for another one falls out of its parent.
bool usesGroupsAgain(std::string_view text) {
    constexpr std::string_view AGAIN = "USE=";
    for (std::size_t at = text.find(AGAIN); at != std::string_view::npos;
         at = text.find(AGAIN, at + 1))
        if (std::ranges::find(X3D_GROUPS, tagName(text, at)) != X3D_GROUPS.end())
            return true;
    return false;
}

std::uint64_t tagsOf(std::string_view text, std::string_view begin) {
    std::uint64_t count = 0;
    for (std::size_t at = text.find(begin); at != std::string_view::npos;
         at = text.find(begin, at + 1)) {
        const std::size_t behind = at + begin.size();
        count += behind < text.size() &&
                 (text[behind] == '>' || BLANKS.find(text[behind]) != std::string_view::npos);
    }
    return count;
}

std::uint64_t facesOf(const aiScene& scene) {
    std::uint64_t count = 0;
    for (const aiMesh* const mesh : std::span(scene.mMeshes, scene.mNumMeshes))
        count += mesh != nullptr ? mesh->mNumFaces : 0;
    return count;
}

} // namespace

std::string libraryLossText(std::string_view format, std::string_view text, const aiScene& scene) {
    if (format == "x3d" && usesGroupsAgain(text))
        return "It shows groups again (USE), which is not read right: parts may be missing. Export "
               "it as glTF to see all of it.";
    const std::uint64_t triangles = format == "amf" ? tagsOf(text, "<triangle") : 0;
    const std::uint64_t faces = facesOf(scene);
    if (triangles <= faces)
        return {};
    return std::to_string(triangles - faces) + " of its " + std::to_string(triangles) +
           " triangles were left out: of objects with several volumes one is read. Export it as "
           "3MF "
           "to see all of it.";
}

} // namespace quarn
