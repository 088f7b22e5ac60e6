#include "host/session/ViewFrame.h"
#include "tests/zoetrix/fixtures/RecordingFixture.h"

#include <cstdlib>

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::Not;

namespace {

class RecordCommand : public RecordingFixture {
protected:
    /// Runs the command and answers its prompts in turn.
    CQuarnCommand::result recordWith(std::initializer_list<std::wstring_view> answers) {
        answer(answers);
        return run(L"RecordAnimation");
    }
    std::wstring folderOption() {
        return std::wstring(front_end.questions().back().options.at(0).value.View());
    }
    std::vector<std::wstring> images() {
        std::vector<std::wstring> names;
        for (const KM_wString& image : record().Images())
            names.emplace_back(image.View());
        return names;
    }
    void expectThreeFramesAndThePageIn(const std::filesystem::path& place) {
        for (const char* name : {"Walk000.jpg", "Walk001.jpg", "Walk002.jpg"})
            EXPECT_TRUE(isJpeg(place / name)) << name;
        EXPECT_THAT(readFile(place / "Walk.html"), HasSubstr("var ImageCount = 3;"));
    }
};

/// An interrupting front end: the person asks the program to stop after so many pictures.
class InterruptedFrontEnd : public quarn::ScriptedFrontEnd {
public:
    void frameWritten(const std::filesystem::path& file, int written, int total) override {
        ScriptedFrontEnd::frameWritten(file, written, total);
        if (written == 2)
            interrupt();
    }
};

/// Puts a program into PATH that stands in for the desktop's opener and notes what it opens.
class OpenerInPath {
public:
    /// @param exit_code  what the program ends with; other than 0 says that it could open nothing
    explicit OpenerInPath(const std::filesystem::path& folder, int exit_code = 0)
        : m_journal(folder / "opened.txt"), m_path(std::getenv("PATH")) {
        const std::filesystem::path program = folder / "bin" / "xdg-open";
        std::filesystem::create_directory(program.parent_path());
        writeFile(m_journal, "");
        writeFile(program, "#!/bin/sh\necho \"$1\" >> '" + m_journal.string() + "'\nexit " +
                               std::to_string(exit_code) + "\n");
        std::filesystem::permissions(program, std::filesystem::perms::owner_all);
        setenv("PATH", program.parent_path().c_str(), 1);
    }
    ~OpenerInPath() { setenv("PATH", m_path.c_str(), 1); }
    OpenerInPath(const OpenerInPath&) = delete;
    OpenerInPath& operator=(const OpenerInPath&) = delete;

    /// The files that were opened, one a line.
    std::string opened() const { return readFile(m_journal); }

private:
    std::filesystem::path m_journal;
    std::string m_path;
};

} // namespace

TEST_F(RecordCommand, WithoutAnimationThereIsNothingToRecord) {
    record().CameraPoints().Empty();
    EXPECT_EQ(CQuarnCommand::failure, run(L"RecordAnimation"));
    EXPECT_THAT(printed(),
                HasSubstr(L"No animation is currently set. There is nothing to record\n"));
    EXPECT_TRUE(front_end.questions().empty());
}

TEST_F(RecordCommand, EnterRecordsIntoTheStoredFolder) {
    ASSERT_EQ(CQuarnCommand::success, recordWith({L"_Enter"}));
    EXPECT_THAT(files(), ElementsAre("Walk.frames.json", "Walk.html", "Walk.recording",
                                     "Walk000.jpg", "Walk001.jpg", "Walk002.jpg"));
    expectThreeFramesAndThePageIn(frames);
    EXPECT_THAT(images(), ElementsAre(L"Walk000.jpg", L"Walk001.jpg", L"Walk002.jpg"));
    EXPECT_EQ(2, record().CurrentFrame());
    EXPECT_EQ(1U, front_end.questions().size());
}

TEST_F(RecordCommand, PromptShowsTheFolderAndTheSwitch) {
    ASSERT_EQ(CQuarnCommand::success, recordWith({L"_Enter"}));
    const quarn::Question& question = front_end.questions().at(0);
    EXPECT_EQ(L"Press Enter to start recording", question.prompt.View());
    EXPECT_TRUE(question.accepts_nothing);
    ASSERT_EQ(2U, question.options.size());
    EXPECT_EQ(L"TargetFolder", question.options[0].english_name.View());
    EXPECT_EQ(wide(frames).View(), question.options[0].value.View());
    EXPECT_EQ(L"RunAnimation", question.options[1].english_name.View());
    EXPECT_EQ(L"No", question.options[1].value.View());
}

TEST_F(RecordCommand, ViewIsAsItWasAfterwards) {
    const KM_3dPoint before = view(L"Perspective").MainViewport().VP().CameraLocation();
    const KM_UUID mode = view(L"Perspective").DisplayAttributes()->Id();
    ASSERT_EQ(CQuarnCommand::success, recordWith({L"_Enter"}));
    EXPECT_TRUE(near(view(L"Perspective").MainViewport().VP().CameraLocation(), before, 0.0));
    EXPECT_EQ(mode, view(L"Perspective").DisplayAttributes()->Id());
}

TEST_F(RecordCommand, EachFormatIsWritten) {
    const struct {
        const wchar_t* extension;
        const char* file;
        std::string begin;
    } formats[] = {{L"png", "Walk001.png", "\x89PNG"},
                   {L"bmp", "Walk001.bmp", "BM"},
                   {L"tga", "Walk001.tga", std::string(2, '\0')}};
    for (const auto& format : formats) {
        record().SetFileExtension(format.extension);
        ASSERT_EQ(CQuarnCommand::success, recordWith({L"_Enter"}));
        EXPECT_TRUE(readFile(frames / format.file).starts_with(format.begin)) << format.file;
        EXPECT_GT(std::filesystem::file_size(frames / format.file), 100U);
    }
}

TEST_F(RecordCommand, CancelledPromptRecordsNothing) {
    EXPECT_EQ(CQuarnCommand::failure, recordWith({L"_Cancel"}));
    EXPECT_FALSE(std::filesystem::exists(frames));
}

TEST_F(RecordCommand, TypedFolderThatExistsIsTaken) {
    const std::filesystem::path other = folder.path() / "other place";
    std::filesystem::create_directory(other);
    ASSERT_EQ(CQuarnCommand::success, recordWith({wide(other).View(), L"_Enter"}));
    expectThreeFramesAndThePageIn(other);
    EXPECT_EQ(wide(other), record().FolderName());
    EXPECT_EQ(wide(other).View(), folderOption());
    EXPECT_EQ(wide(other).View(), front_end.questions().back().default_answer->View());
    EXPECT_FALSE(std::filesystem::exists(frames));
}

TEST_F(RecordCommand, TypedFolderIsNotTakenForAnOption) {
    std::filesystem::create_directory(folder.path() / "other");
    EXPECT_EQ(CQuarnCommand::success, recordWith({(folder.path() / "other").wstring(), L"_Enter"}));
    EXPECT_THAT(printed(), Not(HasSubstr(L"no option")));
}

TEST_F(RecordCommand, TypedFolderThatDoesNotExistLeavesThePreviousOne) {
    ASSERT_EQ(CQuarnCommand::success,
              recordWith({wide(folder.path() / "nowhere").View(), L"_Enter"}));
    EXPECT_THAT(printed(), HasSubstr(L"Folder not found\n"));
    EXPECT_EQ(wide(frames).View(), folderOption());
    expectThreeFramesAndThePageIn(frames);
}

TEST_F(RecordCommand, ScriptedFolderOptionAsksForText) {
    const std::filesystem::path other = folder.path() / "other";
    std::filesystem::create_directory(other);
    ASSERT_EQ(CQuarnCommand::success,
              recordWith({L"TargetFolder", wide(folder.path() / "nowhere").View(), L"TargetFolder",
                          wide(other).View(), L"_Enter"}));
    EXPECT_THAT(printed(), HasSubstr(L"Folder not found\n"));
    EXPECT_EQ(L"Enter target folder", front_end.questions().at(1).prompt.View());
    expectThreeFramesAndThePageIn(other);
}

TEST_F(RecordCommand, CancelledScriptedFolderRecordsNothing) {
    EXPECT_EQ(CQuarnCommand::failure, recordWith({L"TargetFolder", L"_Cancel"}));
    EXPECT_FALSE(std::filesystem::exists(frames));
}

TEST_F(RecordCommand, InteractiveFolderOptionOpensTheChooser) {
    const std::filesystem::path other = folder.path() / "other";
    front_end.addFolderChoice(std::nullopt);
    front_end.addFolderChoice(other);
    answer({L"TargetFolder", L"TargetFolder", L"_Enter"});
    ASSERT_EQ(CQuarnCommand::success, session->runCommand(L"RecordAnimation", true));
    EXPECT_THAT(printed(), HasSubstr(L"No valid folder was set\n"));
    expectThreeFramesAndThePageIn(other);
}

TEST_F(RecordCommand, ChooserSaysWhatItIsForAndBeginsInTheTargetFolderOfNow) {
    const std::filesystem::path other = folder.path() / "other";
    front_end.addFolderChoice(std::nullopt);
    front_end.addFolderChoice(other);
    front_end.addFolderChoice(std::nullopt);
    answer({L"TargetFolder", L"TargetFolder", L"TargetFolder", L"_Cancel"});
    EXPECT_EQ(CQuarnCommand::failure, session->runCommand(L"RecordAnimation", true));
    const auto& questions = front_end.folderQuestions();
    ASSERT_EQ(3U, questions.size());
    for (const auto& question : questions) {
        EXPECT_EQ(L"Quarn Animation", question.title);
        EXPECT_EQ(L"Browse for Folder", question.message);
    }
    EXPECT_EQ(frames, questions[0].start_folder);
    EXPECT_EQ(frames, questions[1].start_folder) << "nothing was chosen";
    EXPECT_EQ(other, questions[2].start_folder);
}

TEST_F(RecordCommand, EmptyTargetFolderFailsWithoutAWord) {
    record().SetFolderName(L"");
    record().Images().Append(L"before.jpg");
    EXPECT_EQ(CQuarnCommand::failure, recordWith({L"_Enter"}));
    EXPECT_EQ(L"", printed());
    EXPECT_THAT(images(), ElementsAre(L"before.jpg"));
    EXPECT_THAT(files(), IsEmpty());
}

TEST_F(RecordCommand, PageThatCannotBeWrittenFailsWithoutAWordAndStoresNothing) {
    std::filesystem::create_directories(frames / "Walk.html");
    record().Images().Append(L"before.jpg");
    const std::vector<std::uint8_t> before = bytesOf(record());
    EXPECT_EQ(CQuarnCommand::failure, recordWith({L"RunAnimation=Yes", L"_Enter"}));
    EXPECT_EQ(L"", printed());
    EXPECT_TRUE(before == bytesOf(record()));
    // The frames were written before.
    EXPECT_THAT(files(), ElementsAre("Walk.frames.json", "Walk.html", "Walk.recording",
                                     "Walk000.jpg", "Walk001.jpg", "Walk002.jpg"));
    EXPECT_EQ(CQuarnCommand::failure, recordWith({L"RunAnimation=No", L"_Cancel"}));
}

TEST_F(RecordCommand, PlaybackThatFailsStoresNothing) {
    record().SetViewportName(L"Back");
    record().Images().Append(L"before.jpg");
    EXPECT_EQ(CQuarnCommand::failure, recordWith({L"_Enter"}));
    EXPECT_THAT(printed(), HasSubstr(L"Unable to find viewport to play animation\n"));
    EXPECT_THAT(images(), ElementsAre(L"before.jpg"));
    EXPECT_FALSE(std::filesystem::exists(frames));
}

TEST_F(RecordCommand, SecondRecordingOverwritesTheFirst) {
    ASSERT_EQ(CQuarnCommand::success, recordWith({L"_Enter"}));
    const std::string page = readFile(frames / "Walk.html");
    writeFile(frames / "Walk001.jpg", "not a picture");
    writeFile(frames / "Walk.html", "not a page");
    writeFile(frames / "other.txt", "kept");
    ASSERT_EQ(CQuarnCommand::success, recordWith({L"_Enter"}));
    expectThreeFramesAndThePageIn(frames);
    EXPECT_EQ(page, readFile(frames / "Walk.html"));
    EXPECT_EQ(3, record().Images().Count());
    EXPECT_EQ("kept", readFile(frames / "other.txt"));
}

TEST_F(RecordCommand, FolderThatCannotBeMadeGivesNeitherFrameNorPage) {
    writeFile(folder.path() / "file", "kept");
    record().SetFolderName(wide(folder.path() / "file" / "frames"));
    EXPECT_EQ(CQuarnCommand::failure, recordWith({L"_Enter"}));
    EXPECT_EQ("kept", readFile(folder.path() / "file"));
    EXPECT_THAT(printed(), HasSubstr(L"/file/frames cannot be made: Not a directory\n"));
}

TEST_F(RecordCommand, RenderThatIsCancelledStopsWithAPageOfNoFrames) {
    renderSmall();
    record().SetRenderFull(true);
    front_end.setKeyDown(VK_ESCAPE, true);
    ASSERT_EQ(CQuarnCommand::success, recordWith({L"_Enter"}));
    EXPECT_THAT(files(), ElementsAre("Walk.html", "Walk.recording"));
    EXPECT_THAT(readFile(frames / "Walk.html"), HasSubstr("var ImageCount = 0;"));
    EXPECT_THAT(images(), IsEmpty());
    EXPECT_EQ(0, record().CurrentFrame());
}

TEST_F(RecordCommand, RendererWritesEveryFrameAndThePage) {
    renderSmall();
    record().SetRenderFull(true);
    ASSERT_EQ(CQuarnCommand::success, recordWith({L"_Enter"}));
    expectThreeFramesAndThePageIn(frames);
    EXPECT_EQ(3, record().Images().Count());
}

TEST_F(RecordCommand, RenderedFramesAreOfTheAnimationsViewWhicheverIsActive) {
    renderSmall();
    record().SetRenderPreview(true);
    const auto recorded = [this] {
        EXPECT_EQ(CQuarnCommand::success, recordWith({L"_Enter"}));
        std::vector<std::string> pictures;
        for (const char* name : {"Walk000.jpg", "Walk001.jpg", "Walk002.jpg"})
            pictures.push_back(readFile(frames / name));
        return pictures;
    };
    const std::vector<std::string> of_the_active_view = recorded();
    EXPECT_NE(of_the_active_view[0], of_the_active_view[2]);
    quarn::activateView(view(L"Top"));
    EXPECT_EQ(of_the_active_view, recorded());
    // Afterwards a command of its own renders the active view again.
    ASSERT_EQ(CQuarnCommand::success, run(L"RenderPreview"));
    const auto saved = [this](const char* name) {
        const std::filesystem::path file = folder.path() / name;
        EXPECT_EQ(CQuarnCommand::success, run(L"SaveRenderWindowAs \"" + wide(file) + L"\""));
        return readFile(file);
    };
    const std::string of_top = saved("top.jpg");
    quarn::activateView(view(L"Perspective"));
    ASSERT_EQ(CQuarnCommand::success, run(L"RenderPreview"));
    EXPECT_NE(of_top, saved("perspective.jpg"));
}

TEST_F(RecordCommand, RenderedSunStudyIsOfTheAnimationsViewAndLitByItsSuns) {
    renderSmall();
    setUpSunFrames(3);
    record().SetRenderPreview(true);
    ASSERT_EQ(CQuarnCommand::success, recordWith({L"_Enter"}));
    const std::string first = readFile(frames / "Walk000.jpg");
    EXPECT_NE(first, readFile(frames / "Walk002.jpg"));
    quarn::activateView(view(L"Front"));
    ASSERT_EQ(CQuarnCommand::success, recordWith({L"_Enter"}));
    EXPECT_EQ(first, readFile(frames / "Walk000.jpg"));
}

TEST_F(RecordCommand, RenderedPictureThatCannotBeSavedEndsTheRecording) {
    renderSmall();
    record().SetRenderPreview(true);
    std::filesystem::create_directories(frames / "Walk001.jpg");
    ASSERT_EQ(CQuarnCommand::success, recordWith({L"_Enter"}));
    EXPECT_THAT(files(), ElementsAre("Walk.frames.json", "Walk.html", "Walk.recording",
                                     "Walk000.jpg", "Walk001.jpg"));
    EXPECT_TRUE(std::filesystem::is_directory(frames / "Walk001.jpg"));
    // A picture that was rendered counts; the next one is not begun.
    EXPECT_THAT(images(), ElementsAre(L"Walk000.jpg", L"Walk001.jpg"));
    EXPECT_EQ(2, record().CurrentFrame());
    EXPECT_THAT(printed(), HasSubstr(L"there is a folder of this name. No more pictures are "
                                     L"rendered.\n"));
    // The next recording begins anew.
    std::filesystem::remove(frames / "Walk001.jpg");
    ASSERT_EQ(CQuarnCommand::success, recordWith({L"_Enter"}));
    expectThreeFramesAndThePageIn(frames);
}

TEST_F(RecordCommand, RenderedPicturesThatWereNotSavedAreNotCounted) {
    renderSmall();
    record().SetRenderPreview(true);
    std::filesystem::create_directories(frames / "Walk001.jpg");
    ASSERT_EQ(CQuarnCommand::success, recordWith({L"_Enter"}));
    ASSERT_EQ(1U, front_end.recordings().size());
    const quarn::RecordingReport& report = front_end.recordings()[0];
    EXPECT_EQ(3, report.expected);
    EXPECT_EQ(1, report.written);
    EXPECT_EQ(1, report.there);
    EXPECT_TRUE(report.has_page);
    EXPECT_EQ(frames / "Walk.html", report.page);
}

TEST_F(RecordCommand, PictureOfAnotherOriginIsLeftAloneAndNothingIsRecordedBesideIt) {
    std::filesystem::create_directories(frames);
    writeFile(frames / "Walk001.jpg", "a texture");
    for (const bool renders : {false, true}) {
        renderSmall();
        record().SetRenderPreview(renders);
        EXPECT_EQ(CQuarnCommand::failure, recordWith({L"_Enter"}));
        EXPECT_THAT(files(), ElementsAre("Walk001.jpg"));
        EXPECT_EQ("a texture", readFile(frames / "Walk001.jpg"));
        EXPECT_THAT(printed(), HasSubstr(L"/Walk001.jpg is not replaced: no recording named Walk "
                                         L"wrote it."));
        EXPECT_THAT(printed(), Not(HasSubstr(L"_RenderPreview")))
            << "refused before it is rendered";
        ASSERT_FALSE(front_end.recordings().empty());
        EXPECT_EQ(0, front_end.recordings().back().written);
    }
}

TEST_F(RecordCommand, FilesOfAnotherOriginMayBeSavedOverByCommandsThatNameThem) {
    renderSmall();
    writeFile(folder.path() / "Walk000.jpg", "mine");
    ASSERT_EQ(CQuarnCommand::success, run(L"RenderPreview"));
    EXPECT_EQ(CQuarnCommand::success,
              run(L"SaveRenderWindowAs \"" + wide(folder.path() / "Walk000.jpg") + L"\""));
    EXPECT_TRUE(isJpeg(folder.path() / "Walk000.jpg"));
}

TEST_F(RecordCommand, NotesWhatIsRecorded) {
    ASSERT_EQ(CQuarnCommand::success, recordWith({L"_Enter"}));
    const std::string noted = readFile(frames / "Walk.recording");
    for (const char* part :
         {"\"kind\": \"turntable\"", "\"frames\": 3", "\"width_px\": 64", "\"height_px\": 48",
          "\"mode\": \"Rendered\"", "\"extension\": \"jpg\"", "\"state\": \"ended\""})
        EXPECT_THAT(noted, HasSubstr(part));
}

TEST_F(RecordCommand, NamesThatLeaveTheFolderGiveNeitherFrameNorPage) {
    for (const wchar_t* name : {L"../Walk", L"a\nb"}) {
        record().SetHtmlFilename(name);
        std::filesystem::create_directories(frames);
        EXPECT_EQ(CQuarnCommand::failure, recordWith({L"_Enter"}));
        EXPECT_THAT(files(), IsEmpty());
        EXPECT_FALSE(std::filesystem::exists(folder.path() / "Walk.html"));
    }
}

TEST_F(RecordCommand, RunSwitchIsRememberedUntilItIsTurnedOff) {
    const OpenerInPath opener(folder.path());
    const std::string page = (frames / "Walk.html").string() + "\n";
    ASSERT_EQ(CQuarnCommand::success, recordWith({L"RunAnimation=Yes", L"_Enter"}));
    EXPECT_THAT(printed(),
                HasSubstr(L"! _Run \"" + std::wstring(wide(frames).View()) + L"/Walk.html\" "));
    EXPECT_EQ(L"Yes", front_end.questions().back().options.at(1).value.View());
    EXPECT_EQ(page, opener.opened());

    ASSERT_EQ(CQuarnCommand::success, recordWith({L"_Enter"}));
    EXPECT_EQ(page + page, opener.opened());

    ASSERT_EQ(CQuarnCommand::success, recordWith({L"RunAnimation", L"_Enter"}));
    EXPECT_EQ(page + page, opener.opened());
}

TEST_F(RecordCommand, RunSwitchIsTheSameForTheNextDocument) {
    const OpenerInPath opener(folder.path());
    EXPECT_EQ(CQuarnCommand::failure, recordWith({L"RunAnimation=Yes", L"_Cancel"}));
    ASSERT_EQ(CQuarnCommand::success, run(L"_-New"));
    setUpCameraFrames(1);
    record().SetFolderName(wide(frames));
    ASSERT_EQ(CQuarnCommand::success, run(L"ViewportSize 32 24"));
    ASSERT_EQ(CQuarnCommand::success, recordWith({L"_Enter"}));
    EXPECT_EQ((frames / "Walk.html").string() + "\n", opener.opened());
    EXPECT_EQ(CQuarnCommand::failure, recordWith({L"RunAnimation=No", L"_Cancel"}));
}

TEST_F(RecordCommand, PageThatCannotBeOpenedIsARecordingAllTheSame) {
    const OpenerInPath opener(folder.path(), 4);
    ASSERT_EQ(CQuarnCommand::success, recordWith({L"RunAnimation=Yes", L"_Enter"}));
    EXPECT_EQ((frames / "Walk.html").string() + "\n", opener.opened());
    EXPECT_THAT(printed(), HasSubstr(L"cannot be opened"));
    expectThreeFramesAndThePageIn(frames);
    EXPECT_THAT(images(), ElementsAre(L"Walk000.jpg", L"Walk001.jpg", L"Walk002.jpg"));
    EXPECT_EQ(2, record().CurrentFrame());
    EXPECT_EQ(CQuarnCommand::failure, recordWith({L"RunAnimation=No", L"_Cancel"}));
}

TEST_F(RecordCommand, PageWhosePathHasAQuoteIsNotOpened) {
    const OpenerInPath opener(folder.path());
    record().SetHtmlFilename(L"a\"b");
    ASSERT_EQ(CQuarnCommand::success, recordWith({L"RunAnimation=Yes", L"_Enter"}));
    EXPECT_THAT(printed(), Not(HasSubstr(L"_Run \"")));
    EXPECT_EQ("", opener.opened());
    EXPECT_THAT(files(), ElementsAre("a\"b.frames.json", "a\"b.html", "a\"b.recording",
                                     "a\"b000.jpg", "a\"b001.jpg", "a\"b002.jpg"));
    ASSERT_EQ(CQuarnCommand::success, recordWith({L"RunAnimation=No", L"_Enter"}));
}

TEST_F(RecordCommand, InterruptedRecordingKeepsItsFramesAndWritesThePage) {
    const std::filesystem::path model = folder.path() / "model.obj";
    session.reset();
    InterruptedFrontEnd person;
    session = std::make_unique<quarn::Session>(person, quarn::SessionOptions());
    ASSERT_TRUE(session->adoptProgramPlugIn().ok());
    ASSERT_EQ(CQuarnCommand::success,
              session->runCommand((L"Import \"" + wide(model) + L"\"").View()));
    ASSERT_EQ(CQuarnCommand::success, session->runCommand(L"ViewportSize 64 48"));
    setUpCameraFrames(10);
    record().SetFolderName(wide(frames));
    EXPECT_EQ(CQuarnCommand::success, session->runCommand(L"RecordAnimation _Enter"));
    EXPECT_THAT(files(), ElementsAre("Walk.frames.json", "Walk.html", "Walk.recording",
                                     "Walk000.jpg", "Walk001.jpg"));
    EXPECT_THAT(readFile(frames / "Walk.html"), HasSubstr("var ImageCount = 2;"));
    EXPECT_EQ(2, record().Images().Count());
    session.reset();
}

TEST_F(RecordCommand, CurvesThatASunStudyNamesStayInItsPictures) {
    importObj("v -2 -2 1\nv 2 -2 1\no rail\nl 1 2\n");
    setUpSunFrames(1);
    record().SetFileExtension(L"bmp");
    record().SetCameraPathId(objectId(L"rail"));
    record().SetTargetPathId(objectId(L"rail"));
    front_end.while_waiting = [this] { EXPECT_FALSE(isHidden(L"rail")); };
    ASSERT_EQ(CQuarnCommand::success, recordWith({L"_Enter"}));
    front_end.while_waiting = nullptr;
    const std::string with_curve = readFile(frames / "Walk000.bmp");
    ASSERT_TRUE(doc().HideObject(CQuarnObjRef(objectId(L"rail")), false));
    ASSERT_EQ(CQuarnCommand::success, recordWith({L"_Enter"}));
    EXPECT_TRUE(isHidden(L"rail")) << "what a person hid stays hidden";
    EXPECT_NE(with_curve, readFile(frames / "Walk000.bmp"));
}

TEST_F(RecordCommand, SunStudyIsRecordedWithItsDatesAndLeavesNoLight) {
    setUpSunFrames(3);
    for (int k = 0; k < 3; ++k)
        record().Dates().Append(KM_wString::FormatToString(L"Day %d", k));
    ASSERT_EQ(CQuarnCommand::success, recordWith({L"_Enter"}));
    expectThreeFramesAndThePageIn(frames);
    const std::string page = readFile(frames / "Walk.html");
    EXPECT_THAT(page, HasSubstr("bDisplayDate = 1;"));
    EXPECT_THAT(page, HasSubstr("Dates[2] = \"Day 2\"\n"));
    for (int i = 0; i < doc().LightTable().LightCount(); ++i)
        EXPECT_TRUE(doc().LightTable()[i].IsDeleted());
    // The sun stands elsewhere in each frame, so no two pictures are the same.
    EXPECT_NE(readFile(frames / "Walk000.jpg"), readFile(frames / "Walk002.jpg"));
}
