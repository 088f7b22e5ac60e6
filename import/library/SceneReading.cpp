#include "import/library/SceneReading.h"

#include "import/assembly/MeshPlacing.h"
#include "import/assembly/PolylineChains.h"
#include "import/assembly/RoundingTold.h"
#include "import/library/MaterialReading.h"
#include "import/library/MeshConversion.h"

#include <assimp/camera.h>
#include <assimp/mesh.h>
#include <assimp/scene.h>
#include <tbb/task_group.h>

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <map>
#include <string_view>
#include <utility>

namespace quarn {
namespace {

KM_Xform xformFrom(const aiMatrix4x4& m) {
    KM_Xform xform;
    for (unsigned i = 0; i < 4; ++i) {
        for (unsigned j = 0; j < 4; ++j) {
            xform.m_xform[i][j] = static_cast<double>(m[i][j]);
        }
    }
    return xform;
}

KM_wString textOf(const aiString& text) {
    return KM_wString::FromUtf8(std::string_view(text.data, text.length));
}

struct PlacedNode {
    const aiNode* node;
    KM_Xform world_from_node;
};

/// All nodes, parents before children, in the file's order. Without recursion: a hostile file nests
/// deeply.
std::vector<PlacedNode> placedNodes(const aiNode* root) {
    std::vector<PlacedNode> placed;
    std::vector<PlacedNode> open;
    if (root != nullptr) {
        open.push_back({root, KM_Xform::Identity()});
    }
    while (!open.empty()) {
        const auto [node, world_from_parent] = open.back();
        open.pop_back();
        const KM_Xform world_from_node = world_from_parent * xformFrom(node->mTransformation);
        placed.push_back({node, world_from_node});
        for (unsigned i = node->mNumChildren; i-- > 0;) {
            open.push_back({node->mChildren[i], world_from_node});
        }
    }
    return placed;
}

bool isUsablePoint(const KM_3dPoint& p) {
    return isUsableCoordinate(p.x) && isUsableCoordinate(p.y) && isUsableCoordinate(p.z);
}

/// Frees meshes of the scene beside other work: each of their triangles has memory of its own, so
/// that a million take a while. All are gone when this ends.
class MeshReleases {
public:
    MeshReleases() = default;
    MeshReleases(const MeshReleases&) = delete;
    MeshReleases& operator=(const MeshReleases&) = delete;
    ~MeshReleases() { m_tasks.wait(); }

    void release(aiMesh* mesh) {
        m_tasks.run([mesh] { delete mesh; });
    }

private:
    tbb::task_group m_tasks;
};

class SceneReader {
public:
    SceneReader(aiScene& scene, const ModelReading& reading, const ModelConventions& conventions)
        : m_scene(scene), m_conventions(conventions),
          m_materials(scene, reading, m_result.warnings) {}

    SourceScene read() {
        m_nodes = placedNodes(m_scene.mRootNode);
        readMeshes();
        for (const PlacedNode& placed : m_nodes) {
            for (unsigned i = 0; i < placed.node->mNumMeshes; ++i) {
                place(placed, placed.node->mMeshes[i]);
            }
        }
        if (const std::string rounded = roundingText(m_result); !rounded.empty())
            m_result.warnings.push_back(rounded);
        readCameras();
        warnOfDropped();
        return std::move(m_result);
    }

private:
    /// Each mesh's memory is freed as soon as it is converted.
    void readMeshes() {
        std::vector<bool> stands(m_scene.mNumMeshes, false);
        for (const PlacedNode& placed : m_nodes) {
            for (unsigned i = 0; i < placed.node->mNumMeshes; ++i) {
                if (placed.node->mMeshes[i] < m_scene.mNumMeshes) {
                    stands[placed.node->mMeshes[i]] = true;
                }
            }
        }
        m_result.meshes.resize(m_scene.mNumMeshes);
        for (unsigned i = 0; i < m_scene.mNumMeshes; ++i) {
            if (stands[i]) {
                readMesh(*m_scene.mMeshes[i], m_result.meshes[i]);
            }
            m_releases.release(std::exchange(m_scene.mMeshes[i], new aiMesh));
        }
    }

    void readMesh(const aiMesh& mesh, SourceMesh& piece) {
        piece.name = isGivenName(mesh.mName) ? textOf(mesh.mName) : KM_wString();
        if (mesh.mPrimitiveTypes & aiPrimitiveType_TRIANGLE) {
            readTriangles(mesh, piece);
        } else if (mesh.mPrimitiveTypes & aiPrimitiveType_LINE) {
            readLines(mesh, piece);
        } else if (mesh.mPrimitiveTypes & aiPrimitiveType_POINT) {
            readPoints(mesh, piece);
        }
    }

    void place(const PlacedNode& placed, unsigned mesh) {
        if (mesh < m_scene.mNumMeshes) {
            const aiString& name = placed.node->mName;
            m_result.places.push_back(
                {isGivenName(name) ? textOf(name) : KM_wString(), mesh, placed.world_from_node});
        }
    }

    void readTriangles(const aiMesh& mesh, SourceMesh& piece) {
        const ReadMaterial& material = m_materials.at(mesh.mMaterialIndex);
        MeshReading reading;
        reading.keep_normals = m_conventions.keep_normals;
        reading.texture_coordinates = material.texture_coordinates;
        ConvertedMesh converted = convertTriangles(mesh, reading);
        m_triangles += mesh.mNumFaces;
        m_dropped += converted.triangles_dropped;
        piece.mesh = std::move(converted.mesh);
        piece.material = material.material;
    }

    void readLines(const aiMesh& mesh, SourceMesh& piece) {
        std::vector<LineSegment> segments;
        segments.reserve(mesh.mNumFaces);
        for (unsigned f = 0; f < mesh.mNumFaces; ++f) {
            const aiFace& face = mesh.mFaces[f];
            KM_3dPoint from;
            KM_3dPoint to;
            if (face.mNumIndices == 2 && readPoint(mesh, face.mIndices[0], from) &&
                readPoint(mesh, face.mIndices[1], to)) {
                segments.emplace_back(from, to);
            } else {
                ++m_lines_dropped;
            }
        }
        piece.lines = joinSegments(segments);
    }

    void readPoints(const aiMesh& mesh, SourceMesh& piece) {
        for (unsigned f = 0; f < mesh.mNumFaces; ++f) {
            const aiFace& face = mesh.mFaces[f];
            KM_3dPoint point;
            if (face.mNumIndices == 1 && readPoint(mesh, face.mIndices[0], point)) {
                piece.points.Append(point);
            } else {
                ++m_points_dropped;
            }
        }
    }

    static bool readPoint(const aiMesh& mesh, unsigned index, KM_3dPoint& point) {
        if (index >= mesh.mNumVertices) {
            return false;
        }
        const aiVector3D& p = mesh.mVertices[index];
        point = KM_3dPoint(p.x, p.y, p.z);
        return isUsablePoint(point);
    }

    /// A name that people gave, not one that the reading library made up.
    static bool isGivenName(const aiString& name) {
        const std::string_view text(name.data, name.length);
        const bool is_id = text.starts_with("nodes[") || text.starts_with("meshes[");
        return !text.empty() && !is_id && text != "defaultobject" && text.front() != '<';
    }

    void readCameras() {
        std::map<std::string_view, const PlacedNode*> by_name;
        for (const PlacedNode& placed : m_nodes) {
            by_name.emplace(std::string_view(placed.node->mName.data, placed.node->mName.length),
                            &placed);
        }
        for (unsigned i = 0; i < m_scene.mNumCameras; ++i) {
            const aiCamera& camera = *m_scene.mCameras[i];
            const auto found =
                by_name.find(std::string_view(camera.mName.data, camera.mName.length));
            if (found != by_name.end()) {
                readCamera(camera, found->second->world_from_node);
            }
        }
    }

    void readCamera(const aiCamera& camera, const KM_Xform& world_from_node) {
        const auto turned = [&world_from_node](const aiVector3D& v) {
            return world_from_node * KM_3dVector(v.x, v.y, v.z);
        };
        const aiVector3D p = m_conventions.gltf_cameras ? aiVector3D() : camera.mPosition;
        SourceCamera read;
        read.name = textOf(camera.mName);
        read.location = world_from_node * KM_3dPoint(p.x, p.y, p.z);
        read.direction = turned(camera.mLookAt);
        read.up = turned(camera.mUp);
        readOpening(camera, read);
        m_result.cameras.push_back(std::move(read));
    }

    void readOpening(const aiCamera& camera, SourceCamera& read) const {
        const double stated = static_cast<double>(camera.mAspect);
        read.aspect = stated > 0.01 && stated < 100.0 ? stated : read.aspect;
        const double width = static_cast<double>(camera.mOrthographicWidth);
        if (width > 0.0 && std::isfinite(width)) {
            read.is_parallel = true;
            read.half_width = width;
            return;
        }
        const double angle = static_cast<double>(camera.mHorizontalFOV);
        const double stated_or_one = stated > 0.0 ? stated : 1.0;
        const double half_angle =
            0.5 * (m_conventions.gltf_cameras ? angle / stated_or_one : angle);
        if (half_angle > 0.01 && half_angle < 1.5) {
            read.half_width =
                std::tan(half_angle) * (m_conventions.gltf_cameras ? read.aspect : 1.0);
        }
    }

    void warnOfDropped() {
        for (const std::string& sentence :
             {leftOutText(m_dropped, m_triangles, "triangles"),
              leftOutText(m_lines_dropped, m_lines_dropped, "line segments"),
              leftOutText(m_points_dropped, m_points_dropped, "points")}) {
            if (!sentence.empty()) {
                m_result.warnings.push_back(sentence);
            }
        }
    }

    aiScene& m_scene;
    const ModelConventions& m_conventions;
    SourceScene m_result;
    MaterialReading m_materials;
    std::vector<PlacedNode> m_nodes;
    MeshReleases m_releases;
    std::uint64_t m_triangles = 0;
    std::uint64_t m_dropped = 0;
    std::uint64_t m_lines_dropped = 0;
    std::uint64_t m_points_dropped = 0;
};

} // namespace

SourceScene takeScene(aiScene& scene, const ModelReading& reading,
                      const ModelConventions& conventions) {
    return SceneReader(scene, reading, conventions).read();
}

} // namespace quarn
