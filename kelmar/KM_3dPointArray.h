#pragma once

#include "kelmar/KM_Array.h"
#include "kelmar/KM_Point.h"

/// A list of places: the corners of a polyline, the camera location of every frame.
class KM_3dPointArray : public KM_SimpleArray<KM_3dPoint> {
public:
    using KM_SimpleArray<KM_3dPoint>::KM_SimpleArray;
};
