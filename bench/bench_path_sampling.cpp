// Dividing a cubic NURBS curve of 1000 control points into a million frames, beside a bare loop
// that finds the span of each parameter by binary search, computes the four basis functions and
// adds up the control points: algorithms A2.1, A2.2 and A3.1 of L. Piegl and W. Tiller, The NURBS
// Book (2nd edition). Both take turns, and the best of many rounds counts, so that the ratio holds
// on a busy machine too. The times a frame of 100 thousand and of a million show that the division
// is linear in the frame count.

#include "kelmar/KM_3dPointArray.h"
#include "kelmar/KM_NurbsCurve.h"
#include "zoetrix/plugin/ZoetrixUtilities.h"

#include <algorithm>
#include <chrono>
#include <cmath>
#include <cstdio>
#include <cstdlib>
#include <limits>
#include <vector>

namespace {

using Clock = std::chrono::steady_clock;

constexpr int degree = 3;
constexpr int control_points = 1000;
constexpr int few_frames = 100'000;
constexpr int many_frames = 1'000'000;
constexpr int rounds = 15;

/// A way that winds upward, with knots at uneven distances.
/// @param rational  with weights that differ
KM_NurbsCurve makeCurve(bool rational) {
    KM_NurbsCurve curve;
    curve.Create(3, rational, degree + 1, control_points);
    for (int i = 0; i < control_points; ++i) {
        curve.SetCV(i, {20.0 * std::cos(0.1 * i), 20.0 * std::sin(0.1 * i), 0.05 * i});
        if (rational)
            curve.SetWeight(i, 1.0 + 0.5 * std::sin(0.7 * i));
    }
    double knot = 0.0;
    for (int i = 0; i < curve.KnotCount(); ++i) {
        curve.SetKnot(i, knot);
        if (i >= degree - 1 && i < control_points - 1)
            knot += 1.0 + 0.5 * std::sin(1.3 * i);
    }
    return curve;
}

/// The curve's numbers as the book has them: with a superfluous knot at either end.
struct BareCurve {
    explicit BareCurve(const KM_NurbsCurve& curve) : knots(1, curve.Knot(0)) {
        for (int i = 0; i < curve.KnotCount(); ++i)
            knots.push_back(curve.Knot(i));
        knots.push_back(knots.back());
        points.resize(static_cast<std::size_t>(curve.CVCount()));
        for (int i = 0; i < curve.CVCount(); ++i) {
            curve.GetCV(i, points[static_cast<std::size_t>(i)]);
            weights.push_back(curve.Weight(i));
        }
    }

    std::vector<double> knots;
    std::vector<KM_3dPoint> points;
    std::vector<double> weights;
};

std::size_t findSpan(const BareCurve& curve, double t) {
    const auto last = curve.knots.end() - degree - 1;
    if (t >= *last)
        return curve.points.size() - 1;
    const auto next = std::upper_bound(curve.knots.begin() + degree, last, t);
    return static_cast<std::size_t>(next - curve.knots.begin()) - 1;
}

void evaluateBasis(const BareCurve& curve, std::size_t span, double t, double (&basis)[4]) {
    double left[degree + 1];
    double right[degree + 1];
    basis[0] = 1.0;
    for (std::size_t j = 1; j <= degree; ++j) {
        left[j] = t - curve.knots[span + 1 - j];
        right[j] = curve.knots[span + j] - t;
        double saved = 0.0;
        for (std::size_t r = 0; r < j; ++r) {
            const double part = basis[r] / (right[r + 1] + left[j - r]);
            basis[r] = saved + right[r + 1] * part;
            saved = left[j - r] * part;
        }
        basis[j] = saved;
    }
}

/// @tparam rational  with the division by the sum of weights
template <bool rational> KM_3dPoint evaluateBare(const BareCurve& curve, double t) {
    const std::size_t span = findSpan(curve, t);
    double basis[degree + 1];
    evaluateBasis(curve, span, t, basis);
    double x = 0.0;
    double y = 0.0;
    double z = 0.0;
    double w = 0.0;
    for (std::size_t j = 0; j <= degree; ++j) {
        const std::size_t i = span - degree + j;
        const double share = rational ? basis[j] * curve.weights[i] : basis[j];
        x += share * curve.points[i].x;
        y += share * curve.points[i].y;
        z += share * curve.points[i].z;
        w += share;
    }
    return rational ? KM_3dPoint(x / w, y / w, z / w) : KM_3dPoint(x, y, z);
}

template <bool rational>
void divideBare(const BareCurve& curve, int frames, KM_3dPointArray& points) {
    const double begin = curve.knots[degree];
    const double step = (curve.knots[curve.points.size()] - begin) / (frames - 1);
    points.Empty();
    points.Reserve(frames);
    for (int i = 0; i < frames; ++i)
        points.Append(evaluateBare<rational>(curve, begin + i * step));
}

template <class Work> double millisecondsOf(Work&& work) {
    const Clock::time_point start = Clock::now();
    work();
    return std::chrono::duration<double, std::milli>(Clock::now() - start).count();
}

double largestDistance(const KM_3dPointArray& a, const KM_3dPointArray& b) {
    double largest = 0.0;
    for (int i = 0; i < a.Count(); ++i)
        largest = std::max(largest, a[i].DistanceTo(b[i]));
    return largest;
}

struct Best {
    double bare = std::numeric_limits<double>::infinity();
    double few = std::numeric_limits<double>::infinity();
    double many = std::numeric_limits<double>::infinity();
};

/// @return whether both ways gave the same points
template <bool rational> bool measure(const char* name) {
    const KM_NurbsCurve curve = makeCurve(rational);
    const BareCurve bare_curve(curve);
    KM_3dPointArray bare_points;
    KM_3dPointArray points;
    Best best;
    for (int round = 0; round < rounds; ++round) {
        best.few =
            std::min(best.few, millisecondsOf([&] {
                         CZoetrixUtilities::GetPathPoints(&curve, few_frames, points, false, true);
                     }));
        best.bare = std::min(best.bare, millisecondsOf([&] {
                                 divideBare<rational>(bare_curve, many_frames, bare_points);
                             }));
        best.many =
            std::min(best.many, millisecondsOf([&] {
                         CZoetrixUtilities::GetPathPoints(&curve, many_frames, points, false, true);
                     }));
    }
    std::printf("%-13s bare loop %6.1f ms   division %6.1f ms   ratio %.2f   "
                "ns a frame: %.0f of 100 thousand, %.0f of a million\n",
                name, best.bare, best.many, best.many / best.bare, 1e6 * best.few / few_frames,
                1e6 * best.many / many_frames);
    return points.Count() == many_frames && bare_points.Count() == many_frames &&
           largestDistance(points, bare_points) < 1e-9;
}

} // namespace

int main() {
    const bool agree = measure<false>("not rational") && measure<true>("rational");
    if (!agree)
        std::puts("The two ways differ.");
    return agree ? EXIT_SUCCESS : EXIT_FAILURE;
}
