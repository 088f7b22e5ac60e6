#include "tests/host/session/RecoveryTest.h"

namespace quarn::test {
namespace {

namespace fs = std::filesystem;
using namespace std::chrono_literals;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::SizeIs;

// ---- Troubles

TEST_F(RecoveryTest, ATroubleIsToldOnceAndWorkGoesOn) {
    fs::remove_all(folder / "home");
    writeFile(folder / "home", "no folder");
    runAll({L"Point 1,2,3"});
    const auto kept = keeper->keepNow();
    ASSERT_TRUE(kept);
    EXPECT_THAT(*kept, HasSubstr("Unsaved work cannot be kept for recovery"));
    EXPECT_EQ(keeper->takeTrouble(), kept);
    for (int i = 0; i < 3; ++i) {
        runAll({L"Point 4,5,6"});
        keeper->beat();
        EXPECT_TRUE(keeper->keepNow());
        EXPECT_EQ(keeper->takeTrouble(), std::nullopt);
    }
    fs::remove(folder / "home");
    EXPECT_EQ(keeper->keepNow(), std::nullopt) << "it tries again though nothing changed";
    EXPECT_EQ(keptFiles(), 2);
}

TEST_F(RecoveryTest, ADamagedFileIsToldAndTheDocumentAtWorkStays) {
    workOnSample("house.quarn");
    crash();
    const RecoverableDocument damaged = found().at(0);
    Bytes bytes = bytesOf(damaged.recovery);
    bytes[bytes.size() / 2] ^= 1;
    writeFile(damaged.recovery, std::string(bytes.begin(), bytes.end()));
    runAll({L"Point 7,8,9"});
    const auto refusal = recover(session, damaged);
    ASSERT_TRUE(refusal);
    EXPECT_THAT(*refusal, HasSubstr("damaged"));
    EXPECT_THAT(*refusal, HasSubstr(damaged.recovery.native()));
    EXPECT_EQ(objectCount(session.document()), 1);
    fs::remove(damaged.recovery);
    EXPECT_THAT(recover(session, damaged).value_or(""), HasSubstr("there is no such file"));
}

TEST_F(RecoveryTest, ATornEndIsToldWithTheTimeOfWhatIsThere) {
    workOnSample("house.quarn");
    const Bytes before = work();
    EXPECT_EQ(keeper->keepNow(), std::nullopt);
    runAll({L"Point 4,5,6"});
    crash();
    const RecoverableDocument torn = found().at(0);
    fs::resize_file(torn.recovery, fs::file_size(torn.recovery) - 1);
    EXPECT_EQ(recover(session, torn), std::nullopt);
    EXPECT_EQ(work(), before);
    EXPECT_THAT(printed(), HasSubstr("The last of what was kept is not whole"));
}

TEST_F(RecoveryTest, AFileThatWasChangedMeanwhileIsWarnedOf) {
    workOnSample("house.quarn");
    crash();
    fs::last_write_time(documents / "house.quarn", fs::file_time_type::clock::now() + 1h);
    EXPECT_EQ(recover(session, found().at(0)), std::nullopt);
    EXPECT_THAT(printed(), HasSubstr("house.quarn was changed after this was kept"));
}

// ---- What is found

TEST_F(RecoveryTest, WorkOfARunningProgramIsNotOffered) {
    runAll({L"Point 1,2,3"});
    EXPECT_EQ(keeper->keepNow(), std::nullopt);
    EXPECT_THAT(found(), IsEmpty());
}

TEST_F(RecoveryTest, WorkOfAnotherMachineIsNotOffered) {
    runAll({L"Point 1,2,3"});
    crash();
    auto mark = readMark(found().at(0).mark);
    mark->writer.host += "-other";
    fs::remove(found().at(0).mark);
    ASSERT_TRUE(writeMark(recoveryFolder(state_folder), *mark));
    EXPECT_THAT(found(), IsEmpty());
    EXPECT_EQ(keptFiles(), 2);
}

TEST_F(RecoveryTest, TheLastKeptComesFirst) {
    for (const wchar_t* name : {L"a", L"b", L"c"}) {
        std::this_thread::sleep_for(2ms);
        workOnSample((std::string(1, static_cast<char>(name[0])) + ".quarn").c_str());
        crash();
        restart();
    }
    ASSERT_THAT(found(), SizeIs(3));
    EXPECT_EQ(found()[0].name, L"c");
    EXPECT_EQ(found()[2].name, L"a");
}

TEST_F(RecoveryTest, MarksOfWhatIsGoneAreClearedButNotThoseOfADiskThatIsNotThere) {
    workOnSample("a.quarn");
    crash();
    restart();
    workOnSample("b.quarn");
    crash();
    const RecoverableDocument b = found().at(0);
    const fs::path away = folder / "away";
    fs::rename(documents, away);
    EXPECT_THAT(found(), IsEmpty());
    fs::rename(away, documents);
    EXPECT_THAT(found(), SizeIs(2));
    fs::remove(b.recovery);
    EXPECT_THAT(found(), SizeIs(1));
    EXPECT_FALSE(fs::exists(b.mark));
}

TEST_F(RecoveryTest, ARecoveredDocumentIsKeptByItsNewProgramAtOnceAndTheOldFileGoes) {
    workOnSample("house.quarn");
    crash();
    restart(1h);
    const RecoverableDocument old = found().at(0);
    EXPECT_EQ(recover(session, old), std::nullopt);
    EXPECT_TRUE(fs::exists(old.recovery));
    keeper->beat();
    EXPECT_TRUE(waitUntil([&] { return !fs::exists(old.mark); }));
    EXPECT_FALSE(fs::exists(old.recovery));
    EXPECT_THAT(recoveryFilesIn(documents), SizeIs(1));
    runAll({L"Save"});
    keeper->beat();
    EXPECT_TRUE(waitUntil([&] { return keptFiles() == 0; }));
}

TEST_F(RecoveryTest, ARecoveredDocumentThatIsSavedAtOnceLeavesNothing) {
    workOnSample("house.quarn");
    const Bytes before = work();
    crash();
    restart(1h);
    EXPECT_EQ(recover(session, found().at(0)), std::nullopt);
    runAll({L"Save"});
    keeper.reset();
    EXPECT_EQ(keptFiles(), 0);
    EXPECT_EQ(bytesOf(documents / "house.quarn"), before);
}

TEST_F(RecoveryTest, DiscardedWorkIsGone) {
    workOnSample("house.quarn");
    crash();
    discard(found().at(0));
    EXPECT_EQ(keptFiles(), 0);
    EXPECT_THAT(found(), IsEmpty());
}

// ---- The command

TEST_F(RecoveryTest, TheCommandListsAndOpensWhatThereIs) {
    EXPECT_EQ(run(L"Recover"), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("no unsaved document to recover"));
    workOnSample("house.quarn");
    const Bytes before = work();
    crash();
    restart();
    runAll({L"Recover _Enter"});
    EXPECT_THAT(printed(), HasSubstr("1: \"house\", kept 20"));
    EXPECT_EQ(work(), before);
    EXPECT_TRUE(modified());
}

TEST_F(RecoveryTest, TheCommandDiscardsTheOneThatIsNamed) {
    for (const char* name : {"a.quarn", "b.quarn"}) {
        std::this_thread::sleep_for(2ms);
        workOnSample(name);
        crash();
        restart();
    }
    EXPECT_EQ(run(L"Recover 3"), CQuarnCommand::cancel);
    runAll({L"Recover _Discard 2"});
    ASSERT_THAT(found(), SizeIs(1));
    EXPECT_EQ(found()[0].name, L"b");
}

} // namespace
} // namespace quarn::test
