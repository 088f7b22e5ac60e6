#include "tests/zoetrix/fixtures/PlugInFixture.h"
#include "zoetrix/plugin/ZoetrixPlugIn.h"

using testing::HasSubstr;

namespace {

constexpr const wchar_t* VIEW_IS_GONE = L"Unable to find viewport to play animation\n";

/// Asks for a view to be closed whenever it works on events, as a person does who clicks meanwhile.
class ClosingFrontEnd final : public quarn::ScriptedFrontEnd {
public:
    void pumpEvents(unsigned) override {
        ++pumps;
        if (session)
            session->closeView(L"Perspective");
    }
    quarn::Session* session = nullptr;
    int pumps = 0;
};

class ClosedView : public PlugInFixture {
protected:
    bool hasView(const wchar_t* name) {
        KM_SimpleArray<CQuarnView*> views;
        doc().GetViewList(views, true, true);
        return std::any_of(views.begin(), views.end(), [&](const CQuarnView* each) {
            return KM_wString(each->MainViewport().Name()) == name;
        });
    }
};

class ViewClosedWhilePlaying : public ClosedView {
protected:
    void SetUp() override {
        session.reset();
        quarn::SessionOptions options;
        options.language = "C";
        session = std::make_unique<quarn::Session>(closing, options);
        ASSERT_TRUE(session->adoptProgramPlugIn().ok());
        ASSERT_EQ(CQuarnCommand::success, run(L"ViewportSize 32 24"));
        setUpCameraFrames(5);
        closing.session = session.get();
    }
    void TearDown() override { session.reset(); }

    ClosingFrontEnd closing;
};

} // namespace

TEST_F(ClosedView, ARecordOfAViewThatIsGoneCannotBePlayedOrStepped) {
    setUpCameraFrames(5);
    ASSERT_EQ(CQuarnCommand::success, run(L"RemoveView Perspective"));
    for (const wchar_t* command : {L"PlayAnimation", L"ViewFirstFrame", L"ViewNextFrame",
                                   L"ViewPreviousFrame", L"ViewLastFrame", L"ViewFrameNumber 3"}) {
        front_end.clearPrinted();
        EXPECT_EQ(CQuarnCommand::failure, run(command)) << KM_wString(command).ToUtf8();
        EXPECT_THAT(printed(), HasSubstr(VIEW_IS_GONE)) << KM_wString(command).ToUtf8();
    }
}

TEST_F(ClosedView, AFrameOfAViewThatIsGoneIsNeitherCameraNorSun) {
    KM_Viewport camera;
    KM_Light light;
    setUpCameraFrames(5);
    IQnZoetrixDynamicAccess& access = *Zoetrix_QuarnDynamicAccess();
    ASSERT_TRUE(access.AnimatedViewAtFrame(doc(), record(), 1, camera));
    ASSERT_EQ(CQuarnCommand::success, run(L"RemoveView Perspective"));
    EXPECT_FALSE(access.AnimatedViewAtFrame(doc(), record(), 1, camera));
    setUpSunFrames(5);
    EXPECT_FALSE(access.AnimatedSunAtFrame(doc(), record(), 1, light));
}

TEST_F(ClosedView, AViewAddedUnderTheNameOfOneThatIsGoneTakesItsAnimationUp) {
    setUpCameraFrames(5);
    ASSERT_EQ(CQuarnCommand::success, run(L"RemoveView Perspective"));
    ASSERT_EQ(CQuarnCommand::success, run(L"AddView Perspective Perspective"));
    EXPECT_EQ(CQuarnCommand::success, run(L"ViewFrameNumber 2"));
    EXPECT_TRUE(
        near(view(L"Perspective").MainViewport().VP().CameraLocation(), cameraOfFrame(2), 1e-12));
}

TEST_F(ViewClosedWhilePlaying, ItIsThereForEveryFrameAndGoneWhenTheCommandHasEnded) {
    EXPECT_EQ(CQuarnCommand::success, run(L"PlayAnimation"));
    EXPECT_GE(closing.pumps, 5);
    EXPECT_FALSE(hasView(L"Perspective"));
    EXPECT_TRUE(hasView(L"Right"));
    EXPECT_EQ(CQuarnCommand::failure, run(L"PlayAnimation"));
    EXPECT_THAT(closing.printed(), HasSubstr(VIEW_IS_GONE));
}
