#include "host/recording/RecordingFile.h"

#include "tests/support/TempFolder.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace quarn::test {
namespace {

using testing::HasSubstr;

RecordingFile sample() {
    RecordingFile recording;
    recording.animation = "Häuschen \"2\"";
    recording.is_running = true;
    recording.writer = {"host-1", 4711, 123456789012345ULL};
    recording.document = "/models/Häuschen.quarn";
    recording.is_shared = true;
    recording.fingerprint = {"quarn 1.0.0", "00000000000000d0", "00000000000000e0", "avx2"};
    recording.settings = {"turntable", 150, 1280, 720, "Rendered", "jpg"};
    recording.written = FrameSet::firstOf(44);
    recording.written.add(50);
    recording.owns_page = true;
    recording.earlier["png"] = FrameSet::firstOf(12);
    return recording;
}

class RecordingFileOnDisk : public testing::Test {
protected:
    const TempFolder folder;
    const std::filesystem::path file = folder / "house.recording";
};

TEST_F(RecordingFileOnDisk, ReadsBackWhatWasWritten) {
    RecordingFile recording = sample();
    ASSERT_TRUE(writeRecordingFile(file, recording).ok());
    ASSERT_TRUE(readRecordingFile(file).ok());
    EXPECT_EQ(readRecordingFile(file).value(), recording);
    recording.is_running = false;
    recording.is_shared = false;
    ASSERT_TRUE(writeRecordingFile(file, recording).ok());
    EXPECT_EQ(readRecordingFile(file).value(), recording);
}

TEST_F(RecordingFileOnDisk, ThatIsMissingIsNoRecordingAndNoError) {
    const auto read = readRecordingFile(file);
    ASSERT_TRUE(read.ok());
    EXPECT_FALSE(read.value());
}

TEST_F(RecordingFileOnDisk, ThatIsSomethingElseIsToldWithItsName) {
    ASSERT_TRUE(writeRecordingFile(file, sample()).ok());
    const std::string good = readFile(file);
    const auto replaced = [&](const std::string& part, const std::string& by) {
        std::string text = good;
        text.replace(text.find(part), part.size(), by);
        return text;
    };
    for (const std::string& text :
         {std::string(), std::string("my notes"), std::string("[]"), std::string("{}"),
          std::string(100000, '['), good.substr(0, good.size() / 2),
          replaced("quarn-recording", "another"), replaced("4711", "-4711"),
          replaced("4711", "\"4711\""), replaced("150", "15000000000"), replaced("\"jpg\"", "7"),
          replaced("4711", "1e300"), replaced("123456789012345", "1.5"),
          replaced("123456789012345", "18446744073709551616"), replaced("\"avx2\"", "2"),
          replaced("\"version\": 2", "\"version\": 0.5")}) {
        writeFile(file, text);
        const auto read = readRecordingFile(file);
        ASSERT_FALSE(read.ok()) << text;
        EXPECT_THAT(read.message(), HasSubstr(file.string()));
        EXPECT_THAT(read.message(), HasSubstr("--overwrite"));
    }
}

TEST_F(RecordingFileOnDisk, OfALaterVersionIsToldAsThat) {
    ASSERT_TRUE(writeRecordingFile(file, sample()).ok());
    std::string text = readFile(file);
    text.replace(text.find("\"version\": 2"), 12, "\"version\": 3");
    writeFile(file, text);
    const auto read = readRecordingFile(file);
    ASSERT_FALSE(read.ok());
    EXPECT_THAT(read.message(), HasSubstr("later version"));
}

TEST_F(RecordingFileOnDisk, MayHoldFieldsThatALaterStepAdds) {
    ASSERT_TRUE(writeRecordingFile(file, sample()).ok());
    std::string text = readFile(file);
    text.insert(1, "\"checksums\": {\"house000.jpg\": \"abc\"},");
    writeFile(file, text);
    EXPECT_EQ(readRecordingFile(file).value(), sample());
}

TEST_F(RecordingFileOnDisk, WithRangesOutOfOrderIsNone) {
    for (const char* ranges : {"[[5, 3]]", "[[3, 5], [0, 1]]", "[[0, 5], [5, 6]]", "[[0]]"}) {
        RecordingFile recording = sample();
        recording.written = {};
        std::string text = recordingFileText(recording);
        const std::string empty = "\"written\": []";
        text.replace(text.find(empty), empty.size(), std::string("\"written\": ") + ranges);
        EXPECT_FALSE(parseRecordingFile(text, file).ok()) << ranges;
    }
}

TEST_F(RecordingFileOnDisk, OfTheFirstVersionKnowsNoFingerprint) {
    writeFile(file, R"({"format": "quarn-recording", "version": 1, "name": "house",
        "state": "recording", "writer": {"host": "studio-3", "pid": 4711, "started": 1381320},
        "lease_until_unix_s": 1795320936,
        "settings": {"kind": "turntable", "frames": 150, "width_px": 1280, "height_px": 720,
                     "mode": "Rendered", "extension": "jpg"},
        "written": [[0, 43]], "owns_page": true, "earlier": {"png": [[0, 11]]}})");
    const auto read = readRecordingFile(file);
    ASSERT_TRUE(read.ok() && read.value());
    EXPECT_EQ(read.value()->fingerprint, RecordingFingerprint());
    EXPECT_FALSE(read.value()->is_shared);
    EXPECT_EQ(read.value()->written, FrameSet::firstOf(44));
}

} // namespace
} // namespace quarn::test
