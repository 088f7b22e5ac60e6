#include "tests/zoetrix/fixtures/PlugInFixture.h"

#include <filesystem>

namespace {

namespace fs = std::filesystem;

class HostileDocument : public PlugInFixture {
protected:
    CQuarnCommand::result open(const fs::path& file) {
        return run(L"_-Open \"" + wide(fs::path(QUARN_SOURCE_DIR) / "tests/data/hostile" / file) +
                   L"\"");
    }

    /// Runs everything that looks at the record.
    void useAnimation() {
        for (const wchar_t* command :
             {L"_-PlayAnimation", L"_-ViewFirstFrame", L"_-ViewNextFrame", L"_-ViewPreviousFrame",
              L"_-ViewLastFrame", L"_-ViewFrameNumber 1", L"_-RecordAnimation _Enter"})
            run(command);
        CQuarnDoc& document = doc();
        KM_Viewport viewport;
        KM_Light light;
        IQnZoetrixDynamicAccess* access = Zoetrix_QuarnDynamicAccess();
        for (const int frame : {-2147483647 - 1, -1, 0, 1, 3, 4, 2147483647}) {
            const KM_3dmAnimationProperties& stored = access->AnimationProperties(document);
            access->AnimatedViewAtFrame(document, stored, frame, viewport);
            access->AnimatedSunAtFrame(document, stored, frame, light);
        }
    }
};

bool isPlayable(const KM_3dmAnimationProperties& record) {
    return record.FrameCount() > 0 && record.CameraPoints().Count() == record.FrameCount() &&
           record.TargetPoints().Count() == record.FrameCount();
}

} // namespace

TEST_F(HostileDocument, ADamagedFileIsRefusedAndTheOpenDocumentKeepsItsAnimation) {
    setUpCameraFrames(4);
    const unsigned int document = doc().RuntimeSerialNumber();
    for (const char* file :
         {"cut_short.quarn", "flipped_bit.quarn", "huge_count.quarn", "hugest_count.quarn",
          "nan_point.quarn", "newer_version.quarn", "no_mesh.quarn", "text.quarn"}) {
        EXPECT_EQ(CQuarnCommand::failure, open(file)) << file;
        EXPECT_EQ(document, doc().RuntimeSerialNumber()) << file;
        EXPECT_EQ(4, record().FrameCount()) << file;
    }
}

TEST_F(HostileDocument, ADamagedRecordInAWholeFileLeavesNothingToPlay) {
    for (const char* file : {"capture_type_17.quarn", "huge_record_count.quarn"}) {
        setUpCameraFrames(4);
        EXPECT_EQ(CQuarnCommand::success, open(file)) << file;
        EXPECT_FALSE(isPlayable(record())) << file;
        useAnimation();
    }
}

TEST_F(HostileDocument, OddNumbersInARecordAreSurvivedByEveryCommand) {
    for (const char* file :
         {"frame_count_unlike_points.quarn", "frame_number_int_min.quarn", "view_gone.quarn"}) {
        EXPECT_EQ(CQuarnCommand::success, open(file)) << file;
        EXPECT_EQ(3, record().CameraPoints().Count()) << file;
        useAnimation();
    }
}
