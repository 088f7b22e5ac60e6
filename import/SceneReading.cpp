#include "import/SceneReading.h"

#include "engine/scene/PlacedMesh.h"
#include "import/MaterialReading.h"
#include "import/MeshConversion.h"
#include "import/PolylineChains.h"

#include <assimp/camera.h>
#include <assimp/mesh.h>
#include <assimp/scene.h>
#include <tbb/task_group.h>

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <locale>
#include <map>
#include <sstream>
#include <string_view>
#include <utility>

namespace quarn {
namespace {

constexpr std::uint64_t most_triangles = 100'000'000;

KM_Xform xformFrom(const aiMatrix4x4& m) {
    KM_Xform xform;
    for (unsigned i = 0; i < 4; ++i) {
        for (unsigned j = 0; j < 4; ++j) {
            xform.m_xform[i][j] = static_cast<double>(m[i][j]);
        }
    }
    return xform;
}

/// Y up to Z up: x stays, y becomes z, z becomes -y.
KM_Xform zUpFromYUp() {
    KM_Xform xform;
    xform.m_xform[1][1] = 0.0;
    xform.m_xform[1][2] = -1.0;
    xform.m_xform[2][1] = 1.0;
    xform.m_xform[2][2] = 0.0;
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
std::vector<PlacedNode> placedNodes(const aiNode* root, const KM_Xform& world_from_root) {
    std::vector<PlacedNode> placed;
    std::vector<PlacedNode> open;
    if (root != nullptr) {
        open.push_back({root, world_from_root});
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
    SceneReader(aiScene& scene, const ModelFolder& folder, const ModelConventions& conventions)
        : m_scene(scene), m_conventions(conventions),
          m_materials(scene, folder, conventions.linear_colors, m_model.warnings) {}

    Result<ImportedModel> read() {
        const KM_Xform turn = m_conventions.turn_y_up ? zUpFromYUp() : KM_Xform::Identity();
        const KM_3dVector from_file = m_conventions.origin - KM_3dPoint::Origin;
        m_nodes = placedNodes(m_scene.mRootNode, turn * KM_Xform::Translation(from_file));
        if (countUses() > most_triangles) {
            return Error{"its meshes have more than 100 million triangles in all"};
        }
        const KM_BoundingBox box = placedBox();
        m_origin = nearbyOrigin(box);
        warnOfRounding(box);
        for (const PlacedNode& placed : m_nodes) {
            for (unsigned i = 0; i < placed.node->mNumMeshes; ++i) {
                readMesh(placed, placed.node->mMeshes[i]);
            }
        }
        readCameras();
        warnOfDropped();
        return std::move(m_model);
    }

private:
    /// A mesh that several nodes show is converted once.
    struct SharedMesh {
        bool repeated = false;
        std::shared_ptr<KM_Mesh> mesh; ///< null until a node has shown it
    };

    std::uint64_t countUses() {
        m_uses.assign(m_scene.mNumMeshes, 0);
        std::uint64_t triangles = 0;
        for (const PlacedNode& placed : m_nodes) {
            for (unsigned i = 0; i < placed.node->mNumMeshes; ++i) {
                const unsigned mesh = placed.node->mMeshes[i];
                if (mesh < m_scene.mNumMeshes) {
                    ++m_uses[mesh];
                    const bool copied = m_uses[mesh] == 1 || isFlattened(placed.world_from_node);
                    triangles += copied ? m_scene.mMeshes[mesh]->mNumFaces : 0;
                }
            }
        }
        m_shared.resize(m_scene.mNumMeshes);
        for (unsigned mesh = 0; mesh < m_scene.mNumMeshes; ++mesh) {
            m_shared[mesh].repeated = m_uses[mesh] > 1;
        }
        return triangles;
    }

    /// A transform without an inverse: what it makes cannot be shared.
    static bool isFlattened(const KM_Xform& world_from_node) {
        KM_Xform inverse = world_from_node;
        return !world_from_node.IsValid() || !inverse.Invert() || !inverse.IsValid();
    }

    /// The box of the boxes of all triangle meshes where they stand.
    KM_BoundingBox placedBox() {
        m_boxes.resize(m_scene.mNumMeshes);
        for (unsigned i = 0; i < m_scene.mNumMeshes; ++i) {
            m_boxes[i] = boxOf(*m_scene.mMeshes[i]);
        }
        KM_BoundingBox all;
        for (const PlacedNode& placed : m_nodes) {
            for (unsigned i = 0; i < placed.node->mNumMeshes; ++i) {
                addPlaced(placed, placed.node->mMeshes[i], all);
            }
        }
        return all;
    }

    /// The reading library keeps coordinates in single precision, with 24 binary digits.
    static double roundingStep(const KM_BoundingBox& box) {
        double largest = 1e-30;
        for (int corner = 0; corner < 8 && box.IsValid(); ++corner) {
            const KM_3dPoint p = box.Corner(corner);
            largest = std::max({largest, std::abs(p.x), std::abs(p.y), std::abs(p.z)});
        }
        return std::ldexp(1.0, std::ilogb(largest) - 23);
    }

    /// How much longer a transform makes what points along an axis, at most.
    static double largestScale(const KM_Xform& x) {
        double largest = 0.0;
        for (int axis = 0; axis < 3; ++axis) {
            largest = std::max(
                largest, std::hypot(x.m_xform[0][axis], x.m_xform[1][axis], x.m_xform[2][axis]));
        }
        return largest;
    }

    void warnOfRounding(const KM_BoundingBox& box) {
        constexpr double visible_share = 1e-5;
        double step = 0.0;
        for (const PlacedNode& placed : m_nodes) {
            const double scale = largestScale(placed.world_from_node);
            for (unsigned i = 0; i < placed.node->mNumMeshes; ++i) {
                const unsigned mesh = placed.node->mMeshes[i];
                step = mesh < m_boxes.size() ? std::max(step, scale * roundingStep(m_boxes[mesh]))
                                             : step;
            }
        }
        if (step > visible_share * box.Diagonal().Length() && box.Diagonal().Length() > 0.0) {
            std::ostringstream text;
            text.imbue(std::locale::classic());
            text << "The model lies so far from the origin that its coordinates are rounded to "
                    "multiples of "
                 << step << ". Move it nearer, or export it as OBJ.";
            m_model.warnings.push_back(text.str());
        }
    }

    static KM_BoundingBox boxOf(const aiMesh& mesh) {
        KM_BoundingBox box;
        for (unsigned v = 0; v < mesh.mNumVertices; ++v) {
            const aiVector3D& p = mesh.mVertices[v];
            const KM_3dPoint point(p.x, p.y, p.z);
            if (isUsablePoint(point)) {
                box.Set(point);
            }
        }
        return box;
    }

    void addPlaced(const PlacedNode& placed, unsigned mesh, KM_BoundingBox& all) const {
        if (mesh >= m_boxes.size() || !m_boxes[mesh].IsValid()) {
            return;
        }
        for (int corner = 0; corner < 8; ++corner) {
            const KM_3dPoint point = placed.world_from_node * m_boxes[mesh].Corner(corner);
            if (isUsablePoint(point)) {
                all.Set(point);
            }
        }
    }

    void readMesh(const PlacedNode& placed, unsigned index) {
        if (index >= m_scene.mNumMeshes) {
            return;
        }
        const aiMesh& mesh = *m_scene.mMeshes[index];
        if (mesh.mPrimitiveTypes & aiPrimitiveType_TRIANGLE) {
            readTriangles(placed, index);
        } else if (mesh.mPrimitiveTypes & aiPrimitiveType_LINE) {
            readLines(placed, mesh);
        } else if (mesh.mPrimitiveTypes & aiPrimitiveType_POINT) {
            readPoints(placed, mesh);
        }
        if (--m_uses[index] == 0) {
            m_releases.release(std::exchange(m_scene.mMeshes[index], new aiMesh));
        }
        completeNewMesh();
    }

    void completeNewMesh() {
        for (const std::shared_ptr<KM_Mesh>& mesh : m_incomplete) {
            completeMesh(*mesh);
        }
        m_incomplete.clear();
    }

    void readTriangles(const PlacedNode& placed, unsigned index) {
        const aiMesh& mesh = *m_scene.mMeshes[index];
        const bool shares = m_shared[index].repeated && !isFlattened(placed.world_from_node);
        const ReadMaterial& material = m_materials.at(mesh.mMaterialIndex);
        std::shared_ptr<KM_Mesh> converted;
        if (shares) {
            converted = sharedMesh(index, material);
        } else {
            converted = convert(mesh, originFromWorld() * placed.world_from_node, material);
        }
        if (converted->m_F.empty()) {
            return;
        }
        m_without_area += hasArea(*converted) ? 0 : 1;
        const KM_Xform world_from_mesh = shares ? placed.world_from_node : worldFromOrigin();
        m_model.meshes.push_back(
            {nameOf(placed, mesh), {std::move(converted), material.material, world_from_mesh}});
    }

    std::shared_ptr<KM_Mesh> sharedMesh(unsigned index, const ReadMaterial& material) {
        std::shared_ptr<KM_Mesh>& mesh = m_shared[index].mesh;
        if (mesh == nullptr) {
            mesh = convert(*m_scene.mMeshes[index], KM_Xform(), material);
        }
        return mesh;
    }

    std::shared_ptr<KM_Mesh> convert(const aiMesh& mesh, const KM_Xform& place,
                                     const ReadMaterial& material) {
        MeshReading reading;
        reading.world_from_mesh = place;
        reading.keep_normals = m_conventions.keep_normals;
        reading.linear_colors = m_conventions.linear_colors;
        reading.texture_coordinates = material.texture_coordinates;
        reading.texture_place = material.texture_place;
        ConvertedMesh converted = convertTriangles(mesh, reading);
        m_triangles += mesh.mNumFaces;
        m_dropped += converted.triangles_dropped;
        m_incomplete.push_back(converted.mesh);
        return std::move(converted.mesh);
    }

    KM_Xform originFromWorld() const {
        return KM_Xform::Translation(KM_3dPoint::Origin - m_origin);
    }
    KM_Xform worldFromOrigin() const {
        return KM_Xform::Translation(m_origin - KM_3dPoint::Origin);
    }

    void readLines(const PlacedNode& placed, const aiMesh& mesh) {
        std::vector<LineSegment> segments;
        segments.reserve(mesh.mNumFaces);
        for (unsigned f = 0; f < mesh.mNumFaces; ++f) {
            const aiFace& face = mesh.mFaces[f];
            KM_3dPoint from;
            KM_3dPoint to;
            if (face.mNumIndices == 2 && readPoint(placed, mesh, face.mIndices[0], from) &&
                readPoint(placed, mesh, face.mIndices[1], to)) {
                segments.emplace_back(from, to);
            } else {
                ++m_lines_dropped;
            }
        }
        for (KM_3dPointArray& points : joinSegments(segments)) {
            m_model.curves.push_back({nameOf(placed, mesh), std::move(points)});
        }
    }

    void readPoints(const PlacedNode& placed, const aiMesh& mesh) {
        for (unsigned f = 0; f < mesh.mNumFaces; ++f) {
            const aiFace& face = mesh.mFaces[f];
            KM_3dPoint point;
            if (face.mNumIndices == 1 && readPoint(placed, mesh, face.mIndices[0], point)) {
                m_model.points.Append(point);
            } else {
                ++m_points_dropped;
            }
        }
    }

    static bool readPoint(const PlacedNode& placed, const aiMesh& mesh, unsigned index,
                          KM_3dPoint& point) {
        if (index >= mesh.mNumVertices) {
            return false;
        }
        const aiVector3D& p = mesh.mVertices[index];
        point = placed.world_from_node * KM_3dPoint(p.x, p.y, p.z);
        return isUsablePoint(point);
    }

    /// A name that people gave, not one that the reading library made up.
    KM_wString nameOf(const PlacedNode& placed, const aiMesh& mesh) const {
        if (isGivenName(placed.node->mName)) {
            return textOf(placed.node->mName);
        }
        return isGivenName(mesh.mName) ? textOf(mesh.mName) : m_conventions.file_name;
    }

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
        const KM_3dPoint location = world_from_node * KM_3dPoint(p.x, p.y, p.z);
        KM_3dVector direction = turned(camera.mLookAt);
        ImportedCamera imported;
        imported.name = textOf(camera.mName);
        KM_Viewport& viewport = imported.viewport;
        if (!isUsablePoint(location) || !direction.Unitize() ||
            !viewport.SetCameraLocation(location)) {
            return;
        }
        const KM_3dPoint target = location + direction * targetDistance(location, direction);
        viewport.SetTargetPoint(target);
        viewport.SetCameraDirection(target - location);
        viewport.SetCameraUp(turned(camera.mUp));
        setOpening(camera, viewport);
        if (viewport.IsValidCamera()) {
            m_model.cameras.push_back(std::move(imported));
        }
    }

    double targetDistance(const KM_3dPoint& location, const KM_3dVector& direction) {
        if (!m_bounds.IsValid()) {
            for (const ImportedMesh& mesh : m_model.meshes) {
                m_bounds.Union(mesh.placed.box());
            }
        }
        const double distance =
            m_bounds.IsValid() ? (m_bounds.Center() - location) * direction : 1.0;
        return distance > 1e-6 ? distance : 1.0;
    }

    void setOpening(const aiCamera& camera, KM_Viewport& viewport) const {
        constexpr double near_distance = 0.1;
        constexpr double far_distance = 1000.0;
        const double stated = static_cast<double>(camera.mAspect);
        const double aspect = stated > 0.01 && stated < 100.0 ? stated : 4.0 / 3.0;
        const auto open = [&](double half_width) {
            viewport.SetFrustum(-half_width, half_width, -half_width / aspect, half_width / aspect,
                                near_distance, far_distance);
        };
        const double width = static_cast<double>(camera.mOrthographicWidth);
        if (width > 0.0 && std::isfinite(width)) {
            viewport.SetProjection(KM_parallel_view);
            open(width);
            return;
        }
        const double angle = static_cast<double>(camera.mHorizontalFOV);
        const double stated_or_one = stated > 0.0 ? stated : 1.0;
        const double half_angle =
            0.5 * (m_conventions.gltf_cameras ? angle / stated_or_one : angle);
        if (half_angle > 0.01 && half_angle < 1.5) {
            const double half_size = near_distance * std::tan(half_angle);
            open(m_conventions.gltf_cameras ? half_size * aspect : half_size);
        }
    }

    void warnOfDropped() {
        warn(m_dropped, m_triangles, "triangles");
        warn(m_lines_dropped, m_lines_dropped, "line segments");
        warn(m_points_dropped, m_points_dropped, "points");
        if (m_without_area > 0) {
            m_model.warnings.push_back(std::to_string(m_without_area) +
                                       " of its meshes cannot be seen: their triangles have no "
                                       "area.");
        }
    }

    void warn(std::uint64_t dropped, std::uint64_t all, std::string_view what) {
        if (dropped == 0) {
            return;
        }
        std::string count = std::to_string(dropped);
        if (all > dropped) {
            count += " of " + std::to_string(all);
        }
        m_model.warnings.push_back(count + " " + std::string(what) +
                                   " were left out: an index is out of range or a coordinate is "
                                   "no usable number.");
    }

    aiScene& m_scene;
    const ModelConventions& m_conventions;
    ImportedModel m_model;
    MaterialReading m_materials;
    std::vector<PlacedNode> m_nodes;
    std::vector<std::uint64_t> m_uses; ///< how many more times each mesh is shown
    MeshReleases m_releases;
    std::uint64_t m_without_area = 0;    ///< meshes of triangles that are all lines or points
    std::vector<SharedMesh> m_shared;    ///< by mesh of the scene
    std::vector<KM_BoundingBox> m_boxes; ///< likewise, in the mesh's own coordinates
    std::vector<std::shared_ptr<KM_Mesh>> m_incomplete;
    KM_3dPoint m_origin; ///< where the coordinates of meshes that stand once begin
    KM_BoundingBox m_bounds;
    std::uint64_t m_triangles = 0;
    std::uint64_t m_dropped = 0;
    std::uint64_t m_lines_dropped = 0;
    std::uint64_t m_points_dropped = 0;
};

} // namespace

Result<ImportedModel> takeScene(aiScene& scene, const ModelFolder& folder,
                                const ModelConventions& conventions) {
    return SceneReader(scene, folder, conventions).read();
}

} // namespace quarn
