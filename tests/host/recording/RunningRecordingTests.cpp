#include "host/recording/RunningRecording.h"

#include "tests/support/TempFolder.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace quarn::test {
namespace {

using testing::HasSubstr;
using testing::IsEmpty;
using testing::SizeIs;

/// A page as the recording of an animation "Walk" with these pictures writes it.
std::string pageOf(const std::vector<std::string>& pictures) {
    std::string page = "\xEF\xBB\xBF<HTML>\n <HEAD>\n  <TITLE>Walk</TITLE>\n </HEAD>\n "
                       "<BODY onLoad=\"Load()\">\n <FONT FACE=VERDANA SIZE=2><B>Walk</B>\n";
    for (std::size_t i = 0; i < pictures.size(); ++i)
        page += "Images[" + std::to_string(i) + "].src = \"" + pictures[i] + "\"\n";
    return page;
}

class Recording : public testing::Test {
protected:
    RunningRecording::Plan plan(int frames, const std::string& extension = "jpg") const {
        return {"Walk", {"turntable", frames, 64, 48, "Rendered", extension}, overwrites};
    }
    RunningRecording make(int frames, const std::string& extension = "jpg",
                          RunningRecording::Pace pace = {}) {
        return {plan(frames, extension), [this](const std::string& text) { told.push_back(text); },
                pace};
    }
    /// Writes a file of the recording where it may.
    bool write(RunningRecording& recording, const std::string& name) const {
        if (!recording.mayWrite(folder / name))
            return false;
        writeFile(folder / name, "recorded");
        recording.fileWritten(folder / name);
        return true;
    }
    RecordingReport record(int frames, const std::string& extension = "jpg") {
        RunningRecording recording = make(frames, extension);
        if (recording.begin(folder.path())) {
            for (int frame = 0; frame < frames; ++frame)
                write(recording, "Walk00" + std::to_string(frame) + "." + extension);
            write(recording, "Walk.html");
        }
        return *recording.end();
    }
    RecordingFile stored() const {
        return readRecordingFile(folder / "Walk.recording").value().value();
    }
    /// Another process records here: one that lives, on this machine.
    void storeOther(const std::function<void(RecordingFile&)>& change = {}) const {
        RecordingFile other;
        other.animation = "Walk";
        other.is_running = true;
        other.writer = {hostName(), 1, 0};
        other.lease_until_s = unixSeconds() + 60;
        other.settings = {"turntable", 5, 64, 48, "Rendered", "jpg"};
        if (change)
            change(other);
        ASSERT_TRUE(writeRecordingFile(folder / "Walk.recording", other).ok());
    }

    const TempFolder folder;
    bool overwrites = false;
    std::vector<std::string> told;
};

TEST_F(Recording, CountsItsPicturesAndNotesThem) {
    const RecordingReport report = record(3);
    EXPECT_EQ(report.expected, 3);
    EXPECT_EQ(report.written, 3);
    EXPECT_EQ(report.there, 3);
    EXPECT_TRUE(report.has_page);
    EXPECT_TRUE(report.isComplete());
    EXPECT_EQ(stored().written, FrameSet::firstOf(3));
    EXPECT_FALSE(stored().is_running);
    EXPECT_TRUE(stored().owns_page);
    EXPECT_EQ(stored().settings, plan(3).settings);
    EXPECT_THAT(told, IsEmpty());
}

TEST_F(Recording, PicturesThatAreGoneAtTheEndAreNotThere) {
    RunningRecording recording = make(3);
    for (const char* name : {"Walk000.jpg", "Walk001.jpg", "Walk002.jpg", "Walk.html"})
        ASSERT_TRUE(write(recording, name));
    std::filesystem::remove(folder / "Walk001.jpg");
    std::filesystem::remove(folder / "Walk.html");
    const auto report = recording.end();
    EXPECT_EQ(report->written, 3);
    EXPECT_EQ(report->there, 2);
    EXPECT_FALSE(report->has_page);
    EXPECT_FALSE(report->isComplete());
}

TEST_F(Recording, MadeAgainReplacesItsOwnFiles) {
    record(3);
    EXPECT_TRUE(record(3).isComplete());
    EXPECT_THAT(told, IsEmpty());
}

TEST_F(Recording, LeavesAFileAloneThatNoneOfItsNameWrote) {
    for (const char* name : {"Walk002.jpg", "Walk.html"}) {
        writeFile(folder / name, "mine");
        told.clear();
        const RecordingReport report = record(3);
        EXPECT_EQ(report.written, 0);
        EXPECT_EQ(readFile(folder / name), "mine");
        EXPECT_FALSE(std::filesystem::exists(folder / "Walk000.jpg")) << "seen before the first";
        EXPECT_FALSE(std::filesystem::exists(folder / "Walk.recording"));
        ASSERT_THAT(told, SizeIs(1));
        EXPECT_THAT(told[0], HasSubstr((folder / name).string()));
        std::filesystem::remove(folder / name);
    }
}

TEST_F(Recording, TellsHowManyFilesAreInItsWay) {
    for (const char* name : {"Walk001.jpg", "Walk000.jpg", "Walk.html"})
        writeFile(folder / name, "mine");
    record(3);
    ASSERT_THAT(told, SizeIs(1));
    EXPECT_THAT(told[0], HasSubstr("Walk.html and 2 more files"));
}

TEST_F(Recording, IsNotInTheWayOfFilesThatItDoesNotWrite) {
    for (const char* name : {"Walk003.jpg", "Walk000.png", "Walk0000.jpg", "other.html"})
        writeFile(folder / name, "mine");
    EXPECT_TRUE(record(3).isComplete());
    for (const char* name : {"Walk003.jpg", "Walk000.png", "Walk0000.jpg", "other.html"})
        EXPECT_EQ(readFile(folder / name), "mine");
}

TEST_F(Recording, MayReplaceFilesOfOthersWhereItIsTold) {
    writeFile(folder / "Walk001.jpg", "mine");
    writeFile(folder / "Walk.html", "mine");
    writeFile(folder / "Walk.recording", "mine");
    overwrites = true;
    EXPECT_TRUE(record(3).isComplete());
    EXPECT_EQ(readFile(folder / "Walk001.jpg"), "recorded");
    overwrites = false;
    EXPECT_TRUE(record(3).isComplete()) << "they are its own now";
}

TEST_F(Recording, OfAnEndedOneOnlyWhatItWroteIsItsOwn) {
    RunningRecording stopped = make(5);
    ASSERT_TRUE(write(stopped, "Walk000.jpg"));
    (void)stopped.end();
    writeFile(folder / "Walk001.jpg", "mine");
    record(5);
    EXPECT_EQ(readFile(folder / "Walk001.jpg"), "mine");
    EXPECT_THAT(told, SizeIs(1));
}

TEST_F(Recording, ThatWasKilledMayBeMadeAgainOverAllThatItMeantToWrite) {
    {
        RunningRecording killed = make(5);
        for (const char* name : {"Walk000.jpg", "Walk001.jpg", "Walk002.jpg"})
            ASSERT_TRUE(write(killed, name));
    }
    EXPECT_TRUE(stored().is_running);
    EXPECT_TRUE(record(5).isComplete());
    EXPECT_THAT(told, IsEmpty());
}

TEST_F(Recording, WaitsForNobodyWhoIsDead) {
    storeOther([](RecordingFile& other) { other.writer.started = 987654321; });
    writeFile(folder / "Walk000.jpg", "theirs");
    EXPECT_TRUE(record(3).isComplete());
}

TEST_F(Recording, IsRefusedWhileAnotherOneOfItsNameRuns) {
    storeOther();
    writeFile(folder / "Walk.html", "theirs");
    overwrites = true; // nor then
    const RecordingReport report = record(3);
    EXPECT_EQ(report.written, 0);
    EXPECT_EQ(report.expected, 3);
    EXPECT_EQ(readFile(folder / "Walk.html"), "theirs");
    EXPECT_TRUE(stored().is_running);
    EXPECT_EQ(stored().writer.pid, 1);
    ASSERT_THAT(told, SizeIs(1));
    EXPECT_THAT(told[0], HasSubstr("process 1 on " + hostName()));
}

TEST_F(Recording, RenewsItsLeaseFromBeatToBeat) {
    using namespace std::chrono_literals;
    RunningRecording recording = make(3, "jpg", {0s, 1000s});
    ASSERT_TRUE(recording.begin(folder.path()));
    storeOther([](RecordingFile& file) {
        file.writer = currentProcess();
        file.lease_until_s = 0;
    });
    recording.beat();
    EXPECT_GT(stored().lease_until_s, unixSeconds() + 900);
    ASSERT_TRUE(write(recording, "Walk000.jpg"));
    EXPECT_EQ(stored().written, FrameSet::firstOf(1)) << "as a killed one leaves it";
}

TEST_F(Recording, DoesNotWriteItsFileForEveryPicture) {
    RunningRecording recording = make(3);
    ASSERT_TRUE(write(recording, "Walk000.jpg"));
    ASSERT_TRUE(write(recording, "Walk001.jpg"));
    EXPECT_TRUE(stored().written.isEmpty());
}

TEST_F(Recording, EndsWhereAnotherOneHasTakenOver) {
    using namespace std::chrono_literals;
    RunningRecording recording = make(3, "jpg", {0s, 60s});
    ASSERT_TRUE(write(recording, "Walk000.jpg"));
    storeOther();
    recording.beat();
    EXPECT_FALSE(write(recording, "Walk001.jpg"));
    EXPECT_FALSE(write(recording, "Walk.html"));
    (void)recording.end();
    EXPECT_EQ(stored().writer.pid, 1);
    EXPECT_TRUE(stored().is_running);
    ASSERT_THAT(told, SizeIs(1));
    EXPECT_THAT(told[0], HasSubstr("ends here"));
}

TEST_F(Recording, TellsWhatALongerOneBeforeItLeft) {
    record(5);
    const RecordingReport report = record(3);
    EXPECT_TRUE(report.isComplete());
    EXPECT_EQ(report.left_over, 2);
    EXPECT_STREQ(report.first_left_over.Array(), L"Walk003.jpg");
    EXPECT_TRUE(record(5).isComplete()) << "what it left is still its own";
    EXPECT_EQ(record(5).left_over, 0);
}

TEST_F(Recording, TellsWhatOneOfAnotherFormatLeftUntilItIsGone) {
    record(2, "png");
    EXPECT_EQ(record(2).left_over, 2);
    EXPECT_EQ(record(2).left_over, 2);
    std::filesystem::remove(folder / "Walk000.png");
    std::filesystem::remove(folder / "Walk001.png");
    EXPECT_EQ(record(2).left_over, 0);
    EXPECT_TRUE(stored().earlier.empty());
}

TEST_F(Recording, WithoutItsFileTakesThePageForTheListOfItsPictures) {
    writeFile(folder / "Walk000.jpg", "recorded before");
    writeFile(folder / "Walk001.jpg", "recorded before");
    writeFile(folder / "Walk.html", pageOf({"Walk000.jpg", "Walk001.jpg"}));
    EXPECT_TRUE(record(2).isComplete());

    std::filesystem::remove(folder / "Walk.recording");
    writeFile(folder / "Walk.html", pageOf({"Walk000.jpg"}));
    EXPECT_EQ(record(2).written, 0) << "Walk001.jpg is not on the page";
}

TEST_F(Recording, ThatWroteNothingLeavesNoFileThatTellsOfIt) {
    RunningRecording recording = make(3);
    ASSERT_TRUE(recording.begin(folder.path()));
    EXPECT_TRUE(std::filesystem::exists(folder / "Walk.recording"));
    EXPECT_EQ(recording.end()->written, 0);
    EXPECT_TRUE(std::filesystem::is_empty(folder.path()));
}

TEST_F(Recording, GoesOnWhereItsFolderWasRemoved) {
    using namespace std::chrono_literals;
    RunningRecording recording = make(2, "jpg", {0s, 60s});
    ASSERT_TRUE(write(recording, "Walk000.jpg"));
    std::filesystem::remove_all(folder.path());
    std::filesystem::create_directory(folder.path());
    ASSERT_TRUE(write(recording, "Walk001.jpg"));
    const auto report = recording.end();
    EXPECT_EQ(report->written, 2);
    EXPECT_EQ(report->there, 1);
}

TEST_F(Recording, TakesTheFolderHoweverItsPathIsWritten) {
    for (const std::string end : {"", "/", "/."}) {
        RunningRecording recording = make(1);
        ASSERT_TRUE(recording.begin(folder.path().string() + end));
        const std::filesystem::path file = folder.path().string() + end + "/Walk000.jpg";
        ASSERT_TRUE(recording.mayWrite(file));
        writeFile(file, "recorded");
        recording.fileWritten(file);
        EXPECT_TRUE(recording.end()->isComplete()) << end;
    }
}

TEST_F(Recording, ThatNeverCameToAFolderHasNothingToReport) {
    EXPECT_FALSE(make(3).end());
}

} // namespace
} // namespace quarn::test
