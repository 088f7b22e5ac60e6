#include "host/curves/CurveEditing.h"

#include "kelmar/KM_LineCurve.h"
#include "kelmar/KM_NurbsCurve.h"
#include "kelmar/KM_PolylineCurve.h"

#include <algorithm>
#include <string>

namespace quarn {

namespace {

KM_3dPoint pointOf(const KM_NurbsCurve& curve, int index) {
    KM_3dPoint point;
    curve.GetCV(index, point);
    return point;
}

/// How many control points at the end of a curve are those of its start again: none of an open
/// one, the degree of a periodic one, 1 of one that is clamped where it closes.
int repeatedPoints(const KM_NurbsCurve& curve) {
    if (!curve.IsClosed())
        return 0;
    for (const int count : {curve.Degree(), 1}) {
        const int turn = curve.CVCount() - count;
        bool repeats = turn > 0;
        for (int i = 0; i < count && repeats; ++i)
            repeats = pointOf(curve, i) == pointOf(curve, i + turn) &&
                      curve.Weight(i) == curve.Weight(i + turn);
        if (repeats)
            return count;
    }
    return 0;
}

int repeatedPoints(const KM_PolylineCurve& polyline) {
    const KM_3dPointArray& corners = polyline.Points();
    return corners.Count() > 2 && *corners.First() == *corners.Last() ? 1 : 0;
}

int countOf(const KM_NurbsCurve& curve) {
    return curve.CVCount() - repeatedPoints(curve);
}

int countOf(const KM_PolylineCurve& polyline) {
    return polyline.PointCount() - repeatedPoints(polyline);
}

std::unique_ptr<KM_Curve> movedLine(const KM_LineCurve& line, int index, const KM_3dPoint& place) {
    std::unique_ptr<KM_LineCurve> moved(line.Duplicate());
    (index == 0 ? moved->m_line.from : moved->m_line.to) = place;
    return moved;
}

std::unique_ptr<KM_Curve> movedPolyline(const KM_PolylineCurve& polyline, int index,
                                        const KM_3dPoint& place) {
    KM_3dPointArray corners = polyline.Points();
    for (int i = index; i < corners.Count(); i += countOf(polyline))
        corners[i] = place;
    auto moved = std::make_unique<KM_PolylineCurve>();
    const std::span all(corners.Array(), static_cast<std::size_t>(corners.Count()));
    if (std::ranges::adjacent_find(all) != all.end() || !moved->Create(all, polyline.Parameters()))
        return nullptr;
    return moved;
}

std::unique_ptr<KM_Curve> movedNurbs(const KM_NurbsCurve& curve, int index,
                                     const KM_3dPoint& place) {
    std::unique_ptr<KM_NurbsCurve> moved(curve.Duplicate());
    for (int i = index; i < curve.CVCount(); i += countOf(curve))
        moved->SetCV(i, place);
    return moved;
}

std::unique_ptr<KM_Curve> moved(const KM_Curve& curve, int index, const KM_3dPoint& place) {
    if (const auto* line = dynamic_cast<const KM_LineCurve*>(&curve))
        return movedLine(*line, index, place);
    if (const auto* polyline = dynamic_cast<const KM_PolylineCurve*>(&curve))
        return movedPolyline(*polyline, index, place);
    if (const auto* nurbs = dynamic_cast<const KM_NurbsCurve*>(&curve))
        return movedNurbs(*nurbs, index, place);
    return nullptr;
}

} // namespace

int movablePointCount(const KM_Curve& curve) {
    if (dynamic_cast<const KM_LineCurve*>(&curve))
        return 2;
    if (const auto* polyline = dynamic_cast<const KM_PolylineCurve*>(&curve))
        return countOf(*polyline);
    if (const auto* nurbs = dynamic_cast<const KM_NurbsCurve*>(&curve))
        return countOf(*nurbs);
    return 0;
}

CurveResult withMovedPoint(const KM_Curve& curve, int index, const KM_3dPoint& place) {
    const int count = movablePointCount(curve);
    if (index < 0 || index >= count)
        return Error{"The curve has no point " + std::to_string(index) + "; its points are 0 to " +
                     std::to_string(count - 1) + "."};
    if (!place.IsValid())
        return Error{"The new place is no point."};
    std::unique_ptr<KM_Curve> result = moved(curve, index, place);
    if (!result || !result->IsValid())
        return Error{"The point cannot be where its neighbour is."};
    return CurveResult(std::move(result));
}

} // namespace quarn
