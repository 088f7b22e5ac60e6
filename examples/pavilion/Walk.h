#pragma once

#include "examples/pavilion/Temple.h"

/// A way for a camera at eye height: in by the gate, past the basin, up the steps, once around the
/// colonnade, out to the street and back to the square.
namespace walk {

/// Control points of a uniform cubic B-spline (C. de Boor, "A Practical Guide to Splines", chapter
/// IX), which starts at the first and ends at the last. The eye rises and sinks over a longer way
/// than the steps do, so that a camera that looks along the way hardly nods.
inline std::vector<Vec> controlPoints() {
    constexpr double street = 1.70;
    constexpr double hall = street + temple::floor_height;
    return {// in by the gate, past the basin
            {0.0, -15.6, street},
            {-0.4, -13.4, street},
            {-2.4, -12.2, street},
            {-3.7, -9.8, street},
            {-3.9, -7.4, street},
            {-3.0, -5.4, street + 0.04},
            // up the steps
            {-1.8, -3.7, street + 0.16},
            {-0.6, -2.1, street + 0.34},
            {0.3, -0.7, street + 0.47},
            {1.2, 0.0, street + 0.53},
            // around the colonnade
            {2.2, 0.2, hall},
            {3.2, 0.35, hall},
            {4.1, 0.85, hall},
            {4.6, 1.75, hall},
            {4.7, 2.8, hall},
            {4.65, 3.7, hall},
            {4.4, 4.6, hall},
            {3.75, 5.4, hall},
            {2.8, 5.8, hall},
            {1.0, 5.85, hall},
            {-1.0, 5.85, hall},
            {-2.5, 5.8, hall},
            {-3.5, 5.5, hall},
            {-4.2, 4.8, hall},
            {-4.7, 4.0, hall},
            // out to the street and back to the square
            {-5.3, 3.3, street + 0.51},
            {-6.1, 2.8, street + 0.40},
            {-7.2, 2.3, street + 0.22},
            {-8.2, 1.3, street + 0.07},
            {-8.6, -0.6, street},
            {-7.6, -2.8, street},
            {-5.4, -4.4, street},
            {-3.0, -5.2, street},
            {-1.0, -5.0, street}};
}

inline std::vector<Vec> points() {
    std::vector<Vec> controls = controlPoints();
    for (int i = 0; i < 2; ++i) { // a triple end point lies on the curve
        controls.insert(controls.begin(), controls.front());
        controls.push_back(controls.back());
    }
    constexpr int steps = 12;
    std::vector<Vec> walk;
    for (std::size_t i = 0; i + 3 < controls.size(); ++i) {
        for (int k = 0; k < steps; ++k) {
            const double t = static_cast<double>(k) / steps;
            const double s = 1.0 - t;
            walk.push_back(controls[i] * (s * s * s / 6.0) +
                           controls[i + 1] * ((3 * t * t * t - 6 * t * t + 4) / 6.0) +
                           controls[i + 2] * ((3 * s * s * s - 6 * s * s + 4) / 6.0) +
                           controls[i + 3] * (t * t * t / 6.0));
        }
    }
    walk.push_back(controls.back());
    return walk;
}

} // namespace walk
