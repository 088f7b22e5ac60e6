#include "tests/zoetrix/fixtures/PlugInFixture.h"
#include "zoetrix/commands/cmdZoetrix.h"

#include <algorithm>
#include <cmath>
#include <limits>
#include <map>
#include <string>
#include <vector>

using testing::HasSubstr;

namespace {

constexpr const char* two_rails =
    "v 0 0 0\nv 10 0 0\nv 0 0 5\nv 0 4 5\no rail\nl 1 2\no gaze\nl 3 4\n";

int regenerations = 0;

class Preview : public PlugInFixture {
protected:
    void SetUp() override {
        placeCamera(L"Perspective", {30.0, 40.0, 50.0}, {1.0, 2.0, 3.0});
        ASSERT_EQ(CQuarnCommand::success, run(L"ViewportSize 64 48"));
        front_end.clearPrinted();
    }

    int preview(int frame) { return PreviewAnimation(doc(), record(), frame, false); }
    const KM_Viewport& camera() { return view(L"Perspective").MainViewport().VP(); }
    KM_UUID modeOf(const wchar_t* name) {
        const CDisplayPipelineAttributes* mode = view(name).DisplayAttributes();
        return mode ? mode->Id() : KM_nil_uuid;
    }
    void switchSun(bool on) {
        doc().Sun().BeginChange(CQuarnSun::change_by_user);
        doc().Sun().SetEnabled(on);
        doc().Sun().EndChange();
        ASSERT_EQ(on, doc().Sun().IsEnabled());
    }
    int liveLights() {
        int count = 0;
        for (int i = 0; i < doc().LightTable().LightCount(); ++i)
            count += doc().LightTable()[i].IsDeleted() ? 0 : 1;
        return count;
    }
    void followBothRails() {
        importObj(two_rails);
        setUpCameraFrames(3);
        record().SetCaptureType(KM_3dmAnimationProperties::path);
        record().SetCameraPathId(objectId(L"rail"));
        record().SetTargetPathId(objectId(L"gaze"));
    }
};

/// Looks at the lights of the document whenever the animation looks whether to go on.
class WatchingFrontEnd final : public quarn::ScriptedFrontEnd {
public:
    bool isKeyDown(int virtual_key) override {
        look();
        return ScriptedFrontEnd::isKeyDown(virtual_key);
    }
    void pumpEvents(unsigned milliseconds) override {
        waits_ms.push_back(milliseconds);
        look();
    }
    void viewShown(CQuarnView&, const quarn::ShownPicture&) override {
        shown_before_wait.push_back(waits_ms.size());
    }

    quarn::Session* session = nullptr;
    std::vector<unsigned> waits_ms;
    std::vector<std::size_t> shown_before_wait; ///< for each picture shown, the waits before it
    std::map<int, KM_Light> lights;             ///< all that ever shone, by their indices

private:
    void look() {
        if (!session)
            return;
        const CQuarnLightTable& table = session->document().LightTable();
        for (int i = 0; i < table.LightCount(); ++i)
            if (!table[i].IsDeleted())
                lights[i] = table[i].Light();
    }
};

class WatchedPreview : public Preview {
protected:
    void SetUp() override {
        session.reset();
        quarn::SessionOptions options;
        options.language = "C";
        session = std::make_unique<quarn::Session>(watching, options);
        ASSERT_TRUE(session->adoptProgramPlugIn().ok());
        Preview::SetUp();
        watching.session = session.get();
        watching.waits_ms.clear();
        watching.shown_before_wait.clear();
    }
    void TearDown() override { session.reset(); }

    WatchingFrontEnd watching;
};

} // namespace

// The plug-in's calls of CQuarnDoc::Regen come here, and go on to the host.
extern "C" void __real__ZN9CQuarnDoc5RegenEv(CQuarnDoc* doc);
extern "C" void __wrap__ZN9CQuarnDoc5RegenEv(CQuarnDoc* doc) {
    ++regenerations;
    __real__ZN9CQuarnDoc5RegenEv(doc);
}

TEST_F(Preview, EveryShowingEndsWithARegenerationOfTheDocument) {
    const auto regenerationsOf = [this](int frame, bool record_frames) {
        regenerations = 0;
        front_end.while_waiting = [] { EXPECT_EQ(0, regenerations) << "before the last frame"; };
        EXPECT_EQ(CQuarnCommand::success, PreviewAnimation(doc(), record(), frame, record_frames));
        front_end.while_waiting = nullptr;
        return regenerations;
    };
    followBothRails();
    record().SetFolderName(wide(folder.path()));
    EXPECT_EQ(1, regenerationsOf(-1, false));
    EXPECT_EQ(1, regenerationsOf(1, false));
    EXPECT_EQ(1, regenerationsOf(-1, true));
    setUpCameraFrames(2);
    EXPECT_EQ(1, regenerationsOf(-1, false)) << "also where no curve was hidden";
    setUpSunFrames(2);
    EXPECT_EQ(1, regenerationsOf(0, false));
}

TEST_F(Preview, RecordsWithoutAsManyPointsAsFramesAreRefused) {
    const auto expect_refused = [this] {
        front_end.clearPrinted();
        EXPECT_EQ(CQuarnCommand::failure, preview(0));
        EXPECT_THAT(printed(),
                    HasSubstr(L"No animation is currently set. There is nothing to view\n"));
    };
    expect_refused();
    setUpCameraFrames(10);
    record().CameraPoints().SetCount(9);
    expect_refused();
    setUpCameraFrames(10);
    record().TargetPoints().Append(KM_3dPoint());
    expect_refused();
    setUpCameraFrames(0);
    expect_refused();
}

TEST_F(Preview, FrameCountsUnlikeTheListsAreRefused) {
    for (const int count :
         {-1, 2, 4, std::numeric_limits<int>::max(), std::numeric_limits<int>::min()}) {
        setUpCameraFrames(3);
        record().SetFrameCount(count);
        EXPECT_EQ(CQuarnCommand::failure, preview(-1)) << count;
        EXPECT_EQ(CQuarnCommand::failure, preview(1)) << count;
    }
}

TEST_F(Preview, ACaptureTypeOutOfRangeIsACameraAnimation) {
    for (const int type : {-1, 5, 6, 17}) {
        setUpCameraFrames(3);
        record().SetCaptureType(static_cast<KM_3dmAnimationProperties::CaptureTypes>(type));
        ASSERT_EQ(CQuarnCommand::success, preview(2)) << type;
        EXPECT_TRUE(near(camera().CameraLocation(), cameraOfFrame(2), 1e-12)) << type;
        EXPECT_EQ(0, doc().LightTable().LightCount()) << type;
        ASSERT_EQ(CQuarnCommand::success, preview(0));
    }
}

TEST_F(Preview, AnyNegativeFrameIsTheWholeAnimation) {
    setUpCameraFrames(3);
    ASSERT_EQ(CQuarnCommand::success, preview(std::numeric_limits<int>::min()));
    EXPECT_EQ(2, record().CurrentFrame());
    EXPECT_EQ(30U, front_end.waited_ms());
}

TEST_F(Preview, PlayingLeavesThePointListsWhereTheyAre) {
    setUpCameraFrames(50);
    front_end.setKeyDown(VK_ESCAPE, true);
    const KM_3dPoint* camera_points = record().CameraPoints().Array();
    const KM_3dPoint* target_points = record().TargetPoints().Array();
    ASSERT_EQ(CQuarnCommand::success, preview(-1));
    EXPECT_EQ(camera_points, record().CameraPoints().Array());
    EXPECT_EQ(target_points, record().TargetPoints().Array());
}

TEST_F(Preview, SingleFrameMovesTheViewAndLeavesItThere) {
    setUpCameraFrames(10);
    ASSERT_EQ(CQuarnCommand::success, preview(4));
    EXPECT_TRUE(near(camera().CameraLocation(), cameraOfFrame(4), 1e-12));
    EXPECT_TRUE(near(camera().TargetPoint(), targetOfFrame(4), 1e-12));
    EXPECT_EQ(4, record().CurrentFrame());
    EXPECT_EQ(10U, front_end.waited_ms());
}

TEST_F(Preview, WholePlayReturnsTheViewToCameraProjectionAndMode) {
    setUpCameraFrames(3);
    ASSERT_TRUE(view(L"Perspective")
                    .MainViewport()
                    .SetDisplayMode(CQuarnDisplayAttrsMgr::RenderedModeId()));
    record().SetDisplayMode(CQuarnDisplayAttrsMgr::WireframeModeId());
    const KM_Viewport before = camera();
    ASSERT_EQ(CQuarnCommand::success, preview(-1));
    EXPECT_TRUE(near(camera().CameraLocation(), before.CameraLocation(), 0.0));
    EXPECT_TRUE(near(camera().TargetPoint(), before.TargetPoint(), 0.0));
    EXPECT_TRUE(near(camera().CameraY(), before.CameraY(), 1e-15));
    EXPECT_EQ(before.FrustumAspect(), camera().FrustumAspect());
    EXPECT_EQ(before.Projection(), camera().Projection());
    EXPECT_EQ(CQuarnDisplayAttrsMgr::RenderedModeId(), modeOf(L"Perspective"));
    EXPECT_EQ(2, record().CurrentFrame());
    EXPECT_EQ(30U, front_end.waited_ms());
}

TEST_F(Preview, WholePlayShowsEveryFrameInTheAnimationsMode) {
    const KM_UUID rendered = CQuarnDisplayAttrsMgr::RenderedModeId();
    const KM_UUID wireframe = CQuarnDisplayAttrsMgr::WireframeModeId();
    const KM_UUID x_ray = modeNamed(L"X-Ray");
    const auto seen = [this](const KM_UUID& mode) {
        EXPECT_TRUE(view(L"Perspective").MainViewport().SetDisplayMode(mode));
        std::vector<KM_UUID> modes;
        front_end.while_waiting = [&] { modes.push_back(modeOf(L"Perspective")); };
        EXPECT_EQ(CQuarnCommand::success, preview(-1));
        front_end.while_waiting = nullptr;
        EXPECT_EQ(mode, modeOf(L"Perspective"));
        return modes;
    };
    setUpCameraFrames(3);
    record().SetDisplayMode(x_ray);
    EXPECT_THAT(seen(rendered), testing::ElementsAre(x_ray, x_ray, x_ray, x_ray));
    record().SetDisplayMode(KM_nil_uuid);
    EXPECT_THAT(seen(rendered), testing::ElementsAre(wireframe, wireframe, wireframe, wireframe));
    setUpSunFrames(3);
    record().SetDisplayMode(x_ray);
    EXPECT_THAT(seen(wireframe), testing::ElementsAre(rendered, rendered, rendered, rendered));
}

TEST_F(Preview, WholePlayReturnsARolledCameraRolled) {
    setUpCameraFrames(2);
    KM_Viewport rolled = camera();
    ASSERT_TRUE(rolled.SetCameraUp({1.0, 0.0, 1.0}));
    ASSERT_TRUE(view(L"Perspective").MainViewport().SetVP(rolled, true, true));
    const KM_3dVector up = camera().CameraY();
    ASSERT_GT(std::abs(camera().CameraX().z), 0.1);
    ASSERT_EQ(CQuarnCommand::success, preview(-1));
    EXPECT_TRUE(near(camera().CameraY(), up, 1e-12));
}

TEST_F(Preview, AnimationWithoutModeIsShownAndLeftInWireframe) {
    setUpCameraFrames(3);
    ASSERT_TRUE(view(L"Perspective")
                    .MainViewport()
                    .SetDisplayMode(CQuarnDisplayAttrsMgr::RenderedModeId()));
    ASSERT_EQ(CQuarnCommand::success, preview(0));
    EXPECT_EQ(CQuarnDisplayAttrsMgr::WireframeModeId(), record().DisplayMode());
    EXPECT_EQ(CQuarnDisplayAttrsMgr::WireframeModeId(), modeOf(L"Perspective"));
}

TEST_F(Preview, FrameOutsideTheListsMovesNothingAndCountsAsShown) {
    setUpCameraFrames(3);
    const KM_3dPoint before = camera().CameraLocation();
    for (const int frame : {3, 1000, std::numeric_limits<int>::max()}) {
        EXPECT_EQ(CQuarnCommand::success, preview(frame));
        EXPECT_EQ(frame, record().CurrentFrame());
        EXPECT_TRUE(near(camera().CameraLocation(), before, 0.0));
    }
    setUpSunFrames(3);
    EXPECT_EQ(CQuarnCommand::success, preview(3));
    EXPECT_EQ(0, doc().LightTable().LightCount());
}

TEST_F(Preview, DotsAreTakenOutOfTheExtension) {
    setUpCameraFrames(1);
    record().SetFileExtension(L".p.ng");
    ASSERT_EQ(CQuarnCommand::success, preview(0));
    EXPECT_EQ(L"png", record().FileExtension().View());
}

TEST_F(Preview, ViewNameIsTrimmedAndFoundInAnyCase) {
    setUpCameraFrames(2);
    record().SetViewportName(L" tOP\t");
    ASSERT_EQ(CQuarnCommand::success, preview(1));
    EXPECT_TRUE(near(view(L"Top").MainViewport().VP().TargetPoint(), targetOfFrame(1), 1e-12));
}

TEST_F(Preview, BlankViewNameFails) {
    setUpCameraFrames(2);
    record().SetViewportName(L" \t");
    EXPECT_EQ(CQuarnCommand::failure, preview(-1));
    EXPECT_THAT(printed(), HasSubstr(L"Invalid view name. Nothing done\n"));
}

TEST_F(Preview, ViewThatIsGoneLeavesTheCurvesHidden) {
    followBothRails();
    record().SetViewportName(L"Back");
    EXPECT_EQ(CQuarnCommand::failure, preview(-1));
    EXPECT_THAT(printed(), HasSubstr(L"Unable to find viewport to play animation\n"));
    EXPECT_TRUE(isHidden(L"rail"));
    EXPECT_TRUE(isHidden(L"gaze"));
}

TEST_F(Preview, CurvesAreFollowedAsTheyAreNowAndShownAgain) {
    followBothRails();
    ASSERT_EQ(CQuarnCommand::success, preview(1));
    EXPECT_TRUE(near(camera().CameraLocation(), KM_3dPoint(5.0, 0.0, 0.0), 1e-6));
    EXPECT_TRUE(near(camera().TargetPoint(), KM_3dPoint(0.0, 2.0, 5.0), 1e-6));
    EXPECT_FALSE(isHidden(L"rail"));
    EXPECT_FALSE(isHidden(L"gaze"));
}

TEST_F(Preview, CurveThatWasHiddenBeforeStaysHidden) {
    followBothRails();
    ASSERT_TRUE(doc().HideObject(CQuarnObjRef(objectId(L"rail")), false));
    ASSERT_EQ(CQuarnCommand::success, preview(-1));
    EXPECT_TRUE(isHidden(L"rail"));
    EXPECT_FALSE(isHidden(L"gaze"));
}

TEST_F(Preview, PathWithOneCurveIsTakenAsStored) {
    followBothRails();
    record().SetTargetPathId(KM_nil_uuid);
    record().SetViewportName(L"Back");
    EXPECT_EQ(CQuarnCommand::failure, preview(0));
    EXPECT_FALSE(isHidden(L"rail"));
    record().SetViewportName(L"Perspective");
    ASSERT_EQ(CQuarnCommand::success, preview(1));
    EXPECT_TRUE(near(camera().CameraLocation(), cameraOfFrame(1), 1e-12));
}

TEST_F(Preview, FlythroughHidesItsOwnCurveOnly) {
    followBothRails();
    record().SetCaptureType(KM_3dmAnimationProperties::flythrough);
    record().SetViewportName(L"Back");
    EXPECT_EQ(CQuarnCommand::failure, preview(0));
    EXPECT_TRUE(isHidden(L"rail"));
    EXPECT_FALSE(isHidden(L"gaze"));
}

TEST_F(Preview, TurntableHidesNothing) {
    followBothRails();
    record().SetCaptureType(KM_3dmAnimationProperties::turntable);
    record().SetViewportName(L"Back");
    EXPECT_EQ(CQuarnCommand::failure, preview(0));
    EXPECT_FALSE(isHidden(L"rail"));
    EXPECT_FALSE(isHidden(L"gaze"));
}

TEST_F(Preview, SunStudyPlaysWithTheSunOffAndEndsWithItOn) {
    setUpSunFrames(3);
    switchSun(true);
    const KM_Viewport before = camera();
    ASSERT_EQ(CQuarnCommand::success, preview(-1));
    EXPECT_TRUE(doc().Sun().IsEnabled());
    EXPECT_EQ(3, doc().LightTable().LightCount());
    EXPECT_EQ(0, liveLights());
    EXPECT_EQ(-1, record().LightIndex());
    EXPECT_EQ(CQuarnDisplayAttrsMgr::RenderedModeId(), record().DisplayMode());
    EXPECT_TRUE(before == camera());
}

TEST_F(Preview, TheDocumentsSunIsNotInTheFramesOfASunStudy) {
    importObj("v -9 -9 0\nv 9 -9 0\nv 9 9 0\nv -9 9 0\nv 1 2 8\nv 4 2 0\n"
              "f 1 2 3 4\nf 1 5 6\n");
    std::vector<std::string> pictures;
    for (const bool sun_is_on : {true, false}) {
        setUpSunFrames(1);
        record().SetFolderName(wide(folder.path()));
        switchSun(sun_is_on);
        ASSERT_EQ(CQuarnCommand::success, PreviewAnimation(doc(), record(), 0, true));
        pictures.push_back(readFile(folder.path() / "Walk000.jpg"));
    }
    ASSERT_FALSE(pictures[0].empty());
    EXPECT_TRUE(pictures[0] == pictures[1]);
}

TEST_F(Preview, SunThatWasOffStaysOff) {
    setUpSunFrames(2);
    switchSun(false);
    ASSERT_EQ(CQuarnCommand::success, preview(-1));
    EXPECT_FALSE(doc().Sun().IsEnabled());
}

TEST_F(WatchedPreview, EachSunFrameShinesFromItsOwnPoint) {
    setUpSunFrames(3);
    ASSERT_EQ(CQuarnCommand::success, preview(-1));
    ASSERT_EQ(3U, watching.lights.size());
    for (int k = 0; k < 3; ++k) {
        const KM_Light& light = watching.lights.at(k);
        EXPECT_EQ(KM_LightStyle::world_directional, light.Style());
        EXPECT_TRUE(near(light.Location(), sunOfFrame(k), 0.0));
        EXPECT_TRUE(near(light.Direction(), KM_3dPoint::Origin - sunOfFrame(k), 0.0));
    }
}

TEST_F(WatchedPreview, TheViewIsShownInItsModeBeforeTheFirstFrameAndOnceForEachFrame) {
    for (const bool is_sun_study : {false, true}) {
        for (const int frame : {-1, 1}) {
            if (is_sun_study)
                setUpSunFrames(3);
            else
                setUpCameraFrames(3);
            watching.waits_ms.clear();
            watching.shown_before_wait.clear();
            ASSERT_EQ(CQuarnCommand::success, preview(frame));
            // The host works on its events once for nothing, then after each frame.
            ASSERT_FALSE(watching.waits_ms.empty());
            EXPECT_EQ(0U, watching.waits_ms.front());
            EXPECT_EQ(1, std::ranges::count(watching.waits_ms, 0U));
            const std::size_t frames = frame < 0 ? 3 : 1;
            ASSERT_EQ(1 + frames, watching.shown_before_wait.size());
            EXPECT_EQ(0U, watching.shown_before_wait[0]);
            EXPECT_EQ(1U, watching.shown_before_wait[1]);
            if (frames == 3) {
                EXPECT_LT(watching.shown_before_wait[1], watching.shown_before_wait[2]);
            }
        }
    }
}

TEST_F(Preview, SingleSunFrameLeavesRenderedModeAndNoLight) {
    setUpSunFrames(3);
    record().SetCaptureType(KM_3dmAnimationProperties::seasonal_sun);
    ASSERT_EQ(CQuarnCommand::success, preview(2));
    EXPECT_EQ(1, doc().LightTable().LightCount());
    EXPECT_EQ(0, liveLights());
    EXPECT_EQ(-1, record().LightIndex());
    EXPECT_EQ(2, record().CurrentFrame());
    EXPECT_EQ(CQuarnDisplayAttrsMgr::RenderedModeId(), modeOf(L"Perspective"));
}

TEST_F(Preview, SunStudyLeavesTheOtherLightsOfTheDocument) {
    KM_Light lamp;
    lamp.SetStyle(KM_LightStyle::world_directional);
    lamp.SetDirection({1.0, 0.0, -1.0});
    CQuarnLightTable& lights = doc().LightTable();
    const int first = lights.AddLight(lamp, nullptr);
    const int deleted = lights.AddLight(lamp, nullptr);
    lights.DeleteLight(deleted, true);
    for (const int stale :
         {-5, deleted, 9999, std::numeric_limits<int>::max(), std::numeric_limits<int>::min()}) {
        for (const int frame : {-1, 1, 1000}) {
            setUpSunFrames(2);
            record().SetLightIndex(stale);
            ASSERT_EQ(CQuarnCommand::success, preview(frame));
            EXPECT_FALSE(lights[first].IsDeleted()) << stale;
            EXPECT_EQ(1, liveLights()) << stale;
        }
    }
    EXPECT_EQ(L"", printed()) << "that there was no light to delete is not told";
}

TEST_F(Preview, EscapeShortensThePauseAndDoesNotStop) {
    setUpCameraFrames(4);
    front_end.setKeyDown(VK_ESCAPE, true);
    ASSERT_EQ(CQuarnCommand::success, preview(-1));
    EXPECT_EQ(3, record().CurrentFrame());
    EXPECT_EQ(0U, front_end.waited_ms());
}

TEST_F(Preview, WaitingTakesWholeStepsAndChecksTheKeyFirst) {
    EXPECT_FALSE(WaitAndCheckForEscapeKey(0));
    EXPECT_EQ(10U, front_end.waited_ms());
    EXPECT_FALSE(WaitAndCheckForEscapeKey(35));
    // Steps of 10 ms until 35 are over; a busy machine may need fewer of them, but never none.
    EXPECT_GE(front_end.waited_ms(), 20U);
    EXPECT_LE(front_end.waited_ms(), 50U);
    const unsigned long long waited = front_end.waited_ms();
    front_end.setKeyDown(VK_ESCAPE, true);
    EXPECT_FALSE(WaitAndCheckForEscapeKey(1000));
    EXPECT_EQ(waited, front_end.waited_ms());
}
