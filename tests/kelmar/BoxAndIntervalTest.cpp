#include "kelmar/KM_BoundingBox.h"
#include "kelmar/KM_Interval.h"
#include "kelmar/KM_Light.h"
#include "kelmar/KM_Line.h"

#include <gtest/gtest.h>

#include <cmath>

TEST(Interval, MinAndMaxAreTheSmallerAndLargerEnd) {
    const KM_Interval down(5, 2);
    EXPECT_EQ(down.Min(), 2.0);
    EXPECT_EQ(down.Max(), 5.0);
    EXPECT_EQ(down.Length(), -3.0);
    EXPECT_FALSE(down.IsIncreasing());
    EXPECT_TRUE(down.Includes(2) && down.Includes(5) && down.Includes(3));
    EXPECT_FALSE(down.Includes(1.99));
}

TEST(Interval, WithoutEndsItIsInvalid) {
    const KM_Interval unset;
    EXPECT_FALSE(unset.IsValid());
    EXPECT_EQ(unset.Min(), KM_UNSET_VALUE);
    EXPECT_EQ(unset.Length(), 0.0);
    EXPECT_FALSE(unset.Includes(0));
    EXPECT_FALSE(KM_Interval(0, std::nan("")).IsIncreasing());
}

TEST(Interval, FractionsReachBothEndsExactly) {
    const KM_Interval interval(0.1, 0.7);
    EXPECT_EQ(interval.ParameterAt(0), 0.1);
    EXPECT_EQ(interval.ParameterAt(1), 0.7);
    EXPECT_EQ(interval.NormalizedParameterAt(0.1), 0.0);
    EXPECT_EQ(interval.NormalizedParameterAt(0.7), 1.0);
    EXPECT_EQ(KM_Interval(2, 2).NormalizedParameterAt(2), 0.0);
}

TEST(BoundingBox, GrowsFromNothing) {
    KM_BoundingBox box;
    EXPECT_FALSE(box.IsValid());
    EXPECT_EQ(box.Center(), KM_3dPoint::UnsetPoint);
    EXPECT_EQ(box.Diagonal(), KM_3dVector::ZeroVector);
    EXPECT_TRUE(box.Set(KM_3dPoint(1, 2, 3)));
    EXPECT_TRUE(box.IsValid());
    EXPECT_TRUE(box.Set(KM_3dPoint(-1, 4, 0)));
    EXPECT_EQ(box.m_min, KM_3dPoint(-1, 2, 0));
    EXPECT_EQ(box.m_max, KM_3dPoint(1, 4, 3));
    EXPECT_EQ(box.Center(), KM_3dPoint(0, 3, 1.5));
    EXPECT_EQ(box.Diagonal(), KM_3dVector(2, 2, 3));
    EXPECT_EQ(box.Corner(5), KM_3dPoint(1, 2, 3));
    EXPECT_TRUE(box.Set(KM_3dPoint(9, 9, 9), false));
    EXPECT_EQ(box.m_min, KM_3dPoint(9, 9, 9));
}

TEST(BoundingBox, InvalidPointsAndEmptyBoxesAddNothing) {
    KM_BoundingBox box(KM_3dPoint(0, 0, 0), KM_3dPoint(1, 1, 1));
    const KM_BoundingBox before = box;
    EXPECT_FALSE(box.Set(KM_3dPoint::UnsetPoint));
    EXPECT_TRUE(box.Union(KM_BoundingBox::EmptyBoundingBox));
    EXPECT_EQ(box, before);
    KM_BoundingBox empty;
    EXPECT_FALSE(empty.Union(KM_BoundingBox()));
    EXPECT_TRUE(empty.Union(before));
    EXPECT_EQ(empty, before);
    EXPECT_TRUE(box.Includes(KM_3dPoint(1, 0, 0.5)));
    EXPECT_FALSE(box.Includes(KM_3dPoint(1, 0, 1.5)));
}

TEST(Line, FractionsReachBothEndsExactly) {
    const KM_Line line(KM_3dPoint(0.1, 0.2, 35), KM_3dPoint(0.7, -0.9, 35));
    EXPECT_EQ(line.PointAt(0), line.from);
    EXPECT_EQ(line.PointAt(1), line.to);
    EXPECT_EQ(line.PointAt(1.0 / 3.0).z, 35.0);
    EXPECT_EQ(KM_Line({0, 0, 0}, {3, 4, 0}).Length(), 5.0);
}

TEST(Light, IsAWhiteLightThatIsOnByDefault) {
    const KM_Light light;
    EXPECT_EQ(light.Style(), KM_LightStyle::unknown);
    EXPECT_EQ(light.Diffuse(), (KM_Color{255, 255, 255, 255}));
    EXPECT_EQ(light.Intensity(), 1.0);
    EXPECT_EQ(light.ShadowIntensity(), 1.0);
    EXPECT_TRUE(light.IsEnabled());
    EXPECT_TRUE(KM_UuidIsNil(light.LightId()));
    EXPECT_TRUE(light.LightName().IsEmpty());
}

TEST(Light, StyleSevenIsADirectionalLightOfTheWorld) {
    KM_Light light;
    light.SetStyle(7);
    EXPECT_EQ(light.Style(), KM_LightStyle::world_directional);
    EXPECT_TRUE(light.IsDirectionalLight());
    light.SetStyle(8);
    EXPECT_FALSE(light.IsDirectionalLight());
    for (const int unknown : {-1, 3, 11}) {
        light.SetStyle(unknown);
        EXPECT_EQ(light.Style(), KM_LightStyle::unknown);
    }
}

TEST(Light, DirectionKeepsItsLength) {
    KM_Light light;
    light.SetDirection(KM_3dVector(0, 0, -100));
    EXPECT_EQ(light.Direction(), KM_3dVector(0, 0, -100));
}

TEST(Light, IntensitiesStayInTheirRange) {
    KM_Light light;
    light.SetIntensity(-1);
    EXPECT_EQ(light.Intensity(), 0.0);
    light.SetIntensity(std::nan(""));
    EXPECT_EQ(light.Intensity(), 0.0);
    light.SetIntensity(2.5);
    EXPECT_EQ(light.Intensity(), 2.5);
    light.SetShadowIntensity(7);
    EXPECT_EQ(light.ShadowIntensity(), 1.0);
}

TEST(Light, CopiesCompareEqualUntilOneChanges) {
    KM_Light light;
    light.SetLightName(L"Sun");
    KM_Light copy = light;
    EXPECT_EQ(copy, light);
    copy.Enable(false);
    EXPECT_FALSE(copy == light);
}
