// De Boor's algorithm. With the local knots u[0..2p-1] around the span [u[p-1], u[p]] and the
// span's p + 1 control points d[0..p], level r of the triangle replaces d[j], j = p..r, by the
// point between d[j-1] and d[j] at (t - u[j-1]) / (u[j+p-r] - u[j-1]). The last d[p] is the point;
// the two points of the level before it give the derivative, p / (u[p] - u[p-1]) times their
// difference.

#include "kelmar/KM_NurbsCurve.h"

#include <algorithm>
#include <array>
#include <cmath>

namespace {

constexpr int stack_order = 16;

// A control point times its weight, and the weight. Places are relative to the span's first
// control point: a curve far from the origin keeps its digits, a plane one its plane.
struct Homogeneous {
    double x;
    double y;
    double z;
    double w;
};

Homogeneous between(const Homogeneous& a, const Homogeneous& b, double s) {
    return {std::lerp(a.x, b.x, s), std::lerp(a.y, b.y, s), std::lerp(a.z, b.z, s),
            std::lerp(a.w, b.w, s)};
}

Homogeneous slope(const Homogeneous& a, const Homogeneous& b, double factor) {
    return {factor * (b.x - a.x), factor * (b.y - a.y), factor * (b.z - a.z), factor * (b.w - a.w)};
}

// Room for the control points of a span: on the stack, but for degrees that hardly anyone uses.
class SpanPoints {
public:
    explicit SpanPoints(int order) {
        if (order > stack_order)
            m_many.resize(static_cast<std::size_t>(order));
    }
    Homogeneous& operator[](int index) {
        const auto i = static_cast<std::size_t>(index);
        return m_many.empty() ? m_few[i] : m_many[i];
    }

private:
    std::array<Homogeneous, stack_order> m_few;
    std::vector<Homogeneous> m_many;
};

// The knots that matter for a span must ascend, and the span must have a length.
bool spanIsSound(const double* u, int degree) {
    for (int i = 1; i < 2 * degree; ++i) {
        if (!(u[i - 1] <= u[i]))
            return false;
    }
    return KM_IsValid(u[0]) && KM_IsValid(u[2 * degree - 1]) && u[degree - 1] < u[degree];
}

} // namespace

// The last span that begins at or before the parameter and has a length; the first or last one of
// the domain when the parameter lies beyond it.
int KM_NurbsCurve::SpanAt(double t) const {
    const int first = m_order - 2;
    const int last = CVCount() - 1;
    const auto begin = m_knots.begin() + first;
    const auto end = m_knots.begin() + last;
    const double inside = std::clamp(t, *begin, std::max(*begin, *end));
    int span = static_cast<int>(std::upper_bound(begin, end, inside) - m_knots.begin()) - 1;
    span = std::clamp(span, first, last - 1);
    while (span > first && m_knots[static_cast<std::size_t>(span)] >= *end)
        --span;
    return span;
}

KM_NurbsCurve::Evaluation KM_NurbsCurve::Evaluate(double t) const {
    if (m_order < 2 || !KM_IsValid(t))
        return {};
    const int degree = Degree();
    const int first = SpanAt(t) - (degree - 1);
    const double* u = m_knots.data() + first;
    const KM_3dPoint* points = m_points.data() + first;
    const double* weights = m_weights.data() + first;
    if (!spanIsSound(u, degree))
        return {};

    const KM_3dPoint origin = points[0];
    SpanPoints d(m_order);
    for (int j = 0; j <= degree; ++j) {
        const KM_3dVector v = weights[j] * (points[j] - origin);
        d[j] = {v.x, v.y, v.z, weights[j]};
    }
    for (int r = 1; r < degree; ++r) {
        for (int j = degree; j >= r; --j)
            d[j] = between(d[j - 1], d[j], (t - u[j - 1]) / (u[j + degree - r] - u[j - 1]));
    }
    const double length = u[degree] - u[degree - 1];
    const Homogeneous change = slope(d[degree - 1], d[degree], degree / length);
    const Homogeneous sum = between(d[degree - 1], d[degree], (t - u[degree - 1]) / length);
    if (sum.w == 0.0)
        return {};

    const KM_3dVector local(sum.x / sum.w, sum.y / sum.w, sum.z / sum.w);
    Evaluation evaluation;
    evaluation.point = origin + local;
    // Where a whole set of knots meets, the curve passes through a control point, without rounding.
    // At the span's start the sum above already gives it.
    if (t == u[degree] && u[2 * degree - 1] == t)
        evaluation.point = points[degree];
    evaluation.derivative = (KM_3dVector(change.x, change.y, change.z) - change.w * local) / sum.w;
    evaluation.valid = evaluation.point.IsValid() && evaluation.derivative.IsValid();
    return evaluation;
}

KM_3dPoint KM_NurbsCurve::PointAt(double t) const {
    const Evaluation evaluation = Evaluate(t);
    return evaluation.valid ? evaluation.point : KM_3dPoint::UnsetPoint;
}

KM_3dVector KM_NurbsCurve::DerivativeAt(double t) const {
    const Evaluation evaluation = Evaluate(t);
    return evaluation.valid ? evaluation.derivative : KM_3dVector::UnsetVector;
}
