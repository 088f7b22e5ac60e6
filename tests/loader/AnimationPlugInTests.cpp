#include "tests/loader/LoaderTest.h"

namespace quarn::test {
namespace {

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

} // namespace
} // namespace quarn::test
