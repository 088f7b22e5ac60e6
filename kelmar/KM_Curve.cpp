#include "kelmar/KM_Curve.h"

#include "kelmar/KM_Line.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <limits>

namespace {

// Nodes and weights of the Gauss-Kronrod pair of 7 and 15 points (QUADPACK, routine QK15). The
// nodes of the 7 point rule are every second one, the middle included.
constexpr std::array<double, 8> nodes = {
    0.991455371120812639206854697526329, 0.949107912342758524526189684047851,
    0.864864423359769072789712788640926, 0.741531185599394439863864773280788,
    0.586087235467691130294144691258260, 0.405845151377397166906606412076961,
    0.207784955007898467600689403773245, 0.0};
constexpr std::array<double, 8> kronrod_weights = {
    0.022935322010529224963732008058970, 0.063092092629978553290700663189204,
    0.104790010322250183839876322541518, 0.140653259715525918745189590510238,
    0.169004726639267902826583426598550, 0.190350578064785409913256402421014,
    0.204432940075298892414161999234649, 0.209482141084727828012999174891714};
constexpr std::array<double, 4> gauss_weights = {
    0.129484966168869693270611432679082, 0.279705391489276667901467771423780,
    0.381830050505118944950369775488975, 0.417959183673469387755102040816327};

struct Estimate {
    double length;
    double error;
};

Estimate estimateLength(const KM_Curve& curve, double t0, double t1) {
    const double middle = 0.5 * (t0 + t1);
    const double half = 0.5 * (t1 - t0);
    const auto speed = [&](double t) {
        const KM_3dVector derivative = curve.DerivativeAt(t);
        return derivative.IsValid() ? derivative.Length()
                                    : std::numeric_limits<double>::quiet_NaN();
    };
    double kronrod = 0.0;
    double gauss = 0.0;
    for (std::size_t i = 0; i < nodes.size(); ++i) {
        const double offset = half * nodes[i];
        const double value =
            offset == 0.0 ? speed(middle) : speed(middle - offset) + speed(middle + offset);
        kronrod += kronrod_weights[i] * value;
        if (i % 2 == 1)
            gauss += gauss_weights[i / 2] * value;
    }
    return {half * kronrod, half * std::abs(kronrod - gauss)};
}

// Halves a piece of a curve until the estimates are good enough. A curve whose derivatives are
// mostly rounding, as with a weight of 1e16 beside others of 1, would be halved a million times for
// nothing: so the estimates are counted, and the best that there is counts when they are used up.
class LengthDivision {
public:
    explicit LengthDivision(const KM_Curve& curve) : m_curve(curve) {}

    double Length(double t0, double t1, double allowed, int depth) {
        const Estimate whole = estimateLength(m_curve, t0, t1);
        --m_estimates_left;
        // What is no number comes from a curve that cannot be evaluated, and would not get better.
        if (!(whole.error > allowed) || depth == 0 || m_estimates_left <= 0)
            return whole.length;
        const double middle = 0.5 * (t0 + t1);
        return Length(t0, middle, 0.5 * allowed, depth - 1) +
               Length(middle, t1, 0.5 * allowed, depth - 1);
    }

private:
    const KM_Curve& m_curve;
    int m_estimates_left = 1000; // a kink takes some forty
};

double adaptiveLength(const KM_Curve& curve, double t0, double t1, double allowed, int depth) {
    return LengthDivision(curve).Length(t0, t1, allowed, depth);
}

double distanceToChord(const KM_3dPoint& point, const KM_Line& chord) {
    const KM_3dVector along = chord.Direction();
    const double square = along.LengthSquared();
    const double s = square > 0.0 ? ((point - chord.from) * along) / square : 0.0;
    return point.DistanceTo(chord.PointAt(std::clamp(s, 0.0, 1.0)));
}

// Divides a piece of a curve until the chords are near enough, and appends the ends of the chords.
class ChordDivision {
public:
    ChordDivision(const KM_Curve& curve, double tolerance, KM_3dPointArray& points)
        : m_curve(curve), m_tolerance(tolerance), m_points(points) {}

    void Divide(double t0, const KM_3dPoint& from, double t1, const KM_3dPoint& to, int depth) {
        if (depth == 0 || isNear(t0, t1, KM_Line(from, to))) {
            m_points.Append(to);
            return;
        }
        const double middle = 0.5 * (t0 + t1);
        const KM_3dPoint point = m_curve.PointAt(middle);
        if (!point.IsValid())
            return;
        Divide(t0, from, middle, point, depth - 1);
        Divide(middle, point, t1, to, depth - 1);
    }

private:
    // The places are uneven, so that no symmetric wave passes through all of them.
    bool isNear(double t0, double t1, const KM_Line& chord) const {
        constexpr std::array<double, 3> places = {0.5, 0.23, 0.79};
        return std::all_of(places.begin(), places.end(), [&](double s) {
            const KM_3dPoint point = m_curve.PointAt(std::lerp(t0, t1, s));
            return distanceToChord(point, chord) <= m_tolerance;
        });
    }

    const KM_Curve& m_curve;
    double m_tolerance;
    KM_3dPointArray& m_points;
};

} // namespace

KM_Curve::~KM_Curve() = default;

KM_3dVector KM_Curve::TangentAt(double t) const {
    KM_3dVector tangent = DerivativeAt(t);
    if (tangent.Unitize())
        return tangent;
    const KM_Interval domain = Domain();
    const double inward = t < domain.Max() ? domain.Length() : -domain.Length();
    for (const int exponent : {-26, -13}) {
        tangent = DerivativeAt(t + std::ldexp(inward, exponent));
        if (tangent.Unitize())
            return tangent;
    }
    return KM_3dVector::ZeroVector;
}

KM_3dPoint KM_Curve::PointAtStart() const {
    return PointAt(Domain().Min());
}

KM_3dPoint KM_Curve::PointAtEnd() const {
    return PointAt(Domain().Max());
}

bool KM_Curve::IsClosed() const {
    const KM_3dPoint start = PointAtStart();
    const KM_3dPoint end = PointAtEnd();
    if (!start.IsValid() || !end.IsValid())
        return false;
    const KM_BoundingBox box = BoundingBox();
    const double extent = box.Diagonal().Length();
    const double reach = std::max({std::abs(start.x), std::abs(start.y), std::abs(start.z)});
    const double rounding = 4.0 * std::numeric_limits<double>::epsilon() * reach;
    const double allowed = KM_ZERO_TOLERANCE * extent + rounding;
    return extent > 2.0 * allowed && start.DistanceTo(end) <= allowed;
}

bool KM_Curve::GetLength(double* length, double fractional_tolerance) const {
    if (!IsValid())
        return false;
    const double tolerance = std::max(fractional_tolerance, 1e-12);
    const std::vector<double> spans = SpanParameters();
    double rough = 0.0;
    for (std::size_t i = 0; i + 1 < spans.size(); ++i)
        rough += estimateLength(*this, spans[i], spans[i + 1]).length;
    const double allowed = tolerance * rough / static_cast<double>(spans.size());
    double total = 0.0;
    for (std::size_t i = 0; i + 1 < spans.size(); ++i)
        total += adaptiveLength(*this, spans[i], spans[i + 1], allowed, 20);
    if (!KM_IsValid(total))
        return false;
    if (length)
        *length = total;
    return true;
}

double KM_Curve::LengthBetween(double t0, double t1, double fractional_tolerance) const {
    const double rough = estimateLength(*this, t0, t1).length;
    return adaptiveLength(*this, t0, t1, std::max(fractional_tolerance, 1e-12) * rough, 20);
}

void KM_Curve::GetDisplayPolyline(double chord_tolerance, KM_3dPointArray& points) const {
    constexpr int finest_depth = 12; // 2^12 = 4096 chords a piece
    points.Empty();
    if (!IsValid())
        return;
    const double tolerance = chord_tolerance > 0.0 ? chord_tolerance : -1.0;
    const std::vector<double> spans = SpanParameters();
    ChordDivision division(*this, tolerance, points);
    KM_3dPoint from = PointAt(spans.front());
    points.Append(from);
    for (std::size_t i = 0; i + 1 < spans.size(); ++i) {
        const KM_3dPoint to = PointAt(spans[i + 1]);
        division.Divide(spans[i], from, spans[i + 1], to, finest_depth);
        from = to;
    }
}
