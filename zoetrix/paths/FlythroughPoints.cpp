#include "zoetrix/paths/FlythroughPoints.h"

#include "zoetrix/plugin/ZoetrixUtilities.h"

bool GetFlythroughPoints(const KM_Curve* curve, int frame_count, KM_3dPointArray& camera_points,
                         KM_3dPointArray& target_points) {
    if (curve && frame_count == 1) {
        camera_points = KM_3dPointArray({curve->PointAtStart()});
        target_points = KM_3dPointArray({curve->PointAtEnd()});
        return true;
    }
    return CZoetrixUtilities::GetPathPoints(curve, frame_count, camera_points, true, true) &&
           CZoetrixUtilities::GetPathPoints(curve, frame_count, target_points, true, false);
}
