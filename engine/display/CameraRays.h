#pragma once

class KM_3dPoint;
class KM_BoundingBox;
class KM_Viewport;

namespace quarn {

/// The rays of a picture, in single precision as the ray tracer takes them. The ray at a place of
/// the picture (continuous pixels, x to the right and y downward from the upper left corner) is
///
///     origin    + x * origin_dx    + y * origin_dy
///     direction + x * direction_dx + y * direction_dy
///
/// Directions are not of unit length: the distance along a ray is the distance from the camera
/// along the view direction. In a parallel view only the origins differ from pixel to pixel, and
/// the plane of origins is moved back so that the whole scene lies before it.
struct CameraRays {
    float origin[3] = {0.0F, 0.0F, 0.0F};
    float origin_dx[3] = {0.0F, 0.0F, 0.0F};
    float origin_dy[3] = {0.0F, 0.0F, 0.0F};
    float direction[3] = {0.0F, 0.0F, -1.0F};
    float direction_dx[3] = {0.0F, 0.0F, 0.0F};
    float direction_dy[3] = {0.0F, 0.0F, 0.0F};
    float camera_x[3] = {1.0F, 0.0F, 0.0F}; ///< unit frame of the camera, world coordinates
    float camera_y[3] = {0.0F, 1.0F, 0.0F};
    float camera_z[3] = {0.0F, 0.0F, 1.0F}; ///< from the scene toward the camera
    bool parallel = false;
    float setback = 0.0F;    ///< how far the origins were moved back; 0 in perspective
    float pixel_size = 0.0F; ///< height of a pixel in model units; in perspective at depth 1
    float far_depth = 0.0F;  ///< in a parallel view no surface lies beyond, measured along a ray

    // For carrying points the other way, from the world to the picture.
    double eye[3] = {0.0, 0.0,
                     0.0};    ///< where depth is 0: the camera, in a parallel view moved back
    double left = 0.0;        ///< of the picture, along camera_x; in perspective at depth 1
    double top = 0.0;         ///< along camera_y
    double pixel_width = 1.0; ///< like pixel_size, across
    double line_near = 0.0;   ///< in perspective lines nearer than this are cut off
};

/// The rays of `viewport` for a picture of the given size. The frustum takes the picture's aspect,
/// and the smaller half angle stays. The near plane clips nothing: surfaces are seen up to the
/// camera.
/// @param viewport  its camera must be valid
/// @param scene     the box that must lie in front of the origins of a parallel view; may be empty
CameraRays cameraRays(const KM_Viewport& viewport, int width, int height,
                      const KM_BoundingBox& scene);

/// How far a point lies before `eye`, along the view direction.
double depthOf(const CameraRays& rays, const KM_3dPoint& point);

} // namespace quarn
