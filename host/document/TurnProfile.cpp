#include "host/document/TurnProfile.h"

#include "host/document/Reach.h"

#include <algorithm>
#include <cmath>

namespace quarn {

namespace {

constexpr int RING_COUNT = 256;

/// Enough to halve the share of the picture down to where no pixel changes.
constexpr int HALVINGS = 24;

constexpr double LEAST_COS_ELEVATION = 1e-6;

/// Less than this, as a share of a radius or of a ring's height, may be rounding: it decides
/// neither which point of a ring counts nor in which ring a point lies. A model is so turned in the
/// same way wherever it stands.
constexpr double ROUNDING = 1e-5;

} // namespace

TurnProfile::TurnProfile(const KM_3dPoint& target, double low, double high)
    : m_target(target), m_low(low),
      m_rings_per_height(high > low ? (RING_COUNT - 1) / (high - low) : 0.0), m_rings(RING_COUNT) {}

void TurnProfile::add(const KM_3dPoint& point) {
    const double rise = (point.z - m_low) * m_rings_per_height;
    const double place = std::clamp(rise + ROUNDING, 0.0, RING_COUNT - 1.0);
    Ring& ring = m_rings[static_cast<std::size_t>(place)];
    const double radius = std::hypot(point.x - m_target.x, point.y - m_target.y);
    if (ring.radius < 0.0 || radius > (1.0 + ROUNDING) * ring.radius)
        ring = {radius, point.z};
}

KM_3dPoint TurnProfile::middle(const KM_Viewport& camera) const {
    if (std::hypot(camera.CameraZ().x, camera.CameraZ().y) < LEAST_COS_ELEVATION)
        return m_target;
    const Opening whole = filledOpening(camera);
    const auto reach_within = [&](double share) {
        Reach reach(camera, m_target, {whole.x, share * whole.y});
        for (const Ring& ring : m_rings)
            if (ring.radius >= 0.0)
                reach.addTurning({m_target.x + ring.radius, m_target.y, ring.z});
        return reach;
    };
    // A wide model leaves room above and below: then it is the part of the picture's height that
    // the model takes at the distance its width asks for that must be filled evenly.
    double share = 1.0;
    if (!reach_within(share).isBoundByHeightInMiddle()) {
        double step = 0.5;
        for (int halving = 0; halving < HALVINGS; ++halving, step *= 0.5)
            if (!reach_within(share - step).isBoundByHeightInMiddle())
                share -= step;
    }
    return m_target + reach_within(share).riseToMiddle() * KM_3dVector::ZAxis;
}

} // namespace quarn
