// What all kinds of curves have in common, and lines and polylines in particular.

#include "kelmar/KM_Circle.h"
#include "kelmar/KM_LineCurve.h"
#include "kelmar/KM_NurbsCurve.h"
#include "kelmar/KM_PolylineCurve.h"
#include "kelmar/KM_Xform.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <memory>
#include <span>
#include <string_view>
#include <vector>

namespace {

const KM_3dPoint square_corners[] = {{0, 0, 0}, {4, 0, 0}, {4, 4, 0}, {0, 4, 0}, {0, 0, 0}};

std::vector<std::unique_ptr<KM_Curve>> oneOfEach() {
    std::vector<std::unique_ptr<KM_Curve>> curves;
    curves.push_back(std::make_unique<KM_LineCurve>(
        KM_Line(KM_3dPoint(1, 2, 3), KM_3dPoint(5, -2, 9)), 2.0, 7.0));
    curves.push_back(std::make_unique<KM_PolylineCurve>(square_corners));
    auto circle = std::make_unique<KM_NurbsCurve>();
    KM_Circle(KM_Plane(KM_3dPoint(1, 2, 3), KM_3dVector(1, 2, 2)), 3.0).GetNurbForm(*circle);
    curves.push_back(std::move(circle));
    auto spline = std::make_unique<KM_NurbsCurve>();
    const KM_3dPoint points[] = {{0, 0, 0}, {1, 3, 0}, {4, 3, 2}, {6, 0, 1}, {9, 1, 0}, {9, 5, 5}};
    spline->CreateClampedUniformNurbs(points, 4);
    curves.push_back(std::move(spline));
    auto loop = std::make_unique<KM_NurbsCurve>();
    loop->CreatePeriodicUniformNurbs(points, 4);
    curves.push_back(std::move(loop));
    return curves;
}

double distanceToPolyline(const KM_3dPoint& point, const KM_3dPointArray& corners) {
    double nearest = point.DistanceTo(corners[0]);
    for (int i = 0; i + 1 < corners.Count(); ++i) {
        const KM_3dVector along = corners[i + 1] - corners[i];
        const double s = ((point - corners[i]) * along) / along.LengthSquared();
        const KM_3dPoint foot = corners[i] + std::clamp(s, 0.0, 1.0) * along;
        nearest = std::min(nearest, point.DistanceTo(foot));
    }
    return nearest;
}

} // namespace

TEST(Curve, ReversalNegatesTheDomainAndKeepsThePoints) {
    for (const auto& curve : oneOfEach()) {
        const std::unique_ptr<KM_Curve> reversed(curve->Duplicate());
        ASSERT_TRUE(reversed->Reverse());
        const KM_Interval domain = curve->Domain();
        EXPECT_EQ(reversed->Domain(), KM_Interval(-domain.m_t[1], -domain.m_t[0]));
        EXPECT_LE(reversed->PointAtStart().DistanceTo(curve->PointAtEnd()), 1e-14);
        EXPECT_LE(reversed->PointAtEnd().DistanceTo(curve->PointAtStart()), 1e-14);
        EXPECT_TRUE(reversed->IsValid());
        EXPECT_EQ(reversed->IsClosed(), curve->IsClosed());
        for (int i = 0; i <= 50; ++i) {
            const double t = domain.ParameterAt(i / 50.0);
            EXPECT_LE(reversed->PointAt(-t).DistanceTo(curve->PointAt(t)), 1e-13);
        }
    }
}

TEST(Curve, ADuplicateIsDeep) {
    for (const auto& curve : oneOfEach()) {
        const KM_3dPoint start = curve->PointAtStart();
        const std::unique_ptr<KM_Curve> copy(curve->Duplicate());
        EXPECT_STREQ(copy->TypeName(), curve->TypeName());
        ASSERT_TRUE(copy->Transform(KM_Xform::Translation(1, 0, 0)));
        EXPECT_EQ(curve->PointAtStart(), start);
        EXPECT_EQ(copy->PointAtStart(), start + KM_3dVector(1, 0, 0));
    }
}

TEST(Curve, TransformMovesEveryPoint) {
    const KM_Xform xform = KM_Xform::Rotation(0.7, KM_3dVector(1, 2, 3), KM_3dPoint(4, 5, 6)) *
                           KM_Xform::Diagonal(1, 2, -3);
    for (const auto& curve : oneOfEach()) {
        const std::unique_ptr<KM_Curve> moved(curve->Duplicate());
        ASSERT_TRUE(moved->Transform(xform));
        for (int i = 0; i <= 50; ++i) {
            const double t = curve->Domain().ParameterAt(i / 50.0);
            EXPECT_LE(moved->PointAt(t).DistanceTo(xform * curve->PointAt(t)), 1e-12);
        }
    }
}

TEST(Curve, APerspectiveTransformIsExactForNurbs) {
    KM_Xform perspective;
    perspective.m_xform[3][0] = 0.05;
    for (const auto& curve : oneOfEach()) {
        if (std::wstring_view(curve->TypeName()) != L"NURBS curve")
            continue;
        const std::unique_ptr<KM_Curve> moved(curve->Duplicate());
        ASSERT_TRUE(moved->Transform(perspective));
        for (int i = 0; i <= 50; ++i) {
            const double t = curve->Domain().ParameterAt(i / 50.0);
            EXPECT_LE(moved->PointAt(t).DistanceTo(perspective * curve->PointAt(t)), 1e-13);
        }
    }
}

TEST(Curve, ATransformThatCannotBeLeavesTheCurveAlone) {
    KM_Xform broken;
    broken.m_xform[0][0] = std::nan("");
    for (const auto& curve : oneOfEach()) {
        const KM_3dPoint end = curve->PointAtEnd();
        EXPECT_FALSE(curve->Transform(broken));
        EXPECT_EQ(curve->PointAtEnd(), end);
    }
}

TEST(Curve, ANewDomainKeepsThePoints) {
    for (const auto& curve : oneOfEach()) {
        const std::unique_ptr<KM_Curve> stretched(curve->Duplicate());
        ASSERT_TRUE(stretched->SetDomain(-3.0, 11.5));
        EXPECT_EQ(stretched->Domain(), KM_Interval(-3.0, 11.5));
        EXPECT_LE(stretched->PointAtStart().DistanceTo(curve->PointAtStart()), 1e-14);
        EXPECT_LE(stretched->PointAtEnd().DistanceTo(curve->PointAtEnd()), 1e-14);
        for (int i = 0; i <= 20; ++i) {
            const KM_3dPoint wanted = curve->PointAt(curve->Domain().ParameterAt(i / 20.0));
            const KM_3dPoint point = stretched->PointAt(stretched->Domain().ParameterAt(i / 20.0));
            EXPECT_LE(point.DistanceTo(wanted), 1e-12);
        }
        EXPECT_FALSE(stretched->SetDomain(1.0, 1.0));
        EXPECT_FALSE(stretched->SetDomain(2.0, 1.0));
        EXPECT_FALSE(stretched->SetDomain(0.0, KM_UNSET_VALUE));
        EXPECT_EQ(stretched->Domain(), KM_Interval(-3.0, 11.5));
    }
}

TEST(Curve, DerivativeAgreesWithDifferencesOfPoints) {
    for (const auto& curve : oneOfEach()) {
        const std::vector<double> spans = curve->SpanParameters();
        for (std::size_t i = 0; i + 1 < spans.size(); ++i) {
            const double t = std::lerp(spans[i], spans[i + 1], 0.37);
            const double h = 1e-5;
            const KM_3dVector slope = (curve->PointAt(t + h) - curve->PointAt(t - h)) / (2 * h);
            EXPECT_LE((curve->DerivativeAt(t) - slope).Length(), 1e-6 * slope.Length() + 1e-6);
        }
    }
}

TEST(Curve, EveryPointLiesInTheBoundingBox) {
    for (const auto& curve : oneOfEach()) {
        KM_BoundingBox box = curve->BoundingBox();
        box.Union(KM_BoundingBox(box.m_min - KM_3dVector(1e-12, 1e-12, 1e-12),
                                 box.m_max + KM_3dVector(1e-12, 1e-12, 1e-12)));
        for (int i = 0; i <= 100; ++i)
            EXPECT_TRUE(box.Includes(curve->PointAt(curve->Domain().ParameterAt(i / 100.0))));
    }
}

TEST(Curve, DisplayPolylineStaysWithinTheTolerance) {
    for (const auto& curve : oneOfEach()) {
        for (const double tolerance : {0.1, 0.001}) {
            KM_3dPointArray corners;
            curve->GetDisplayPolyline(tolerance, corners);
            ASSERT_GE(corners.Count(), 2);
            EXPECT_EQ(*corners.First(), curve->PointAtStart());
            EXPECT_EQ(*corners.Last(), curve->PointAtEnd());
            for (int i = 0; i <= 500; ++i) {
                const KM_3dPoint point = curve->PointAt(curve->Domain().ParameterAt(i / 500.0));
                // Between the places that the division looks at it may be off a little more.
                ASSERT_LE(distanceToPolyline(point, corners), 1.1 * tolerance + 1e-12);
            }
        }
    }
}

TEST(Curve, DisplayPolylineOfACircleHasTheChordsItsToleranceNeeds) {
    KM_NurbsCurve curve;
    KM_Circle(KM_xy_plane, 1.0).GetNurbForm(curve);
    KM_3dPointArray corners;
    curve.GetDisplayPolyline(0.01, corners);
    // A chord over the angle a lies 1 - cos(a / 2) away: 0.01 allows a = 0.283, so 23 chords, and
    // halving quarter turns gives 32.
    EXPECT_EQ(corners.Count(), 33);
    curve.GetDisplayPolyline(0.0, corners);
    EXPECT_EQ(corners.Count(), 4 * 4096 + 1) << "no tolerance: the finest division";
}

TEST(Curve, DisplayPolylineMeetsKinksExactly) {
    // Degree 2 with a double knot at 1: the curve has a kink at its third control point.
    KM_NurbsCurve curve;
    ASSERT_TRUE(curve.Create(3, false, 3, 5));
    const KM_3dPoint points[] = {{0, 0, 0}, {1, 2, 0}, {0.3, 0.7, 0.1}, {3, -2, 0}, {4, 0, 0}};
    for (int i = 0; i < 5; ++i)
        curve.SetCV(i, points[i]);
    const double knots[] = {0, 0, 1, 1, 2, 2};
    for (int i = 0; i < 6; ++i)
        curve.SetKnot(i, knots[i]);
    ASSERT_TRUE(curve.IsValid());
    EXPECT_EQ(curve.PointAt(1.0), points[2]);
    KM_3dPointArray corners;
    curve.GetDisplayPolyline(10.0, corners);
    EXPECT_GE(corners.Search(points[2]), 1);
}

TEST(LineCurve, EqualParameterStepsGiveEqualSteps) {
    const KM_LineCurve line(KM_Line({0, 0, 0}, {10, 20, -10}), 0.0, 10.0);
    for (const double t : {0.0, 2.5, 5.0, 7.5, 10.0})
        EXPECT_EQ(line.PointAt(t), KM_3dPoint(t, 2 * t, -t));
    EXPECT_EQ(line.PointAt(12), KM_3dPoint(12, 24, -12)) << "beyond the domain it goes on";
    EXPECT_EQ(line.DerivativeAt(3), KM_3dVector(1, 2, -1));
    EXPECT_FALSE(line.IsClosed());
    double length = 0;
    ASSERT_TRUE(line.GetLength(&length));
    EXPECT_NEAR(length, 10 * std::sqrt(6.0), 1e-12);
    KM_3dPointArray corners;
    line.GetDisplayPolyline(1e-6, corners);
    EXPECT_EQ(corners.Count(), 2);
}

TEST(LineCurve, WithoutLengthItIsNeitherValidNorClosed) {
    const KM_LineCurve line(KM_3dPoint(1, 1, 1), KM_3dPoint(1, 1, 1));
    EXPECT_FALSE(line.IsValid());
    EXPECT_FALSE(line.IsClosed());
    EXPECT_EQ(line.PointAt(0.5), KM_3dPoint(1, 1, 1));
    EXPECT_EQ(line.TangentAt(0.5), KM_3dVector::ZeroVector);
    double length = -1;
    EXPECT_FALSE(line.GetLength(&length));
    EXPECT_EQ(length, -1);
}

TEST(LineCurve, InvalidEndsOrParametersGiveNoPoint) {
    const KM_LineCurve broken(KM_3dPoint(0, 0, 0), KM_3dPoint(std::nan(""), 0, 0));
    EXPECT_EQ(broken.PointAt(0.5), KM_3dPoint::UnsetPoint);
    const KM_LineCurve line(KM_3dPoint(0, 0, 0), KM_3dPoint(1, 0, 0));
    EXPECT_EQ(line.PointAt(std::nan("")), KM_3dPoint::UnsetPoint);
    EXPECT_EQ(line.PointAt(INFINITY), KM_3dPoint::UnsetPoint);
}

TEST(PolylineCurve, CornersAreMetExactlyAtTheirParameters) {
    const KM_PolylineCurve polyline(square_corners);
    EXPECT_EQ(polyline.Domain(), KM_Interval(0, 4));
    for (int i = 0; i < 5; ++i)
        EXPECT_EQ(polyline.PointAt(i), square_corners[i]);
    EXPECT_EQ(polyline.PointAt(1.25), KM_3dPoint(4, 1, 0));
    EXPECT_EQ(polyline.PointAt(-0.5), KM_3dPoint(-2, 0, 0)) << "the first segment goes on";
    EXPECT_EQ(polyline.PointAt(4.5), KM_3dPoint(0, -2, 0)) << "and so does the last";
    EXPECT_EQ(polyline.TangentAt(1.0), KM_3dVector::YAxis) << "at a corner the next segment's";
    EXPECT_EQ(polyline.TangentAt(4.0), -KM_3dVector::YAxis);
    double length = 0;
    ASSERT_TRUE(polyline.GetLength(&length));
    EXPECT_EQ(length, 16.0);
}

TEST(PolylineCurve, SegmentsRunAtTheSpeedOfTheirParameters) {
    KM_PolylineCurve polyline;
    const double parameters[] = {0, 1, 10, 11, 12};
    ASSERT_TRUE(polyline.Create(square_corners, parameters));
    EXPECT_EQ(polyline.PointAt(5.5), KM_3dPoint(4, 2, 0));
    EXPECT_EQ(polyline.DerivativeAt(0.5), KM_3dVector(4, 0, 0));
}

TEST(PolylineCurve, UnsoundParametersAreRefused) {
    KM_PolylineCurve polyline(square_corners);
    const double repeated[] = {0, 1, 1, 2, 3};
    const double falling[] = {0, 2, 1, 3, 4};
    const double unset[] = {0, 1, 2, 3, std::nan("")};
    EXPECT_FALSE(polyline.Create(square_corners, repeated));
    EXPECT_FALSE(polyline.Create(square_corners, falling));
    EXPECT_FALSE(polyline.Create(square_corners, unset));
    EXPECT_FALSE(polyline.Create(square_corners, std::span(repeated).first(4)));
    EXPECT_EQ(polyline.Domain(), KM_Interval(0, 4));
}

TEST(PolylineCurve, ClosedWhenItReturnsToItsStart) {
    EXPECT_TRUE(KM_PolylineCurve(square_corners).IsClosed());
    EXPECT_FALSE(KM_PolylineCurve(std::span(square_corners).first(4)).IsClosed());
    KM_3dPointArray nearly;
    nearly.Append(5, square_corners);
    nearly[4].x = 1e-10; // the extent is 5.7, so a gap up to 1.3e-9 is none
    EXPECT_TRUE(KM_PolylineCurve(nearly).IsClosed());
    nearly[4].x = 1e-8;
    EXPECT_FALSE(KM_PolylineCurve(nearly).IsClosed());
}

TEST(PolylineCurve, FarFromTheOriginRoundingIsNoGap) {
    KM_3dPointArray corners;
    for (const KM_3dPoint& corner : square_corners)
        corners.Append(corner + KM_3dVector(1e9, 0, 0));
    corners[4].x = std::nextafter(1e9, 2e9); // 1.2e-7 off
    EXPECT_TRUE(KM_PolylineCurve(corners).IsClosed());
}

TEST(PolylineCurve, WithoutExtentItIsNeitherValidNorClosed) {
    const KM_3dPoint same[] = {{1, 2, 3}, {1, 2, 3}, {1, 2, 3}};
    const KM_PolylineCurve polyline(same);
    EXPECT_FALSE(polyline.IsValid());
    EXPECT_FALSE(polyline.IsClosed());
    EXPECT_EQ(polyline.PointAt(1.5), KM_3dPoint(1, 2, 3));
    EXPECT_EQ(polyline.TangentAt(1.5), KM_3dVector::ZeroVector);
}

TEST(PolylineCurve, WithFewerThanTwoCornersNothingCanBeEvaluated) {
    const KM_PolylineCurve one{std::span(square_corners).first(1)};
    for (const KM_PolylineCurve& polyline : {KM_PolylineCurve(), one}) {
        EXPECT_FALSE(polyline.IsValid());
        EXPECT_FALSE(polyline.IsClosed());
        EXPECT_EQ(polyline.PointAtStart(), KM_3dPoint::UnsetPoint);
        EXPECT_EQ(polyline.DerivativeAt(0), KM_3dVector::UnsetVector);
        KM_3dPointArray corners = {KM_3dPoint(1, 1, 1)};
        polyline.GetDisplayPolyline(0.1, corners);
        EXPECT_EQ(corners.Count(), 0);
    }
    KM_PolylineCurve empty;
    EXPECT_FALSE(empty.Reverse());
    EXPECT_FALSE(empty.Domain().IsValid());
    EXPECT_FALSE(empty.SetDomain(0, 1));
}

TEST(Curve, LengthsOfPartsAddUpToTheLength) {
    for (const auto& curve : oneOfEach()) {
        const std::vector<double> spans = curve->SpanParameters();
        double sum = 0.0;
        for (std::size_t i = 0; i + 1 < spans.size(); ++i) {
            const double middle = std::lerp(spans[i], spans[i + 1], 0.3);
            sum += curve->LengthBetween(spans[i], middle);
            sum += curve->LengthBetween(middle, spans[i + 1]);
        }
        double length = 0.0;
        ASSERT_TRUE(curve->GetLength(&length));
        EXPECT_NEAR(sum, length, 1e-7 * length);
        EXPECT_EQ(curve->LengthBetween(spans[0], spans[0]), 0.0);
    }
}

TEST(Curve, APartOfACircleIsAsLongAsItsArc) {
    KM_NurbsCurve circle;
    ASSERT_EQ(KM_Circle(KM_xy_plane, 3.0).GetNurbForm(circle), 2);
    EXPECT_NEAR(circle.LengthBetween(0.0, 0.5 * KM_PI), 1.5 * KM_PI, 1e-9);
    EXPECT_NEAR(circle.LengthBetween(0.5 * KM_PI, 0.75 * KM_PI), 0.75 * KM_PI, 1e-9);
}

TEST(Curve, WhatCannotBeEvaluatedHasNoLength) {
    KM_NurbsCurve curve;
    const KM_3dPoint points[] = {{-1e308, 0, 0}, {1e308, 1, 0}, {1e308, 2, 0}, {0, 0, 1e308}};
    ASSERT_TRUE(curve.CreateClampedUniformNurbs(points, 4));
    ASSERT_FALSE(curve.DerivativeAt(0.0).IsValid());
    double length = -1.0;
    EXPECT_FALSE(curve.GetLength(&length));
    EXPECT_EQ(length, -1.0);
    EXPECT_FALSE(KM_IsValid(curve.LengthBetween(0.0, 1.0)));
}

TEST(PolylineCurve, AnInvalidCornerSpoilsItsSegmentsOnly) {
    KM_3dPointArray corners;
    corners.Append(5, square_corners);
    corners[2] = KM_3dPoint::UnsetPoint;
    const KM_PolylineCurve polyline(corners);
    EXPECT_FALSE(polyline.IsValid());
    EXPECT_TRUE(polyline.PointAt(0.5).IsValid());
    EXPECT_EQ(polyline.PointAt(1.5), KM_3dPoint::UnsetPoint);
    EXPECT_EQ(polyline.PointAt(2.5), KM_3dPoint::UnsetPoint);
    EXPECT_TRUE(polyline.PointAt(3.5).IsValid());
}
