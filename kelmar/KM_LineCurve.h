#pragma once

#include "kelmar/KM_Curve.h"
#include "kelmar/KM_Line.h"

/// A straight curve, run through at constant speed.
class KELMAR_API KM_LineCurve : public KM_Curve {
public:
    KM_Line m_line;

    /// A line without length at the world origin: not valid until it is given ends.
    KM_LineCurve() = default;
    /// The domain is [0, 1].
    explicit KM_LineCurve(const KM_Line& line);
    KM_LineCurve(const KM_3dPoint& from, const KM_3dPoint& to);
    /// The domain is [t0, t1]; it stays [0, 1] unless t0 < t1 and both are finite.
    KM_LineCurve(const KM_Line& line, double t0, double t1);

    KM_LineCurve* Duplicate() const override;
    const wchar_t* TypeName() const override;
    /// True when both ends are valid and differ.
    bool IsValid() const override;
    KM_Interval Domain() const override;
    bool SetDomain(double t0, double t1) override;
    std::vector<double> SpanParameters() const override;
    KM_3dPoint PointAt(double t) const override;
    KM_3dVector DerivativeAt(double t) const override;
    /// Always false.
    bool IsClosed() const override;
    bool Reverse() override;
    bool Transform(const KM_Xform& xform) override;
    KM_BoundingBox BoundingBox() const override;

private:
    KM_Interval m_domain{0.0, 1.0};
};
