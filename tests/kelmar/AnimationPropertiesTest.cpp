#include "kelmar/KM_AnimationProperties.h"
#include "tests/kelmar/FilledRecord.h"

#include <gtest/gtest.h>

#include <type_traits>
#include <utility>

using Record = KM_3dmAnimationProperties;

TEST(AnimationProperties, NewRecordHoldsTheDefaults) {
    Record record;
    EXPECT_EQ(record.CaptureType(), Record::none);
    EXPECT_TRUE(record.FileExtension() == L"jpg");
    EXPECT_TRUE(record.CaptureMethod().IsEmpty());
    EXPECT_TRUE(record.ViewportName().IsEmpty());
    EXPECT_TRUE(record.HtmlFilename().IsEmpty());
    EXPECT_TRUE(record.FolderName().IsEmpty());
    EXPECT_TRUE(KM_UuidIsNil(record.DisplayMode()));
    EXPECT_TRUE(KM_UuidIsNil(record.CameraPathId()));
    EXPECT_TRUE(KM_UuidIsNil(record.TargetPathId()));
    EXPECT_EQ(record.CameraPoints().Count(), 0);
    EXPECT_EQ(record.TargetPoints().Count(), 0);
    EXPECT_EQ(record.Images().Count(), 0);
    EXPECT_EQ(record.Dates().Count(), 0);
    EXPECT_EQ(record.FrameCount(), 100);
    EXPECT_EQ(record.CurrentFrame(), 1);
    EXPECT_EQ(record.Latitude(), 51.2838);
    EXPECT_EQ(record.Longitude(), 0.0);
    EXPECT_EQ(record.NorthAngle(), 0.0);
    EXPECT_EQ(record.LightIndex(), -1);
    EXPECT_FALSE(record.RenderFull());
    EXPECT_FALSE(record.RenderPreview());
}

TEST(AnimationProperties, NewStudyRunsFromJune2010ToJune2012BySixToEighteen) {
    const Record record;
    EXPECT_EQ(record.StartDay(), 1);
    EXPECT_EQ(record.StartMonth(), 6);
    EXPECT_EQ(record.StartYear(), 2010);
    EXPECT_EQ(record.EndDay(), 1);
    EXPECT_EQ(record.EndMonth(), 6);
    EXPECT_EQ(record.EndYear(), 2012);
    EXPECT_EQ(record.StartHour(), 6);
    EXPECT_EQ(record.StartMinutes(), 0);
    EXPECT_EQ(record.StartSeconds(), 0);
    EXPECT_EQ(record.EndHour(), 18);
    EXPECT_EQ(record.EndMinutes(), 0);
    EXPECT_EQ(record.EndSeconds(), 59);
    EXPECT_EQ(record.DaysBetweenFrames(), 30);
    EXPECT_EQ(record.MinutesBetweenFrames(), 30);
}

TEST(AnimationProperties, CaptureTypesHaveTheirStoredValues) {
    EXPECT_EQ(Record::path, 0);
    EXPECT_EQ(Record::turntable, 1);
    EXPECT_EQ(Record::flythrough, 2);
    EXPECT_EQ(Record::one_day_sun, 3);
    EXPECT_EQ(Record::seasonal_sun, 4);
    EXPECT_EQ(Record::none, 5);
    EXPECT_EQ(sizeof(Record::CaptureTypes), 4U);
}

TEST(AnimationProperties, EverySetterReachesItsOwnField) {
    Record record = filledRecord();
    expectFilled(record);
}

TEST(AnimationProperties, CopyAndAssignmentTakeEveryField) {
    const Record record = filledRecord();
    Record copy(record);
    expectFilled(copy);
    Record assigned;
    EXPECT_EQ(&(assigned = record), &assigned);
    expectFilled(assigned);
}

TEST(AnimationProperties, CopiesShareNoStorage) {
    Record record = filledRecord();
    Record copy(record);
    copy.CameraPoints()[0] = KM_3dPoint(9, 9, 9);
    copy.TargetPoints().Empty();
    copy.Images()[0] = L"other";
    copy.Dates().AppendNew() = L"more";
    copy.SetFileExtension(L"bmp");
    expectFilled(record);
}

TEST(AnimationProperties, ARecordSurvivesBeingAssignedToItself) {
    Record record = filledRecord();
    const Record& self = record;
    record = self;
    expectFilled(record);
}

TEST(AnimationProperties, PointsOfAConstRecordCanBeReadButNotChanged) {
    using ConstPoints = decltype(std::declval<const Record&>().CameraPoints());
    EXPECT_TRUE((std::is_same_v<ConstPoints, const KM_3dPointArray&>));
    const Record record = filledRecord();
    EXPECT_EQ(record.CameraPoints().Count(), 1);
    EXPECT_EQ(record.TargetPoints().Count(), 1);
}
