#include "kelmar/KM_NurbsCurve.h"

#include "kelmar/KM_Circle.h"
#include "kelmar/KM_Xform.h"

#include <gtest/gtest.h>

#include <cmath>
#include <memory>
#include <random>
#include <vector>

namespace {

std::vector<KM_3dPoint> randomPoints(int count) {
    std::mt19937 random(static_cast<unsigned>(count));
    std::normal_distribution<double> coordinate;
    std::vector<KM_3dPoint> points;
    for (int i = 0; i < count; ++i)
        points.emplace_back(coordinate(random), coordinate(random), coordinate(random));
    return points;
}

// The Cox - de Boor recurrence as Piegl and Tiller write it (The NURBS Book, equation 2.5), on
// knots with the superfluous one at either end.
double basis(const std::vector<double>& u, int i, int p, double t) {
    const auto k = static_cast<std::size_t>(i);
    if (p == 0)
        return u[k] <= t && t < u[k + 1] ? 1.0 : 0.0;
    const auto q = static_cast<std::size_t>(i + p);
    double sum = 0.0;
    if (u[q] > u[k])
        sum += (t - u[k]) / (u[q] - u[k]) * basis(u, i, p - 1, t);
    if (u[q + 1] > u[k + 1])
        sum += (u[q + 1] - t) / (u[q + 1] - u[k + 1]) * basis(u, i + 1, p - 1, t);
    return sum;
}

KM_3dPoint pointByBasis(const KM_NurbsCurve& curve, double t) {
    std::vector<double> u = {curve.Knot(0)};
    for (int i = 0; i < curve.KnotCount(); ++i)
        u.push_back(curve.Knot(i));
    u.push_back(u.back());
    KM_3dVector sum;
    double weight = 0.0;
    for (int i = 0; i < curve.CVCount(); ++i) {
        KM_3dPoint place;
        curve.GetCV(i, place);
        const double share = curve.Weight(i) * basis(u, i, curve.Degree(), t);
        sum += share * KM_3dVector(place);
        weight += share;
    }
    return KM_3dPoint(sum / weight);
}

KM_NurbsCurve arch() {
    KM_NurbsCurve curve;
    const KM_3dPoint points[] = {{0, 0, 0}, {0, 2, 0}, {2, 2, 0}, {2, 0, 0}};
    curve.CreateClampedUniformNurbs(points, 4);
    return curve;
}

} // namespace

TEST(NurbsCurve, CreateMakesRoomByOrderAndCount) {
    KM_NurbsCurve curve;
    ASSERT_TRUE(curve.Create(3, false, 4, 6));
    EXPECT_EQ(curve.Order(), 4);
    EXPECT_EQ(curve.Degree(), 3);
    EXPECT_EQ(curve.CVCount(), 6);
    EXPECT_EQ(curve.KnotCount(), 8);
    EXPECT_FALSE(curve.IsRational());
    EXPECT_FALSE(curve.IsValid()) << "the knots are still all 0";
    EXPECT_FALSE(curve.Create(2, false, 4, 6));
    EXPECT_FALSE(curve.Create(3, false, 1, 6));
    EXPECT_FALSE(curve.Create(3, false, 4, 3));
    EXPECT_EQ(curve.CVCount(), 6);
}

TEST(NurbsCurve, ACubicOnOneSpanIsABezierCurve) {
    // B(1/2) = (P0 + 3 P1 + 3 P2 + P3) / 8, B'(1/2) = 3/4 (P3 + P2 - P1 - P0)
    const KM_NurbsCurve curve = arch();
    EXPECT_EQ(curve.Domain(), KM_Interval(0, 1));
    EXPECT_EQ(curve.PointAt(0.5), KM_3dPoint(1, 1.5, 0));
    EXPECT_EQ(curve.DerivativeAt(0.5), KM_3dVector(3, 0, 0));
    EXPECT_EQ(curve.PointAtStart(), KM_3dPoint(0, 0, 0));
    EXPECT_EQ(curve.PointAtEnd(), KM_3dPoint(2, 0, 0));
    EXPECT_EQ(curve.TangentAt(0), KM_3dVector::YAxis);
    EXPECT_EQ(curve.TangentAt(1), -KM_3dVector::YAxis);
}

TEST(NurbsCurve, PointsAgreeWithTheBasisFunctions) {
    std::mt19937 random(5);
    std::uniform_real_distribution<double> weight(0.2, 5.0);
    for (int order = 2; order <= 19; ++order) {
        KM_NurbsCurve curve;
        ASSERT_TRUE(curve.CreateClampedUniformNurbs(randomPoints(order + 4), order));
        for (int i = 0; i < curve.CVCount(); ++i)
            curve.SetWeight(i, weight(random));
        const double end = curve.Domain().Max();
        for (int i = 0; i < 20; ++i) {
            const double t = end * (i + 0.3) / 20.0;
            EXPECT_LE(curve.PointAt(t).DistanceTo(pointByBasis(curve, t)), 1e-13) << order;
        }
    }
}

TEST(NurbsCurve, UnevenKnotsWithMultiplicityAgreeWithTheBasisFunctions) {
    KM_NurbsCurve curve;
    ASSERT_TRUE(curve.Create(3, false, 4, 8));
    const auto points = randomPoints(8);
    for (int i = 0; i < 8; ++i)
        curve.SetCV(i, points[static_cast<std::size_t>(i)]);
    const double knots[] = {-1, -0.5, 0, 0.25, 0.25, 3, 7, 7, 7.5, 8};
    for (int i = 0; i < 10; ++i)
        ASSERT_TRUE(curve.SetKnot(i, knots[i]));
    ASSERT_TRUE(curve.IsValid());
    EXPECT_EQ(curve.Domain(), KM_Interval(0, 7));
    EXPECT_EQ(curve.SpanParameters(), (std::vector<double>{0, 0.25, 3, 7}));
    for (int i = 0; i < 50; ++i) {
        const double t = 7.0 * i / 50.0;
        EXPECT_LE(curve.PointAt(t).DistanceTo(pointByBasis(curve, t)), 1e-14);
    }
}

TEST(NurbsCurve, ReproducesAParabola) {
    // y = x^2 over [0, 2] as a quadratic: control points (0,0), (1,0), (2,4).
    KM_NurbsCurve curve;
    const KM_3dPoint points[] = {{0, 0, 0}, {1, 0, 0}, {2, 4, 0}};
    ASSERT_TRUE(curve.CreateClampedUniformNurbs(points, 3));
    ASSERT_TRUE(curve.SetDomain(0, 2));
    for (double t = -1.0; t <= 3.0; t += 0.125)
        EXPECT_EQ(curve.PointAt(t), KM_3dPoint(t, t * t, 0)) << "beyond the domain too";
    // Arc length of y = x^2 from 0 to 2: sqrt(17) + asinh(4) / 4
    double length = 0.0;
    ASSERT_TRUE(curve.GetLength(&length, 1e-12));
    EXPECT_NEAR(length, std::sqrt(17.0) + std::asinh(4.0) / 4.0, 1e-11);
}

TEST(NurbsCurve, ClampedUniformKnotsStartAtZero) {
    KM_NurbsCurve curve;
    ASSERT_TRUE(curve.CreateClampedUniformNurbs(randomPoints(6), 4));
    const double knots[] = {0, 0, 0, 1, 2, 3, 3, 3};
    for (int i = 0; i < 8; ++i)
        EXPECT_EQ(curve.Knot(i), knots[i]);
    ASSERT_TRUE(curve.MakeClampedUniformKnotVector(0.5));
    EXPECT_EQ(curve.Domain(), KM_Interval(0, 1.5));
    EXPECT_FALSE(curve.MakeClampedUniformKnotVector(0.0));
    EXPECT_FALSE(curve.CreateClampedUniformNurbs(randomPoints(3), 4));
    EXPECT_EQ(curve.CVCount(), 6);
    EXPECT_FALSE(KM_NurbsCurve().MakeClampedUniformKnotVector());
}

TEST(NurbsCurve, ClampedEndsAreTheirControlPointsExactly) {
    for (int count = 4; count < 60; ++count) {
        const auto points = randomPoints(count);
        KM_NurbsCurve curve;
        ASSERT_TRUE(curve.CreateClampedUniformNurbs(points, 4));
        curve.SetWeight(0, 0.3);
        curve.SetWeight(count - 1, 0.7);
        EXPECT_EQ(curve.PointAtStart(), points.front());
        EXPECT_EQ(curve.PointAtEnd(), points.back());
    }
}

TEST(NurbsCurve, PeriodicCurveIsClosedAndSmoothAtItsSeam) {
    for (int order = 2; order <= 6; ++order) {
        KM_NurbsCurve curve;
        ASSERT_TRUE(curve.CreatePeriodicUniformNurbs(randomPoints(7), order));
        EXPECT_TRUE(curve.IsValid());
        EXPECT_TRUE(curve.IsClosed());
        EXPECT_EQ(curve.Domain(), KM_Interval(0, 7));
        EXPECT_LE(curve.PointAtStart().DistanceTo(curve.PointAtEnd()), 1e-14);
        const double change_of_slope = (curve.DerivativeAt(0) - curve.DerivativeAt(7)).Length();
        EXPECT_EQ(change_of_slope <= 1e-13, order > 2) << order;
    }
    KM_NurbsCurve curve;
    EXPECT_FALSE(curve.CreatePeriodicUniformNurbs(randomPoints(2), 3));
    EXPECT_FALSE(curve.CreatePeriodicUniformNurbs(randomPoints(3), 5));
    EXPECT_FALSE(curve.CreatePeriodicUniformNurbs(randomPoints(5), 1));
}

TEST(NurbsCurve, OpenCurvesAreNotClosed) {
    EXPECT_FALSE(arch().IsClosed());
    KM_NurbsCurve loop = arch();
    loop.SetCV(3, KM_3dPoint(0, 0, 0));
    EXPECT_TRUE(loop.IsClosed()) << "clamped at the same point";
}

TEST(NurbsCurve, WithoutExtentItIsNeitherValidNorClosed) {
    KM_NurbsCurve curve;
    const KM_3dPoint same[] = {{5, 5, 5}, {5, 5, 5}, {5, 5, 5}};
    ASSERT_TRUE(curve.CreateClampedUniformNurbs(same, 3));
    EXPECT_FALSE(curve.IsValid());
    EXPECT_FALSE(curve.IsClosed());
    EXPECT_EQ(curve.PointAt(0.5), KM_3dPoint(5, 5, 5));
    EXPECT_EQ(curve.TangentAt(0.5), KM_3dVector::ZeroVector);
}

TEST(NurbsCurve, WithoutControlPointsNothingCanBeEvaluated) {
    const std::unique_ptr<KM_NurbsCurve> curve(KM_NurbsCurve::New());
    EXPECT_FALSE(curve->IsValid());
    EXPECT_FALSE(curve->IsClosed());
    EXPECT_FALSE(curve->Domain().IsValid());
    EXPECT_EQ(curve->PointAt(0), KM_3dPoint::UnsetPoint);
    EXPECT_EQ(curve->PointAtStart(), KM_3dPoint::UnsetPoint);
    EXPECT_FALSE(curve->Reverse());
    EXPECT_FALSE(curve->SetDomain(0, 1));
    EXPECT_TRUE(curve->SpanParameters().empty());
}

TEST(NurbsCurve, InvalidControlPointsGiveNoPointWhereTheyCount) {
    KM_NurbsCurve curve;
    ASSERT_TRUE(curve.CreateClampedUniformNurbs(randomPoints(8), 3));
    curve.SetCV(7, KM_3dPoint(std::nan(""), 0, 0));
    EXPECT_FALSE(curve.IsValid());
    EXPECT_TRUE(curve.PointAt(2.5).IsValid());
    EXPECT_EQ(curve.PointAt(5.5), KM_3dPoint::UnsetPoint);
    EXPECT_EQ(curve.PointAtEnd(), KM_3dPoint::UnsetPoint);
    EXPECT_EQ(curve.PointAt(std::nan("")), KM_3dPoint::UnsetPoint);
}

TEST(NurbsCurve, UnsoundKnotsGiveNoPoint) {
    KM_NurbsCurve zeros;
    ASSERT_TRUE(zeros.Create(3, false, 3, 4));
    EXPECT_EQ(zeros.PointAt(0), KM_3dPoint::UnsetPoint);
    KM_NurbsCurve falling = arch();
    falling.SetKnot(1, 5.0);
    EXPECT_FALSE(falling.IsValid());
    EXPECT_EQ(falling.PointAt(0.5), KM_3dPoint::UnsetPoint);
    KM_NurbsCurve unset = arch();
    unset.SetKnot(4, std::nan(""));
    EXPECT_FALSE(unset.IsValid());
    EXPECT_EQ(unset.PointAt(0.5), KM_3dPoint::UnsetPoint);
}

TEST(NurbsCurve, KnotsMayRepeatUpToTheDegree) {
    KM_NurbsCurve curve;
    ASSERT_TRUE(curve.CreateClampedUniformNurbs(randomPoints(7), 3)); // knots 0 0 1 2 3 4 5 5
    curve.SetKnot(3, 1.0);
    EXPECT_TRUE(curve.IsValid()) << "twice is the degree";
    curve.SetKnot(4, 1.0);
    EXPECT_FALSE(curve.IsValid());
}

TEST(NurbsCurve, WeightsPullWithoutMovingTheControlPoints) {
    KM_NurbsCurve curve = arch();
    const double before = curve.PointAt(0.5).DistanceTo(KM_3dPoint(0, 2, 0));
    ASSERT_TRUE(curve.SetWeight(1, 10.0));
    EXPECT_TRUE(curve.IsRational());
    EXPECT_LT(curve.PointAt(0.5).DistanceTo(KM_3dPoint(0, 2, 0)), before);
    KM_3dPoint place;
    ASSERT_TRUE(curve.GetCV(1, place));
    EXPECT_EQ(place, KM_3dPoint(0, 2, 0));
    EXPECT_EQ(curve.PointAtStart(), KM_3dPoint(0, 0, 0));
}

TEST(NurbsCurve, WeightsThatAreNotPositiveAreRefused) {
    KM_NurbsCurve curve = arch();
    for (const double weight : {0.0, -1.0, std::nan(""), KM_UNSET_VALUE})
        EXPECT_FALSE(curve.SetWeight(0, weight));
    EXPECT_EQ(curve.Weight(0), 1.0);
    EXPECT_FALSE(curve.IsRational());
}

TEST(NurbsCurve, IndicesOutsideAreRefused) {
    KM_NurbsCurve curve = arch();
    KM_3dPoint place(7, 7, 7);
    for (const int index : {-1, 4}) {
        EXPECT_FALSE(curve.GetCV(index, place));
        EXPECT_FALSE(curve.SetCV(index, place));
        EXPECT_FALSE(curve.SetWeight(index, 2.0));
        EXPECT_EQ(curve.Weight(index), 0.0);
    }
    EXPECT_EQ(place, KM_3dPoint(7, 7, 7));
    for (const int index : {-1, 6}) {
        EXPECT_FALSE(curve.SetKnot(index, 1.0));
        EXPECT_EQ(curve.Knot(index), KM_UNSET_VALUE);
    }
}

TEST(NurbsCurve, TangentExistsWhereTheDerivativeVanishes) {
    KM_NurbsCurve curve;
    const KM_3dPoint points[] = {{0, 0, 0}, {0, 0, 0}, {1, 1, 0}, {1, 1, 0}};
    ASSERT_TRUE(curve.CreateClampedUniformNurbs(points, 4));
    EXPECT_EQ(curve.DerivativeAt(0), KM_3dVector::ZeroVector);
    const KM_3dVector along(std::sqrt(0.5), std::sqrt(0.5), 0);
    EXPECT_LE((curve.TangentAt(0) - along).Length(), 1e-7);
    EXPECT_LE((curve.TangentAt(1) - along).Length(), 1e-7);
}

TEST(NurbsCurve, ATransformThatSendsPointsBehindTheEyeIsRefused) {
    KM_NurbsCurve curve = arch();
    KM_Xform perspective;
    perspective.m_xform[3][0] =
        -1.0; // the fourth coordinate is 1 - x: positive at 0, negative at 2
    EXPECT_FALSE(curve.Transform(perspective));
    EXPECT_EQ(curve.PointAtEnd(), KM_3dPoint(2, 0, 0));
    EXPECT_FALSE(curve.IsRational());
}

TEST(NurbsCurve, LengthIsTheSameForEveryWayToParametrise) {
    KM_NurbsCurve curve;
    ASSERT_TRUE(curve.CreateClampedUniformNurbs(randomPoints(12), 4));
    double length = 0.0;
    double other = 0.0;
    ASSERT_TRUE(curve.GetLength(&length, 1e-10));
    ASSERT_TRUE(curve.SetDomain(-100, 7));
    ASSERT_TRUE(curve.Reverse());
    ASSERT_TRUE(curve.GetLength(&other, 1e-10));
    EXPECT_NEAR(other / length, 1.0, 1e-9);
    EXPECT_TRUE(curve.GetLength(nullptr));
}
