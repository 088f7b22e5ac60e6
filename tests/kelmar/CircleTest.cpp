#include "kelmar/KM_Circle.h"

#include "kelmar/KM_NurbsCurve.h"
#include "kelmar/KM_Xform.h"

#include <gtest/gtest.h>

#include <cmath>
#include <memory>

namespace {

KM_NurbsCurve nurbsForm(const KM_Circle& circle) {
    KM_NurbsCurve curve;
    EXPECT_EQ(circle.GetNurbForm(curve), 2);
    return curve;
}

} // namespace

TEST(Circle, NurbsFormHasNineControlPointsAndDegreeTwo) {
    const KM_NurbsCurve curve = nurbsForm(KM_Circle(KM_xy_plane, 3.0));
    EXPECT_EQ(curve.CVCount(), 9);
    EXPECT_EQ(curve.Degree(), 2);
    EXPECT_EQ(curve.KnotCount(), 10);
    EXPECT_TRUE(curve.IsRational());
    EXPECT_TRUE(curve.IsValid());
    EXPECT_TRUE(curve.IsClosed());
    EXPECT_EQ(curve.Domain(), KM_Interval(0.0, 2.0 * KM_PI));
}

TEST(Circle, EveryPointOfTheNurbsFormIsAtTheRadius) {
    for (const double radius : {1e-6, 1.0, 73.2, 1e9}) {
        const KM_NurbsCurve curve = nurbsForm(KM_Circle(KM_xy_plane, radius));
        for (int i = 0; i <= 1000; ++i) {
            const KM_3dPoint point = curve.PointAt(2.0 * KM_PI * i / 1000.0);
            ASSERT_NEAR(std::hypot(point.x, point.y) / radius, 1.0, 1e-15) << i;
            ASSERT_EQ(point.z, 0.0);
        }
    }
}

TEST(Circle, QuarterParametersGiveExactQuarterPoints) {
    KM_Plane plane = KM_xy_plane;
    plane.SetOrigin(KM_3dPoint(10, 20, 35));
    const KM_NurbsCurve curve = nurbsForm(KM_Circle(plane, 5.0));
    const double step = 2.0 * KM_PI / 4.0;
    EXPECT_EQ(curve.PointAt(0), KM_3dPoint(15, 20, 35));
    EXPECT_EQ(curve.PointAt(step), KM_3dPoint(10, 25, 35));
    EXPECT_EQ(curve.PointAt(2 * step), KM_3dPoint(5, 20, 35));
    EXPECT_EQ(curve.PointAt(3 * step), KM_3dPoint(10, 15, 35));
    EXPECT_EQ(curve.PointAt(4 * step), KM_3dPoint(15, 20, 35));
}

TEST(Circle, PointsStayAtTheCirclesHeightExactly) {
    KM_Plane plane = KM_xy_plane;
    plane.SetOrigin(KM_3dPoint(1.1, 2.2, 35.7));
    const KM_NurbsCurve curve = nurbsForm(KM_Circle(plane, 5.3));
    for (int i = 0; i < 360; ++i)
        ASSERT_EQ(curve.PointAt(i * KM_PI / 180).z, 35.7);
}

TEST(Circle, ParameterAndAngleDifferByLessThanTheStatedBound) {
    const KM_NurbsCurve curve = nurbsForm(KM_Circle());
    double largest = 0.0;
    for (int i = 0; i < 4000; ++i) {
        const double t = 0.5 * KM_PI * i / 4000.0;
        const KM_3dPoint point = curve.PointAt(t);
        largest = std::max(largest, std::abs(std::atan2(point.y, point.x) - t));
    }
    EXPECT_LT(largest, 0.0161);
    EXPECT_GT(largest, 0.0160);
}

TEST(Circle, RunsAnticlockwiseSeenFromTheNormal) {
    const KM_NurbsCurve up = nurbsForm(KM_Circle(KM_xy_plane, 1.0));
    EXPECT_EQ(up.TangentAt(0), KM_3dVector::YAxis);
    const KM_Plane facing_down(KM_3dPoint(), -KM_3dVector::ZAxis);
    const KM_NurbsCurve down = nurbsForm(KM_Circle(facing_down, 1.0));
    const KM_3dVector turn = KM_CrossProduct(KM_3dVector(down.PointAtStart()), down.TangentAt(0));
    EXPECT_LT(turn.z, 0.0);
}

TEST(Circle, LengthOfTheNurbsFormIsTheCircumference) {
    const KM_Circle circle(KM_Plane(KM_3dPoint(1, 2, 3), KM_3dVector(1, 1, 1)), 7.0);
    double length = 0.0;
    ASSERT_TRUE(nurbsForm(circle).GetLength(&length));
    EXPECT_NEAR(length, 14.0 * KM_PI, 1e-8 * length);
    EXPECT_EQ(circle.Circumference(), 14.0 * KM_PI);
}

TEST(Circle, PointAtAngleLiesWhereTheAngleSays) {
    const KM_Circle circle(KM_Plane(KM_3dPoint(0, 0, 9), KM_3dVector::ZAxis), 2.0);
    const KM_3dPoint point = circle.PointAt(KM_PI / 3); // cos 60 degrees = 1 / 2
    EXPECT_NEAR(point.x, 1.0, 1e-15);
    EXPECT_NEAR(point.y, std::sqrt(3.0), 1e-15);
    EXPECT_EQ(point.z, 9.0);
}

TEST(Circle, InvalidCirclesHaveNoNurbsForm) {
    KM_NurbsCurve curve;
    for (const double radius : {0.0, -1.0, KM_UNSET_VALUE, std::nan("")}) {
        const KM_Circle circle(KM_xy_plane, radius);
        EXPECT_FALSE(circle.IsValid());
        EXPECT_EQ(circle.GetNurbForm(curve), 0);
    }
    EXPECT_EQ(KM_Circle(KM_Plane(KM_3dPoint(), KM_3dVector()), 1.0).GetNurbForm(curve), 0);
    EXPECT_EQ(curve.CVCount(), 0) << "a failure leaves the curve as it was";
}

// The circle of a turntable: camera at E, target below or above the centre, turned so that it
// starts at the camera.
TEST(Circle, TurnedOntoACameraStartsAndEndsThere) {
    const KM_3dPoint target(1, 2, -4);
    for (const KM_3dPoint& camera : {KM_3dPoint(40, -60, 35), KM_3dPoint(-9, 2, 3),
                                     KM_3dPoint(11, 2, 3), KM_3dPoint(1, 9, 0)}) {
        KM_Plane plane = KM_xy_plane;
        plane.SetOrigin(KM_3dPoint(target.x, target.y, 0));
        const double radius = KM_3dPoint(camera.x, camera.y, 0).DistanceTo(plane.Origin());
        plane.Translate(KM_3dVector(0, 0, camera.z));
        const std::unique_ptr<KM_NurbsCurve> curve(KM_NurbsCurve::New());
        ASSERT_EQ(KM_Circle(plane, radius).GetNurbForm(*curve), 2);
        const KM_3dPoint center = plane.Origin();
        const KM_Xform turn =
            KM_Xform::Rotation(curve->PointAtStart() - center, camera - center, center);
        ASSERT_TRUE(curve->Transform(turn));
        EXPECT_LE(curve->PointAtStart().DistanceTo(camera), 2e-14);
        EXPECT_EQ(curve->PointAtStart(), curve->PointAtEnd());
        EXPECT_EQ(curve->PointAt(1.0).z, camera.z);
        const double area = KM_CrossProduct(curve->PointAtStart() - center, curve->TangentAt(0)).z;
        EXPECT_GT(area, 0.0) << "still anticlockwise from above";
        ASSERT_TRUE(curve->Reverse());
        EXPECT_LE(curve->PointAtStart().DistanceTo(camera), 2e-14);
        EXPECT_LT(KM_CrossProduct(camera - center, curve->TangentAt(curve->Domain().Min())).z, 0.0);
    }
}
