#pragma once

#include "engine/display/MaterialCache.h"
#include "engine/display/PictureLight.h"
#include "engine/display/RayScene.h"
#include "engine/scene/SceneContent.h"
#include "ground/Result.h"
#include "kelmar/KM_BoundingBox.h"

#include <cmath>
#include <map>
#include <memory>
#include <span>
#include <vector>

class KM_Viewport;

namespace quarn {

/// A document's content made ready for drawing. It is kept between frames: a camera animation
/// rebuilds nothing, and a sun study only changes a direction.
class DisplayScene {
public:
    DisplayScene();
    ~DisplayScene();
    DisplayScene(const DisplayScene&) = delete;
    DisplayScene& operator=(const DisplayScene&) = delete;

    /// Lets a scene that has nothing yet use what another one has built: what it needs of meshes,
    /// textures and the search structures of large meshes. Both may then be used by threads of
    /// their own.
    void shareWith(const DisplayScene& earlier);

    /// Takes over what changed since the last call: everything when the revision is new, else the
    /// lights and what is shown or hidden. Meshes stay shared with the document. A mesh with
    /// indices outside its vertices or arrays of different lengths is not drawn, nor is an object
    /// that is out of range, see DrawableRange.h.
    /// @param progress  may be null; told to another thread, which may give the building up
    /// @return an error when the ray scene cannot be built, or was given up; then the scene is
    /// empty
    Result<void> update(const SceneContent& content, BuildProgress* progress = nullptr);

    /// The box of everything that is shown; empty when nothing is.
    const KM_BoundingBox& boundingBox() const { return m_box; }
    /// The box of the meshes that are shown.
    const KM_BoundingBox& surfaceBox() const { return m_surface_box; }

    /// Where the coordinates of the ray scene and of `MeshObject` begin: they are those of the
    /// world, less this point, so that models far from the origin keep their digits.
    const KM_3dPoint& origin() const { return m_origin; }

    /// Whether a picture of the scene can be taken; others show the background.
    bool canBeSeenBy(const KM_Viewport& camera, int width_px, int height_px) const;

    /// The objects that are never drawn, because they are out of range.
    std::span<const KM_UUID> outOfRange() const { return m_out_of_range; }

    /// A mesh object for drawing its lines; `mesh` is null when it cannot be drawn.
    struct MeshObject {
        std::shared_ptr<const RayMesh> mesh;
        bool visible = true;
        KM_Xform frame_from_mesh;
        KM_BoundingBox box; ///< in the world
    };

    const RayScene& rays() const { return m_rays; }
    std::span<const MeshObject> meshes() const { return m_meshes; }
    /// The mesh object that a surface of the ray scene belongs to, as an index in `meshes`.
    std::size_t meshOfSurface(std::size_t surface) const;
    /// Curves and points that are out of range have no polyline and no place, and are hidden.
    std::span<const SceneCurve> curves() const { return m_curves; }
    std::span<const ScenePoint> points() const { return m_points; }
    std::span<const KM_Light> lights() const { return m_lights; }
    const LightSettings& light() const { return m_light; }
    /// What lies around, see surroundingsOf: studio, sky or picture.
    Surroundings surroundings() const { return m_surroundings; }
    /// Null unless a picture lies around.
    const PictureLight* pictureLight() const { return m_picture.get(); }
    /// Of all surfaces that can be drawn, shown or hidden, in the world.
    const KM_BoundingBox& wholeBox() const { return m_whole_box; }

private:
    using MeshCache = std::map<const KM_Mesh*, std::shared_ptr<const RayMesh>>;

    bool canKeep(const SceneContent& content) const;
    void rebuild(const SceneContent& content, BuildProgress* progress);
    void addMeshes(const SceneContent& content, const MeshCache& earlier, BuildProgress* progress);
    void updateVisibility(const SceneContent& content);
    void updateBoxes();
    void updateLight(const SceneContent& content);
    void addMesh(const SceneMesh& object, const MeshCache& earlier);
    void choosePlaces(const SceneContent& content);
    void dropMeshesBeyondReach(const SceneContent& content);
    void takeLines(const SceneContent& content);
    void clear();
    RaySurface surfaceOf(const SceneMesh& object, const RayMesh& mesh);

    bool m_built = false;
    std::uint64_t m_revision = 0;
    RayScene m_rays;
    MeshCache m_mesh_cache;
    MaterialCache m_materials;
    std::vector<MeshObject> m_meshes;
    std::vector<std::size_t> m_member_of_mesh; ///< index in the ray scene; none: no_member
    std::vector<SceneCurve> m_curves;
    std::vector<ScenePoint> m_points;
    std::vector<KM_UUID> m_out_of_range;
    std::vector<KM_Light> m_lights;
    LightSettings m_light;
    Surroundings m_surroundings = Surroundings::sky;
    std::shared_ptr<const PictureLight> m_picture;
    KM_3dPoint m_origin;
    double m_reach = HUGE_VAL; ///< how far from the origin rays may start
    KM_BoundingBox m_whole_box;
    KM_BoundingBox m_box;
    KM_BoundingBox m_surface_box;
};

} // namespace quarn
