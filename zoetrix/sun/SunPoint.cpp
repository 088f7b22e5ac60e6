#include "zoetrix/sun/SunPoint.h"

#include "kelmar/KM_Xform.h"
#include "sdk/zel/QnZelSun.h"
#include "sdk/zel/QnZone.h"
#include "zoetrix/plugin/ZoetrixUtilities.h"

#include <cmath>

namespace {

constexpr double radians_per_degree = 0.017453292519943295;

void Rotate(KM_3dVector& vector, double degrees, const KM_3dVector& axis) {
    vector.Transform(KM_Xform::Rotation(degrees * radians_per_degree, axis, KM_3dPoint::Origin));
}

} // namespace

KM_3dVector DirectionToSun(double azimuth_deg, double altitude_deg) {
    // A rotation by what is not a number would leave the direction at north.
    if (!std::isfinite(azimuth_deg) || !std::isfinite(altitude_deg))
        return KM_3dVector::UnsetVector;
    KM_3dVector direction = KM_3dVector::YAxis;
    Rotate(direction, azimuth_deg, -KM_3dVector::ZAxis);
    const KM_3dVector tilt_axis = KM_CrossProduct(direction, KM_3dVector::ZAxis);
    Rotate(direction, altitude_deg, tilt_axis);
    direction.Unitize();
    return direction;
}

KM_3dPoint CZoetrixUtilities::GetSunPoint(int hour, int minute, int year, int month, int day,
                                          double northAngle, double latitude, double longitude) {
    CQnZelSun sun;
    sun.SetLatitude(latitude);
    sun.SetLongitude(longitude);
    sun.SetTimeZone(QnZoneOfLongitude(longitude));
    sun.SetLocalDateTime(year, month, day, hour + minute / 60.0);
    return KM_3dPoint(DirectionToSun(sun.Azimuth() + northAngle, sun.Altitude()));
}
