#include "ground/ProcessIdentity.h"
#include "host/app/DocumentsFolder.h"
#include "sdk/qncore/QnDirDialog.h"
#include "sdk/qncore/QnFileUtilities.h"
#include "sdk/qncore/QnTextFile.h"
#include "tests/host/app/TestCommand.h"
#include "tests/support/TempFolder.h"

#include <cstdlib>
#include <fstream>
#include <iterator>
#include <sys/wait.h>
#include <unistd.h>

namespace quarn::test {
namespace {

namespace fs = std::filesystem;

std::string bytesOf(const fs::path& file) {
    std::ifstream stream(file, std::ios::binary);
    return {std::istreambuf_iterator<char>(stream), {}};
}

KM_wString wide(const fs::path& path) {
    return KM_wString::FromUtf8(path.native());
}

/// A fresh folder, which is also the home folder and names no other.
class FilesAndFolders : public HostTest {
protected:
    void SetUp() override {
        fs::create_directories(home / ".config");
        setenv("HOME", home.c_str(), 1);
        unsetenv("XDG_CONFIG_HOME");
    }
    void TearDown() override { setenv("HOME", old_home.c_str(), 1); }
    void writeUserFolders(const std::string& text) {
        std::ofstream(home / ".config" / "user-dirs.dirs") << text;
    }

    const std::string old_home = std::getenv("HOME") ? std::getenv("HOME") : "";
    const TempFolder folder_of_home;
    const fs::path home = folder_of_home.path();
};

// ---- The documents folder

TEST_F(FilesAndFolders, TheDocumentsFolderIsTheConfiguredOne) {
    EXPECT_EQ(documentsFolder("/my/texts"), fs::path("/my/texts"));
}

TEST_F(FilesAndFolders, TheDocumentsFolderIsTheDesktopsBeforeDocumentsAtHome) {
    fs::create_directories(home / "Documents");
    EXPECT_EQ(documentsFolder({}), home / "Documents");
    fs::create_directories(home / "Meine Texte");
    writeUserFolders("# a remark\nXDG_MUSIC_DIR=\"$HOME/Musik\"\n"
                     "XDG_DOCUMENTS_DIR=\"$HOME/Meine Texte\"\n");
    EXPECT_EQ(documentsFolder({}), home / "Meine Texte");
    writeUserFolders("#XDG_DOCUMENTS_DIR=\"$HOME/Meine Texte\"\n");
    EXPECT_EQ(documentsFolder({}), home / "Documents");
}

TEST_F(FilesAndFolders, WithoutAnyDocumentsFolderThereIsNoneAndTheTextIsUntouched) {
    writeUserFolders("XDG_DOCUMENTS_DIR=\"$HOME/\"\n");
    EXPECT_EQ(documentsFolder({}), std::nullopt);
    KM_wString folder = L"before";
    EXPECT_FALSE(CQuarnFileUtilities::GetMyDocumentsFolder(folder));
    EXPECT_STREQ(folder, L"before");
}

TEST_F(FilesAndFolders, TheDocumentsFolderHasNoSeparatorAtItsEnd) {
    fs::create_directories(home / "Texts");
    writeUserFolders("XDG_DOCUMENTS_DIR=\"$HOME/Texts/\"\n");
    KM_wString folder;
    EXPECT_TRUE(CQuarnFileUtilities::GetMyDocumentsFolder(folder));
    EXPECT_STREQ(folder, wide(home / "Texts"));
}

// ---- Folders

TEST_F(FilesAndFolders, AFolderExistsAndAFileIsNone) {
    std::ofstream(home / "file") << "x";
    EXPECT_TRUE(CQuarnFileUtilities::DirExists(wide(home)));
    EXPECT_FALSE(CQuarnFileUtilities::DirExists(wide(home / "file")));
    EXPECT_FALSE(CQuarnFileUtilities::DirExists(wide(home / "missing")));
    EXPECT_FALSE(CQuarnFileUtilities::DirExists(nullptr));
    EXPECT_FALSE(CQuarnFileUtilities::DirExists(L""));
}

TEST_F(FilesAndFolders, AFolderIsMadeWithThoseAboveIt) {
    const KM_wString folder = wide(home / "a" / "größe" / "c");
    EXPECT_TRUE(CQuarnFileUtilities::CreateDir(folder));
    EXPECT_TRUE(CQuarnFileUtilities::CreateDir(folder)) << "it exists now";
    EXPECT_TRUE(CQuarnFileUtilities::CreateDir(folder + L"/"));
    EXPECT_TRUE(fs::is_directory(home / "a" / "größe" / "c"));
}

TEST_F(FilesAndFolders, AFolderInPlaceOfAFileCannotBeMade) {
    std::ofstream(home / "file") << "x";
    EXPECT_FALSE(CQuarnFileUtilities::CreateDir(wide(home / "file")));
    EXPECT_FALSE(CQuarnFileUtilities::CreateDir(wide(home / "file" / "below")));
    EXPECT_FALSE(CQuarnFileUtilities::CreateDir(nullptr));
    EXPECT_FALSE(CQuarnFileUtilities::CreateDir(L""));
    EXPECT_EQ(bytesOf(home / "file"), "x");
}

TEST_F(FilesAndFolders, WhyAFolderCannotBeMadeIsTold) {
    const fs::path folder = home / "file" / "below";
    std::ofstream(home / "file") << "x";
    EXPECT_FALSE(CQuarnFileUtilities::CreateDir(wide(folder)));
    EXPECT_EQ(printed(), "The folder " + folder.string() + " cannot be made: Not a directory\n");
}

TEST_F(FilesAndFolders, TheFolderChooserAnswersWithTheChoiceOrKeepsItsStart) {
    front_end.addFolderChoice(std::nullopt);
    front_end.addFolderChoice(fs::path("/chosen"));
    CQuarnUiDirDialog dialog(L"Title", L"Message", L"/start", nullptr);
    EXPECT_EQ(dialog.DoModal(), 2);
    EXPECT_STREQ(dialog.GetPathName(), L"/start");
    EXPECT_EQ(dialog.DoModal(), 1);
    EXPECT_STREQ(dialog.GetPathName(), L"/chosen");
    ASSERT_EQ(front_end.folderQuestions().size(), 2U);
    EXPECT_EQ(front_end.folderQuestions()[0].title, L"Title");
    EXPECT_EQ(front_end.folderQuestions()[0].message, L"Message");
    EXPECT_EQ(front_end.folderQuestions()[0].start_folder, fs::path("/start"));
}

// ---- Text files

using filetype = CQnTextFile::filetype;
using open_mode = CQnTextFile::open_mode;

TEST_F(FilesAndFolders, ATextFileIsUtf8WithAMarkWhereThatIsAskedFor) {
    const fs::path path = home / "page.html";
    CQnTextFile file;
    ASSERT_TRUE(file.Open(wide(path), open_mode::write, filetype::utf8_bom));
    EXPECT_TRUE(file.WriteString(L"für "));
    EXPECT_TRUE(file.WriteString(L"日本\n"));
    EXPECT_TRUE(file.WriteString(nullptr));
    EXPECT_TRUE(file.Close());
    EXPECT_EQ(bytesOf(path), "\xEF\xBB\xBF"
                             "für 日本\n");
}

TEST_F(FilesAndFolders, ATextFileAppearsWhenItIsClosed) {
    const fs::path path = home / "page.html";
    std::ofstream(path) << "old";
    CQnTextFile file;
    ASSERT_TRUE(file.Open(wide(path), open_mode::write, filetype::ansi));
    EXPECT_FALSE(file.Open(wide(home / "other"), open_mode::write, filetype::ansi));
    file.WriteString(L"ü日");
    EXPECT_EQ(bytesOf(path), "old");
    EXPECT_TRUE(file.Close());
    EXPECT_EQ(bytesOf(path), "\xFC?");
    EXPECT_FALSE(file.Close());
    EXPECT_FALSE(file.WriteString(L"late"));
}

TEST_F(FilesAndFolders, ATextFileThatIsForgottenIsClosed) {
    {
        CQnTextFile file;
        ASSERT_TRUE(file.Open(wide(home / "forgotten"), open_mode::write, filetype::utf8));
        file.WriteString(L"text");
    }
    EXPECT_EQ(bytesOf(home / "forgotten"), "text");
}

TEST_F(FilesAndFolders, WhyATextFileCannotBeClosedIsTold) {
    const fs::path folder = home / "gone";
    fs::create_directory(folder);
    CQnTextFile file;
    ASSERT_TRUE(file.Open(wide(folder / "page.html"), open_mode::write, filetype::utf8));
    fs::remove(folder);
    EXPECT_FALSE(file.Close());
    EXPECT_EQ(printed(), "Cannot write '" + (folder / "page.html").string() +
                             "': its folder does not exist.\n");
}

TEST_F(FilesAndFolders, ATextFileThroughALinkGoesWhereTheLinkLeads) {
    fs::create_directory(home / "there");
    fs::create_symlink("there/page.html", home / "page.html");
    CQnTextFile file;
    ASSERT_TRUE(file.Open(wide(home / "page.html"), open_mode::write, filetype::utf8));
    file.WriteString(L"text");
    ASSERT_TRUE(file.Close());
    EXPECT_TRUE(fs::is_symlink(home / "page.html"));
    EXPECT_EQ(bytesOf(home / "there" / "page.html"), "text");
}

TEST_F(FilesAndFolders, AWriteProtectedTextFileStaysAndIsTold) {
    const fs::path path = home / "page.html";
    std::ofstream(path) << "old";
    fs::permissions(path, fs::perms::owner_read);
    CQnTextFile file;
    ASSERT_TRUE(file.Open(wide(path), open_mode::write, filetype::utf8));
    EXPECT_FALSE(file.Close());
    EXPECT_NE(printed().find("page.html': it is write-protected"), std::string::npos) << printed();
    EXPECT_EQ(bytesOf(path), "old");
}

TEST_F(FilesAndFolders, ATextFileTakesAwayWhatAnEndedProgramLeftBesideIt) {
    const pid_t ended = fork();
    if (ended == 0)
        _exit(0);
    int status = 0;
    ASSERT_EQ(waitpid(ended, &status, 0), ended);
    const fs::path left = home / (".quarn-" + hostName() + "-" + std::to_string(ended) + "-0.part");
    std::ofstream(left) << "half a picture";
    CQnTextFile file;
    ASSERT_TRUE(file.Open(wide(home / "page.html"), open_mode::write, filetype::utf8));
    ASSERT_TRUE(file.Close());
    EXPECT_FALSE(fs::exists(left));
}

TEST_F(FilesAndFolders, ATextFileNeedsAFolderAndAName) {
    CQnTextFile file;
    EXPECT_FALSE(file.Open(nullptr, open_mode::write, filetype::utf8));
    EXPECT_FALSE(file.Open(L"", open_mode::write, filetype::utf8));
    EXPECT_FALSE(file.Open(wide(home), open_mode::write, filetype::utf8));
    EXPECT_FALSE(file.Open(wide(home / "missing" / "x"), open_mode::write, filetype::utf8));
}

} // namespace
} // namespace quarn::test
