#include "kelmar/KM_LineCurve.h"

#include "kelmar/KM_Xform.h"

KM_LineCurve::KM_LineCurve(const KM_Line& line) : m_line(line) {}

KM_LineCurve::KM_LineCurve(const KM_3dPoint& from, const KM_3dPoint& to) : m_line(from, to) {}

KM_LineCurve::KM_LineCurve(const KM_Line& line, double t0, double t1) : m_line(line) {
    SetDomain(t0, t1);
}

KM_LineCurve* KM_LineCurve::Duplicate() const {
    return new KM_LineCurve(*this);
}

const wchar_t* KM_LineCurve::TypeName() const {
    return L"line";
}

bool KM_LineCurve::IsValid() const {
    return m_line.IsValid() && m_line.Length() > 0.0;
}

KM_Interval KM_LineCurve::Domain() const {
    return m_domain;
}

bool KM_LineCurve::SetDomain(double t0, double t1) {
    const KM_Interval domain(t0, t1);
    if (!domain.IsIncreasing())
        return false;
    m_domain = domain;
    return true;
}

std::vector<double> KM_LineCurve::SpanParameters() const {
    return {m_domain.m_t[0], m_domain.m_t[1]};
}

KM_3dPoint KM_LineCurve::PointAt(double t) const {
    const KM_3dPoint point = m_line.PointAt(m_domain.NormalizedParameterAt(t));
    return m_line.IsValid() && point.IsValid() ? point : KM_3dPoint::UnsetPoint;
}

KM_3dVector KM_LineCurve::DerivativeAt(double) const {
    return m_line.IsValid() ? m_line.Direction() / m_domain.Length() : KM_3dVector::UnsetVector;
}

bool KM_LineCurve::IsClosed() const {
    return false;
}

bool KM_LineCurve::Reverse() {
    m_line = KM_Line(m_line.to, m_line.from);
    m_domain = KM_Interval(-m_domain.m_t[1], -m_domain.m_t[0]);
    return true;
}

bool KM_LineCurve::Transform(const KM_Xform& xform) {
    const KM_Line moved(xform * m_line.from, xform * m_line.to);
    if (!moved.IsValid())
        return false;
    m_line = moved;
    return true;
}

KM_BoundingBox KM_LineCurve::BoundingBox() const {
    KM_BoundingBox box;
    box.Set(m_line.from);
    box.Set(m_line.to);
    return box;
}
