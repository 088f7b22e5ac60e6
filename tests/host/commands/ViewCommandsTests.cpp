#include "host/commands/PointText.h"
#include "tests/host/app/TestCommand.h"
#include "tests/host/document/DocumentFixtures.h"

#include <gmock/gmock.h>

namespace quarn::test {
namespace {

using testing::HasSubstr;

class ViewCommandsTest : public HostTest {
protected:
    Document& document() { return Document::of(session.document()); }
    ViewState& view() { return document().activeView(); }
    const KM_Viewport& viewport() { return view().viewport(); }
};

TEST_F(ViewCommandsTest, CameraTakesLocationTargetAndLens) {
    ASSERT_EQ(run(L"_-Camera _Location 10,-5.5,3 _Target 1,2,3 _Lens 24 _Enter"),
              CQuarnCommand::success);
    EXPECT_EQ(viewport().CameraLocation(), KM_3dPoint(10, -5.5, 3));
    EXPECT_EQ(viewport().TargetPoint(), KM_3dPoint(1, 2, 3));
    double lens_mm = 0.0;
    viewport().GetCamera35mmLensLength(&lens_mm);
    EXPECT_NEAR(lens_mm, 24.0, 1e-9);
}

TEST_F(ViewCommandsTest, CameraSwitchesToParallelAndBack) {
    ASSERT_EQ(run(L"Camera Parallel=Yes _Enter"), CQuarnCommand::success);
    EXPECT_TRUE(viewport().IsParallelProjection());
    EXPECT_EQ(run(L"Camera Lens 35 _Enter"), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("A parallel view has no lens"));
    ASSERT_EQ(run(L"Camera Parallel=No Lens 35 _Enter"), CQuarnCommand::success);
    EXPECT_TRUE(viewport().IsPerspectiveProjection());
}

TEST_F(ViewCommandsTest, CameraTellsWhatIsWrongAndChangesNothing) {
    const KM_Viewport before = viewport();
    EXPECT_EQ(run(L"Camera Location 1,2"), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("\"1,2\" is no point. Write x,y,z"));
    EXPECT_EQ(run(L"Camera Location 1,2,3 Target 1,2,3 _Enter"), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("cannot stand at its target"));
    EXPECT_EQ(run(L"Camera Zoom 3"), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("\"Zoom\" is no option here"));
    EXPECT_EQ(run(L"Camera Lens 0 _Enter"), CQuarnCommand::cancel);
    EXPECT_EQ(run(L"Camera Location 1,2,3"), CQuarnCommand::cancel) << "without _Enter";
    EXPECT_TRUE(viewport() == before);
}

TEST_F(ViewCommandsTest, PointsAreReadWhateverTheLocale) {
    EXPECT_EQ(readPoint(L"1.5,-2e3, 0.25").value(), KM_3dPoint(1.5, -2000, 0.25));
    for (const wchar_t* text :
         {L"", L"1", L"1,2", L"1,2,3,4", L"1,2,x", L"1,,3", L"1;2;3", L"1,2,nan", L"inf,0,0"})
        EXPECT_FALSE(readPoint(text)) << KM_wString(text).ToUtf8();
    const KM_3dPoint point(0.1, -1e-9, 12345.678);
    EXPECT_EQ(readPoint(pointText(point).View()).value(), point);
}

TEST_F(ViewCommandsTest, FitViewFitsTheActiveView) {
    addBox(document(), {0, 0, 0}, {10, 20, 30});
    ASSERT_EQ(run(L"_-FitView _Enter"), CQuarnCommand::success);
    EXPECT_EQ(viewport().TargetPoint(), KM_3dPoint(5, 10, 15));
    ASSERT_EQ(run(L"_-FitView _Turn=Yes _Enter"), CQuarnCommand::success);
    EXPECT_EQ(viewport().TargetPoint().x, 5.0);
    EXPECT_EQ(viewport().TargetPoint().y, 10.0);
    const double once = viewport().TargetDistance();
    ASSERT_EQ(run(L"FitView Turn=Yes Distance 2 _Enter"), CQuarnCommand::success);
    EXPECT_NEAR(viewport().TargetDistance() / once, 2.0, 1e-9);
    ASSERT_EQ(run(L"Camera Target 1,1,1 _Enter"), CQuarnCommand::success);
    ASSERT_EQ(run(L"FitView KeepTarget=Yes _Enter"), CQuarnCommand::success);
    EXPECT_EQ(viewport().TargetPoint(), KM_3dPoint(1, 1, 1));
}

TEST_F(ViewCommandsTest, FitViewNeedsSomethingToFit) {
    const KM_Viewport before = viewport();
    EXPECT_EQ(run(L"FitView _Enter"), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("nothing visible"));
    EXPECT_EQ(run(L"FitView Distance 0 _Enter"), CQuarnCommand::cancel);
    EXPECT_EQ(run(L"FitView Wide _Enter"), CQuarnCommand::failure);
    EXPECT_TRUE(viewport() == before);
}

TEST_F(ViewCommandsTest, ViewportSizeSetsFrameAndAspect) {
    ASSERT_EQ(run(L"ViewportSize 1000 500"), CQuarnCommand::success);
    EXPECT_EQ(view().frameWidth(), 1000);
    EXPECT_EQ(view().frameHeight(), 500);
    EXPECT_NEAR(viewport().FrustumAspect(), 2.0, 1e-12);
    for (const wchar_t* line : {L"ViewportSize 0 500", L"ViewportSize 500 16385",
                                L"ViewportSize wide 500", L"ViewportSize 640"})
        EXPECT_EQ(run(line), CQuarnCommand::cancel) << KM_wString(line).ToUtf8();
    EXPECT_EQ(view().frameWidth(), 1000);
    EXPECT_EQ(view().frameHeight(), 500);
}

TEST_F(ViewCommandsTest, DisplayModeTakesNamesAndListsTheModes) {
    for (const wchar_t* line : {L"DisplayMode X-Ray", L"DisplayMode _XRay", L"DisplayMode xray"}) {
        run(L"DisplayMode Shaded");
        EXPECT_EQ(run(line), CQuarnCommand::success) << KM_wString(line).ToUtf8();
        EXPECT_STREQ(view().displayMode()->EnglishName(), L"X-Ray");
    }
    EXPECT_EQ(run(L"DisplayMode Cubist"), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("There is no display mode \"Cubist\". The modes are "
                                     "Wireframe, Shaded, Rendered, Translucent, X-Ray, "
                                     "Drawing, Clay."));
    EXPECT_STREQ(view().displayMode()->EnglishName(), L"X-Ray");
}

TEST_F(ViewCommandsTest, StandardViewTurnsTheCameraAndKeepsTheTarget) {
    run(L"Camera Target 1,2,3 _Enter");
    const double distance = viewport().TargetDistance();
    ASSERT_EQ(run(L"StandardView Front"), CQuarnCommand::success);
    EXPECT_NEAR((viewport().CameraZ() - KM_3dVector(0, -1, 0)).Length(), 0.0, 1e-12);
    EXPECT_EQ(viewport().TargetPoint(), KM_3dPoint(1, 2, 3));
    EXPECT_NEAR(viewport().TargetDistance(), distance, 1e-9);
    EXPECT_EQ(run(L"StandardView Back"), CQuarnCommand::failure);
}

class AnimationNameTest : public HostTest {
protected:
    RecordKeeper keeper;
};

TEST_F(AnimationNameTest, StoresTheNameInTheRecord) {
    keeper.record.SetFrameCount(12);
    ASSERT_EQ(run(L"_-AnimationName \"Walk round\""), CQuarnCommand::success);
    EXPECT_STREQ(keeper.record.HtmlFilename(), L"Walk round");
    EXPECT_EQ(keeper.record.FrameCount(), 12);
}

TEST_F(AnimationNameTest, RefusesNamesThatFilesCannotHave) {
    keeper.record.SetHtmlFilename(L"Before");
    for (const wchar_t character : std::wstring_view(L"\\|/:*?<>\t\x7f")) {
        const std::wstring line = std::wstring(L"AnimationName \"a") + character + L"b\"";
        EXPECT_EQ(run(line.c_str()), CQuarnCommand::failure) << static_cast<int>(character);
    }
    EXPECT_THAT(printed(), HasSubstr("becomes part of file names"));
    EXPECT_EQ(run(L"AnimationName \"  \""), CQuarnCommand::failure);
    EXPECT_EQ(run(L"AnimationName .."), CQuarnCommand::failure);
    EXPECT_STREQ(keeper.record.HtmlFilename(), L"Before");
}

TEST_F(AnimationNameTest, A255CharacterNameIsTheLongest) {
    const std::wstring name(255, L'a');
    EXPECT_EQ(run((L"AnimationName " + name).c_str()), CQuarnCommand::success);
    EXPECT_EQ(run((L"AnimationName b" + name).c_str()), CQuarnCommand::failure);
    EXPECT_EQ(keeper.record.HtmlFilename().View(), name);
}

TEST_F(HostTest, AnimationNameNeedsAPlugInThatKeepsIt) {
    EXPECT_EQ(run(L"AnimationName Walk"), CQuarnCommand::failure);
    EXPECT_THAT(printed(), HasSubstr("No plug-in keeps an animation"));
}

} // namespace
} // namespace quarn::test
