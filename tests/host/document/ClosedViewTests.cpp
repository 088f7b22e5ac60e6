#include "engine/display/DisplayMode.h"
#include "sdk/qncore/QnApp.h"
#include "tests/host/app/TestCommand.h"
#include "tests/host/border/BreachList.h"
#include "tests/host/document/DocumentFixtures.h"

#include <gmock/gmock.h>

namespace quarn::test {
namespace {

using testing::ElementsAre;
using testing::EndsWith;
using testing::SizeIs;
using Messages = std::vector<std::string>;

std::vector<std::string> viewNames(const Document& document) {
    std::vector<std::string> names;
    for (const auto& view : document.views())
        names.push_back(view->name().ToUtf8());
    return names;
}

// ---- Adding and closing

TEST_F(DocumentTest, AViewIsAddedBehindTheOthersAndTheActiveOneStays) {
    const auto added = document.addView(L"Garden", view.viewport());
    ASSERT_TRUE(added) << added.message();
    EXPECT_THAT(viewNames(document), ElementsAre("Top", "Front", "Right", "Perspective", "Garden"));
    EXPECT_EQ(document.findView(L"garden"), added.value());
    EXPECT_EQ(added.value()->displayMode()->Id(), shaded_mode_id);
    EXPECT_EQ(&document.activeView(), &view);
}

TEST_F(DocumentTest, AViewNameIsTakenWhateverItsCase) {
    EXPECT_EQ(document.addView(L"tOP", view.viewport()).message(),
              "There is a view \"Top\" already. Give the new one another name.");
    for (const wchar_t* bad : {L"", L"two\nlines", L"a\x7F"})
        EXPECT_FALSE(document.addView(bad, view.viewport())) << KM_wString(bad).ToUtf8();
    EXPECT_THAT(viewNames(document), SizeIs(4));
}

TEST_F(DocumentTest, WhenTheActiveViewClosesTheOneBehindItBecomesActiveElseTheLast) {
    ASSERT_TRUE(document.activateView(L"Front"));
    ASSERT_TRUE(document.closeView(L"FRONT"));
    EXPECT_THAT(viewNames(document), ElementsAre("Top", "Right", "Perspective"));
    EXPECT_STREQ(document.activeView().name().Array(), L"Right");
    ASSERT_TRUE(document.closeView(L"Top"));
    EXPECT_STREQ(document.activeView().name().Array(), L"Right");
    ASSERT_TRUE(document.activateView(L"Perspective"));
    ASSERT_TRUE(document.closeView(L"Perspective"));
    EXPECT_STREQ(document.activeView().name().Array(), L"Right");
    EXPECT_EQ(document.closeView(L"Right").message(),
              "The view \"Right\" is the document's last one and stays. Add another one first.");
    EXPECT_EQ(document.closeView(L"Top").message(), "There is no view \"Top\".");
}

TEST_F(DocumentTest, WhileACommandRunsAViewThatIsToCloseStays) {
    list.commandStarted();
    ASSERT_TRUE(document.closeView(L"Perspective"));
    ASSERT_TRUE(document.closeView(L"Perspective")) << "asked twice, it closes once";
    ASSERT_TRUE(document.closeView(L"Top"));
    ASSERT_TRUE(document.closeView(L"Front"));
    EXPECT_FALSE(document.closeView(L"Right")) << "no view would be left";
    EXPECT_THAT(viewNames(document), SizeIs(4));
    EXPECT_EQ(&document.activeView(), &view);
    view.face().Redraw();
    EXPECT_EQ(view.drawCount(), 1U);
    list.commandEnded();
    EXPECT_THAT(viewNames(document), ElementsAre("Right"));
    EXPECT_STREQ(document.activeView().name().Array(), L"Right");
}

// ---- What plug-ins keep

TEST_F(DocumentTest, EveryCallOnAClosedViewIsReportedByItsNameAndDoesNothing) {
    CQuarnView& kept = view.face();
    ASSERT_TRUE(document.closeView(L"Perspective"));
    BreachList breaches;

    kept.Redraw();
    EXPECT_EQ(breaches.take(), Messages{"CQuarnView::Redraw: the view was closed"});
    EXPECT_EQ(view.drawCount() + view.showCount(), 0U);
    EXPECT_EQ(kept.DisplayAttributes(), nullptr);
    EXPECT_EQ(breaches.take(), Messages{"CQuarnView::DisplayAttributes: the view was closed"});
    EXPECT_EQ(&kept.Document(), &document.face());
    EXPECT_EQ(breaches.take(), Messages{"CQuarnView::Document: the view was closed"});
    const CQuarnViewport* viewport = &kept.MainViewport();
    EXPECT_EQ(&std::as_const(kept).MainViewport(), viewport);
    EXPECT_EQ(&kept.ActiveViewport(), viewport);
    EXPECT_EQ(breaches.take(), (Messages{"CQuarnView::MainViewport: the view was closed",
                                         "CQuarnView::MainViewport: the view was closed",
                                         "CQuarnView::ActiveViewport: the view was closed"}));
}

TEST_F(DocumentTest, EveryCallOnTheViewportOfAClosedViewIsReportedByItsName) {
    CQuarnViewport& kept = view.face().MainViewport();
    const KM_Viewport before = view.viewport();
    ASSERT_TRUE(document.closeView(L"Perspective"));
    BreachList breaches;

    EXPECT_STREQ(kept.Name(), L"");
    EXPECT_TRUE(kept.VP() == KM_Viewport());
    EXPECT_EQ(kept.Target(), KM_Viewport().TargetPoint());
    EXPECT_FALSE(kept.SetVP(KM_Viewport(), true, true));
    EXPECT_FALSE(kept.SetTargetAndCameraLocation({0, 0, 0}, {1, 2, 3}, true, true));
    EXPECT_FALSE(kept.SetDisplayMode(wireframe_mode_id));
    EXPECT_TRUE(view.viewport() == before);
    EXPECT_EQ(view.displayMode()->Id(), shaded_mode_id);
    EXPECT_EQ(breaches.take(),
              (Messages{"CQuarnViewport::Name: the view was closed",
                        "CQuarnViewport::VP: the view was closed",
                        "CQuarnViewport::Target: the view was closed",
                        "CQuarnViewport::SetVP: the view was closed",
                        "CQuarnViewport::SetTargetAndCameraLocation: the view was closed",
                        "CQuarnViewport::SetDisplayMode: the view was closed"}));
    EXPECT_NE(kept.DisplayPipeline(), nullptr);
    EXPECT_EQ(breaches.take(), Messages{"CQuarnViewport::DisplayPipeline: the view was closed"});
}

TEST_F(DocumentTest, EveryCallOnThePipelineOfAClosedViewIsReportedByItsName) {
    CQuarnDisplayPipeline& kept = *view.face().MainViewport().DisplayPipeline();
    const CDisplayPipelineAttributes attributes = *kept.CurrentDisplayAttributes();
    ASSERT_TRUE(document.closeView(L"Perspective"));
    BreachList breaches;

    EXPECT_EQ(kept.FrameWidth(), 0);
    EXPECT_EQ(kept.FrameHeight(), 0);
    EXPECT_EQ(kept.CurrentDisplayAttributes(), nullptr);
    CQuarnDib dib;
    EXPECT_FALSE(kept.DrawToDib(dib, 8, 8, attributes));
    EXPECT_EQ(dib.Width(), 0);
    EXPECT_FALSE(kept.CopyToFrameBuffer(dib));
    EXPECT_EQ(breaches.take(),
              (Messages{"CQuarnDisplayPipeline::FrameWidth: the view was closed",
                        "CQuarnDisplayPipeline::FrameHeight: the view was closed",
                        "CQuarnDisplayPipeline::CurrentDisplayAttributes: the view was closed",
                        "CQuarnDisplayPipeline::DrawToDib: the view was closed",
                        "CQuarnDisplayPipeline::CopyToFrameBuffer: the view was closed"}));
}

TEST_F(DocumentTest, AViewOfAClosedDocumentIsClosedAndSoAreTheDocumentsParts) {
    CQuarnDoc& kept = document.face();
    CQuarnLightTable& lights = kept.LightTable();
    CQuarnSun& sun = kept.Sun();
    const unsigned int number = kept.RuntimeSerialNumber();
    addBox(document, {0, 0, 0}, {1, 1, 1});
    list.openNew();
    list.commandEnded();
    BreachList breaches;

    view.face().Redraw();
    EXPECT_EQ(breaches.take(), Messages{"CQuarnView::Redraw: the view was closed"});
    EXPECT_EQ(&view.face().Document(), &kept);
    EXPECT_EQ(breaches.take(), Messages{"CQuarnView::Document: the view was closed"});
    EXPECT_EQ(kept.RuntimeSerialNumber(), number);
    EXPECT_EQ(kept.FindObjectByName(L"Box"), nullptr);
    KM_SimpleArray<CQuarnView*> views;
    EXPECT_EQ(kept.GetViewList(views, true, true), 0);
    EXPECT_EQ(kept.AbsoluteTolerance(), Document::default_absolute_tolerance);
    EXPECT_EQ(kept.Properties().AnimationProperties().FrameCount(), 100);
    kept.Regen();
    EXPECT_THAT(breaches.take(),
                ElementsAre("CQuarnDoc::RuntimeSerialNumber: the document was closed",
                            "CQuarnDoc::FindObjectByName: the document was closed",
                            "CQuarnDoc::GetViewList: the document was closed",
                            "CQuarnDoc::AbsoluteTolerance: the document was closed",
                            "CQuarnDoc::Properties: the document was closed",
                            "CQuarnDocProperties::AnimationProperties: the document was closed",
                            "CQuarnDoc::Regen: the document was closed"));
    EXPECT_EQ(lights.AddLight(KM_Light(), nullptr), -1);
    EXPECT_EQ(lights.LightCount(), 0);
    EXPECT_TRUE(lights[0].IsDeleted());
    EXPECT_FALSE(lights.DeleteLight(0, false));
    EXPECT_FALSE(sun.IsEnabled());
    EXPECT_EQ(sun.DirectionToSun(), KM_3dVector(0, 0, 1));
    EXPECT_THAT(breaches.take(),
                testing::AllOf(SizeIs(6), testing::Each(EndsWith(": the document was closed"))));
}

// ---- In a session

/// Asks for a view to be closed while it works on events, as a person does who clicks meanwhile.
class ClosingFrontEnd final : public ScriptedFrontEnd {
public:
    void pumpEvents(unsigned) override {
        ++pumps;
        closes_asked += session && session->closeView(L"Perspective");
    }
    Session* session = nullptr;
    int pumps = 0;
    int closes_asked = 0;
};

TEST(ClosingWhilePlaying, TheViewIsThereUntilTheCommandHasEnded) {
    ClosingFrontEnd front_end;
    Session session(front_end, {{}, {}, "C", {}});
    front_end.session = &session;
    CQuarnView* view = nullptr;
    TestCommand play(L"Play", [&](const CQuarnCommandContext&) {
        view = QuarnApp().ActiveView();
        for (int frame = 0; frame < 3; ++frame) {
            view->Redraw();
            QuarnApp().Wait(1);
        }
        EXPECT_EQ(QuarnApp().ActiveView(), view);
        EXPECT_STREQ(view->MainViewport().Name(), L"Perspective");
        return CQuarnCommand::success;
    });
    ASSERT_TRUE(Application::current()->commands().add(play));

    EXPECT_EQ(session.runCommand(L"Play"), CQuarnCommand::success);
    EXPECT_EQ(front_end.pumps, 3);
    EXPECT_EQ(front_end.closes_asked, 3);
    EXPECT_NE(QuarnApp().ActiveView(), view);
    EXPECT_EQ(Document::of(session.document()).findView(L"Perspective"), nullptr);
    BreachList breaches;
    view->Redraw();
    EXPECT_EQ(breaches.take(), Messages{"CQuarnView::Redraw: the view was closed"});
}

TEST_F(HostTest, OutsideACommandAViewClosesAtOnce) {
    EXPECT_TRUE(session.closeView(L"perspective"));
    EXPECT_EQ(Document::of(session.document()).findView(L"Perspective"), nullptr);
    EXPECT_FALSE(session.closeView(L"Perspective"));
    EXPECT_EQ(printed(), "There is no view \"Perspective\".\n");
}

} // namespace
} // namespace quarn::test
