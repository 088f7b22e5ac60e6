#include "host/import/SceneRepair.h"

#include <assimp/mesh.h>
#include <assimp/scene.h>

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

void repairScene(aiScene& scene) {
    bool has_empty = false;
    for (unsigned i = 0; i < scene.mNumMeshes; ++i) {
        aiMesh& mesh = *scene.mMeshes[i];
        has_empty = has_empty || mesh.mNumVertices == 0;
        if (mesh.mNumVertices > 0 && mesh.mNumFaces == 0) {
            makePoints(mesh);
        }
    }
    if (has_empty && scene.mRootNode != nullptr) {
        renumberAll(scene.mRootNode, removeEmptyMeshes(scene));
    }
}

} // namespace quarn
