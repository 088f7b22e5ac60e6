#include "kelmar/KM_AnimationProperties.h"

#include <gtest/gtest.h>

#include <type_traits>
#include <utility>

using Record = KM_3dmAnimationProperties;

namespace {

constexpr KM_UUID some_id = {1, 2, 3, {4, 5, 6, 7, 8, 9, 10, 11}};
constexpr KM_UUID camera_id = {2, 2, 3, {4, 5, 6, 7, 8, 9, 10, 11}};
constexpr KM_UUID target_id = {3, 2, 3, {4, 5, 6, 7, 8, 9, 10, 11}};

// Every field gets a value of its own.
Record filledRecord() {
    Record record;
    record.SetCaptureType(Record::seasonal_sun);
    record.SetFileExtension(L"png");
    record.SetCaptureMethod(L"RenderFull");
    record.SetViewportName(L"Perspective");
    record.SetHtmlFilename(L"Summer");
    record.SetDisplayMode(some_id);
    record.CameraPoints().Append(KM_3dPoint(1, 2, 3));
    record.TargetPoints().Append(KM_3dPoint(4, 5, 6));
    record.SetFrameCount(11);
    record.SetCurrentFrame(12);
    record.SetCameraPathId(camera_id);
    record.SetTargetPathId(target_id);
    record.SetLatitude(13.5);
    record.SetLongitude(14.5);
    record.SetNorthAngle(15.5);
    record.SetStartDay(16);
    record.SetStartMonth(17);
    record.SetStartYear(18);
    record.SetEndDay(19);
    record.SetEndMonth(20);
    record.SetEndYear(21);
    record.SetStartHour(22);
    record.SetStartMinutes(23);
    record.SetStartSeconds(24);
    record.SetEndHour(25);
    record.SetEndMinutes(26);
    record.SetEndSeconds(27);
    record.SetDaysBetweenFrames(28);
    record.SetMinutesBetweenFrames(29);
    record.SetLightIndex(30);
    record.SetFolderName(L"/tmp/out");
    record.Images().AppendNew() = L"Summer000.png";
    record.Dates().AppendNew() = L"1 June";
    record.SetRenderFull(true);
    record.SetRenderPreview(true);
    return record;
}

void expectFilled(Record& record) {
    EXPECT_EQ(record.CaptureType(), Record::seasonal_sun);
    EXPECT_TRUE(record.FileExtension() == L"png");
    EXPECT_TRUE(record.CaptureMethod() == L"RenderFull");
    EXPECT_TRUE(record.ViewportName() == L"Perspective");
    EXPECT_TRUE(record.HtmlFilename() == L"Summer");
    EXPECT_EQ(record.DisplayMode(), some_id);
    EXPECT_EQ(record.CameraPoints(), KM_3dPointArray({KM_3dPoint(1, 2, 3)}));
    EXPECT_EQ(record.TargetPoints(), KM_3dPointArray({KM_3dPoint(4, 5, 6)}));
    EXPECT_EQ(record.FrameCount(), 11);
    EXPECT_EQ(record.CurrentFrame(), 12);
    EXPECT_EQ(record.CameraPathId(), camera_id);
    EXPECT_EQ(record.TargetPathId(), target_id);
    EXPECT_EQ(record.Latitude(), 13.5);
    EXPECT_EQ(record.Longitude(), 14.5);
    EXPECT_EQ(record.NorthAngle(), 15.5);
    EXPECT_EQ(record.StartDay(), 16);
    EXPECT_EQ(record.StartMonth(), 17);
    EXPECT_EQ(record.StartYear(), 18);
    EXPECT_EQ(record.EndDay(), 19);
    EXPECT_EQ(record.EndMonth(), 20);
    EXPECT_EQ(record.EndYear(), 21);
    EXPECT_EQ(record.StartHour(), 22);
    EXPECT_EQ(record.StartMinutes(), 23);
    EXPECT_EQ(record.StartSeconds(), 24);
    EXPECT_EQ(record.EndHour(), 25);
    EXPECT_EQ(record.EndMinutes(), 26);
    EXPECT_EQ(record.EndSeconds(), 27);
    EXPECT_EQ(record.DaysBetweenFrames(), 28);
    EXPECT_EQ(record.MinutesBetweenFrames(), 29);
    EXPECT_EQ(record.LightIndex(), 30);
    EXPECT_TRUE(record.FolderName() == L"/tmp/out");
    ASSERT_EQ(record.Images().Count(), 1);
    EXPECT_TRUE(record.Images()[0] == L"Summer000.png");
    ASSERT_EQ(record.Dates().Count(), 1);
    EXPECT_TRUE(record.Dates()[0] == L"1 June");
    EXPECT_TRUE(record.RenderFull());
    EXPECT_TRUE(record.RenderPreview());
}

} // namespace

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
