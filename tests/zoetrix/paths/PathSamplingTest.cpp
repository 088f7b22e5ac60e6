#include "kelmar/KM_Circle.h"
#include "kelmar/KM_LineCurve.h"
#include "kelmar/KM_NurbsCurve.h"
#include "kelmar/KM_PolylineCurve.h"
#include "zoetrix/paths/FlythroughPoints.h"
#include "zoetrix/plugin/ZoetrixUtilities.h"

#include <gtest/gtest.h>

#include <array>
#include <limits>
#include <vector>

namespace {

/// A curve whose point at parameter t is (t, 0, 0), so that the points of a division are its
/// parameters. Parameters from `gap_from` to `gap_to` cannot be
/// evaluated.
class ParameterCurve final : public KM_Curve {
public:
    ParameterCurve(double t0, double t1, bool closed) : m_domain(t0, t1), m_closed(closed) {}

    KM_Curve* Duplicate() const override { return new ParameterCurve(*this); }
    const wchar_t* TypeName() const override { return L"ParameterCurve"; }
    bool IsValid() const override { return true; }
    KM_Interval Domain() const override { return m_domain; }
    bool SetDomain(double, double) override { return false; }
    std::vector<double> SpanParameters() const override { return {m_domain.Min(), m_domain.Max()}; }
    KM_3dPoint PointAt(double t) const override {
        ++evaluations;
        return t >= gap_from && t <= gap_to ? KM_3dPoint::UnsetPoint : KM_3dPoint(t, 0.0, 0.0);
    }
    KM_3dVector DerivativeAt(double) const override { return KM_3dVector::XAxis; }
    bool IsClosed() const override {
        ++closed_questions;
        return m_closed;
    }
    bool Reverse() override { return false; }
    bool Transform(const KM_Xform&) override { return false; }
    KM_BoundingBox BoundingBox() const override { return {}; }

    double gap_from = 1.0;
    double gap_to = 0.0;
    mutable int closed_questions = 0;
    mutable int evaluations = 0;

private:
    KM_Interval m_domain;
    bool m_closed;
};

struct Division {
    bool ok = false;
    std::vector<double> parameters;
};

Division divide(const KM_Curve& curve, int count, bool look_ahead, bool is_camera) {
    KM_3dPointArray points;
    points.Append(KM_3dPoint(99.0, 0.0, 0.0));
    Division division;
    division.ok = CZoetrixUtilities::GetPathPoints(&curve, count, points, look_ahead, is_camera);
    for (const KM_3dPoint& point : points)
        division.parameters.push_back(point.x);
    return division;
}

using Parameters = std::vector<double>;

} // namespace

TEST(PathSampling, NoCurveGivesNoPointsAndLeavesTheListAlone) {
    KM_3dPointArray points;
    points.Append(KM_3dPoint(1.0, 2.0, 3.0));
    EXPECT_FALSE(CZoetrixUtilities::GetPathPoints(nullptr, 5, points, false, true));
    EXPECT_EQ(1, points.Count());
}

TEST(PathSampling, CountsBelowOneGiveAnEmptyList) {
    const ParameterCurve line(0.0, 10.0, false);
    for (const int count : {0, -3, std::numeric_limits<int>::min()}) {
        const Division division = divide(line, count, true, true);
        EXPECT_FALSE(division.ok);
        EXPECT_TRUE(division.parameters.empty());
    }
}

TEST(PathSampling, OneFrameIsTheStartPointWhateverTheFlags) {
    for (const bool closed : {false, true}) {
        const ParameterCurve curve(3.0, 10.0, closed);
        for (const bool look_ahead : {false, true}) {
            for (const bool is_camera : {false, true}) {
                const Division division = divide(curve, 1, look_ahead, is_camera);
                EXPECT_TRUE(division.ok);
                EXPECT_EQ(Parameters({3.0}), division.parameters);
            }
        }
    }
}

TEST(PathSampling, OneFrameIsTheStartPointEvenWhereTheCurveHasNone) {
    ParameterCurve line(3.0, 10.0, false);
    line.gap_from = 3.0;
    line.gap_to = 5.0;
    const Division division = divide(line, 1, false, true);
    EXPECT_TRUE(division.ok);
    EXPECT_EQ(Parameters({KM_UNSET_VALUE}), division.parameters);
}

TEST(PathSampling, OpenCurveIsDividedFromEndToEnd) {
    const ParameterCurve line(0.0, 10.0, false);
    for (const bool is_camera : {false, true})
        EXPECT_EQ(Parameters({0.0, 2.5, 5.0, 7.5, 10.0}),
                  divide(line, 5, false, is_camera).parameters);
}

TEST(PathSampling, FlythroughTargetRunsOneStepAheadOfTheCamera) {
    const ParameterCurve line(0.0, 10.0, false);
    EXPECT_EQ(Parameters({0.0, 2.0, 4.0, 6.0, 8.0}), divide(line, 5, true, true).parameters);
    EXPECT_EQ(Parameters({2.0, 4.0, 6.0, 8.0, 10.0}), divide(line, 5, true, false).parameters);
}

TEST(PathSampling, FlythroughNeverAsksWhetherTheCurveIsClosed) {
    const ParameterCurve line(0.0, 10.0, true);
    EXPECT_EQ(Parameters({0.0, 5.0}), divide(line, 2, true, true).parameters);
    EXPECT_EQ(0, line.closed_questions);
}

TEST(PathSampling, ClosedCurveTakesTheSeamOnceAsItsLastFrame) {
    const ParameterCurve loop(0.0, 8.0, true);
    for (const bool is_camera : {false, true})
        EXPECT_EQ(Parameters({2.0, 4.0, 6.0, 8.0}), divide(loop, 4, false, is_camera).parameters);
}

TEST(PathSampling, CircleIsDividedAtItsQuarters) {
    KM_NurbsCurve circle;
    ASSERT_EQ(2, KM_Circle(KM_xy_plane, 3.0).GetNurbForm(circle));
    KM_3dPointArray points;
    ASSERT_TRUE(CZoetrixUtilities::GetPathPoints(&circle, 4, points, false, false));
    ASSERT_EQ(4, points.Count());
    const KM_3dPoint quarters[] = {
        {0.0, 3.0, 0.0}, {-3.0, 0.0, 0.0}, {0.0, -3.0, 0.0}, {3.0, 0.0, 0.0}};
    for (int i = 0; i < 4; ++i)
        EXPECT_LT(points[i].DistanceTo(quarters[i]), 1e-14) << i;
}

TEST(PathSampling, LastFrameMeetsTheEndOfTheDomainExactly) {
    // Neither end is a binary fraction, so the first end plus all steps misses the other at times.
    for (int count = 2; count < 400; ++count) {
        const ParameterCurve line(0.1, 1.0 / 3.0, false);
        EXPECT_EQ(1.0 / 3.0, divide(line, count, false, true).parameters.back()) << count;
    }
}

TEST(PathSampling, FallingDomainIsTakenFromItsSmallerEnd) {
    const ParameterCurve line(10.0, 0.0, false);
    EXPECT_EQ(Parameters({0.0, 5.0, 10.0}), divide(line, 3, false, true).parameters);
}

TEST(PathSampling, PlacesThatCannotBeEvaluatedAreLeftOut) {
    ParameterCurve line(0.0, 10.0, false);
    line.gap_from = 2.0;
    line.gap_to = 6.0;
    const Division division = divide(line, 5, false, true);
    EXPECT_TRUE(division.ok);
    EXPECT_EQ(Parameters({0.0, 7.5, 10.0}), division.parameters);
}

TEST(PathSampling, CurveWithoutAnyPointFails) {
    ParameterCurve line(0.0, 10.0, false);
    line.gap_from = -1.0;
    line.gap_to = 11.0;
    EXPECT_FALSE(divide(line, 5, false, true).ok);
}

TEST(PathSampling, LargestCountWithAnExtraStepAsksForNoMemoryOnACurveWithoutDomain) {
    const KM_NurbsCurve no_curve;
    KM_3dPointArray points;
    EXPECT_FALSE(CZoetrixUtilities::GetPathPoints(&no_curve, std::numeric_limits<int>::max(),
                                                  points, true, false));
    EXPECT_EQ(0, points.Capacity());
}

TEST(PathSampling, EmptiedListKeepsItsStorage) {
    const ParameterCurve line(0.0, 10.0, false);
    KM_3dPointArray points;
    points.Reserve(64);
    const KM_3dPoint* storage = points.Array();
    ASSERT_TRUE(CZoetrixUtilities::GetPathPoints(&line, 64, points, false, true));
    EXPECT_EQ(storage, points.Array());
}

TEST(PathSampling, ControlPointThatIsNoNumberTakesItsSpansAwayOnly) {
    // Places 0 to 5 along x; the spans from 1 to 2 and from 2 to 3 need the third one.
    KM_NurbsCurve curve;
    ASSERT_TRUE(curve.CreateClampedUniformNurbs(
        std::array<KM_3dPoint, 6>{
            {{0, 0, 0}, {1, 0, 0}, {2, 0, 0}, {3, 0, 0}, {4, 0, 0}, {5, 0, 0}}},
        2));
    ASSERT_TRUE(curve.SetCV(2, {std::numeric_limits<double>::quiet_NaN(), 0.0, 0.0}));
    EXPECT_EQ(Parameters({0.0, 3.0, 4.0, 5.0}), divide(curve, 6, false, true).parameters);
    EXPECT_EQ(Parameters({0.0, 3.0, 4.0}), divide(curve, 5, true, true).parameters);
    EXPECT_EQ(Parameters({3.0, 4.0, 5.0}), divide(curve, 5, true, false).parameters);
}

TEST(PathSampling, CurveOfNothingButNoNumbersFails) {
    constexpr double no_number = std::numeric_limits<double>::quiet_NaN();
    const KM_LineCurve line({no_number, 0.0, 0.0}, {no_number, 1.0, 0.0});
    EXPECT_FALSE(divide(line, 5, false, true).ok);
    EXPECT_FALSE(divide(line, 5, true, false).ok);
}

TEST(PathSampling, CurveWithoutLengthIsOpenAndGivesItsPlaceForEveryFrame) {
    const KM_LineCurve line({7.0, 0.0, 0.0}, {7.0, 0.0, 0.0});
    EXPECT_EQ(Parameters({7.0, 7.0, 7.0}), divide(line, 3, false, true).parameters);
    EXPECT_EQ(Parameters({7.0, 7.0, 7.0}), divide(line, 3, true, false).parameters);
}

TEST(PathSampling, CurveOfOneCornerIsNoCurveToDivide) {
    const KM_PolylineCurve corner(std::array<KM_3dPoint, 1>{{{7.0, 0.0, 0.0}}});
    EXPECT_FALSE(divide(corner, 3, false, true).ok);
    EXPECT_FALSE(divide(corner, 3, true, true).ok);
}

TEST(FlythroughPoints, AreTheTwoDivisionsOfTheCurve) {
    const ParameterCurve line(0.0, 10.0, true);
    KM_3dPointArray camera;
    KM_3dPointArray target;
    ASSERT_TRUE(GetFlythroughPoints(&line, 2, camera, target));
    EXPECT_EQ(KM_3dPointArray({{0.0, 0.0, 0.0}, {5.0, 0.0, 0.0}}), camera);
    EXPECT_EQ(KM_3dPointArray({{5.0, 0.0, 0.0}, {10.0, 0.0, 0.0}}), target);
}

TEST(FlythroughPoints, OfOneFrameAreStartAndEnd) {
    const ParameterCurve line(3.0, 10.0, true);
    KM_3dPointArray camera = {{1.0, 1.0, 1.0}, {2.0, 2.0, 2.0}};
    KM_3dPointArray target;
    ASSERT_TRUE(GetFlythroughPoints(&line, 1, camera, target));
    EXPECT_EQ(KM_3dPointArray({{3.0, 0.0, 0.0}}), camera);
    EXPECT_EQ(KM_3dPointArray({{10.0, 0.0, 0.0}}), target);
}

TEST(FlythroughPoints, AreNoneWithoutCurveOrFrames) {
    const ParameterCurve line(0.0, 10.0, false);
    KM_3dPointArray camera;
    KM_3dPointArray target;
    EXPECT_FALSE(GetFlythroughPoints(nullptr, 1, camera, target));
    EXPECT_FALSE(GetFlythroughPoints(nullptr, 5, camera, target));
    EXPECT_FALSE(GetFlythroughPoints(&line, 0, camera, target));
    EXPECT_FALSE(GetFlythroughPoints(&line, -5, camera, target));
}

TEST(FlythroughPoints, AreNoneWhereOnlyOneListHasAny) {
    // Of the places 0, 5 and 10 only the last can be evaluated: the camera has none.
    ParameterCurve line(0.0, 10.0, false);
    line.gap_from = 0.0;
    line.gap_to = 7.0;
    KM_3dPointArray camera;
    KM_3dPointArray target;
    EXPECT_FALSE(GetFlythroughPoints(&line, 2, camera, target));
    // And of these only the first: the target has none.
    line.gap_from = 3.0;
    line.gap_to = 10.0;
    EXPECT_FALSE(GetFlythroughPoints(&line, 2, camera, target));
}
