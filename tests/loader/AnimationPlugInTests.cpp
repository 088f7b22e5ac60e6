#include "host/session/DocumentState.h"
#include "tests/loader/LoaderTest.h"
#include "tests/support/TempFolder.h"

namespace quarn::test {
namespace {

using testing::HasSubstr;

const KM_UUID ZOETRIX_ID = KM_UuidFromString("3AA81848-5635-41BB-ABDB-0EC069BC5519");

TEST_F(LoaderTest, TheAnimationPlugInBringsItsTwelveCommands) {
    const PlugInLoad loaded = session->loadPlugIn(ZOETRIX_PLUGIN_PATH);
    ASSERT_EQ(loaded.outcome, Outcome::loaded) << loaded.message;
    EXPECT_TRUE(CQuarnPlugIn::PlugInIsLoaded(ZOETRIX_ID));
    for (const wchar_t* name :
         {L"PlayAnimation", L"ViewFirstFrame", L"ViewLastFrame", L"ViewPreviousFrame",
          L"ViewNextFrame", L"ViewFrameNumber", L"RecordAnimation", L"SetFlythroughAnimation",
          L"SetOneDaySunAnimation", L"SetPathAnimation", L"SetSeasonalSunAnimation",
          L"SetTurntableAnimation"}) {
        const std::wstring help = L"Help ";
        EXPECT_EQ(session->runCommand(help + name), CQuarnCommand::success)
            << KM_wString(name).ToUtf8();
    }
}

TEST_F(LoaderTest, TheAnimationPlugInKeepsTheRecordWhileItIsLoaded) {
    EXPECT_EQ(Zoetrix_QuarnDynamicAccess(), nullptr);
    ASSERT_TRUE(session->loadPlugIn(ZOETRIX_PLUGIN_PATH).ok());
    EXPECT_NE(Zoetrix_QuarnDynamicAccess(), nullptr);
    session.reset();
    EXPECT_EQ(Zoetrix_QuarnDynamicAccess(), nullptr);
}

class AnimationInTheDocument : public LoaderTest {
protected:
    void SetUp() override {
        LoaderTest::SetUp();
        ASSERT_TRUE(session->loadPlugIn(ZOETRIX_PLUGIN_PATH).ok());
    }
    /// Sets up a turntable of so many frames.
    void setUpTurntable(int frames) {
        const std::wstring line = L"_SetTurntableAnimation " + std::to_wstring(frames) +
                                  L" _Clockwise _jpg _Wireframe Perspective _Enter";
        ASSERT_EQ(session->runCommand(line), CQuarnCommand::success) << printed();
    }
    int frameCount() { return session->document().Properties().AnimationProperties().FrameCount(); }
    void expectSetUpStores() {
        setUpTurntable(8);
        EXPECT_EQ(frameCount(), 8);
    }
};

TEST_F(AnimationInTheDocument, IsUnsavedAlsoAfterAnotherPlugInWasLoaded) {
    setUpTurntable(7);
    ASSERT_TRUE(isModified(session->document()));
    ASSERT_TRUE(load("good.qnp").ok());
    EXPECT_TRUE(isModified(session->document()));
}

TEST_F(AnimationInTheDocument, DoesNotGoIntoANewOneAfterAnotherPlugInWasLoaded) {
    const int frames_at_first = frameCount();
    setUpTurntable(7);
    ASSERT_TRUE(load("good.qnp").ok());
    ASSERT_EQ(run(L"_New"), CQuarnCommand::success) << printed();
    EXPECT_EQ(frameCount(), frames_at_first);
    EXPECT_FALSE(isModified(session->document()));
}

TEST_F(AnimationInTheDocument, IsStillReachedAfterASecondCopyOfThePlugInWasRefused) {
    const TempFolder folder;
    const std::filesystem::path copy = folder / "Zoetrix.qnp";
    std::filesystem::copy_file(ZOETRIX_PLUGIN_PATH, copy);
    const PlugInLoad second = session->loadPlugIn(copy);
    ASSERT_EQ(second.outcome, Outcome::load_refused);
    EXPECT_THAT(second.message, HasSubstr("a plug-in with the id 3AA81848"));
    EXPECT_NE(Zoetrix_QuarnDynamicAccess(), nullptr);
    expectSetUpStores();
}

} // namespace
} // namespace quarn::test
