#include "engine/display/DisplayScene.h"

#include "engine/display/BuildProgress.h"
#include "engine/display/LightChoice.h"
#include "engine/images/ColorSpace.h"
#include "engine/scene/DrawableRange.h"
#include "engine/scene/PlacedMesh.h"

#include <algorithm>
#include <limits>
#include <utility>

namespace quarn {

namespace {

/// Of the building of meshes, which are read once, all of which are searched later.
constexpr double SHARE_OF_MESHES = 0.2;

constexpr std::size_t no_member = static_cast<std::size_t>(-1);

KM_BoundingBox boxOf(const KM_3dPointArray& points) {
    KM_BoundingBox box;
    for (const KM_3dPoint& p : points)
        box.Set(p);
    return box;
}

bool canBeShown(const SceneCurve& curve) {
    return curve.polyline.Count() > 0;
}

bool canBeShown(const ScenePoint& point) {
    return point.location.IsValid();
}

/// @return true when an object was shown or hidden
template <class Object>
bool takeVisibility(const std::vector<Object>& from, std::vector<Object>& to) {
    bool changed = false;
    for (std::size_t i = 0; i < to.size(); ++i) {
        const bool visible = from[i].visible && canBeShown(to[i]);
        changed |= std::exchange(to[i].visible, visible) != visible;
    }
    return changed;
}

/// How much of a sun's light comes through glass, whatever its colour.
float passingOf(const SurfaceLook& look, const LinearColor& albedo) {
    const float(&part)[3] = look.numbers.passing;
    const float mean = (part[0] * albedo.r + part[1] * albedo.g + part[2] * albedo.b) / 3.0F;
    return mean * (1.0F - look.numbers.metalness);
}

/// The greatest distance of a corner from the origin, along an axis.
double greatestCoordinate(const KM_BoundingBox& box) {
    return std::max({std::abs(box.m_min.x), std::abs(box.m_min.y), std::abs(box.m_min.z),
                     std::abs(box.m_max.x), std::abs(box.m_max.y), std::abs(box.m_max.z)});
}

} // namespace

DisplayScene::DisplayScene() = default;
DisplayScene::~DisplayScene() = default;

void DisplayScene::shareWith(const DisplayScene& earlier) {
    m_mesh_cache = earlier.m_mesh_cache;
    m_materials = earlier.m_materials;
    m_rays.shareWith(earlier.m_rays);
    m_picture = earlier.m_picture;
}

Result<void> DisplayScene::update(const SceneContent& content, BuildProgress* progress) {
    if (canKeep(content))
        updateVisibility(content);
    else
        rebuild(content, progress);
    updateLight(content);
    std::string error = m_rays.takeError();
    if (progress && progress->is_given_up)
        error = "The scene was not built: it was given up.";
    if (error.empty())
        return {};
    clear();
    return Error{error};
}

void DisplayScene::updateLight(const SceneContent& content) {
    m_lights = content.lights;
    m_light = content.light;
    m_surroundings = surroundingsOf(m_light, m_lights, m_whole_box);
    if (m_surroundings != Surroundings::picture)
        m_picture = nullptr;
    else if (!m_picture || m_picture->picture() != m_light.picture)
        m_picture = std::make_shared<const PictureLight>(m_light.picture);
}

bool DisplayScene::canKeep(const SceneContent& content) const {
    return m_built && !m_rays.mustBeBuiltAgain() && content.revision == m_revision &&
           content.meshes.size() == m_meshes.size() && content.curves.size() == m_curves.size() &&
           content.points.size() == m_points.size();
}

void DisplayScene::clear() {
    m_built = false;
    m_meshes.clear();
    m_curves.clear();
    m_points.clear();
    m_out_of_range.clear();
    updateBoxes();
}

void DisplayScene::rebuild(const SceneContent& content, BuildProgress* progress) {
    // What rays search is taken over by the address of its mesh, which therefore stays till then.
    const MeshCache earlier_meshes = std::exchange(m_mesh_cache, {});
    m_materials.beginRevision();
    addMeshes(content, earlier_meshes, progress);
    choosePlaces(content);
    dropMeshesBeyondReach(content);
    std::vector<RayScene::Member> members;
    m_member_of_mesh.clear();
    for (std::size_t i = 0; i < m_meshes.size(); ++i) {
        const MeshObject& object = m_meshes[i];
        m_member_of_mesh.push_back(object.mesh ? members.size() : no_member);
        if (object.mesh)
            members.push_back({object.mesh, surfaceOf(content.meshes[i], *object.mesh),
                               object.visible, object.frame_from_mesh});
    }
    if (!progress || !progress->is_given_up)
        m_rays.build(std::move(members), progress);
    m_materials.endRevision();
    takeLines(content);
    m_revision = content.revision;
    m_built = true;
    updateBoxes();
}

void DisplayScene::addMeshes(const SceneContent& content, const MeshCache& earlier,
                             BuildProgress* progress) {
    m_meshes.clear();
    m_out_of_range.clear();
    const auto count = static_cast<double>(content.meshes.size());
    for (const SceneMesh& object : content.meshes) {
        if (progress && progress->is_given_up)
            return;
        addMesh(object, earlier);
        if (progress)
            progress->share = SHARE_OF_MESHES * static_cast<double>(m_meshes.size()) / count;
    }
}

void DisplayScene::addMesh(const SceneMesh& object, const MeshCache& earlier) {
    auto& mesh = m_mesh_cache[object.placed.mesh.get()];
    if (!mesh) {
        const auto found = earlier.find(object.placed.mesh.get());
        mesh = found != earlier.end() ? found->second
                                      : std::make_shared<const RayMesh>(object.placed.mesh);
    }
    const bool drawable =
        mesh->isDrawable() && isInDrawableRange(mesh->box(), object.placed.world_from_mesh);
    if (!drawable && (mesh->isDrawable() || !mesh->isInRange()))
        m_out_of_range.push_back(object.id);
    const KM_BoundingBox box = drawable ? object.placed.box(mesh->box()) : KM_BoundingBox();
    m_meshes.push_back({drawable ? mesh : nullptr, object.visible, KM_Xform(), box});
}

/// The origin is one of the objects' own where that is near enough: such objects then need no
/// transform.
void DisplayScene::choosePlaces(const SceneContent& content) {
    KM_BoundingBox box;
    for (const MeshObject& object : m_meshes)
        box.Union(object.box);
    m_origin = nearbyOrigin(box);
    const double reach = 100.0 * box.Diagonal().Length();
    for (const SceneMesh& object : content.meshes) {
        const KM_3dPoint own = object.placed.world_from_mesh * KM_3dPoint::Origin;
        if (m_origin == KM_3dPoint::Origin || own == m_origin)
            break;
        if (own != KM_3dPoint::Origin && own.DistanceTo(box.Center()) < reach) {
            m_origin = own;
            break;
        }
    }
    const KM_Xform frame_from_world = KM_Xform::Translation(KM_3dPoint::Origin - m_origin);
    for (std::size_t i = 0; i < m_meshes.size(); ++i)
        m_meshes[i].frame_from_mesh = frame_from_world * content.meshes[i].placed.world_from_mesh;
}

/// A mesh of a very small scale cannot stand beside a very large one: in its own coordinates rays
/// that start there would be out of range.
void DisplayScene::dropMeshesBeyondReach(const SceneContent& content) {
    const KM_3dVector from_world = KM_3dPoint::Origin - m_origin;
    double size = 0.0;
    for (const MeshObject& object : m_meshes)
        if (object.mesh)
            size = std::max(size, greatestCoordinate({object.box.m_min + from_world,
                                                      object.box.m_max + from_world}));
    m_reach = std::numeric_limits<double>::infinity();
    for (std::size_t i = 0; i < m_meshes.size(); ++i) {
        MeshObject& object = m_meshes[i];
        if (!object.mesh)
            continue;
        const double reach = reachOfRays(object.mesh->box(), object.frame_from_mesh);
        if (reach >= rays_start_within * size) {
            m_reach = std::min(m_reach, reach);
            continue;
        }
        m_out_of_range.push_back(content.meshes[i].id);
        object.mesh = nullptr;
    }
}

void DisplayScene::takeLines(const SceneContent& content) {
    m_curves = content.curves;
    for (SceneCurve& curve : m_curves)
        if (!isInDrawableRange(curve.polyline)) {
            m_out_of_range.push_back(curve.id);
            curve.polyline.Empty();
            curve.visible = false;
        }
    m_points = content.points;
    for (ScenePoint& point : m_points)
        if (!isInDrawableRange(point.location)) {
            m_out_of_range.push_back(point.id);
            point.location = KM_3dPoint::UnsetPoint;
            point.visible = false;
        }
}

bool DisplayScene::canBeSeenBy(const KM_Viewport& camera, int width_px, int height_px) const {
    return isInDrawableRange(camera, width_px, height_px,
                             {m_origin, m_box.Diagonal().Length(), m_reach});
}

std::size_t DisplayScene::meshOfSurface(std::size_t surface) const {
    const std::size_t member = m_rays.surfaceMembers()[surface];
    const auto found = std::ranges::find(m_member_of_mesh, member);
    return static_cast<std::size_t>(found - m_member_of_mesh.begin());
}

RaySurface DisplayScene::surfaceOf(const SceneMesh& object, const RayMesh& mesh) {
    static const Material default_material;
    const Material& material = object.placed.material ? *object.placed.material : default_material;
    const LinearColor albedo = linearFromColor(material.base_color);
    RaySurface surface;
    surface.triangles = mesh.mesh().m_F.data();
    surface.vertices = mesh.mesh().m_V.data();
    surface.corner_normals = mesh.cornerNormals();
    surface.colors = mesh.mesh().m_C.empty() ? nullptr : mesh.mesh().m_C.data();
    surface.albedo[0] = albedo.r;
    surface.albedo[1] = albedo.g;
    surface.albedo[2] = albedo.b;
    surface.opacity = static_cast<float>(material.base_color.a) / 255.0F;
    surface.has_cutout = material.alpha_cutout;
    surface.alpha_cutoff = material.alpha_cutoff;
    surface.see_through = material.see_through && !material.alpha_cutout;
    const bool has_coordinates = !mesh.mesh().m_T.empty();
    surface.look = m_materials.look(object.placed.material, has_coordinates);
    if (surface.look)
        surface.passing = passingOf(*surface.look, albedo);
    if (has_coordinates && material.base_color_texture)
        surface.texture = m_materials.texture(material.base_color_texture, TexelMeaning::colors);
    if (surface.texture || (surface.look && surface.look->has_textures))
        surface.texture_coordinates = mesh.mesh().m_T.data();
    return surface;
}

void DisplayScene::updateVisibility(const SceneContent& content) {
    bool rays_changed = false;
    for (std::size_t i = 0; i < m_meshes.size(); ++i) {
        if (m_meshes[i].visible == content.meshes[i].visible)
            continue;
        m_meshes[i].visible = content.meshes[i].visible;
        if (m_member_of_mesh[i] != no_member)
            m_rays.setVisible(m_member_of_mesh[i], m_meshes[i].visible);
        rays_changed = true;
    }
    if (rays_changed)
        m_rays.commit();
    const bool curves_changed = takeVisibility(content.curves, m_curves);
    const bool points_changed = takeVisibility(content.points, m_points);
    if (rays_changed || curves_changed || points_changed)
        updateBoxes();
}

void DisplayScene::updateBoxes() {
    m_surface_box = KM_BoundingBox();
    m_whole_box = KM_BoundingBox();
    for (const MeshObject& object : m_meshes) {
        if (!object.mesh)
            continue;
        m_whole_box.Union(object.box);
        if (object.visible)
            m_surface_box.Union(object.box);
    }
    m_box = m_surface_box;
    for (const SceneCurve& curve : m_curves)
        if (curve.visible)
            m_box.Union(boxOf(curve.polyline));
    for (const ScenePoint& point : m_points)
        if (point.visible)
            m_box.Set(point.location);
}

} // namespace quarn
