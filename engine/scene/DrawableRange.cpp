#include "engine/scene/DrawableRange.h"

#include "kelmar/KM_3dPointArray.h"
#include "kelmar/KM_BoundingBox.h"
#include "kelmar/KM_Mesh.h"
#include "kelmar/KM_Viewport.h"
#include "kelmar/KM_Xform.h"

#include <algorithm>
#include <cmath>
#include <limits>

namespace quarn {

namespace {

/// Coordinates of rays up to this are far from what the ray tracing library refuses.
constexpr double greatest_ray_coordinate = 1e17;
/// What the product of two edges of a mesh and a ray's distance may come to, by the bound above
/// DrawableRange.h's constants: 6.9 times it is still a float.
constexpr double greatest_product = 3e37;

/// A determinant below this share of the sum of its terms is mostly rounding in single precision,
/// in which the ray tracing library inverts transforms.
constexpr double least_sure_share = 1e-6;

/// The tangent of the widest half angle of a picture.
constexpr double greatest_tangent = least_reach;
/// The least distance of the near plane, and the least size of a pixel: as the tangent of an angle
/// in perspective, in model units else. Squares of less are no floats.
constexpr double least_opening = 1e-18;

bool isWithin(double number, double greatest) {
    return std::abs(number) <= greatest; // false for what is no number
}

bool isWithin(const KM_3dPoint& p, double greatest) {
    return isWithin(p.x, greatest) && isWithin(p.y, greatest) && isWithin(p.z, greatest);
}

double greatestOf(const KM_3dPoint& p) {
    return std::max({std::abs(p.x), std::abs(p.y), std::abs(p.z)});
}

double greatestCoordinate(const KM_BoundingBox& box) {
    return std::max(greatestOf(box.m_min), greatestOf(box.m_max));
}

KM_3dPoint shiftOf(const KM_Xform& x) {
    return {x.m_xform[0][3], x.m_xform[1][3], x.m_xform[2][3]};
}

/// The least and the greatest that one row of a transform makes of a box.
struct RowRange {
    double least;
    double greatest;
};

RowRange rangeOf(const double (&row)[4], const KM_BoundingBox& box) {
    const double low[3] = {box.m_min.x, box.m_min.y, box.m_min.z};
    const double high[3] = {box.m_max.x, box.m_max.y, box.m_max.z};
    RowRange range{row[3], row[3]};
    for (int i = 0; i < 3; ++i) {
        range.least += std::min(row[i] * low[i], row[i] * high[i]);
        range.greatest += std::max(row[i] * low[i], row[i] * high[i]);
    }
    return range;
}

/// What is added up on the way must be in range too: sums of larger numbers lose all digits.
bool termsAreInRange(const double (&row)[4], const KM_BoundingBox& box) {
    const double greatest[3] = {std::max(std::abs(box.m_min.x), std::abs(box.m_max.x)),
                                std::max(std::abs(box.m_min.y), std::abs(box.m_max.y)),
                                std::max(std::abs(box.m_min.z), std::abs(box.m_max.z))};
    for (int i = 0; i < 3; ++i)
        if (!isWithin(row[i], greatest_drawn_coordinate) ||
            !isWithin(row[i] * greatest[i], greatest_drawn_coordinate))
            return false;
    return isWithin(row[3], greatest_drawn_coordinate);
}

bool keepsInRange(const KM_BoundingBox& box, const KM_Xform& x) {
    return std::all_of(x.m_xform, x.m_xform + 3, [&](const double(&row)[4]) {
        if (!termsAreInRange(row, box))
            return false;
        const RowRange range = rangeOf(row, box);
        return isWithin(range.least, greatest_drawn_coordinate) &&
               isWithin(range.greatest, greatest_drawn_coordinate);
    });
}

/// How many times larger the inverse of the linear part makes a coordinate at most; infinite where
/// single precision has no inverse.
double growthOfInverse(const KM_Xform& x) {
    double cofactors[3][3];
    for (int i = 0; i < 3; ++i)
        for (int j = 0; j < 3; ++j) {
            const auto at = [&](int row, int column) {
                return x.m_xform[(i + row) % 3][(j + column) % 3];
            };
            cofactors[i][j] = at(1, 1) * at(2, 2) - at(1, 2) * at(2, 1);
        }
    double determinant = 0.0;
    double terms = 0.0;
    for (int j = 0; j < 3; ++j) {
        determinant += x.m_xform[0][j] * cofactors[0][j];
        for (int k = 1; k < 3; ++k)
            terms += std::abs(x.m_xform[0][j] * x.m_xform[1][(j + k) % 3] *
                              x.m_xform[2][(j + 3 - k) % 3]);
    }
    const double size = std::abs(determinant);
    const bool is_sure = size >= std::numeric_limits<float>::min() &&
                         size <= std::numeric_limits<float>::max() &&
                         size >= least_sure_share * terms;
    double growth = 0.0;
    for (int j = 0; j < 3; ++j)
        growth = std::max(growth, (std::abs(cofactors[0][j]) + std::abs(cofactors[1][j]) +
                                   std::abs(cofactors[2][j])) /
                                      size);
    return is_sure ? growth : std::numeric_limits<double>::infinity();
}

/// How far rays may start from a mesh, in its own coordinates.
double ownReach(const KM_BoundingBox& own_box) {
    const double size = greatestCoordinate(own_box);
    return std::min(greatest_ray_coordinate, greatest_product / (size * size));
}

} // namespace

bool isInDrawableRange(const KM_3dPoint& point) {
    return isWithin(point, greatest_drawn_coordinate);
}

bool isInDrawableRange(const KM_BoundingBox& box) {
    return box.IsValid() && isInDrawableRange(box.m_min) && isInDrawableRange(box.m_max);
}

bool isInDrawableRange(const KM_3dPointArray& points) {
    return std::all_of(points.begin(), points.end(),
                       [](const KM_3dPoint& point) { return isInDrawableRange(point); });
}

bool isInDrawableRange(const KM_Mesh& mesh) {
    constexpr auto greatest = static_cast<float>(greatest_drawn_coordinate);
    const auto is_within = [](float number) { return std::fabs(number) <= greatest; };
    bool are_within = true; // all are looked at, so that the compiler can take several at once
    for (const KM_3fPoint& v : mesh.m_V)
        are_within &= is_within(v.x) & is_within(v.y) & is_within(v.z);
    return are_within;
}

bool isInDrawableRange(const KM_BoundingBox& own_box, const KM_Xform& world_from_mesh) {
    if (!isInDrawableRange(own_box))
        return false;
    if (world_from_mesh.IsIdentity())
        return true;
    return world_from_mesh.IsValid() && world_from_mesh.IsAffine() &&
           keepsInRange(own_box, world_from_mesh) &&
           ownReach(own_box) >= least_reach * growthOfInverse(world_from_mesh);
}

double reachOfRays(const KM_BoundingBox& own_box, const KM_Xform& frame_from_mesh) {
    return ownReach(own_box) / growthOfInverse(frame_from_mesh) -
           greatestOf(shiftOf(frame_from_mesh));
}

bool isInDrawableRange(const KM_Viewport& camera, int width_px, int height_px,
                       const DrawnRoom& room) {
    KM_Viewport shaped = camera;
    if (!camera.IsValidCamera() || !isWithin(camera.CameraLocation(), greatest_camera_coordinate) ||
        !shaped.SetFrustumAspect(static_cast<double>(width_px) / height_px))
        return false;
    double left = 0.0;
    double right = 0.0;
    double bottom = 0.0;
    double top = 0.0;
    double near_distance = 0.0;
    shaped.GetFrustum(&left, &right, &bottom, &top, &near_distance, nullptr);
    const bool is_parallel = camera.IsParallelProjection();
    if (!is_parallel && near_distance < least_opening)
        return false;
    const double unit = is_parallel ? 1.0 : near_distance;
    const double widest =
        std::max({std::abs(left), std::abs(right), std::abs(bottom), std::abs(top)}) / unit;
    const double pixel = std::min((right - left) / width_px, (top - bottom) / height_px) / unit;
    const double limit = is_parallel ? greatest_camera_coordinate : greatest_tangent;
    if (!isWithin(widest, limit) || !(pixel >= least_opening))
        return false;
    // The rays of a parallel picture start before all that is shown.
    const double away = greatestOf(KM_3dPoint::Origin + (camera.CameraLocation() - room.origin));
    return away + (is_parallel ? widest + 2.0 * room.size : 0.0) <= room.reach;
}

} // namespace quarn
