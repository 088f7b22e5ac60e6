#include "kelmar/KM_NurbsCurve.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <random>
#include <vector>

namespace {

std::vector<KM_3dPoint> scatteredPoints(int count) {
    std::mt19937 random(static_cast<unsigned>(count));
    std::normal_distribution<double> coordinate(0.0, 5.0);
    std::vector<KM_3dPoint> points;
    for (int i = 0; i < count; ++i)
        points.emplace_back(coordinate(random), coordinate(random), coordinate(random));
    return points;
}

KM_NurbsCurve through(const std::vector<KM_3dPoint>& points, bool closed) {
    KM_NurbsCurve curve;
    EXPECT_TRUE(curve.CreateCubicThroughPoints(points, closed));
    EXPECT_TRUE(curve.IsValid());
    return curve;
}

// The second derivative on one side of a parameter. The first derivative of a cubic piece is a
// parabola, whose slope at its end follows from three values: (-3 f0 + 4 f1 - f2) / 2h.
KM_3dVector secondDerivative(const KM_Curve& curve, double t, double h) {
    const double inside = t + 1e-9 * h; // of the piece on this side
    const KM_3dVector f0 = curve.DerivativeAt(inside);
    const KM_3dVector f1 = curve.DerivativeAt(t + h);
    const KM_3dVector f2 = curve.DerivativeAt(t + 2.0 * h);
    return (4.0 * f1 - 3.0 * f0 - f2) / (2.0 * h);
}

void expectNear(const KM_3dVector& a, const KM_3dVector& b, double tolerance) {
    EXPECT_LT((a - b).Length(), tolerance)
        << a.x << "," << a.y << "," << a.z << " and " << b.x << "," << b.y << "," << b.z;
}

TEST(NurbsInterpolation, PassesThePointsAtTheLengthsOfTheChords) {
    for (const int count : {2, 3, 4, 7, 60}) {
        for (const bool closed : {false, true}) {
            if (closed && count < 3)
                continue;
            const auto points = scatteredPoints(count);
            const KM_NurbsCurve curve = through(points, closed);
            EXPECT_EQ(curve.Degree(), 3);
            double t = 0.0;
            for (std::size_t k = 0; k < points.size(); ++k) {
                EXPECT_LT(curve.PointAt(t).DistanceTo(points[k]), 1e-12 * (1.0 + t)) << k;
                t += points[k].DistanceTo(points[(k + 1) % points.size()]);
            }
            if (closed) {
                EXPECT_LT(curve.PointAtEnd().DistanceTo(points[0]), 1e-12 * (1.0 + t));
            }
            const double open_length = t - points.back().DistanceTo(points.front());
            EXPECT_NEAR(curve.Domain().Max(), closed ? t : open_length, 1e-12 * t);
            EXPECT_EQ(curve.Domain().Min(), 0.0);
        }
    }
}

TEST(NurbsInterpolation, SecondDerivativesAgreeOnBothSidesOfEveryPoint) {
    for (const bool closed : {false, true}) {
        const KM_NurbsCurve curve = through(scatteredPoints(12), closed);
        const std::vector<double> spans = curve.SpanParameters();
        for (std::size_t i = 1; i + 1 < spans.size(); ++i) {
            const double before = 0.25 * (spans[i] - spans[i - 1]);
            const double after = 0.25 * (spans[i + 1] - spans[i]);
            expectNear(secondDerivative(curve, spans[i], -before),
                       secondDerivative(curve, spans[i], after), 1e-6);
        }
    }
}

TEST(NurbsInterpolation, TheSeamOfAClosedCurveIsAsSmoothAsTheRest) {
    const KM_NurbsCurve curve = through(scatteredPoints(9), true);
    EXPECT_TRUE(curve.IsClosed());
    const KM_Interval domain = curve.Domain();
    expectNear(curve.DerivativeAt(domain.Min()), curve.DerivativeAt(domain.Max()), 1e-10);
    const std::vector<double> spans = curve.SpanParameters();
    const double after = 0.25 * (spans[1] - spans[0]);
    const double before = 0.25 * (spans.back() - spans[spans.size() - 2]);
    expectNear(secondDerivative(curve, domain.Min(), after),
               secondDerivative(curve, domain.Max(), -before), 1e-6);
}

TEST(NurbsInterpolation, AnOpenCurveIsNotCurvedAtItsEnds) {
    const KM_NurbsCurve curve = through(scatteredPoints(6), false);
    const std::vector<double> spans = curve.SpanParameters();
    expectNear(secondDerivative(curve, spans.front(), 0.25 * (spans[1] - spans[0])), {0, 0, 0},
               1e-6);
    const double last = spans.back() - spans[spans.size() - 2];
    expectNear(secondDerivative(curve, spans.back(), -0.25 * last), {0, 0, 0}, 1e-6);
}

// Three points with unit steps: 2 (1 + 1) m1 = 6 (s1 - s0), so m1 = 1.5 (s1 - s0).
TEST(NurbsInterpolation, ThreePointsGiveTheSplineThatOneEquationTells) {
    const std::vector<KM_3dPoint> points = {{0, 0, 0}, {1, 0, 0}, {1, 1, 0}};
    const KM_NurbsCurve curve = through(points, false);
    expectNear(secondDerivative(curve, 1.0, -0.25), {-1.5, 1.5, 0}, 1e-6);
    // First derivatives: s0 - (2 * 0 + m1) / 6 at the start, s0 + (2 m1 + 0) / 6 at the middle.
    expectNear(curve.DerivativeAt(0.0), {1.25, -0.25, 0}, 1e-12);
    expectNear(curve.DerivativeAt(1.0), {0.5, 0.5, 0}, 1e-12);
    // Half-way: the mean of the ends less m1 / 16.
    expectNear(curve.PointAt(0.5) - KM_3dPoint(0.5, 0, 0), {1.5 / 16, -1.5 / 16, 0}, 1e-12);
}

TEST(NurbsInterpolation, TwoPointsGiveAStraightCurveOfUnitSpeed) {
    const KM_NurbsCurve curve = through({{1, 2, 3}, {4, 6, 3}}, false);
    EXPECT_EQ(curve.Domain().Length(), 5.0);
    expectNear(curve.PointAt(2.5) - KM_3dPoint(2.5, 4, 3), {0, 0, 0}, 1e-12);
    expectNear(curve.DerivativeAt(4.0), {0.6, 0.8, 0}, 1e-12);
}

// By symmetry every point of a square has the same speed along its tangent.
TEST(NurbsInterpolation, AClosedCurveThroughASquareHasItsSymmetry) {
    const KM_NurbsCurve curve = through({{1, 0, 0}, {0, 1, 0}, {-1, 0, 0}, {0, -1, 0}}, true);
    const double side = std::sqrt(2.0);
    const double speed = curve.DerivativeAt(0.0).y;
    EXPECT_GT(speed, 1.0);
    expectNear(curve.DerivativeAt(0.0), {0, speed, 0}, 1e-12);
    expectNear(curve.DerivativeAt(side), {-speed, 0, 0}, 1e-12);
    expectNear(curve.DerivativeAt(3.0 * side), {speed, 0, 0}, 1e-12);
}

TEST(NurbsInterpolation, StepsOfVeryUnlikeLengthsAreNoTrouble) {
    const std::vector<KM_3dPoint> points = {{0, 0, 0},    {1e-9, 0, 0}, {1, 1, 0},
                                            {1, 1, 1e-6}, {1e6, 0, 0},  {1e6, 1, 0}};
    for (const bool closed : {false, true}) {
        const KM_NurbsCurve curve = through(points, closed);
        const std::vector<double> spans = curve.SpanParameters();
        ASSERT_EQ(spans.size(), points.size() + (closed ? 1U : 0U));
        for (std::size_t k = 0; k < points.size(); ++k)
            EXPECT_LT(curve.PointAt(spans[k]).DistanceTo(points[k]), 1e-9) << k;
    }
}

TEST(NurbsInterpolation, RefusesTooFewCoincidingAndInvalidPoints) {
    const double nan = std::numeric_limits<double>::quiet_NaN();
    KM_NurbsCurve curve = through({{0, 0, 0}, {1, 0, 0}}, false);
    const auto refuses = [&](const std::vector<KM_3dPoint>& points, bool closed) {
        return !curve.CreateCubicThroughPoints(points, closed);
    };
    EXPECT_TRUE(refuses({}, false));
    EXPECT_TRUE(refuses({{0, 0, 0}}, false));
    EXPECT_TRUE(refuses({{0, 0, 0}, {1, 0, 0}}, true));
    EXPECT_TRUE(refuses({{0, 0, 0}, {1, 0, 0}, {1, 0, 0}, {2, 1, 0}}, false));
    EXPECT_TRUE(refuses({{0, 0, 0}, {1, 0, 0}, {1, 1, 0}, {0, 0, 0}}, true));
    EXPECT_TRUE(refuses({{0, 0, 0}, {nan, 0, 0}, {1, 1, 0}}, false));
    EXPECT_TRUE(refuses({{0, 0, 0}, KM_3dPoint::UnsetPoint, {1, 1, 0}}, false));
    EXPECT_TRUE(refuses({{-1e308, 0, 0}, {1e308, 0, 0}, {0, 1, 0}}, false));
    EXPECT_EQ(curve.Domain().Max(), 1.0) << "the curve changed";
}

} // namespace
