#include "tests/zoetrix/fixtures/RecordingFixture.h"

using testing::ElementsAre;
using testing::HasSubstr;

namespace {

class RecordParts : public RecordingFixture {
protected:
    /// Records into a folder what the line chooses.
    CQuarnCommand::result recordInto(const std::filesystem::path& place, const wchar_t* choice) {
        if (run(choice) != CQuarnCommand::success)
            return CQuarnCommand::failure;
        std::filesystem::create_directory(place);
        record().SetFolderName(wide(place));
        answer({L"_Enter"});
        return run(L"RecordAnimation");
    }
    void expectSameFile(const char* name) const {
        EXPECT_EQ(readFile(parts / name), readFile(frames / name)) << name;
    }
    void expectPartsEqualTheWhole() {
        ASSERT_EQ(recordInto(frames, L"NextRecording _Anew _Enter"), CQuarnCommand::success);
        ASSERT_EQ(recordInto(parts, L"NextRecording _Resume 2-2 _Enter"), CQuarnCommand::success);
        EXPECT_FALSE(std::filesystem::exists(parts / "Walk.html"));
        EXPECT_FALSE(std::filesystem::exists(parts / "Walk001.jpg"));
        ASSERT_EQ(recordInto(parts, L"NextRecording _Resume _Enter"), CQuarnCommand::success);
        for (const char* name :
             {"Walk000.jpg", "Walk001.jpg", "Walk002.jpg", "Walk.html", "Walk.frames.json"})
            expectSameFile(name);
    }

    const std::filesystem::path parts = folder.path() / "parts";
};

} // namespace

TEST_F(RecordParts, OfADisplayModeEqualTheWhole) {
    expectPartsEqualTheWhole();
}

TEST_F(RecordParts, OfARenderMethodEqualTheWhole) {
    renderSmall();
    record().SetRenderPreview(true);
    expectPartsEqualTheWhole();
}

TEST_F(RecordParts, WaitForNoFrameThatIsPassedOver) {
    ASSERT_EQ(recordInto(frames, L"NextRecording 1-1 _Enter"), CQuarnCommand::success);
    EXPECT_EQ(front_end.waited_ms(), 10U);
    ASSERT_EQ(recordInto(frames, L"NextRecording _Resume 1-1 _Enter"), CQuarnCommand::success);
    EXPECT_EQ(front_end.waited_ms(), 10U);
}

TEST_F(RecordParts, AreChosenForTheNextRecordingAlone) {
    ASSERT_EQ(recordInto(parts, L"NextRecording 1-1 _Enter"), CQuarnCommand::success);
    answer({L"_Enter"});
    record().SetFolderName(wide(frames));
    ASSERT_EQ(run(L"RecordAnimation"), CQuarnCommand::success);
    EXPECT_THAT(files(), ElementsAre("Walk.frames.json", "Walk.html", "Walk.recording",
                                     "Walk000.jpg", "Walk001.jpg", "Walk002.jpg"));
}

TEST_F(RecordParts, WithABareNumberAreRefused) {
    EXPECT_EQ(run(L"NextRecording 2 _Enter"), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr(L"bare number"));
}

TEST_F(RecordParts, BehindTheLastFrameAreRefused) {
    recordInto(parts, L"NextRecording 1-3 _Enter");
    EXPECT_THAT(printed(), HasSubstr(L"There is no frame 3"));
    EXPECT_TRUE(std::filesystem::is_empty(parts));
}
