#include "sdk/qncore/QnZoetrixDynamicAccess.h"
#include "tests/kelmar/FilledRecord.h"
#include "tests/zoetrix/fixtures/PlugInFixture.h"
#include "zoetrix/commands/cmdFlyThru.h"
#include "zoetrix/commands/cmdOneDaySun.h"
#include "zoetrix/commands/cmdPath.h"
#include "zoetrix/commands/cmdSeasonalSun.h"
#include "zoetrix/commands/cmdTurntable.h"
#include "zoetrix/commands/cmdZoetrix.h"
#include "zoetrix/plugin/ZoetrixPlugIn.h"
#include "zoetrix/plugin/ZoetrixUtilities.h"

#include <cstdlib>
#include <regex>
#include <type_traits>

extern CCommandPlayAnimation thePlayAnimationCommand;
extern CCommandViewFirstFrame theViewFirstFrameCommand;
extern CCommandViewLastFrame theViewLastFrameCommand;
extern CCommandViewPreviousFrame theViewPreviousFrameCommand;
extern CCommandViewNextFrame theViewNextFrameCommand;
extern CCommandViewFrameNumber theViewFrameNumberCommand;
extern CCommandRecordAnimation theRecordAnimationCommand;
extern CCommandFlythroughAnimation theFlythroughAnimationCommand;
extern CCommandOneDaySun theOneDaySunCommand;
extern CCommandPathAnimation thePathAnimationCommand;
extern CCommandSeasonalSun theSeasonalSunCommand;
extern CCommandTurntableAnimation theTurntableAnimationCommand;

extern "C" unsigned int QuarnPlugInSdkVersion();
extern "C" unsigned int QuarnPlugInSdkServiceRelease();
extern "C" const wchar_t* QuarnPlugInUpdateURL();
extern "C" const wchar_t* QuarnPlugInDeveloperOrganization();
extern "C" const wchar_t* QuarnPlugInDeveloperAddress();
extern "C" const wchar_t* QuarnPlugInDeveloperCountry();
extern "C" const wchar_t* QuarnPlugInDeveloperPhone();
extern "C" const wchar_t* QuarnPlugInDeveloperFax();
extern "C" const wchar_t* QuarnPlugInDeveloperEmail();
extern "C" const wchar_t* QuarnPlugInDeveloperWebsite();

namespace {

class PlugIn : public PlugInFixture {
protected:
    /// Starts the host anew, without the plug-in.
    void restart() {
        session.reset();
        session = std::make_unique<quarn::Session>(front_end, quarn::SessionOptions());
    }
};

class SpanishPlugIn : public PlugInFixture {
protected:
    SpanishPlugIn() : PlugInFixture("", "es") {}
};

/// A user without a home, of whom no documents folder is known, for as long as the object lives.
class Homeless {
public:
    Homeless() : m_home(std::getenv("HOME") ? std::getenv("HOME") : "") { unsetenv("HOME"); }
    ~Homeless() { setenv("HOME", m_home.c_str(), 1); }
    Homeless(const Homeless&) = delete;
    Homeless& operator=(const Homeless&) = delete;

private:
    std::string m_home;
};

struct ExpectedCommand {
    CQuarnCommand& command;
    const wchar_t* name;
    const char* id;
};

std::vector<ExpectedCommand> expectedCommands() {
    return {
        {thePlayAnimationCommand, L"PlayAnimation", "CDCA99EF-EF0F-4DE3-85A7-C63CB2BD0F15"},
        {theViewFirstFrameCommand, L"ViewFirstFrame", "01DC4D43-8287-424B-8E6F-72A4E67BDE55"},
        {theViewLastFrameCommand, L"ViewLastFrame", "1683D016-E18C-475B-BF04-3D119A7042CC"},
        {theViewPreviousFrameCommand, L"ViewPreviousFrame", "2885F440-04BB-44DB-947C-588E7AFA5843"},
        {theViewNextFrameCommand, L"ViewNextFrame", "4C469EE8-C86C-4360-AF5E-399364C9548C"},
        {theViewFrameNumberCommand, L"ViewFrameNumber", "3C6EDF7C-FBD0-47EE-A399-2E977058E95B"},
        {theRecordAnimationCommand, L"RecordAnimation", "FCE04371-0752-46BA-A4DA-0C6F62A24D61"},
        {theFlythroughAnimationCommand, L"SetFlythroughAnimation",
         "66C3E01D-DE14-43D9-B796-DA7B7411E343"},
        {theOneDaySunCommand, L"SetOneDaySunAnimation", "99C50CFF-7C59-4F46-B3A9-B1FB70C3A343"},
        {thePathAnimationCommand, L"SetPathAnimation", "BBFB4E20-1E39-4047-8109-D953556A2441"},
        {theSeasonalSunCommand, L"SetSeasonalSunAnimation", "A768A27F-B022-4296-8549-FE87042CDF17"},
        {theTurntableAnimationCommand, L"SetTurntableAnimation",
         "24E39B43-B4C1-44AC-8479-4CB1AB388ED5"},
    };
}

} // namespace

TEST_F(PlugIn, HasItsIdentity) {
    const CZoetrixPlugIn& plug_in = ZoetrixPlugIn();
    EXPECT_STREQ(L"Zoetrix", plug_in.PlugInName());
    EXPECT_STREQ(L"Zoetrix", plug_in.LocalPlugInName());
    EXPECT_EQ(L"3AA81848-5635-41BB-ABDB-0EC069BC5519", KM_UuidToString(plug_in.PlugInID()).View());
    EXPECT_EQ(2, plug_in.PlugInLoadTime());
    EXPECT_EQ(16U, plug_in.PlugInType());
    EXPECT_TRUE(CQuarnPlugIn::PlugInIsLoaded(plug_in.PlugInID()));
}

TEST_F(PlugIn, VersionIsTheBuildDateAndTimeWithTwoBlanksBetween) {
    const std::string version = KM_wString(ZoetrixPlugIn().PlugInVersion()).ToUtf8();
    const std::regex form("[A-Z][a-z]{2} [ 1-3][0-9] [0-9]{4}  [0-9]{2}:[0-9]{2}:[0-9]{2}");
    EXPECT_TRUE(std::regex_match(version, form)) << version;
}

TEST_F(PlugIn, ExportsAnswerTheInterfaceVersionTwice) {
    EXPECT_EQ(2353819966U, QuarnPlugInSdkVersion());
    EXPECT_EQ(2353819966U, QuarnPlugInSdkServiceRelease());
}

TEST_F(PlugIn, ContactsTellWhereToUpdateAndWhoMadeIt) {
    EXPECT_STREQ(L"https://quarn.example/download", QuarnPlugInUpdateURL());
    EXPECT_STREQ(L"Quarn", QuarnPlugInDeveloperOrganization());
    EXPECT_STREQ(L"1 Example Street", QuarnPlugInDeveloperAddress());
    EXPECT_STREQ(L"Example Country", QuarnPlugInDeveloperCountry());
    EXPECT_STREQ(L"+1 555 0100", QuarnPlugInDeveloperPhone());
    EXPECT_STREQ(L"+1 555 0101", QuarnPlugInDeveloperFax());
    EXPECT_STREQ(L"zoetrix@quarn.example", QuarnPlugInDeveloperEmail());
    EXPECT_STREQ(L"https://quarn.example/zoetrix", QuarnPlugInDeveloperWebsite());
}

TEST_F(PlugIn, TwelveCommandsHaveTheirNamesAndIds) {
    for (const ExpectedCommand& expected : expectedCommands()) {
        EXPECT_STREQ(expected.name, expected.command.EnglishCommandName());
        EXPECT_EQ(KM_UuidFromString(expected.id), expected.command.CommandUUID()) << expected.id;
        EXPECT_EQ(&ZoetrixPlugIn(), expected.command.PlugIn()) << expected.id;
        EXPECT_GT(std::wstring_view(expected.command.CommandDescription()).size(), 10U);
        EXPECT_FALSE(expected.command.IsTransparent());
        EXPECT_TRUE(expected.command.RepeatsOnEnter());
        EXPECT_FALSE(expected.command.IsHidden());
    }
}

TEST_F(PlugIn, OnlyRecordingRunsScripts) {
    for (const ExpectedCommand& expected : expectedCommands())
        EXPECT_EQ(&expected.command == &theRecordAnimationCommand,
                  expected.command.IsScriptCommand());
    EXPECT_TRUE((std::is_base_of_v<CQuarnScriptCommand, CCommandRecordAnimation>));
}

TEST_F(PlugIn, RegistersItsDynamicAccessWhileLoaded) {
    const IQnZoetrixDynamicAccess* access = Zoetrix_QuarnDynamicAccess();
    ASSERT_TRUE(access);
    EXPECT_EQ(&record(), &access->AnimationProperties(doc()));
    session.reset();
    EXPECT_EQ(nullptr, Zoetrix_QuarnDynamicAccess());
}

TEST_F(PlugIn, StoresWhatADocumentIsGiven) {
    KM_3dmAnimationProperties changed = ZoetrixPlugIn().AnimationProperties(doc());
    changed.SetFrameCount(37);
    doc().Properties().SetAnimationProperties(changed);
    EXPECT_EQ(37, ZoetrixPlugIn().AnimationProperties(doc()).FrameCount());
    EXPECT_EQ(37, doc().Properties().AnimationProperties().FrameCount());

    CZoetrixPlugIn other;
    EXPECT_EQ(100, other.AnimationProperties(doc()).FrameCount());
}

TEST_F(PlugIn, KeepsItsLastRecordAfterUnloadingForWhateverDocument) {
    record() = filledRecord();
    const KM_3dmAnimationProperties* kept = &ZoetrixPlugIn().AnimationProperties(doc());
    restart();
    EXPECT_EQ(kept, &ZoetrixPlugIn().AnimationProperties(doc()));
    expectFilled(record());
    ASSERT_EQ(CQuarnCommand::success, run(L"_-New"));
    EXPECT_EQ(kept, &ZoetrixPlugIn().AnimationProperties(doc()));
    expectFilled(record());
}

TEST_F(PlugIn, LoadingGivesTheRecordItsStartingValues) {
    const KM_3dmAnimationProperties& props = record();
    EXPECT_EQ(L"Wireframe", props.CaptureMethod().View());
    EXPECT_EQ(L"Animation", props.HtmlFilename().View());
    EXPECT_EQ((wide(folder.path()) + L"/Animation").View(), props.FolderName().View());
}

TEST_F(PlugIn, StartingValuesAreGivenToThreeFieldsAndNoOther) {
    KM_3dmAnimationProperties props = filledRecord();
    CZoetrixUtilities::InitializeAnimationProperties(props);
    KM_3dmAnimationProperties expected = filledRecord();
    expected.SetCaptureMethod(L"Wireframe");
    expected.SetHtmlFilename(L"Animation");
    expected.SetFolderName(wide(folder.path()) + L"/Animation");
    EXPECT_TRUE(bytesOf(expected) == bytesOf(props));
}

TEST_F(PlugIn, DocumentsFolderThatIsGoneLeavesTheFolderAsItIs) {
    std::filesystem::remove_all(folder.path());
    for (const wchar_t* before : {L"", L"/tmp/out"}) {
        KM_3dmAnimationProperties props;
        props.SetFolderName(before);
        CZoetrixUtilities::InitializeAnimationProperties(props);
        EXPECT_EQ(L"Animation", props.HtmlFilename().View());
        EXPECT_EQ(before, props.FolderName().View());
    }
}

TEST_F(PlugIn, UnknownDocumentsFolderLeavesTheFolderAsItIs) {
    const Homeless nobody;
    restart();
    KM_3dmAnimationProperties props;
    CZoetrixUtilities::InitializeAnimationProperties(props);
    EXPECT_EQ(L"Animation", props.HtmlFilename().View());
    EXPECT_TRUE(props.FolderName().IsEmpty());
}

TEST_F(SpanishPlugIn, StartsWithTheNamesOfTheUsersLanguage) {
    EXPECT_STREQ(L"Zoetrix", ZoetrixPlugIn().PlugInName());
    EXPECT_EQ(L"Alámbrico", record().CaptureMethod().View());
    EXPECT_EQ(L"Animación", record().HtmlFilename().View());
    EXPECT_EQ((wide(folder.path()) + L"/Animación").View(), record().FolderName().View());
}
