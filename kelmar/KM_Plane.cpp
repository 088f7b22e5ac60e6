#include "kelmar/KM_Plane.h"

#include "kelmar/KM_Xform.h"

constinit const KM_Plane KM_xy_plane;

KM_Plane::KM_Plane(const KM_3dPoint& origin_, const KM_3dVector& normal)
    : origin(origin_), zaxis(normal) {
    if (!zaxis.Unitize() || !xaxis.PerpendicularTo(zaxis)) {
        xaxis = yaxis = zaxis = KM_3dVector::ZeroVector;
        return;
    }
    yaxis = KM_CrossProduct(zaxis, xaxis);
}

KM_Plane::KM_Plane(const KM_3dPoint& origin_, const KM_3dVector& x, const KM_3dVector& y)
    : origin(origin_), xaxis(x), yaxis(y) {
    const bool directed = xaxis.Unitize() && yaxis.Unitize();
    zaxis = KM_CrossProduct(xaxis, yaxis);
    // Below this the normal would be made of rounding alone.
    if (!directed || zaxis.IsTiny(1e-15) || !zaxis.Unitize()) {
        xaxis = yaxis = zaxis = KM_3dVector::ZeroVector;
        return;
    }
    yaxis = KM_CrossProduct(zaxis, xaxis);
}

bool KM_Plane::IsValid() const {
    if (!origin.IsValid() || !xaxis.IsUnitVector() || !yaxis.IsUnitVector())
        return false;
    return (KM_CrossProduct(xaxis, yaxis) - zaxis).IsTiny();
}

bool KM_Plane::Translate(const KM_3dVector& delta) {
    if (!delta.IsValid())
        return false;
    origin += delta;
    return true;
}

bool KM_Plane::Transform(const KM_Xform& xform) {
    const KM_Plane moved(xform * origin, xform * xaxis, xform * yaxis);
    if (!moved.IsValid())
        return false;
    *this = moved;
    return true;
}

KM_3dPoint KM_Plane::PointAt(double u, double v) const {
    return origin + (u * xaxis + v * yaxis);
}

double KM_Plane::DistanceTo(const KM_3dPoint& point) const {
    return (point - origin) * zaxis;
}
