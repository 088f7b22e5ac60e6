#pragma once

#include "kelmar/KM_Point.h"

class KM_3dPointArray;
class KM_BoundingBox;
class KM_Mesh;
class KM_Viewport;
class KM_Xform;

namespace quarn {

// What can be drawn: everything that reaches the display and the renderer passes here.
//
// Rays, surfaces and pictures are computed in single precision, whose numbers end at 3.4e38. To
// find where a ray meets a triangle, twice the triangle's area is multiplied by the ray's distance
// from it. With coordinates up to L the first is at most 6.9 L^2, and rays start up to 27 L away:
// the camera may stand 10 L from the origin, and light on the ground, which fades out 24 L around
// the model, looks back at it from there. With L = 1e12 the product stays below 2e38. Measured
// with both renderers in all display modes, pictures are right up to five times that and wrong
// from there on; from 1.8e18 on the ray tracing library refuses rays and ends the program.

/// The greatest coordinate of an object that is drawn, in model units. Beyond it an object stays
/// in its document and is not drawn.
inline constexpr double greatest_drawn_coordinate = 1e12;
/// The greatest coordinate of a camera. Pictures of a camera beyond show the background.
inline constexpr double greatest_camera_coordinate = 1e13;
/// How far rays start from the origin at most, for each unit of the greatest coordinate of the
/// surfaces, see above; and what every mesh must bear, whatever stands around it: the directions
/// of rays are that long in a picture of the widest angle.
inline constexpr double rays_start_within = 27.0;
inline constexpr double least_reach = 1e6;

/// True for a point with numbers up to greatest_drawn_coordinate.
bool isInDrawableRange(const KM_3dPoint& point);
/// True for a box that is not empty, with both corners in range.
bool isInDrawableRange(const KM_BoundingBox& box);
/// True when all points are in range; also when there are none.
bool isInDrawableRange(const KM_3dPointArray& points);
/// True when all vertices, those of no triangle too, are in range. Normals and texture coordinates
/// do no harm, whatever they are.
bool isInDrawableRange(const KM_Mesh& mesh);

/// True for a mesh that can be drawn where a transform puts it: in its own coordinates and in the
/// world's it is in range, and rays can be carried into its own coordinates, where both the library
/// and the renderers trace them.
/// @param own_box  of all vertices, which must be finite; not empty
bool isInDrawableRange(const KM_BoundingBox& own_box, const KM_Xform& world_from_mesh);

/// How far from the origin rays may start that this mesh can meet, in the coordinates that the
/// transform leads to; 0 or less when it can meet none. Where meshes of a very small scale stand
/// beside very large ones it is less than greatest_camera_coordinate.
double reachOfRays(const KM_BoundingBox& own_box, const KM_Xform& frame_from_mesh);

/// The room that is drawn.
struct DrawnRoom {
    KM_3dPoint origin;  ///< where the coordinates of its rays begin, in the world
    double size = 0.0;  ///< diagonal of the box of all that is shown
    double reach = 0.0; ///< how far from `origin` rays may start: the least of all meshes
};

/// True when a picture of the room can be taken: the camera is valid and in range, the opening is
/// neither wider than 179.9998 degrees nor too narrow for pixels to differ, and its rays start
/// within reach.
/// @param width_px, height_px  of the picture, whose aspect the opening takes
bool isInDrawableRange(const KM_Viewport& camera, int width_px, int height_px,
                       const DrawnRoom& room);

} // namespace quarn
