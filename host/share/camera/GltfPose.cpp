#include "host/share/camera/GltfPose.h"

#include <algorithm>
#include <cmath>

namespace quarn {

namespace {

/// A camera within the model, from which near things are seen too, does not see what is nearer than
/// this part of what is farthest.
constexpr double NEAREST_PART = 1e-4;
constexpr double ASKEW = 1e-9; ///< of the picture's size

double metresOf(const CameraTrack& track) {
    return track.units == UnitSystem::none ? 1.0 : metresPerUnit(track.units);
}

KM_3dVector withYUp(const KM_3dVector& v) {
    return {v.x, v.z, -v.y};
}

/// How far in front of the camera things are over all frames, in model units.
struct DepthRange {
    double nearest = 0.0;
    double farthest = 0.0;
};

DepthRange depthsOf(const CameraTrack& track) {
    if (!track.scene.IsValid())
        return {track.opening.near_distance, track.opening.far_distance};
    DepthRange range{HUGE_VAL, -HUGE_VAL};
    for (const CameraKey& key : track.keys)
        for (int corner = 0; corner < 8; ++corner) {
            const double depth = (track.scene.Corner(corner) - key.camera.place) * key.direction;
            range.nearest = std::min(range.nearest, depth);
            range.farthest = std::max(range.farthest, depth);
        }
    return range;
}

/// Where nothing lies in front of the camera its own planes are as good as any.
void boundPerspective(const CameraTrack& track, GltfLens& lens) {
    const DepthRange depths = depthsOf(track);
    if (depths.farthest <= 0.0) {
        lens.near_distance = track.opening.near_distance;
        lens.far_distance = track.opening.far_distance;
        return;
    }
    lens.far_distance = 1.01 * depths.farthest;
    lens.near_distance = std::max(0.9 * depths.nearest, NEAREST_PART * lens.far_distance);
}

void boundParallel(const CameraTrack& track, GltfLens& lens) {
    const DepthRange depths = depthsOf(track);
    const double margin =
        0.01 * (depths.farthest - depths.nearest) + 0.001 * track.opening.height();
    lens.setback = std::max(0.0, margin - depths.nearest);
    lens.near_distance = depths.nearest + lens.setback - margin;
    lens.far_distance = depths.farthest + lens.setback + margin;
}

bool isAskew(const CameraOpening& opening) {
    return std::abs(opening.left + opening.right) > ASKEW * opening.width() ||
           std::abs(opening.bottom + opening.top) > ASKEW * opening.height();
}

/// The turn that takes the axes X, Y and Z to these, which stand at right angles.
/// Shepperd, "Quaternion from rotation matrix", Journal of Guidance and Control 1 (1978): the
/// largest of the four is found first, so that nothing is divided by a small number.
GltfTurn turnOf(const KM_3dVector& x, const KM_3dVector& y, const KM_3dVector& z) {
    const double squares[4] = {1.0 + x.x - y.y - z.z, 1.0 - x.x + y.y - z.z, 1.0 - x.x - y.y + z.z,
                               1.0 + x.x + y.y + z.z};
    const auto largest = std::max_element(std::begin(squares), std::end(squares)) - squares;
    const double twice = std::sqrt(squares[largest]);
    const double part = 0.5 / twice;
    const double xy = part * (x.y + y.x), zx = part * (z.x + x.z), yz = part * (y.z + z.y);
    const double wx = part * (y.z - z.y), wy = part * (z.x - x.z), wz = part * (x.y - y.x);
    switch (largest) {
    case 0:
        return {0.5 * twice, xy, zx, wx};
    case 1:
        return {xy, 0.5 * twice, yz, wy};
    case 2:
        return {zx, yz, 0.5 * twice, wz};
    default:
        return {wx, wy, wz, 0.5 * twice};
    }
}

} // namespace

GltfLens gltfLens(const CameraTrack& track) {
    const CameraOpening& opening = track.opening;
    const double metres = metresOf(track);
    GltfLens lens;
    lens.is_parallel = opening.is_parallel;
    if (opening.is_parallel) {
        lens.half_width = 0.5 * metres * opening.width();
        lens.half_height = 0.5 * metres * opening.height();
        boundParallel(track, lens);
    } else {
        lens.is_straightened = isAskew(opening);
        lens.aspect = opening.width() / opening.height();
        lens.vertical_angle = 2.0 * std::atan(0.5 * opening.height());
        boundPerspective(track, lens);
    }
    for (double* const length : {&lens.near_distance, &lens.far_distance, &lens.setback})
        *length *= metres;
    return lens;
}

GltfPose cameraPose(const CameraTrack& track, const GltfLens& lens, const CameraKey& key) {
    const KM_3dVector y = key.camera.up;
    const KM_3dVector z = -key.direction;
    const KM_3dVector x = KM_CrossProduct(y, z);
    KM_3dPoint place = key.camera.place;
    if (lens.is_parallel) {
        const CameraOpening& opening = track.opening;
        place = place + 0.5 * (opening.left + opening.right) * x +
                0.5 * (opening.bottom + opening.top) * y + lens.setback / metresOf(track) * z;
    }
    const KM_3dVector p = metresOf(track) * withYUp(place - KM_3dPoint::Origin);
    return {{p.x, p.y, p.z}, turnOf(withYUp(x), withYUp(y), withYUp(z))};
}

/// A light has no up of its own. Its X axis stays as near as it can from each frame to the next, so
/// that it does not spin about the line of its light.
std::vector<GltfTurn> lightTurns(const std::vector<SunKey>& suns) {
    std::vector<GltfTurn> turns;
    KM_3dVector x(1.0, 0.0, 0.0);
    for (const SunKey& sun : suns) {
        const KM_3dVector z = withYUp(sun.to_sun);
        KM_3dVector nearest = x - (x * z) * z;
        if (nearest.Length() < 0.1)
            nearest = KM_CrossProduct(
                std::abs(z.y) < 0.9 ? KM_3dVector(0.0, 1.0, 0.0) : KM_3dVector(1.0, 0.0, 0.0), z);
        nearest.Unitize();
        x = nearest;
        const GltfTurn turn = turnOf(x, KM_CrossProduct(z, x), z);
        turns.push_back(turns.empty() ? turn : continued(turn, turns.back()));
    }
    return turns;
}

GltfTurn continued(const GltfTurn& turn, const GltfTurn& before) {
    const double alike =
        turn[0] * before[0] + turn[1] * before[1] + turn[2] * before[2] + turn[3] * before[3];
    return alike < 0.0 ? GltfTurn{-turn[0], -turn[1], -turn[2], -turn[3]} : turn;
}

} // namespace quarn
