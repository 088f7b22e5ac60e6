#include "host/session/ViewPicking.h"

#include "engine/display/LinePick.h"
#include "engine/display/RayPick.h"
#include "host/document/DisplayModeList.h"
#include "host/document/Document.h"
#include "host/document/DocumentDrawing.h"
#include "host/document/DocumentScene.h"

#include <algorithm>
#include <cmath>
#include <tuple>
#include <vector>

namespace quarn {

namespace {

/// How far from the mouse a line or a point object is still meant.
constexpr double REACH_PX = 6.0;

/// How far behind a surface a line on that surface may seem to lie: pixels at its depth, and a
/// share of the scene's size, by which a drawn curve may miss the true one.
constexpr double SURFACE_TOLERANCE_PX = 3.0;
constexpr double SURFACE_TOLERANCE_OF_SIZE = 2e-4;

/// The sine of the angle below which a view direction counts as along an axis, or along the ground.
constexpr double LEAST_SINE = 1e-6;

/// A line or point object near the mouse.
struct Candidate {
    KM_UUID id;
    bool is_curve = false;
    LineHit hit;

    /// Points go before curves, which would cover those on them; then what is nearer to the mouse.
    auto rank() const { return std::tuple(is_curve, hit.distance_px, hit.depth); }
};

std::optional<PickRay> rayAt(const ViewState& view, double x_px, double y_px) {
    PickRay ray;
    const KM_Viewport camera = view.frameCamera();
    const CDisplayPipelineAttributes* const mode = view.displayMode();
    ray.passes_backs = mode && showsMaterials(drawingAttributes(*mode).surface_style);
    ray.is_parallel = camera.IsParallelProjection();
    if (!camera.GetRay(x_px, y_px, ray.origin, ray.direction))
        return std::nullopt;
    return ray;
}

std::optional<KM_3dPoint> onPlane(const PickRay& ray, const KM_3dPoint& through,
                                  const KM_3dVector& normal) {
    const double slope = normal * ray.direction;
    if (std::abs(slope) < LEAST_SINE)
        return std::nullopt;
    const double distance = (normal * (through - ray.origin)) / slope;
    const KM_3dPoint point = ray.origin + distance * ray.direction;
    if (!point.IsValid() || (distance < 0.0 && !ray.is_parallel))
        return std::nullopt;
    return point;
}

/// A camera that is out of range shows nothing that could be picked.
bool seesScene(const ViewState& view, const DocumentScene& scene) {
    return scene.display().canBeSeenBy(view.frameCamera(), view.frameWidth(), view.frameHeight());
}

bool looksAlongAxis(const KM_Viewport& camera) {
    const KM_3dVector& z = camera.CameraZ();
    const double along = std::max({std::abs(z.x), std::abs(z.y), std::abs(z.z)});
    return std::sqrt(std::max(0.0, 1.0 - along * along)) < LEAST_SINE;
}

/// Looks for what is seen at one place of a view's picture.
class Picking {
public:
    Picking(const ViewState& view, const DocumentScene& scene, const PickRay& ray, double x_px,
            double y_px)
        : m_scene(scene), m_ray(ray), m_camera(view.frameCamera()), m_lines(m_camera, x_px, y_px),
          m_sees_all_lines(seesAllLines(view)) {}

    struct Found {
        KM_UUID id;
        KM_3dPoint point;
    };
    std::optional<Found> find() const {
        std::vector<Candidate> near = candidates();
        std::ranges::sort(near, {}, &Candidate::rank);
        for (const Candidate& candidate : near)
            if (m_sees_all_lines || !isCovered(candidate.hit))
                return Found{candidate.id, candidate.hit.point};
        const auto surface = firstSurface(m_scene.display(), m_ray);
        if (!surface)
            return std::nullopt;
        return Found{m_scene.content().meshes[surface->mesh].id, surface->point};
    }

private:
    static bool seesAllLines(const ViewState& view) {
        const CDisplayPipelineAttributes* mode = view.displayMode();
        if (!mode)
            return true;
        const DisplayModeAttributes attributes = drawingAttributes(*mode);
        return attributes.shows_hidden_lines || attributes.surface_style == SurfaceStyle::none ||
               attributes.surface_style == SurfaceStyle::translucent ||
               attributes.surface_style == SurfaceStyle::x_ray;
    }

    std::vector<Candidate> candidates() const {
        std::vector<Candidate> near;
        const auto take = [&](const KM_UUID& id, bool is_curve, const std::optional<LineHit>& hit) {
            if (hit && hit->distance_px <= REACH_PX)
                near.push_back({id, is_curve, *hit});
        };
        for (const SceneCurve& curve : m_scene.display().curves())
            if (curve.visible)
                take(curve.id, true,
                     m_lines.nearest({curve.polyline.Array(),
                                      static_cast<std::size_t>(curve.polyline.Count())}));
        for (const ScenePoint& point : m_scene.display().points())
            if (point.visible)
                take(point.id, false, m_lines.nearest({&point.location, 1}));
        return near;
    }

    bool isCovered(const LineHit& line) const {
        PickRay ray = m_ray;
        KM_3dVector way = line.point - m_camera.CameraLocation();
        if (ray.is_parallel) {
            way = -line.depth * m_camera.CameraZ();
            ray.origin = line.point - way;
        } else {
            ray.origin = m_camera.CameraLocation();
            ray.direction = way;
            if (!ray.direction.Unitize())
                return false;
        }
        const auto surface = firstSurface(m_scene.display(), ray);
        const double distance = ray.is_parallel ? line.depth : way.Length();
        const double tolerance =
            SURFACE_TOLERANCE_PX * m_lines.pixelSizeAt(line.depth) +
            SURFACE_TOLERANCE_OF_SIZE * m_scene.display().boundingBox().Diagonal().Length();
        return surface && surface->distance < distance - tolerance;
    }

    const DocumentScene& m_scene;
    const PickRay& m_ray;
    KM_Viewport m_camera;
    LinePick m_lines;
    bool m_sees_all_lines;
};

PickedObject describe(const ObjectTable& objects, const Picking::Found& found) {
    PickedObject picked;
    picked.id = found.id;
    picked.point = found.point;
    if (const DocumentObject* object = objects.find(found.id)) {
        picked.name = object->name;
        picked.is_selected = object->selected;
    }
    if (picked.name.IsEmpty())
        picked.name = KM_UuidToString(found.id);
    return picked;
}

} // namespace

std::optional<PickedObject> objectAt(CQuarnView& view, double x_px, double y_px) {
    const ViewState& state = ViewState::of(view);
    if (!state.isOpen())
        return std::nullopt;
    const auto ray = rayAt(state, x_px, y_px);
    if (!ray)
        return std::nullopt;
    const auto scene = state.document().drawing().scene();
    if (!scene || !seesScene(state, *scene.value()))
        return std::nullopt;
    const auto found = Picking(state, *scene.value(), *ray, x_px, y_px).find();
    if (!found)
        return std::nullopt;
    return describe(state.document().objects(), *found);
}

std::optional<KM_3dPoint> pointAt(CQuarnView& view, double x_px, double y_px) {
    const ViewState& state = ViewState::of(view);
    if (!state.isOpen())
        return std::nullopt;
    const auto ray = rayAt(state, x_px, y_px);
    if (!ray)
        return std::nullopt;
    if (const auto scene = state.document().drawing().scene();
        scene && seesScene(state, *scene.value()))
        if (const auto surface = firstSurface(scene.value()->display(), *ray))
            return surface->point;
    const KM_Viewport camera = state.frameCamera();
    if (!ray->is_parallel || !looksAlongAxis(camera))
        return onPlane(*ray, KM_3dPoint::Origin, KM_3dVector::ZAxis);
    const bool has_target = camera.TargetPoint().IsValid();
    return onPlane(*ray, has_target ? camera.TargetPoint() : KM_3dPoint::Origin, camera.CameraZ());
}

} // namespace quarn
