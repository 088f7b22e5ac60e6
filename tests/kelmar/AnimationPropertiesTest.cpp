#include "kelmar/KM_AnimationProperties.h"
#include "tests/kelmar/FilledRecord.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <initializer_list>
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

namespace {

constexpr KM_UUID rail{0x11111111, 0x2222, 0x3333, {1, 2, 3, 4, 5, 6, 7, 8}};
constexpr KM_UUID gaze{0x44444444, 0x5555, 0x6666, {8, 7, 6, 5, 4, 3, 2, 1}};

Record following(Record::CaptureTypes type, const KM_UUID& camera_path,
                 const KM_UUID& target_path) {
    Record record;
    record.SetCaptureType(type);
    record.SetCameraPathId(camera_path);
    record.SetTargetPathId(target_path);
    return record;
}

void expectFollowed(const Record& record, std::initializer_list<KM_UUID> curves) {
    EXPECT_EQ(record.FollowsCurves(), curves.size() > 0);
    const KM_SimpleArray<KM_UUID> followed = record.FollowedCurves();
    EXPECT_TRUE(std::equal(followed.begin(), followed.end(), curves.begin(), curves.end()));
}

} // namespace

TEST(AnimationProperties, SunStudiesAreThoseOfADayAndOfASeason) {
    const std::pair<Record::CaptureTypes, bool> kinds[] = {
        {Record::path, false},       {Record::turntable, false},   {Record::flythrough, false},
        {Record::one_day_sun, true}, {Record::seasonal_sun, true}, {Record::none, false}};
    for (const auto& [kind, is_sun_study] : kinds) {
        Record record;
        record.SetCaptureType(kind);
        EXPECT_EQ(record.IsSunStudy(), is_sun_study) << kind;
    }
}

TEST(AnimationProperties, ARecordIsPlayableWithOneCameraAndOneTargetPointForEachFrame) {
    Record record;
    EXPECT_FALSE(record.IsPlayable());
    record.SetFrameCount(1);
    record.CameraPoints().Append(KM_3dPoint(1, 2, 3));
    EXPECT_FALSE(record.IsPlayable()) << "without a target";
    record.TargetPoints().Append(KM_3dPoint(0, 0, 0));
    EXPECT_TRUE(record.IsPlayable());
    record.TargetPoints().Append(KM_3dPoint(0, 0, 0));
    EXPECT_FALSE(record.IsPlayable()) << "with a target too many";
    record.CameraPoints().Append(KM_3dPoint(1, 2, 3));
    EXPECT_FALSE(record.IsPlayable()) << "with a point of each too many";
    record.SetFrameCount(2);
    EXPECT_TRUE(record.IsPlayable());
}

TEST(AnimationProperties, NothingIsPlayableWithoutAFrame) {
    for (const int frame_count : {0, -1}) {
        Record record;
        record.SetFrameCount(frame_count);
        EXPECT_FALSE(record.IsPlayable()) << frame_count;
    }
}

TEST(AnimationProperties, APathFollowsItsCurvesWhereCameraAndTargetHaveOne) {
    expectFollowed(following(Record::path, rail, gaze), {rail, gaze});
    expectFollowed(following(Record::path, rail, KM_nil_uuid), {});
    expectFollowed(following(Record::path, KM_nil_uuid, gaze), {});
}

TEST(AnimationProperties, AFlythroughFollowsTheCurveOfItsCameraAlone) {
    expectFollowed(following(Record::flythrough, rail, KM_nil_uuid), {rail});
    expectFollowed(following(Record::flythrough, rail, gaze), {rail});
    expectFollowed(following(Record::flythrough, KM_nil_uuid, gaze), {});
}

TEST(AnimationProperties, WhatMovesOtherwiseFollowsNoCurve) {
    for (const auto type :
         {Record::turntable, Record::one_day_sun, Record::seasonal_sun, Record::none})
        expectFollowed(following(type, rail, gaze), {});
}
