#include "host/curves/EvenSpeed.h"

#include "kelmar/KM_Circle.h"
#include "kelmar/KM_LineCurve.h"
#include "kelmar/KM_NurbsCurve.h"
#include "kelmar/KM_PolylineCurve.h"
#include "kelmar/KM_Xform.h"

#include <gtest/gtest.h>

#include <cmath>
#include <random>

namespace quarn::test {
namespace {

constexpr double TOLERANCE = 1e-4;

std::unique_ptr<KM_Curve> evenOf(const KM_Curve& curve, double tolerance = TOLERANCE) {
    auto even = evenSpeedCurve(curve, tolerance);
    EXPECT_TRUE(even) << even.message();
    return even ? std::move(even.value()) : nullptr;
}

/// The length between two parameters, by many chords.
double chordSum(const KM_Curve& curve, double t0, double t1) {
    constexpr int chords = 400;
    double sum = 0.0;
    KM_3dPoint from = curve.PointAt(t0);
    for (int i = 1; i <= chords; ++i) {
        const KM_3dPoint to = curve.PointAt(std::lerp(t0, t1, i / double(chords)));
        sum += from.DistanceTo(to);
        from = to;
    }
    return sum;
}

/// Lengths of equal steps of the parameter are equal, and are the steps.
void expectEvenSteps(const KM_Curve& curve, int steps) {
    const KM_Interval domain = curve.Domain();
    EXPECT_EQ(domain.Min(), 0.0);
    const double step = domain.Length() / steps;
    for (int i = 0; i < steps; ++i)
        EXPECT_NEAR(chordSum(curve, i * step, (i + 1) * step), step, 0.001 * step) << i;
}

/// Every sample of one curve is near the other, which is taken as fine chords.
void expectNear(const KM_Curve& samples, const KM_Curve& curve, double tolerance) {
    KM_3dPointArray chords;
    curve.GetDisplayPolyline(0.01 * tolerance, chords);
    const KM_Interval domain = samples.Domain();
    for (int i = 0; i <= 500; ++i) {
        const KM_3dPoint point = samples.PointAt(domain.ParameterAt(i / 500.0));
        double nearest = 1e300;
        for (int k = 0; k + 1 < chords.Count(); ++k) {
            const KM_Line chord(chords[k], chords[k + 1]);
            const KM_3dVector along = chord.Direction();
            const double square = along.LengthSquared();
            const double s = square > 0.0 ? ((point - chord.from) * along) / square : 0.0;
            nearest = std::min(nearest, point.DistanceTo(chord.PointAt(std::clamp(s, 0.0, 1.0))));
        }
        EXPECT_LE(nearest, 1.02 * tolerance) << i;
    }
}

void expectSameShape(const KM_Curve& a, const KM_Curve& b, double tolerance = TOLERANCE) {
    expectNear(a, b, tolerance);
    expectNear(b, a, tolerance);
}

/// Control points that bunch up: a camera on it crawls, then rushes.
KM_NurbsCurve unevenCurve() {
    KM_NurbsCurve curve;
    const KM_3dPoint points[] = {{0, 0, 0},   {0.1, 0, 0}, {0.2, 0.1, 0}, {10, 0, 0},
                                 {10, 10, 3}, {10, 11, 3}, {0, 11, 0},    {0, 5, 0}};
    EXPECT_TRUE(curve.CreateClampedUniformNurbs(points, 4));
    return curve;
}

TEST(EvenSpeed, EqualStepsOfACurveWithBunchedControlPointsAreEquallyLong) {
    const KM_NurbsCurve curve = unevenCurve();
    const KM_Interval domain = curve.Domain();
    const double step = domain.Length() / 20;
    EXPECT_GT(chordSum(curve, domain.Max() - 2 * step, domain.Max() - step),
              5 * chordSum(curve, 0, step))
        << "the curve is even already";
    const auto even = evenOf(curve);
    expectEvenSteps(*even, 7);
    expectEvenSteps(*even, 1000);
    expectSameShape(*even, curve);
    double length = 0.0;
    curve.GetLength(&length);
    EXPECT_NEAR(even->Domain().Length(), length, 1e-6 * length);
}

TEST(EvenSpeed, TheWholeCurveIsFollowedInItsDirection) {
    const KM_NurbsCurve curve = unevenCurve();
    const auto even = evenOf(curve);
    EXPECT_EQ(even->PointAtStart(), curve.PointAtStart());
    EXPECT_EQ(even->PointAtEnd(), curve.PointAtEnd());
    double way = 0.0;
    for (int i = 0; i < 20; ++i) {
        const double t = curve.Domain().ParameterAt(i / 20.0);
        way += i > 0 ? chordSum(curve, curve.Domain().ParameterAt((i - 1) / 20.0), t) : 0.0;
        EXPECT_LT(even->PointAt(way).DistanceTo(curve.PointAt(t)), 0.003) << i;
    }
}

TEST(EvenSpeed, ACircleIsRunThroughByItsAngleAndStaysClosed) {
    KM_NurbsCurve circle;
    ASSERT_EQ(KM_Circle(KM_xy_plane, 5.0).GetNurbForm(circle), 2);
    const auto even = evenOf(circle);
    EXPECT_TRUE(even->IsClosed());
    EXPECT_NEAR(even->Domain().Length(), 10.0 * KM_PI, 1e-6);
    for (int i = 0; i <= 36; ++i) {
        const double angle = i * KM_PI / 18.0;
        const KM_3dPoint point(5.0 * std::cos(angle), 5.0 * std::sin(angle), 0.0);
        EXPECT_LT(even->PointAt(5.0 * angle).DistanceTo(point), 5e-3) << i;
    }
    expectEvenSteps(*even, 360);
    expectSameShape(*even, circle);
}

TEST(EvenSpeed, AWeightThatPullsHardIsFollowed) {
    KM_NurbsCurve curve = unevenCurve();
    curve.SetWeight(4, 50.0);
    curve.SetWeight(1, 0.02);
    const auto even = evenOf(curve);
    expectEvenSteps(*even, 300);
    expectSameShape(*even, curve);
}

TEST(EvenSpeed, APeriodicCurveStaysClosedAndSmoothAtItsSeam) {
    KM_NurbsCurve curve;
    const KM_3dPoint points[] = {{0, 0, 0}, {9, 0, 1}, {9, 1, 0}, {1, 7, 0}};
    ASSERT_TRUE(curve.CreatePeriodicUniformNurbs(points, 4));
    const auto even = evenOf(curve);
    EXPECT_TRUE(even->IsClosed());
    const KM_Interval domain = even->Domain();
    EXPECT_LT((even->DerivativeAt(domain.Min()) - even->DerivativeAt(domain.Max())).Length(), 1e-5);
    expectEvenSteps(*even, 100);
    expectSameShape(*even, curve);
}

TEST(EvenSpeed, KinksStayKinks) {
    KM_NurbsCurve curve;
    const KM_3dPoint points[] = {{0, 0, 0}, {3, 0, 0}, {3, 4, 0}, {3, 4, 12}};
    ASSERT_TRUE(curve.CreateClampedUniformNurbs(points, 2)); // straight pieces
    const auto even = evenOf(curve);
    EXPECT_NEAR(even->Domain().Length(), 19.0, 1e-9);
    EXPECT_LT(even->PointAt(3.0).DistanceTo({3, 0, 0}), 1e-9);
    EXPECT_LT(even->PointAt(7.0).DistanceTo({3, 4, 0}), 1e-9);
    EXPECT_LT(even->PointAt(13.0).DistanceTo({3, 4, 6}), 1e-9);
    expectEvenSteps(*even, 19);
}

// Control points on a cross give a cubic that stops at its middle and turns back: its derivative,
// 3 ((1,1) (1-u)^2 + 2 (-1,0) u (1-u) + (1,-1) u^2), vanishes at u = 1/2.
TEST(EvenSpeed, ACuspInsideAPieceIsNoTrouble) {
    KM_NurbsCurve curve;
    const KM_3dPoint points[] = {{0, 0, 0}, {1, 1, 0}, {0, 1, 0}, {1, 0, 0}};
    ASSERT_TRUE(curve.CreateClampedUniformNurbs(points, 4));
    ASSERT_LT(curve.DerivativeAt(0.5).Length(), 1e-12);
    const auto even = evenOf(curve);
    expectEvenSteps(*even, 50);
    expectSameShape(*even, curve);
}

TEST(EvenSpeed, ControlPointsThatCoincideAtTheEndsAreNoTrouble) {
    KM_NurbsCurve curve;
    const KM_3dPoint points[] = {{0, 0, 0}, {0, 0, 0}, {5, 3, 0}, {8, 0, 0}, {8, 0, 0}, {8, 0, 0}};
    ASSERT_TRUE(curve.CreateClampedUniformNurbs(points, 4));
    const auto even = evenOf(curve);
    expectEvenSteps(*even, 40);
    expectSameShape(*even, curve);
}

TEST(EvenSpeed, ACurveFarFromTheOriginIsNoTrouble) {
    KM_NurbsCurve curve = unevenCurve();
    ASSERT_TRUE(curve.Transform(KM_Xform::Translation({3e6, -5e6, 100})));
    const auto even = evenOf(curve);
    expectEvenSteps(*even, 200);
    expectSameShape(*even, curve);
    EXPECT_LT(dynamic_cast<KM_NurbsCurve&>(*even).CVCount(), 2000);
}

TEST(EvenSpeed, SmallTolerancesCostPiecesAndLargeOnesFew) {
    const KM_NurbsCurve curve = unevenCurve();
    const auto coarse = evenOf(curve, 0.1);
    const auto fine = evenOf(curve, 1e-5);
    expectSameShape(*fine, curve, 1e-5);
    expectEvenSteps(*coarse, 100);
    const int few = dynamic_cast<KM_NurbsCurve&>(*coarse).CVCount();
    const int many = dynamic_cast<KM_NurbsCurve&>(*fine).CVCount();
    EXPECT_LT(few, many);
    EXPECT_LT(many, 5000);
}

TEST(EvenSpeed, APolylineKeepsItsCornersAndGetsTheirDistances) {
    KM_PolylineCurve polyline;
    const KM_3dPoint corners[] = {{0, 0, 0}, {3, 0, 0}, {3, 0, 0}, {3, 4, 0}, {3, 4, 12}};
    const double parameters[] = {0, 1, 2, 3, 4};
    ASSERT_TRUE(polyline.Create(corners, parameters));
    const auto even = evenOf(polyline);
    const auto& result = dynamic_cast<const KM_PolylineCurve&>(*even);
    EXPECT_EQ(result.Parameters(), (std::vector<double>{0, 3, 7, 19}));
    ASSERT_EQ(result.PointCount(), 4);
    EXPECT_EQ(result.Points()[2], KM_3dPoint(3, 4, 0));
}

TEST(EvenSpeed, ALineGetsItsLengthAsDomain) {
    const auto even = evenOf(KM_LineCurve({1, 1, 1}, {1, 4, 5}));
    EXPECT_EQ(even->Domain().Min(), 0.0);
    EXPECT_EQ(even->Domain().Max(), 5.0);
    EXPECT_EQ(even->PointAt(2.5), KM_3dPoint(1, 2.5, 3));
}

TEST(EvenSpeed, InvalidCurvesAreRefused) {
    EXPECT_FALSE(evenSpeedCurve(KM_NurbsCurve(), TOLERANCE));
    EXPECT_FALSE(evenSpeedCurve(KM_PolylineCurve(), TOLERANCE));
    EXPECT_FALSE(evenSpeedCurve(KM_LineCurve({1, 1, 1}, {1, 1, 1}), TOLERANCE));
    KM_NurbsCurve curve = unevenCurve();
    curve.SetCV(3, KM_3dPoint::UnsetPoint);
    EXPECT_FALSE(evenSpeedCurve(curve, TOLERANCE));
}

TEST(EvenSpeed, ACurveTooLargeToBeMeasuredIsRefused) {
    KM_NurbsCurve curve;
    const KM_3dPoint points[] = {{-1e308, 0, 0}, {1e308, 1e308, 0}, {1, 1, 1}, {0, 0, 1e308}};
    ASSERT_TRUE(curve.CreateClampedUniformNurbs(points, 4));
    EXPECT_FALSE(evenSpeedCurve(curve, TOLERANCE));
}

TEST(EvenSpeed, AThousandControlPointsAreDoneAtOnce) {
    std::mt19937 random(7);
    std::uniform_real_distribution<double> coordinate(0.0, 100.0);
    std::vector<KM_3dPoint> points;
    for (int i = 0; i < 1000; ++i)
        points.emplace_back(coordinate(random), coordinate(random), coordinate(random));
    KM_NurbsCurve curve;
    ASSERT_TRUE(curve.CreateClampedUniformNurbs(points, 4));
    const auto even = evenOf(curve, 1e-3);
    double length = 0.0;
    curve.GetLength(&length);
    EXPECT_NEAR(even->Domain().Length(), length, 1e-5 * length);
    expectEvenSteps(*even, 3000);
}

} // namespace
} // namespace quarn::test
