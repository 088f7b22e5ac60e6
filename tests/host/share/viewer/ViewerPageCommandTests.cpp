#include "host/app/Application.h"
#include "tests/host/app/TestCommand.h"
#include "tests/host/share/viewer/RecordedFrames.h"

#include <gmock/gmock.h>

namespace quarn::test {
namespace {

using testing::AllOf;
using testing::HasSubstr;

class ViewerPageCommandTest : public testing::Test {
protected:
    static SessionOptions options() {
        SessionOptions options;
        options.language = "C";
        options.viewer_folder = std::filesystem::path(QUARN_SOURCE_DIR) / "share/viewer";
        return options;
    }
    CQuarnCommand::result run(const std::string& words) {
        return session.runCommand(KM_wString::FromUtf8("-ViewerPage " + words).View());
    }
    std::string printed() const { return KM_wString(front_end.printed()).ToUtf8(); }
    std::string folderOf(const RecordedFrames& frames) {
        return '"' + frames.folder().string() + '"';
    }

    ScriptedFrontEnd front_end;
    Session session{front_end, options()};
};

TEST_F(ViewerPageCommandTest, WritesThePageOfAFolderAndTellsItsSize) {
    const RecordedFrames frames(3);
    EXPECT_EQ(run(folderOf(frames) + " _Enter"), CQuarnCommand::success);
    EXPECT_THAT(readFile(frames.page()), HasSubstr("<title>House</title>"));
    EXPECT_THAT(printed(), AllOf(HasSubstr("House-viewer.html: 3 pictures, "), HasSubstr(" kB.")));
}

TEST_F(ViewerPageCommandTest, TakesPicturesInsideAndATitle) {
    const RecordedFrames frames(3);
    EXPECT_EQ(run(folderOf(frames) + " _OneFile=Yes _Title \"The house\" _Enter"),
              CQuarnCommand::success);
    EXPECT_THAT(readFile(frames.page()),
                AllOf(HasSubstr("<title>The house</title>"), HasSubstr("id=\"frame-2\"")));
}

TEST_F(ViewerPageCommandTest, SaysWhatIsWrongWithAFolder) {
    const TempFolder empty;
    EXPECT_EQ(run('"' + empty.path().string() + "\" _Enter"), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("holds no recorded frames"));
    EXPECT_EQ(run('"' + (empty / "gone").string() + "\" _Enter"), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("There is no folder"));
}

TEST_F(ViewerPageCommandTest, ShowsWhatThereIsOfADamagedRecordingAndSaysWhatIsMissing) {
    const RecordedFrames frames(4);
    std::filesystem::remove(frames.file(1));
    frames.cut(2);
    writeFile(frames.folder() / "House.frames.json", "{\"format\": 7");
    EXPECT_EQ(run(folderOf(frames) + " _Enter"), CQuarnCommand::success);
    EXPECT_THAT(printed(),
                AllOf(HasSubstr("House.frames.json"), HasSubstr("1 of 4 frames are missing"),
                      HasSubstr("1 frames are cut off"), HasSubstr(": 2 pictures")));
}

} // namespace
} // namespace quarn::test
