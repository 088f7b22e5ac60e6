#include "host/commands/StudyPlace.h"

#include "import/ImportedModel.h"
#include "tests/host/app/TestCommand.h"
#include "tests/host/document/DocumentFixtures.h"

#include <gmock/gmock.h>

namespace quarn::test {
namespace {

class StudyPlaceTest : public HostTest {
protected:
    Document& document() { return Document::of(session.document()); }
    std::string offer() { return offerStudyPlace(document(), {59.913868, 10.752245, 12.5}); }

    RecordKeeper keeper;
};

TEST_F(StudyPlaceTest, TheRecordTakesThePlaceAndKeepsAllElse) {
    keeper.record.SetCaptureType(KM_3dmAnimationProperties::turntable);
    keeper.record.SetFrameCount(24);
    EXPECT_EQ(offer(), "Sun studies begin with the place that the file states: latitude 59.91, "
                       "longitude 10.75, north angle 12.5.");
    EXPECT_EQ(keeper.record.Latitude(), 59.913868);
    EXPECT_EQ(keeper.record.Longitude(), 10.752245);
    EXPECT_EQ(keeper.record.NorthAngle(), 12.5);
    EXPECT_EQ(keeper.record.CaptureType(), KM_3dmAnimationProperties::turntable);
    EXPECT_EQ(keeper.record.FrameCount(), 24);
}

TEST_F(StudyPlaceTest, APlaceThatTheDocumentHasStays) {
    keeper.record.SetLongitude(-71.1);
    EXPECT_EQ(offer(), "");
    EXPECT_EQ(keeper.record.Longitude(), -71.1);
}

TEST_F(StudyPlaceTest, ASunStudyKeepsItsPlaceWhateverThatIs) {
    keeper.record.SetCaptureType(KM_3dmAnimationProperties::one_day_sun);
    EXPECT_EQ(offer(), "");
    EXPECT_EQ(keeper.record.Latitude(), KM_3dmAnimationProperties().Latitude());
}

TEST(StudyPlace, WithoutAnyoneWhoKeepsARecordNothingIsTold) {
    ScriptedFrontEnd front_end;
    Session session(front_end, {{}, {}, "C", {}});
    EXPECT_EQ(offerStudyPlace(Document::of(session.document()), {1, 2, 3}), "");
}

} // namespace
} // namespace quarn::test
