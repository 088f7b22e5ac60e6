#pragma once

#include "kelmar/KM_Curve.h"

#include <span>

/// Straight segments through a list of corners. Each corner has a parameter, and each segment is
/// run through at a constant speed of its own.
class KELMAR_API KM_PolylineCurve : public KM_Curve {
public:
    /// A polyline without corners: not valid.
    KM_PolylineCurve() = default;
    /// Corner i has the parameter i, so the domain is [0, count - 1].
    explicit KM_PolylineCurve(std::span<const KM_3dPoint> corners);

    /// Replaces corners and parameters.
    /// @return false, with the curve unchanged, unless there are as many parameters as corners and
    ///         the parameters are finite and strictly increasing
    bool Create(std::span<const KM_3dPoint> corners, std::span<const double> parameters);

    int PointCount() const { return m_corners.Count(); }
    /// The corners; valid until the curve changes or dies.
    const KM_3dPointArray& Points() const { return m_corners; }
    /// The parameter of each corner; valid until the curve changes or dies.
    const std::vector<double>& Parameters() const { return m_parameters; }

    KM_PolylineCurve* Duplicate() const override;
    const wchar_t* TypeName() const override;
    /// True when there are two corners or more, all are valid, and not all coincide.
    bool IsValid() const override;
    KM_Interval Domain() const override;
    bool SetDomain(double t0, double t1) override;
    std::vector<double> SpanParameters() const override;
    /// At a corner's parameter the result is the corner exactly.
    KM_3dPoint PointAt(double t) const override;
    KM_3dVector DerivativeAt(double t) const override;
    bool Reverse() override;
    bool Transform(const KM_Xform& xform) override;
    KM_BoundingBox BoundingBox() const override;
    bool GetLength(double* length, double fractional_tolerance = 1e-8) const override;
    /// The corners, whatever the tolerance.
    void GetDisplayPolyline(double chord_tolerance, KM_3dPointArray& points) const override;

private:
    int SegmentAt(double t) const;

    KM_3dPointArray m_corners;
    std::vector<double> m_parameters;
};
