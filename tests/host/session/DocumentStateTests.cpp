#include "host/session/DocumentState.h"

#include "engine/display/DisplayMode.h"
#include "host/session/AnimationState.h"
#include "host/session/ViewFrame.h"
#include "host/session/ViewNavigation.h"
#include "tests/host/app/TestCommand.h"
#include "tests/host/document/DocumentFixtures.h"
#include "tests/support/TempFolder.h"

#include <fstream>

namespace quarn::test {
namespace {

KM_Light lamp() {
    KM_Light light;
    light.SetStyle(KM_LightStyle::world_point);
    light.SetLocation({1.0, 2.0, 3.0});
    return light;
}

class DocumentStateTest : public HostTest {
protected:
    Document& document() { return Document::of(session.document()); }
    bool modified() { return isModified(session.document()); }
    std::wstring path(const char* name) const {
        return L"\"" + (folder.path() / name).wstring() + L"\"";
    }
    void runAll(std::initializer_list<std::wstring> lines) {
        for (const std::wstring& line : lines)
            ASSERT_EQ(session.runCommand(line), CQuarnCommand::success) << printed();
    }

    TempFolder folder;
};

TEST_F(DocumentStateTest, ANewDocumentIsUnmodifiedWithoutFileAndWithoutObjects) {
    EXPECT_FALSE(modified());
    EXPECT_EQ(documentFile(session.document()), std::filesystem::path());
    EXPECT_EQ(objectCount(session.document()), 0);
    runAll({L"Point 1,2,3", L"New"});
    EXPECT_FALSE(modified());
    EXPECT_EQ(objectCount(session.document()), 0);
}

TEST_F(DocumentStateTest, SavingRemembersTheFileAndTheDocumentIsUnmodifiedAgain) {
    runAll({L"Point 1,2,3"});
    EXPECT_TRUE(modified());
    EXPECT_EQ(objectCount(session.document()), 1);
    runAll({L"SaveAs " + path("a.quarn")});
    EXPECT_FALSE(modified());
    EXPECT_EQ(documentFile(session.document()), folder.path() / "a.quarn");
    runAll({L"Point 4,5,6", L"Save"});
    EXPECT_FALSE(modified());
}

TEST_F(DocumentStateTest, RenderSettingsBelongToTheDocument) {
    runAll({L"RenderSettings Size 320 200 Samples 9 _Enter"});
    EXPECT_TRUE(modified());
    runAll({L"SaveAs " + path("a.quarn"), L"New"});
    EXPECT_EQ(document().renderWindow().settings, RenderSettings());
    runAll({L"Open " + path("a.quarn")});
    EXPECT_EQ(document().renderWindow().settings, (RenderSettings{320, 200, 9, 4}));
    EXPECT_FALSE(modified());
    runAll({L"RenderSettings Samples 10 _Enter"});
    EXPECT_TRUE(modified());
    runAll({L"RenderSettings Samples 9 _Enter"});
    EXPECT_FALSE(modified());
}

TEST_F(DocumentStateTest, TheLightBelongsToTheDocument) {
    runAll({L"RenderSettings Light Studio Exposure -0.5 Background Transparent Ground=No _Enter"});
    EXPECT_TRUE(modified());
    const LightChoice chosen = document().renderWindow().settings.light;
    runAll({L"SaveAs " + path("a.quarn"), L"New"});
    EXPECT_EQ(document().renderWindow().settings.light, LightChoice());
    runAll({L"Open " + path("a.quarn")});
    EXPECT_EQ(document().renderWindow().settings.light, chosen);
    EXPECT_EQ(chosen.surroundings, Surroundings::studio);
    EXPECT_FALSE(modified());
}

TEST_F(DocumentStateTest, WhatDoesNotBecomeTheDocumentsFileLeavesItModified) {
    runAll({L"Point 1,2,3", L"Select _All", L"SaveSelected " + path("part.quarn")});
    EXPECT_TRUE(modified());
    EXPECT_EQ(documentFile(session.document()), std::filesystem::path());
}

TEST_F(DocumentStateTest, AnOpenedDocumentIsUnmodifiedAndSoIsAModelThatIsLookedAt) {
    runAll(
        {L"Point 1,2,3", L"SaveAs " + path("a.quarn"), L"Point 4,5,6", L"Open " + path("a.quarn")});
    EXPECT_FALSE(modified());
    EXPECT_EQ(objectCount(session.document()), 1);
    std::ofstream(folder.path() / "a.obj") << "v 0 0 0\nv 1 0 0\nv 0 1 0\nf 1 2 3\n";
    runAll({L"Open " + path("a.obj")});
    EXPECT_FALSE(modified());
    EXPECT_EQ(documentFile(session.document()), std::filesystem::path());
    runAll({L"Import " + path("a.obj")});
    EXPECT_TRUE(modified());
}

// ---- What counts

TEST_F(DocumentStateTest, NamesAndVisibilityCountAndWhatIsPutBackIsNoChange) {
    ObjectTable& objects = document().objects();
    const KM_UUID id = objects.addPoint(L"P", {1.0, 2.0, 3.0}).id;
    EXPECT_TRUE(modified());
    document().markSaved();
    objects.setVisible(id, false);
    EXPECT_TRUE(modified());
    objects.setVisible(id, true);
    EXPECT_FALSE(modified());
    objects.rename(id, L"Q");
    EXPECT_TRUE(modified());
    objects.rename(id, L"P");
    EXPECT_FALSE(modified());
    objects.movePoint(id, {1.0, 2.0, 4.0});
    EXPECT_TRUE(modified());
    document().markSaved();
    objects.remove(id);
    EXPECT_TRUE(modified());
}

TEST_F(DocumentStateTest, LightsAndSunCount) {
    const int index = document().lights().add(lamp());
    EXPECT_TRUE(modified());
    document().lights().remove(index);
    EXPECT_FALSE(modified()) << "a sun study leaves deleted slots behind";
    DocumentSun& sun = document().sun();
    const KM_3dVector before = sun.directionToSun();
    sun.restore(true, {0.0, 0.0, 1.0});
    EXPECT_TRUE(modified());
    sun.restore(false, before);
    EXPECT_TRUE(modified());
    sun.restore(true, before);
    EXPECT_FALSE(modified());
}

TEST_F(DocumentStateTest, ViewsTheirModesAndSizesAndEdgesCount) {
    runAll({L"DisplayMode Rendered"});
    EXPECT_TRUE(modified());
    document().markSaved();
    runAll({L"ViewportSize 300 200"});
    EXPECT_TRUE(modified());
    document().markSaved();
    ASSERT_TRUE(document().addView(L"Garden", KM_Viewport()));
    EXPECT_TRUE(modified());
    ASSERT_TRUE(document().closeView(L"Garden"));
    EXPECT_FALSE(modified());
    document().setEdgesOf(shaded_mode_id, MeshEdgeChoice::all);
    EXPECT_TRUE(modified());
}

TEST_F(DocumentStateTest, TheAnimationCountsButNotWhatPlayingItChanges) {
    RecordKeeper keeper;
    document().markRecordSaved();
    EXPECT_FALSE(modified());
    keeper.record.SetFrameCount(12);
    keeper.record.CameraPoints().Append({1.0, 2.0, 3.0});
    EXPECT_TRUE(modified());
    document().markSaved();
    keeper.record.SetCurrentFrame(7);
    keeper.record.SetLightIndex(3);
    EXPECT_FALSE(modified());
    keeper.record.CameraPoints()[0].z = 3.5;
    EXPECT_TRUE(modified());
}

TEST_F(DocumentStateTest, TheAnimationsDisplayModeInItsViewIsNoChangeAnywhereElseItIs) {
    RecordKeeper keeper;
    keeper.record.SetViewportName(L"Perspective");
    keeper.record.SetDisplayMode(rendered_mode_id);
    document().markSaved();
    document().findView(L"Perspective")->setDisplayMode(rendered_mode_id);
    EXPECT_FALSE(modified());
    document().findView(L"Perspective")->setDisplayMode(wireframe_mode_id);
    EXPECT_TRUE(modified());
    document().findView(L"Perspective")->setDisplayMode(shaded_mode_id);
    EXPECT_FALSE(modified());
    document().findView(L"Top")->setDisplayMode(rendered_mode_id);
    EXPECT_TRUE(modified());
}

TEST_F(DocumentStateTest, CamerasActiveViewsSelectionAndAWindowsSizesDoNotCount) {
    const KM_UUID id = document().objects().addPoint(L"P", {1.0, 2.0, 3.0}).id;
    document().markSaved();
    CQuarnView& view = activeView(session.document());
    orbitView(view, 10.0, 20.0);
    zoomView(view, 2.0, 10.0, 20.0);
    runAll({L"StandardView Top"});
    ASSERT_TRUE(setFrameSize(view, 500, 400));
    activateView(document().findView(L"Top")->face());
    document().objects().select(id);
    EXPECT_FALSE(modified());
}

TEST_F(DocumentStateTest, ASizeThatAPersonGaveCountsAlsoAfterTheWindowsOwn) {
    CQuarnView& view = activeView(session.document());
    runAll({L"ViewportSize 300 200"});
    ASSERT_TRUE(setFrameSize(view, 500, 400));
    EXPECT_TRUE(modified());
}

// ---- The animation

TEST_F(DocumentStateTest, WithoutAPlugInThereIsNoAnimation) {
    const AnimationState state = animationState(session.document());
    EXPECT_FALSE(state.can_play);
    EXPECT_EQ(state.frame_count, 0);
    EXPECT_TRUE(state.name.IsEmpty());
    EXPECT_TRUE(state.page_file.empty());
}

TEST_F(DocumentStateTest, AnAnimationCanBePlayedWhenEveryFrameHasItsCamera) {
    RecordKeeper keeper;
    keeper.record.SetFrameCount(2);
    keeper.record.SetCaptureType(KM_3dmAnimationProperties::one_day_sun);
    for (int i = 0; i < 2; ++i)
        keeper.record.CameraPoints().Append({0.0, 0.0, 1.0});
    keeper.record.TargetPoints().Append({0.0, 0.0, 0.0});
    EXPECT_FALSE(animationState(session.document()).can_play) << "a target is missing";
    EXPECT_EQ(animationState(session.document()).frame_count, 0);
    keeper.record.TargetPoints().Append({0.0, 0.0, 0.0});
    keeper.record.SetCurrentFrame(1);
    keeper.record.SetViewportName(L"Perspective");
    keeper.record.SetHtmlFilename(L"Walk");
    keeper.record.SetFolderName(L"/films");
    const AnimationState state = animationState(session.document());
    EXPECT_TRUE(state.can_play);
    EXPECT_TRUE(state.is_sun_study);
    EXPECT_EQ(state.frame_count, 2);
    EXPECT_EQ(state.current_frame, 1);
    EXPECT_STREQ(state.view.Array(), L"Perspective");
    EXPECT_STREQ(state.name.Array(), L"Walk");
    EXPECT_STREQ(state.folder.Array(), L"/films");
    EXPECT_EQ(state.page_file, std::filesystem::path("/films/Walk.html"));
}

TEST_F(DocumentStateTest, AStoredFrameOutOfRangeIsMovedIntoTheFramesThereAre) {
    RecordKeeper keeper;
    keeper.record.SetFrameCount(1);
    keeper.record.CameraPoints().Append({0.0, 0.0, 1.0});
    keeper.record.TargetPoints().Append({0.0, 0.0, 0.0});
    keeper.record.SetCurrentFrame(1);
    EXPECT_EQ(animationState(session.document()).current_frame, 0);
    keeper.record.SetCurrentFrame(-5);
    EXPECT_EQ(animationState(session.document()).current_frame, 0);
}

} // namespace
} // namespace quarn::test
