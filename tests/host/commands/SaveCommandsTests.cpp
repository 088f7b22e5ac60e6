#include "ground/PathText.h"
#include "host/document/file/ChunkIds.h"
#include "host/document/file/DocumentFile.h"
#include "tests/host/app/TestCommand.h"
#include "tests/host/document/DocumentFixtures.h"
#include "tests/host/document/QualityChanges.h"
#include "tests/support/OtherUser.h"
#include "tests/support/TempFolder.h"

#include <gmock/gmock.h>

#include <algorithm>
#include <csignal>
#include <sys/resource.h>
#include <unistd.h>

namespace quarn::test {
namespace {

using testing::ElementsAre;
using testing::HasSubstr;
using testing::IsEmpty;

/// A document with a mesh "Roof", a curve "Walk" and a point "Mark", and a folder for files.
class SaveCommandsTest : public HostTest {
protected:
    SaveCommandsTest() {
        document().objects().addMesh(L"Roof", {boxMesh({0, 0, 0}, {1, 1, 1})});
        const KM_3dPoint corners[] = {{0, 0, 0}, {5, 0, 0}};
        document().objects().addCurve(L"Walk", std::make_unique<KM_PolylineCurve>(corners));
        document().objects().addPoint(L"Mark", {1, 2, 3});
    }

    Document& document() { return Document::of(session.document()); }

    /// Runs `command words "folder/name"` and keeps what was printed.
    CQuarnCommand::result runOn(const wchar_t* command, const std::string& name) {
        front_end.clearPrinted();
        return run(KM_wString(command) + L" \"" + textFromPath(folder / name) + L"\"");
    }

    std::vector<std::string> names() {
        std::vector<std::string> all;
        for (const auto& each : document().objects().objects())
            all.push_back(each->name.ToUtf8());
        return all;
    }
    std::vector<std::string> filesOfFolder() const {
        std::vector<std::string> files;
        for (const auto& entry : std::filesystem::directory_iterator(folder.path()))
            files.push_back(entry.path().filename().string());
        std::sort(files.begin(), files.end());
        return files;
    }
    DocumentContent read(const std::string& name) {
        auto content = readDocumentFile(folder / name);
        EXPECT_TRUE(content) << (content ? "" : content.message());
        return content ? std::move(content.value()) : DocumentContent();
    }

    /// A mesh "Door" with a material in which no quality is the usual one.
    void addLacquered() {
        document().objects().addMesh(L"Door", {boxMesh({0, 0, 0}, {1, 1, 1}),
                                               std::make_shared<Material>(changedMaterial())});
    }
    const Material& lacquer() { return *document().objects().findByName(L"Door")->placed.material; }
    static std::size_t changesOf(const Material& material) {
        std::size_t count = 0;
        for (const QualityChange& change : qualityChanges())
            count += change.is_made(material) ? 1 : 0;
        return count;
    }

    TempFolder folder;
};

// ---- There and back

TEST_F(SaveCommandsTest, ASavedDocumentIsOpenedAgainWithItsObjectsAndViews) {
    const KM_UUID roof = document().objects().findByName(L"Roof")->id;
    document().objects().setVisible(document().objects().findByName(L"Mark")->id, false);
    run(L"Camera Location 1,2,3 Target 0,0,0 _Enter");
    ASSERT_EQ(runOn(L"_-SaveAs", "my house.quarn"), CQuarnCommand::success);
    EXPECT_EQ(printed(), "Saved my house.quarn.\n");

    run(L"New");
    ASSERT_EQ(runOn(L"_-Open", "my house.quarn"), CQuarnCommand::success);
    EXPECT_EQ(printed(), "my house.quarn: 1 object with 12 triangles, 1 curve, 1 point\n");
    EXPECT_THAT(names(), ElementsAre("Roof", "Walk", "Mark"));
    EXPECT_EQ(document().objects().findByName(L"Roof")->id, roof);
    EXPECT_FALSE(document().objects().findByName(L"Mark")->visible);
    EXPECT_EQ(document().objects().selectedCount(), 0);
    EXPECT_EQ(document().activeView().viewport().CameraLocation(), KM_3dPoint(1, 2, 3));
    EXPECT_EQ(document().file(), folder / "my house.quarn");
}

TEST_F(SaveCommandsTest, OpenClosesTheDocumentBeforeOnlyWhenTheFileIsGood) {
    runOn(L"_-SaveAs", "house.quarn");
    const std::string bytes = readFile(folder / "house.quarn");
    writeFile(folder / "cut.quarn", std::string_view(bytes).substr(0, bytes.size() / 2));
    RecordKeeper keeper;
    keeper.record.SetFrameCount(3);
    const unsigned int number = document().serialNumber();
    for (const char* name : {"cut.quarn", "missing.quarn"}) {
        EXPECT_EQ(runOn(L"_-Open", name), CQuarnCommand::failure);
        EXPECT_THAT(printed(), HasSubstr(name));
        EXPECT_EQ(runOn(L"_-Import", name), CQuarnCommand::failure);
    }
    EXPECT_EQ(document().serialNumber(), number);
    EXPECT_EQ(keeper.record.FrameCount(), 3) << "the record was not emptied";
    EXPECT_EQ(document().file(), folder / "house.quarn");
    EXPECT_THAT(names(), ElementsAre("Roof", "Walk", "Mark"));
    ASSERT_EQ(runOn(L"_-Open", "house.quarn"), CQuarnCommand::success);
    EXPECT_NE(document().serialNumber(), number);
}

TEST_F(SaveCommandsTest, ImportAddsADocumentAndTheFileStaysTheOpenOnes) {
    runOn(L"_-SaveAs", "house.quarn");
    ASSERT_EQ(runOn(L"_-Import", "house.quarn"), CQuarnCommand::success);
    EXPECT_THAT(printed(), HasSubstr("house.quarn: 1 object with 12 triangles, 1 curve, 1 point"));
    EXPECT_THAT(names(), ElementsAre("Roof", "Walk", "Mark", "Roof 2", "Walk 2", "Mark 2"));
    run(L"New");
    ASSERT_EQ(runOn(L"_-Import", "house.quarn"), CQuarnCommand::success);
    EXPECT_TRUE(document().file().empty());
    EXPECT_EQ(document().activeView().viewport().TargetPoint(), KM_3dPoint(2.5, 1, 1.5))
        << "the middle of what was read into the empty document";
}

TEST_F(SaveCommandsTest, TheUpAxisOfADocumentIsItsOwn) {
    runOn(L"_-SaveAs", "house.quarn");
    EXPECT_EQ(runOn(L"_-Open [Up] _Y", "house.quarn"), CQuarnCommand::failure);
    EXPECT_EQ(printed(), "A document has its axes and its meshes; leave Up and Tolerance out.\n");
}

// ---- Which file

TEST_F(SaveCommandsTest, SaveAsksForTheFileOnceAndRemembersIt) {
    ASSERT_EQ(runOn(L"_-Save", "house"), CQuarnCommand::success);
    EXPECT_THAT(filesOfFolder(), ElementsAre("house.quarn"));
    EXPECT_EQ(document().file(), folder / "house.quarn");
    run(L"_-Delete Roof");
    front_end.clearPrinted();
    ASSERT_EQ(run(L"_-Save"), CQuarnCommand::success);
    EXPECT_EQ(printed(), "Saved house.quarn.\n");
    EXPECT_EQ(read("house.quarn").objects.size(), 2U);
    run(L"New");
    EXPECT_EQ(run(L"_-Save"), CQuarnCommand::cancel) << "a new document has no file";
    EXPECT_THAT(printed(),
                HasSubstr("Save needs an answer to \"Document file\" (Version, Overwrite)"));
}

TEST_F(SaveCommandsTest, SaveAsMovesTheDocumentToTheOtherFileAndOffersIt) {
    runOn(L"_-Save", "one.quarn");
    ASSERT_EQ(runOn(L"_-SaveAs", "two.QUARN"), CQuarnCommand::success);
    EXPECT_EQ(document().file(), folder / "two.QUARN");
    run(L"_-Delete Roof");
    run(L"_-Save");
    EXPECT_EQ(read("one.quarn").objects.size(), 3U);
    EXPECT_EQ(read("two.QUARN").objects.size(), 2U);
    front_end.addAnswer(L"_Enter");
    ASSERT_EQ(run(L"SaveAs"), CQuarnCommand::success);
    EXPECT_EQ(*front_end.questions().back().default_answer, textFromPath(folder / "two.QUARN"));
}

TEST_F(SaveCommandsTest, ThroughALinkTheFileBehindItIsSaved) {
    runOn(L"_-SaveAs", "house.quarn");
    std::filesystem::create_symlink("house.quarn", folder / "link.quarn");
    run(L"New");
    document().objects().addPoint(L"Mark", {1, 2, 3});
    ASSERT_EQ(runOn(L"_-SaveAs", "link.quarn"), CQuarnCommand::success);
    EXPECT_TRUE(std::filesystem::is_symlink(folder / "link.quarn"));
    EXPECT_EQ(read("house.quarn").objects.size(), 1U);
    EXPECT_THAT(filesOfFolder(), ElementsAre("house.quarn", "link.quarn"));
}

// ---- Protected files

TEST_F(SaveCommandsTest, AWriteProtectedDocumentIsReplacedOnlyWithOverwrite) {
    runOn(L"_-SaveAs", "house.quarn");
    std::filesystem::permissions(folder / "house.quarn", std::filesystem::perms::owner_read);
    run(L"_-Delete Roof");
    const std::string other =
        "with _-SaveAs [Overwrite=Yes] \"" + (folder / "house.quarn").string();
    for (const wchar_t* line : {L"_-Save", L"_-SaveAs _Enter"}) {
        front_end.clearPrinted();
        EXPECT_EQ(run(line), CQuarnCommand::failure);
        EXPECT_THAT(printed(), HasSubstr("house.quarn is write-protected and was not replaced."));
        EXPECT_THAT(printed(), HasSubstr(other));
    }
    EXPECT_EQ(read("house.quarn").objects.size(), 3U);
    EXPECT_TRUE(document().isModified());

    EXPECT_EQ(runOn(L"_-SaveAs [Overwrite=No]", "house.quarn"), CQuarnCommand::failure);
    EXPECT_EQ(runOn(L"_-SaveAs [Overwrite=Yes]", "house.quarn"), CQuarnCommand::success);
    EXPECT_EQ(read("house.quarn").objects.size(), 2U);
    EXPECT_FALSE(document().isModified());
}

TEST_F(SaveCommandsTest, SelectedObjectsReplaceAProtectedDocumentOnlyWithOverwrite) {
    writeFile(folder / "part.quarn", "old");
    std::filesystem::permissions(folder / "part.quarn", std::filesystem::perms::owner_read);
    run(L"_-Select Roof");
    EXPECT_EQ(runOn(L"_-SaveSelected", "part.quarn"), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("with _-SaveSelected [Overwrite=Yes]"));
    EXPECT_EQ(readFile(folder / "part.quarn"), "old");
    EXPECT_EQ(runOn(L"_-SaveSelected [Overwrite]", "part.quarn"), CQuarnCommand::success);
    EXPECT_EQ(read("part.quarn").objects.size(), 1U);
}

TEST_F(SaveCommandsTest, InAFolderThatCannotBeFlushedTheDocumentIsSavedWithAWarning) {
    const std::filesystem::path box = folder / "box"; // whose files nobody may list
    std::filesystem::create_directory(box);
    if (isRoot()) {
        std::filesystem::permissions(folder.path(), std::filesystem::perms::all);
        ASSERT_EQ(chown(box.c_str(), NOBODY, NOBODY), 0);
    }
    std::filesystem::permissions(box, std::filesystem::perms::owner_write |
                                          std::filesystem::perms::owner_exec);
    EXPECT_TRUE(runAsOrdinaryUser([this] {
        return runOn(L"_-SaveAs", "box/house.quarn") == CQuarnCommand::success &&
               printed().find("could not be flushed to the disk") != std::string::npos &&
               printed().find("Saved house.quarn.") != std::string::npos &&
               !document().isModified();
    }));
    std::filesystem::permissions(box, std::filesystem::perms::owner_all);
    EXPECT_EQ(read("box/house.quarn").objects.size(), 3U);
}

// ---- Words behind the name

TEST_F(SaveCommandsTest, ANameWithBlanksWithoutQuotesIsToldAndNothingIsWritten) {
    run(L"_-Select Roof");
    const std::wstring name = L" " + (folder / "my").wstring() + L" green house.quarn";
    for (const wchar_t* command : {L"_-SaveAs", L"_-Save", L"_-SaveSelected", L"SaveAs"}) {
        front_end.clearPrinted();
        EXPECT_EQ(run((command + name).c_str()), CQuarnCommand::failure);
        EXPECT_EQ(printed(), "Nothing was written: behind the name of the file stands \"green "
                             "house.quarn\". Put a name with blanks in double quotes.\n");
    }
    EXPECT_THAT(filesOfFolder(), IsEmpty());
    EXPECT_TRUE(document().file().empty());
}

TEST_F(SaveCommandsTest, SaveOfADocumentThatHasAFileTakesNoName) {
    runOn(L"_-SaveAs", "house.quarn");
    run(L"_-Delete Roof");
    EXPECT_EQ(runOn(L"_-Save", "other.quarn"), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("Save takes no name. Save under another name with SaveAs."));
    EXPECT_EQ(read("house.quarn").objects.size(), 3U);
}

TEST_F(SaveCommandsTest, ARelativeNameIsMadeAbsolute) {
    const auto before = std::filesystem::current_path();
    std::filesystem::current_path(folder.path());
    EXPECT_EQ(run(L"_-Save house"), CQuarnCommand::success);
    std::filesystem::current_path(before);
    EXPECT_EQ(document().file(), folder / "house.quarn");
}

TEST_F(SaveCommandsTest, NamesThatAreNoDocumentsAreRefused) {
    EXPECT_EQ(runOn(L"_-SaveAs", "house.obj"), CQuarnCommand::failure);
    EXPECT_EQ(printed(), "Documents are saved as NAME.quarn files only, not as \"house.obj\".\n");
    for (const char* name : {"", ".."}) {
        EXPECT_EQ(runOn(L"_-SaveAs", name), CQuarnCommand::failure);
        EXPECT_THAT(printed(), HasSubstr("names a folder. Give the name of a file."));
    }
    EXPECT_THAT(filesOfFolder(), IsEmpty());
    EXPECT_TRUE(document().file().empty());
}

// ---- Versions

TEST_F(SaveCommandsTest, AnOlderVersionIsWrittenAndLeavesTheDocumentItsFile) {
    runOn(L"_-Save", "house.quarn");
    ASSERT_EQ(runOn(L"_-SaveAs [Version] 3", "old.quarn"), CQuarnCommand::success);
    EXPECT_EQ(read("old.quarn").version, 3);
    EXPECT_EQ(read("house.quarn").version, 5);
    EXPECT_EQ(document().file(), folder / "house.quarn");
    ASSERT_EQ(runOn(L"_-SaveAs [Version] 4 [Version] 5", "new.quarn"), CQuarnCommand::success);
    EXPECT_EQ(read("new.quarn").version, 5);
    EXPECT_EQ(document().file(), folder / "new.quarn");
}

TEST_F(SaveCommandsTest, AnOlderVersionSaysWhatItLeavesOutOfMaterials) {
    ASSERT_EQ(runOn(L"_-SaveAs [Version] 4", "plain.quarn"), CQuarnCommand::success);
    EXPECT_EQ(printed(), "Saved plain.quarn.\n");
    addLacquered();
    ASSERT_EQ(runOn(L"_-SaveAs [Version] 4", "old.quarn"), CQuarnCommand::success);
    EXPECT_EQ(printed(), "A file of version 4 holds no more of materials than their base colour: "
                         "metal, roughness, light, glass and the textures of these were left "
                         "out.\nSaved old.quarn.\n");
    EXPECT_EQ(changesOf(*read("old.quarn").objects.back().placed.material), 0U);
    ASSERT_EQ(runOn(L"_-SaveAs", "new.quarn"), CQuarnCommand::success);
    EXPECT_EQ(printed(), "Saved new.quarn.\n");
}

TEST_F(SaveCommandsTest, MaterialsAreKeptBySavingOpeningImportingAndSavingTheSelection) {
    addLacquered();
    const std::size_t all = qualityChanges().size();
    ASSERT_EQ(runOn(L"_-SaveAs", "whole.quarn"), CQuarnCommand::success);
    run(L"New");
    ASSERT_EQ(runOn(L"_-Open", "whole.quarn"), CQuarnCommand::success);
    EXPECT_EQ(changesOf(lacquer()), all);
    run(L"_-Select Door");
    ASSERT_EQ(runOn(L"_-SaveSelected", "part.quarn"), CQuarnCommand::success);
    run(L"New");
    ASSERT_EQ(runOn(L"_-Import", "part.quarn"), CQuarnCommand::success);
    EXPECT_EQ(changesOf(lacquer()), all);
}

TEST_F(SaveCommandsTest, WhatAnOlderProgramLostOfMaterialsIsTold) {
    DocumentContent content = document().content(false);
    content.unknown = {{chunk::SURFACE, {1, 2, 3}}};
    ASSERT_TRUE(writeDocumentFile(content, folder / "house.quarn"));
    for (const wchar_t* line : {L"_-Open", L"_-Import"}) {
        run(L"New");
        ASSERT_EQ(runOn(line, "house.quarn"), CQuarnCommand::success);
        EXPECT_THAT(printed(), HasSubstr("An older program saved the document. What it does not "
                                         "know of materials is lost"));
    }
}

TEST_F(SaveCommandsTest, VersionsThatDoNotExistAreRefused) {
    for (const wchar_t* line : {L"_-SaveAs [Version] 2", L"_-SaveAs [Version] 6"}) {
        EXPECT_EQ(runOn(line, "old.quarn"), CQuarnCommand::cancel);
        EXPECT_THAT(printed(), HasSubstr("Enter a number from 3 to 5."));
    }
    EXPECT_THAT(filesOfFolder(), IsEmpty());
}

// ---- The selected objects alone

TEST_F(SaveCommandsTest, SaveSelectedWritesTheSelectionAndTheDocumentKeepsItsFile) {
    runOn(L"_-Save", "house.quarn");
    run(L"_-Select Walk Mark");
    ASSERT_EQ(runOn(L"_-SaveSelected", "part.quarn"), CQuarnCommand::success);
    EXPECT_EQ(document().file(), folder / "house.quarn");
    EXPECT_EQ(read("house.quarn").objects.size(), 3U);
    run(L"New");
    runOn(L"_-Open", "part.quarn");
    EXPECT_THAT(names(), ElementsAre("Walk", "Mark"));
    EXPECT_EQ(document().views().size(), 4U);
    EXPECT_EQ(document().activeView().viewport().TargetPoint(), KM_3dPoint(2.5, 1, 1.5))
        << "the file has no views, so what is read is fitted";
}

TEST_F(SaveCommandsTest, SaveSelectedRefusesAnEmptySelectionAndTheDocumentsOwnFile) {
    runOn(L"_-Save", "house.quarn");
    EXPECT_EQ(runOn(L"_-SaveSelected", "part.quarn"), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("Nothing is selected."));
    run(L"_-Select Mark");
    EXPECT_EQ(runOn(L"_-SaveSelected", "../" + folder.path().filename().string() + "/house.quarn"),
              CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("cannot be saved over the document's own file."));
    EXPECT_EQ(read("house.quarn").objects.size(), 3U);
    EXPECT_THAT(filesOfFolder(), ElementsAre("house.quarn"));
}

// ---- Places that cannot be written to

TEST_F(SaveCommandsTest, AMissingFolderAndAFolderNameAreTold) {
    runOn(L"_-Save", "house.quarn");
    EXPECT_EQ(runOn(L"_-SaveAs", "nowhere/house.quarn"), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("nowhere"));
    std::filesystem::create_directory(folder / "folder.quarn");
    EXPECT_EQ(runOn(L"_-SaveAs", "folder.quarn"), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("folder.quarn"));
    EXPECT_TRUE(std::filesystem::is_empty(folder / "folder.quarn"));
    EXPECT_EQ(document().file(), folder / "house.quarn") << "a failed save changes nothing";
    EXPECT_THAT(filesOfFolder(), ElementsAre("folder.quarn", "house.quarn"));
}

/// No file may grow beyond 16 bytes, as on a full disk.
TEST_F(SaveCommandsTest, AFailedSaveLeavesTheOldFileWhole) {
    runOn(L"_-Save", "house.quarn");
    const std::string before = readFile(folder / "house.quarn");
    run(L"_-Delete Walk");
    rlimit old_limit{};
    getrlimit(RLIMIT_FSIZE, &old_limit);
    const auto old_signal = std::signal(SIGXFSZ, SIG_IGN);
    const rlimit limit{16, old_limit.rlim_max};
    setrlimit(RLIMIT_FSIZE, &limit);
    const CQuarnCommand::result result = run(L"_-Save");
    setrlimit(RLIMIT_FSIZE, &old_limit);
    std::signal(SIGXFSZ, old_signal);
    EXPECT_EQ(result, CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("house.quarn"));
    EXPECT_EQ(readFile(folder / "house.quarn"), before);
    EXPECT_THAT(filesOfFolder(), ElementsAre("house.quarn"));
}

/// The super user may write everywhere, so the save is another user's then.
TEST_F(SaveCommandsTest, AFolderWithoutPermissionIsToldAndTheOldFileStays) {
    constexpr uid_t SOMEBODY_ELSE = 65534;
    using std::filesystem::perms;
    runOn(L"_-Save", "house.quarn");
    const std::string before = readFile(folder / "house.quarn");
    run(L"_-Delete Walk");
    const uid_t user = geteuid();
    std::filesystem::permissions(folder.path(), perms::owner_read | perms::owner_exec |
                                                    perms::others_read | perms::others_exec);
    ASSERT_TRUE(user != 0 || seteuid(SOMEBODY_ELSE) == 0);
    const CQuarnCommand::result result = run(L"_-Save");
    ASSERT_EQ(seteuid(user), 0);
    std::filesystem::permissions(folder.path(), perms::owner_all);
    EXPECT_EQ(result, CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("house.quarn"));
    EXPECT_EQ(readFile(folder / "house.quarn"), before);
    EXPECT_THAT(filesOfFolder(), ElementsAre("house.quarn"));
}

} // namespace
} // namespace quarn::test
