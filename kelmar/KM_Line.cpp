#include "kelmar/KM_Line.h"

KM_3dPoint KM_Line::PointAt(double t) const {
    return {std::lerp(from.x, to.x, t), std::lerp(from.y, to.y, t), std::lerp(from.z, to.z, t)};
}
