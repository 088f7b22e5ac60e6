#include "host/app/StudyMoments.h"
#include "host/commands/AnimationText.h"
#include "host/document/file/DocumentContent.h"
#include "tests/host/app/TestCommand.h"
#include "tests/host/document/DocumentFixtures.h"

#include <gmock/gmock.h>

namespace quarn::test {
namespace {

using testing::HasSubstr;

class SunStudyCommands : public HostTest {
protected:
    /// A study of Auckland with one frame an hour, by the whole hours of its longitude: UTC+11.
    static KM_3dmAnimationProperties study(int day, int first_hour, int last_hour) {
        KM_3dmAnimationProperties record;
        record.SetCaptureType(KM_3dmAnimationProperties::one_day_sun);
        record.SetLatitude(-36.85);
        record.SetLongitude(174.76);
        record.SetStartDay(day);
        record.SetStartHour(first_hour);
        record.SetEndHour(last_hour);
        for (int hour = first_hour; hour <= last_hour; ++hour) {
            record.Dates().Append(
                KM_wString::FormatToString(L"2026-12-%02d %02d:00:00", day, hour));
            record.CameraPoints().Append(KM_3dPoint(0, 1, 0));
            record.TargetPoints().Append(KM_3dPoint::Origin);
        }
        record.SetFrameCount(last_hour - first_hour + 1);
        return record;
    }

    Document& document() { return Document::of(session.document()); }

    /// "2026-12-21T01:00:00 NZDT"
    std::string toldTime(int frame) {
        const auto sun = sunOfFrame(keeper.record, frame, studyZone(document(), keeper.record));
        return sun ? sun->time + " " + sun->zone : "nothing";
    }

    RecordKeeper keeper;
};

TEST_F(SunStudyCommands, PartsStandBehindEachOtherFromTheFirstStartToTheLastEnd) {
    keeper.record = study(20, 22, 23);
    ASSERT_EQ(run(L"_-JoinSunStudy _Keep"), CQuarnCommand::success);
    keeper.record = study(21, 0, 2);
    ASSERT_EQ(run(L"_-JoinSunStudy _Append"), CQuarnCommand::success);
    ASSERT_EQ(keeper.record.FrameCount(), 5);
    ASSERT_EQ(keeper.record.Dates().Count(), 5);
    EXPECT_EQ(keeper.record.CameraPoints().Count(), 5);
    EXPECT_EQ(keeper.record.TargetPoints().Count(), 5);
    EXPECT_STREQ(keeper.record.Dates()[1], L"2026-12-20 23:00:00");
    EXPECT_STREQ(keeper.record.Dates()[2], L"2026-12-21 00:00:00");
    EXPECT_EQ(keeper.record.StartDay(), 20);
    EXPECT_EQ(keeper.record.StartHour(), 22);
    EXPECT_EQ(keeper.record.EndHour(), 2);
    keeper.record = study(22, 5, 5);
    ASSERT_EQ(run(L"_-JoinSunStudy _Append"), CQuarnCommand::success);
    EXPECT_EQ(keeper.record.FrameCount(), 6);
}

TEST_F(SunStudyCommands, NothingIsJoinedThatDoesNotBelongTogether) {
    keeper.record = study(20, 22, 23);
    EXPECT_EQ(run(L"_-JoinSunStudy _Append"), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("No sun study was kept"));
    ASSERT_EQ(run(L"_-JoinSunStudy _Keep"), CQuarnCommand::success);
    keeper.record.SetLatitude(-36.0);
    EXPECT_EQ(run(L"_-JoinSunStudy _Append"), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("another kind or place"));
    EXPECT_EQ(keeper.record.FrameCount(), 2);
    keeper.record.SetCaptureType(KM_3dmAnimationProperties::turntable);
    EXPECT_EQ(run(L"_-JoinSunStudy _Keep"), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("There is no sun study"));
}

TEST_F(SunStudyCommands, FramesAreToldByTheClocksOfTheirPlace) {
    keeper.record = study(20, 22, 23);
    EXPECT_EQ(toldTime(0), "2026-12-20T22:00:00 UTC+11");
    ASSERT_EQ(run(L"_-SunStudyPlace \"Auckland, New Zealand\" \"pacific/auckland\""),
              CQuarnCommand::success);
    EXPECT_EQ(toldTime(0), "2026-12-21T00:00:00 NZDT");
    EXPECT_EQ(toldTime(1), "2026-12-21T01:00:00 NZDT");
    ASSERT_TRUE(document().studiedPlace());
    EXPECT_STREQ(document().studiedPlace()->city, L"Auckland, New Zealand");
    EXPECT_STREQ(document().studiedPlace()->zone, L"Pacific/Auckland");
}

TEST_F(SunStudyCommands, ClocksOfAnotherPlaceDoNotCount) {
    keeper.record = study(20, 22, 23);
    ASSERT_EQ(run(L"_-SunStudyPlace \"Auckland, New Zealand\" \"Pacific/Auckland\""),
              CQuarnCommand::success);
    keeper.record.SetLongitude(150.0);
    EXPECT_EQ(toldTime(0), "2026-12-20T22:00:00 UTC+10");
    EXPECT_FALSE(studyZone(document(), keeper.record));
}

TEST_F(SunStudyCommands, NameOfAnotherPlaceIsNeitherShownNorSaved) {
    keeper.record = study(20, 22, 23);
    ASSERT_EQ(run(L"_-SunStudyPlace \"Auckland, New Zealand\" \"Pacific/Auckland\""),
              CQuarnCommand::success);
    ASSERT_EQ(run(L"_-List"), CQuarnCommand::success);
    EXPECT_THAT(printed(), HasSubstr("Auckland, New Zealand, by the clocks of Pacific/Auckland"));
    EXPECT_TRUE(document().content(false).studied_place);
    keeper.record.SetLatitude(-36.0);
    EXPECT_FALSE(document().studiedPlace());
    EXPECT_FALSE(document().content(false).studied_place);
    EXPECT_THAT(animationText(document()).ToUtf8(), testing::Not(HasSubstr("Auckland")));
}

TEST_F(SunStudyCommands, LabelsOfDaysThatDoNotExistAreToldAsTheyAre) {
    keeper.record = study(20, 22, 22);
    ASSERT_EQ(run(L"_-SunStudyPlace \"Auckland\" \"Pacific/Auckland\""), CQuarnCommand::success);
    keeper.record.Dates()[0] = L"2026-02-31 10:00:00";
    EXPECT_EQ(toldTime(0), "2026-02-31T10:00:00 UTC+11");
}

TEST_F(SunStudyCommands, PlaceWithAnUnknownZoneIsRefused) {
    EXPECT_EQ(run(L"_-SunStudyPlace \"Auckland\" \"Pacific/Aukland\""), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("Did you mean Pacific/Auckland?"));
    EXPECT_FALSE(document().studiedPlace());
}

TEST_F(HostTest, SunStudiesNeedAPlugInThatKeepsThem) {
    EXPECT_EQ(run(L"_-JoinSunStudy _Keep"), CQuarnCommand::failure);
    EXPECT_EQ(run(L"_-SunStudyPlace \"Berlin\" \"Europe/Berlin\""), CQuarnCommand::failure);
}

} // namespace
} // namespace quarn::test
