#include "host/app/FileOptionsAccess.h"
#include "kelmar/KM_BinaryArchive.h"
#include "tests/zoetrix/fixtures/PlugInFixture.h"
#include "zoetrix/plugin/ZoetrixPlugIn.h"

namespace {

using quarn::FileOptionsAccess;
using Bytes = std::vector<std::uint8_t>;

class DocumentChunk : public PlugInFixture {
protected:
    CQuarnFileWriteOptions whole(int version = KM_CURRENT_ARCHIVE_VERSION) {
        return FileOptionsAccess::forWriting(false, version, doc().RuntimeSerialNumber());
    }
    CQuarnFileWriteOptions selectedOnly() {
        return FileOptionsAccess::forWriting(true, KM_CURRENT_ARCHIVE_VERSION,
                                             doc().RuntimeSerialNumber());
    }

    /// What the plug-in writes of the record as it is now.
    Bytes written(const CQuarnFileWriteOptions& options,
                  int archive_version = KM_CURRENT_ARCHIVE_VERSION) {
        KM_BinaryArchive archive = KM_BinaryArchive::ForWriting(archive_version);
        EXPECT_TRUE(ZoetrixPlugIn().WriteDocument(doc(), archive, options));
        return archive.TakeBytes();
    }

    /// Hands the plug-in the bytes as the host does: behind the chunk's version.
    bool read(const Bytes& bytes, unsigned int modes) {
        KM_BinaryArchive archive = KM_BinaryArchive::ForReading(bytes);
        int major = 0;
        int minor = 0;
        EXPECT_TRUE(archive.Read3dmChunkVersion(major, minor));
        return ZoetrixPlugIn().ReadDocument(doc(), archive, FileOptionsAccess::forReading(modes));
    }
};

bool hasNothingToPlay(const KM_3dmAnimationProperties& record) {
    return record.CaptureType() == KM_3dmAnimationProperties::none && record.FrameCount() == 0 &&
           record.CameraPoints().IsEmpty() && record.TargetPoints().IsEmpty();
}

} // namespace

TEST_F(DocumentChunk, ANewDocumentHasNoneToWrite) {
    EXPECT_FALSE(ZoetrixPlugIn().CallWriteDocument(whole()));
}

TEST_F(DocumentChunk, AnAnimationIsToBeWritten) {
    setUpCameraFrames(3);
    EXPECT_TRUE(ZoetrixPlugIn().CallWriteDocument(whole()));
}

TEST_F(DocumentChunk, AnAnimationWithoutTargetsOrWithoutCamerasIsNotWritten) {
    setUpCameraFrames(100);
    const KM_3dPointArray targets = record().TargetPoints();
    record().TargetPoints().SetCount(0);
    EXPECT_EQ(100, record().CameraPoints().Count());
    EXPECT_FALSE(ZoetrixPlugIn().CallWriteDocument(whole()));

    record().TargetPoints() = targets;
    EXPECT_TRUE(ZoetrixPlugIn().CallWriteDocument(whole()));
    record().CameraPoints().SetCount(0);
    EXPECT_FALSE(ZoetrixPlugIn().CallWriteDocument(whole()));
}

TEST_F(DocumentChunk, PointsOfNoKindOfAnimationAreNotWritten) {
    setUpCameraFrames(3);
    record().SetCaptureType(KM_3dmAnimationProperties::none);
    EXPECT_FALSE(ZoetrixPlugIn().CallWriteDocument(whole()));
}

TEST_F(DocumentChunk, IsNoneWhereOnlySelectedObjectsAreSaved) {
    setUpCameraFrames(3);
    EXPECT_FALSE(ZoetrixPlugIn().CallWriteDocument(selectedOnly()));
    EXPECT_TRUE(written(selectedOnly()).empty());
}

TEST_F(DocumentChunk, VersionsBelowFourHaveNoneAndWritingSucceedsWithoutABytes) {
    setUpCameraFrames(3);
    EXPECT_FALSE(ZoetrixPlugIn().CallWriteDocument(whole(3)));
    EXPECT_TRUE(written(whole(3)).empty());
    EXPECT_TRUE(written(whole(4), 3).empty()) << "the archive is of an older file";

    EXPECT_TRUE(ZoetrixPlugIn().CallWriteDocument(whole(4)));
    EXPECT_FALSE(written(whole(4), 4).empty());
}

TEST_F(DocumentChunk, IsNoneForADocumentThatIsNotOpen) {
    setUpCameraFrames(3);
    const auto options =
        FileOptionsAccess::forWriting(false, KM_CURRENT_ARCHIVE_VERSION, 0xFFFFFFFFU);
    EXPECT_FALSE(ZoetrixPlugIn().CallWriteDocument(options));
}

TEST_F(DocumentChunk, BeginsWithItsVersion) {
    setUpCameraFrames(3);
    const Bytes bytes = written(whole());
    const Bytes five_zero = {5, 0, 0, 0, 0, 0, 0, 0};
    ASSERT_GT(bytes.size(), five_zero.size());
    EXPECT_EQ(five_zero, Bytes(bytes.begin(), bytes.begin() + 8));
}

TEST_F(DocumentChunk, WritingTellsAnArchiveThatFails) {
    setUpCameraFrames(3);
    KM_BinaryArchive no_room = KM_BinaryArchive::ForWriting(KM_CURRENT_ARCHIVE_VERSION, 7);
    EXPECT_FALSE(ZoetrixPlugIn().WriteDocument(doc(), no_room, whole()));
    KM_BinaryArchive room_for_version = KM_BinaryArchive::ForWriting(KM_CURRENT_ARCHIVE_VERSION, 8);
    EXPECT_FALSE(ZoetrixPlugIn().WriteDocument(doc(), room_for_version, whole()));
}

TEST_F(DocumentChunk, OpeningAFileReplacesTheRecord) {
    setUpCameraFrames(3);
    record().SetHtmlFilename(L"Walk");
    const Bytes bytes = written(whole());
    setUpCameraFrames(7);
    record().SetHtmlFilename(L"Other");

    EXPECT_TRUE(read(bytes, CQuarnFileReadOptions::open_mode));
    EXPECT_EQ(L"Walk", record().HtmlFilename().View());
    ASSERT_EQ(3, record().CameraPoints().Count());
    EXPECT_EQ(cameraOfFrame(2), record().CameraPoints()[2]);
    EXPECT_EQ(targetOfFrame(2), record().TargetPoints()[2]);
}

TEST_F(DocumentChunk, ImportingAFileReplacesTheRecordToo) {
    setUpCameraFrames(3);
    const Bytes bytes = written(whole());
    for (const auto mode :
         {CQuarnFileReadOptions::import_mode, CQuarnFileReadOptions::insert_mode}) {
        setUpSunFrames(5);
        EXPECT_TRUE(read(bytes, mode));
        EXPECT_EQ(3, record().FrameCount());
        EXPECT_EQ(3, record().CameraPoints().Count());
        EXPECT_EQ(KM_3dmAnimationProperties::turntable, record().CaptureType());
    }
}

TEST_F(DocumentChunk, AChunkThatCannotBeReadLeavesNothingToPlayAfterAnImport) {
    setUpCameraFrames(3);
    Bytes bytes = written(whole());
    bytes.back() ^= 1;
    for (const auto mode :
         {CQuarnFileReadOptions::import_mode, CQuarnFileReadOptions::insert_mode}) {
        setUpCameraFrames(5);
        EXPECT_FALSE(read(bytes, mode));
        EXPECT_TRUE(hasNothingToPlay(record()));
    }
}

TEST_F(DocumentChunk, AChunkThatCannotBeReadChangesNothingOnOpening) {
    setUpCameraFrames(3);
    Bytes bytes = written(whole());
    bytes.back() ^= 1;
    EXPECT_FALSE(read(bytes, CQuarnFileReadOptions::open_mode));
    EXPECT_EQ(3, record().FrameCount()) << "the host empties the record before it opens a file";
}
