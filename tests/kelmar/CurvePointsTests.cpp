#include "kelmar/KM_Circle.h"
#include "kelmar/KM_NurbsCurve.h"
#include "kelmar/KM_PolylineCurve.h"

#include <gtest/gtest.h>

#include <array>
#include <cmath>
#include <cstring>
#include <limits>
#include <vector>

// Points at many parameters at once are those of so many single calls, to the last bit.

namespace {

KM_NurbsCurve windingCurve(int order, bool rational) {
    KM_NurbsCurve curve;
    EXPECT_TRUE(curve.Create(3, rational, order, 40));
    for (int i = 0; i < curve.CVCount(); ++i) {
        curve.SetCV(i, {5.0 * std::cos(0.7 * i), 5.0 * std::sin(0.7 * i), 0.3 * i - 4.0});
        if (rational)
            curve.SetWeight(i, 1.0 + 0.4 * std::sin(2.0 * i));
    }
    double knot = -1.0;
    for (int i = 0; i < curve.KnotCount(); ++i) {
        curve.SetKnot(i, knot);
        if (i >= order - 2 && i < curve.CVCount() - 1)
            knot += 0.2 + 0.1 * std::sin(3.0 * i);
    }
    EXPECT_TRUE(curve.IsValid());
    return curve;
}

/// Equal steps over the domain, and beyond it at both ends.
std::vector<double> stepsOver(const KM_Curve& curve) {
    const KM_Interval domain = curve.Domain();
    std::vector<double> parameters;
    for (int i = -50; i <= 1050; ++i)
        parameters.push_back(domain.ParameterAt(i / 1000.0));
    return parameters;
}

void expectSameAsSingleCalls(const KM_Curve& curve, const std::vector<double>& parameters) {
    std::vector<KM_3dPoint> points(parameters.size(), KM_3dPoint(1.0, 2.0, 3.0));
    curve.PointsAt(parameters, points.data());
    for (std::size_t i = 0; i < parameters.size(); ++i) {
        const KM_3dPoint single = curve.PointAt(parameters[i]);
        ASSERT_EQ(0, std::memcmp(&single, &points[i], sizeof single)) << parameters[i];
    }
}

} // namespace

TEST(CurvePoints, OfNurbsCurvesOfEveryDegreeAreThoseOfSingleCalls) {
    for (const int order : {2, 3, 4, 5, 16, 17, 25}) {
        for (const bool rational : {false, true}) {
            SCOPED_TRACE(order);
            const KM_NurbsCurve curve = windingCurve(order, rational);
            expectSameAsSingleCalls(curve, stepsOver(curve));
        }
    }
}

TEST(CurvePoints, AtKnotsAreThoseOfSingleCalls) {
    const KM_NurbsCurve curve = windingCurve(4, true);
    expectSameAsSingleCalls(curve, curve.SpanParameters());
    KM_NurbsCurve circle;
    ASSERT_EQ(2, KM_Circle(KM_xy_plane, 3.0).GetNurbForm(circle));
    expectSameAsSingleCalls(circle, circle.SpanParameters());
}

TEST(CurvePoints, MayBeAskedForInAnyOrderAndAtWhatIsNoNumber) {
    const KM_NurbsCurve curve = windingCurve(4, false);
    std::vector<double> parameters = stepsOver(curve);
    for (std::size_t i = 0; i + 7 < parameters.size(); i += 3)
        std::swap(parameters[i], parameters[i + 7]);
    parameters[0] = std::numeric_limits<double>::quiet_NaN();
    parameters[500] = std::numeric_limits<double>::infinity();
    parameters[501] = std::numeric_limits<double>::quiet_NaN();
    expectSameAsSingleCalls(curve, parameters);
}

TEST(CurvePoints, OfBrokenCurvesAreThoseOfSingleCalls) {
    KM_NurbsCurve falling = windingCurve(4, false);
    const std::vector<double> parameters = stepsOver(falling);
    ASSERT_TRUE(falling.SetKnot(20, -50.0));
    expectSameAsSingleCalls(falling, parameters);

    KM_NurbsCurve torn = windingCurve(4, false);
    ASSERT_TRUE(torn.SetCV(20, {std::numeric_limits<double>::quiet_NaN(), 0.0, 0.0}));
    expectSameAsSingleCalls(torn, parameters);
    expectSameAsSingleCalls(KM_NurbsCurve(), parameters);
}

TEST(CurvePoints, OfOtherCurvesAreThoseOfSingleCalls) {
    const std::array<KM_3dPoint, 3> corners = {{{0, 0, 0}, {1, 0, 0}, {1, 5, 0}}};
    const KM_PolylineCurve polyline(corners);
    expectSameAsSingleCalls(polyline, stepsOver(polyline));
}

TEST(CurvePoints, OfNoParametersAreNone) {
    const KM_NurbsCurve curve = windingCurve(4, false);
    KM_3dPoint untouched(1.0, 2.0, 3.0);
    curve.PointsAt({}, &untouched);
    EXPECT_EQ(KM_3dPoint(1.0, 2.0, 3.0), untouched);
}
