#include "host/document/ViewFit.h"

#include "host/document/CameraMove.h"
#include "host/document/DisplayPolyline.h"
#include "host/document/ObjectTable.h"
#include "host/document/Reach.h"
#include "host/document/TurnProfile.h"
#include "sdk/qncore/QnLocalize.h"

#include <algorithm>
#include <cmath>
#include <map>

namespace quarn {

namespace {

/// The least distance of the camera from the nearest point, as a share of the objects' size: what
/// is a line in the direction of view leaves the camera no other bound.
constexpr double CLEARANCE_OF_SIZE = 0.005;

constexpr double CHORD_TOLERANCE_OF_SIZE = 1e-4;

/// A repeated mesh smaller than this share of all that is visible is taken for its box.
constexpr double SMALL_SHARE = 0.02;

/// The points of all visible objects. Meshes that are repeated a thousand times, as bolts and
/// leaves are, are represented by the corners of their boxes, so that they are fitted at once.
class VisiblePoints {
public:
    explicit VisiblePoints(const ObjectTable& objects) : m_objects(objects) {
        for (const auto& object : objects.objects()) {
            if (!isFitted(*object))
                continue;
            if (object->placed.mesh)
                m_box.Union(object->boundingBox());
            else
                visitCurveOrPoint(*object, [&](const KM_3dPoint& point) { m_box.Set(point); });
        }
    }

    const KM_BoundingBox& box() const { return m_box; }

    template <class Visit> void visit(Visit&& visit) const {
        for (const auto& object : m_objects.objects()) {
            if (!isFitted(*object))
                continue;
            if (!object->placed.mesh)
                visitCurveOrPoint(*object, visit);
            else if (isSmallCopy(*object))
                visitCorners(*object, visit);
            else
                visitVertices(*object, visit);
        }
    }

private:
    static bool isFitted(const DocumentObject& object) {
        return object.visible && object.isInDrawableRange();
    }

    bool isSmallCopy(const DocumentObject& object) const {
        return !object.placed.world_from_mesh.IsIdentity() && object.placed.mesh.use_count() > 2 &&
               object.boundingBox().Diagonal().Length() < SMALL_SHARE * m_box.Diagonal().Length();
    }

    template <class Visit> void visitCorners(const DocumentObject& object, Visit& visit) const {
        const auto [found, is_new] = m_mesh_boxes.try_emplace(object.placed.mesh.get());
        if (is_new)
            found->second = object.placed.mesh->BoundingBox();
        for (int corner = 0; corner < 8; ++corner)
            visit(object.placed.world_from_mesh * found->second.Corner(corner));
    }

    template <class Visit> static void visitVertices(const DocumentObject& object, Visit& visit) {
        if (object.placed.world_from_mesh.IsIdentity()) {
            for (const KM_3fPoint& vertex : object.placed.mesh->m_V)
                visit(vertex.ToDouble());
            return;
        }
        for (const KM_3fPoint& vertex : object.placed.mesh->m_V)
            visit(object.placed.world_from_mesh * vertex.ToDouble());
    }

    template <class Visit>
    static void visitCurveOrPoint(const DocumentObject& object, Visit&& visit) {
        if (object.curve) {
            const KM_3dPointArray points = displayPolyline(*object.curve, CHORD_TOLERANCE_OF_SIZE);
            std::for_each(points.begin(), points.end(), visit);
        } else if (object.point) {
            visit(*object.point);
        }
    }

    const ObjectTable& m_objects;
    KM_BoundingBox m_box;
    mutable std::map<const KM_Mesh*, KM_BoundingBox> m_mesh_boxes;
};

Reach measure(const KM_Viewport& camera, const KM_3dPoint& target, const VisiblePoints& points,
              bool turn) {
    Reach reach(camera, target);
    if (turn)
        points.visit([&](const KM_3dPoint& point) { reach.addTurning(point); });
    else
        points.visit([&](const KM_3dPoint& point) { reach.add(point); });
    return reach;
}

KM_3dPoint middleOfTurn(const KM_Viewport& camera, const KM_3dPoint& target,
                        const VisiblePoints& points) {
    TurnProfile profile(target, points.box().m_min.z, points.box().m_max.z);
    points.visit([&](const KM_3dPoint& point) { profile.add(point); });
    return profile.middle(camera);
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
    const VisiblePoints points(objects);
    const KM_BoundingBox& box = points.box();
    if (!box.IsValid() && std::ranges::any_of(objects.objects(), &DocumentObject::visible))
        return Error{
            KM_wString(QnLocalizeString(L"All that is visible lies too far from the origin "
                                        L"to be drawn. Move or scale it first.",
                                        42523))
                .ToUtf8()};
    if (!box.IsValid())
        return Error{"There is nothing visible to fit into the view. Import a model or show an "
                     "object first."};
    const bool keeps_target = fit.keep_target && viewport.TargetPoint().IsValid();
    KM_3dPoint target = keeps_target ? viewport.TargetPoint() : box.Center();
    const double size = box.Diagonal().Length();
    // A single point has no size; any distance shows it.
    const double clearance = size > 0.0 ? CLEARANCE_OF_SIZE * size : 1.0;

    KM_Viewport fitted = viewport;
    bool is_placed = placeCamera(fitted, target, safeDistance(target, size));
    if (fit.turn && !keeps_target && fitted.IsPerspectiveProjection()) {
        target = middleOfTurn(fitted, target, points);
        is_placed = is_placed && placeCamera(fitted, target, safeDistance(target, size));
    }
    const Reach reach = measure(fitted, target, points, fit.turn);
    const auto fit_camera = fitted.IsPerspectiveProjection() ? fitPerspective : fitParallel;
    if (!is_placed || !fit_camera(fitted, reach, target, clearance, fit.distance))
        return Error{"The view cannot be fitted: the objects are too small, or too far from the "
                     "origin. Scale or move the model before it is imported."};
    return fitted;
}

} // namespace quarn
