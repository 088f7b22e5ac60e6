#include "host/session/DocumentState.h"
#include "tests/loader/LoaderTest.h"
#include "tests/plug-ins/TestPlugIn.h"
#include "tests/support/TempFolder.h"

namespace quarn::test {
namespace {

using testing::HasSubstr;

const KM_UUID ZOETRIX_ID = KM_UuidFromString("3AA81848-5635-41BB-ABDB-0EC069BC5519");

/// The commands in the order in which their objects are made.
constexpr const wchar_t* COMMANDS_IN_ORDER[] = {
    L"PlayAnimation",     L"ViewFirstFrame",          L"ViewLastFrame",
    L"ViewPreviousFrame", L"ViewNextFrame",           L"ViewFrameNumber",
    L"RecordAnimation",   L"SetFlythroughAnimation",  L"SetOneDaySunAnimation",
    L"SetPathAnimation",  L"SetSeasonalSunAnimation", L"SetTurntableAnimation",
};

TEST_F(LoaderTest, TheAnimationPlugInBringsItsTwelveCommands) {
    const PlugInLoad loaded = session->loadPlugIn(ZOETRIX_PLUGIN_PATH);
    ASSERT_EQ(loaded.outcome, Outcome::loaded) << loaded.message;
    EXPECT_TRUE(CQuarnPlugIn::PlugInIsLoaded(ZOETRIX_ID));
    for (const wchar_t* name : COMMANDS_IN_ORDER) {
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

TEST_F(LoaderTest, TheAnimationPlugInMakesItsCommandsInTheirOrder) {
    // Commands are registered as they were made, and the first whose name is taken is told: with
    // the names from one on all taken, it is that one.
    for (std::size_t first = 0; first < std::size(COMMANDS_IN_ORDER); ++first) {
        start({{}, {}, "C", {}});
        const TestApplication application;
        const TestPlugIn plug_in("0B7E9B0C-6C1E-4C5B-8C55-3A8D0C9F2A00");
        std::vector<std::unique_ptr<TestCommand>> taken;
        for (std::size_t k = first; k < std::size(COMMANDS_IN_ORDER); ++k)
            taken.push_back(std::make_unique<TestCommand>(
                COMMANDS_IN_ORDER[k],
                ("0B7E9B0C-6C1E-4C5B-8C55-3A8D0C9F2B" + std::to_string(10 + k)).c_str()));
        ASSERT_TRUE(session->adoptProgramPlugIn().ok());
        const PlugInLoad refused = session->loadPlugIn(ZOETRIX_PLUGIN_PATH);
        EXPECT_EQ(refused.outcome, Outcome::load_refused);
        const std::string name = KM_wString(COMMANDS_IN_ORDER[first]).ToUtf8();
        EXPECT_THAT(refused.message, testing::HasSubstr("There is a command " + name + " already"));
        session.reset();
    }
}

/// What the animation plug-in remembers from one command to the next, as long as it is loaded.
class RememberedChoices : public LoaderTest {
protected:
    void load() {
        start({{}, {}, "C", {}});
        ASSERT_TRUE(session->loadPlugIn(ZOETRIX_PLUGIN_PATH).ok());
    }
    /// Sets up a turntable. @return where the camera stands in its first frame
    KM_3dPoint firstCamera(const std::wstring& direction) {
        EXPECT_EQ(run((L"SetTurntableAnimation 4 " + direction + L" _Enter _Enter _Enter _Enter")
                          .c_str()),
                  CQuarnCommand::success);
        return session->document().Properties().AnimationProperties().CameraPoints()[0];
    }
    /// What the question of RecordAnimation shows of its switch.
    std::wstring runSwitch(const wchar_t* words) {
        EXPECT_EQ(run(words), CQuarnCommand::failure) << "it is cancelled";
        front_end.addAnswer(L"_Cancel");
        EXPECT_EQ(run(L"RecordAnimation"), CQuarnCommand::failure);
        return std::wstring(front_end.questions().back().options.at(1).value.View());
    }
};

TEST_F(RememberedChoices, BeginAnewWhenThePlugInIsLoadedAgain) {
    load();
    const KM_3dPoint clockwise = firstCamera(L"_Enter");
    const KM_3dPoint anticlockwise = firstCamera(L"AntiClockwise");
    EXPECT_NE(clockwise, anticlockwise);
    EXPECT_EQ(firstCamera(L"_Enter"), anticlockwise);
    EXPECT_EQ(runSwitch(L"RecordAnimation RunAnimation=Yes _Cancel"), L"Yes");
    load();
    EXPECT_EQ(firstCamera(L"_Enter"), clockwise);
    EXPECT_EQ(runSwitch(L"RecordAnimation _Cancel"), L"No");
}

} // namespace
} // namespace quarn::test
