#include "kelmar/KM_PolylineCurve.h"

#include "kelmar/KM_Line.h"
#include "kelmar/KM_SpanParameters.h"
#include "kelmar/KM_Xform.h"

#include <algorithm>

namespace {

void copyPoints(std::span<const KM_3dPoint> from, KM_3dPointArray& to) {
    KM_3dPointArray copies;
    copies.Append(static_cast<int>(from.size()), from.data());
    to = copies;
}

} // namespace

KM_PolylineCurve::KM_PolylineCurve(std::span<const KM_3dPoint> corners) {
    copyPoints(corners, m_corners);
    for (int i = 0; i < m_corners.Count(); ++i)
        m_parameters.push_back(i);
}

bool KM_PolylineCurve::Create(std::span<const KM_3dPoint> corners,
                              std::span<const double> parameters) {
    if (corners.size() != parameters.size())
        return false;
    for (std::size_t i = 0; i < parameters.size(); ++i) {
        if (!KM_IsValid(parameters[i]) || (i > 0 && parameters[i] <= parameters[i - 1]))
            return false;
    }
    copyPoints(corners, m_corners);
    m_parameters.assign(parameters.begin(), parameters.end());
    return true;
}

KM_PolylineCurve* KM_PolylineCurve::Duplicate() const {
    return new KM_PolylineCurve(*this);
}

const wchar_t* KM_PolylineCurve::TypeName() const {
    return L"polyline";
}

bool KM_PolylineCurve::IsValid() const {
    const auto is_valid = [](const KM_3dPoint& corner) { return corner.IsValid(); };
    return PointCount() >= 2 && std::all_of(m_corners.begin(), m_corners.end(), is_valid) &&
           !BoundingBox().Diagonal().IsZero();
}

KM_Interval KM_PolylineCurve::Domain() const {
    return m_parameters.empty() ? KM_Interval()
                                : KM_Interval(m_parameters.front(), m_parameters.back());
}

bool KM_PolylineCurve::SetDomain(double t0, double t1) {
    return kelmar::stretchParameters(m_parameters, Domain(), KM_Interval(t0, t1));
}

std::vector<double> KM_PolylineCurve::SpanParameters() const {
    return m_parameters;
}

// The segment that begins at or before the parameter; the first or last one beyond the ends.
int KM_PolylineCurve::SegmentAt(double t) const {
    const auto next = std::upper_bound(m_parameters.begin(), m_parameters.end(), t);
    const int segment = static_cast<int>(next - m_parameters.begin()) - 1;
    return std::clamp(segment, 0, PointCount() - 2);
}

KM_3dPoint KM_PolylineCurve::PointAt(double t) const {
    if (PointCount() < 2 || !KM_IsValid(t))
        return KM_3dPoint::UnsetPoint;
    const int segment = SegmentAt(t);
    const auto i = static_cast<std::size_t>(segment);
    const KM_Line line(m_corners[segment], m_corners[segment + 1]);
    const KM_Interval domain(m_parameters[i], m_parameters[i + 1]);
    const KM_3dPoint point = line.PointAt(domain.NormalizedParameterAt(t));
    return line.IsValid() && point.IsValid() ? point : KM_3dPoint::UnsetPoint;
}

KM_3dVector KM_PolylineCurve::DerivativeAt(double t) const {
    if (PointCount() < 2 || !KM_IsValid(t))
        return KM_3dVector::UnsetVector;
    const int segment = SegmentAt(t);
    const auto i = static_cast<std::size_t>(segment);
    const KM_Line line(m_corners[segment], m_corners[segment + 1]);
    if (!line.IsValid())
        return KM_3dVector::UnsetVector;
    return line.Direction() / (m_parameters[i + 1] - m_parameters[i]);
}

bool KM_PolylineCurve::Reverse() {
    if (m_parameters.empty())
        return false;
    m_corners.Reverse();
    kelmar::reverseParameters(m_parameters);
    return true;
}

bool KM_PolylineCurve::Transform(const KM_Xform& xform) {
    KM_3dPointArray moved = m_corners;
    for (KM_3dPoint& corner : moved) {
        corner.Transform(xform);
        if (!corner.IsValid())
            return false;
    }
    m_corners = moved;
    return true;
}

KM_BoundingBox KM_PolylineCurve::BoundingBox() const {
    KM_BoundingBox box;
    for (const KM_3dPoint& corner : m_corners)
        box.Set(corner);
    return box;
}

bool KM_PolylineCurve::GetLength(double* length, double) const {
    if (!IsValid())
        return false;
    double total = 0.0;
    for (int i = 0; i + 1 < PointCount(); ++i)
        total += m_corners[i].DistanceTo(m_corners[i + 1]);
    if (length)
        *length = total;
    return true;
}

void KM_PolylineCurve::GetDisplayPolyline(double, KM_3dPointArray& points) const {
    points.Empty();
    if (IsValid())
        points = m_corners;
}
