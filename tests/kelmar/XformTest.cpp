#include "kelmar/KM_Xform.h"

#include "kelmar/KM_Plane.h"

#include <gtest/gtest.h>

#include <cmath>
#include <random>

namespace {

void expectNear(const KM_3dVector& actual, const KM_3dVector& wanted, double tolerance) {
    EXPECT_LE((actual - wanted).Length(), tolerance)
        << actual.x << " " << actual.y << " " << actual.z << " instead of " << wanted.x << " "
        << wanted.y << " " << wanted.z;
}

class RandomVectors {
public:
    KM_3dVector operator()() {
        return {m_coordinate(m_random), m_coordinate(m_random), m_coordinate(m_random)};
    }

private:
    std::mt19937 m_random{11};
    std::normal_distribution<double> m_coordinate;
};

} // namespace

TEST(Xform, TranslationMovesPointsAndLeavesVectors) {
    const KM_Xform move = KM_Xform::Translation(KM_3dVector(1, 2, 3));
    EXPECT_EQ(move * KM_3dPoint(1, 1, 1), KM_3dPoint(2, 3, 4));
    EXPECT_EQ(move * KM_3dVector(1, 1, 1), KM_3dVector(1, 1, 1));
}

TEST(Xform, ScaleKeepsItsCenter) {
    const KM_Xform scale = KM_Xform::Scale(KM_3dPoint(1, 2, 3), 2.0);
    EXPECT_EQ(scale * KM_3dPoint(1, 2, 3), KM_3dPoint(1, 2, 3));
    EXPECT_EQ(scale * KM_3dPoint(2, 2, 3), KM_3dPoint(3, 2, 3));
}

TEST(Xform, ProductAppliesTheRightFactorFirst) {
    const KM_Xform move = KM_Xform::Translation(1, 0, 0);
    const KM_Xform scale = KM_Xform::Diagonal(2, 2, 2);
    EXPECT_EQ((scale * move) * KM_3dPoint(1, 0, 0), KM_3dPoint(4, 0, 0));
    EXPECT_EQ((move * scale) * KM_3dPoint(1, 0, 0), KM_3dPoint(3, 0, 0));
}

TEST(Xform, QuarterTurnsAreExact) {
    for (int quarter = -4; quarter <= 4; ++quarter) {
        const KM_Xform turn =
            KM_Xform::Rotation(quarter * 0.5 * KM_PI, KM_3dVector(0, 0, 7), KM_3dPoint(0, 0, 5));
        const KM_3dVector images[4] = {{1, 0, 0}, {0, 1, 0}, {-1, 0, 0}, {0, -1, 0}};
        EXPECT_EQ(turn * KM_3dVector::XAxis, images[(quarter + 8) % 4]) << quarter;
        EXPECT_EQ(turn * KM_3dVector::ZAxis, KM_3dVector::ZAxis);
    }
}

TEST(Xform, RotationTurnsAnticlockwiseAboutItsCenter) {
    const KM_3dPoint center(10, 20, 30);
    const KM_Xform turn = KM_Xform::Rotation(KM_PI / 6, KM_3dVector::ZAxis, center);
    const KM_3dPoint image = turn * (center + KM_3dVector(2, 0, 1));
    // cos 30 degrees = sqrt(3) / 2, sin 30 degrees = 1 / 2
    expectNear(image - center, KM_3dVector(std::sqrt(3.0), 1, 1), 1e-14);
    expectNear((turn * center) - center, KM_3dVector::ZeroVector, 1e-14);
}

TEST(Xform, RotationAboutACubeDiagonalPermutesTheAxes) {
    const KM_Xform turn =
        KM_Xform::Rotation(2 * KM_PI / 3, KM_3dVector(1, 1, 1), KM_3dPoint::Origin);
    expectNear(turn * KM_3dVector::XAxis, KM_3dVector::YAxis, 1e-15);
    expectNear(turn * KM_3dVector::YAxis, KM_3dVector::ZAxis, 1e-15);
    expectNear(turn * KM_3dVector::ZAxis, KM_3dVector::XAxis, 1e-15);
}

TEST(Xform, RotationScalesSineAndCosineToOneTurn) {
    const KM_Xform turn = KM_Xform::Rotation(3.0, 4.0, KM_3dVector::ZAxis, KM_3dPoint::Origin);
    expectNear(turn * KM_3dVector::XAxis, KM_3dVector(0.8, 0.6, 0), 1e-15);
    EXPECT_TRUE(KM_Xform::Rotation(0.0, 0.0, KM_3dVector::ZAxis, KM_3dPoint::Origin).IsIdentity());
}

TEST(Xform, RotationAboutNoAxisIsTheIdentity) {
    EXPECT_TRUE(KM_Xform::Rotation(1.0, KM_3dVector(), KM_3dPoint(1, 2, 3)).IsIdentity());
    EXPECT_TRUE(KM_Xform::Rotation(1.0, KM_3dVector::ZAxis, KM_3dPoint::UnsetPoint).IsIdentity());
    EXPECT_TRUE(KM_Xform::Rotation(std::nan(""), KM_3dVector::ZAxis, {}).IsIdentity());
}

TEST(Xform, RotationBetweenDirectionsCarriesOneOntoTheOther) {
    RandomVectors random;
    for (int i = 0; i < 1000; ++i) {
        KM_3dVector start = random();
        KM_3dVector end = random();
        const KM_Xform turn = KM_Xform::Rotation(start, 5.0 * end, KM_3dPoint(1, 2, 3));
        start.Unitize();
        end.Unitize();
        expectNear(turn * start, end, 3e-15);
        const KM_3dVector axis = KM_CrossProduct(start, end);
        expectNear(turn * axis, axis, 3e-15);
        EXPECT_NEAR(turn.Determinant(), 1.0, 1e-14);
    }
}

TEST(Xform, RotationBetweenNearlyOppositeDirectionsIsAsGood) {
    RandomVectors random;
    for (const double angle : {1e-3, 1e-6, 1e-9, 1e-12, 1e-14}) {
        KM_3dVector start = random();
        start.Unitize();
        KM_3dVector aside;
        aside.PerpendicularTo(start);
        const KM_3dVector end = -start + angle * aside;
        const KM_Xform turn = KM_Xform::Rotation(start, end, KM_3dPoint::Origin);
        expectNear(turn * start, end / end.Length(), 3e-15);
        EXPECT_NEAR(turn.Determinant(), 1.0, 1e-14);
    }
}

TEST(Xform, RotationBetweenNearlyEqualDirectionsKeepsTheAngle) {
    const KM_Xform turn =
        KM_Xform::Rotation(KM_3dVector::XAxis, KM_3dVector(1, 1e-12, 0), KM_3dPoint::Origin);
    EXPECT_NEAR((turn * KM_3dVector::XAxis).y, 1e-12, 1e-26);
}

TEST(Xform, RotationBetweenEqualDirectionsIsExactlyTheIdentity) {
    RandomVectors random;
    for (int i = 0; i < 100; ++i) {
        const KM_3dVector v = random();
        EXPECT_TRUE(KM_Xform::Rotation(v, 3.0 * v, KM_3dPoint(7, 8, 9)).IsIdentity());
    }
    EXPECT_TRUE(KM_Xform::Rotation(KM_3dVector(), KM_3dVector::XAxis, {}).IsIdentity());
    EXPECT_TRUE(KM_Xform::Rotation(KM_3dVector::XAxis, KM_3dVector(), {}).IsIdentity());
}

TEST(Xform, RotationBetweenOppositeHorizontalDirectionsTurnsAboutWorldZ) {
    const KM_3dPoint center(4, 5, 6);
    for (const KM_3dVector& start : {KM_3dVector(1, 0, 0), KM_3dVector(3, -4, 0)}) {
        const KM_Xform turn = KM_Xform::Rotation(start, -2.0 * start, center);
        EXPECT_EQ(turn * KM_3dVector::ZAxis, KM_3dVector::ZAxis);
        EXPECT_EQ(turn * KM_3dVector::XAxis, -KM_3dVector::XAxis);
        EXPECT_EQ(turn * KM_3dVector::YAxis, -KM_3dVector::YAxis);
        EXPECT_EQ(turn * center, center);
    }
}

TEST(Xform, RotationBetweenOppositeDirectionsTurnsHalfRound) {
    RandomVectors random;
    for (int i = 0; i < 100; ++i) {
        const KM_3dVector v = random();
        const KM_Xform turn = KM_Xform::Rotation(v, -v, KM_3dPoint::Origin);
        expectNear(turn * v, -v, 1e-14);
        EXPECT_NEAR(turn.Determinant(), 1.0, 1e-14);
    }
    const KM_Xform over = KM_Xform::Rotation(KM_3dVector::ZAxis, -KM_3dVector::ZAxis, {});
    expectNear(over * KM_3dVector::ZAxis, -KM_3dVector::ZAxis, 1e-15);
}

TEST(Xform, ProjectionOntoTheGroundIsExact) {
    const KM_Xform project = KM_Xform::PlanarProjection(KM_xy_plane);
    const KM_3dPoint image = project * KM_3dPoint(0.1, -1e9, -0.3);
    EXPECT_EQ(image, KM_3dPoint(0.1, -1e9, 0));
    EXPECT_FALSE(std::signbit(image.z));
}

TEST(Xform, ProjectionLandsOnThePlaneAlongItsNormal) {
    RandomVectors random;
    for (int i = 0; i < 100; ++i) {
        const KM_Plane plane(KM_3dPoint(random()), random());
        const KM_3dPoint point(random());
        const KM_3dPoint image = KM_Xform::PlanarProjection(plane) * point;
        EXPECT_NEAR(plane.DistanceTo(image), 0.0, 1e-14);
        expectNear(point - image, plane.DistanceTo(point) * plane.Normal(), 1e-14);
    }
}

TEST(Xform, InverseUndoesTheMatrix) {
    RandomVectors random;
    for (int i = 0; i < 100; ++i) {
        KM_Xform xform = KM_Xform::Rotation(1.0 + i, random(), KM_3dPoint(random())) *
                         KM_Xform::Diagonal(2, 3, -0.5) * KM_Xform::Translation(random());
        if (i % 2 == 0)
            xform.m_xform[3][i % 3] = 0.25;
        KM_Xform inverse = xform;
        ASSERT_TRUE(inverse.Invert());
        EXPECT_TRUE((inverse * xform).IsIdentity(1e-12)) << i;
        EXPECT_TRUE((xform * inverse).IsIdentity(1e-12)) << i;
    }
}

TEST(Xform, InverseOfVeryUnevenScalesExists) {
    KM_Xform xform = KM_Xform::Translation(1e20, 0, 0) * KM_Xform::Diagonal(1e-9, 1, 1e9);
    ASSERT_TRUE(xform.Invert());
    EXPECT_NEAR(xform.m_xform[0][0], 1e9, 1e-6);
    EXPECT_NEAR(xform.m_xform[2][2], 1e-9, 1e-24);
    EXPECT_NEAR(xform.m_xform[0][3], -1e29, 1e14);
}

TEST(Xform, AFlatteningMatrixHasNoInverse) {
    KM_Xform ground = KM_Xform::PlanarProjection(KM_xy_plane);
    const KM_Xform before = ground;
    EXPECT_FALSE(ground.Invert());
    EXPECT_EQ(ground, before);
    KM_Xform slanted = KM_Xform::PlanarProjection(KM_Plane({1, 2, 3}, {1, 1, 1}));
    EXPECT_FALSE(slanted.Invert());
    EXPECT_NEAR(slanted.Determinant(), 0.0, 1e-15);
    KM_Xform broken;
    broken.m_xform[1][1] = std::nan("");
    EXPECT_FALSE(broken.Invert());
}

TEST(Xform, DeterminantIsTheVolumeScale) {
    EXPECT_EQ(KM_Xform::Diagonal(2, 3, 4).Determinant(), 24.0);
    EXPECT_EQ(KM_Xform::Diagonal(-1, 1, 1).Determinant(), -1.0);
    KM_Xform shear;
    shear.m_xform[0][1] = 5.0;
    EXPECT_EQ(shear.Determinant(), 1.0);
    // A permutation of rows 0 and 3 has the determinant -1.
    KM_Xform swap = KM_Xform::Diagonal(0, 1, 1);
    swap.m_xform[3][3] = 0.0;
    swap.m_xform[0][3] = swap.m_xform[3][0] = 1.0;
    EXPECT_EQ(swap.Determinant(), -1.0);
}

TEST(Xform, TransposeSwapsRowsAndColumns) {
    KM_Xform xform = KM_Xform::Translation(1, 2, 3);
    xform.Transpose();
    EXPECT_EQ(xform.m_xform[3][0], 1.0);
    EXPECT_EQ(xform.m_xform[3][2], 3.0);
    EXPECT_EQ(xform.m_xform[0][3], 0.0);
    EXPECT_FALSE(xform.IsAffine());
}

TEST(Xform, PerspectiveDividesAndAVanishingDivisorGivesNoPoint) {
    KM_Xform xform;
    xform.m_xform[3][2] = 1.0;
    xform.m_xform[3][3] = 0.0;
    EXPECT_EQ(xform * KM_3dPoint(4, 6, 2), KM_3dPoint(2, 3, 1));
    EXPECT_EQ(xform * KM_3dPoint(4, 6, 0), KM_3dPoint::UnsetPoint);
}

TEST(Xform, UnsetPointsStayUnset) {
    KM_3dPoint point = KM_3dPoint::UnsetPoint;
    point.Transform(KM_Xform::Translation(1, 1, 1));
    EXPECT_EQ(point, KM_3dPoint::UnsetPoint);
    KM_3dVector vector = KM_3dVector::UnsetVector;
    vector.Transform(KM_Xform::Diagonal(2, 2, 2));
    EXPECT_EQ(vector, KM_3dVector::UnsetVector);
}
