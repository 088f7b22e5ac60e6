#include "host/session/Completion.h"
#include "host/session/FileCompletion.h"
#include "tests/support/TempFolder.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace quarn::test {
namespace {

using testing::ElementsAre;
using testing::IsEmpty;

std::vector<std::wstring> textsOf(const Completion& completion) {
    std::vector<std::wstring> texts;
    for (const Completion::Candidate& candidate : completion.candidates)
        texts.push_back(candidate.text);
    return texts;
}

const std::vector<CommandName> NAMES = {
    {L"Help", L"Hilfe", L""}, {L"Hide", L"Hide", L""}, {L"SetTurntable", L"SetTurntable", L""}};

TEST(CommandCompletion, FindsNamesInAnyCaseAndBothLanguages) {
    EXPECT_THAT(textsOf(completeCommand(L"h", NAMES)), ElementsAre(L"Hilfe", L"Help", L"Hide"));
    EXPECT_THAT(textsOf(completeCommand(L"HIL", NAMES)), ElementsAre(L"Hilfe"));
    EXPECT_THAT(textsOf(completeCommand(L"x", NAMES)), IsEmpty());
    EXPECT_THAT(textsOf(completeCommand(L"Helper", NAMES)), IsEmpty());
}

TEST(CommandCompletion, KeepsPrefixesAndIsEnglishBehindAnUnderscore) {
    EXPECT_THAT(textsOf(completeCommand(L"_-h", NAMES)), ElementsAre(L"_-Help", L"_-Hide"));
    EXPECT_THAT(textsOf(completeCommand(L"-set", NAMES)), ElementsAre(L"-SetTurntable"));
}

TEST(CommandCompletion, ReplacesTheNameBehindBlanksAndEndsItWithOne) {
    const Completion completion = completeCommand(L"  sett", NAMES);
    EXPECT_EQ(completion.begin, 2u);
    ASSERT_THAT(textsOf(completion), ElementsAre(L"SetTurntable"));
    EXPECT_EQ(completion.candidates[0].ending, L" ");
}

TEST(CommandCompletion, IsOfFilesBehindTheName) {
    const TempFolder folder;
    writeFile(folder / "house.obj", "");
    const std::wstring path(KM_wString::FromUtf8((folder / "ho").native()).View());
    const Completion completion = completeCommand(L"Import " + path, NAMES);
    EXPECT_EQ(completion.begin, 7u);
    ASSERT_THAT(textsOf(completion), ElementsAre(path + L"use.obj"));
    EXPECT_EQ(completion.candidates[0].ending, L" ");
}

TEST(Completion, SharedTextIgnoresCaseAndIsSpeltAsTheFirst) {
    Completion completion;
    EXPECT_EQ(completion.commonText(), L"");
    completion.candidates = {{L"SetTurn", L"", L""}, {L"setTour", L"", L""}, {L"SETT", L"", L""}};
    EXPECT_EQ(completion.commonText(), L"SetT");
}

class FileCompletion : public testing::Test {
protected:
    FileCompletion() {
        writeFile(m_folder / "Grand Hall.obj", "");
        writeFile(m_folder / "Grange.obj", "");
        writeFile(m_folder / ".hidden", "");
        std::filesystem::create_directory(m_folder / "größe");
    }

    std::wstring inFolder(std::wstring_view name) const {
        return std::wstring(KM_wString::FromUtf8(m_folder.path().native()).View()) + L"/" +
               std::wstring(name);
    }

    TempFolder m_folder;
};

TEST_F(FileCompletion, GoesIntoFoldersAndLeavesHiddenFilesOut) {
    EXPECT_THAT(
        textsOf(completeFile(inFolder(L""), false)),
        ElementsAre(inFolder(L"Grand Hall.obj"), inFolder(L"Grange.obj"), inFolder(L"größe/")));
    EXPECT_THAT(textsOf(completeFile(inFolder(L".h"), false)), ElementsAre(inFolder(L".hidden")));
    EXPECT_EQ(completeFile(inFolder(L"gr"), false).candidates[0].shown, L"größe/");
}

TEST_F(FileCompletion, DistinguishesCaseAsTheFileSystemDoes) {
    EXPECT_THAT(textsOf(completeFile(inFolder(L"gra"), false)), IsEmpty());
}

TEST_F(FileCompletion, OfAWordPutsBlanksInQuotes) {
    const Completion hall = completeFile(inFolder(L"Grand"), true);
    ASSERT_THAT(textsOf(hall), ElementsAre(L"\"" + inFolder(L"Grand Hall.obj")));
    EXPECT_EQ(hall.candidates[0].ending, L"\" ");
    EXPECT_EQ(completeFile(inFolder(L"Gran"), true).commonText(), L"\"" + inFolder(L"Gran"));
    const Completion grange = completeFile(L"\"" + inFolder(L"Grang"), true);
    ASSERT_THAT(textsOf(grange), ElementsAre(L"\"" + inFolder(L"Grange.obj")));
    EXPECT_EQ(grange.candidates[0].ending, L"\" ");
}

TEST_F(FileCompletion, OfAWholeAnswerNeedsNoQuotes) {
    const Completion hall = completeFile(inFolder(L"Grand"), false);
    ASSERT_THAT(textsOf(hall), ElementsAre(inFolder(L"Grand Hall.obj")));
    EXPECT_EQ(hall.candidates[0].ending, L"");
}

TEST_F(FileCompletion, OfAFolderThatIsNotThereFindsNothing) {
    EXPECT_THAT(textsOf(completeFile(inFolder(L"nowhere/a"), false)), IsEmpty());
}

Question questionOf(Question::Kind kind) {
    Question question;
    question.kind = kind;
    question.prompt = L"Direction";
    question.options = {{L"Clockwise", L"Rechts", L""}, {L"Frames", L"Bilder", L"12"}};
    return question;
}

TEST(AnswerCompletion, IsOfOptionsInTheUsersLanguage) {
    const Question question = questionOf(Question::Kind::option);
    EXPECT_THAT(textsOf(completeAnswer(L"", question)), ElementsAre(L"Rechts", L"Bilder"));
    EXPECT_THAT(textsOf(completeAnswer(L"re", question)), ElementsAre(L"Rechts"));
    EXPECT_THAT(textsOf(completeAnswer(L"_c", question)), ElementsAre(L"_Clockwise"));
}

TEST(AnswerCompletion, ClicksOptionsOfATextQuestionInBrackets) {
    const Question question = questionOf(Question::Kind::string);
    EXPECT_THAT(textsOf(completeAnswer(L"[b", question)), ElementsAre(L"[Bilder]"));
    EXPECT_THAT(textsOf(completeAnswer(L"[_f", question)), ElementsAre(L"[_Frames]"));
}

TEST(AnswerCompletion, IsOfFilesWhereTextIsAnAnswerOnly) {
    const TempFolder folder;
    writeFile(folder / "a b.txt", "");
    const std::wstring path(KM_wString::FromUtf8((folder / "a").native()).View());
    EXPECT_THAT(textsOf(completeAnswer(path, questionOf(Question::Kind::string))),
                ElementsAre(path + L" b.txt"));
    EXPECT_THAT(textsOf(completeAnswer(path, questionOf(Question::Kind::number))), IsEmpty());
}

TEST(AnswerCompletion, IsOfObjectsWhereTheyAreAskedFor) {
    Question question;
    question.kind = Question::Kind::object;
    question.object_names = {KM_wString(L"North gate"), KM_wString(L"Tower")};
    EXPECT_THAT(textsOf(completeAnswer(L"no", question)), ElementsAre(L"North gate"));
}

} // namespace
} // namespace quarn::test
