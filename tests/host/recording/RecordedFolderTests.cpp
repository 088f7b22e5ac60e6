#include "host/recording/RecordedFolder.h"

#include "host/recording/RecordingFile.h"
#include "tests/support/TempFolder.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace quarn::test {
namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

class Folder : public testing::Test {
protected:
    void writeFrames(const std::string& name, int first, int count,
                     const std::string& extension = "jpg") const {
        for (int frame = first; frame < first + count; ++frame) {
            std::string digits = std::to_string(frame);
            digits.insert(0, digits.size() < 3 ? 3 - digits.size() : 0, '0');
            writeFile(folder / (name + digits + "." + extension), "picture");
        }
    }
    FramesManifest writeManifest(const std::string& name, int frames) const {
        FramesManifest manifest;
        manifest.name = name;
        manifest.kind = "turntable";
        manifest.frames = frames;
        manifest.extension = "jpg";
        manifest.frame_rate = 12;
        for (int frame = 0; frame < frames; ++frame)
            manifest.images.push_back(
                {frame, name + "00" + std::to_string(frame) + ".jpg", 7, 0, {}, {}});
        EXPECT_TRUE(writeFramesManifest(folder / manifestName(name), manifest).ok());
        return manifest;
    }
    void writeRecording(const std::string& name, int frames) const {
        RecordingFile recording;
        recording.animation = name;
        recording.settings = {"path", frames, 64, 48, "Shaded", "jpg"};
        ASSERT_TRUE(writeRecordingFile(folder / (name + ".recording"), recording).ok());
    }
    /// What is wrong, where nothing can be read.
    std::string messageFor(const std::filesystem::path& path) const {
        const auto read = readRecordedFolder(path);
        return read ? "read" : read.message();
    }
    RecordedFolder read() const { return readRecordedFolder(folder.path()).value(); }

    const TempFolder folder;
};

std::vector<std::string> filesOf(const RecordedFolder& recorded) {
    std::vector<std::string> files;
    for (const ManifestFrame& frame : recorded.manifest.images)
        files.push_back(frame.file);
    return files;
}

TEST_F(Folder, IsReadByItsManifest) {
    writeFrames("walk", 0, 3);
    const FramesManifest written = writeManifest("walk", 3);
    EXPECT_TRUE(read().has_manifest);
    EXPECT_EQ(read().manifest, written);
    EXPECT_THAT(read().warnings, IsEmpty());
}

TEST_F(Folder, TellsWhichFramesAreMissingEmptyOrChanged) {
    writeFrames("walk", 0, 4);
    writeManifest("walk", 5);
    writeFile(folder / "walk001.jpg", "");
    writeFile(folder / "walk002.jpg", "pict");
    EXPECT_THAT(filesOf(read()), ElementsAre("walk000.jpg", "walk002.jpg", "walk003.jpg"));
    EXPECT_THAT(read().warnings,
                ElementsAre("2 of 5 frames are missing in " + folder.path().string() +
                                "; the first is number 1.",
                            "1 of 3 frames in " + folder.path().string() +
                                " were changed since they were recorded; the first is "
                                "walk002.jpg."));
}

TEST_F(Folder, WithADamagedManifestIsTakenByTheNamesOfItsFramesAndSaysSo) {
    writeFrames("walk", 0, 2, "png");
    writeFile(folder / "walk.frames.json", "{");
    EXPECT_FALSE(read().has_manifest);
    EXPECT_THAT(filesOf(read()), ElementsAre("walk000.png", "walk001.png"));
    EXPECT_THAT(read().warnings, ElementsAre(HasSubstr("walk.frames.json is damaged")));
}

TEST_F(Folder, WithoutAManifestIsTakenByWhatTheRecordingNoted) {
    writeFrames("walk", 0, 4);
    writeRecording("walk", 3);
    EXPECT_FALSE(read().has_manifest);
    EXPECT_EQ(read().manifest.kind, "path");
    EXPECT_EQ(read().manifest.width_px, 64);
    EXPECT_EQ(read().manifest.frames, 3) << "the fourth is of an earlier recording";
    EXPECT_THAT(filesOf(read()), ElementsAre("walk000.jpg", "walk001.jpg", "walk002.jpg"));
}

TEST_F(Folder, OfPicturesAloneIsTakenByTheirNames) {
    writeFrames("walk", 0, 1002);
    writeFile(folder / "walk.txt", "notes");
    EXPECT_EQ(read().manifest.name, "walk");
    EXPECT_EQ(read().manifest.frames, 1002);
    EXPECT_EQ(read().manifest.frame_rate, 30);
    EXPECT_EQ(read().manifest.images[1000].file, "walk1000.jpg") << "no first frame of walk1";
    EXPECT_THAT(read().warnings, IsEmpty());
}

TEST_F(Folder, OfSeveralRecordingsAsksForOne) {
    writeFrames("walk", 0, 2);
    writeFrames("house", 0, 3, "png");
    EXPECT_EQ(messageFor(folder.path()),
              folder.path().string() +
                  " holds 2 recordings. Name the file of one of them, such "
                  "as " +
                  (folder / "house000.png").string() + ".");
    const auto one = readRecordedFolder(folder / "walk001.jpg");
    ASSERT_TRUE(one) << one.message();
    EXPECT_THAT(filesOf(one.value()), ElementsAre("walk000.jpg", "walk001.jpg"));
}

TEST_F(Folder, OfSeveralListedRecordingsIsReadByTheListThatIsNamed) {
    writeFrames("walk", 0, 2);
    writeManifest("walk", 2);
    writeFrames("house", 0, 1);
    writeRecording("house", 1);
    EXPECT_THAT(messageFor(folder.path()), HasSubstr("walk.frames.json"));
    const auto walk = readRecordedFolder(folder / "walk.frames.json");
    ASSERT_TRUE(walk) << walk.message();
    EXPECT_EQ(walk.value().manifest.name, "walk");
    const auto house = readRecordedFolder(folder / "house000.jpg");
    ASSERT_TRUE(house) << house.message();
    EXPECT_EQ(house.value().manifest.name, "house");
}

TEST_F(Folder, WithoutFramesIsTold) {
    EXPECT_EQ(messageFor(folder.path()),
              folder.path().string() + " holds no recorded frames. Name a folder that a recording "
                                       "was made into.");
    writeManifest("walk", 2);
    EXPECT_THAT(messageFor(folder.path()), HasSubstr("holds no recorded frames"));
    EXPECT_EQ(messageFor(folder / "none"),
              "There is no folder " + (folder / "none").string() + ".");
}

} // namespace
} // namespace quarn::test
