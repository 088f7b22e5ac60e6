#pragma once

#include "kelmar/KM_Curve.h"

#include <span>

/// A non-uniform rational B-spline curve.
///
/// Order is degree + 1. Knots are those that matter: there are order + control points - 2 of them,
/// without the superfluous one that some books add at either end, and the domain runs from knot
/// [order - 2] to knot [control points - 1]. A clamped end has its knot `degree` times.
/// Control points are places with a weight; a curve that is not rational has weights of 1.
/// Control points and knots are counted from 0.
///
/// Points are evaluated by the algorithm of C. de Boor, "On calculating with B-splines", Journal of
/// Approximation Theory 6 (1972), in homogeneous coordinates; derivatives by equation 4.8 of
/// L. Piegl and W. Tiller, The NURBS Book (2nd edition). At a knot of full multiplicity the point
/// is the control point exactly.
class KELMAR_API KM_NurbsCurve : public KM_Curve {
public:
    /// A curve without control points: not valid until Create.
    KM_NurbsCurve() = default;

    /// A new curve without control points, which the caller owns and deletes.
    static KM_NurbsCurve* New();

    /// Makes room for a curve with all control points at the origin, weights of 1 and knots of 0.
    /// Set control points and knots next.
    /// @param dimension  3
    /// @return false, with the curve unchanged, unless dimension is 3 and 2 <= order <= cv_count
    bool Create(int dimension, bool rational, int order, int cv_count);

    /// A curve from clamped ends and uniform knots: starts at the first point, ends at the last,
    /// and is drawn toward the others. Domain [0, points - order + 1].
    /// @return false, with the curve unchanged, unless 2 <= order <= number of points
    bool CreateClampedUniformNurbs(std::span<const KM_3dPoint> points, int order);

    /// A closed curve, smooth at its seam too, drawn toward the points in turn; the first point is
    /// not to be repeated. Domain [0, points].
    /// @return false, with the curve unchanged, unless order >= 2 and there are at least
    ///         max(3, order - 1) points
    bool CreatePeriodicUniformNurbs(std::span<const KM_3dPoint> points, int order);

    /// The cubic curve through the points in turn, with continuous second derivatives. Parameters
    /// are chord lengths: at point k the parameter is the length of the polyline through the points
    /// up to it, in model units, so the curve is run through at nearly unit speed.
    ///
    /// An open curve has no curvature at its ends (the natural spline); two points give a straight
    /// one. A closed curve passes the first point again at its end and is as smooth there as
    /// elsewhere; the first point is not to be repeated.
    /// @return false, with the curve unchanged, for less than 2 points (3 when closed), when
    ///         neighbours coincide or a point is not valid
    bool CreateCubicThroughPoints(std::span<const KM_3dPoint> points, bool closed);

    int Order() const { return m_order; }
    /// Order() - 1, and 0 for a curve that was not created.
    int Degree() const { return m_order > 0 ? m_order - 1 : 0; }
    int CVCount() const { return static_cast<int>(m_points.size()); }
    /// Order() + CVCount() - 2, and 0 for a curve that was not created.
    int KnotCount() const { return static_cast<int>(m_knots.size()); }
    bool IsRational() const { return m_rational; }

    /// The knot, or KM_UNSET_VALUE for an index outside the curve.
    double Knot(int index) const;
    /// @return false when the index is outside the curve; that the knots ascend is left to IsValid
    bool SetKnot(int index, double knot);

    /// Writes the place of a control point (not multiplied by its weight).
    /// @return false, with `point` untouched, when the index is outside the curve
    bool GetCV(int index, KM_3dPoint& point) const;
    /// Moves a control point and keeps its weight.
    /// @return false when the index is outside the curve
    bool SetCV(int index, const KM_3dPoint& point);
    /// The weight, or 0 for an index outside the curve.
    double Weight(int index) const;
    /// Sets a weight and keeps the control point's place. A curve that was not rational becomes so
    /// when the weight is not 1.
    /// @return false, with nothing changed, when the index is outside the curve or the weight is
    ///         not finite and above 0
    bool SetWeight(int index, double weight);

    /// Sets clamped, uniform knots from 0 in steps of `delta`.
    /// @return false, with the curve unchanged, when it was not created or delta is not finite and
    ///         above 0
    bool MakeClampedUniformKnotVector(double delta = 1.0);

    KM_NurbsCurve* Duplicate() const override;
    const wchar_t* TypeName() const override;
    /// True when control points are valid and do not all coincide, weights are above 0, the knots
    /// ascend, none occurs more than `degree` times, and the domain has a length.
    bool IsValid() const override;
    KM_Interval Domain() const override;
    bool SetDomain(double t0, double t1) override;
    std::vector<double> SpanParameters() const override;
    KM_3dPoint PointAt(double t) const override;
    KM_3dVector DerivativeAt(double t) const override;
    bool Reverse() override;
    /// A matrix with perspective changes the weights too, so the result is exact.
    bool Transform(const KM_Xform& xform) override;
    KM_BoundingBox BoundingBox() const override;

private:
    class Triangle;

    int SpanAt(double t) const;

    int m_order = 0;
    bool m_rational = false;
    std::vector<KM_3dPoint> m_points;
    std::vector<double> m_weights;
    std::vector<double> m_knots;
};
