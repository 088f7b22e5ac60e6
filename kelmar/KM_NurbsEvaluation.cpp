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

// Exact at s = 0 and for equal numbers. std::lerp is exact at s = 1 too and never leaves the
// bounds, by comparisons that take several times as long as all the rest.
Homogeneous between(const Homogeneous& a, const Homogeneous& b, double s) {
    return {a.x + s * (b.x - a.x), a.y + s * (b.y - a.y), a.z + s * (b.z - a.z),
            a.w + s * (b.w - a.w)};
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
    Homogeneous* data() { return m_many.empty() ? m_few.data() : m_many.data(); }
    const Homogeneous* data() const { return m_many.empty() ? m_few.data() : m_many.data(); }

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

// The triangle without its last level: leaves the two points of which the curve's point is one
// between in d[degree - 1] and d[degree].
inline void runTriangle(Homogeneous* d, const double* u, int degree, double t) {
    for (int r = 1; r < degree; ++r) {
        for (int j = degree; j >= r; --j)
            d[j] = between(d[j - 1], d[j], (t - u[j - 1]) / (u[j + degree - r] - u[j - 1]));
    }
}

// Where the parameter lies between the ends of the span, from 0 to 1.
double placeInSpan(const double* u, int degree, double t) {
    return (t - u[degree - 1]) / (u[degree] - u[degree - 1]);
}

// The sum of the triangle, without the division by its weight. The degree of nearly all curves is a
// constant here, which takes the loops apart.
Homogeneous sumOfTriangle(const SpanPoints& control_points, SpanPoints& work, const double* u,
                          int degree, double t) {
    if (degree == 3) {
        std::array<Homogeneous, 4> d;
        std::copy_n(control_points.data(), d.size(), d.data());
        runTriangle(d.data(), u, 3, t);
        return between(d[2], d[3], placeInSpan(u, 3, t));
    }
    Homogeneous* d = work.data();
    std::copy_n(control_points.data(), degree + 1, d);
    runTriangle(d, u, degree, t);
    return between(d[degree - 1], d[degree], placeInSpan(u, degree, t));
}

} // namespace

// A stretch between two knots, with what its points are computed from.
class KM_NurbsCurve::Span {
public:
    Span(const KM_NurbsCurve& curve, double t)
        : m_degree(curve.Degree()), m_rational(curve.m_rational), m_control_points(curve.m_order),
          m_work(curve.m_order) {
        const int first = curve.SpanAt(t) - (m_degree - 1);
        m_knots = curve.m_knots.data() + first;
        m_points = curve.m_points.data() + first;
        m_is_sound = spanIsSound(m_knots, m_degree);
        const double* weights = curve.m_weights.data() + first;
        for (int j = 0; j <= m_degree; ++j) {
            const KM_3dVector v = weights[j] * (m_points[j] - m_points[0]);
            m_control_points.data()[j] = {v.x, v.y, v.z, weights[j]};
        }
    }

    bool Holds(double t) const { return t >= m_knots[m_degree - 1] && t < m_knots[m_degree]; }

    KM_3dPoint PointAt(double t) {
        if (!m_is_sound)
            return KM_3dPoint::UnsetPoint;
        // Where a whole set of knots meets, the curve passes through a control point, without
        // rounding. At the span's start the sum below already gives it.
        if (t == m_knots[m_degree] && m_knots[2 * m_degree - 1] == t)
            return OrUnset(m_points[m_degree]);
        const Homogeneous sum = sumOfTriangle(m_control_points, m_work, m_knots, m_degree, t);
        if (!m_rational)
            return OrUnset(m_points[0] + KM_3dVector(sum.x, sum.y, sum.z));
        if (sum.w == 0.0)
            return KM_3dPoint::UnsetPoint;
        return OrUnset(m_points[0] + KM_3dVector(sum.x / sum.w, sum.y / sum.w, sum.z / sum.w));
    }

    KM_3dVector DerivativeAt(double t) {
        if (!m_is_sound)
            return KM_3dVector::UnsetVector;
        Homogeneous* d = m_work.data();
        std::copy_n(m_control_points.data(), m_degree + 1, d);
        runTriangle(d, m_knots, m_degree, t);
        const Homogeneous& from = d[m_degree - 1];
        const Homogeneous& to = d[m_degree];
        const double length = m_knots[m_degree] - m_knots[m_degree - 1];
        const Homogeneous change = slope(from, to, m_degree / length);
        const Homogeneous sum = between(from, to, placeInSpan(m_knots, m_degree, t));
        if (sum.w == 0.0)
            return KM_3dVector::UnsetVector;
        const KM_3dVector local(sum.x / sum.w, sum.y / sum.w, sum.z / sum.w);
        const KM_3dVector derivative =
            (KM_3dVector(change.x, change.y, change.z) - change.w * local) / sum.w;
        return derivative.IsValid() ? derivative : KM_3dVector::UnsetVector;
    }

private:
    static KM_3dPoint OrUnset(const KM_3dPoint& point) {
        return point.IsValid() ? point : KM_3dPoint::UnsetPoint;
    }

    int m_degree;
    bool m_rational;
    bool m_is_sound;
    const double* m_knots;
    const KM_3dPoint* m_points;
    SpanPoints m_control_points;
    SpanPoints m_work;
};

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

KM_3dPoint KM_NurbsCurve::PointAt(double t) const {
    if (m_order < 2 || !KM_IsValid(t))
        return KM_3dPoint::UnsetPoint;
    return Span(*this, t).PointAt(t);
}

void KM_NurbsCurve::PointsAt(std::span<const double> parameters, KM_3dPoint* points) const {
    for (std::size_t i = 0; i < parameters.size();) {
        const double first = parameters[i];
        if (m_order < 2 || !KM_IsValid(first)) {
            points[i++] = KM_3dPoint::UnsetPoint;
            continue;
        }
        Span span(*this, first);
        do {
            points[i] = span.PointAt(parameters[i]);
            ++i;
        } while (i < parameters.size() && span.Holds(parameters[i]));
    }
}

KM_3dVector KM_NurbsCurve::DerivativeAt(double t) const {
    if (m_order < 2 || !KM_IsValid(t))
        return KM_3dVector::UnsetVector;
    return Span(*this, t).DerivativeAt(t);
}
