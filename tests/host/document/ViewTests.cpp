#include "engine/display/DisplayMode.h"
#include "host/document/DisplayModeList.h"
#include "tests/host/document/DocumentFixtures.h"

#include <random>

namespace quarn::test {
namespace {

class ViewCameraTest : public DocumentTest {
protected:
    CQuarnViewport& viewport = view.face().MainViewport();
};

TEST_F(ViewCameraTest, MovingKeepsTheHorizonLevel) {
    std::mt19937 random(7);
    std::uniform_real_distribution<double> place(-50.0, 50.0);
    for (int i = 0; i < 200; ++i) {
        const KM_3dPoint target(place(random), place(random), place(random));
        const KM_3dPoint camera(place(random), place(random), place(random));
        ASSERT_TRUE(viewport.SetTargetAndCameraLocation(target, camera, true, true));
        EXPECT_EQ(viewport.VP().CameraLocation(), camera);
        EXPECT_EQ(viewport.Target(), target);
        EXPECT_NEAR(viewport.VP().CameraX().z, 0.0, 1e-12);
        EXPECT_GT(viewport.VP().CameraY().z, 0.0);
    }
}

TEST_F(ViewCameraTest, LookingStraightDownKeepsTheOldUpTurnedWithTheDirection) {
    ASSERT_TRUE(viewport.SetTargetAndCameraLocation({0, 0, 0}, {0, -10, 0}, true, true));
    ASSERT_TRUE(viewport.SetTargetAndCameraLocation({0, 0, 0}, {0, 0, 10}, true, true));
    // The direction turned from +Y to -Z about X, so up turned from +Z to +Y.
    EXPECT_NEAR((viewport.VP().CameraY() - KM_3dVector(0, 1, 0)).Length(), 0.0, 1e-15);
    EXPECT_NEAR((viewport.VP().CameraZ() - KM_3dVector(0, 0, 1)).Length(), 0.0, 1e-15);
}

TEST_F(ViewCameraTest, WithoutUpdateOfUpTheOldUpStays) {
    KM_Viewport rolled = viewport.VP();
    rolled.SetCameraUp({1, 0, 1});
    ASSERT_TRUE(viewport.SetVP(rolled, true, true));
    ASSERT_TRUE(viewport.SetTargetAndCameraLocation({0, 0, 0}, {0, -10, 0}, true, false));
    EXPECT_GT(std::abs(viewport.VP().CameraX().z), 0.1);
}

TEST_F(ViewCameraTest, RefusedPointsChangeNothing) {
    const KM_Viewport before = viewport.VP();
    EXPECT_FALSE(viewport.SetTargetAndCameraLocation({1, 2, 3}, {1, 2, 3}, true, true));
    EXPECT_FALSE(
        viewport.SetTargetAndCameraLocation(KM_3dPoint::UnsetPoint, {1, 2, 3}, true, true));
    EXPECT_FALSE(viewport.SetTargetAndCameraLocation({1, 2, 3}, {NAN, 0, 0}, true, true));
    EXPECT_TRUE(viewport.VP() == before);
}

TEST_F(ViewCameraTest, TheTargetStaysUnlessItIsToBeUpdated) {
    const KM_3dPoint target = viewport.Target();
    ASSERT_TRUE(viewport.SetTargetAndCameraLocation({9, 9, 9}, {1, 2, 3}, false, true));
    EXPECT_EQ(viewport.Target(), target);
    KM_Viewport other = viewport.VP();
    other.SetTargetPoint({7, 7, 7});
    ASSERT_TRUE(viewport.SetVP(other, false, true));
    EXPECT_EQ(viewport.Target(), target);
}

TEST_F(ViewCameraTest, ASavedCameraComesBackExactly) {
    const KM_Viewport saved = viewport.VP();
    viewport.SetTargetAndCameraLocation({1, 1, 1}, {5, 7, 9}, true, true);
    ASSERT_TRUE(viewport.SetVP(saved, true, true));
    EXPECT_TRUE(viewport.VP() == saved);
}

TEST_F(ViewCameraTest, ForeignCamerasTakeTheFramesAspect) {
    ASSERT_TRUE(view.setFrameSize(400, 100));
    KM_Viewport other;
    other.SetScreenPort(100, 100);
    ASSERT_TRUE(viewport.SetVP(other, true, true));
    EXPECT_NEAR(viewport.VP().FrustumAspect(), 4.0, 1e-12);
}

class ViewPictureTest : public DocumentTest {
protected:
    ViewPictureTest() {
        addBox(document, {-20, -20, -20}, {20, 20, 20});
        view.setFrameSize(64, 48);
    }
    CQuarnViewport& viewport = view.face().MainViewport();
    CQuarnDisplayPipeline& pipeline = *viewport.DisplayPipeline();
};

TEST_F(ViewPictureTest, FlagZeroDrawsAndFlagFourOnlyShows) {
    view.face().Redraw(0);
    EXPECT_EQ(view.drawCount(), 1U);
    const std::vector<std::uint8_t> drawn = view.frameBuffer().rgba;
    EXPECT_EQ(drawn.size(), 4U * 64U * 48U);
    viewport.SetTargetAndCameraLocation({0, 0, 0}, {300, 0, 0}, true, true);
    view.face().Redraw(4);
    EXPECT_EQ(view.drawCount(), 1U);
    EXPECT_EQ(view.frameBuffer().rgba, drawn);
    view.face().Redraw();
    EXPECT_EQ(view.drawCount(), 2U);
    EXPECT_NE(view.frameBuffer().rgba, drawn);
    EXPECT_EQ(view.showCount(), 3U);
}

TEST_F(ViewPictureTest, DrawToDibDrawsOnceAndLeavesTheFrameBuffer) {
    view.face().Redraw(0);
    const std::vector<std::uint8_t> shown = view.frameBuffer().rgba;
    viewport.SetTargetAndCameraLocation({0, 0, 0}, {300, 0, 0}, true, true);
    CQuarnDib dib;
    ASSERT_TRUE(pipeline.DrawToDib(dib, 64, 48, *pipeline.CurrentDisplayAttributes()));
    EXPECT_EQ(view.drawCount(), 2U);
    EXPECT_EQ(view.frameBuffer().rgba, shown);
    ASSERT_TRUE(pipeline.CopyToFrameBuffer(dib));
    view.face().Redraw(4);
    EXPECT_EQ(view.frameBuffer().rgba, dib.Image().rgba);
    EXPECT_NE(view.frameBuffer().rgba, shown);
    EXPECT_EQ(view.drawCount(), 2U);
}

TEST_F(ViewPictureTest, DrawToDibRefusesOnceInterruptedAndBadSizes) {
    CQuarnDib dib;
    const CDisplayPipelineAttributes attributes = *pipeline.CurrentDisplayAttributes();
    EXPECT_FALSE(pipeline.DrawToDib(dib, 0, 10, attributes));
    EXPECT_FALSE(pipeline.DrawToDib(dib, 10, 16385, attributes));
    front_end.interrupt();
    EXPECT_FALSE(pipeline.DrawToDib(dib, 10, 10, attributes));
    EXPECT_EQ(dib.Width(), 0);
    EXPECT_EQ(view.drawCount(), 0U);
}

TEST_F(ViewPictureTest, RedrawOnceInterruptedDrawsNothingAndLeavesThePicture) {
    view.face().Redraw();
    const std::vector<std::uint8_t> shown = view.frameBuffer().rgba;
    viewport.SetTargetAndCameraLocation({0, 0, 0}, {300, 0, 0}, true, true);
    front_end.interrupt();
    view.face().Redraw();
    EXPECT_EQ(view.drawCount(), 1U);
    EXPECT_EQ(view.showCount(), 1U);
    EXPECT_EQ(view.frameBuffer().rgba, shown);
}

TEST_F(ViewPictureTest, OnlyAPictureOfTheFramesSizeIsCopied) {
    CQuarnDib dib;
    ASSERT_TRUE(pipeline.DrawToDib(dib, 32, 48, *pipeline.CurrentDisplayAttributes()));
    EXPECT_FALSE(pipeline.CopyToFrameBuffer(dib));
}

TEST_F(ViewPictureTest, HiddenObjectsAreNotDrawnAndComeBack) {
    view.face().Redraw();
    const std::vector<std::uint8_t> with_box = view.frameBuffer().rgba;
    const CQuarnObjRef box(document.objects().objects()[0]->id);
    document.face().HideObject(box, false);
    view.face().Redraw();
    EXPECT_NE(view.frameBuffer().rgba, with_box);
    document.face().ShowObject(box, false);
    view.face().Redraw();
    EXPECT_EQ(view.frameBuffer().rgba, with_box);
}

TEST_F(ViewPictureTest, RenderedPicturesFollowTheDocumentsSun) {
    viewport.SetDisplayMode(CQuarnDisplayAttrsMgr::RenderedModeId());
    view.face().Redraw();
    const std::vector<std::uint8_t> with_sun = view.frameBuffer().rgba;
    CQuarnSun& sun = document.face().Sun();
    sun.BeginChange(CQuarnSun::change_by_program);
    sun.SetEnabled(false);
    sun.EndChange();
    view.face().Redraw();
    EXPECT_NE(view.frameBuffer().rgba, with_sun);
}

TEST_F(ViewPictureTest, SettingTheModeMakesTheAttributesAnew) {
    pipeline.CurrentDisplayAttributes()->m_antialiasing_level = 2;
    EXPECT_EQ(view.face().DisplayAttributes()->m_antialiasing_level, 1) << "the mode itself stays";
    ASSERT_TRUE(viewport.SetDisplayMode(view.face().DisplayAttributes()->Id()));
    EXPECT_EQ(pipeline.CurrentDisplayAttributes()->m_antialiasing_level, 1);
}

TEST_F(ViewPictureTest, AnIdOfNoModeChangesNothing) {
    const auto* const before = view.face().DisplayAttributes();
    EXPECT_FALSE(viewport.SetDisplayMode(KM_nil_uuid));
    EXPECT_FALSE(viewport.SetDisplayMode(KM_CreateUuid()));
    EXPECT_EQ(view.face().DisplayAttributes(), before);
}

TEST(DisplayModeListTest, HasTheModesInTheHostsOrder) {
    KM_SimpleArray<const CDisplayPipelineAttributes*> modes;
    ASSERT_EQ(CQuarnDisplayAttrsMgr::GetDisplayAttrsList(modes), 7);
    const wchar_t* const names[] = {L"Wireframe", L"Shaded",  L"Rendered", L"Translucent",
                                    L"X-Ray",     L"Drawing", L"Clay"};
    for (int i = 0; i < 7; ++i)
        EXPECT_STREQ(modes[i]->EnglishName(), names[i]);
    EXPECT_EQ(modes[0]->Id(), CQuarnDisplayAttrsMgr::WireframeModeId());
    EXPECT_EQ(modes[2]->Id(), CQuarnDisplayAttrsMgr::RenderedModeId());
    EXPECT_EQ(modes[0]->m_mode_kind, 1);
    EXPECT_EQ(modes[2]->m_mode_kind, 2);
    EXPECT_TRUE(modes[2]->m_uses_document_lights);
}

TEST(DisplayModeListTest, FindsModesByAnyFormOfTheirName) {
    const DisplayModeList& list = DisplayModeList::instance();
    for (const wchar_t* name : {L"X-Ray", L"xray", L"X Ray", L"_XRay"}) {
        ASSERT_NE(list.findByName(name), nullptr);
        EXPECT_STREQ(list.findByName(name)->EnglishName(), L"X-Ray");
    }
    EXPECT_EQ(list.findByName(L"RenderedViewport"), list.find(rendered_mode_id));
    EXPECT_EQ(list.findByName(L"Ray"), nullptr);
    EXPECT_EQ(list.findByName(L""), nullptr);
}

const CDisplayPipelineAttributes& modeNamed(const wchar_t* name) {
    return *DisplayModeList::instance().findByName(name);
}

TEST(DisplayModeListTest, OffersTheRenderedAndTheXRayModeUnderNamesOfTheirOwn) {
    EXPECT_EQ(QnCaptureOptionName(modeNamed(L"Rendered")).m_english.ToUtf8(), "RenderedViewport");
    EXPECT_EQ(QnCaptureOptionName(modeNamed(L"X-Ray")).m_english.ToUtf8(), "XRay");
    EXPECT_EQ(QnCaptureOptionName(modeNamed(L"Clay")).m_english.ToUtf8(), "Clay");
}

TEST(DisplayModeListTest, KnowsTheCaptureOptionOfAModeByItsLocalName) {
    CDisplayPipelineAttributes mode;
    mode.m_english_name = L"House, style_1";
    mode.m_local_name = L"Haus - Stil_1, neu";
    const CQuarnCommandOptionName own = QnCaptureOptionName(mode);
    EXPECT_EQ(own.m_english.ToUtf8(), "House, style_1");
    EXPECT_EQ(own.m_local.ToUtf8(), "HausStil1neu");
    mode.m_local_name = L"REN_dered";
    EXPECT_EQ(QnCaptureOptionName(mode).m_english.ToUtf8(), "RenderedViewport");
}

TEST(DisplayModeListTest, ShowsSunStudiesInShadedModesWithTheDocumentsLightsOrShadows) {
    const auto shows = [](int kind, bool lights, bool shadows) {
        CDisplayPipelineAttributes mode;
        mode.m_mode_kind = kind;
        mode.m_uses_document_lights = lights;
        mode.m_casts_shadows = shadows;
        return mode.ShowsSunStudies();
    };
    EXPECT_TRUE(shows(CDisplayPipelineAttributes::shaded, true, false));
    EXPECT_TRUE(shows(CDisplayPipelineAttributes::shaded, false, true));
    EXPECT_FALSE(shows(CDisplayPipelineAttributes::shaded, false, false));
    EXPECT_FALSE(shows(CDisplayPipelineAttributes::wireframe, true, true));
}

} // namespace
} // namespace quarn::test
