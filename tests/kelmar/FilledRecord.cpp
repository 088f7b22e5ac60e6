#include "tests/kelmar/FilledRecord.h"

#include <gtest/gtest.h>

using Record = KM_3dmAnimationProperties;

namespace {

constexpr KM_UUID some_id = {1, 2, 3, {4, 5, 6, 7, 8, 9, 10, 11}};
constexpr KM_UUID camera_id = {2, 2, 3, {4, 5, 6, 7, 8, 9, 10, 11}};
constexpr KM_UUID target_id = {3, 2, 3, {4, 5, 6, 7, 8, 9, 10, 11}};

} // namespace

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
