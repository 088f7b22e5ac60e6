#include "tests/host/session/RecoveryTest.h"

#include "ground/ProcessIdentity.h"

namespace quarn::test {
namespace {

namespace fs = std::filesystem;
using namespace std::chrono_literals;
using testing::AllOf;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::SizeIs;

// ---- What is kept, and where

TEST_F(RecoveryTest, UnsavedWorkComesBackWhole) {
    workOnSample("house.quarn");
    const Bytes saved = bytesOf(documents / "house.quarn");
    const Bytes before = work();
    crash();
    restart();
    ASSERT_THAT(found(), SizeIs(1));
    EXPECT_EQ(recover(session, found()[0]), std::nullopt);
    EXPECT_EQ(work(), before);
    EXPECT_TRUE(modified());
    EXPECT_EQ(documentFile(session.document()), documents / "house.quarn");
    EXPECT_EQ(bytesOf(documents / "house.quarn"), saved);
    EXPECT_THAT(printed(), HasSubstr("Recovered \"house\", kept 20"));
}

TEST_F(RecoveryTest, ADocumentWithAFileIsKeptBesideIt) {
    workOnSample("house.quarn");
    EXPECT_EQ(keeper->keepNow(), std::nullopt);
    ASSERT_THAT(recoveryFilesIn(documents), SizeIs(1));
    EXPECT_THAT(recoveryFilesIn(documents)[0].filename().native(),
                AllOf(testing::StartsWith(".house.quarn-"), HasSubstr(hostName()),
                      HasSubstr(std::to_string(getpid()))));
}

TEST_F(RecoveryTest, ADocumentThatWasNeverSavedIsKeptInTheStateFolder) {
    runAll({L"Point 1,2,3"});
    crash();
    EXPECT_THAT(recoveryFilesIn(recoveryFolder(state_folder)), SizeIs(1));
    ASSERT_THAT(found(), SizeIs(1));
    EXPECT_EQ(found()[0].document, fs::path());
    EXPECT_TRUE(found()[0].name.IsEmpty());
    EXPECT_EQ(recover(session, found()[0]), std::nullopt);
    EXPECT_EQ(objectCount(session.document()), 1);
    EXPECT_EQ(documentFile(session.document()), fs::path());
    EXPECT_TRUE(modified());
}

TEST_F(RecoveryTest, TheListTellsNameTimeAndPicture) {
    workOnSample("house.quarn");
    Image picture;
    picture.resize(document().activeView().frameWidth(), document().activeView().frameHeight());
    ASSERT_TRUE(document().activeView().copyToFrameBuffer(picture));
    document().activeView().redraw(CQuarnView::show_frame_buffer);
    const auto before = std::chrono::system_clock::now();
    crash();
    ASSERT_THAT(found(), SizeIs(1));
    const RecoverableDocument first = found()[0];
    EXPECT_EQ(first.name, L"house");
    EXPECT_EQ(first.document, documents / "house.quarn");
    EXPECT_GE(first.kept_at, before - 1s);
    EXPECT_LE(first.kept_at, std::chrono::system_clock::now());
    ASSERT_GT(first.picture.size(), 24U);
    EXPECT_EQ(first.picture[1], std::byte{'P'});
    EXPECT_EQ(std::to_integer<int>(first.picture[18]) * 256 +
                  std::to_integer<int>(first.picture[19]),
              320)
        << "the width in a PNG file's head";
}

TEST_F(RecoveryTest, APictureThatIsDrawnAfterTheDocumentWasKeptIsKeptToo) {
    runAll({L"Point 1,2,3"});
    EXPECT_EQ(keeper->keepNow(), std::nullopt);
    Image picture;
    picture.resize(document().activeView().frameWidth(), document().activeView().frameHeight());
    ASSERT_TRUE(document().activeView().copyToFrameBuffer(picture));
    crash();
    ASSERT_THAT(found(), SizeIs(1));
    EXPECT_GT(found()[0].picture.size(), 24U);
}

TEST_F(RecoveryTest, NothingIsKeptWhereNothingIsUnsaved) {
    ASSERT_TRUE(writeDocumentFile(sampleContent(), documents / "house.quarn"));
    runAll({L"Open " + path("house.quarn"), L"Camera _Location 1,2,3 _Enter"});
    keeper->beat();
    EXPECT_EQ(keeper->keepNow(), std::nullopt);
    EXPECT_EQ(keptFiles(), 0);
}

TEST_F(RecoveryTest, ABeatWritesNothingWhenNothingChanged) {
    workOnSample("house.quarn");
    EXPECT_EQ(keeper->keepNow(), std::nullopt);
    ASSERT_THAT(recoveryFilesIn(documents), SizeIs(1));
    const fs::path file = recoveryFilesIn(documents)[0];
    const auto size = fs::file_size(file);
    for (int i = 0; i < 5; ++i) {
        keeper->beat();
        EXPECT_EQ(keeper->keepNow(), std::nullopt);
    }
    EXPECT_EQ(fs::file_size(file), size);
    runAll({L"Camera _Location 1,2,3 _Enter"});
    keeper->beat();
    EXPECT_EQ(keeper->keepNow(), std::nullopt);
    EXPECT_GT(fs::file_size(file), size) << "the camera of unsaved work is kept";
}

TEST_F(RecoveryTest, MeshesAreNotWrittenAgain) {
    auto mesh = boxMesh({0, 0, 0}, {1, 1, 1});
    const auto one_box = mesh->m_F;
    for (int i = 0; i < 5000; ++i)
        mesh->m_F.insert(mesh->m_F.end(), one_box.begin(), one_box.end());
    document().objects().addMesh(L"Large", {mesh});
    EXPECT_EQ(keeper->keepNow(), std::nullopt);
    const fs::path file = recoveryFilesIn(recoveryFolder(state_folder)).at(0);
    const auto size = fs::file_size(file);
    EXPECT_GT(size, 700'000U);
    runAll({L"Line 0,0,0 1,1,1"});
    EXPECT_EQ(keeper->keepNow(), std::nullopt);
    EXPECT_GT(fs::file_size(file), size);
    EXPECT_LT(fs::file_size(file) - size, 5'000U);
}

// ---- When

TEST_F(RecoveryTest, ABeatKeepsWhatChangedWithoutWaitingForTheDisk) {
    runAll({L"Point 1,2,3"});
    keeper->beat();
    EXPECT_TRUE(waitUntil([&] { return keptFiles() == 2; }));
}

TEST_F(RecoveryTest, WhatACommandBeganWithIsKeptWhileItRuns) {
    restart(300ms);
    bool was_kept = false;
    TestCommand command(L"Long", [&](const auto&) {
        was_kept = waitUntil([&] { return keptFiles() == 2; });
        return CQuarnCommand::success;
    });
    add(command);
    runAll({L"Point 1,2,3", L"Long"});
    EXPECT_TRUE(was_kept);
}

TEST_F(RecoveryTest, WhatACommandHasDoneByHalfIsNotKept) {
    std::optional<std::string> refusal;
    TestCommand command(L"Half", [&](const auto&) {
        document().objects().addPoint(L"Half", {0, 0, 0});
        keeper->beat();
        refusal = keeper->keepNow();
        std::this_thread::sleep_for(20ms);
        return CQuarnCommand::success;
    });
    add(command);
    runAll({L"Half"});
    EXPECT_TRUE(refusal);
    EXPECT_EQ(keptFiles(), 0);
}

TEST_F(RecoveryTest, ALongerBeatWaits) {
    restart(1h);
    runAll({L"Point 1,2,3", L"Point 4,5,6"});
    keeper->beat();
    std::this_thread::sleep_for(20ms);
    EXPECT_EQ(keptFiles(), 0);
    EXPECT_EQ(keeper->keepNow(), std::nullopt);
    EXPECT_EQ(keptFiles(), 2);
}

TEST_F(RecoveryTest, CopyingManyObjectsEndsWhenTimeIsUpAndGoesOnLater) {
    for (std::uint32_t i = 0; i < 1000; ++i)
        document().objects().addPoint(L"", {0, 0, 0}, sampleId(i + 1));
    constexpr std::chrono::steady_clock::time_point long_ago{};
    int calls = 1;
    while (!document().objectCopies(long_ago) && calls < 1000)
        ++calls;
    EXPECT_GT(calls, 10);
    EXPECT_LT(calls, 100);
    ASSERT_TRUE(document().objectCopies(long_ago));
    EXPECT_THAT(*document().objectCopies(long_ago), SizeIs(1000));
}

TEST_F(RecoveryTest, ManyObjectsAreCopiedOverSeveralLooksAndComeBackAll) {
    for (std::uint32_t i = 0; i < 30'000; ++i)
        document().objects().addPoint(KM_wString::FormatToString(L"P%u", i), KM_3dPoint(i, 0, 0),
                                      sampleId(i + 1));
    restart(1ms);
    EXPECT_TRUE(waitUntil([&] {
        keeper->beat();
        return keptFiles() == 2;
    }));
    const Bytes before = work();
    crash();
    EXPECT_EQ(recover(session, found().at(0)), std::nullopt);
    EXPECT_EQ(work(), before);
}

TEST_F(RecoveryTest, EveryChangeOfAnObjectIsKept) {
    ObjectTable& objects = document().objects();
    const KM_UUID point = objects.addPoint(L"P", {1, 2, 3}).id;
    const KM_UUID curve = objects
                              .addCurve(L"C", std::make_unique<KM_PolylineCurve>(
                                                  std::vector<KM_3dPoint>{{0, 0, 0}, {1, 0, 0}}))
                              .id;
    const auto kept = [&] {
        EXPECT_EQ(keeper->keepNow(), std::nullopt);
        const auto files = recoveryFilesIn(recoveryFolder(state_folder));
        auto read = decodeRecovery(bytesOf(files.at(0)));
        EXPECT_TRUE(read) << read.message();
        return documentBytes(read.value().content);
    };
    EXPECT_EQ(kept(), work());
    objects.movePoint(point, {4, 5, 6});
    EXPECT_EQ(kept(), work());
    objects.rename(point, L"Q");
    EXPECT_EQ(kept(), work());
    objects.setVisible(curve, false);
    EXPECT_EQ(kept(), work());
    objects.replaceCurve(
        curve, std::make_unique<KM_PolylineCurve>(std::vector<KM_3dPoint>{{0, 0, 0}, {0, 7, 0}}));
    EXPECT_EQ(kept(), work());
    objects.remove(point);
    EXPECT_EQ(kept(), work());
}

// ---- When it goes

TEST_F(RecoveryTest, ASavedDocumentNeedsNoRecovery) {
    runAll({L"Point 1,2,3"});
    EXPECT_EQ(keeper->keepNow(), std::nullopt);
    EXPECT_EQ(keptFiles(), 2);
    runAll({L"SaveAs " + path("a.quarn")});
    keeper->beat();
    EXPECT_TRUE(waitUntil([&] { return keptFiles() == 0; }));
    EXPECT_TRUE(fs::exists(documents / "a.quarn"));
}

TEST_F(RecoveryTest, SavingDoesNotWaitForTheNextBeat) {
    restart(1h);
    runAll({L"Point 1,2,3"});
    EXPECT_EQ(keeper->keepNow(), std::nullopt);
    runAll({L"SaveAs " + path("a.quarn")});
    keeper->beat();
    EXPECT_TRUE(waitUntil([&] { return keptFiles() == 0; }));
}

TEST_F(RecoveryTest, ADocumentThatAnotherOneTookThePlaceOfNeedsNoRecovery) {
    runAll({L"Point 1,2,3"});
    EXPECT_EQ(keeper->keepNow(), std::nullopt);
    runAll({L"New"});
    keeper->beat();
    EXPECT_TRUE(waitUntil([&] { return keptFiles() == 0; }));
}

TEST_F(RecoveryTest, WhatWasPutBackNeedsNoRecovery) {
    runAll({L"Point 1,2,3", L"SaveAs " + path("a.quarn")});
    const KM_UUID id = document().objects().objects()[0]->id;
    document().objects().setVisible(id, false);
    EXPECT_EQ(keeper->keepNow(), std::nullopt);
    EXPECT_EQ(keptFiles(), 2);
    document().objects().setVisible(id, true);
    keeper->beat();
    EXPECT_TRUE(waitUntil([&] { return keptFiles() == 0; }));
}

TEST_F(RecoveryTest, ForgottenWorkIsKeptAgainWhenItChangesFurther) {
    runAll({L"Point 1,2,3"});
    EXPECT_EQ(keeper->keepNow(), std::nullopt);
    keeper->forget();
    EXPECT_EQ(keptFiles(), 0);
    keeper->beat();
    EXPECT_EQ(keeper->keepNow(), std::nullopt);
    EXPECT_EQ(keptFiles(), 0);
    runAll({L"Point 4,5,6"});
    EXPECT_EQ(keeper->keepNow(), std::nullopt);
    EXPECT_EQ(keptFiles(), 2);
}

TEST_F(RecoveryTest, AnEndByAPersonsWishLeavesNothing) {
    runAll({L"Point 1,2,3"});
    keeper->beat();
    EXPECT_TRUE(waitUntil([&] { return keptFiles() == 2; }));
    keeper.reset();
    EXPECT_EQ(keptFiles(), 0);
}

TEST_F(RecoveryTest, AnEndAfterASaveLeavesNothingOfWhatWasKeptBefore) {
    runAll({L"Point 1,2,3"});
    EXPECT_EQ(keeper->keepNow(), std::nullopt);
    runAll({L"SaveAs " + path("a.quarn")});
    keeper.reset();
    EXPECT_EQ(keptFiles(), 0);
}

} // namespace
} // namespace quarn::test
