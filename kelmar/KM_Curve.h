#pragma once

#include "kelmar/KM_3dPointArray.h"
#include "kelmar/KM_BoundingBox.h"
#include "kelmar/KM_Export.h"
#include "kelmar/KM_Interval.h"
#include "kelmar/KM_Point.h"

#include <vector>

class KM_Xform;

/// A curve in space: a point for every parameter of its domain. Lengths are in model units.
///
/// Parameters outside the domain extend the curve's first or last piece.
class KELMAR_API KM_Curve {
public:
    KM_Curve() = default;
    virtual ~KM_Curve();

    /// A deep copy, which the caller owns and deletes.
    virtual KM_Curve* Duplicate() const = 0;

    /// What kind of curve this is, in English, for lists and messages: "line", "polyline", "NURBS
    /// curve". A static text.
    virtual const wchar_t* TypeName() const = 0;

    /// True when the curve can be evaluated all over its domain and has an extent.
    virtual bool IsValid() const = 0;

    /// The parameters at which the curve is defined, increasing; an unset interval for a curve
    /// that has no points yet.
    virtual KM_Interval Domain() const = 0;
    /// Stretches and shifts the parameters so that the domain becomes [t0, t1]; the curve's points
    /// stay.
    /// @return false, with the curve unchanged, unless t0 < t1 and both are finite
    virtual bool SetDomain(double t0, double t1) = 0;

    /// The parameters at which the pieces of the curve begin and end, increasing, from the
    /// domain's start to its end. Between two neighbours the curve is smooth; kinks lie only at
    /// them. Empty for a curve that has no points yet.
    virtual std::vector<double> SpanParameters() const = 0;

    /// The point at the parameter; KM_3dPoint::UnsetPoint where the curve cannot be evaluated.
    virtual KM_3dPoint PointAt(double t) const = 0;
    /// The derivative by the parameter, in model units per unit of parameter. At a kink it is that
    /// of the piece that begins there. KM_3dVector::UnsetVector where the curve cannot be
    /// evaluated.
    virtual KM_3dVector DerivativeAt(double t) const = 0;
    /// The unit vector along the curve. Where the derivative vanishes, the direction in which the
    /// curve leaves the point (arrives, at the domain's end); zero when there is none.
    KM_3dVector TangentAt(double t) const;

    /// The points at the domain's start and end; the unset point for a curve without points.
    KM_3dPoint PointAtStart() const;
    KM_3dPoint PointAtEnd() const;

    /// True when the curve ends where it starts and has an extent. "Where" allows a gap of 2^-32
    /// of the curve's extent, and the rounding of its coordinates.
    virtual bool IsClosed() const;

    /// Turns the direction round: the domain [a, b] becomes [-b, -a], and the point at t is the one
    /// that was at -t.
    /// @return false, with the curve unchanged, for a curve that has no points
    virtual bool Reverse() = 0;

    /// Moves the curve by the matrix.
    /// @return false, with the curve unchanged, when the matrix is invalid or sends a defining
    ///         point to infinity
    virtual bool Transform(const KM_Xform& xform) = 0;

    /// A box that holds the curve. For a NURBS curve it holds the control points too, so it may be
    /// larger than needed. Empty for a curve without points.
    virtual KM_BoundingBox BoundingBox() const = 0;

    /// Arc length, by adaptive Gauss-Kronrod quadrature (7 and 15 nodes; R. Piessens et al.,
    /// QUADPACK, Springer 1983) of the derivative's length over every piece.
    /// @param length                receives the length; may be null
    /// @param fractional_tolerance  wished relative error, at least 1e-12
    /// @return false, with `length` untouched, when the curve is invalid or cannot be evaluated
    virtual bool GetLength(double* length, double fractional_tolerance = 1e-8) const;

    /// Arc length of a part of a valid curve, by the same quadrature. Meant for parts without a
    /// kink inside. It does not check that the curve is valid, so that many parts are quick.
    /// @param t0, t1  the ends of the part, t0 <= t1, in the domain
    /// @return a value that is not finite when the curve cannot be evaluated there
    double LengthBetween(double t0, double t1, double fractional_tolerance = 1e-8) const;

    /// Writes corners of a polyline that stays near the curve, for drawing: its first and last
    /// corner and all its kinks are points of the curve exactly.
    /// @param chord_tolerance  wished distance between curve and polyline in model units; a value
    ///                         that is not above 0, or finer than 1/4096 of a piece can follow,
    ///                         gives the finest division
    /// @param points           emptied first; left empty when the curve is not valid
    virtual void GetDisplayPolyline(double chord_tolerance, KM_3dPointArray& points) const;

protected:
    KM_Curve(const KM_Curve&) = default;
    KM_Curve& operator=(const KM_Curve&) = default;
};
