#include "host/curves/EvenSpeed.h"

#include "kelmar/KM_LineCurve.h"
#include "kelmar/KM_NurbsCurve.h"
#include "kelmar/KM_PolylineCurve.h"

#include <algorithm>
#include <array>
#include <cmath>
#include <limits>

namespace quarn {

namespace {

constexpr double SPEED_TOLERANCE =
    2e-4; // of the speed anywhere; steps differ by twice that at most
constexpr std::size_t MOST_PIECES = 1'000'000;
constexpr int DEEPEST = 60;

// ---- Lines and polylines

CurveResult evenLine(const KM_LineCurve& line) {
    std::unique_ptr<KM_LineCurve> even(line.Duplicate());
    const double length = line.m_line.from.DistanceTo(line.m_line.to);
    if (!even->SetDomain(0.0, length))
        return Error{"The line is too long or too short to be measured."};
    return CurveResult(std::move(even));
}

CurveResult evenPolyline(const KM_PolylineCurve& polyline) {
    std::vector<KM_3dPoint> corners;
    std::vector<double> parameters;
    for (const KM_3dPoint& corner : polyline.Points()) {
        const double length =
            corners.empty() ? 0.0 : parameters.back() + corners.back().DistanceTo(corner);
        if (!corners.empty() && length == parameters.back())
            continue;
        corners.push_back(corner);
        parameters.push_back(length);
    }
    auto even = std::make_unique<KM_PolylineCurve>();
    if (!even->Create(corners, parameters) || !even->IsValid())
        return Error{"The polyline is too long or too short to be measured."};
    return CurveResult(std::move(even));
}

// ---- Other curves

/// One cubic piece by its Bezier points.
struct BezierPiece {
    std::array<KM_3dPoint, 4> b;

    KM_3dPoint pointAt(double s) const {
        const double r = 1.0 - s;
        return b[0] + 3.0 * r * r * s * (b[1] - b[0]) + 3.0 * r * s * s * (b[2] - b[0]) +
               s * s * s * (b[3] - b[0]);
    }
    double speedAt(double s) const {
        const double r = 1.0 - s;
        return 3.0 * (r * r * (b[1] - b[0]) + 2.0 * r * s * (b[2] - b[1]) + s * s * (b[3] - b[2]))
                         .Length();
    }
};

/// A part of the curve, and what is known about it.
struct Part {
    double t0 = 0.0;
    double t1 = 0.0;
    std::array<double, 8> eighths{}; ///< arc lengths
    double length = 0.0;

    double at(double share) const { return std::lerp(t0, t1, share); }
};

/// Lays Bezier pieces along a curve, each as long as its parameter is wide.
class PieceLaying {
public:
    PieceLaying(const KM_Curve& curve, double tolerance)
        : m_curve(curve), m_tolerance(tolerance), m_points{curve.PointAtStart()} {}

    /// Lays the smooth part between two parameters.
    /// @return false when the curve cannot be evaluated there, or there are too many pieces
    bool lay(double t0, double t1, int depth = DEEPEST) {
        const Part part = measured(t0, t1);
        const KM_3dPoint end = m_curve.PointAt(t1);
        if (!KM_IsValid(part.length) || !end.IsValid() || m_knots.size() > MOST_PIECES)
            return false;
        const BezierPiece piece = pieceOf(part, end);
        if (follows(piece, part)) {
            add(piece, part.length);
            return true;
        }
        // Where a curve turns on the spot no smooth piece is short enough.
        if (part.length <= m_tolerance || depth == 0) {
            addStraight(end);
            return true;
        }
        const double middle = part.at(0.5);
        return lay(t0, middle, depth - 1) && lay(middle, t1, depth - 1);
    }

    /// The curve of all pieces; null when they make none.
    std::unique_ptr<KM_NurbsCurve> curve(bool closed) {
        if (closed)
            m_points.back() = m_points.front();
        auto curve = std::make_unique<KM_NurbsCurve>();
        if (!curve->Create(3, false, 4, static_cast<int>(m_points.size())))
            return nullptr;
        for (int i = 0; i < curve->CVCount(); ++i)
            curve->SetCV(i, m_points[static_cast<std::size_t>(i)]);
        for (int i = 0; i < curve->KnotCount(); ++i)
            curve->SetKnot(i, m_knots[static_cast<std::size_t>(i) / 3]);
        return curve->IsValid() ? std::move(curve) : nullptr;
    }

private:
    Part measured(double t0, double t1) const {
        Part part{t0, t1, {}, 0.0};
        for (std::size_t i = 0; i < part.eighths.size(); ++i) {
            const double share = 0.125 * static_cast<double>(i);
            part.eighths[i] = m_curve.LengthBetween(part.at(share), part.at(share + 0.125));
            part.length += part.eighths[i];
        }
        return part;
    }

    /// The direction near the start or end of a part, from inside: the end may be a kink, and the
    /// curve may stand still there.
    KM_3dVector directionAt(const Part& part, bool at_end) const {
        for (const int exponent : {-26, -13}) {
            const double share = std::ldexp(1.0, exponent);
            KM_3dVector direction = m_curve.DerivativeAt(part.at(at_end ? 1.0 - share : share));
            if (direction.Unitize())
                return direction;
        }
        return KM_3dVector::ZeroVector;
    }

    BezierPiece pieceOf(const Part& part, const KM_3dPoint& end) const {
        const KM_3dPoint& start = m_points.back();
        const double third = part.length / 3.0;
        return {{start, start + third * directionAt(part, false),
                 end - third * directionAt(part, true), end}};
    }

    bool follows(const BezierPiece& piece, const Part& part) const {
        for (const double s : {0.0, 0.15, 0.3, 0.5, 0.7, 0.85, 1.0}) {
            if (!(std::abs(piece.speedAt(s) - part.length) <= SPEED_TOLERANCE * part.length))
                return false;
        }
        double length = 0.0;
        for (std::size_t i = 0; i + 1 < part.eighths.size(); ++i) {
            length += part.eighths[i];
            const KM_3dPoint point = m_curve.PointAt(part.at(0.125 * static_cast<double>(i + 1)));
            // Half of what is allowed, as the curves are compared in a few places only.
            if (!(piece.pointAt(length / part.length).DistanceTo(point) <= 0.5 * m_tolerance))
                return false;
        }
        return true;
    }

    void add(const BezierPiece& piece, double length) {
        const double knot = m_knots.back() + length;
        if (!(knot > m_knots.back()))
            return;
        m_points.insert(m_points.end(), piece.b.begin() + 1, piece.b.end());
        m_knots.push_back(knot);
    }

    void addStraight(const KM_3dPoint& end) {
        const KM_3dPoint start = m_points.back();
        const KM_3dVector third = (end - start) / 3.0;
        add({{start, start + third, end - third, end}}, start.DistanceTo(end));
    }

    const KM_Curve& m_curve;
    double m_tolerance;
    std::vector<KM_3dPoint> m_points;
    std::vector<double> m_knots{0.0}; ///< each stands for three
};

/// Coordinates cannot be told apart more finely than this.
double roundingOf(const KM_Curve& curve) {
    const KM_BoundingBox box = curve.BoundingBox();
    double reach = 0.0;
    for (const KM_3dPoint& corner : {box.m_min, box.m_max})
        reach = std::max({reach, std::abs(corner.x), std::abs(corner.y), std::abs(corner.z)});
    return 64.0 * std::numeric_limits<double>::epsilon() * reach;
}

} // namespace

CurveResult evenSpeedCurve(const KM_Curve& curve, double tolerance) {
    if (!curve.IsValid())
        return Error{"The curve has no extent or cannot be evaluated."};
    if (const auto* line = dynamic_cast<const KM_LineCurve*>(&curve))
        return evenLine(*line);
    if (const auto* polyline = dynamic_cast<const KM_PolylineCurve*>(&curve))
        return evenPolyline(*polyline);
    PieceLaying laying(curve, std::max(tolerance, roundingOf(curve)));
    const std::vector<double> spans = curve.SpanParameters();
    for (std::size_t i = 0; i + 1 < spans.size(); ++i) {
        if (!laying.lay(spans[i], spans[i + 1]))
            return Error{"The curve cannot be measured between its parameters " +
                         std::to_string(spans[i]) + " and " + std::to_string(spans[i + 1]) + "."};
    }
    std::unique_ptr<KM_NurbsCurve> even = laying.curve(curve.IsClosed());
    if (!even)
        return Error{"The curve is too long or too short to be measured."};
    return CurveResult(std::move(even));
}

} // namespace quarn
