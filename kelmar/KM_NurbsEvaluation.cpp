// De Boor's algorithm. With the local knots u[0..2p-1] around the span [u[p-1], u[p]] and the
// span's p + 1 control points d[0..p], level r of the triangle replaces d[j], j = p..r, by the
// point between d[j-1] and d[j] at (t - u[j-1]) / (u[j+p-r] - u[j-1]). The last d[p] is the point;
// the two points of the level before it give the derivative, p / (u[p] - u[p-1]) times their
// difference.

#include "kelmar/KM_NurbsCurve.h"

#include <algorithm>

namespace {

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

// The knots that matter for a span must ascend, and the span must have a length.
bool spanIsSound(const double* u, int degree) {
    for (int i = 1; i < 2 * degree; ++i) {
        if (!(u[i - 1] <= u[i]))
            return false;
    }
    return KM_IsValid(u[0]) && KM_IsValid(u[2 * degree - 1]) && u[degree - 1] < u[degree];
}

} // namespace

// The triangle at a parameter but for its last level: the curve's point is one between two others.
class KM_NurbsCurve::Triangle {
public:
    Triangle(const KM_NurbsCurve& curve, double t) : m_degree(curve.Degree()), m_t(t) {
        const int first = curve.SpanAt(t) - (m_degree - 1);
        m_knots = curve.m_knots.data() + first;
        m_points = curve.m_points.data() + first;
        m_is_sound = spanIsSound(m_knots, m_degree);
        if (m_is_sound)
            Run(curve.m_weights.data() + first);
    }

    KM_3dPoint Point() const {
        if (!m_is_sound)
            return KM_3dPoint::UnsetPoint;
        // Where a whole set of knots meets, the curve passes through a control point, without
        // rounding. At the span's start the sum below already gives it.
        if (m_t == m_knots[m_degree] && m_knots[2 * m_degree - 1] == m_t)
            return OrUnset(m_points[m_degree]);
        const Homogeneous sum = Sum();
        if (sum.w == 0.0)
            return KM_3dPoint::UnsetPoint;
        return OrUnset(m_points[0] + KM_3dVector(sum.x / sum.w, sum.y / sum.w, sum.z / sum.w));
    }

    KM_3dVector Derivative() const {
        if (!m_is_sound)
            return KM_3dVector::UnsetVector;
        const Homogeneous change = slope(m_from, m_to, m_degree / SpanLength());
        const Homogeneous sum = Sum();
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

    void Run(const double* weights) {
        std::vector<Homogeneous> points;
        for (int j = 0; j <= m_degree; ++j) {
            const KM_3dVector v = weights[j] * (m_points[j] - m_points[0]);
            points.push_back({v.x, v.y, v.z, weights[j]});
        }
        Homogeneous* const d = points.data();
        const double* const u = m_knots;
        for (int r = 1; r < m_degree; ++r) {
            for (int j = m_degree; j >= r; --j)
                d[j] = between(d[j - 1], d[j], (m_t - u[j - 1]) / (u[j + m_degree - r] - u[j - 1]));
        }
        m_from = d[m_degree - 1];
        m_to = d[m_degree];
    }

    double SpanLength() const { return m_knots[m_degree] - m_knots[m_degree - 1]; }
    Homogeneous Sum() const {
        return between(m_from, m_to, (m_t - m_knots[m_degree - 1]) / SpanLength());
    }

    int m_degree;
    double m_t;
    bool m_is_sound;
    const double* m_knots;
    const KM_3dPoint* m_points;
    Homogeneous m_from{};
    Homogeneous m_to{};
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
    return Triangle(*this, t).Point();
}

KM_3dVector KM_NurbsCurve::DerivativeAt(double t) const {
    if (m_order < 2 || !KM_IsValid(t))
        return KM_3dVector::UnsetVector;
    return Triangle(*this, t).Derivative();
}
