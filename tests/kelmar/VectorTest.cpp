#include "kelmar/KM_Point.h"

#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <random>

namespace {

constexpr double infinity = std::numeric_limits<double>::infinity();
const double not_a_number = std::nan("");

} // namespace

TEST(Vector, UnsetInfiniteAndNotANumberAreInvalid) {
    EXPECT_TRUE(KM_3dPoint(1, 2, 3).IsValid());
    EXPECT_FALSE(KM_3dPoint::UnsetPoint.IsValid());
    EXPECT_FALSE(KM_3dVector::UnsetVector.IsValid());
    for (const double bad : {KM_UNSET_VALUE, infinity, -infinity, not_a_number}) {
        EXPECT_FALSE(KM_3dPoint(bad, 0, 0).IsValid());
        EXPECT_FALSE(KM_3dPoint(0, bad, 0).IsValid());
        EXPECT_FALSE(KM_3dVector(0, 0, bad).IsValid());
    }
}

TEST(Vector, TinyMeansEveryCoordinateWithinTheTolerance) {
    const double limit = std::ldexp(1.0, -32);
    EXPECT_EQ(KM_ZERO_TOLERANCE, limit);
    EXPECT_TRUE(KM_3dVector(limit, -limit, limit).IsTiny());
    EXPECT_FALSE(KM_3dVector(0, 0, std::nextafter(limit, 1.0)).IsTiny());
    EXPECT_TRUE(KM_3dVector(1, -2, 0).IsTiny(2.0));
    EXPECT_FALSE(KM_3dVector(1, -2, 0).IsTiny(1.5));
    EXPECT_FALSE(KM_3dVector(not_a_number, 0, 0).IsTiny());
}

TEST(Vector, LengthOfAPythagoreanTripleIsExact) {
    EXPECT_EQ(KM_3dVector(3, 4, 12).Length(), 13.0);
    EXPECT_EQ(KM_3dPoint(1, 1, 1).DistanceTo(KM_3dPoint(4, 5, 13)), 13.0);
    EXPECT_EQ(KM_3dVector(2, 3, 6).LengthSquared(), 49.0);
}

TEST(Vector, LengthNeitherOverflowsNorUnderflows) {
    const double huge = std::ldexp(1.0, 1000);
    EXPECT_EQ(KM_3dVector(3 * huge, 4 * huge, 0).Length(), 5 * huge);
    const double small = std::ldexp(1.0, -1060);
    EXPECT_EQ(KM_3dVector(3 * small, 4 * small, 0).Length(), 5 * small);
    EXPECT_EQ(KM_3dVector(not_a_number, 1, 1).Length(), 0.0);
}

TEST(Vector, UnitizeRefusesZeroAndInvalidVectors) {
    KM_3dVector zero;
    EXPECT_FALSE(zero.Unitize());
    KM_3dVector unset = KM_3dVector::UnsetVector;
    EXPECT_FALSE(unset.Unitize());
    EXPECT_EQ(unset, KM_3dVector::UnsetVector);
    KM_3dVector subnormal(0, -std::ldexp(1.0, -1070), 0);
    EXPECT_TRUE(subnormal.Unitize());
    EXPECT_EQ(subnormal, KM_3dVector(0, -1, 0));
}

TEST(Vector, CrossProductIsRightHanded) {
    EXPECT_EQ(KM_CrossProduct(KM_3dVector::XAxis, KM_3dVector::YAxis), KM_3dVector::ZAxis);
    EXPECT_EQ(KM_CrossProduct(KM_3dVector::YAxis, KM_3dVector::ZAxis), KM_3dVector::XAxis);
    EXPECT_EQ(KM_DotProduct(KM_3dVector(1, 2, 3), KM_3dVector(4, 5, 6)), 32.0);
    EXPECT_EQ(KM_3dVector(1, 2, 3) * KM_3dVector(4, 5, 6), 32.0);
}

TEST(Vector, PerpendicularIsAUnitVectorForEveryDirection) {
    std::mt19937 random(7);
    std::normal_distribution<double> coordinate;
    for (int i = 0; i < 1000; ++i) {
        const KM_3dVector v(coordinate(random), coordinate(random), 30 * coordinate(random));
        KM_3dVector perpendicular;
        ASSERT_TRUE(perpendicular.PerpendicularTo(v));
        EXPECT_NEAR(perpendicular.Length(), 1.0, 1e-15);
        EXPECT_NEAR(perpendicular * v, 0.0, 1e-15 * v.Length());
    }
    KM_3dVector perpendicular;
    EXPECT_TRUE(perpendicular.PerpendicularTo(KM_3dVector::ZAxis));
    EXPECT_EQ(perpendicular, KM_3dVector::XAxis);
    EXPECT_FALSE(perpendicular.PerpendicularTo(KM_3dVector::ZeroVector));
    EXPECT_EQ(perpendicular, KM_3dVector::ZeroVector);
}

TEST(Vector, ParallelTellsTheSenseApart) {
    const KM_3dVector v(1, 2, 3);
    EXPECT_EQ(v.IsParallelTo(1e-3 * v), 1);
    EXPECT_EQ(v.IsParallelTo(-5 * v), -1);
    EXPECT_EQ(v.IsParallelTo(KM_3dVector(1, 2, 4)), 0);
    EXPECT_EQ(v.IsParallelTo(KM_3dVector::ZeroVector), 0);
    // The angle of the two is atan(0.001).
    EXPECT_EQ(KM_3dVector::XAxis.IsParallelTo(KM_3dVector(1, 0.001, 0), 0.0011), 1);
    EXPECT_EQ(KM_3dVector::XAxis.IsParallelTo(KM_3dVector(1, 0.001, 0), 0.0009), 0);
}

TEST(Vector, PointsAndVectorsCombine) {
    KM_3dPoint p(1, 2, 3);
    EXPECT_EQ(p - KM_3dPoint(0, 1, 1), KM_3dVector(1, 1, 2));
    EXPECT_EQ(p + KM_3dVector(1, 1, 1), KM_3dPoint(2, 3, 4));
    p += KM_3dVector(1, 0, 0);
    p -= KM_3dVector(0, 0, 3);
    EXPECT_EQ(p, KM_3dPoint(2, 2, 0));
    KM_3dVector v(2, 4, 6);
    v /= 2;
    v *= 3;
    v += KM_3dVector(1, 0, 0);
    v -= KM_3dVector(0, 1, 0);
    v.Reverse();
    EXPECT_EQ(v, KM_3dVector(-4, -5, -9));
    EXPECT_EQ(KM_3dPoint(KM_3dVector(p)), p);
}
