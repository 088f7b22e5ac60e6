#include "kelmar/KM_Plane.h"

#include "kelmar/KM_Xform.h"

#include <gtest/gtest.h>

#include <random>

TEST(Plane, WorldPlaneHasTheWorldsAxes) {
    EXPECT_EQ(KM_xy_plane.Origin(), KM_3dPoint::Origin);
    EXPECT_EQ(KM_xy_plane.xaxis, KM_3dVector::XAxis);
    EXPECT_EQ(KM_xy_plane.yaxis, KM_3dVector::YAxis);
    EXPECT_EQ(KM_xy_plane.Normal(), KM_3dVector::ZAxis);
    const KM_Plane up(KM_3dPoint(1, 2, 3), KM_3dVector(0, 0, 9));
    EXPECT_EQ(up.xaxis, KM_3dVector::XAxis);
    EXPECT_EQ(up.yaxis, KM_3dVector::YAxis);
}

TEST(Plane, EveryNormalGivesARightHandedFrame) {
    std::mt19937 random(3);
    std::normal_distribution<double> coordinate;
    for (int i = 0; i < 500; ++i) {
        const KM_3dVector normal(coordinate(random), coordinate(random), coordinate(random));
        const KM_Plane plane(KM_3dPoint(1, 2, 3), normal);
        ASSERT_TRUE(plane.IsValid());
        EXPECT_EQ(plane.Normal().IsParallelTo(normal, 1e-7), 1);
        EXPECT_LE((KM_CrossProduct(plane.xaxis, plane.yaxis) - plane.zaxis).Length(), 1e-15);
    }
}

TEST(Plane, DirectionsInThePlaneFixItsFrame) {
    const KM_Plane plane(KM_3dPoint(0, 0, 1), KM_3dVector(0, 2, 0), KM_3dVector(-1, 5, 0));
    ASSERT_TRUE(plane.IsValid());
    EXPECT_EQ(plane.xaxis, KM_3dVector(0, 1, 0));
    EXPECT_LE((plane.yaxis - KM_3dVector(-1, 0, 0)).Length(), 1e-15);
    EXPECT_LE((plane.zaxis - KM_3dVector(0, 0, 1)).Length(), 1e-15);
}

TEST(Plane, DegenerateDirectionsGiveAnInvalidPlane) {
    EXPECT_FALSE(KM_Plane(KM_3dPoint(), KM_3dVector()).IsValid());
    EXPECT_FALSE(KM_Plane(KM_3dPoint(), KM_3dVector::UnsetVector).IsValid());
    EXPECT_FALSE(KM_Plane(KM_3dPoint(), {1, 2, 3}, {-2, -4, -6}).IsValid());
    EXPECT_FALSE(KM_Plane(KM_3dPoint::UnsetPoint, KM_3dVector::ZAxis).IsValid());
}

TEST(Plane, TranslationMovesTheOriginAlone) {
    KM_Plane plane = KM_xy_plane;
    plane.SetOrigin(KM_3dPoint(1, 2, 0));
    EXPECT_TRUE(plane.Translate(KM_3dVector(0, 0, 5)));
    EXPECT_EQ(plane.Origin(), KM_3dPoint(1, 2, 5));
    EXPECT_EQ(plane.xaxis, KM_3dVector::XAxis);
    EXPECT_FALSE(plane.Translate(KM_3dVector::UnsetVector));
    EXPECT_EQ(plane.Origin(), KM_3dPoint(1, 2, 5));
    EXPECT_EQ(KM_xy_plane.Origin(), KM_3dPoint::Origin);
}

TEST(Plane, PointsAndDistancesFollowTheFrame) {
    const KM_Plane plane(KM_3dPoint(1, 2, 3), KM_3dVector::YAxis, KM_3dVector::ZAxis);
    EXPECT_EQ(plane.PointAt(2, 5), KM_3dPoint(1, 4, 8));
    EXPECT_EQ(plane.DistanceTo(KM_3dPoint(4, 9, 9)), 3.0);
    EXPECT_EQ(plane.DistanceTo(KM_3dPoint(-1, 0, 0)), -2.0);
}

TEST(Plane, TransformKeepsTheFrameOfUnitLength) {
    KM_Plane plane(KM_3dPoint(1, 0, 0), KM_3dVector::ZAxis);
    ASSERT_TRUE(plane.Transform(KM_Xform::Diagonal(3, 5, 7)));
    EXPECT_TRUE(plane.IsValid());
    EXPECT_EQ(plane.Origin(), KM_3dPoint(3, 0, 0));
    const KM_Plane before = plane;
    EXPECT_FALSE(plane.Transform(KM_Xform::Diagonal(0, 1, 1)));
    EXPECT_EQ(plane.Origin(), before.Origin());
}
