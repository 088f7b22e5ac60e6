#include "import/library/GltfLosses.h"

#include <assimp/mesh.h>
#include <assimp/scene.h>

#include <span>

namespace quarn {
namespace {

/// What was read of the meshes of one name.
struct ReadFaces {
    std::uint64_t all = 0;
    std::uint64_t below_fewest = 0; ///< missing if each mesh is the smallest one of that name
    unsigned meshes = 0;
    unsigned kind = 0; ///< aiPrimitiveType
};

std::map<std::string, ReadFaces> facesRead(const aiScene& scene,
                                           const GltfDescription& description) {
    std::map<std::string, ReadFaces> read;
    for (const aiMesh* const mesh : std::span(scene.mMeshes, scene.mNumMeshes)) {
        const std::string name(mesh->mName.data, mesh->mName.length);
        const auto stated = description.faces.find(name);
        if (stated == description.faces.end()) {
            continue;
        }
        ReadFaces& faces = read[name];
        const std::uint64_t fewest = stated->second.fewest;
        faces.all += mesh->mNumFaces;
        faces.below_fewest += fewest > mesh->mNumFaces ? fewest - mesh->mNumFaces : 0;
        ++faces.meshes;
        faces.kind |= mesh->mPrimitiveTypes;
    }
    return read;
}

/// Meshes that no node shows are not read. Where some of a name are not, it is unknown which.
std::uint64_t lostOf(const ReadFaces& read, const GltfFaces& stated) {
    if (read.meshes != stated.meshes) {
        return read.below_fewest;
    }
    return stated.all > read.all ? stated.all - read.all : 0;
}

std::string nounFor(unsigned kind) {
    const bool has_triangles = (kind & aiPrimitiveType_TRIANGLE) != 0;
    return has_triangles ? "triangles" : (kind & aiPrimitiveType_LINE) != 0 ? "lines" : "points";
}

} // namespace

std::vector<std::string> tellLostFaces(const aiScene& scene, const GltfDescription& description) {
    constexpr std::size_t most_sentences = 8;
    std::vector<std::string> sentences;
    std::uint64_t lost_by_others = 0;
    for (const auto& [name, read] : facesRead(scene, description)) {
        const std::uint64_t lost = lostOf(read, description.faces.at(name));
        if (lost == 0) {
            continue;
        }
        if (sentences.size() == most_sentences) {
            lost_by_others += lost;
            continue;
        }
        sentences.push_back(std::to_string(lost) + " of " + std::to_string(lost + read.all) + " " +
                            nounFor(read.kind) + " of the mesh '" + name +
                            "' were left out: their indices lie beyond its vertices. The file may "
                            "be damaged; export the model again.");
    }
    if (lost_by_others > 0) {
        sentences.push_back("Other meshes lost " + std::to_string(lost_by_others) +
                            " faces in the same way.");
    }
    return sentences;
}

} // namespace quarn
