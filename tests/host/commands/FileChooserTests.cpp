#include "host/document/Document.h"
#include "sdk/qncore/QnLocalize.h"
#include "tests/host/app/TestCommand.h"
#include "tests/support/TempFolder.h"

#include <gmock/gmock.h>

#include <array>
#include <fstream>

namespace quarn::test {
namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsSupersetOf;

class FileChooserTest : public HostTest {
protected:
    CQuarnCommand::result runInWindow(const wchar_t* line) {
        return session.runCommand(line, true);
    }
    void choose(const std::filesystem::path& file) {
        front_end.addFileChoice({FileChoice::Kind::chosen, file});
    }
    void giveUp() { front_end.addFileChoice({FileChoice::Kind::given_up, {}}); }
    const FileQuestion& asked() const { return front_end.fileQuestions().back(); }
    Document& document() { return Document::of(session.document()); }
    std::filesystem::path modelFile() {
        const std::filesystem::path file = folder / "a.obj";
        std::ofstream(file) << "v 0 0 0\nv 1 0 0\nv 0 1 0\nf 1 2 3\n";
        return file;
    }

    TempFolder folder;
};

TEST_F(FileChooserTest, OpenAndImportReadTheFileThatAPersonChose) {
    const std::filesystem::path file = modelFile();
    choose(file);
    ASSERT_EQ(runInWindow(L"Open"), CQuarnCommand::success) << printed();
    EXPECT_EQ(asked().kind, FileQuestion::Kind::open);
    EXPECT_STREQ(asked().title.Array(), L"Open a document or model");
    EXPECT_THAT(asked().file_kinds[0].extensions, IsSupersetOf({"quarn", "obj", "glb"}));
    EXPECT_TRUE(asked().file_kinds.back().extensions.empty()) << "every file";
    EXPECT_EQ(document().objects().objects().size(), 1U);
    choose(file);
    ASSERT_EQ(runInWindow(L"Import"), CQuarnCommand::success) << printed();
    EXPECT_EQ(document().objects().objects().size(), 2U);
    EXPECT_TRUE(front_end.questions().empty());
}

TEST_F(FileChooserTest, AClosedChooserCancelsTheCommand) {
    document().objects().addPoint(L"P", {1.0, 2.0, 3.0});
    document().objects().selectAll();
    for (const wchar_t* line : {L"Open", L"Import", L"Save", L"SaveAs", L"SaveSelected",
                                L"ImportCurve", L"LoadPlugIn", L"Run"}) {
        const std::size_t before = front_end.fileQuestions().size();
        giveUp();
        EXPECT_EQ(runInWindow(line), CQuarnCommand::cancel) << KM_wString(line).ToUtf8();
        EXPECT_EQ(front_end.fileQuestions().size(), before + 1) << KM_wString(line).ToUtf8();
    }
    EXPECT_TRUE(front_end.questions().empty());
    EXPECT_EQ(document().objects().objects().size(), 1U);
}

TEST_F(FileChooserTest, WhereNobodyChoosesTheCommandAsksAtItsPrompt) {
    front_end.addAnswer(modelFile().wstring());
    ASSERT_EQ(runInWindow(L"Open"), CQuarnCommand::success) << printed();
    ASSERT_EQ(front_end.questions().size(), 1U);
    EXPECT_STREQ(front_end.questions()[0].prompt.Array(), L"Model or document file");
}

TEST_F(FileChooserTest, ScriptsAndLinesThatNameAFileAskNoChooser) {
    const std::wstring name = modelFile().wstring();
    choose("/never/asked.obj");
    ASSERT_EQ(runInWindow((L"Open " + name).c_str()), CQuarnCommand::success) << printed();
    ASSERT_EQ(runInWindow((L"-Import " + name).c_str()), CQuarnCommand::success) << printed();
    ASSERT_EQ(run((L"Import " + name).c_str()), CQuarnCommand::success) << printed();
    front_end.addAnswer(name);
    ASSERT_EQ(runInWindow(L"-Import"), CQuarnCommand::success) << printed();
    EXPECT_TRUE(front_end.fileQuestions().empty());
}

TEST_F(FileChooserTest, SaveAsksOnceForADocumentsFileAndSaveAsOffersTheOneItHas) {
    choose(folder / "plan");
    ASSERT_EQ(runInWindow(L"Save"), CQuarnCommand::success) << printed();
    EXPECT_EQ(asked().kind, FileQuestion::Kind::save);
    EXPECT_THAT(asked().file_kinds[0].extensions, ElementsAre("quarn"));
    EXPECT_EQ(document().file(), folder / "plan.quarn");
    ASSERT_EQ(runInWindow(L"Save"), CQuarnCommand::success) << printed();
    EXPECT_EQ(front_end.fileQuestions().size(), 1U);
    choose(folder / "other.quarn");
    ASSERT_EQ(runInWindow(L"SaveAs"), CQuarnCommand::success) << printed();
    EXPECT_EQ(asked().start, folder / "plan.quarn");
    EXPECT_TRUE(std::filesystem::exists(folder / "other.quarn"));
}

TEST_F(FileChooserTest, AChooserBeginsInTheFolderOfTheDocument) {
    choose(folder / "plan.quarn");
    ASSERT_EQ(runInWindow(L"Save"), CQuarnCommand::success) << printed();
    giveUp();
    runInWindow(L"Import");
    EXPECT_EQ(asked().start, folder.path());
}

TEST_F(FileChooserTest, ADocumentIsSavedUnderNoOtherEnding) {
    choose(folder / "plan.obj");
    EXPECT_EQ(runInWindow(L"Save"), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("Documents are saved as NAME.quarn files only"));
    EXPECT_TRUE(document().file().empty());
}

// ---- The render window

class RenderingFrontEnd : public ScriptedFrontEnd {
public:
    void renderWindowShown(const ShownPicture& picture) override {
        shown.push_back(
            {picture.width_px, picture.height_px, static_cast<int>(picture.rgba.size())});
    }
    std::vector<std::array<int, 3>> shown;
};

TEST(RenderWindowShownTest, ARenderedPictureIsShownAndClosedWithItsWindowOrItsDocument) {
    RenderingFrontEnd front_end;
    Session session(front_end, {{}, {}, "C", {}});
    Document& document = Document::of(session.document());
    document.renderWindow().settings = {8, 4, 1, 1};
    ASSERT_EQ(session.runCommand(L"RenderPreview"), CQuarnCommand::success);
    EXPECT_THAT(front_end.shown, ElementsAre(std::array{8, 4, 128}));
    front_end.shown.clear();

    TempFolder folder;
    front_end.addFileChoice({FileChoice::Kind::chosen, folder / "picture"});
    ASSERT_EQ(session.runCommand(L"SaveRenderWindowAs", true), CQuarnCommand::success);
    EXPECT_TRUE(std::filesystem::exists(folder / "picture.png"));

    ASSERT_EQ(session.runCommand(L"CloseRenderWindow"), CQuarnCommand::success);
    EXPECT_THAT(front_end.shown, ElementsAre(std::array{0, 0, 0}));
    session.runCommand(L"Render");
    front_end.shown.clear();
    session.runCommand(L"New");
    EXPECT_THAT(front_end.shown, ElementsAre(std::array{0, 0, 0}));
}

// ---- Texts of the program

TEST(ProgramTextsTest, TheTablesOfTheProgramAreAskedAfterTheHosts) {
    const TempFolder folder;
    std::filesystem::create_directory(folder / "host");
    std::ofstream(folder / "host" / "de.json") << R"({"strings": {"7": "vom Wirt"}})";
    std::ofstream(folder / "de.json")
        << R"({"strings": {"7": "vom Programm", "45001": "Ansicht"}})";
    ScriptedFrontEnd front_end;
    SessionOptions options{{}, {folder / "host"}, "de", {}};
    options.program_locale_folder = folder.path();
    const Session session(front_end, options);
    EXPECT_STREQ(QnLocalizeString(L"View", 45001), L"Ansicht");
    EXPECT_STREQ(QnLocalizeString(L"by the host", 7), L"vom Wirt");
    EXPECT_STREQ(QnLocalizeString(L"in English", 45002), L"in English");
}

TEST(ProgramTextsTest, ADamagedTableOfTheProgramIsTold) {
    const TempFolder folder;
    std::ofstream(folder / "de.json") << "[";
    ScriptedFrontEnd front_end;
    SessionOptions options{{}, {}, "de", {}};
    options.program_locale_folder = folder.path();
    const Session session(front_end, options);
    EXPECT_THAT(KM_wString(front_end.printed()).ToUtf8(), HasSubstr("was left out"));
}

} // namespace
} // namespace quarn::test
