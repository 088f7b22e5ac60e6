#include "host/recording/RunningRecording.h"

#include "ground/Checksum.h"
#include "tests/support/TempFolder.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <set>
#include <unistd.h>

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
    RecordingPlan plan(int frames, const std::string& extension = "jpg") const {
        RecordingPlan plan;
        plan.animation = "Walk";
        plan.settings = {"turntable", frames, 64, 48, "Rendered", extension};
        plan.fingerprint = [this] { return fingerprint; };
        plan.choice = choice;
        plan.overwrites = overwrites;
        return plan;
    }
    RunningRecording make(int frames, const std::string& extension = "jpg",
                          RunningRecording::Pace pace = {}) {
        return {plan(frames, extension),
                {[this](const std::string& text) { told.push_back(text); },
                 [this](const RecordingStart& start) { started = start; }},
                pace};
    }
    /// Writes a file of the recording where it may.
    bool write(RunningRecording& recording, const std::string& name) const {
        if (!recording.mayWrite(folder / name))
            return false;
        if (recording.passesOver(folder / name))
            return true;
        writeFile(folder / name, "recorded");
        if (const auto frame = recording.fileWritten(folder / name))
            recording.note(frameOf(folder.path(), name, *frame));
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
    /// What is noted of a frame whose file stands written.
    static ManifestFrame frameOf(const std::filesystem::path& folder, const std::string& name,
                                 int number) {
        const FileChecksum sum = checksumOfFile(folder / name).value();
        return {number, name, sum.bytes, sum.xxh64, {}, {}};
    }
    RecordingFile stored() const {
        return readRecordingFile(folder / "Walk.recording").value().value();
    }
    /// Another process records here: one that lives, on this machine.
    /// @return its journal
    JournalWriter storeOther(const ProcessIdentity& writer = {hostName(), 1, 0}) const {
        RecordingFile other = recordingFileOf(plan(5), fingerprint);
        other.writer = writer;
        EXPECT_TRUE(writeRecordingFile(folder / "Walk.recording", other).ok());
        return std::move(
            JournalWriter::create(folder.path(), {"Walk", writer, fingerprint, 0.0}).value());
    }
    std::vector<std::filesystem::path> journals() const {
        return journalsIn(folder.path(), "Walk");
    }
    /// Every file but those of which programs tell each other.
    std::set<std::string> files() const {
        std::set<std::string> names;
        for (const auto& entry : std::filesystem::directory_iterator(folder.path()))
            names.insert(entry.path().filename().string());
        return names;
    }

    const TempFolder folder;
    RecordingFingerprint fingerprint{"quarn 1.0.0", "00000000000000d0", "00000000000000e0", "avx2"};
    RecordingChoice choice;
    bool overwrites = false;
    std::vector<std::string> told;
    RecordingStart started;
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
    storeOther({hostName(), 1, 987654321});
    writeFile(folder / "Walk000.jpg", "theirs");
    EXPECT_TRUE(record(3).isComplete());
}

TEST_F(Recording, IsRefusedWhileAnotherOneOfItsNameRuns) {
    const JournalWriter other = storeOther();
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

TEST_F(Recording, RenewsItsJournalFromBeatToBeat) {
    using namespace std::chrono_literals;
    RunningRecording recording = make(3, "jpg", {0s, 1000s});
    ASSERT_TRUE(recording.begin(folder.path()));
    ASSERT_THAT(journals(), SizeIs(1));
    const auto before = std::filesystem::last_write_time(journals().front()) - 1h;
    std::filesystem::last_write_time(journals().front(), before);
    recording.beat();
    EXPECT_GT(std::filesystem::last_write_time(journals().front()), before + 59min);
}

TEST_F(Recording, NotesEveryPictureAtOnceAsAKilledOneLeavesIt) {
    RunningRecording recording = make(3);
    ASSERT_TRUE(write(recording, "Walk000.jpg"));
    ASSERT_TRUE(write(recording, "Walk001.jpg"));
    JournalReader journal(journals().front());
    ASSERT_TRUE(journal.readOn().ok());
    ASSERT_THAT(journal.content().frames, SizeIs(2));
    EXPECT_EQ(journal.content().frames[1].frame, frameOf(folder.path(), "Walk001.jpg", 1));
    EXPECT_TRUE(stored().written.isEmpty()) << "that file is not written for every picture";
}

TEST_F(Recording, EndsWhereAnotherOneHasTakenOver) {
    using namespace std::chrono_literals;
    RunningRecording recording = make(3, "jpg", {0s, 60s});
    ASSERT_TRUE(write(recording, "Walk000.jpg"));
    const JournalWriter other = storeOther();
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
        EXPECT_EQ(recording.fileWritten(file), 0);
        EXPECT_TRUE(recording.end()->isComplete()) << end;
    }
}

TEST_F(Recording, ThatNeverCameToAFolderHasNothingToReport) {
    EXPECT_FALSE(make(3).end());
}

// ---- Recordings that go on, and that several make

class SharedRecording : public Recording {
protected:
    SharedRecording() { choice.begin = RecordingBegin::resume; }

    /// Records these frames, as far as the recording makes them.
    RecordingReport recordPart(FrameSet frames, int of = 6) {
        choice.frames = std::move(frames);
        RunningRecording recording = make(of);
        run(recording, of);
        choice.frames.reset();
        return *recording.end();
    }
    RecordingReport recordAll(int frames = 6) {
        RunningRecording recording = make(frames);
        run(recording, frames);
        return *recording.end();
    }
    /// Goes through all frames as the command does.
    void run(RunningRecording& recording, int frames) {
        if (!recording.begin(folder.path()))
            return;
        for (int frame = 0; frame < frames; ++frame) {
            const bool is_made = recording.makesNext();
            const std::string name = "Walk00" + std::to_string(frame) + ".jpg";
            ASSERT_TRUE(write(recording, name));
            if (is_made)
                made.push_back(frame);
        }
        write(recording, "Walk.html");
    }

    std::vector<int> made;
};

TEST_F(SharedRecording, MakesTheFramesOfItsPartAndNoPage) {
    const RecordingReport report = recordPart(FrameSet::firstOf(2));
    EXPECT_EQ(report.expected, 2);
    EXPECT_EQ(report.written, 2);
    EXPECT_TRUE(report.isComplete());
    EXPECT_TRUE(report.is_part);
    EXPECT_FALSE(report.has_page);
    EXPECT_FALSE(std::filesystem::exists(folder / "Walk.html"));
    EXPECT_FALSE(std::filesystem::exists(folder / "Walk002.jpg"));
    EXPECT_FALSE(std::filesystem::exists(folder / "Walk.frames.json"));
    EXPECT_TRUE(stored().is_running) << "the recording has not come to its end";
}

TEST_F(SharedRecording, KeepsWhatIsThereAndMakesTheRest) {
    recordPart(FrameSet::firstOf(2));
    made.clear();
    const RecordingReport report = recordAll();
    EXPECT_THAT(made, testing::ElementsAre(2, 3, 4, 5));
    EXPECT_EQ(started.wanted, 6);
    EXPECT_EQ(started.kept, 2);
    EXPECT_EQ(report.kept, 2);
    EXPECT_EQ(report.written, 4);
    EXPECT_EQ(report.there, 6);
    EXPECT_TRUE(report.isComplete());
    EXPECT_TRUE(report.has_page);
    EXPECT_THAT(files(), testing::ElementsAre("Walk.frames.json", "Walk.html", "Walk.recording",
                                              "Walk000.jpg", "Walk001.jpg", "Walk002.jpg",
                                              "Walk003.jpg", "Walk004.jpg", "Walk005.jpg"))
        << "the journals went into the list of frames";
}

TEST_F(SharedRecording, OfACompleteOneMakesNothing) {
    recordAll();
    made.clear();
    EXPECT_EQ(recordAll().kept, 6);
    EXPECT_THAT(made, IsEmpty());
    EXPECT_TRUE(journals().empty());
}

TEST_F(SharedRecording, MakesDamagedFramesAgain) {
    recordAll();
    made.clear();
    writeFile(folder / "Walk001.jpg", "");
    writeFile(folder / "Walk002.jpg", "recor");
    writeFile(folder / "Walk003.jpg", "rec0rded");
    std::filesystem::remove(folder / "Walk004.jpg");
    const RecordingReport report = recordAll();
    EXPECT_THAT(made, testing::ElementsAre(1, 2, 3, 4));
    EXPECT_TRUE(report.isComplete());
    EXPECT_EQ(readFile(folder / "Walk003.jpg"), "recorded");
}

TEST_F(SharedRecording, GoesOnAfterOneThatWasKilled) {
    choice.begin = RecordingBegin::anew;
    {
        RunningRecording killed = make(6);
        ASSERT_TRUE(write(killed, "Walk000.jpg"));
        ASSERT_TRUE(write(killed, "Walk001.jpg"));
    }
    ASSERT_THAT(journals(), SizeIs(1));
    // The process of the test is the one that was killed.
    JournalReader journal(journals().front());
    ASSERT_TRUE(journal.readOn().ok());
    std::string text = readFile(journals().front());
    const std::string pid = "\"pid\":" + std::to_string(getpid());
    text.replace(text.find(pid), pid.size(), "\"pid\":1");
    const std::string start = "\"started\":";
    text.insert(text.find(start) + start.size(), "9");
    writeFile(journals().front(), text);
    choice.begin = RecordingBegin::if_same;
    EXPECT_EQ(recordAll().kept, 2);
    EXPECT_THAT(made, testing::ElementsAre(2, 3, 4, 5));
}

TEST_F(SharedRecording, IsRefusedWhereTheDocumentChanged) {
    recordPart(FrameSet::firstOf(2));
    fingerprint.document = "00000000000000d1";
    EXPECT_EQ(recordAll().written, 0);
    EXPECT_TRUE(stored().is_running);
    ASSERT_THAT(told, SizeIs(1));
    EXPECT_THAT(told[0], HasSubstr("another state of the document"));
    EXPECT_THAT(told[0], HasSubstr("--overwrite"));
    EXPECT_THAT(files(), SizeIs(4)) << "two frames, a journal and NAME.recording";
}

TEST_F(SharedRecording, IsRefusedWhereASettingChanged) {
    recordPart(FrameSet::firstOf(2));
    EXPECT_EQ(recordAll(5).written, 0);
    ASSERT_THAT(told, SizeIs(1));
    EXPECT_THAT(told[0], HasSubstr("turntable, 6 frames, 64x48, Rendered, jpg"));
    EXPECT_THAT(told[0], HasSubstr("turntable, 5 frames, 64x48, Rendered, jpg"));
    told.clear();
    fingerprint.settings = "00000000000000e1";
    EXPECT_EQ(recordAll().written, 0);
    ASSERT_THAT(told, SizeIs(1));
    EXPECT_THAT(told[0], HasSubstr("another camera"));
}

TEST_F(SharedRecording, IsRefusedWithOtherInstructions) {
    recordPart(FrameSet::firstOf(2));
    fingerprint.instructions = "sse2";
    EXPECT_EQ(recordAll().written, 0);
    ASSERT_THAT(told, SizeIs(1));
    EXPECT_THAT(told[0], HasSubstr("--instructions avx2"));
}

TEST_F(SharedRecording, OfAnotherOneBeginsAnewWhereOnlyTheSameIsGoneOnWith) {
    recordAll();
    made.clear();
    fingerprint.document = "00000000000000d1";
    choice.begin = RecordingBegin::if_same;
    EXPECT_TRUE(recordAll().isComplete());
    EXPECT_THAT(made, SizeIs(6));
    EXPECT_EQ(stored().fingerprint, fingerprint);
    EXPECT_THAT(told, IsEmpty());
}

TEST_F(SharedRecording, OfNoFramesPreparesTheFolderForAnyInstructions) {
    EXPECT_TRUE(recordPart(FrameSet()).isComplete());
    EXPECT_EQ(stored().fingerprint.instructions, "");
    EXPECT_TRUE(journals().empty());
    fingerprint.instructions = "sse2";
    recordPart(FrameSet::firstOf(1));
    EXPECT_EQ(stored().fingerprint.instructions, "sse2") << "of the first who makes a frame";
    EXPECT_TRUE(recordAll().isComplete());
}

TEST_F(SharedRecording, RefusesFramesBehindTheEnd) {
    FrameSet frames = FrameSet::firstOf(2);
    frames.add(6);
    EXPECT_EQ(recordPart(frames).written, 0);
    ASSERT_THAT(told, SizeIs(1));
    EXPECT_THAT(told[0], HasSubstr("no frame 6"));
    EXPECT_TRUE(files().empty());
}

TEST_F(SharedRecording, LeavesFramesToThoseWhoMakeThemNow) {
    recordPart(FrameSet::firstOf(1));
    const JournalWriter other = std::move(
        JournalWriter::create(folder.path(), {"Walk", {hostName(), 1, 0}, fingerprint, 0.0})
            .value());
    writeFile(folder / "Walk003.claim", other.file().filename().string());
    made.clear();
    const RecordingReport report = recordAll();
    EXPECT_THAT(made, testing::ElementsAre(1, 2, 4, 5));
    EXPECT_EQ(report.elsewhere, 1);
    EXPECT_FALSE(report.isComplete());
    EXPECT_FALSE(report.has_page) << "it would show a frame that is not there";
    EXPECT_TRUE(std::filesystem::exists(folder / "Walk003.claim"));
}

TEST_F(SharedRecording, TakesTheFramesOfTheDeadOver) {
    recordPart(FrameSet::firstOf(1));
    writeFile(folder / "Walk003.claim", "Walk.gone-1-000000.journal");
    writeFile(folder / "Walk004.claim", "../elsewhere");
    EXPECT_TRUE(recordAll().isComplete());
    EXPECT_FALSE(std::filesystem::exists(folder / "Walk003.claim"));
    EXPECT_FALSE(std::filesystem::exists(folder / "Walk004.claim"));
}

TEST_F(SharedRecording, FindsFramesThatOthersMadeMeanwhile) {
    RunningRecording recording = make(6);
    ASSERT_TRUE(recording.begin(folder.path()));
    ASSERT_TRUE(write(recording, "Walk000.jpg"));
    JournalWriter other = std::move(
        JournalWriter::create(folder.path(), {"Walk", {hostName(), 1, 0}, fingerprint, 0.0})
            .value());
    writeFile(folder / "Walk001.jpg", "recorded");
    ASSERT_TRUE(other.add({frameOf(folder.path(), "Walk001.jpg", 1), 0.5}).ok());
    EXPECT_FALSE(recording.makesNext());
    ASSERT_TRUE(write(recording, "Walk001.jpg"));
    EXPECT_TRUE(recording.hasKept(1));
    EXPECT_TRUE(recording.hasPassedOver());
    EXPECT_TRUE(recording.makesNext());
}

TEST_F(SharedRecording, IsRefusedWhileSomebodyRecordsAlone) {
    choice.begin = RecordingBegin::anew;
    const JournalWriter other = storeOther();
    choice.begin = RecordingBegin::resume;
    EXPECT_EQ(recordAll(5).written, 0);
    ASSERT_THAT(told, SizeIs(1));
    EXPECT_THAT(told[0], HasSubstr("process 1 on " + hostName()));
}

TEST_F(SharedRecording, CountsNobodyAliveWhoseJournalWasNotRenewedByTheClockOfTheDisk) {
    using namespace std::chrono_literals;
    recordPart(FrameSet::firstOf(1));
    const JournalWriter other = std::move(
        JournalWriter::create(folder.path(), {"Walk", {"far-away", 1, 0}, fingerprint, 0.0})
            .value());
    writeFile(folder / "Walk003.claim", other.file().filename().string());
    EXPECT_EQ(recordAll().elsewhere, 1);
    std::filesystem::last_write_time(other.file(),
                                     std::filesystem::last_write_time(other.file()) - 61s);
    EXPECT_TRUE(recordAll().isComplete());
    EXPECT_FALSE(std::filesystem::exists(other.file()));
}

TEST_F(SharedRecording, TellsWhoeverGoesOnWhatItsFramesTook) {
    recordPart(FrameSet::firstOf(2));
    JournalReader journal(journals().front());
    ASSERT_TRUE(journal.readOn().ok());
    EXPECT_TRUE(journal.content().has_ended);
    EXPECT_EQ(journal.content().trouble, "");
    EXPECT_EQ(journal.content().head.fingerprint, fingerprint);
    for (const JournalFrame& frame : journal.content().frames)
        EXPECT_GE(frame.seconds, 0.0);
}

} // namespace
} // namespace quarn::test
