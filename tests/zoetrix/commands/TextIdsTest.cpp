#include "tests/zoetrix/fixtures/PlugInFixture.h"
#include "zoetrix/commands/cmdZoetrix.h"
#include "zoetrix/plugin/ZoetrixPlugIn.h"
#include "zoetrix/plugin/ZoetrixUtilities.h"

using testing::ElementsAre;
using testing::HasSubstr;

namespace {

using Texts = std::vector<std::wstring>;

/// A table in which every text is its number with a letter before it.
std::string numbersAfter(char letter) {
    constexpr std::pair<int, int> ranges[] = {
        {15604, 15621}, {16714, 16784}, {18433, 18438}, {19628, 19628}, {19746, 19763},
        {20120, 20121}, {20752, 20763}, {26225, 26225}, {32015, 32016}, {33987, 33988}};
    std::string entries;
    for (const auto& [first, last] : ranges)
        for (int id = first; id <= last; ++id)
            entries += (entries.empty() ? "\"" : ", \"") + std::to_string(id) + "\": \"" + letter +
                       std::to_string(id) + "\"";
    return "{" + entries + "}";
}

/// Texts that read alike in English have a number each, so that a language may word each by itself.
/// In the language of these tests strings begin with T, option names with N, option values with V.
class TextIds : public PlugInFixture {
protected:
    void SetUp() override {
        std::filesystem::create_directory(folder / "locale");
        writeFile(folder / "locale" / "xx.json",
                  "{\"strings\": " + numbersAfter('T') + ", \"option_names\": " +
                      numbersAfter('N') + ", \"option_values\": " + numbersAfter('V') + "}");
        record() = KM_3dmAnimationProperties();
        session.reset();
        quarn::SessionOptions options;
        options.language = "xx";
        options.locale_folders = {folder / "locale"};
        options.documents_folder = folder.path();
        session = std::make_unique<quarn::Session>(front_end, options);
        ASSERT_TRUE(session->adoptProgramPlugIn().ok());
        ASSERT_EQ(CQuarnCommand::success, run(L"ViewportSize 32 24"));
        front_end.clearPrinted();
    }

    /// What is printed while a command asks for the options with these answers.
    std::wstring printedByOptions(std::initializer_list<std::wstring_view> answers) {
        front_end.clearPrinted();
        answer(answers);
        insideCommand(
            [this](CQuarnDoc& document) { GetAnimationOptions(document, record(), false); });
        return printed();
    }
    std::wstring methodAfter(const wchar_t* method, std::wstring_view typed) {
        record().SetCaptureMethod(method);
        printedByOptions({L"_Enter", typed, L"_Enter", L"_Enter"});
        return std::wstring(record().CaptureMethod().View());
    }
    Texts promptsFrom(std::size_t first) {
        Texts prompts;
        for (std::size_t k = first; k < front_end.questions().size(); ++k)
            prompts.emplace_back(front_end.questions()[k].prompt.View());
        return prompts;
    }
    Texts optionsOf(std::size_t question) {
        Texts names;
        for (const quarn::QuestionOption& option : front_end.questions().at(question).options)
            names.emplace_back(option.local_name.View());
        return names;
    }
};

} // namespace

TEST_F(TextIds, LoadingTakesTheNamesByTheirNumbers) {
    EXPECT_STREQ(L"T19628", ZoetrixPlugIn().LocalPlugInName());
    EXPECT_EQ(L"T32015", record().CaptureMethod().View());
    EXPECT_EQ(L"T32016", record().HtmlFilename().View());
}

TEST_F(TextIds, EachCommandHasANumberOfItsOwnForNoAnimation) {
    const std::pair<const wchar_t*, const wchar_t*> commands[] = {
        {L"PlayAnimation", L"T16776"},   {L"ViewFirstFrame", L"T16777"},
        {L"ViewLastFrame", L"T16778"},   {L"ViewPreviousFrame", L"T16779"},
        {L"ViewNextFrame", L"T16780"},   {L"ViewFrameNumber", L"T16781"},
        {L"RecordAnimation", L"T16784"},
    };
    for (const auto& [command, message] : commands) {
        front_end.clearPrinted();
        EXPECT_EQ(CQuarnCommand::failure, run(command));
        EXPECT_EQ(message, printed()) << KM_wString(command).ToUtf8();
    }
    front_end.clearPrinted();
    EXPECT_EQ(CQuarnCommand::failure, PreviewAnimation(doc(), record(), 0, false));
    EXPECT_EQ(L"T16773", printed());
}

TEST_F(TextIds, ShowingAFrameHasItsNumbers) {
    setUpCameraFrames(2);
    answer({L"_Cancel"});
    EXPECT_EQ(CQuarnCommand::cancel, run(L"ViewFrameNumber"));
    EXPECT_EQ(L"T16783", printed());
    EXPECT_THAT(promptsFrom(0), ElementsAre(L"T16782"));
    front_end.clearPrinted();
    record().SetViewportName(L" ");
    EXPECT_EQ(CQuarnCommand::failure, run(L"PlayAnimation"));
    record().SetViewportName(L"Back");
    EXPECT_EQ(CQuarnCommand::failure, run(L"PlayAnimation"));
    EXPECT_EQ(L"T16774T16775", printed());
}

TEST_F(TextIds, OptionsHaveANumberForEachWayToEnd) {
    EXPECT_EQ(L"T16715", printedByOptions({L"_Cancel"}));
    EXPECT_EQ(L"T16717", printedByOptions({L"_Enter", L"_Cancel"}));
    EXPECT_EQ(L"T16719", printedByOptions({L"_Enter", L"_Enter", L"_Cancel"}));
    EXPECT_EQ(L"T16720", printedByOptions({L"_Enter", L"_Enter", L"  "}));
    EXPECT_EQ(L"T16721", printedByOptions({L"_Enter", L"_Enter", L"Back"}));
    const std::size_t asked = front_end.questions().size();
    EXPECT_EQ(L"T16723", printedByOptions({L"_Enter", L"_Enter", L"_Enter", L"_Cancel"}));
    EXPECT_THAT(promptsFrom(asked), ElementsAre(L"T16714", L"T16716", L"T16718", L"T16722"));
    EXPECT_THAT(optionsOf(asked), ElementsAre(L"N18433", L"N18434", L"N18435", L"N18436"));
    EXPECT_EQ(L"N18437", optionsOf(asked + 1).at(0));
    EXPECT_EQ(L"N18438", optionsOf(asked + 1).at(1));
    EXPECT_THAT(optionsOf(asked + 1), testing::Contains(L"T19747"));
    EXPECT_THAT(optionsOf(asked + 1), testing::Contains(L"T20121"));
}

TEST_F(TextIds, RenderMethodsAreStoredKeptAndOfferedByDifferentNumbers) {
    EXPECT_EQ(L"T19750", methodAfter(L"", L"_RenderFull"));
    EXPECT_EQ(L"T19750", methodAfter(L"", L"[N18437]"));
    EXPECT_EQ(L"T19751", methodAfter(L"", L"_RenderPreview"));
    EXPECT_EQ(L"T19748", methodAfter(L"T19748", L"_Enter"));
    EXPECT_EQ(L"T19749", methodAfter(L"T19749", L"_Enter"));
    EXPECT_NE(L"T19750", methodAfter(L"T19750", L"_Enter")) << "stored so, and not known so";

    KM_ClassArray<KM_wString> types, methods, views;
    KM_SimpleArray<KM_UUID> ids;
    int type = 0, method = 0, view_index = 0;
    GetDailogAnimationOptions(record(), types, type, methods, method, views, view_index, ids,
                              false);
    EXPECT_EQ(L"T20762", methods[0].View());
    EXPECT_EQ(L"T20763", methods[1].View());
}

TEST_F(TextIds, RecordingTellsTypedFoldersAndAskedOnesApart) {
    setUpCameraFrames(1);
    answer({L"nowhere", L"TargetFolder", L"nowhere", L"_Cancel"});
    EXPECT_EQ(CQuarnCommand::failure, run(L"RecordAnimation"));
    EXPECT_EQ(L"T20758T20757", printed());
    EXPECT_THAT(promptsFrom(0), ElementsAre(L"T33987", L"T33987", L"T20756", L"T33987"));
    EXPECT_THAT(optionsOf(0), ElementsAre(L"N33988", L"N20752"));
    EXPECT_EQ(L"V20753", front_end.questions()[0].options[1].value.View());
}

TEST_F(TextIds, TheFolderChooserHasItsNumbers) {
    setUpCameraFrames(1);
    answer({L"TargetFolder", L"_Cancel"});
    EXPECT_EQ(CQuarnCommand::failure, session->runCommand(L"RecordAnimation", true));
    EXPECT_EQ(L"T26225", printed());
    ASSERT_EQ(1U, front_end.folderQuestions().size());
    EXPECT_EQ(L"T19763", front_end.folderQuestions()[0].title);
    EXPECT_EQ(L"T19762", front_end.folderQuestions()[0].message);
}

TEST_F(TextIds, TheStopOfThePageAndThatOfItsScriptAreApart) {
    const std::wstring page(CZoetrixUtilities::GetHTMLtemplate(record()).View());
    EXPECT_THAT(page, HasSubstr(L"onDblClick=\"start_stop()\">T15604</BUTTON>"));
    EXPECT_THAT(page, HasSubstr(L">T15605\n"));
    EXPECT_THAT(page, HasSubstr(L">T15606\n"));
    EXPECT_THAT(page, HasSubstr(L">T15607 <A HREF"));
    EXPECT_THAT(page, HasSubstr(L".textContent = \"T15620\";"));
    EXPECT_THAT(page, HasSubstr(L".textContent = \"T15621\";"));
}
