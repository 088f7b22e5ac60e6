#include "kelmar/KM_NurbsCurve.h"

#include "kelmar/KM_SpanParameters.h"
#include "kelmar/KM_Xform.h"

#include <algorithm>
#include <utility>

namespace {

std::size_t at(int index) {
    return static_cast<std::size_t>(index);
}

std::vector<double> uniformKnots(int count, int first, double delta) {
    std::vector<double> knots;
    knots.reserve(at(count));
    for (int i = 0; i < count; ++i)
        knots.push_back((first + i) * delta);
    return knots;
}

} // namespace

KM_NurbsCurve* KM_NurbsCurve::New() {
    return new KM_NurbsCurve;
}

bool KM_NurbsCurve::Create(int dimension, bool rational, int order, int cv_count) {
    if (dimension != 3 || order < 2 || cv_count < order)
        return false;
    m_order = order;
    m_rational = rational;
    m_points.assign(at(cv_count), KM_3dPoint::Origin);
    m_weights.assign(at(cv_count), 1.0);
    m_knots.assign(at(cv_count) + at(order) - 2, 0.0);
    return true;
}

bool KM_NurbsCurve::CreateClampedUniformNurbs(std::span<const KM_3dPoint> points, int order) {
    const std::vector<KM_3dPoint> copies(points.begin(), points.end());
    if (!Create(3, false, order, static_cast<int>(copies.size())))
        return false;
    m_points = copies;
    return MakeClampedUniformKnotVector();
}

bool KM_NurbsCurve::CreatePeriodicUniformNurbs(std::span<const KM_3dPoint> points, int order) {
    std::vector<KM_3dPoint> wrapped(points.begin(), points.end());
    const int degree = order - 1;
    if (degree < 1 || wrapped.size() < at(std::max(3, degree)))
        return false;
    for (int i = 0; i < degree; ++i)
        wrapped.push_back(wrapped[at(i)]);
    if (!Create(3, false, order, static_cast<int>(wrapped.size())))
        return false;
    m_points = std::move(wrapped);
    m_knots = uniformKnots(KnotCount(), 1 - degree, 1.0);
    return true;
}

double KM_NurbsCurve::Knot(int index) const {
    return index >= 0 && index < KnotCount() ? m_knots[at(index)] : KM_UNSET_VALUE;
}

bool KM_NurbsCurve::SetKnot(int index, double knot) {
    if (index < 0 || index >= KnotCount())
        return false;
    m_knots[at(index)] = knot;
    return true;
}

bool KM_NurbsCurve::GetCV(int index, KM_3dPoint& point) const {
    if (index < 0 || index >= CVCount())
        return false;
    point = m_points[at(index)];
    return true;
}

bool KM_NurbsCurve::SetCV(int index, const KM_3dPoint& point) {
    if (index < 0 || index >= CVCount())
        return false;
    m_points[at(index)] = point;
    return true;
}

double KM_NurbsCurve::Weight(int index) const {
    return index >= 0 && index < CVCount() ? m_weights[at(index)] : 0.0;
}

bool KM_NurbsCurve::SetWeight(int index, double weight) {
    if (index < 0 || index >= CVCount() || !KM_IsValid(weight) || weight <= 0.0)
        return false;
    m_weights[at(index)] = weight;
    m_rational = m_rational || weight != 1.0;
    return true;
}

bool KM_NurbsCurve::MakeClampedUniformKnotVector(double delta) {
    if (m_order < 2 || !KM_IsValid(delta) || delta <= 0.0)
        return false;
    const int last = CVCount() - Degree();
    for (int i = 0; i < KnotCount(); ++i)
        m_knots[at(i)] = std::clamp(i - (Degree() - 1), 0, last) * delta;
    return true;
}

KM_NurbsCurve* KM_NurbsCurve::Duplicate() const {
    return new KM_NurbsCurve(*this);
}

const wchar_t* KM_NurbsCurve::TypeName() const {
    return L"NURBS curve";
}

bool KM_NurbsCurve::IsValid() const {
    if (m_order < 2 || CVCount() < m_order || !Domain().IsIncreasing())
        return false;
    for (int i = 0; i < KnotCount(); ++i) {
        if (!KM_IsValid(m_knots[at(i)]) || (i > 0 && m_knots[at(i)] < m_knots[at(i - 1)]))
            return false;
        if (i >= Degree() && m_knots[at(i)] <= m_knots[at(i - Degree())])
            return false;
    }
    const auto is_valid = [](const KM_3dPoint& point) { return point.IsValid(); };
    return std::all_of(m_points.begin(), m_points.end(), is_valid) &&
           !BoundingBox().Diagonal().IsZero();
}

KM_Interval KM_NurbsCurve::Domain() const {
    if (m_order < 2)
        return {};
    return {m_knots[at(m_order - 2)], m_knots[at(CVCount() - 1)]};
}

bool KM_NurbsCurve::SetDomain(double t0, double t1) {
    return kelmar::stretchParameters(m_knots, Domain(), KM_Interval(t0, t1));
}

std::vector<double> KM_NurbsCurve::SpanParameters() const {
    if (m_order < 2)
        return {};
    std::vector<double> spans(m_knots.begin() + (m_order - 2), m_knots.begin() + CVCount());
    spans.erase(std::unique(spans.begin(), spans.end()), spans.end());
    return spans;
}

bool KM_NurbsCurve::Reverse() {
    if (m_order < 2)
        return false;
    std::reverse(m_points.begin(), m_points.end());
    std::reverse(m_weights.begin(), m_weights.end());
    kelmar::reverseParameters(m_knots);
    return true;
}

bool KM_NurbsCurve::Transform(const KM_Xform& xform) {
    if (!xform.IsValid())
        return false;
    std::vector<KM_3dPoint> points = m_points;
    std::vector<double> weights = m_weights;
    const auto& row = xform.m_xform[3];
    for (std::size_t i = 0; i < points.size(); ++i) {
        const KM_3dPoint& p = m_points[i];
        weights[i] *= row[0] * p.x + row[1] * p.y + row[2] * p.z + row[3];
        points[i].Transform(xform);
        if (!points[i].IsValid() || !KM_IsValid(weights[i]))
            return false;
    }
    // Only the ratio of weights counts, so a common sign may be dropped; mixed ones may not.
    if (!weights.empty() && weights[0] < 0.0)
        std::transform(weights.begin(), weights.end(), weights.begin(), std::negate<>());
    const auto is_positive = [](double weight) { return weight > 0.0; };
    if (!std::all_of(weights.begin(), weights.end(), is_positive))
        return false;
    m_points = std::move(points);
    m_weights = std::move(weights);
    m_rational = m_rational || !xform.IsAffine();
    return true;
}

KM_BoundingBox KM_NurbsCurve::BoundingBox() const {
    KM_BoundingBox box;
    for (const KM_3dPoint& point : m_points)
        box.Set(point);
    return box;
}
