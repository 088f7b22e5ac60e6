#include "host/document/ViewFit.h"

#include "host/document/CameraMove.h"
#include "host/document/ObjectTable.h"

#include <algorithm>
#include <cmath>

namespace quarn {

namespace {

/// How far out the farthest point comes, from the middle of the picture (0) to its border (1).
constexpr double FILL = 0.95;

/// The least distance of the camera from the nearest point, as a share of the objects' size: what
/// is a line in the direction of view leaves the camera no other bound.
constexpr double CLEARANCE_OF_SIZE = 0.005;

constexpr double CHORD_TOLERANCE_OF_SIZE = 1e-4;

template <class Visit> void visitPoints(const DocumentObject& object, Visit&& visit) {
    if (object.mesh) {
        for (const KM_3fPoint& vertex : object.mesh->m_V)
            visit(vertex.ToDouble());
    } else if (object.curve) {
        KM_3dPointArray points;
        const double size = object.curve->BoundingBox().Diagonal().Length();
        object.curve->GetDisplayPolyline(CHORD_TOLERANCE_OF_SIZE * size, points);
        std::for_each(points.begin(), points.end(), visit);
    } else if (object.point) {
        visit(*object.point);
    }
}

template <class Visit> void visitVisiblePoints(const ObjectTable& objects, Visit&& visit) {
    for (const auto& object : objects.objects())
        if (object->visible)
            visitPoints(*object, visit);
}

KM_BoundingBox visibleBox(const ObjectTable& objects) {
    KM_BoundingBox box;
    visitVisiblePoints(objects, [&](const KM_3dPoint& point) { box.Set(point); });
    return box;
}

/// Half the opening of the picture that may be filled: width and height, as tangents of the half
/// angles in perspective.
struct Opening {
    double x;
    double y;
};

Opening filledOpening(const KM_Viewport& viewport) {
    double vertical = 0.0;
    double horizontal = 0.0;
    if (viewport.GetCameraHalfAngles(&vertical, &horizontal))
        return {FILL * std::tan(horizontal), FILL * std::tan(vertical)};
    return {FILL * viewport.FrustumAspect(), FILL};
}

/// How far points reach out as a camera sees them: sideways, up or down, toward it, and how far
/// from the target it must stand for the picture to hold them.
class Reach {
public:
    Reach(const KM_Viewport& camera, const KM_3dPoint& target)
        : m_target(target), m_x(camera.CameraX()), m_y(camera.CameraY()), m_z(camera.CameraZ()),
          m_opening(filledOpening(camera)),
          m_cos_elevation(std::hypot(camera.CameraZ().x, camera.CameraZ().y)),
          m_sin_elevation(camera.CameraZ().z) {}

    /// A point that stands still.
    void add(const KM_3dPoint& point) {
        const KM_3dVector v = point - m_target;
        const double x = std::abs(v * m_x);
        const double y = std::abs(v * m_y);
        const double z = v * m_z;
        take(x, y, z, v.LengthSquared());
        m_distance = std::max({m_distance, z + x / m_opening.x, z + y / m_opening.y});
    }

    /// A point that turns once about the vertical through the target. At the turning angle a it is
    /// seen at x = r sin a, y = h cos e - r cos a sin e, z = h sin e + r cos a cos e, where r is
    /// its distance from the vertical, h its height over the target and e the camera's elevation;
    /// each bound below is the largest value over all a.
    void addTurning(const KM_3dPoint& point) {
        const KM_3dVector v = point - m_target;
        const double r = std::hypot(v.x, v.y);
        const double rise = v.z * m_cos_elevation;
        const double toward = v.z * m_sin_elevation;
        take(r, r * std::abs(m_sin_elevation) + std::abs(rise), r * m_cos_elevation + toward,
             v.LengthSquared());
        const double sideways = r * std::hypot(m_cos_elevation, 1.0 / m_opening.x) + toward;
        const double slope = m_sin_elevation / m_opening.y;
        const double up = r * std::abs(m_cos_elevation - slope) + toward + rise / m_opening.y;
        const double down = r * std::abs(m_cos_elevation + slope) + toward - rise / m_opening.y;
        m_distance = std::max({m_distance, sideways, up, down});
    }

    /// Distance of a perspective camera from the target at which the picture holds all points.
    double distance(double clearance) const {
        return std::max({m_distance, m_toward + clearance, clearance});
    }
    /// Half the height of a parallel picture that holds all points; 0 for a single one.
    double parallelHalfHeight() const {
        return std::max(m_sideways / m_opening.x, m_upright / m_opening.y);
    }
    /// Of the farthest point from the target.
    double radius() const { return std::sqrt(m_radius_squared); }

private:
    void take(double sideways, double upright, double toward, double radius_squared) {
        m_sideways = std::max(m_sideways, sideways);
        m_upright = std::max(m_upright, upright);
        m_toward = std::max(m_toward, toward);
        m_radius_squared = std::max(m_radius_squared, radius_squared);
    }

    KM_3dPoint m_target;
    KM_3dVector m_x;
    KM_3dVector m_y;
    KM_3dVector m_z;
    Opening m_opening;
    double m_cos_elevation;
    double m_sin_elevation;
    double m_sideways = 0.0;
    double m_upright = 0.0;
    double m_toward = -HUGE_VAL;
    double m_distance = -HUGE_VAL;
    double m_radius_squared = 0.0;
};

Reach measure(const KM_Viewport& camera, const KM_3dPoint& target, const ObjectTable& objects,
              bool turn) {
    Reach reach(camera, target);
    if (turn)
        visitVisiblePoints(objects, [&](const KM_3dPoint& point) { reach.addTurning(point); });
    else
        visitVisiblePoints(objects, [&](const KM_3dPoint& point) { reach.add(point); });
    return reach;
}

/// Puts the camera at a distance from the target, along its present direction.
bool placeCamera(KM_Viewport& viewport, const KM_3dPoint& target, double distance) {
    const KM_3dVector to_camera = viewport.CameraZ();
    viewport.SetTargetPoint(target);
    return moveCamera(viewport, target, target + distance * to_camera, true);
}

/// A distance at which the direction of view keeps its digits, so far from the origin as it is.
double safeDistance(const KM_3dPoint& target, double size) {
    return std::max({1.0, size, std::abs(target.x), std::abs(target.y), std::abs(target.z)});
}

bool standBack(KM_Viewport& viewport, const KM_3dPoint& target, double distance, double radius) {
    if (!placeCamera(viewport, target, distance))
        return false;
    const double near_distance = std::max((distance - radius) / 2.0, distance / 1000.0);
    return viewport.SetFrustumNearFar(near_distance, 2.0 * (distance + radius));
}

bool fitPerspective(KM_Viewport& viewport, const Reach& reach, const KM_3dPoint& target,
                    double clearance, double factor) {
    return standBack(viewport, target, factor * reach.distance(clearance), reach.radius());
}

bool fitParallel(KM_Viewport& viewport, const Reach& reach, const KM_3dPoint& target,
                 double clearance, double factor) {
    const double aspect = viewport.FrustumAspect();
    const double fitted = reach.parallelHalfHeight();
    const double half_height = factor * (fitted > 0.0 ? fitted : clearance);
    const double distance = 2.0 * std::max(reach.radius(), clearance);
    if (!standBack(viewport, target, distance, reach.radius()))
        return false;
    double near_distance = 0.0;
    double far_distance = 0.0;
    viewport.GetFrustum(nullptr, nullptr, nullptr, nullptr, &near_distance, &far_distance);
    return viewport.SetFrustum(-half_height * aspect, half_height * aspect, -half_height,
                               half_height, near_distance, far_distance);
}

} // namespace

Result<KM_Viewport> fitViewport(const KM_Viewport& viewport, const ObjectTable& objects,
                                const ViewFit& fit) {
    const KM_BoundingBox box = visibleBox(objects);
    if (!box.IsValid())
        return Error{"There is nothing visible to fit into the view. Import a model or show an "
                     "object first."};
    const bool keeps_target = fit.keep_target && viewport.TargetPoint().IsValid();
    const KM_3dPoint target = keeps_target ? viewport.TargetPoint() : box.Center();
    const double size = box.Diagonal().Length();
    // A single point has no size; any distance shows it.
    const double clearance = size > 0.0 ? CLEARANCE_OF_SIZE * size : 1.0;

    KM_Viewport fitted = viewport;
    const bool is_placed = placeCamera(fitted, target, safeDistance(target, size));
    const Reach reach = measure(fitted, target, objects, fit.turn);
    const auto fit_camera = fitted.IsPerspectiveProjection() ? fitPerspective : fitParallel;
    if (!is_placed || !fit_camera(fitted, reach, target, clearance, fit.distance))
        return Error{"The view cannot be fitted: the objects are too small, or too far from the "
                     "origin. Scale or move the model before it is imported."};
    return fitted;
}

} // namespace quarn
