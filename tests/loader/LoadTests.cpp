#include "tests/loader/LoaderTest.h"
#include "tests/support/TempFolder.h"

#include <fstream>

namespace quarn::test {
namespace {

namespace fs = std::filesystem;
using testing::EndsWith;
using testing::HasSubstr;
using testing::Not;
using testing::StartsWith;

const KM_UUID GOOD_ID = KM_UuidFromString("0B7E9B0C-6C1E-4C5B-8C55-3A8D0C9F1A01");

// ---- The way of a good plug-in

TEST_F(LoaderTest, AGoodPlugInIsInitialisedThenLoadedAndItsCommandsRun) {
    EXPECT_EQ(run(L"TestGood"), CQuarnCommand::failure) << "not before it is loaded";
    const PlugInLoad loaded = load("good.qnp");
    EXPECT_EQ(loaded.outcome, Outcome::loaded) << loaded.message;
    EXPECT_EQ(loaded.message, "");
    EXPECT_TRUE(CQuarnPlugIn::PlugInIsLoaded(GOOD_ID));
    EXPECT_EQ(run(L"TestGood"), CQuarnCommand::success);
    EXPECT_EQ(journal(), "construct init load run ");
}

TEST_F(LoaderTest, ACommandWithoutAPlugInBelongsToTheOneOfItsFile) {
    load("good.qnp");
    front_end.clearPrinted();
    run(L"TestWhose");
    EXPECT_EQ(printed(), "I belong to Test\n");
}

TEST_F(LoaderTest, UnloadingRunsInReverseAndReallyDestroysTheObjects) {
    load("good.qnp");
    session.reset();
    EXPECT_EQ(journal(), "construct init load unload exit destroy ");
}

TEST_F(LoaderTest, AFileIsLoadedOnceUnderWhateverName) {
    load("good.qnp");
    EXPECT_EQ(load("good.qnp").outcome, Outcome::loaded_before);
    EXPECT_EQ(load("../plug-ins/./good.qnp").outcome, Outcome::loaded_before);
    EXPECT_EQ(journal(), "construct init load ");
}

TEST_F(LoaderTest, APlugInComesBackInTheNextSession) {
    load("good.qnp");
    start({{}, {}, "C", {}});
    EXPECT_FALSE(CQuarnPlugIn::PlugInIsLoaded(GOOD_ID));
    EXPECT_EQ(load("good.qnp").outcome, Outcome::loaded);
    EXPECT_EQ(run(L"TestGood"), CQuarnCommand::success);
}

TEST_F(LoaderTest, TheLoadPlugInCommandLoadsAFile) {
    const std::wstring file(textOf(folder() / "good.qnp"));
    EXPECT_EQ(session->runCommand(L"_-LoadPlugIn \"" + file + L"\""), CQuarnCommand::success);
    EXPECT_EQ(printed(), "Loaded good.qnp.\n");
    EXPECT_EQ(run(L"TestGood"), CQuarnCommand::success);
}

// ---- The ways loading fails

TEST_F(LoaderTest, AMissingFileIsTold) {
    const PlugInLoad loaded = load("nowhere.qnp");
    EXPECT_EQ(loaded.outcome, Outcome::file_missing);
    EXPECT_THAT(loaded.message, EndsWith("nowhere.qnp."));
    EXPECT_EQ(session->loadPlugIn(folder()).outcome, Outcome::file_missing) << "a folder";
}

TEST_F(LoaderTest, ATextFileIsNoLibrary) {
    const TempFolder folder;
    const fs::path file = folder / "text.qnp";
    std::ofstream(file) << "I am a text.\n";
    const PlugInLoad loaded = session->loadPlugIn(file);
    EXPECT_EQ(loaded.outcome, Outcome::not_a_library);
    EXPECT_THAT(loaded.message, HasSubstr("text.qnp cannot be loaded as a library: "));
}

TEST_F(LoaderTest, MissingExportsAreNamedAndTheObjectsDropped) {
    const PlugInLoad loaded = load("missing_exports.qnp");
    EXPECT_EQ(loaded.outcome, Outcome::exports_missing);
    EXPECT_THAT(loaded.message, HasSubstr("does not export QuarnPlugInSdkServiceRelease."));
    EXPECT_EQ(journal(), "construct destroy ");
    EXPECT_EQ(run(L"TestGood"), CQuarnCommand::failure);
}

TEST_F(LoaderTest, AnotherVersionIsRefusedWithBothNumbersAndTheObjectsDropped) {
    const PlugInLoad loaded = load("wrong_version.qnp");
    EXPECT_EQ(loaded.outcome, Outcome::version_mismatch);
    EXPECT_THAT(loaded.message, HasSubstr("2353819967"));
    EXPECT_THAT(loaded.message, HasSubstr("2353819966"));
    EXPECT_EQ(journal(), "construct destroy ");
    EXPECT_EQ(run(L"TestGood"), CQuarnCommand::failure);
}

TEST_F(LoaderTest, APlugInLinkedAgainstAnotherHostIsRefusedBeforeItsCodeRuns) {
    const PlugInLoad loaded = load("foreign_interface.qnp");
    EXPECT_EQ(loaded.outcome, Outcome::version_mismatch) << loaded.message;
    EXPECT_THAT(loaded.message, HasSubstr("QNCORE_1"));
    EXPECT_EQ(journal(), "");
}

struct Refusal {
    const char* fault;
    const char* reason;
    const char* journal;
};

class RefusalTest : public LoaderTest, public testing::WithParamInterface<Refusal> {};

TEST_P(RefusalTest, IsToldAndNothingOfThePlugInStays) {
    setenv("QUARN_TEST_FAULT", GetParam().fault, 1);
    const PlugInLoad loaded = load("refusing.qnp");
    EXPECT_EQ(loaded.outcome, Outcome::load_refused);
    EXPECT_THAT(loaded.message, HasSubstr(GetParam().reason));
    EXPECT_EQ(journal(), GetParam().journal);
    EXPECT_EQ(run(L"TestRefusing"), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("Unknown command: TestRefusing."));
}

INSTANTIATE_TEST_SUITE_P(
    Loader, RefusalTest,
    testing::Values(Refusal{"init=refuse", "its InitInstance refused", "construct init destroy "},
                    Refusal{"init=throw", "thrown in init", "construct init destroy "},
                    Refusal{"load=refuse", "its OnLoadPlugIn refused",
                            "construct init load exit destroy "},
                    Refusal{"load=throw", "thrown in load", "construct init load exit destroy "},
                    Refusal{"id=refuse", "it has no id", "construct destroy "},
                    Refusal{"id=throw", "it has no id", "construct destroy "}));

TEST_F(LoaderTest, APlugInFileHasOnePlugInObject) {
    EXPECT_THAT(load("two_plug_ins.qnp").message, HasSubstr("2 plug-in objects instead of one"));
    EXPECT_EQ(load("no_plug_in.qnp").outcome, Outcome::load_refused);
    EXPECT_EQ(journal(), "construct construct destroy destroy ");
}

TEST_F(LoaderTest, AnIdOrACommandNameThatIsTakenIsRefused) {
    load("good.qnp");
    EXPECT_THAT(load("same_id.qnp").message, HasSubstr("a plug-in with the id 0B7E9B0C"));
    const PlugInLoad taken = load("taken_name.qnp");
    EXPECT_EQ(taken.outcome, Outcome::load_refused);
    EXPECT_THAT(taken.message, HasSubstr("There is a command HELP already."));
    EXPECT_EQ(run(L"TestFirst"), CQuarnCommand::failure) << "its other command went with it";
    EXPECT_EQ(run(L"Help"), CQuarnCommand::success);
    EXPECT_EQ(run(L"TestGood"), CQuarnCommand::success);
}

TEST_F(LoaderTest, WhatAPlugInThrowsInItsCommandsAndAtItsEndStopsAtTheBorder) {
    ASSERT_TRUE(load("refusing.qnp").ok());
    setenv("QUARN_TEST_FAULT", "run=throw", 1);
    EXPECT_EQ(run(L"TestRefusing"), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("TestRefusing stopped with an error: thrown in run"));
    setenv("QUARN_TEST_FAULT", "unload=throw", 1);
    session.reset();
    EXPECT_THAT(printed(), HasSubstr("stopped with an error: thrown in unload"));
    EXPECT_EQ(journal(), "construct init load unload exit destroy ");
}

// ---- Texts

TEST_F(LoaderTest, APlugInsStringTableStandsBesideTheHosts) {
    const TempFolder tables;
    fs::create_directories(tables / "host");
    fs::create_directories(tables / "good");
    std::ofstream(tables / "good" / "de.json") << R"({"strings": {"7": "Ich gehöre "}})";
    start({{}, {tables / "host"}, "de", {}});
    ASSERT_TRUE(load("good.qnp").ok());
    run(L"TestWhose");
    EXPECT_EQ(printed(), "Ich gehöre Test\n");
}

TEST_F(LoaderTest, AMalformedTableIsToldAndThePlugInLoads) {
    const TempFolder tables;
    fs::create_directories(tables / "good");
    std::ofstream(tables / "good" / "de.json") << "{";
    start({{}, {tables / "host"}, "de", {}});
    EXPECT_TRUE(load("good.qnp").ok());
    EXPECT_THAT(printed(), HasSubstr("de.json was left out"));
    EXPECT_EQ(run(L"TestWhose"), CQuarnCommand::success);
}

// ---- By id

TEST_F(LoaderTest, TheDialogPlugInIsFoundByItsIdInThePlugInFolders) {
    start({{folder() / "nowhere", folder() / "dialogs"}, {}, "C", {}});
    EXPECT_FALSE(CQuarnPlugIn::PlugInIsLoaded(ZelVexUiPlugInId));
    EXPECT_EQ(QnZoetrixVexUiTurnTable(), nullptr);
    EXPECT_EQ(CQuarnPlugIn::LoadPlugIn(ZelVexUiPlugInId, true, true), 0);
    EXPECT_EQ(CQuarnPlugIn::LoadPlugIn(ZelVexUiPlugInId, true, true), 1);
    EXPECT_TRUE(CQuarnPlugIn::PlugInIsLoaded(ZelVexUiPlugInId));
    EXPECT_NE(QnZoetrixVexUiTurnTable(), nullptr);
    EXPECT_NE(QnZoetrixVexUiPathAnimation(), nullptr);
    EXPECT_NE(QnZoetrixVexUiDay(), nullptr);
    EXPECT_NE(QnZoetrixVexUiSeason(), nullptr);
}

TEST_F(LoaderTest, ADialogPlugInWithoutDialogsHasNoEntryPoints) {
    start({{folder() / "no-dialogs"}, {}, "C", {}});
    EXPECT_EQ(CQuarnPlugIn::LoadPlugIn(ZelVexUiPlugInId, true, true), 0);
    EXPECT_EQ(QnZoetrixVexUiTurnTable(), nullptr);
    EXPECT_EQ(QnZoetrixVexUiPathAnimation(), nullptr);
    EXPECT_EQ(QnZoetrixVexUiDay(), nullptr);
    EXPECT_EQ(QnZoetrixVexUiSeason(), nullptr);
}

TEST_F(LoaderTest, AMissingDialogPlugInIsToldUnlessQuiet) {
    EXPECT_EQ(CQuarnPlugIn::LoadPlugIn(ZelVexUiPlugInId, true, true), -2);
    EXPECT_EQ(printed(), "");
    EXPECT_EQ(CQuarnPlugIn::LoadPlugIn(ZelVexUiPlugInId, false, true), -2);
    EXPECT_EQ(printed(), "There is no plug-in file ZEL_VexUI.qnp.\n");
}

TEST_F(LoaderTest, WhatARefusingPlugInPrintsIsAReasonThatAQuietLoadKeepsBack) {
    start({{folder() / "talkative"}, {}, "C", {}});
    setenv("QUARN_TEST_FAULT", "load", 1);
    EXPECT_EQ(CQuarnPlugIn::LoadPlugIn(ZelVexUiPlugInId, true, true), -5);
    EXPECT_EQ(printed(), "");
    EXPECT_EQ(CQuarnPlugIn::LoadPlugIn(ZelVexUiPlugInId, false, true), -5);
    EXPECT_THAT(printed(), StartsWith("I look around.\nThe plug-in "));
    EXPECT_THAT(printed(), EndsWith("its OnLoadPlugIn refused.\n"));
}

TEST_F(LoaderTest, WhatAPlugInPrintsWhileItIsLoadedIsShownAlsoByAQuietLoad) {
    start({{folder() / "talkative"}, {}, "C", {}});
    EXPECT_EQ(CQuarnPlugIn::LoadPlugIn(ZelVexUiPlugInId, true, true), 0);
    EXPECT_EQ(printed(), "I look around.\n");
}

TEST_F(LoaderTest, AFileWithAnotherIdThanItsNamePromisesIsRefused) {
    start({{folder() / "impostor"}, {}, "C", {}});
    EXPECT_EQ(CQuarnPlugIn::LoadPlugIn(ZelVexUiPlugInId, false, true), -5);
    EXPECT_THAT(printed(), HasSubstr("it has another id"));
    EXPECT_EQ(journal(), "construct destroy ");
}

TEST_F(LoaderTest, AnUnknownIdIsTold) {
    EXPECT_EQ(CQuarnPlugIn::LoadPlugIn(GOOD_ID, false, true), -1);
    EXPECT_THAT(printed(),
                HasSubstr("No plug-in with the id 0B7E9B0C-6C1E-4C5B-8C55-3A8D0C9F1A01"));
}

} // namespace
} // namespace quarn::test
