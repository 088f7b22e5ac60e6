#include "import/library/SceneRepair.h"

#include <assimp/anim.h>
#include <assimp/light.h>
#include <assimp/mesh.h>
#include <assimp/scene.h>

#include <algorithm>
#include <utility>
#include <vector>

namespace quarn {
namespace {

void makePoints(aiMesh& mesh) {
    mesh.mPrimitiveTypes = aiPrimitiveType_POINT;
    mesh.mFaces = new aiFace[mesh.mNumVertices];
    mesh.mNumFaces = mesh.mNumVertices;
    for (unsigned v = 0; v < mesh.mNumVertices; ++v) {
        mesh.mFaces[v].mNumIndices = 1;
        mesh.mFaces[v].mIndices = new unsigned[1]{v};
    }
}

/// For each mesh its index when the empty ones are gone, or -1.
std::vector<int> removeEmptyMeshes(aiScene& scene) {
    std::vector<int> new_index(scene.mNumMeshes, -1);
    unsigned kept = 0;
    for (unsigned i = 0; i < scene.mNumMeshes; ++i) {
        if (scene.mMeshes[i]->mNumVertices == 0) {
            delete scene.mMeshes[i];
            continue;
        }
        new_index[i] = static_cast<int>(kept);
        scene.mMeshes[kept++] = scene.mMeshes[i];
    }
    scene.mNumMeshes = kept;
    return new_index;
}

void renumber(aiNode& node, const std::vector<int>& new_index) {
    unsigned kept = 0;
    for (unsigned i = 0; i < node.mNumMeshes; ++i) {
        const unsigned mesh = node.mMeshes[i];
        if (mesh < new_index.size() && new_index[mesh] >= 0) {
            node.mMeshes[kept++] = static_cast<unsigned>(new_index[mesh]);
        }
    }
    node.mNumMeshes = kept;
    if (kept == 0) {
        delete[] node.mMeshes;
        node.mMeshes = nullptr;
    }
}

void removeMissing(aiNode& node) {
    aiNode** const end = node.mChildren + node.mNumChildren;
    node.mNumChildren =
        static_cast<unsigned>(std::remove(node.mChildren, end, nullptr) - node.mChildren);
}

void removeMissingNodes(aiNode* root) {
    std::vector<aiNode*> open{root};
    while (!open.empty()) {
        aiNode& node = *open.back();
        open.pop_back();
        removeMissing(node);
        open.insert(open.end(), node.mChildren, node.mChildren + node.mNumChildren);
    }
}

template <typename T> void removeAll(T**& list, unsigned& count) {
    std::for_each(list, list + count, [](const T* element) { delete element; });
    delete[] std::exchange(list, nullptr);
    count = 0;
}

/// @return how many there were
std::uint64_t removeFacesWithoutCorners(aiMesh& mesh) {
    aiFace* const end = mesh.mFaces + mesh.mNumFaces;
    const auto is_empty = [](const aiFace& face) { return face.mNumIndices == 0; };
    aiFace* kept = std::find_if(mesh.mFaces, end, is_empty);
    for (aiFace* face = kept; face != end; ++face) {
        if (!is_empty(*face)) {
            std::swap(kept->mNumIndices, face->mNumIndices);
            std::swap(kept->mIndices, face->mIndices);
            ++kept;
        }
    }
    mesh.mNumFaces = static_cast<unsigned>(kept - mesh.mFaces);
    return static_cast<std::uint64_t>(end - kept);
}

unsigned kindOf(const aiFace& face) {
    switch (face.mNumIndices) {
    case 1:
        return aiPrimitiveType_POINT;
    case 2:
        return aiPrimitiveType_LINE;
    case 3:
        return aiPrimitiveType_TRIANGLE;
    default:
        return aiPrimitiveType_POLYGON;
    }
}

/// Cutting polygons into triangles ends the program where a mesh claims to have some and has none.
void restateKinds(aiMesh& mesh) {
    constexpr unsigned all_kinds = aiPrimitiveType_POINT | aiPrimitiveType_LINE |
                                   aiPrimitiveType_TRIANGLE | aiPrimitiveType_POLYGON;
    unsigned kinds = 0;
    std::for_each(mesh.mFaces, mesh.mFaces + mesh.mNumFaces,
                  [&kinds](const aiFace& face) { kinds |= kindOf(face); });
    mesh.mPrimitiveTypes = (mesh.mPrimitiveTypes & ~all_kinds) | kinds;
}

void removeMeaninglessColors(aiMesh& mesh) {
    const auto is_nothing = [](const aiColor4D& c) {
        return c.r <= 0.0F && c.g <= 0.0F && c.b <= 0.0F && c.a <= 0.0F;
    };
    aiColor4D* const colors = mesh.mColors[0];
    if (colors != nullptr && std::all_of(colors, colors + mesh.mNumVertices, is_nothing)) {
        delete[] colors;
        std::move(mesh.mColors + 1, mesh.mColors + AI_MAX_NUMBER_OF_COLOR_SETS, mesh.mColors);
        mesh.mColors[AI_MAX_NUMBER_OF_COLOR_SETS - 1] = nullptr;
    }
}

void renumberAll(aiNode* root, const std::vector<int>& new_index) {
    std::vector<aiNode*> open{root};
    while (!open.empty()) {
        aiNode& node = *open.back();
        open.pop_back();
        renumber(node, new_index);
        open.insert(open.end(), node.mChildren, node.mChildren + node.mNumChildren);
    }
}

} // namespace

std::uint64_t repairScene(aiScene& scene) {
    bool has_empty = false;
    std::uint64_t faces_removed = 0;
    removeAll(scene.mLights, scene.mNumLights);
    removeAll(scene.mAnimations, scene.mNumAnimations);
    if (scene.mRootNode != nullptr) {
        removeMissingNodes(scene.mRootNode);
    }
    for (unsigned i = 0; i < scene.mNumMeshes; ++i) {
        aiMesh& mesh = *scene.mMeshes[i];
        has_empty = has_empty || mesh.mNumVertices == 0;
        faces_removed += removeFacesWithoutCorners(mesh);
        restateKinds(mesh);
        removeMeaninglessColors(mesh);
        if (mesh.mNumVertices > 0 && mesh.mNumFaces == 0) {
            makePoints(mesh);
        }
    }
    if (has_empty && scene.mRootNode != nullptr) {
        renumberAll(scene.mRootNode, removeEmptyMeshes(scene));
    }
    return faces_removed;
}

} // namespace quarn
